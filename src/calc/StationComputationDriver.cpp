#include "calc/StationComputationDriver.h"

#include "calc/IntersectionListing.h"
#include "calc/StationComputationForm.h"
#include "calc/StationTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

namespace {

constexpr const char* kHelpStation =
    "la station à calculer : NOM, ou NOM(2) pour sa deuxième mise en station";
constexpr const char* kHelpSightings =
    "les points visés (ou les stations qui visent) dont les visées sont prises (par défaut toutes)";
constexpr const char* kHelpPlani =
    "calculer la planimétrie (1) ou non (0) ; par défaut, comme la dernière fois";
constexpr const char* kHelpAlti = "calculer l'altimétrie (1) ou non (0) ; par défaut, comme la dernière fois";
constexpr const char* kHelpSave = "écrire la station calculée (point et V0) dans la GéoBase et l'enregistrer";

std::string Shown(const std::string& text) {
    return text.empty() ? std::string("-") : text;
}

// A linear residual to the tenth of a millimetre, a zero without its sign.
std::string Metres(double metres) {
    return IsKnown(metres) ? FormatFixedShown(metres, 4) : std::string("-");
}

} // namespace

void CStationComputationDriver::DeclareOptions(ui::DialogOptions& options) {
    options.Value("station", "NOM", kHelpStation, [this](const std::string& name) {
        m_requests.station = name;
        return std::string();
    });
    options.Value("visees", "SELECTION", kHelpSightings, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.sightings = selection;
        return std::string();
    });
    options.ZeroOrOne("plani", kHelpPlani, [this](bool on) { m_requests.plani = on; });
    options.ZeroOrOne("alti", kHelpAlti, [this](bool on) { m_requests.alti = on; });
    DeclareComputationOptions(options, m_requests.computation, kHelpSave);
}

// The result as the dialog shows it: the fields, then the residuals of each sighting taken.
void CStationComputationDriver::Print(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    const StationResult& result = m_model.Result();
    const std::string name = m_model.Station();
    const char* station = name.c_str();
    if (!result.status.empty()) txt.Print(station::kLineStatus, station, result.status.c_str());
    if (IsKnown(result.x)) {
        const bool swap = CPointGen::SwapXY();
        const std::string x = m_model.XText(), y = m_model.YText();
        const std::string emqX = Shown(m_model.EmqXText()), emqY = Shown(m_model.EmqYText());
        txt.Print(station::kLinePlace, station, swap ? station::kLabelY : station::kLabelX,
                  (swap ? y : x).c_str(), swap ? station::kLabelX : station::kLabelY, (swap ? x : y).c_str(),
                  swap ? "Y" : "X", (swap ? emqY : emqX).c_str(), swap ? "X" : "Y",
                  (swap ? emqX : emqY).c_str());
        txt.Print(station::kLineV0, station, m_model.V0Text().c_str(), Shown(m_model.EmqV0Text()).c_str());
    }
    if (IsKnown(result.z))
        txt.Print(station::kLineAltitude, station, m_model.ZText().c_str(), Shown(m_model.EmqZText()).c_str(),
                  result.altitudes);
    for (const StationSighting& s : result.sightings) {
        const std::string line = s.onStation
                                     ? Sprintf(station::kLineIntersection, s.reference.c_str(), s.reprise)
                                     : Sprintf(station::kLineResection, s.reference.c_str());
        txt.Print(station::kLineSighting, line.c_str(), Milligrads(s.v).c_str(), Metres(s.e).c_str(),
                  Milligrads(s.vz).c_str(), Metres(s.ez).c_str());
    }
}

bool CStationComputationDriver::ComputeStation(ui::FrontEnd& frontEnd) {
    if (!m_requests.station) {
        frontEnd.MessageBox(station::kMsgNoStationAsked, ui::kCaption, ui::kIconWarning);
        return false;
    }
    if (!m_model.ChooseStation(*m_requests.station)) return false;
    if (m_requests.sightings) {
        if (!m_model.SelectSightings(*m_requests.sightings)) {
            frontEnd.MessageBox(Sprintf(station::kMsgNoSightingKept, m_model.Station().c_str(),
                                        m_requests.sightings->c_str()),
                                ui::kCaption, ui::kIconWarning);
            return false;
        }
    } else {
        m_model.AddAll();
    }
    Print(frontEnd);
    // A station is computed when its planimetry is, or its altitude when only the altimetry is asked.
    const StationResult& result = m_model.Result();
    if (m_model.Plani() ? !(result.flags & kStationComputed) : !IsKnown(result.z)) return false;
    return !m_requests.computation.save || m_model.WriteStation();
}

ui::DialogResult CStationComputationDriver::Run(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(Inputs());
    if (GeoBaseNamed()) m_model.SetGeoBase(GeoBase());
    if (!m_model.Open(frontEnd))
        return m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if (m_requests.plani) m_model.SetPlani(*m_requests.plani);
    if (m_requests.alti) m_model.SetAlti(*m_requests.alti);
    bool ok = ComputeStation(frontEnd);
    // "--enregistrer" saves without the question of the closing.
    if (m_requests.computation.save && m_model.Modified() && !m_model.Save()) ok = false;
    m_model.Close(m_requests.computation.listing, m_requests.computation.listingPath);
    return ok ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CStationComputationDriver::MakeForm() {
    return std::make_unique<CStationComputationForm>(*this, m_model);
}

} // namespace pyr

#include "calc/ResectionDriver.h"

#include "calc/IntersectionListing.h"
#include "calc/ResectionForm.h"
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
constexpr const char* kHelpSave = "écrire la station calculée (point et V0) dans la GéoBase et l'enregistrer";

} // namespace

CResectionDriver::CResectionDriver(CResectionComputation& model)
    : CComputationDriver(model, kHelpSave), m_model(model) {}

void CResectionDriver::DeclareOwnOptions(ui::DialogOptions& options) {
    options.Value("station", "NOM", kHelpStation, [this](const std::string& name) {
        m_requests.station = name;
        return std::string();
    });
    options.Value("visees", "SELECTION", kHelpSightings, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.sightings = selection;
        return std::string();
    });
}

// The result as the dialog shows it: the fields, then the residuals of each sighting taken.
void CResectionDriver::Print(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    const StationResult& result = m_model.Result();
    const std::string name = m_model.Station();
    const char* station = name.c_str();
    if (!result.status.empty()) txt.Print(station::kLineStatus, station, result.status.c_str());
    if (IsKnown(result.x)) {
        const bool swap = CPointGen::SwapXY();
        const std::string x = m_model.XText(), y = m_model.YText();
        const std::string emqX = Dashed(m_model.EmqXText()), emqY = Dashed(m_model.EmqYText());
        txt.Print(station::kLinePlace, station, swap ? station::kLabelY : station::kLabelX,
                  (swap ? y : x).c_str(), swap ? station::kLabelX : station::kLabelY, (swap ? x : y).c_str(),
                  swap ? "Y" : "X", (swap ? emqY : emqX).c_str(), swap ? "X" : "Y",
                  (swap ? emqX : emqY).c_str());
        txt.Print(station::kLineV0, station, m_model.V0Text().c_str(), Dashed(m_model.EmqV0Text()).c_str());
    }
    if (IsKnown(result.z))
        txt.Print(station::kLineAltitude, station, m_model.ZText().c_str(),
                  Dashed(m_model.EmqZText()).c_str(), result.altitudes);
    for (const StationSighting& s : result.sightings) {
        const std::string line = s.onStation
                                     ? Sprintf(station::kLineIntersection, s.reference.c_str(), s.reprise)
                                     : Sprintf(station::kLineResection, s.reference.c_str());
        txt.Print(station::kLineSighting, line.c_str(), Milligrads(s.v).c_str(), DashedMetres(s.e).c_str(),
                  Milligrads(s.vz).c_str(), DashedMetres(s.ez).c_str());
    }
}

bool CResectionDriver::Compute(ui::FrontEnd& frontEnd) {
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
    return !SaveAsked() || m_model.Write();
}

std::unique_ptr<ui::Form> CResectionDriver::MakeForm() {
    return std::make_unique<CResectionForm>(*this, m_model);
}

} // namespace pyr

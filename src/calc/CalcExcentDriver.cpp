#include "calc/CalcExcentDriver.h"

#include "calc/CalcExcentForm.h"
#include "calc/EccentricTexts.h"
#include "calc/IntersectionListing.h"
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
    "la station excentrée à calculer : NOM, ou NOM(2) pour sa deuxième mise en station";
constexpr const char* kHelpCentre =
    "le point connu, visé avec une distance, à côté duquel la station est faite";
constexpr const char* kHelpSightings =
    "les visées prises : celles des points d'appui de la sélection (comme --appuis)";
constexpr const char* kHelpReferences =
    "les points d'appui dont les visées sont prises (par défaut tous ceux que vise la station)";
constexpr const char* kHelpSave = "écrire la station calculée (point et V0) dans la GéoBase et l'enregistrer";

} // namespace

CCalcExcentDriver::CCalcExcentDriver() : CComputationDriver(m_model, kHelpSave) {}

void CCalcExcentDriver::DeclareOwnOptions(ui::DialogOptions& options) {
    options.Value("station", "NOM", kHelpStation, [this](const std::string& name) {
        m_requests.station = name;
        return std::string();
    });
    options.Value("centre", "C", kHelpCentre, [this](const std::string& mat) {
        m_requests.centre = mat;
        return std::string();
    });
    // The sightings taken are those of the reference points: "--visees" says the same as "--appuis", as
    // for the other station computations.
    const auto references = [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.references = selection;
        return std::string();
    };
    options.Value("appuis", "SELECTION", kHelpReferences, references);
    options.Value("visees", "SELECTION", kHelpSightings, references);
}

// The result as the dialog shows it: the centre, the fields, then the residuals of each reference taken.
void CCalcExcentDriver::Print(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    const EccentricResult& result = m_model.Result();
    const std::string name = m_model.Station();
    const char* station = name.c_str();
    const std::string dhC = IsKnown(result.dhC) ? FormatFixedShown(result.dhC, CPointGen::DeciXY()) : "-";
    txt.Print(excent::kLineCentre, station, result.centre.c_str(), dhC.c_str());
    if (!result.status.empty()) txt.Print(station::kLineStatus, station, result.status.c_str());
    if (IsKnown(result.x)) {
        const bool swap = CPointGen::SwapXY();
        const std::string x = m_model.XText(), y = m_model.YText();
        txt.Print(excent::kLinePlace, station, swap ? station::kLabelY : station::kLabelX,
                  (swap ? y : x).c_str(), swap ? station::kLabelX : station::kLabelY, (swap ? x : y).c_str());
        txt.Print(excent::kLineV0, station, m_model.V0Text().c_str());
    }
    if (IsKnown(result.z)) {
        if (result.altitudes == 0)
            txt.Print(excent::kLineAltitudeFromCentre, station, m_model.ZText().c_str(),
                      result.centre.c_str());
        else
            txt.Print(excent::kLineAltitude, station, m_model.ZText().c_str(),
                      Dashed(m_model.EmqZText()).c_str(), result.altitudes);
    }
    for (const EccentricSighting& s : result.sightings)
        txt.Print(excent::kLineReference, Sprintf(station::kLineResection, s.reference.c_str()).c_str(),
                  Milligrads(s.ev0).c_str(), Milligrads(s.eav).c_str());
}

bool CCalcExcentDriver::Compute(ui::FrontEnd& frontEnd) {
    if (!m_requests.station || !m_requests.centre) {
        frontEnd.MessageBox(m_requests.station ? excent::kMsgNoCentreAsked : station::kMsgNoStationAsked,
                            ui::kCaption, ui::kIconWarning);
        return false;
    }
    if (!m_model.ChooseStation(*m_requests.station) || !m_model.ChooseCentre(*m_requests.centre))
        return false;
    const std::string& chosen = m_model.Station();
    if (m_requests.references) {
        if (!m_model.SelectReferences(*m_requests.references)) {
            frontEnd.MessageBox(
                Sprintf(station::kMsgNoSightingKept, chosen.c_str(), m_requests.references->c_str()),
                ui::kCaption, ui::kIconWarning);
            return false;
        }
    } else {
        m_model.AddAll();
    }
    if (m_model.Selected().empty()) {
        frontEnd.MessageBox(Sprintf(excent::kMsgNoReference, chosen.c_str(), m_model.Centre().c_str()),
                            ui::kCaption, ui::kIconWarning);
        return false;
    }
    Print(frontEnd);
    // A station is computed when its planimetry is, or its altitude when only the altimetry is asked.
    const EccentricResult& result = m_model.Result();
    if (m_model.Plani() ? !(result.flags & kExcentComputed) : !IsKnown(result.z)) return false;
    return !SaveAsked() || m_model.Write();
}

std::unique_ptr<ui::Form> CCalcExcentDriver::MakeForm() {
    return std::make_unique<CCalcExcentForm>(*this, m_model);
}

} // namespace pyr

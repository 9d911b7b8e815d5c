#include "calc/CalcIntersDriver.h"

#include "calc/CalcIntersForm.h"
#include "calc/IntersectionListing.h"
#include "calc/IntersectionTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

namespace {

constexpr const char* kHelpPoint = "le point à calculer (à répéter : chaque point est calculé à son tour)";
constexpr const char* kHelpPoints = "tous les points calculables de la sélection (100-150, P1 P7 ...)";
constexpr const char* kHelpStations = "les stations dont les visées sont prises (par défaut toutes les "
                                      "stations orientées qui visent le point)";
constexpr const char* kHelpSave = "écrire chaque point calculé dans la GéoBase et l'enregistrer";

} // namespace

CCalcIntersDriver::CCalcIntersDriver() : CComputationDriver(m_model, kHelpSave) {}

void CCalcIntersDriver::DeclareOwnOptions(ui::DialogOptions& options) {
    options.Value(
        "point", "NOM", kHelpPoint,
        [this](const std::string& mat) {
            m_requests.points.push_back(mat);
            return std::string();
        },
        true);
    options.Value("points", "SELECTION", kHelpPoints, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.selection = selection;
        return std::string();
    });
    options.Value("visees", "LISTE", kHelpStations, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.stations = selection;
        return std::string();
    });
}

// The result as the dialog shows it: the fields, then the residuals of each sighting taken.
void CCalcIntersDriver::Print(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    const InterResult& result = m_model.Result();
    const char* mat = result.mat.c_str();
    if (!result.status.empty()) txt.Print(inters::kLineStatus, mat, result.status.c_str());
    if (IsKnown(result.x)) {
        const bool swap = CPointGen::SwapXY();
        const std::string x = m_model.XText(), y = m_model.YText();
        const std::string emqX = Dashed(m_model.EmqXText()), emqY = Dashed(m_model.EmqYText());
        txt.Print(inters::kLinePoint, mat, swap ? inters::kLabelY : inters::kLabelX, (swap ? y : x).c_str(),
                  swap ? inters::kLabelX : inters::kLabelY, (swap ? x : y).c_str(), swap ? "Y" : "X",
                  (swap ? emqY : emqX).c_str(), swap ? "X" : "Y", (swap ? emqX : emqY).c_str());
    }
    if (IsKnown(result.z))
        txt.Print(inters::kLineAltitude, mat, m_model.ZText().c_str(), Dashed(m_model.EmqZText()).c_str(),
                  result.altitudes);
    for (const InterSighting& s : result.sightings)
        txt.Print(inters::kLineSighting, StationPlace{-1, s.station, s.reprise}.Designation().c_str(),
                  Milligrads(s.v).c_str(), DashedMetres(s.e).c_str(), Milligrads(s.vz).c_str(),
                  DashedMetres(s.ez).c_str());
}

bool CCalcIntersDriver::ComputePoint(ui::FrontEnd& frontEnd, const std::string& mat) {
    if (!m_model.ChoosePoint(mat)) return false;
    if (m_requests.stations) {
        if (!m_model.SelectStations(*m_requests.stations)) {
            frontEnd.MessageBox(
                Sprintf(inters::kMsgNoSightingKept, mat.c_str(), m_requests.stations->c_str()), ui::kCaption,
                ui::kIconWarning);
            return false;
        }
    } else {
        m_model.AddAll();
    }
    Print(frontEnd);
    // A point is computed when its planimetry is, or its altitude when only the altimetry is asked.
    const InterResult& result = m_model.Result();
    if (m_model.Plani() ? !(result.flags & kInterComputed) : !IsKnown(result.z)) return false;
    return !SaveAsked() || m_model.WritePoint();
}

bool CCalcIntersDriver::Compute(ui::FrontEnd& frontEnd) {
    std::vector<std::string> asked = m_requests.points;
    bool ok = true;
    if (m_requests.selection) {
        const std::optional<CSelection> selection = CSelection::Parse(*m_requests.selection);
        std::size_t found = 0;
        for (const std::string& mat : m_model.Points())
            if (selection && selection->Contains(mat)) asked.push_back(mat), ++found;
        if (found == 0) {
            frontEnd.MessageBox(Sprintf(inters::kMsgNoPointInSelection, m_requests.selection->c_str()),
                                ui::kCaption, ui::kIconWarning);
            ok = false;
        }
    }
    if (asked.empty() && ok) {
        frontEnd.MessageBox(inters::kMsgNoPointAsked, ui::kCaption, ui::kIconWarning);
        ok = false;
    }
    for (const std::string& mat : asked)
        ok = ComputePoint(frontEnd, mat) && ok;
    return ok;
}

std::unique_ptr<ui::Form> CCalcIntersDriver::MakeForm() {
    return std::make_unique<CCalcIntersForm>(*this, m_model);
}

} // namespace pyr

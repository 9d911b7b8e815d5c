#include "calc/CalcRayonDriver.h"

#include "calc/CalcRayonForm.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"

namespace pyr {

namespace {

constexpr const char* kHelpType = "les stations à rayonner : une, celles d'une liste, toutes (par défaut, "
                                  "comme la dernière fois)";
constexpr const char* kHelpStation = "la station à rayonner, S1 ou S1(2) pour sa deuxième reprise";
constexpr const char* kHelpList = "les stations à rayonner, toutes leurs reprises";
constexpr const char* kHelpPoints = "ne rayonner que ces points (par défaut tous les points visés)";
constexpr const char* kHelpSave = "écrire les points nouveaux (et les V0 calculés) dans la GéoBase et "
                                  "l'enregistrer ; un point hors tolérance est proposé";

} // namespace

void CCalcRayonDriver::DeclareOptions(ui::DialogOptions& options) {
    DeclareTypeOption(options, m_requests.choice, kHelpType);
    DeclareStationOption(options, m_requests.choice, kHelpStation);
    DeclareListOption(options, m_requests.choice, kHelpList);
    options.Value("points", "SELECTION", kHelpPoints, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.points = selection;
        return std::string();
    });
    DeclareComputationOptions(options, m_requests.computation, kHelpSave);
}

ui::DialogResult CCalcRayonDriver::Run(ui::FrontEnd& frontEnd) {
    CCalcRayon& rayon = m_model;
    rayon.SetInputs(Inputs());
    if (GeoBaseNamed()) rayon.SetGeoBase(GeoBase());
    if (m_requests.choice.type) rayon.SetType(*m_requests.choice.type);
    if (!rayon.Open(frontEnd)) return rayon.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if ((m_requests.choice.station && !rayon.ChooseStation(*m_requests.choice.station)) ||
        (m_requests.choice.list && !rayon.SetList(*m_requests.choice.list)) ||
        (m_requests.points && !rayon.SetPoints(*m_requests.points))) {
        rayon.Close(false, false);
        return ui::DialogResult::Failed;
    }
    const bool done = rayon.Calculate();
    const bool saved = done && m_requests.computation.save && rayon.Enregistrer();
    rayon.Close(saved, m_requests.computation.listing, m_requests.computation.listingPath);
    return done && (saved || !m_requests.computation.save) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CCalcRayonDriver::MakeForm() {
    return std::make_unique<CCalcRayonForm>(*this, m_model);
}

} // namespace pyr

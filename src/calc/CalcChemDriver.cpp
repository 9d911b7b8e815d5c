#include "calc/CalcChemDriver.h"

#include "calc/CalcChemForm.h"

namespace pyr {

namespace {

constexpr const char* kHelpTraverse = "le cheminement à calculer, par son nom (l'option peut se répéter)";
constexpr const char* kHelpSearch =
    "cherche les cheminements parmi les stations et les écrit dans la GéoBase avant le calcul";
constexpr const char* kHelpAll = "tous les cheminements de la GéoBase (par défaut)";
constexpr const char* kHelpSave = "écrire les coordonnées et les V0 des stations dans la GéoBase et "
                                  "l'enregistrer ; un cheminement hors tolérance est proposé";

} // namespace

void CCalcChemDriver::DeclareOptions(ui::DialogOptions& options) {
    options.Value(
        "cheminement", "NOM", kHelpTraverse,
        [this](const std::string& name) {
            m_traverses.push_back(name);
            return std::string();
        },
        true);
    options.Switch("recherche", kHelpSearch, [this] {
        m_search = true;
        return std::string();
    });
    options.Switch("tous", kHelpAll, [this] {
        m_traverses.clear();
        return std::string();
    });
    DeclareComputationOptions(options, m_computation, kHelpSave);
}

ui::DialogResult CCalcChemDriver::Run(ui::FrontEnd& frontEnd) {
    CCalcChem& chem = m_model;
    chem.SetInputs(Inputs());
    if (GeoBaseNamed()) chem.SetGeoBase(GeoBase());
    if (!chem.Open(frontEnd, m_search))
        return chem.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if (m_search && chem.Search() < 0) {
        chem.Close(false, false);
        return ui::DialogResult::Failed;
    }
    for (const std::string& name : m_traverses)
        if (!chem.Choose(name)) {
            chem.Close(false, false);
            return ui::DialogResult::Failed;
        }
    const bool done = chem.Calculate();
    const bool saved = done && m_computation.save && chem.Enregistrer();
    chem.Close(saved, m_computation.listing, m_computation.listingPath);
    return done && (saved || !m_computation.save) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CCalcChemDriver::MakeForm() {
    return std::make_unique<CCalcChemForm>(*this, m_model);
}

} // namespace pyr

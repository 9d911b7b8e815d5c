#include "calc/CalcNivDriver.h"

#include "calc/CalcNivForm.h"

namespace pyr {

namespace {

constexpr const char* kHelpStart = "ne calculer que les cheminements qui partent de ce repère";
constexpr const char* kHelpEnd = "ne calculer que les cheminements qui arrivent sur ce repère";
constexpr const char* kHelpSave = "écrire les altitudes calculées dans la GéoBase et l'enregistrer ; un "
                                  "cheminement hors tolérance est proposé";

} // namespace

void CCalcNivDriver::DeclareOptions(ui::DialogOptions& options) {
    options.Value("depart", "A", kHelpStart, [this](const std::string& name) {
        m_start = name;
        return std::string();
    });
    options.Value("arrivee", "B", kHelpEnd, [this](const std::string& name) {
        m_end = name;
        return std::string();
    });
    DeclareComputationOptions(options, m_computation, kHelpSave);
}

ui::DialogResult CCalcNivDriver::Run(ui::FrontEnd& frontEnd) {
    CCalcNiv& niv = m_model;
    niv.SetInputs(Inputs());
    if (GeoBaseNamed()) niv.SetGeoBase(GeoBase());
    if (!niv.Open(frontEnd)) return niv.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    niv.Choose(m_start, m_end);
    const bool done = niv.Calculate();
    const bool saved = done && m_computation.save && niv.Enregistrer();
    niv.Close(saved, m_computation.listing, m_computation.listingPath);
    return done && (saved || !m_computation.save) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CCalcNivDriver::MakeForm() {
    return std::make_unique<CCalcNivForm>(*this, m_model);
}

} // namespace pyr

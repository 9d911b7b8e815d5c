#pragma once

#include "calc/CalcChem.h"
#include "calc/ComputationOptions.h"
#include "ui/Dialog.h"

#include <memory>
#include <string>
#include <vector>

namespace pyr {

// The polygonal traverses run from a command line: "--recherche" (the automatic search first, its traverses
// written into the GéoBase), "--cheminement NOM" (repeatable) or "--tous" (every
// traverse of the GéoBase, the default), "--enregistrer" and "--listing"; the run opens the GéoBase,
// computes, writes and closes. With "--oui", a traverse out of tolerance is written, as a person answering
// yes would. It fails when no traverse could be computed, or when the GéoBase could not be saved.
class CCalcChemDriver : public ui::Dialog {
public:
    std::string Caption() const override { return m_model.Caption(); }
    ui::DialogModel& Model() override { return m_model; }
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The window, over the same model.
    std::unique_ptr<ui::Form> MakeForm() override;

private:
    CCalcChem m_model;
    std::vector<std::string> m_traverses;
    bool m_search = false;
    ComputationRequests m_computation;
};

} // namespace pyr

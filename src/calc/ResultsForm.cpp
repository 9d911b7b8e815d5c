#include "calc/ResultsForm.h"

#include "ui/FormControls.h"

namespace pyr {

namespace {
constexpr const char* kStatusSaved = "Enregistrement terminé : le détail est dans la fenêtre de texte.";
constexpr const char* kStatusNotSaved = "La GéoBase n'a pas pu être enregistrée.";
} // namespace

std::vector<ui::Control> CResultsForm::FootButtons() const {
    using ui::ControlKind;
    using ui::Ctl;
    return {Ctl(m_saveId, ControlKind::Button, "enregistrer", "&Enregistrer").In(ui::kButtonRow),
            Ctl(ui::kIdOk, ControlKind::Button, "finListing", "Fin + Listing").In(ui::kButtonRow).At(0, 1),
            Ctl(ui::kIdCancel, ControlKind::Button, "fermer", "&Fermer").In(ui::kButtonRow).At(0, 2)};
}

void CResultsForm::SayNotSaved() {
    m_message = kStatusNotSaved;
}

bool CResultsForm::FootState(int id, ui::ControlState& state) const {
    if (id == m_saveId)
        state.enabled = m_pending;
    else if (id == ui::kIdOk)
        state.enabled = HasResults();
    else
        return id == ui::kIdCancel;
    return true;
}

void CResultsForm::Finish(bool listingAsked) {
    CloseModel(m_saved, listingAsked);
    End(listingAsked || m_saved ? ui::DialogResult::Ok : ui::DialogResult::Cancel);
}

bool CResultsForm::FootAct(int id) {
    if (id == m_saveId) {
        if (!m_pending) return true;
        if (WriteResults()) {
            m_saved = true;
            m_pending = false;
            m_message = kStatusSaved;
            Focus(ui::kIdOk);
        } else {
            m_message = kStatusNotSaved;
        }
    } else if (id == ui::kIdOk) {
        if (HasResults()) Finish(true);
    } else if (id == ui::kIdCancel) {
        Finish(false);
    } else {
        return false;
    }
    return true;
}

} // namespace pyr

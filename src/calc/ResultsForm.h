#pragma once

#include "ui/Form.h"

#include <string>
#include <vector>

namespace pyr {

// A window whose results are computed, then written into the GéoBase by "&Enregistrer", and which is
// left by "Fin + Listing" (the listing written) or "&Fermer" (the listing offered): the three buttons
// of its foot, their states and actions, and the status line's last word on them.
class CResultsForm : public ui::Form {
protected:
    explicit CResultsForm(int saveId) : m_saveId(saveId) {}

    // "&Enregistrer", "Fin + Listing" and "&Fermer", in that order.
    std::vector<ui::Control> FootButtons() const;
    // After "&Calculer": whether there is something to write.
    void Computed(bool anything) {
        m_pending = anything;
        m_message.clear();
        if (anything) Focus(m_saveId);
    }
    // The state of a button of the foot into `state`; false when `id` is none of them.
    bool FootState(int id, ui::ControlState& state) const;
    // The action of a button of the foot; false when `id` is none of them.
    bool FootAct(int id);

    // What the last action left to say; empty when the window says what it shows.
    const std::string& Message() const { return m_message; }
    void Say(std::string message) { m_message = std::move(message); }
    // "La GéoBase n'a pas pu être enregistrée."
    void SayNotSaved();

private:
    // The model's "&Enregistrer": false when the GéoBase could not be saved.
    virtual bool WriteResults() = 0;
    // The model closed: the listing written when asked, offered otherwise.
    virtual void CloseModel(bool saved, bool listingAsked) = 0;
    virtual bool HasResults() const = 0;
    void Finish(bool listingAsked);

    int m_saveId;
    bool m_saved = false;   // the results written into the GéoBase
    bool m_pending = false; // results computed and not yet written
    std::string m_message;
};

} // namespace pyr

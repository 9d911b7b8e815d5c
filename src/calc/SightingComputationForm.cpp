#include "calc/SightingComputationForm.h"

#include "core/Strings.h"
#include "ui/FormControls.h"

#include <algorithm>

namespace pyr {

namespace {

using ui::Control;
using ui::ControlKind;
using ui::Ctl;
using Line = CSightingComputation::Line;

constexpr const char* kLabelEmq = "EMQ";

std::vector<std::string> Texts(const std::vector<Line>& lines) {
    std::vector<std::string> texts;
    texts.reserve(lines.size());
    for (const auto& line : lines)
        texts.push_back(line.text);
    return texts;
}

std::vector<std::string> Tips(const std::vector<Line>& lines) {
    std::vector<std::string> tips;
    tips.reserve(lines.size());
    for (const auto& line : lines)
        tips.push_back(line.tooltip);
    return tips;
}

} // namespace

std::vector<ui::Control> CSightingComputationForm::Controls() const {
    // Two lists side by side with the arrows between them, the switches under them, then the results in
    // a frame: a value and its EMQ on each line.
    using K = ControlKind;
    std::vector<Control> controls{
        Ctl(kLabelSubject, K::Label, "etiquetteSujet", m_subjectLabel).Buddy(kSubject),
        Ctl(kSubject, K::EditCombo, "sujet").At(0, 1).Width(12),
        Ctl(kLabelAvailable, K::Label, "etiquetteDisponibles", "Visées &disponibles :")
            .At(1, 0, 1, 2)
            .Buddy(kAvailable),
        Ctl(kAvailable, K::List, "disponibles").At(2, 0, 4, 2).Width(20).Lines(8),
        Ctl(kAddOne, K::Button, "ajouterUne", "&Ajouter >").At(2, 2),
        Ctl(kAddAll, K::Button, "ajouterToutes", "Ajouter t&out >>").At(3, 2),
        Ctl(kRemoveOne, K::Button, "retirerUne", "< &Retirer").At(4, 2),
        Ctl(kRemoveAll, K::Button, "retirerToutes", "<< Retirer to&us").At(5, 2),
        Ctl(kLabelSelected, K::Label, "etiquetteRetenues", "Visées rete&nues :")
            .At(1, 3, 1, 2)
            .Buddy(kSelected),
        Ctl(kSelected, K::List, "retenues").At(2, 3, 4, 2).Width(20).Lines(8),
        Ctl(kPlani, K::Check, "calculPlani", "Calcul en p&lanimétrie").At(6, 0, 1, 2),
        Ctl(kAlti, K::Check, "calculAlti", "Calcul en al&timétrie").At(6, 3, 1, 2),
        Ctl(kResults, K::Group, "resultat", "Résultat").At(7, 0, 1, 5),
    };
    int row = 0;
    for (const ResultLine& line : ResultLines()) {
        const std::string name = line.name;
        controls.push_back(Ctl(ResultLabel(row), K::Label, "etiquette" + name, line.label)
                               .In(kResults)
                               .At(row, 0)
                               .Buddy(ResultValue(row)));
        controls.push_back(
            Ctl(ResultValue(row), K::Field, "valeur" + name).In(kResults).At(row, 1).Width(14));
        if (line.withEmq) {
            controls.push_back(Ctl(ResultLabel(row) + 2, K::Label, "etiquetteEmq" + name, kLabelEmq)
                                   .In(kResults)
                                   .At(row, 2)
                                   .Buddy(ResultEmq(row)));
            controls.push_back(Ctl(ResultEmq(row), K::Field, "emq" + name).In(kResults).At(row, 3).Width(8));
        }
        ++row;
    }
    controls.push_back(Ctl(kStatus, K::Status, "etat").At(8, 0, 1, 5));
    controls.push_back(Ctl(kWrite, K::Button, "ecrire", m_writeLabel).At(9, 0, 1, 2));
    controls.push_back(Ctl(ui::kIdOk, K::Button, "finListing", "Fin + Listing").In(ui::kButtonRow).Default());
    controls.push_back(Ctl(ui::kIdCancel, K::Button, "fermer", "&Fermer").In(ui::kButtonRow).At(0, 1));
    AddOwnControls(controls);
    return controls;
}

bool CSightingComputationForm::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (m_model.Open(frontEnd)) return true;
    // No GéoBase chosen is a cancel; any other refusal was told by a message.
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

ui::ControlState CSightingComputationForm::State(int id) const {
    ui::ControlState state;
    switch (id) {
    case kSubject: {
        state.items = m_model.Subjects();
        state.text = m_model.Subject();
        const auto found = std::find(state.items.begin(), state.items.end(), state.text);
        if (!state.text.empty() && found != state.items.end())
            state.current = static_cast<int>(found - state.items.begin());
        return state;
    }
    case kAvailable:
        state.items = Texts(m_model.Available());
        state.tips = Tips(m_model.Available());
        state.current = m_model.HighlightedAvailable();
        return state;
    case kSelected:
        state.items = Texts(m_model.Selected());
        state.tips = Tips(m_model.Selected());
        state.current = m_model.HighlightedSelected();
        return state;
    case kAddOne:
        state.enabled = m_model.CanAddOne();
        return state;
    case kAddAll:
        state.enabled = m_model.CanAddAll();
        return state;
    case kRemoveOne:
        state.enabled = m_model.CanRemoveOne();
        return state;
    case kRemoveAll:
        state.enabled = m_model.CanRemoveAll();
        return state;
    case kPlani:
        state.checked = m_model.Plani();
        return state;
    case kAlti:
        state.checked = m_model.Alti();
        return state;
    case kStatus:
        state.text = m_model.Status();
        return state;
    case kWrite:
        state.enabled = m_model.CanWrite();
        return state;
    case ui::kIdOk:
        state.enabled = m_model.CanFinish();
        return state;
    default:
        break;
    }
    if (id >= kFirstOwn) return OwnState(id);
    if (id >= kFirstResult) {
        const std::vector<ResultLine> lines = ResultLines();
        const auto line = static_cast<std::size_t>((id - kFirstResult) / 4);
        if (line >= lines.size()) return state;
        switch ((id - kFirstResult) % 4) {
        case 0:
            state.text = lines[line].label;
            break;
        case 1:
            state.text = lines[line].value;
            break;
        case 3:
            state.text = lines[line].emq;
            break;
        default:
            break;
        }
    }
    return state;
}

void CSightingComputationForm::Moved() {
    if (m_model.CanFinish()) Focus(ui::kIdOk);
}

void CSightingComputationForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    using ui::EventKind;
    switch (id) {
    case kSubject: {
        const std::vector<std::string>& subjects = m_model.Subjects();
        std::string subject;
        if (event.kind == EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(subjects.size()))
            subject = subjects[static_cast<std::size_t>(event.rank)];
        else if (event.kind == EventKind::Text)
            subject = Trimmed(event.text);
        // The subject shown again keeps the sightings taken.
        if (subject.empty() || subject == m_model.Subject()) return;
        if (m_model.ChooseSubject(subject)) Focus(kAvailable);
        return;
    }
    case kAvailable:
        if (event.kind == EventKind::Select || event.kind == EventKind::Activate)
            m_model.HighlightAvailable(event.rank);
        if (event.kind == EventKind::Activate && m_model.CanAddOne()) {
            m_model.AddOne();
            Moved();
        }
        return;
    case kSelected:
        if (event.kind == EventKind::Select || event.kind == EventKind::Activate)
            m_model.HighlightSelected(event.rank);
        if (event.kind == EventKind::Activate && m_model.CanRemoveOne()) {
            m_model.RemoveOne();
            Moved();
        }
        return;
    case kAddOne:
        m_model.AddOne(), Moved();
        return;
    case kAddAll:
        m_model.AddAll(), Moved();
        return;
    case kRemoveOne:
        m_model.RemoveOne(), Moved();
        return;
    case kRemoveAll:
        m_model.RemoveAll(), Moved();
        return;
    case kPlani:
        if (event.kind == EventKind::Check) m_model.SetPlani(event.on);
        return;
    case kAlti:
        if (event.kind == EventKind::Check) m_model.SetAlti(event.on);
        return;
    case kWrite:
        if (m_model.CanWrite() && m_model.Write()) m_written = true;
        return;
    case ui::kIdOk:
        if (!m_model.CanFinish()) return;
        m_model.FinishWithListing();
        End(ui::DialogResult::Ok);
        return;
    case ui::kIdCancel:
        m_model.Close();
        End(m_written ? ui::DialogResult::Ok : ui::DialogResult::Cancel);
        return;
    default:
        if (id >= kFirstOwn) OwnAct(frontEnd, id, event);
        return;
    }
}

} // namespace pyr

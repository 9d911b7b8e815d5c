#include "calc/ChangeRepForm.h"

#include "calc/ChangeRepTexts.h"
#include "core/Strings.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

namespace pyr {

using ui::ControlKind;
using ui::Ctl;

namespace {

constexpr const char* kFieldNames[CChange_Rep::kFieldCount] = {
    "repere1XA", "repere1YA", "repere1XB", "repere1YB", "repere2XA", "repere2YA", "repere2XB", "repere2YB",
};

} // namespace

std::vector<ui::Control> CChangeRepForm::Controls() const {
    std::vector<ui::Control> controls;
    // Each frame: the columns X and Y, then a row for each common point.
    for (int frame = 0; frame < 2; ++frame) {
        const int group = kFirstFrameGroup + frame;
        const int label = kFirstFrameLabel + 4 * frame;
        const int field = kFirstField + 4 * frame;
        const std::string suffix = std::to_string(frame + 1);
        controls.push_back(
            Ctl(group, ControlKind::Group, "repere" + suffix, frame == 0 ? rep::kFrame1 : rep::kFrame2)
                .At(0, frame));
        controls.push_back(
            Ctl(label, ControlKind::Label, "colonneX" + suffix, rep::kColumnX).In(group).At(0, 1));
        controls.push_back(
            Ctl(label + 1, ControlKind::Label, "colonneY" + suffix, rep::kColumnY).In(group).At(0, 2));
        for (int point = 0; point < 2; ++point) {
            controls.push_back(Ctl(label + 2 + point, ControlKind::Label,
                                   "point" + std::to_string(point + 1) + suffix,
                                   point == 0 ? rep::kFirstPoint : rep::kSecondPoint)
                                   .In(group)
                                   .At(1 + point, 0)
                                   .Buddy(field + 2 * point));
            for (int axis = 0; axis < 2; ++axis) {
                const int id = field + 2 * point + axis;
                controls.push_back(Ctl(id, ControlKind::Edit, kFieldNames[id - kFirstField])
                                       .In(group)
                                       .At(1 + point, 1 + axis)
                                       .Width(14));
            }
        }
    }
    controls.push_back(Ctl(kDistances, ControlKind::Status, "distances").At(1, 0, 1, 2));

    controls.push_back(Ctl(kResultsGroup, ControlKind::Group, "resultats", rep::kResults).At(2, 0, 1, 2));
    const struct {
        int label, field;
        const char *labelName, *fieldName, *text;
    } results[] = {
        {kLabelRotation, kRotation, "etiquetteRotation", "rotation", rep::kLabelRotation},
        {kLabelTranslationX, kTranslationX, "etiquetteTranslationX", "translationX", rep::kLabelTranslationX},
        {kLabelTranslationY, kTranslationY, "etiquetteTranslationY", "translationY",
         rep::kLabelTranslationY}};
    for (int row = 0; row < 3; ++row) {
        const auto& result = results[row];
        controls.push_back(Ctl(result.label, ControlKind::Label, result.labelName, result.text)
                               .In(kResultsGroup)
                               .At(row, 0));
        controls.push_back(
            Ctl(result.field, ControlKind::Field, result.fieldName).In(kResultsGroup).At(row, 1).Width(14));
    }
    controls.push_back(
        Ctl(kUnitRotation, ControlKind::Label, "uniteRotation", rep::kUnitGrads).In(kResultsGroup).At(0, 2));

    controls.push_back(Ctl(kOptionsGroup, ControlKind::Group, "options", rep::kOptions).At(3, 0, 1, 2));
    const std::span<const ChangeRepSwitch> switches = ChangeRepSwitches();
    for (std::size_t i = 0; i < switches.size(); ++i) {
        const int row = static_cast<int>(i);
        controls.push_back(Ctl(kFirstSwitch + row, ControlKind::Check, switches[i].key, switches[i].checkBox)
                               .In(kOptionsGroup)
                               .At(row, 0, 1, 2));
        // The selection follows "Tous les points", which it stands for when that is off.
        if (i == kSwitchAllPoints) {
            controls.push_back(
                Ctl(kLabelSelection, ControlKind::Label, "etiquetteSelection", rep::kLabelSelection)
                    .In(kOptionsGroup)
                    .At(static_cast<int>(switches.size()), 0)
                    .Buddy(kSelection));
            controls.push_back(Ctl(kSelection, ControlKind::Edit, "selection")
                                   .In(kOptionsGroup)
                                   .At(static_cast<int>(switches.size()), 1)
                                   .Width(30));
        }
    }
    controls.push_back(Ctl(ui::kIdOk, ControlKind::Button, "ok", "OK").In(ui::kButtonRow).Default());
    controls.push_back(
        Ctl(ui::kIdCancel, ControlKind::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1));
    return controls;
}

bool CChangeRepForm::Open(ui::FrontEnd&) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (!m_model.Carnet()) {
        End(ui::DialogResult::Failed);
        return false;
    }
    m_model.OnInitDialog();
    return true;
}

ui::ControlState CChangeRepForm::State(int id) const {
    ui::ControlState state;
    if (id >= kFirstField && id < kFirstField + CChange_Rep::kFieldCount) {
        state.text = m_model.FieldText(id - kFirstField);
        return state;
    }
    const int which = id - kFirstSwitch;
    if (which >= 0 && which < static_cast<int>(kChangeRepSwitchCount)) {
        state.checked = m_model.Switch(static_cast<std::size_t>(which));
        // "Conserver le Z" only means something when Y and Z are swapped.
        if (which == kSwitchKeepZ) state.enabled = m_model.Options().swapYZ;
        return state;
    }
    switch (id) {
    case kDistances:
        state.text = m_model.DistanceStatus();
        break;
    case kRotation:
        state.text = m_model.RotationText();
        break;
    case kTranslationX:
        state.text = m_model.TranslationXText();
        break;
    case kTranslationY:
        state.text = m_model.TranslationYText();
        break;
    case kLabelSelection:
    case kSelection:
        state.text = id == kSelection ? m_model.Selection() : std::string();
        state.enabled = !m_model.Options().allPoints;
        break;
    case ui::kIdOk:
        state.enabled = m_model.CanOK();
        break;
    default:
        break;
    }
    return state;
}

void CChangeRepForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    if (event.kind == ui::EventKind::Text && id >= kFirstField &&
        id < kFirstField + CChange_Rep::kFieldCount) {
        if (!m_model.SetField(id - kFirstField, event.text)) {
            frontEnd.MessageBox(Sprintf(rep::kNotANumber, event.text.c_str()), ui::kCaption,
                                ui::kIconWarning);
            Focus(id);
        }
        return;
    }
    const int which = id - kFirstSwitch;
    if (event.kind == ui::EventKind::Check && which >= 0 && which < static_cast<int>(kChangeRepSwitchCount)) {
        // A box ticked in the window is kept in the parameter file on OK only.
        m_model.Options().*ChangeRepSwitches()[static_cast<std::size_t>(which)].member = event.on;
        return;
    }
    if (id == kSelection && event.kind == ui::EventKind::Text) {
        m_model.SetSelection(event.text);
    } else if (id == ui::kIdOk) {
        if (m_model.OnOK(frontEnd))
            End(ui::DialogResult::Ok);
        else if (!m_model.Options().allPoints)
            Focus(kSelection); // the selection to type again
    } else if (id == ui::kIdCancel) {
        End(ui::DialogResult::Cancel);
    }
}

} // namespace pyr

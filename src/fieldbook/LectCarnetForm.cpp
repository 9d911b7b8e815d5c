#include "fieldbook/LectCarnetForm.h"

#include "fieldbook/ParamDriverForm.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

namespace pyr {

namespace {

using ui::ControlKind;

constexpr int kPathWidth = 50;

} // namespace

std::vector<ui::Control> CLectCarnetForm::Controls() const {
    using Id = CLectCarnetForm;
    std::vector<ui::Control> controls;
    // A file: its label, its edit and its browse button, on a row of the grid.
    const auto file = [&controls](int label, const char* name, const char* text, int row) {
        ui::Control caption =
            ui::Ctl(label, ControlKind::Label, std::string(name) + "Label", text).At(row, 0);
        caption.buddy = label + 1;
        controls.push_back(caption);
        ui::Control edit = ui::Ctl(label + 1, ControlKind::Edit, name).At(row, 1);
        edit.width = kPathWidth;
        controls.push_back(edit);
        controls.push_back(
            ui::Ctl(label + 2, ControlKind::Button, std::string(name) + "Parcourir", "...").At(row, 2));
    };
    file(Id::kCarnetLabel, "carnet", "&Carnet :", 0);
    file(Id::kGeoBaseLabel, "geobase", "&GéoBase à créer :", 1);
    file(Id::kParamFileLabel, "parametrage", "&Fichier de paramétrage :", 2);
    controls.push_back(ui::Ctl(Id::kInterpret, ControlKind::Check, "interpretation",
                               "&Interpréter les codes par la table de codes")
                           .At(3, 1, 1, 2));
    file(Id::kCodeTableLabel, "table", "Ta&ble de codes :", 4);
    controls.push_back(ui::Ctl(Id::kWriteInstrument, ControlKind::Check, "ecrireAppareil",
                               "Écrire l'&appareil en tête de la GéoBase")
                           .At(5, 1, 1, 2));
    ui::Control label =
        ui::Ctl(Id::kInstrumentLabel, ControlKind::Label, "appareilLabel", "Appareil de &terrain :").At(6, 0);
    label.buddy = Id::kInstrument;
    controls.push_back(label);
    controls.push_back(ui::Ctl(Id::kInstrument, ControlKind::Combo, "appareil").At(6, 1));

    ui::Control params = ui::Ctl(Id::kEditParams, ControlKind::Button, "parametres", "&Paramètres...");
    params.parent = ui::kButtonRow;
    controls.push_back(params);
    ui::Control ok = ui::Ctl(ui::kIdOk, ControlKind::Button, "ok", "OK").At(0, 1);
    ok.parent = ui::kButtonRow;
    ok.isDefault = true;
    controls.push_back(ok);
    ui::Control cancel = ui::Ctl(ui::kIdCancel, ControlKind::Button, "annuler", "Annuler").At(0, 2);
    cancel.parent = ui::kButtonRow;
    controls.push_back(cancel);
    return controls;
}

bool CLectCarnetForm::Open(ui::FrontEnd&) {
    return true; // the conversion filled the dialog from the format's settings
}

int CLectCarnetForm::FieldControl(CLectCarnet::Field field) {
    switch (field) {
    case CLectCarnet::Field::Carnet:
        return kCarnet;
    case CLectCarnet::Field::GeoBase:
        return kGeoBase;
    case CLectCarnet::Field::ParamFile:
        return kParamFile;
    case CLectCarnet::Field::CodeTable:
        return kCodeTable;
    case CLectCarnet::Field::None:
        break;
    }
    return 0;
}

ui::ControlState CLectCarnetForm::State(int id) const {
    ui::ControlState state;
    switch (id) {
    case kCarnet:
        state.text = m_dialog.Carnet();
        break;
    case kGeoBase:
        state.text = m_dialog.GeoBasePath();
        [[fallthrough]];
    case kGeoBaseLabel:
    case kBrowseGeoBase:
        state.visible = m_dialog.GeoBaseFieldVisible();
        break;
    case kParamFile:
        state.text = m_dialog.ParamFile();
        [[fallthrough]];
    case kParamFileLabel:
    case kBrowseParamFile:
    case kEditParams:
        state.visible = m_dialog.HasParamFile();
        break;
    case kInterpret:
        state.checked = m_dialog.Interpret();
        break;
    case kCodeTable:
        state.text = m_dialog.CodeTablePath();
        [[fallthrough]];
    case kCodeTableLabel:
    case kBrowseCodeTable:
        state.enabled = m_dialog.CodeTableEnabled();
        break;
    case kWriteInstrument:
        state.checked = m_dialog.WriteInstrument();
        break;
    case kInstrument:
        state.items = m_dialog.InstrumentNames();
        state.current = m_dialog.InstrumentIndex();
        [[fallthrough]];
    case kInstrumentLabel:
        state.enabled = m_dialog.InstrumentEnabled();
        break;
    default:
        break;
    }
    return state;
}

void CLectCarnetForm::EditParams(ui::FrontEnd& frontEnd) {
    if (!m_dialog.PrepareEditParams(frontEnd)) {
        Focus(kParamFile);
        return;
    }
    CDlgParamDriver settings(m_dialog.Driver(), m_dialog.InstallDir(), m_dialog.FormatName());
    settings.SetInputs(m_dialog.Inputs());
    frontEnd.DoModal(settings);
}

void CLectCarnetForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    const bool typed = event.kind == ui::EventKind::Text;
    switch (id) {
    case kCarnet:
        // A field book typed names the GéoBase to create, as one chosen does.
        if (typed && event.text != m_dialog.Carnet()) m_dialog.SetCarnetFromSettings(event.text);
        break;
    case kGeoBase:
        if (typed) m_dialog.SetGeoBasePath(event.text);
        break;
    case kParamFile:
        if (typed) m_dialog.SetParamFile(event.text);
        break;
    case kCodeTable:
        if (typed) m_dialog.SetCodeTablePath(event.text);
        break;
    case kBrowseCarnet:
        m_dialog.BrowseCarnet(frontEnd);
        break;
    case kBrowseGeoBase:
        m_dialog.BrowseGeoBase(frontEnd);
        break;
    case kBrowseParamFile:
        m_dialog.BrowseParamFile(frontEnd);
        break;
    case kBrowseCodeTable:
        m_dialog.BrowseCodeTable(frontEnd);
        break;
    case kInterpret:
        m_dialog.SetInterpret(event.on);
        break;
    case kWriteInstrument:
        m_dialog.SetWriteInstrument(event.on);
        break;
    case kInstrument: {
        const auto names = m_dialog.InstrumentNames();
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(names.size()))
            m_dialog.SetInstrumentName(names[static_cast<std::size_t>(event.rank)]);
        break;
    }
    case kEditParams:
        if (m_dialog.HasParamFile()) EditParams(frontEnd);
        break;
    case ui::kIdOk:
        // A check that fails leaves the dialog open on the field it names.
        if (m_dialog.OnOK(frontEnd) == ui::DialogResult::Ok)
            End(ui::DialogResult::Ok);
        else
            Focus(FieldControl(m_dialog.FocusField()));
        break;
    case ui::kIdCancel:
        End(ui::DialogResult::Cancel);
        break;
    default:
        break;
    }
}

std::unique_ptr<ui::Form> CLectCarnet::MakeForm() {
    return std::make_unique<CLectCarnetForm>(*this);
}

} // namespace pyr

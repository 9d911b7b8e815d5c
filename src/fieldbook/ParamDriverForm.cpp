#include "fieldbook/ParamDriverForm.h"

#include "core/Files.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookTexts.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <span>

namespace pyr {

namespace {

constexpr const char* kCaption = "Paramétrage du carnet";

struct Named {
    const char* name;
    const char* label;
};

// The keys as a surveyor reads them. The accelerators are unique among the keys of each format: the
// instruments' keys and those of the delimited and columnar layouts never show together.
constexpr Named kKeyLabels[] = {
    {kKeyUniteAngles, "Unité des &angles :"},
    {kKeyUniteDistances, "Unité des &distances :"},
    {kKeyOrdreCoordonnees, "&Ordre des coordonnées :"},
    {kKeyReferences, "Visées de &référence :"},
    {kKeyCodesReference, "&Codes des visées de référence :"},
    {kKeyConventionStation, "Écriture des &stations :"},
    {kKeyCodesStation, "Codes des &blocs de station (41) :"},
    {kKeyPointsCalcules, "Garder les &points calculés par l'appareil"},
    {kKeySeparateur, "&Séparateur des champs (TAB, ESPACE) :"},
    {kKeySeparateurDecimal, "Séparateur déc&imal :"},
    {kKeyLignesEntete, "&Lignes d'en-tête à sauter :"},
    {kKeyTypeStation, "Type des s&tations :"},
    {kKeyTypeReference, "Type des &références :"},
    {kKeyTypeMesure, "Type des &mesures :"},
    {kKeyTypePoint, "Type des &points connus :"},
    {kKeyTypeCode, "Type des &codes :"},
    {kKeyTypeCommentaire, "Type des comm&entaires :"},
    {kKeyChampsStation, "C&hamps des stations :"},
    {kKeyChampsVisee, "Champs des &visées :"},
    {kKeyChampsPoint, "Champs des p&oints :"},
};

// The words of the keys, as the lists show them.
constexpr Named kWordLabels[] = {
    {"grades", "grades"},
    {"degres", "degrés décimaux"},
    {"dms", "degrés, minutes, secondes (DDD.MMSS)"},
    {"mils", "millièmes"},
    {"metres", "mètres"},
    {"pieds", "pieds"},
    {"XY", "X (Est) puis Y (Nord)"},
    {"YX", "Y (Nord) puis X (Est)"},
    {"aucune", "aucune : toutes les visées sont mesurées"},
    {"premiere", "la première visée après chaque station"},
    {"codes", "les visées qui portent un code de référence"},
    {"auto", "l'une ou l'autre écriture"},
    {"84", "mots 84, 85, 86 de la station"},
    {"41", "bloc de code 41 (station en 42, hauteur en 43)"},
    {".", "point (.)"},
    {",", "virgule (,)"},
};

const char* LabelOf(std::span<const Named> table, std::string_view name) {
    for (const Named& named : table)
        if (name == named.name) return named.label;
    return nullptr;
}

bool IsSwitch(const CParamDriver::Key& key) {
    return key.words.size() == 2 && std::string_view(key.words[0]) == "0" &&
           std::string_view(key.words[1]) == "1";
}

int WordIndex(const CParamDriver::Key& key, const std::string& value) {
    for (std::size_t i = 0; i < key.words.size(); ++i)
        if (EqualIgnoringCase(key.words[i], value)) return static_cast<int>(i);
    return -1;
}

} // namespace

// ---- The dialog ------------------------------------------------------------------------------------------

CDlgParamDriver::CDlgParamDriver(const CParamDriver& driver, std::string installDir, std::string formatName)
    : m_values(driver), m_installDir(std::move(installDir)), m_formatName(std::move(formatName)) {}

std::string CDlgParamDriver::Caption() const {
    return std::string(kCaption) + ' ' + m_formatName;
}

std::string CDlgParamDriver::InstalledFile() const {
    const char* shipped = FormatInfo(m_values.Format()).parameterFile;
    return shipped ? InstallationConfigFile(m_installDir, shipped) : std::string();
}

void CDlgParamDriver::Read() {
    std::string source = m_values.FileName();
    if (!FileExists(source)) source = InstalledFile();
    for (const CParamDriver::Key& key : m_values.Keys()) {
        std::string value = key.defaultValue;
        if (!source.empty() && FileExists(source))
            ReadParamString(source, kSectionParametrage, key.name, key.defaultValue, value);
        m_values.SetText(key.name, std::string(Trimmed(value)));
    }
}

std::string CDlgParamDriver::OnOK(ui::FrontEnd& frontEnd) {
    std::string why = m_values.Validate();
    if (why.empty()) {
        const std::string& file = m_values.FileName();
        const std::string installed = InstalledFile();
        if (!FileExists(file) && !installed.empty() && FileExists(installed) &&
            CopyFileContents(installed, file) != 0)
            why = Sprintf(fb::kMsgCannotWriteFile, file.c_str());
        else if (!m_values.Save())
            return Sprintf(fb::kMsgCannotWriteFile, file.c_str()); // the store has said why
    }
    if (!why.empty()) frontEnd.MessageBox(why, ui::kCaption, ui::kIconWarning);
    return why;
}

ui::DialogResult CDlgParamDriver::Run(ui::FrontEnd& frontEnd) {
    m_values.Edit(frontEnd);
    return ui::DialogResult::Ok;
}

std::unique_ptr<ui::Form> CDlgParamDriver::MakeForm() {
    return std::make_unique<CParamDriverForm>(*this);
}

// ---- Its window ------------------------------------------------------------------------------------------

CParamDriverForm::CParamDriverForm(CDlgParamDriver& dialog) : m_dialog(dialog) {}

std::vector<ui::Control> CParamDriverForm::Controls() const {
    using ui::ControlKind;
    std::vector<ui::Control> controls;
    const auto add = [&controls](int id, ControlKind kind, std::string name, std::string text, int row,
                                 int column, int span = 1) -> ui::Control& {
        ui::Control control;
        control.id = id;
        control.kind = kind;
        control.name = std::move(name);
        control.text = std::move(text);
        control.row = row;
        control.column = column;
        control.columnSpan = span;
        controls.push_back(std::move(control));
        return controls.back();
    };
    add(kFileLabel, ControlKind::Label, "fichierLabel", "Fichier :", 0, 0).buddy = kFile;
    add(kFile, ControlKind::Field, "fichier", "", 0, 1).width = 50;
    add(kShowFile, ControlKind::Button, "voirFichier", "Voir le &fichier", 1, 1);
    const auto keys = m_dialog.Values().Keys();
    for (std::size_t i = 0; i < keys.size(); ++i) {
        const CParamDriver::Key& key = keys[i];
        const int id = kFirstKey + 2 * static_cast<int>(i);
        const int row = 2 + static_cast<int>(i);
        const char* label = LabelOf(kKeyLabels, key.name);
        const std::string text = label ? label : std::string(key.name) + " :";
        if (IsSwitch(key)) {
            add(id + 1, ControlKind::Check, key.name, text, row, 0, 2);
            continue;
        }
        add(id, ControlKind::Label, std::string(key.name) + "Label", text, row, 0).buddy = id + 1;
        ui::Control& field =
            add(id + 1, key.words.empty() ? ControlKind::Edit : ControlKind::Combo, key.name, "", row, 1);
        if (key.words.empty()) field.width = key.maximum >= 0 ? 6 : 40;
    }
    ui::Control& ok = add(ui::kIdOk, ControlKind::Button, "ok", "OK", 0, 0);
    ok.parent = ui::kButtonRow;
    ok.isDefault = true;
    add(ui::kIdCancel, ControlKind::Button, "annuler", "Annuler", 0, 1).parent = ui::kButtonRow;
    return controls;
}

bool CParamDriverForm::Open(ui::FrontEnd&) {
    m_dialog.Read();
    return true;
}

int CParamDriverForm::ControlOf(std::string_view name) const {
    const auto keys = m_dialog.Values().Keys();
    for (std::size_t i = 0; i < keys.size(); ++i)
        if (name == keys[i].name) return kFirstKey + 2 * static_cast<int>(i) + 1;
    return 0;
}

const CParamDriver::Key* CParamDriverForm::KeyOf(int id) const {
    const auto keys = m_dialog.Values().Keys();
    const int index = (id - kFirstKey - 1) / 2;
    if (id < kFirstKey || (id - kFirstKey) % 2 != 1 || index >= static_cast<int>(keys.size())) return nullptr;
    return &keys[static_cast<std::size_t>(index)];
}

ui::ControlState CParamDriverForm::State(int id) const {
    ui::ControlState state;
    const std::string& file = m_dialog.Values().FileName();
    if (id == kFile) state.text = file;
    if (id == kShowFile) state.enabled = FileExists(file);
    const CParamDriver::Key* key = KeyOf(id);
    if (!key) return state;
    const std::string& value = m_dialog.Values().Text(key->name);
    if (IsSwitch(*key)) {
        state.checked = value == "1";
    } else if (key->words.empty()) {
        state.text = value;
    } else {
        for (const char* word : key->words) {
            const char* label = LabelOf(kWordLabels, word);
            state.items.emplace_back(label ? label : word);
        }
        state.current = WordIndex(*key, value);
    }
    return state;
}

void CParamDriverForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    if (const CParamDriver::Key* key = KeyOf(id)) {
        if (event.kind == ui::EventKind::Check && IsSwitch(*key))
            m_dialog.Set(key->name, event.on ? "1" : "0");
        else if (event.kind == ui::EventKind::Text)
            m_dialog.Set(key->name, std::string(Trimmed(event.text)));
        else if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
                 event.rank < static_cast<int>(key->words.size()))
            m_dialog.Set(key->name, key->words[static_cast<std::size_t>(event.rank)]);
        return;
    }
    switch (id) {
    case kShowFile:
        if (FileExists(m_dialog.Values().FileName())) frontEnd.ShowFile(m_dialog.Values().FileName());
        break;
    case ui::kIdOk:
        if (m_dialog.OnOK(frontEnd).empty()) End(ui::DialogResult::Ok);
        break;
    case ui::kIdCancel:
        End(ui::DialogResult::Cancel);
        break;
    default:
        break;
    }
}

} // namespace pyr

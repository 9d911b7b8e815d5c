#include "settings/OptionPSheetForm.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "settings/ListingObject.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <array>

namespace pyr {

namespace {

using ui::Control;
using ui::ControlKind;

// The pages' titles, in the order of the sheet.
constexpr std::array<const char*, 8> kPageTitles = {"Appareils",   "Calculs",         "Corrections",
                                                    "Éditeur",     "Base de données", "Listings",
                                                    "Nivellement", "Tolérances"};
constexpr int kInstrumentsPage = 0;
constexpr int kListingsPage = 5;

enum class Widget { Check, Edit, Bits, Choice };

// A key of a page as its control shows it. A set of switches kept as bits has as many lines as bits; a
// kind among a few, one line for each value from 0.
struct KeyField {
    int page;
    const char* section;
    const char* key;
    Widget widget;
    const char* label;
    std::vector<std::string> lines = {};
    const char* group = nullptr; // a frame around the fields that follow with the same title
};

// "Interrupteur 1 (valeur 1)", ...: the switches of a set whose meaning the computations that read it
// give.
std::vector<std::string> BitLines(int bits) {
    std::vector<std::string> lines;
    for (int bit = 0; bit < bits; ++bit)
        lines.push_back(Sprintf("Interrupteur %d (valeur %d)", bit + 1, 1 << bit));
    return lines;
}

std::vector<std::string> KindLines(int kinds) {
    std::vector<std::string> lines;
    for (int kind = 0; kind < kinds; ++kind)
        lines.push_back(Sprintf("Type %d", kind));
    return lines;
}

const std::vector<KeyField>& KeyFields() {
    using enum Widget;
    static const std::vector<KeyField> fields{
        {1, kSectionCalculations, "General", Bits, "Options &générales :", BitLines(3)},
        {1,
         kSectionCalculations,
         "Cheminements",
         Bits,
         "Options des &cheminements :",
         {"Fermeture planimétrique répartie sur les écarts de coordonnées (1)",
          "Fermeture angulaire non compensée (2)", "Fermeture planimétrique non compensée (4)",
          "Fermeture altimétrique non compensée (8)", "V0 des stations non écrits (16)",
          "Points rayonnés depuis les stations calculées (32)", "Interrupteur 7 (valeur 64)"}},
        {1, kSectionCalculations, "RayonHp0Check", Check,
         "Rayonnement : remplacer une hauteur de voyant &nulle"},
        {1, kSectionCalculations, "ValeurDeHp0", Edit, "&Hauteur de voyant qui la remplace (m) :"},
        {1, kSectionCalculations, "RayonV0Calcule", Check, "Rayonnement avec le &V0 calculé"},
        {1, kSectionCalculations, "TrianguPtsRayon", Check,
         "La &triangulation utilise aussi les points rayonnés"},
        {1, kSectionCalculations, "IntersAvecHp", Check,
         "L'&intersection tient compte des hauteurs de voyant"},
        {1, kSectionCalculations, "ExcentVertDansAngles", Check,
         "&Excentrement vertical dans l'angle zénithal et la distance"},
        {1, kSectionCalculations, "AppareilParDefaut", Edit, "N° de l'&appareil par défaut :"},

        {2, kSectionCorrections, "AlterLineaire", Edit, "Altération l&inéaire (mm/km) :"},
        {2, kSectionCorrections, "CorrNivZero", Edit, "Réduction au &niveau zéro (mm/km) :"},
        {2, kSectionCorrections, "Projection", Edit, "&Projection :"},
        {2, kSectionCorrections, "CorrAuto", Check, "Corrections calculées &automatiquement"},
        {2, kSectionCorrections, "AbsiMoyenne", Edit, "A&bscisse moyenne du chantier (m) :"},
        {2, kSectionCorrections, "OrdoMoyenne", Edit, "&Ordonnée moyenne du chantier (m) :"},
        {2, kSectionCorrections, "AltiMoyenne", Edit, "Altitude &moyenne du chantier (m) :"},
        {2, kSectionCorrections, "RayonTerre", Edit, "&Rayon terrestre (km) :"},

        {3, kSectionEditor, "General", Bits, "Options &générales de l'éditeur :", BitLines(3)},
        {3, kSectionEditor, "NombreDecimaleXY", Edit, "Décimales des &coordonnées et distances :"},
        {3, kSectionEditor, "NombreDecimaleZ", Edit, "Décimales des &altitudes :"},
        {3, kSectionEditor, "NombreDecimaleAng", Edit, "Décimales des a&ngles :"},
        {3, kSectionEditor, "Reductions", Check, "&Réductions"},
        {3, kSectionEditor, "PointsDoubles", Check, "Rechercher les points &doubles"},
        {3, kSectionEditor, "TolerancePointDouble", Edit, "&Tolérance des points doubles (m) :"},
        {3, kSectionEditor, "CodePointDouble", Edit, "Code donné aux &points doubles :"},

        {4, kSectionDatabase, "NomBaseDonnées", Edit, "&Base de données :"},
        {4, kSectionDatabase, "NomTableDonnées", Edit, "&Table :"},
        {4, kSectionDatabase, "Tolérance", Edit, "T&olérance :"},
        {4, kSectionDatabase, "Distance3D", Check, "Distances en &3D"},
        {4, kSectionDatabase, "ConfirmerImport", Check, "Confirmer les &importations"},
        {4, kSectionDatabase, "ConfirmerExport", Check, "Confirmer les &exportations"},
        {4, kSectionDatabase, "RendrePtsInvariants", Check, "Rendre les points i&nvariants"},
        {4, kSectionDatabase, "AltitudeImportation", Check, "Importer les &altitudes"},
        {4, kSectionDatabase, "AltitudeExportation", Check, "Exporter les a&ltitudes"},
        {4, kSectionDatabase, "Ident_Mat", Edit, "Colonne des &matricules :"},
        {4, kSectionDatabase, "Ident_X", Edit, "Colonne des &X :"},
        {4, kSectionDatabase, "Ident_Y", Edit, "Colonne des &Y :"},
        {4, kSectionDatabase, "Ident_Z", Edit, "Colonne des &Z :"},

        {5, kSectionListings, "ChoixNomListing", Check, "&Choisir le nom du fichier listing"},
        {5, kSectionListings, "ProduireJournal", Check, "Tenir le &journal des calculs"},
        {5, kSectionListings, "EcrireTolérances", Check, "Écrire les &tolérances et les options en tête"},
        {5, kSectionListings, "AffichePtsAppro", Check, "Afficher les points &approchés"},
        {5, kSectionListings, "AfficherListing", Check, "Afficher chaque &listing une fois créé"},
        {5, kSectionListings, "CreationAnnulation", Check, "Création / a&nnulation"},
        {5, kSectionListings, "Inverser_XY", Check, "&Inverser X et Y"},
        {5, kSectionListings, "ControleV0Rayonne", Check, "Contrôler le &V0 des points rayonnés"},
        {5, kSectionListings, "RayonContenu", Edit, "C&olonnes des points rayonnés :"},
        {5,
         kSectionListingLayout,
         kKeyListingFormat,
         Choice,
         "&Format :",
         {"Texte enrichi (RTF)", "Texte en pages numérotées", "Texte d'un seul tenant, sans pages"},
         "Mise en page des listings"},
        {5,
         kSectionListingLayout,
         kKeyPageLength,
         Edit,
         "Longueur de &page (lignes) :",
         {},
         "Mise en page des listings"},
        {5,
         kSectionListingLayout,
         kKeyPageWidth,
         Edit,
         "La&rgeur de page (caractères) :",
         {},
         "Mise en page des listings"},

        {6,
         kSectionLevelling,
         "TypeTolerance",
         Choice,
         "Type de &tolérance :",
         {"Fixe", "Par racine du kilomètre", "Par racine du nombre de dénivelées"}},
        {6,
         kSectionLevelling,
         "TypeNivel",
         Choice,
         "Type de &nivellement :",
         {"Ordinaire (compensation aux portées)", "De chantier (compensation par dénivelée)",
          "En pente (compensation aux dénivelées)"}},
        {6, kSectionLevelling, "FermAltimetr", Edit, "&Fermeture altimétrique (m) :"},

        {7,
         kSectionTolerances,
         "TypeTolerance",
         Choice,
         "Type de &tolérance :",
         {"Normales", "De précision", "Personnalisées"}},
        {7, kSectionTolerances, "TypeCanevas", Choice, "Type de &canevas :", KindLines(4)},
        {7, kSectionTolerances, "TolAngles", Edit, "Tolérance sur les &angles (gr) :"},
        {7, kSectionTolerances, "TolDistances", Edit, "Tolérance sur les &distances (m) :"},
        {7, kSectionTolerances, "TolAltitudes", Edit, "Tolérance sur les a&ltitudes (m) :"},
        {7, kSectionTolerances, "FermAngulaire", Edit, "Fermeture an&gulaire (gr) :"},
        {7, kSectionTolerances, "FermPlanimetr", Edit, "Fermeture &planimétrique (m) :"},
        {7, kSectionTolerances, "FermAltimetr", Edit, "Fermeture alti&métrique (m) :"},
    };
    return fields;
}

// The values of an instrument, in the order of InstrumentValueKeys().
constexpr std::array<const char*, 6> kInstrumentValueLabels = {
    "&Constante de prisme (m) :",
    "C&ollimation verticale (gr) :",
    "Précision des directions &horizontales (gr) :",
    "Précision des angles &zénithaux (gr) :",
    "Précision des &distances, partie constante (m) :",
    "Précision des distances, partie &proportionnelle (ppm) :",
};
constexpr int kNumberWidth = 12;
constexpr int kTextWidth = 30;

// The page ids follow the controls of the instruments page and the columns.
constexpr int PageId(int rank) {
    return COptionPSheetForm::kAddExtraColumn + 1 + rank;
}

} // namespace

COptionPSheetForm::COptionPSheetForm(COptionPSheet& sheet) : m_sheet(sheet) {
    Build();
}

int COptionPSheetForm::InstrumentValueEdit(std::string_view prefix) {
    const auto keys = InstrumentValueKeys();
    for (std::size_t i = 0; i < keys.size(); ++i)
        if (EqualIgnoringCase(keys[i].prefix, prefix)) return kInstrumentValues + 2 * static_cast<int>(i) + 1;
    return 0;
}

void COptionPSheetForm::Build() {
    for (int rank = 0; rank < static_cast<int>(kPageTitles.size()); ++rank)
        m_controls.push_back(
            ui::Ctl(PageId(rank), ControlKind::Page, Sprintf("page%d", rank), kPageTitles[rank]));

    // Instruments: the list, its two buttons, then the instrument highlighted.
    const int instruments = PageId(kInstrumentsPage);
    Control label = ui::Ctl(kInstrumentsLabel, ControlKind::Label, "appareilsLabel", "&Appareils :")
                        .In(instruments)
                        .At(0, 0, 1, 2);
    label.buddy = kInstruments;
    m_controls.push_back(label);
    Control list = ui::Ctl(kInstruments, ControlKind::List, "appareils").In(instruments).At(1, 0, 1, 2);
    list.columns = {"N°",        "Nom",       "Prisme (m)", "Coll. V (gr)",
                    "σ AH (gr)", "σ AV (gr)", "σ DI (m)",   "σ DI (ppm)"};
    list.width = 125;
    list.lines = 6;
    m_controls.push_back(list);
    m_controls.push_back(
        ui::Ctl(kAddInstrument, ControlKind::Button, "ajouterAppareil", "A&jouter").In(instruments).At(2, 0));
    m_controls.push_back(ui::Ctl(kRemoveInstrument, ControlKind::Button, "supprimerAppareil", "&Supprimer")
                             .In(instruments)
                             .At(2, 1));
    label = ui::Ctl(kInstrumentNameLabel, ControlKind::Label, "nomAppareilLabel", "&Nom :")
                .In(instruments)
                .At(3, 0);
    label.buddy = kInstrumentName;
    m_controls.push_back(label);
    Control edit = ui::Ctl(kInstrumentName, ControlKind::Edit, "nomAppareil").In(instruments).At(3, 1);
    edit.width = kTextWidth;
    m_controls.push_back(edit);
    const auto valueKeys = InstrumentValueKeys();
    for (std::size_t i = 0; i < valueKeys.size(); ++i) {
        const int id = kInstrumentValues + 2 * static_cast<int>(i);
        const int row = 4 + static_cast<int>(i);
        label = ui::Ctl(id, ControlKind::Label, std::string(valueKeys[i].prefix) + "Label",
                        kInstrumentValueLabels[i])
                    .In(instruments)
                    .At(row, 0);
        label.buddy = id + 1;
        m_controls.push_back(label);
        edit = ui::Ctl(id + 1, ControlKind::Edit, valueKeys[i].prefix).In(instruments).At(row, 1);
        edit.width = kNumberWidth;
        m_controls.push_back(edit);
    }

    // The keys of the other pages, each page's grid filled row by row, a group's in its frame.
    std::array<int, kPageTitles.size()> rows{};
    int id = kFirstKeyControl;
    int group = 0, groupRow = 0;
    const char* groupTitle = nullptr;
    for (const KeyField& field : KeyFields()) {
        int parent = PageId(field.page);
        int* row = &rows[static_cast<std::size_t>(field.page)];
        if (field.group) {
            if (!groupTitle || std::string_view(groupTitle) != field.group) {
                group = id++;
                groupRow = 0;
                groupTitle = field.group;
                m_controls.push_back(
                    ui::Ctl(group, ControlKind::Group, Sprintf("groupe%d", group), field.group)
                        .In(parent)
                        .At((*row)++, 0, 1, 2));
            }
            parent = group;
            row = &groupRow;
        } else {
            groupTitle = nullptr;
        }
        const std::string name = std::string(field.section) + "/" + field.key;
        KeyControl key{0, field.page, field.key, Shows::Value, field.lines};
        if (field.widget == Widget::Check) {
            key.id = id++;
            key.shows = Shows::Switch;
            m_controls.push_back(
                ui::Ctl(key.id, ControlKind::Check, name, field.label).In(parent).At((*row)++, 0, 1, 2));
        } else {
            label = ui::Ctl(id++, ControlKind::Label, name + "/label", field.label).In(parent).At(*row, 0);
            key.id = id++;
            label.buddy = key.id;
            m_controls.push_back(label);
            Control control;
            switch (field.widget) {
            case Widget::Bits:
                key.shows = Shows::Bits;
                control = ui::Ctl(key.id, ControlKind::CheckList, name).In(parent).At(*row, 1);
                control.lines = static_cast<int>(field.lines.size());
                break;
            case Widget::Choice:
                key.shows = Shows::Choice;
                control = ui::Ctl(key.id, ControlKind::Combo, name).In(parent).At(*row, 1);
                break;
            default:
                control = ui::Ctl(key.id, ControlKind::Edit, name).In(parent).At(*row, 1);
                control.width = FindOption(field.section, field.key)->type == OptionType::Text ? kTextWidth
                                                                                               : kNumberWidth;
                break;
            }
            m_controls.push_back(control);
            ++*row;
        }
        m_keys.push_back(std::move(key));

        // The columns of the radiated points are completed from those offered.
        if (field.page == kListingsPage && std::string_view(field.key) == "RayonContenu") {
            const int page = PageId(kListingsPage);
            label =
                ui::Ctl(kExtraColumnLabel, ControlKind::Label, "colonneLabel", "Colonne &supplémentaire :")
                    .In(page)
                    .At(*row, 0);
            label.buddy = kExtraColumn;
            m_controls.push_back(label);
            m_controls.push_back(ui::Ctl(kExtraColumn, ControlKind::Combo, "colonne").In(page).At(*row, 1));
            m_controls.push_back(
                ui::Ctl(kAddExtraColumn, ControlKind::Button, "ajouterColonne", "Ajo&uter la colonne")
                    .In(page)
                    .At(++*row, 1));
            ++*row;
        }
    }

    Control ok = ui::Ctl(ui::kIdOk, ControlKind::Button, "ok", "OK").In(ui::kButtonRow);
    ok.isDefault = true;
    m_controls.push_back(ok);
    m_controls.push_back(
        ui::Ctl(ui::kIdCancel, ControlKind::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1));
}

bool COptionPSheetForm::Open(ui::FrontEnd&) {
    m_sheet.Pages(); // read from the parameter file, once
    m_instrument = 0;
    return true;
}

int COptionPSheetForm::ControlOf(std::string_view section, std::string_view key) const {
    const auto& fields = KeyFields();
    for (std::size_t i = 0; i < fields.size(); ++i)
        if (EqualIgnoringCase(fields[i].section, section) && EqualIgnoringCase(fields[i].key, key))
            return m_keys[i].id;
    return 0;
}

const COptionPSheetForm::KeyControl* COptionPSheetForm::Find(int id) const {
    if (id < kFirstKeyControl) return nullptr;
    auto found =
        std::find_if(m_keys.begin(), m_keys.end(), [id](const KeyControl& key) { return key.id == id; });
    return found == m_keys.end() ? nullptr : &*found;
}

COptionPage& COptionPSheetForm::PageOf(const KeyControl& control) const {
    return *m_sheet.Pages()[static_cast<std::size_t>(control.page)];
}

std::string COptionPSheetForm::EditText(const COptionPage& page, std::string_view key) {
    const OptionEntry* entry = FindOption(page.SectionOf(key), key);
    if (!entry) return {};
    switch (entry->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return Sprintf("%d", page.Int(key));
    case OptionType::Real:
        return FormatShortest(page.Real(key));
    case OptionType::Text:
        return page.Text(key);
    }
    return {};
}

int COptionPSheetForm::Instrument() const {
    const int count = static_cast<int>(m_sheet.Appareil().Instruments().size());
    return std::clamp(m_instrument, 0, count - 1);
}

ui::ControlState COptionPSheetForm::State(int id) const {
    ui::ControlState state;
    if (const KeyControl* key = Find(id)) {
        const COptionPage& page = PageOf(*key);
        const int value = page.Int(key->key);
        switch (key->shows) {
        case Shows::Switch:
            state.checked = value != 0;
            break;
        case Shows::Value:
            state.text = EditText(page, key->key);
            break;
        case Shows::Bits:
            state.items = key->items;
            for (std::size_t bit = 0; bit < key->items.size(); ++bit)
                state.checks.push_back(((value >> bit) & 1) != 0);
            break;
        case Shows::Choice:
            state.items = key->items;
            state.current = value;
            break;
        }
        return state;
    }

    const std::vector<InstrumentOptions>& instruments = m_sheet.Appareil().Instruments();
    const InstrumentOptions& chosen = instruments[static_cast<std::size_t>(Instrument())];
    const auto valueKeys = InstrumentValueKeys();
    switch (id) {
    case kInstruments:
        for (std::size_t i = 0; i < instruments.size(); ++i) {
            std::string line = Sprintf("%zu\t%s", i, instruments[i].name.c_str());
            for (const auto& key : valueKeys)
                line += "\t" + FormatShortest(instruments[i].*key.member);
            state.items.push_back(std::move(line));
        }
        state.current = Instrument();
        break;
    case kRemoveInstrument:
        state.enabled = Instrument() > 0; // the standard instrument stays
        break;
    case kInstrumentName:
        state.text = chosen.name;
        state.enabled = Instrument() > 0;
        break;
    case kExtraColumn:
        state.items.assign(CPagOptionListing::kExtraColumns.begin(), CPagOptionListing::kExtraColumns.end());
        state.current = m_extraColumn;
        break;
    default:
        if (id > kInstrumentValues && id < kInstrumentValues + 2 * static_cast<int>(valueKeys.size()) &&
            (id - kInstrumentValues) % 2 == 1)
            state.text = FormatShortest(
                chosen.*valueKeys[static_cast<std::size_t>(id - kInstrumentValues) / 2].member);
        break;
    }
    return state;
}

void COptionPSheetForm::SetTyped(ui::FrontEnd& frontEnd, COptionPage& page, const std::string& key,
                                 const std::string& text, int id) {
    const std::string refusal = page.Set(key, text);
    if (refusal.empty()) return;
    frontEnd.MessageBox(refusal, ui::kCaption, ui::kIconWarning);
    Focus(id);
}

void COptionPSheetForm::ActOnKey(ui::FrontEnd& frontEnd, const KeyControl& control, const ui::Event& event) {
    COptionPage& page = PageOf(control);
    const int value = page.Int(control.key);
    switch (control.shows) {
    case Shows::Switch:
        if (event.kind == ui::EventKind::Check) page.SetSwitch(control.key, event.on);
        break;
    case Shows::Value:
        if (event.kind == ui::EventKind::Text)
            SetTyped(frontEnd, page, std::string(control.key), event.text, control.id);
        break;
    case Shows::Bits:
        if (event.kind == ui::EventKind::CheckLine && event.rank >= 0 &&
            event.rank < static_cast<int>(control.items.size()))
            page.SetInt(control.key, event.on ? (value | (1 << event.rank)) : (value & ~(1 << event.rank)));
        break;
    case Shows::Choice:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(control.items.size()))
            page.SetInt(control.key, event.rank);
        break;
    }
}

void COptionPSheetForm::ActOnInstruments(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    CPagOptionAppareil& page = m_sheet.Appareil();
    const int chosen = Instrument();
    const auto valueKeys = InstrumentValueKeys();
    switch (id) {
    case kInstruments:
        if (event.kind == ui::EventKind::Select && event.rank >= 0) m_instrument = event.rank;
        break;
    case kAddInstrument: {
        // A new instrument, with null constants, named after its number until the person names it.
        const int count = static_cast<int>(page.Instruments().size());
        m_instrument = page.AddInstrument(Sprintf("Appareil n°%d", count));
        Focus(kInstrumentName);
        break;
    }
    case kRemoveInstrument:
        if (page.RemoveInstrument(chosen)) m_instrument = chosen - 1;
        break;
    case kInstrumentName:
        if (event.kind == ui::EventKind::Text)
            SetTyped(frontEnd, page, Sprintf("%s%d", kInstrumentNameKey, chosen), event.text, id);
        break;
    default:
        if (event.kind == ui::EventKind::Text && id > kInstrumentValues &&
            id < kInstrumentValues + 2 * static_cast<int>(valueKeys.size()))
            SetTyped(frontEnd, page,
                     Sprintf("%s%d", valueKeys[static_cast<std::size_t>(id - kInstrumentValues) / 2].prefix,
                             chosen),
                     event.text, id);
        break;
    }
}

void COptionPSheetForm::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    if (const KeyControl* key = Find(id)) {
        ActOnKey(frontEnd, *key, event);
        return;
    }
    switch (id) {
    case ui::kIdOk:
        End(m_sheet.OnOK() ? ui::DialogResult::Ok : ui::DialogResult::Failed); // the store said what failed
        break;
    case ui::kIdCancel:
        m_sheet.OnCancel();
        End(ui::DialogResult::Cancel);
        break;
    case kExtraColumn:
        if (event.kind == ui::EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(CPagOptionListing::kExtraColumns.size()))
            m_extraColumn = event.rank;
        break;
    case kAddExtraColumn:
        m_sheet.Listing().AddRadiatedColumn(
            CPagOptionListing::kExtraColumns[static_cast<std::size_t>(m_extraColumn)]);
        break;
    default:
        ActOnInstruments(frontEnd, id, event);
        break;
    }
}

std::unique_ptr<ui::Form> COptionPSheet::MakeForm() {
    return std::make_unique<COptionPSheetForm>(*this);
}

} // namespace pyr

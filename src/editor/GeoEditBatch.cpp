// The editor as a command: its options, and the run of the actions they ask for on the GéoBase named.
#include "calc/ChangeRepTexts.h"
#include "core/Files.h"
#include "core/Strings.h"
#include "editor/GeoEditor.h"
#include "fieldbook/ExportTexts.h"
#include "fieldbook/FieldBookTexts.h"
#include "geobase/GeoBaseMessages.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <charconv>

namespace pyr {

namespace {

constexpr const char* kOpened = "GéoBase <%s> : %d élément(s).";
constexpr const char* kGeoBaseHelp = "la GéoBase à éditer (au lieu de la dernière utilisée)";
constexpr const char* kReductionOption = "reduction";
constexpr const char* kReductionHelp =
    "réduit les stations (réduction des reprises) avant de montrer la GéoBase";
constexpr const char* kChangeFrameOption = "changement-repere";
constexpr const char* kReadingOption = "lecture";
constexpr const char* kReadingHelp = "lit un carnet de ce format, l'ajoute à la GéoBase et l'enregistre";
constexpr const char* kExportOption = "exportation";

constexpr const char* kRenameHelp =
    "renomme la station ANCIEN en NOUVEAU, avec toutes ses reprises et tout ce qui porte son nom";
constexpr const char* kRenameForm = "--renommer : « %s » n'est pas de la forme ANCIEN=NOUVEAU.";
constexpr const char* kRenumberHelp =
    "renumérote les points de la sélection (--selection ; tous sans elle) : --decalage, --prefixe, "
    "--debut, --chiffres";
constexpr const char* kOffsetHelp = "ajoute N au numéro de chaque point (négatif : le retire)";
constexpr const char* kPrefixHelp = "donne ce préfixe aux points renumérotés";
constexpr const char* kStartHelp = "numérote les points à la suite à partir de N, dans l'ordre de la GéoBase";
constexpr const char* kDigitsHelp = "écrit chaque numéro avec au moins N chiffres";
constexpr const char* kNotAWholeNumber = "--%s : « %s » n'est pas un nombre entier.";
constexpr const char* kRemoveHelp =
    "supprime les points (lignes de coordonnées) de la sélection ; les visées sur eux sont gardées";
constexpr const char* kSearchHelp =
    "montre les éléments des matricules de la sélection (tous sans elle) qui répondent à --code, "
    "--genre et --valeur";
constexpr const char* kCodeHelp = "le code cherché (vide : les éléments sans code)";
constexpr const char* kKindHelp = "le genre d'élément cherché, par son nom ou son numéro (Station, 1001...)";
constexpr const char* kUnknownKind = "--genre : « %s » n'est pas un genre d'élément.";
constexpr const char* kValueHelp = "la valeur cherchée : CHAMP=NOMBRE, CHAMP<NOMBRE ou CHAMP>NOMBRE (z>100)";
constexpr const char* kValueForm =
    "--valeur : « %s » n'est pas de la forme CHAMP=NOMBRE, CHAMP<NOMBRE ou CHAMP>NOMBRE.";
constexpr const char* kFound = "%d élément(s) trouvé(s).";
constexpr const char* kDuplicatesHelp =
    "cherche les points doubles (tolérance et code des options de l'éditeur) ; le listing va dans LISTING";
constexpr const char* kProjectionHelp =
    "convertit les points de la projection du chantier (options, corrections) dans la projection NOM";
constexpr const char* kProjectionFromHelp = "la projection de départ, au lieu de celle des options";

bool ParseWhole(std::string_view text, long long& value) {
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value);
    return error == std::errc() && stop == end && !text.empty();
}

// "Station", "station" or "1001".
std::optional<int> KindNamed(std::string_view text) {
    long long code = 0;
    if (ParseWhole(text, code))
        return IsKnownKind(static_cast<int>(code)) ? std::optional<int>(code) : std::nullopt;
    for (int kind = kKindComment; kind <= kKindExcentrement; ++kind)
        if (EqualIgnoringCase(KindLabel(kind), text)) return kind;
    return std::nullopt;
}

} // namespace

void CGeoEditor::DeclareOptions(ui::DialogOptions& options) {
    BatchEdits& batch = m_batch;
    options.Positional("GEOBASE", kGeoBaseHelp, [this](const std::string& path) {
        SetGeoBase(path);
        return std::string();
    });
    options.Switch(kReductionOption, kReductionHelp, [this] {
        m_reduce = true;
        return std::string();
    });
    m_reduction.DeclareOptions(options);
    options.Switch(kChangeFrameOption, rep::kHelpAction, [this] {
        m_changeFrame = true;
        return std::string();
    });
    m_frameChange.DeclareOptions(options);
    options.Values(
        kReadingOption, {"FORMAT", "CARNET"}, kReadingHelp, [this](const std::vector<std::string>& values) {
            const std::optional<FieldBookFormat> format = FindFieldBookFormat(values.at(0));
            if (!format)
                return Sprintf(fb::kMsgUnknownFormat, values.at(0).c_str(), FieldBookFormatNames().c_str());
            m_reading = Reading{*format, values.at(1)};
            return std::string();
        });
    DeclareReadingOptions(options, m_readingRequests, true, false);
    options.Switch(kExportOption, exp::kHelpExport, [this] {
        m_export = true;
        return std::string();
    });
    DeclareExportOptions(options, m_exportRequests, false, true);

    options.Value(
        "renommer", "ANCIEN=NOUVEAU", kRenameHelp,
        [&batch](const std::string& value) {
            const std::size_t equal = value.find('=');
            if (equal == std::string::npos || equal == 0) return Sprintf(kRenameForm, value.c_str());
            batch.renames.emplace_back(value.substr(0, equal), value.substr(equal + 1));
            return std::string();
        },
        true);
    options.Switch("renumeroter", kRenumberHelp, [&batch] {
        batch.renumber = true;
        return std::string();
    });
    const auto whole = [](const char* name, long long& target) {
        return [name, &target](const std::string& value) {
            return ParseWhole(value, target) ? std::string() : Sprintf(kNotAWholeNumber, name, value.c_str());
        };
    };
    options.Value("decalage", "N", kOffsetHelp, whole("decalage", batch.renumbering.offset));
    options.Value("debut", "N", kStartHelp, [&batch, whole](const std::string& value) {
        batch.renumbering.mode = RenumberRequest::Mode::Start;
        return whole("debut", batch.renumbering.start)(value);
    });
    options.Value("prefixe", "PREFIXE", kPrefixHelp, [&batch](const std::string& value) {
        batch.renumbering.newPrefix = value;
        return std::string();
    });
    options.Value("chiffres", "N", kDigitsHelp, [&batch](const std::string& value) {
        long long digits = 0;
        if (!ParseWhole(value, digits) || digits < 0 || digits > 18)
            return Sprintf(kNotAWholeNumber, "chiffres", value.c_str());
        batch.renumbering.minDigits = static_cast<int>(digits);
        return std::string();
    });
    options.Value("supprimer", "SELECTION", kRemoveHelp, [&batch](const std::string& value) {
        batch.remove = value;
        return std::string();
    });
    options.OptionalValue("chercher", "MATRICULES", kSearchHelp, [&batch](const std::string& value) {
        batch.search = SearchCriteria{};
        batch.search->identifiers = value;
        return std::string();
    });
    options.Value("code", "CODE", kCodeHelp, [&batch](const std::string& value) {
        batch.criteria.code = value;
        return std::string();
    });
    options.Value(
        "genre", "GENRE", kKindHelp,
        [&batch](const std::string& value) {
            const std::optional<int> kind = KindNamed(value);
            if (!kind) return Sprintf(kUnknownKind, value.c_str());
            batch.criteria.kinds.push_back(*kind);
            return std::string();
        },
        true);
    options.OptionalValue("points-doubles", "LISTING", kDuplicatesHelp, [&batch](const std::string& value) {
        batch.duplicates = value;
        return std::string();
    });
    options.Value("changement-projection", "NOM", kProjectionHelp, [&batch](const std::string& value) {
        batch.projection = value;
        return std::string();
    });
    options.Value("projection-depart", "NOM", kProjectionFromHelp, [&batch](const std::string& value) {
        batch.projectionFrom = value;
        return std::string();
    });
    options.Value("valeur", "CHAMP=NOMBRE", kValueHelp, [&batch](const std::string& value) {
        const std::optional<ValueCriterion> criterion = ParseValueCriterion(value);
        if (!criterion) return Sprintf(kValueForm, value.c_str());
        batch.criteria.value = criterion;
        return std::string();
    });
}

ui::DialogResult CGeoEditor::RunBatchEdits(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    BatchEdits& batch = m_batch;
    // Each edit is refused whole with its reason; the ones before it stay made, and are saved.
    bool refused = false;
    for (const auto& [from, to] : batch.renames)
        refused |= !RenameStation(frontEnd, from, to);
    if (batch.renumber && !refused) {
        RenumberRequest request = batch.renumbering;
        if (const std::optional<std::string>& selection = m_frameChange.SelectionText())
            request.selection = *selection;
        refused |= !Renumber(frontEnd, request);
    }
    if (batch.remove && !refused) refused |= !RemovePoints(frontEnd, *batch.remove);
    if (batch.duplicates && !refused) refused |= FindDuplicates(frontEnd, false, *batch.duplicates) < 0;
    if (!Document().Modified()) {
        if (batch.Edits()) txt.Print("%s", msg::kNoChange);
    } else if (!Save(frontEnd)) {
        return ui::DialogResult::Failed;
    }
    return refused ? ui::DialogResult::Failed : ui::DialogResult::Ok;
}

ui::DialogResult CGeoEditor::Run(ui::FrontEnd& frontEnd) {
    const std::optional<std::string> path = ChosenGeoBase(frontEnd);
    if (!path) return ui::DialogResult::Cancel;

    CPyrTxtWnd txt(frontEnd);
    if (m_reading && !FileExists(*path)) {
        // A new GéoBase, made by the reading, recorded once it is saved.
        auto fresh = std::make_unique<CGeoDocument>();
        fresh->Store().SetPathName(*path);
        Adopt(std::move(fresh));
    } else if (!Load(*path, frontEnd)) {
        return ui::DialogResult::Failed;
    }

    if (m_reduce && !ReduceStations(txt, frontEnd, false)) return ui::DialogResult::Failed;
    if (m_changeFrame && ChangeFrame(txt, frontEnd, false) == ui::DialogResult::Failed)
        return ui::DialogResult::Failed;
    if (m_batch.projection && !ChangeProjection(frontEnd, *m_batch.projection, m_batch.projectionFrom))
        return ui::DialogResult::Failed;
    if (m_reading) {
        const ui::DialogResult read = ReadFieldBook(*m_reading, txt, frontEnd, false);
        if (read != ui::DialogResult::Ok) return read;
    }
    ui::DialogResult result = ui::DialogResult::Ok;
    if (m_batch.Edits()) result = RunBatchEdits(txt, frontEnd);
    if (m_batch.search) {
        SearchCriteria criteria = m_batch.criteria;
        criteria.identifiers = m_batch.search->identifiers;
        if (SearchAll(frontEnd, criteria) < 0) return ui::DialogResult::Failed;
        txt.Print(kFound, static_cast<int>(Document().Selection().size()));
        for (int index : Document().Selection())
            txt.PrintText(EditorLine(Carnet(), index));
    }
    if (m_export) return ExportPoints(frontEnd, false);
    // After a reduction or a change of frame, the GéoBase is shown as it now stands; the edits say
    // what they did, the search shows what it found.
    if (m_reading || m_batch.Edits() || m_batch.search || m_batch.projection) return result;
    txt.Print(kOpened, path->c_str(), Carnet().GetSize());
    for (int i = 0; i < Carnet().GetSize(); ++i)
        txt.PrintText(EditorLine(Carnet(), i));
    return ui::DialogResult::Ok;
}

} // namespace pyr

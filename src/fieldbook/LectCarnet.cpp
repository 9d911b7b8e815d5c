#include "fieldbook/LectCarnet.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/TableCode.h"
#include "geobase/GeoFile.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <filesystem>

namespace pyr {

namespace {

constexpr const char* kHelpCarnet = "le carnet à lire (par défaut le dernier lu, à confirmer)";
constexpr const char* kHelpParamFile = "le fichier de paramétrage du format (par défaut celui de la dernière "
                                       "lecture, sinon celui livré dans Config)";
constexpr const char* kHelpInterpret =
    "interpréter les codes du carnet par la table de codes (1) ou les garder "
    "tels quels (0)";
constexpr const char* kHelpTable = "la table de codes (.cod) de l'interprétation";
constexpr const char* kHelpInstrument = "l'appareil de terrain, un appareil des options";
constexpr const char* kHelpWriteInstrument = "écrire cet appareil en tête de la GéoBase (1) ou non (0)";
constexpr const char* kHelpEditParams = "montre le fichier de paramétrage (créé s'il n'existe pas) avant la "
                                        "lecture";

std::string Assign(std::optional<std::string>& slot, const std::string& value) {
    slot = value;
    return {};
}

} // namespace

void DeclareReadingOptions(ui::DialogOptions& options, ReadingRequests& requests, bool withParamFile,
                           bool withCarnet) {
    if (withCarnet)
        options.Positional("CARNET", kHelpCarnet,
                           [&requests](const std::string& path) { return Assign(requests.carnet, path); });
    if (withParamFile)
        options.Value("parametrage", "FICHIER", kHelpParamFile,
                      [&requests](const std::string& path) { return Assign(requests.paramFile, path); });
    options.ZeroOrOne("interpretation", kHelpInterpret, [&requests](bool on) { requests.interpret = on; });
    options.Value("table", "FICHIER", kHelpTable,
                  [&requests](const std::string& path) { return Assign(requests.codeTable, path); });
    options.Value("appareil", "NOM", kHelpInstrument,
                  [&requests](const std::string& name) { return Assign(requests.instrument, name); });
    options.ZeroOrOne("ecrire-appareil", kHelpWriteInstrument,
                      [&requests](bool on) { requests.writeInstrument = on; });
    if (withParamFile)
        options.Switch("editer-parametres", kHelpEditParams, [&requests] {
            requests.editParams = true;
            return std::string();
        });
}

bool IsDefaultCodeTable(std::string_view path) {
    const std::string name = std::filesystem::path(std::string(Trimmed(path))).filename().string();
    return EqualIgnoringCase(name, kDefaultCodeTable);
}

CLectCarnet::CLectCarnet(FieldBookFormat format, const CParamFile& params, std::string installDir)
    : m_format(format), m_params(params), m_installDir(std::move(installDir)),
      m_formatName(FormatInfo(format).name), m_driver(m_installDir, std::string(), format) {}

std::string CLectCarnet::Caption() const {
    return std::string(fb::kCaption) + ' ' + m_formatName;
}

void CLectCarnet::SetCarnetFromSettings(std::string path) {
    m_carnet = std::move(path);
    m_geoBase = m_carnet.empty() ? std::string() : BesideCarnet(m_carnet, kGeoFileExtension);
}

void CLectCarnet::SetInstruments(std::vector<InstrumentOptions> instruments) {
    m_instruments = std::move(instruments);
}

std::vector<std::string> CLectCarnet::InstrumentNames() const {
    std::vector<std::string> names;
    for (const auto& instrument : m_instruments)
        names.push_back(instrument.name);
    return names;
}

int CLectCarnet::InstrumentIndex() const {
    for (std::size_t i = 0; i < m_instruments.size(); ++i)
        if (m_instruments[i].name == m_instrument) return static_cast<int>(i);
    return m_instruments.empty() ? -1 : 0;
}

// ---- Browse buttons ------------------------------------------------------------------------------------

bool CLectCarnet::BrowseCarnet(ui::FrontEnd& frontEnd) {
    auto chosen = frontEnd.ChooseFile({false, fb::kChooseCarnet, fb::kCarnetFilter, "", m_carnet});
    if (!chosen) return false;
    SetCarnetFromSettings(*chosen);
    return true;
}

bool CLectCarnet::BrowseGeoBase(ui::FrontEnd& frontEnd) {
    auto chosen =
        frontEnd.ChooseFile({true, fb::kChooseGeoBase, kGeoFileFilter, kGeoFileExtension, m_geoBase});
    if (!chosen) return false;
    m_geoBase = *chosen;
    return true;
}

bool CLectCarnet::BrowseParamFile(ui::FrontEnd& frontEnd) {
    const FieldBookFormatInfo& info = FormatInfo(m_format);
    auto chosen = frontEnd.ChooseFile(
        {false, fb::kChooseParamFile, info.paramFilter, info.paramExtension, ParamFile()});
    if (!chosen) return false;
    SetParamFile(*chosen);
    return true;
}

bool CLectCarnet::BrowseCodeTable(ui::FrontEnd& frontEnd) {
    auto chosen = frontEnd.ChooseFile(
        {false, fb::kChooseCodeTable, kCodeTableFilter, kCodeTableExtension, m_codeTable});
    if (!chosen) return false;
    m_codeTable = *chosen;
    return true;
}

bool CLectCarnet::OnEditParams(ui::FrontEnd& frontEnd) {
    if (!PrepareEditParams(frontEnd)) return false;
    m_driver.Edit(frontEnd);
    return true;
}

bool CLectCarnet::PrepareEditParams(ui::FrontEnd& frontEnd) {
    if (!FileExists(ParamFile())) {
        const std::string question = Sprintf(fb::kAskCreateParamFile, fb::kMsgParamFileMissing);
        if (frontEnd.Ask(question, ui::kCaption, ui::Buttons::YesNo, ui::Answer::Yes) != ui::Answer::Yes) {
            m_focus = Field::ParamFile;
            return false;
        }
    }
    // The delimited and columnar layouts serve the loading of points too: it finds them there.
    if (m_format == FieldBookFormat::Colonne)
        m_params.WriteString(kSectionChargementDeSemis, kKeyParametresColonne, WholePath(ParamFile()));
    else if (m_format == FieldBookFormat::Separateur)
        m_params.WriteString(kSectionChargementDeSemis, kKeyParametresSeparateur, WholePath(ParamFile()));
    return true;
}

void CLectCarnet::ShowFieldFile(ui::FrontEnd& frontEnd, Field field) {
    std::string path;
    switch (field) {
    case Field::Carnet:
        path = m_carnet;
        break;
    case Field::ParamFile:
        path = ParamFile();
        break;
    case Field::CodeTable:
        path = ResolvedCodeTable();
        break;
    default:
        return;
    }
    if (!path.empty() && FileExists(path)) frontEnd.ShowFile(path);
}

// ---- OK ------------------------------------------------------------------------------------------------

std::string CLectCarnet::ResolvedCodeTable() const {
    const std::string path(Trimmed(m_codeTable));
    if (path.empty() || FileExists(path) || std::filesystem::path(path).has_parent_path()) return path;
    // The default table is known by its name whatever its case ("DEFAUT.COD").
    const std::string installed = InstallationConfigFile(
        m_installDir, IsDefaultCodeTable(path) ? std::string(kDefaultCodeTable) : path);
    return FileExists(installed) ? installed : path;
}

ui::DialogResult CLectCarnet::Fail(ui::FrontEnd& frontEnd, const std::string& text, Field field) {
    if (!text.empty()) frontEnd.MessageBox(text, ui::kCaption, ui::kIconWarning);
    m_focus = field;
    return ui::DialogResult::Failed;
}

ui::DialogResult CLectCarnet::OnOK(ui::FrontEnd& frontEnd) {
    m_focus = Field::None;
    m_noCodeTable = false;
    if (m_carnet.empty() || !FileExists(m_carnet))
        return Fail(frontEnd, Sprintf(fb::kInParentheses, fb::kMsgCarnetMissing, m_carnet.c_str()),
                    Field::Carnet);
    if (HasParamFile() && (ParamFile().empty() || !FileExists(ParamFile())))
        return Fail(frontEnd, Sprintf(fb::kInParentheses, fb::kMsgParamFileMissing, ParamFile().c_str()),
                    Field::ParamFile);

    m_codeTable = std::string(Trimmed(m_codeTable));
    const std::string table = ResolvedCodeTable();
    if (m_interpret && (table.empty() || !FileExists(table))) {
        const std::string question =
            Sprintf(fb::kAskCodeTable, table.empty() ? fb::kNoCodeTableNamed : fb::kCodeTableMissing,
                    fb::kAskNoInterpretation);
        if (frontEnd.Ask(question, ui::kCaption, ui::Buttons::YesNo, ui::Answer::Yes) != ui::Answer::Yes) {
            m_focus = Field::CodeTable;
            return ui::DialogResult::Cancel;
        }
        m_noCodeTable = true;
    }

    if (HasParamFile() && !m_driver.Load(&frontEnd)) return Fail(frontEnd, {}, Field::CodeTable);
    // A table other than the one of the conversion must be readable; the default one is never loaded.
    if (m_interpret && !m_noCodeTable && m_table && !IsDefaultCodeTable(table) &&
        !EqualIgnoringCase(m_table->FileName(), table)) {
        CTableCode probe;
        if (!probe.Init(table))
            return Fail(frontEnd, Sprintf(fb::kMsgCodeTableUnreadable, table.c_str()), Field::CodeTable);
    }

    if (m_createNew) {
        if (m_geoBase.empty()) m_geoBase = BesideCarnet(m_carnet, kGeoFileExtension);
        if (FileExists(m_geoBase)) {
            const std::string question = Sprintf(fb::kAskReplaceGeoBase, fb::kGeoBaseExists, fb::kReplaceIt);
            if (frontEnd.Ask(question, ui::kCaption, ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes) {
                m_focus = Field::GeoBase;
                return ui::DialogResult::Cancel;
            }
        }
    }
    return ui::DialogResult::Ok;
}

ReadingChoices CLectCarnet::Choices() const {
    ReadingChoices choices;
    choices.carnet = m_carnet;
    choices.interpret = m_interpret && !m_noCodeTable;
    choices.writeInstrument = m_writeInstrument;
    const int index = InstrumentIndex();
    choices.instrumentName = index < 0 ? m_instrument : m_instruments[static_cast<std::size_t>(index)].name;
    choices.instruments = m_instruments;
    return choices;
}

// ---- Command line --------------------------------------------------------------------------------------

void CLectCarnet::DeclareOptions(ui::DialogOptions& options) {
    DeclareReadingOptions(options, m_requests, HasParamFile());
}

std::string CLectCarnet::Apply(const ReadingRequests& requests) {
    if (requests.carnet) SetCarnetFromSettings(*requests.carnet);
    if (requests.geoBase) m_geoBase = *requests.geoBase;
    if (requests.paramFile) SetParamFile(*requests.paramFile);
    if (requests.codeTable) m_codeTable = *requests.codeTable;
    if (requests.interpret) m_interpret = *requests.interpret;
    if (requests.writeInstrument) m_writeInstrument = *requests.writeInstrument;
    if (requests.instrument) {
        const auto names = InstrumentNames();
        if (std::find(names.begin(), names.end(), *requests.instrument) == names.end())
            return Sprintf(fb::kMsgUnknownInstrument, requests.instrument->c_str());
        m_instrument = *requests.instrument;
    }
    return {};
}

ui::DialogResult CLectCarnet::Run(ui::FrontEnd& frontEnd) {
    ReadingRequests requests = m_requests;
    if (GeoBaseNamed() && !requests.geoBase) requests.geoBase = GeoBase();
    if (const std::string refusal = Apply(requests); !refusal.empty()) {
        frontEnd.MessageBox(refusal, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }
    // The last field book read is offered to be confirmed or changed.
    if (!requests.carnet) {
        const std::string geoBase = m_geoBase;
        if (!BrowseCarnet(frontEnd)) return ui::DialogResult::Cancel;
        if (requests.geoBase) m_geoBase = geoBase;
    }
    if (requests.editParams && HasParamFile() && !OnEditParams(frontEnd)) return ui::DialogResult::Cancel;
    return OnOK(frontEnd);
}

} // namespace pyr

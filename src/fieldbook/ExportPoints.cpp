#include "fieldbook/ExportPoints.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigQdl.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/ExportDxf.h"
#include "fieldbook/ExportGdm.h"
#include "fieldbook/ExportLeica.h"
#include "fieldbook/ExportSokkia.h"
#include "fieldbook/ExportTexts.h"
#include "fieldbook/FieldBookFormats.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <filesystem>

namespace pyr {

namespace {

constexpr ExportFormatInfo kFormats[kExportFormatCount] = {
    {ExportFormat::GeoBase, "Fichier GéoBase PYRALIS", "geo", true, exp::kFilterGeoBase, "geo", nullptr,
     nullptr},
    {ExportFormat::Separateur, "Fichier texte avec séparateur", "txt", false, exp::kFilterPoints, "txt",
     exp::kKeyParametresSeparateur, exp::kDefaultSeparateur},
    {ExportFormat::Colonne, "Fichier texte colonné", "txt", false, exp::kFilterPoints, "txt",
     exp::kKeyParametresColonne, exp::kDefaultColonne},
    {ExportFormat::Quendal, "Fichier Quendal-Pc", "txt", false, exp::kFilterPoints, "txt", nullptr, nullptr},
    {ExportFormat::Leica, "Fichier carnet Leica", "txt", false, exp::kFilterPoints, "txt",
     exp::kKeyParametresLeica, exp::kDefaultLeica},
    // The GDM writer has its settings file, but no key keeps the one chosen: the delivered one is offered.
    {ExportFormat::Gdm, "Fichier carnet Trimble GDM", "txt", false, exp::kFilterPoints, "txt", nullptr,
     exp::kDefaultGdm},
    {ExportFormat::Sokkia, "Fichier carnet Sokkia", "sdr", true, exp::kFilterSokkia, "sdr",
     exp::kKeyParametresSokkia, exp::kDefaultSokkia},
    // A drawing's save dialog proposes "txt" as its default extension, as the other text formats do.
    {ExportFormat::Dxf, "Fichier DXF Version 12", "dxf", false, exp::kFilterDxf, "txt",
     exp::kKeyParametresDxf, exp::kDefaultDxf},
};

constexpr int kFormatDxf = static_cast<int>(ExportFormat::Dxf);

bool ReadBool(const CParamFile& params, const char* key, bool current) {
    int value = current ? 1 : 0;
    params.ReadInt(exp::kSection, key, value, 0, 1, value);
    return value != 0;
}

} // namespace

const ExportFormatInfo& ExportFormatOf(int number) {
    if (number < 0 || number >= kExportFormatCount) number = 0;
    return kFormats[number];
}

bool IsElementFormat(int number) {
    const ExportFormat format = ExportFormatOf(number).format;
    return format == ExportFormat::GeoBase || format == ExportFormat::Quendal;
}

// ---------------------------------------------------------------- the overwrite question

std::string CDlgOverWrite::Caption() const {
    return exp::kOverwriteCaption;
}

std::array<std::string, 3> CDlgOverWrite::Lines() const {
    return {exp::kOverwriteExists, m_completeAllowed ? exp::kOverwriteLine1 : exp::kOverwriteDxfLine1,
            m_completeAllowed ? exp::kOverwriteLine2 : exp::kOverwriteDxfLine2};
}

ui::DialogResult CDlgOverWrite::Run(ui::FrontEnd& frontEnd) {
    const std::array<std::string, 3> lines = Lines();
    const std::string text = lines[0] + "\n" + lines[1] + "\n" + lines[2] + "\n" +
                             (m_completeAllowed ? exp::kOverwriteAnswers : exp::kOverwriteDxfAnswers);
    // Nothing lost by default: a question nobody answers abandons the export.
    const ui::Answer answer =
        frontEnd.Ask(text, ui::kCaption, m_completeAllowed ? ui::Buttons::YesNoCancel : ui::Buttons::YesNo,
                     m_completeAllowed ? ui::Answer::Cancel : ui::Answer::No);
    if (answer == ui::Answer::Yes)
        m_choice = OverwriteChoice::Replace;
    else if (answer == ui::Answer::No && m_completeAllowed)
        m_choice = OverwriteChoice::Complete;
    else
        m_choice = OverwriteChoice::Cancel;
    return m_choice == OverwriteChoice::Cancel ? ui::DialogResult::Cancel : ui::DialogResult::Ok;
}

// ---------------------------------------------------------------- the export dialog

CDlgExportPoints::CDlgExportPoints(const CCarnet* carnet, const std::vector<int>* selection,
                                   std::optional<int> imposedFormat)
    : m_carnet(carnet), m_imposedFormat(imposedFormat) {
    if (m_imposedFormat) m_format = *m_imposedFormat;
    SetSelection(selection);
}

void CDlgExportPoints::SetSelection(const std::vector<int>* selection) {
    m_selection = selection;
    m_hasObservations = m_hasPoints = false;
    if (m_selection)
        for (int reference : *m_selection)
            (reference >= kObservationReference ? m_hasObservations : m_hasPoints) = true;
}

std::string CDlgExportPoints::Caption() const {
    return Inputs().title.empty() ? exp::kCaption : Inputs().title;
}

std::vector<std::string> CDlgExportPoints::FormatList() {
    std::vector<std::string> list;
    for (const ExportFormatInfo& format : kFormats)
        list.emplace_back(format.listText);
    return list;
}

void CDlgExportPoints::ReadSettings() {
    const CParamFile params = Params();
    for (int i = 0; i < kExportFormatCount; ++i)
        if (const char* file = kFormats[i].defaultSettings)
            m_paramFiles[static_cast<std::size_t>(i)] = InstallationConfigFile(Inputs().configFolder, file);
    if (!m_imposedFormat) params.ReadInt(exp::kSection, exp::kKeyDernierFormat, m_format, 0, 7, m_format);
    for (int i = 0; i < kExportFormatCount; ++i)
        if (const char* key = kFormats[i].settingsKey) {
            std::string& file = m_paramFiles[static_cast<std::size_t>(i)];
            params.ReadString(exp::kSection, key, file, file);
        }
    m_view = ReadBool(params, exp::kKeyVisualiserFichier, m_view);
    m_writePoints = ReadBool(params, exp::kKeyEcrirePoints, m_writePoints);
    m_writeCarnet = ReadBool(params, exp::kKeyEcrireCarnet, m_writeCarnet);
}

bool CDlgExportPoints::WriteSettings(ui::FrontEnd&) const {
    const CParamFile params = Params();
    bool written = params.WriteInt(exp::kSection, exp::kKeyDernierFormat, m_format);
    for (int i = 0; i < kExportFormatCount; ++i) {
        const char* key = kFormats[i].settingsKey;
        // The Leica settings file is read but never written back: the one chosen serves this export only.
        if (!key || key == exp::kKeyParametresLeica) continue;
        written =
            params.WriteString(exp::kSection, key, m_paramFiles[static_cast<std::size_t>(i)]) && written;
    }
    written = params.WriteBool(exp::kSection, exp::kKeyVisualiserFichier, m_view) && written;
    written = params.WriteBool(exp::kSection, exp::kKeyEcrirePoints, m_writePoints) && written;
    written = params.WriteBool(exp::kSection, exp::kKeyEcrireCarnet, m_writeCarnet) && written;
    return written;
}

void CDlgExportPoints::OnInitDialog() {
    ReadSettings();
    if (m_carnet)
        m_source = m_carnet->PathName();
    else if (m_source.empty())
        m_source = GeoBase();
    if (!SelectedEnabled() && m_scope == kSelected) m_scope = kAll;
    if (SelectedEnabled()) m_scope = kSelected;
    DeriveOutput();
    Notify(kPartFields | kPartLayout);
}

std::string CDlgExportPoints::DerivedOutput(const std::string& source, int format) {
    if (source.empty()) return {};
    const ExportFormatInfo& info = ExportFormatOf(format);
    const std::filesystem::path path(source);
    std::string name = path.stem().string();
    if (info.suffix) name += "_2";
    name += '.';
    name += info.extension;
    return (path.parent_path() / name).string();
}

void CDlgExportPoints::DeriveOutput() {
    m_output = DerivedOutput(SourcePath(), m_format);
}

const std::string& CDlgExportPoints::SourcePath() const {
    return m_carnet && !m_carnet->PathName().empty() ? m_carnet->PathName() : m_source;
}

std::string CDlgExportPoints::GroupTitle() const {
    return ElementFormat() ? exp::kGroupElements : exp::kGroupPoints;
}

std::string CDlgExportPoints::SelectedText() const {
    return ElementFormat() ? exp::kOnlySelectedElements : exp::kOnlySelectedPoints;
}

std::string CDlgExportPoints::AllText() const {
    return ElementFormat() ? exp::kAllElements : exp::kAllPoints;
}

bool CDlgExportPoints::ParamFileVisible() const {
    return kFormats[m_format].defaultSettings != nullptr;
}

void CDlgExportPoints::SetOutput(std::string path) {
    m_output = std::move(path);
    Notify(kPartFields);
}

void CDlgExportPoints::SetSource(std::string path) {
    m_source = std::move(path);
    DeriveOutput();
    Notify(kPartFields);
}

void CDlgExportPoints::SetWritePoints(bool on) {
    m_writePoints = on;
    Notify(kPartFields);
}

void CDlgExportPoints::SetWriteCarnet(bool on) {
    m_writeCarnet = on;
    Notify(kPartFields);
}

void CDlgExportPoints::SetScope(int scope) {
    if (scope < kSelected || scope > kRange || (scope == kSelected && !SelectedEnabled())) return;
    m_scope = scope;
    Notify(kPartFields | kPartLayout);
}

void CDlgExportPoints::SetFrom(std::string mat) {
    const bool typed = !mat.empty() && mat != m_from;
    m_from = std::move(mat);
    if (typed) m_scope = kRange;
    Notify(kPartFields | kPartLayout);
}

void CDlgExportPoints::SetTo(std::string mat) {
    m_to = std::move(mat);
    Notify(kPartFields);
}

void CDlgExportPoints::SetViewFile(bool on) {
    m_view = on;
    Notify(kPartFields);
}

void CDlgExportPoints::SetFormat(int number) {
    if (number < 0 || number >= kExportFormatCount || (m_imposedFormat && number != *m_imposedFormat)) return;
    m_format = number;
    DeriveOutput();
    Notify(kPartFields | kPartLayout);
}

void CDlgExportPoints::SetParamFile(std::string path) {
    if (!ParamFileVisible()) return;
    m_paramFiles[static_cast<std::size_t>(m_format)] = std::move(path);
    Notify(kPartFields);
}

bool CDlgExportPoints::BrowseOutput(ui::FrontEnd& frontEnd) {
    const ExportFormatInfo& info = kFormats[m_format];
    std::optional<std::string> path =
        frontEnd.ChooseFile({true, exp::kChooseOutput, info.filter, info.browseExtension, m_output});
    if (!path) return false;
    SetOutput(std::move(*path));
    return true;
}

bool CDlgExportPoints::BrowseSource(ui::FrontEnd& frontEnd) {
    std::optional<std::string> path =
        frontEnd.ChooseFile({false, exp::kChooseSource, exp::kFilterGeoBase, "geo", m_source});
    if (!path) return false;
    SetSource(std::move(*path));
    return true;
}

bool CDlgExportPoints::BrowseParamFile(ui::FrontEnd& frontEnd) {
    if (!ParamFileVisible()) return false;
    std::optional<std::string> path =
        frontEnd.ChooseFile({false, exp::kChooseParamFile, exp::kFilterParamFile, "ini", ParamFile()});
    if (!path) return false;
    SetParamFile(std::move(*path));
    return true;
}

bool CDlgExportPoints::HasSomethingToExport() const {
    const bool selectedOnly = m_scope == kSelected;
    if (ElementFormat()) {
        if (m_writeCarnet && WriteCarnetEnabled() && (!selectedOnly || m_hasObservations)) return true;
        return m_writePoints && (!selectedOnly || m_hasPoints);
    }
    return !selectedOnly || m_hasPoints;
}

ui::DialogResult CDlgExportPoints::OnOK(ui::FrontEnd& frontEnd) {
    m_written = 0;
    if (!HasSomethingToExport()) {
        frontEnd.MessageBox(exp::kMsgNothingToExport, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }
    if (m_output.empty()) {
        frontEnd.MessageBox(exp::kMsgNoOutput, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }
    if (!m_carnet && m_source.empty()) {
        frontEnd.MessageBox(exp::kMsgNoSource, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }
    PointExportJob job;
    if (m_scope == kRange) {
        std::string why;
        job.range = IdentifierRange::Make(m_from, m_to, &why);
        if (!job.range) {
            frontEnd.MessageBox(Sprintf(exp::kMsgBadRange, why.c_str()), ui::kCaption, ui::kIconWarning);
            return ui::DialogResult::Failed;
        }
    }

    // The file mode: an existing file is replaced or completed as the person says.
    bool append = false;
    if (FileExists(m_output)) {
        CDlgOverWrite question(m_format != kFormatDxf);
        const OverwriteChoice choice =
            askOverwrite ? askOverwrite(frontEnd, question)
                         : (frontEnd.DoModal(question) == ui::DialogResult::Ok ? question.Choice()
                                                                               : OverwriteChoice::Cancel);
        if (choice == OverwriteChoice::Cancel) return ui::DialogResult::Cancel;
        append = choice == OverwriteChoice::Complete && question.CompleteAllowed();
    }

    WriteSettings(frontEnd);

    CPyrTxtWnd txt(frontEnd);
    CCarnet loaded;
    const CCarnet* carnet = m_carnet;
    if (!carnet) {
        if (!loaded.Load(&txt, m_source, {}, 0, &frontEnd)) return ui::DialogResult::Failed;
        if (loaded.LoadedFileIsForeign()) {
            frontEnd.MessageBox(Sprintf(exp::kMsgNotAGeoBase, m_source.c_str()), ui::kCaption,
                                ui::kIconWarning);
            return ui::DialogResult::Failed;
        }
        carnet = &loaded;
    }

    job.carnet = carnet;
    job.paramFile = ParamFileVisible() ? ParamFile() : std::string();
    job.selection = m_scope == kSelected ? m_selection : nullptr;
    job.path = m_output;
    job.append = append;
    job.parent = &frontEnd;
    job.txt = &txt;
    // An empty GéoBase, a range or a selection that holds nothing of what is written: no file is made.
    if (!ScopeHoldsSomething(job)) {
        frontEnd.MessageBox(exp::kMsgNothingToExport, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }

    bool done = false;
    switch (kFormats[m_format].format) {
    case ExportFormat::GeoBase:
        done = ExportGeoBase(*carnet, job, frontEnd, txt);
        break;
    case ExportFormat::Quendal:
        done = ExportQuendal(job);
        break;
    default:
        done = ExportPoints(job);
        break;
    }
    if (!done) return ui::DialogResult::Failed;
    if (ElementFormat())
        txt.Print(exp::kMsgElementsExported, m_written, m_output.c_str());
    else
        txt.Print(exp::kMsgExported, m_output.c_str());
    if (m_view && FileExists(m_output)) frontEnd.ShowFile(m_output);
    return ui::DialogResult::Ok;
}

bool CDlgExportPoints::ScopeHoldsSomething(const PointExportJob& job) const {
    const CCarnet& carnet = *job.carnet;
    const bool points = !ElementFormat() || m_writePoints;
    const bool observations = ElementFormat() && m_writeCarnet && WriteCarnetEnabled();
    const std::vector<bool> inScope = ElementsInScope(job);
    for (int i = 0; i < carnet.GetSize(); ++i)
        if (inScope[static_cast<std::size_t>(i)] && (carnet.GetType(i) == kKindPoint ? points : observations))
            return true;
    return false;
}

bool CDlgExportPoints::ExportGeoBase(const CCarnet& carnet, const PointExportJob& job, ui::FrontEnd& frontEnd,
                                     CPyrTxtWnd& txt) {
    // A copy of the elements of the export, in their order: what the GéoBase holds once every element out
    // of it is taken away, made without taking them away one by one (a million removals from a vector).
    CCarnet copy;
    const bool observations = m_writeCarnet && WriteCarnetEnabled();
    const std::vector<bool> inScope = ElementsInScope(job);
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (inScope[static_cast<std::size_t>(i)] && (kind == kKindPoint ? m_writePoints : observations))
            copy.Add(carnet.copyElement(i), kind);
    }
    m_written = copy.GetSize();
    if (job.append) {
        // Completing a GéoBase: its elements first, then those exported.
        CCarnet target;
        if (!target.Load(&txt, job.path, {}, 0, &frontEnd)) return false;
        if (target.LoadedFileIsForeign()) {
            frontEnd.MessageBox(Sprintf(exp::kMsgNotAGeoBase, job.path.c_str()), ui::kCaption,
                                ui::kIconWarning);
            return false;
        }
        target.Append(std::move(copy));
        return target.Save(job.path, &frontEnd) == 1;
    }
    return copy.Save(job.path, &frontEnd) == 1;
}

bool CDlgExportPoints::ExportQuendal(const PointExportJob& job) {
    const QdlExportChoices choices{m_writePoints, m_writeCarnet && WriteCarnetEnabled()};
    return CDlgConfigQdl::Export(job, choices, &m_written);
}

bool CDlgExportPoints::ExportPoints(const PointExportJob& job) {
    switch (kFormats[m_format].format) {
    case ExportFormat::Separateur:
        return CDlgConfigSep::Export(job);
    case ExportFormat::Colonne:
        return CDlgConfigCol::Export(job);
    case ExportFormat::Leica:
        return CDlgConfigLeica::Export(job);
    case ExportFormat::Gdm:
        return dll_ExportSpectra(job);
    case ExportFormat::Sokkia:
        return DlgCfgSok::Export(job);
    case ExportFormat::Dxf:
        return CDlgConfigDxf::Export(job);
    default:
        return false;
    }
}

} // namespace pyr

#include "editor/GeoEditor.h"

#include "calc/ChangeRepTexts.h"
#include "core/Files.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/ExportTexts.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/TableCode.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "settings/LastGeoBase.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

namespace {

constexpr const char* kChooseTitle = "Sélectionnez la GéoBase à éditer :";
constexpr const char* kOpened = "GéoBase <%s> : %d élément(s).";
constexpr int kKindColumn = 14;
constexpr const char* kReductionOption = "reduction";
constexpr const char* kReductionHelp =
    "réduit les stations (réduction des reprises) avant de montrer la GéoBase";
constexpr const char* kChangeFrameOption = "changement-repere";
constexpr const char* kGeoBaseHelp = "la GéoBase à éditer (au lieu de la dernière utilisée)";
constexpr const char* kReadingOption = "lecture";
constexpr const char* kReadingHelp = "lit un carnet de ce format, l'ajoute à la GéoBase et l'enregistre";
constexpr const char* kExportOption = "exportation";
constexpr const char* kReadingDone = "GéoBase <%s> : %d élément(s), dont %d lu(s) dans le carnet.";

// The code table the editor holds for a GéoBase: the one it goes with, else the job's table of the
// settings; none when neither can be read.
std::unique_ptr<CTableCode> EditorCodeTable(const CCarnet& carnet, std::string_view paramPath,
                                            CPyrTxtWnd& txt) {
    std::string path = carnet.Configuration();
    if (path.empty()) ReadParamString(paramPath, kSectionGeocodification, kKeyTableDeCode, "", path);
    if (path.empty() || !FileExists(path)) return nullptr;
    auto table = std::make_unique<CTableCode>();
    if (!table->Init(path, &txt)) return nullptr;
    return table;
}

} // namespace

namespace {

// The element's fields as the file writes them, the kind code left out, two blanks between them.
std::string ElementValues(const CCarnet& carnet, int index) {
    const std::string fields = ElementLine(*carnet.GetAt(index), carnet.GetType(index));
    const size_t first = fields.find('\t');
    std::string values;
    if (first == std::string::npos) return values;
    for (char c : std::string_view(fields).substr(first + 1))
        values += c == '\t' ? std::string("  ") : std::string(1, c);
    return values;
}

} // namespace

std::string EditorLine(const CCarnet& carnet, int index) {
    return Sprintf("%06d  %s%s", index + 1, PadRight(KindLabel(carnet.GetType(index)), kKindColumn).c_str(),
                   ElementValues(carnet, index).c_str());
}

std::string EditorRow(const CCarnet& carnet, int index) {
    return Sprintf("%06d\t%s\t%s", index + 1, std::string(KindLabel(carnet.GetType(index))).c_str(),
                   ElementValues(carnet, index).c_str());
}

void CGeoEditor::DeclareOptions(ui::DialogOptions& options) {
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
}

ui::DialogResult CGeoEditor::ExportPoints(ui::FrontEnd& frontEnd, bool asWindow) {
    m_exporter.SetInputs({m_carnet.PathName(), Inputs().paramPath, Inputs().configFolder, exp::kCaption});
    m_exporter.SetCarnet(&m_carnet);
    ui::DialogResult result = ui::DialogResult::Failed;
    if (asWindow) {
        result = frontEnd.DoModal(m_exporter);
    } else {
        // The editor's selection is the one its other actions take.
        ExportRequests requests = m_exportRequests;
        if (const std::optional<std::string>& selection = m_frameChange.SelectionText()) {
            requests.selection = *selection;
            if (!requests.from) requests.scope = CDlgExportPoints::kSelected;
        }
        m_exporter.Export().SetInputs(m_exporter.Inputs());
        result = RunExport(m_exporter.Export(), requests, frontEnd, &m_carnet);
    }
    m_exporter.SetCarnet(nullptr);
    return result;
}

ui::DialogResult CGeoEditor::ExportPoints(ui::FrontEnd& frontEnd) {
    return ExportPoints(frontEnd, true);
}

ui::DialogResult CGeoEditor::ReadFieldBook(const Reading& reading, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd,
                                           bool asWindow) {
    CCarnet fresh;
    CCarnet* target = &m_carnet;
    if (!m_carnet.IsEmpty()) {
        const ui::Answer answer =
            frontEnd.Ask(fb::kAskAppendToGeoBase, ui::kCaption, ui::Buttons::YesNoCancel, ui::Answer::Cancel);
        if (answer == ui::Answer::Cancel) return ui::DialogResult::Cancel;
        if (answer == ui::Answer::No) target = &fresh; // the open GéoBase stays as it is
    }
    // A new GéoBase is named after the field book: asked about at once when a command line names the book,
    // once the reading dialog has it otherwise.
    const auto nameFresh = [&frontEnd, &fresh](const std::string& carnet) {
        const std::string path = BesideCarnet(carnet, kGeoFileExtension);
        if (FileExists(path) &&
            frontEnd.Ask(Sprintf(fb::kAskReplaceGeoBase, fb::kGeoBaseExists, fb::kReplaceIt), ui::kCaption,
                         ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes)
            return false;
        fresh.SetPathName(path);
        return true;
    };
    if (target == &fresh && reading.carnet && !nameFresh(*reading.carnet)) return ui::DialogResult::Cancel;

    const std::string paramPath = Inputs().paramPath;
    std::unique_ptr<CTableCode> table = EditorCodeTable(*target, paramPath, txt);
    EditorDocument document{table.get(), ReadInstruments(paramPath)};
    FieldBookConverter converter(reading.format, &frontEnd, paramPath, Inputs().configFolder, &txt,
                                 &document);
    ReadingRequests requests = m_readingRequests;
    requests.carnet = reading.carnet;
    converter.showDialog = [&](CLectCarnet& dialog) {
        dialog.SetRequests(requests);
        const ui::DialogResult shown = asWindow ? frontEnd.DoModal(dialog) : dialog.Run(frontEnd);
        if (shown == ui::DialogResult::Ok && target == &fresh && !reading.carnet &&
            !nameFresh(dialog.Carnet()))
            return ui::DialogResult::Cancel;
        return shown;
    };
    const int former = target->GetSize();
    const ui::DialogResult read = RunConversion(converter, target);
    if (read != ui::DialogResult::Ok) return read;

    if (target == &fresh) {
        m_carnet = std::move(fresh);
        m_tracked.clear();
    }
    Notify(kPartGeoBase);
    const std::string path = m_carnet.PathName();
    if (!m_carnet.BackUp(&frontEnd) || !m_carnet.Save(path, &frontEnd)) return ui::DialogResult::Failed;
    txt.Print(msg::kSaved, path.c_str());
    WriteLastGeoBase(paramPath, WholePath(path));
    // The view refreshed from the former end of the GéoBase on.
    txt.Print(kReadingDone, path.c_str(), m_carnet.GetSize(), m_carnet.GetSize() - former);
    if (!asWindow) // a window lists them
        for (int i = former; i < m_carnet.GetSize(); ++i)
            txt.PrintText(EditorLine(m_carnet, i));
    return ui::DialogResult::Ok;
}

ui::DialogResult CGeoEditor::ReadFieldBook(ui::FrontEnd& frontEnd, FieldBookFormat format) {
    CPyrTxtWnd txt(frontEnd);
    return ReadFieldBook(Reading{format, std::nullopt}, txt, frontEnd, true);
}

bool CGeoEditor::ReduceStations(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow) {
    m_reduction.SetInputs(
        {m_carnet.PathName(), Inputs().paramPath, Inputs().configFolder, kReductionCaption});
    CReduction_Station& reduction = m_reduction.Reduction();
    reduction.SetCarnet(&m_carnet);
    const ui::DialogResult shown = asWindow ? frontEnd.DoModal(m_reduction) : m_reduction.Run(frontEnd);
    reduction.SetCarnet(nullptr);
    if (shown != ui::DialogResult::Ok || !reduction.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return true;
    }
    Notify(kPartGeoBase);
    const std::string path = m_carnet.PathName();
    if (!m_carnet.BackUp(&frontEnd) || !m_carnet.Save(path, &frontEnd)) return false;
    txt.Print(msg::kSaved, path.c_str());
    return true;
}

bool CGeoEditor::ReduceStations(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    return ReduceStations(txt, frontEnd, true);
}

ui::DialogResult CGeoEditor::ChangeFrame(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow) {
    m_frameChange.SetInputs({m_carnet.PathName(), Inputs().paramPath, Inputs().configFolder, rep::kCaption});
    CChange_Rep& change = m_frameChange.FrameChange();
    change.SetCarnet(&m_carnet);
    const ui::DialogResult shown = asWindow ? frontEnd.DoModal(m_frameChange) : m_frameChange.Run(frontEnd);
    change.SetCarnet(nullptr);
    if (shown == ui::DialogResult::Failed) return shown;
    if (shown != ui::DialogResult::Ok || !change.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return shown;
    }
    ElementChanges& changes = change.Changes();
    if (m_tracked.empty())
        m_tracked.swap(changes);
    else
        m_tracked.insert(m_tracked.end(), std::make_move_iterator(changes.begin()),
                         std::make_move_iterator(changes.end()));
    changes.clear();
    Notify(kPartGeoBase);
    const std::string path = m_carnet.PathName();
    if (!m_carnet.BackUp(&frontEnd) || !m_carnet.Save(path, &frontEnd)) return ui::DialogResult::Failed;
    txt.Print(msg::kSaved, path.c_str());
    return ui::DialogResult::Ok;
}

ui::DialogResult CGeoEditor::ChangeFrame(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    return ChangeFrame(txt, frontEnd, true);
}

std::optional<std::string> CGeoEditor::ChosenGeoBase(ui::FrontEnd& frontEnd) const {
    std::string path = GeoBase();
    if (!GeoBaseNamed()) {
        auto chosen = frontEnd.ChooseFile({false, kChooseTitle, kGeoFileFilter, kGeoFileExtension, path});
        if (!chosen) return std::nullopt;
        path = *chosen;
    }
    if (path.empty()) return std::nullopt;
    return path;
}

bool CGeoEditor::Load(const std::string& path, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    CCarnet carnet;
    if (!carnet.Load(&txt, path, {}, 0, &frontEnd)) return false;
    // The next command opens the last GéoBase: never a file that is not one.
    if (!carnet.LoadedFileIsForeign()) WriteLastGeoBase(Inputs().paramPath, WholePath(path));
    m_carnet = std::move(carnet);
    m_tracked.clear();
    Notify(kPartGeoBase);
    return true;
}

ui::DialogResult CGeoEditor::OpenGeoBase(ui::FrontEnd& frontEnd) {
    const std::optional<std::string> path = ChosenGeoBase(frontEnd);
    if (!path) return ui::DialogResult::Cancel;
    CPyrTxtWnd txt(frontEnd);
    return Load(*path, txt, frontEnd) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

ui::DialogResult CGeoEditor::Run(ui::FrontEnd& frontEnd) {
    const std::optional<std::string> path = ChosenGeoBase(frontEnd);
    if (!path) return ui::DialogResult::Cancel;

    CPyrTxtWnd txt(frontEnd);
    if (m_reading && !FileExists(*path)) {
        m_carnet = CCarnet(); // a new GéoBase, made by the reading, recorded once it is saved
        m_tracked.clear();
        m_carnet.SetPathName(*path);
    } else if (!Load(*path, txt, frontEnd)) {
        return ui::DialogResult::Failed;
    }

    if (m_reduce && !ReduceStations(txt, frontEnd, false)) return ui::DialogResult::Failed;
    if (m_changeFrame && ChangeFrame(txt, frontEnd, false) == ui::DialogResult::Failed)
        return ui::DialogResult::Failed;
    if (m_reading) {
        const ui::DialogResult read = ReadFieldBook(*m_reading, txt, frontEnd, false);
        if (read != ui::DialogResult::Ok || !m_export) return read;
    }
    if (m_export) return ExportPoints(frontEnd, false);
    txt.Print(kOpened, path->c_str(), m_carnet.GetSize());
    for (int i = 0; i < m_carnet.GetSize(); ++i)
        txt.PrintText(EditorLine(m_carnet, i));
    return ui::DialogResult::Ok;
}

} // namespace pyr

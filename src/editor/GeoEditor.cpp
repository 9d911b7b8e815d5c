#include "editor/GeoEditor.h"

#include "core/Files.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
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
constexpr const char* kGeoBaseHelp = "la GéoBase à éditer (au lieu de la dernière utilisée)";
constexpr const char* kReadingOption = "lecture";
constexpr const char* kReadingHelp = "lit un carnet de ce format, l'ajoute à la GéoBase et l'enregistre";
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

std::string EditorLine(const CCarnet& carnet, int index) {
    const int kind = carnet.GetType(index);
    // The element's fields as the file writes them, the kind code left out, a column between them.
    std::string fields = ElementLine(*carnet.GetAt(index), kind);
    const size_t first = fields.find('\t');
    fields = first == std::string::npos ? std::string() : fields.substr(first + 1);
    std::string values;
    for (char c : fields)
        values += c == '\t' ? std::string("  ") : std::string(1, c);
    return Sprintf("%06d  %s%s", index + 1, PadRight(KindLabel(kind), kKindColumn).c_str(), values.c_str());
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
    options.Values(
        kReadingOption, {"FORMAT", "CARNET"}, kReadingHelp, [this](const std::vector<std::string>& values) {
            const std::optional<FieldBookFormat> format = FindFieldBookFormat(values.at(0));
            if (!format)
                return Sprintf(fb::kMsgUnknownFormat, values.at(0).c_str(), FieldBookFormatNames().c_str());
            m_reading = Reading{*format, values.at(1)};
            return std::string();
        });
    DeclareReadingOptions(options, m_readingRequests, true, false);
}

ui::DialogResult CGeoEditor::ReadFieldBook(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    CCarnet fresh;
    CCarnet* target = &carnet;
    if (!carnet.IsEmpty()) {
        const ui::Answer answer =
            frontEnd.Ask(fb::kAskAppendToGeoBase, ui::kCaption, ui::Buttons::YesNoCancel, ui::Answer::Cancel);
        if (answer == ui::Answer::Cancel) return ui::DialogResult::Cancel;
        if (answer == ui::Answer::No) {
            // A new GéoBase, named after the field book; the open one stays as it is.
            const std::string path = BesideCarnet(m_reading->carnet, kGeoFileExtension);
            if (FileExists(path) &&
                frontEnd.Ask(Sprintf(fb::kAskReplaceGeoBase, fb::kGeoBaseExists, fb::kReplaceIt),
                             ui::kCaption, ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes)
                return ui::DialogResult::Cancel;
            fresh.SetPathName(path);
            target = &fresh;
        }
    }
    const std::string paramPath = Inputs().paramPath;
    std::unique_ptr<CTableCode> table = EditorCodeTable(*target, paramPath, txt);
    EditorDocument document{table.get(), ReadInstruments(paramPath)};
    FieldBookConverter converter(m_reading->format, &frontEnd, paramPath, Inputs().configFolder, &txt,
                                 &document);
    ReadingRequests requests = m_readingRequests;
    requests.carnet = m_reading->carnet;
    converter.showDialog = [&frontEnd, &requests](CLectCarnet& dialog) {
        dialog.SetRequests(requests);
        return dialog.Run(frontEnd);
    };
    const int former = target->GetSize();
    const ui::DialogResult read = RunConversion(converter, target);
    if (read != ui::DialogResult::Ok) return read;

    if (target == &fresh) carnet = std::move(fresh);
    const std::string path = carnet.PathName();
    if (!carnet.BackUp(&frontEnd) || !carnet.Save(path, &frontEnd)) return ui::DialogResult::Failed;
    txt.Print(msg::kSaved, path.c_str());
    WriteLastGeoBase(paramPath, WholePath(path));
    // The view refreshed from the former end of the GéoBase on.
    txt.Print(kReadingDone, path.c_str(), carnet.GetSize(), carnet.GetSize() - former);
    for (int i = former; i < carnet.GetSize(); ++i)
        txt.PrintText(EditorLine(carnet, i));
    return ui::DialogResult::Ok;
}

bool CGeoEditor::ReduceStations(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    m_reduction.SetInputs({carnet.PathName(), Inputs().paramPath, Inputs().configFolder, kReductionCaption});
    CReduction_Station& reduction = m_reduction.Reduction();
    reduction.SetCarnet(&carnet);
    const bool reduced = m_reduction.Run(frontEnd) == ui::DialogResult::Ok;
    reduction.SetCarnet(nullptr);
    if (!reduced || !reduction.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return true;
    }
    const std::string path = carnet.PathName();
    if (!carnet.BackUp(&frontEnd) || !carnet.Save(path, &frontEnd)) return false;
    txt.Print(msg::kSaved, path.c_str());
    return true;
}

ui::DialogResult CGeoEditor::Run(ui::FrontEnd& frontEnd) {
    std::string path = GeoBase();
    if (!GeoBaseNamed()) {
        auto chosen = frontEnd.ChooseFile({false, kChooseTitle, kGeoFileFilter, kGeoFileExtension, path});
        if (!chosen) return ui::DialogResult::Cancel;
        path = *chosen;
    }
    if (path.empty()) return ui::DialogResult::Cancel;

    CPyrTxtWnd txt(frontEnd);
    CCarnet carnet;
    if (m_reading && !FileExists(path)) {
        carnet.SetPathName(path); // a new GéoBase, made by the reading, recorded once it is saved
    } else {
        if (!carnet.Load(&txt, path, {}, 0, &frontEnd)) return ui::DialogResult::Failed;
        // The next command opens the last GéoBase: never a file that is not one.
        if (!carnet.LoadedFileIsForeign()) WriteLastGeoBase(Inputs().paramPath, WholePath(path));
    }

    if (m_reduce && !ReduceStations(carnet, txt, frontEnd)) return ui::DialogResult::Failed;
    if (m_reading) return ReadFieldBook(carnet, txt, frontEnd);
    txt.Print(kOpened, path.c_str(), carnet.GetSize());
    for (int i = 0; i < carnet.GetSize(); ++i)
        txt.PrintText(EditorLine(carnet, i));
    return ui::DialogResult::Ok;
}

} // namespace pyr

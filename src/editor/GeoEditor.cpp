#include "editor/GeoEditor.h"

#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "settings/LastGeoBase.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <filesystem>

namespace pyr {

namespace {

constexpr const char* kChooseTitle = "Sélectionnez la GéoBase à éditer :";
constexpr const char* kOpened = "GéoBase <%s> : %d élément(s).";
constexpr int kKindColumn = 14;
constexpr const char* kReductionOption = "reduction";
constexpr const char* kReductionHelp =
    "réduit les stations (réduction des reprises) avant de montrer la GéoBase";

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
    options.Switch(kReductionOption, kReductionHelp, [this] {
        m_reduce = true;
        return std::string();
    });
    m_reduction.DeclareOptions(options);
}

bool CGeoEditor::ReduceStations(CCarnet& carnet, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    m_reduction.SetInputs({carnet.PathName(), Inputs().paramPath, Inputs().configFolder, kReductionCaption});
    m_reduction.SetCarnet(&carnet);
    const bool reduced = m_reduction.Run(frontEnd) == ui::DialogResult::Ok;
    m_reduction.SetCarnet(nullptr);
    if (!reduced || !m_reduction.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return true;
    }
    const std::string path = carnet.PathName();
    carnet.BackUp();
    if (!carnet.Save(path, &frontEnd)) return false;
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
    if (!carnet.Load(&txt, path, {}, 0, &frontEnd)) return ui::DialogResult::Failed;
    // Recorded whole, so that the next command finds it from whatever folder it is run.
    std::error_code error;
    const std::filesystem::path absolute = std::filesystem::absolute(path, error);
    WriteLastGeoBase(Inputs().paramPath, error ? path : absolute.lexically_normal().string());

    if (m_reduce && !ReduceStations(carnet, txt, frontEnd)) return ui::DialogResult::Failed;
    txt.Print(kOpened, path.c_str(), carnet.GetSize());
    for (int i = 0; i < carnet.GetSize(); ++i)
        txt.PrintText(EditorLine(carnet, i));
    return ui::DialogResult::Ok;
}

} // namespace pyr

#include "core/Strings.h"
#include "settings/OptionPages.h"
#include "settings/OptionTexts.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>

namespace pyr {

std::string COptionPSheet::Caption() const {
    return kOptionSheetCaption;
}

void COptionPSheet::Load() {
    if (m_loaded) return;
    m_loaded = true;
    for (COptionPage* page : Pages())
        page->Read(Inputs().paramPath);
    ApplyStoreOptions(Inputs().paramPath);
}

std::array<COptionPage*, 8> COptionPSheet::Pages() {
    Load();
    return {&m_appareil, &m_calcul, &m_correct, &m_editor, &m_linkDB, &m_listing, &m_nivel, &m_toler};
}

COptionPage* COptionPSheet::FindPage(std::string_view section) {
    for (COptionPage* page : Pages())
        if (page->Holds(section)) return page;
    return nullptr;
}

bool COptionPSheet::OnOK() {
    bool written = true;
    for (COptionPage* page : Pages())
        written = page->Write(Inputs().paramPath) && written;
    ApplyStoreOptions(Inputs().paramPath);
    return written;
}

std::string COptionPSheet::Regler(std::string_view setting) {
    const std::size_t slash = setting.find('/');
    const std::size_t equal = setting.find('=', slash == std::string_view::npos ? 0 : slash);
    if (slash == std::string_view::npos || equal == std::string_view::npos || slash == 0 ||
        equal == slash + 1)
        return Sprintf(kMsgSettingMalformed, std::string(setting).c_str());
    const std::string section(Trimmed(setting.substr(0, slash)));
    const std::string key(Trimmed(setting.substr(slash + 1, equal - slash - 1)));
    COptionPage* page = FindPage(section);
    if (!page) return Sprintf(kMsgUnknownSection, section.c_str());
    // A page that holds two sections knows each key in its own only.
    if (!EqualIgnoringCase(page->SectionOf(key), section))
        return Sprintf(kMsgUnknownKey, section.c_str(), key.c_str());
    std::string refusal = page->Set(key, setting.substr(equal + 1));
    if (!refusal.empty()) return refusal;
    // Kept under the names the page gives the section and the key, so that a key given twice is written
    // once.
    std::string name = page->KeyAndValue(key).first;
    std::pair<std::string, std::string> set(page->SectionOf(key), std::move(name));
    if (std::find(m_settings.begin(), m_settings.end(), set) == m_settings.end())
        m_settings.push_back(std::move(set));
    return {};
}

std::vector<std::string> COptionPSheet::Lines() {
    std::vector<std::string> lines;
    for (COptionPage* page : Pages()) {
        if (!lines.empty()) lines.emplace_back();
        auto pageLines = page->Lines();
        lines.insert(lines.end(), pageLines.begin(), pageLines.end());
    }
    return lines;
}

void COptionPSheet::DeclareOptions(ui::DialogOptions& options) {
    options.Value(
        kOptSetName, kOptSetValue, kOptSetHelp,
        [this](const std::string& setting) { return Regler(setting); }, true);
    options.Switch(kOptShowName, kOptShowHelp, [this] {
        m_show = true;
        return std::string();
    });
}

ui::DialogResult COptionPSheet::Run(ui::FrontEnd& frontEnd) {
    Load();
    CPyrTxtWnd txt(frontEnd);
    bool written = true;
    if (!m_settings.empty()) {
        // Only the keys named are written: a file kept by hand is not filled with every default.
        for (const auto& [section, key] : m_settings) {
            COptionPage* page = FindPage(section);
            if (!page->WriteKey(Inputs().paramPath, key)) {
                written = false; // the store has said why
                continue;
            }
            const auto [name, value] = page->KeyAndValue(key);
            txt.Print(kMsgSettingWritten, section.c_str(), name.c_str(), value.c_str());
        }
        ApplyStoreOptions(Inputs().paramPath);
    }
    // Nothing asked: the values are shown, which is what a person running the command alone wants.
    if (m_show || m_settings.empty()) {
        if (!m_settings.empty()) txt.PrintText("");
        for (const auto& line : Lines())
            txt.PrintText(line);
    }
    return written ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

} // namespace pyr

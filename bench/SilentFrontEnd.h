#pragma once

#include "ui/FrontEnd.h"

#include <optional>
#include <string>
#include <string_view>

namespace pyr::bench {

// A front end that nobody watches: the messages and lines of thousands of stations go nowhere, only
// counted; every question takes its default answer.
class SilentFrontEnd : public ui::FrontEnd {
public:
    void MessageBox(std::string_view, std::string_view, int) override { ++messages; }
    ui::Answer Ask(std::string_view, std::string_view, ui::Buttons, ui::Answer byDefault, int) override {
        return byDefault;
    }
    std::optional<std::string> ChooseFile(const ui::FileChoice& choice) override { return choice.startPath; }
    void TextLine(std::string_view) override {}
    ui::DialogResult DoModal(ui::Dialog&) override { return ui::DialogResult::Cancel; }
    void ShowFile(const std::string&) override {}

    int messages = 0;
};

} // namespace pyr::bench

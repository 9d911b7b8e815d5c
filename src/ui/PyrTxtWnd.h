#pragma once

#include "ui/FrontEnd.h"

#include <string_view>

namespace pyr {

// The text window: where loading, validation, conversions and computations write their reports, one
// printf-style line at a time. A text that holds '\n' gives several lines ("\nCréation ..." gives an
// empty line first).
class CPyrTxtWnd {
public:
    explicit CPyrTxtWnd(ui::FrontEnd& frontEnd) : m_frontEnd(frontEnd) {}

    void Print(const char* format, ...) __attribute__((format(printf, 2, 3)));
    void PrintText(std::string_view text);

    int LineCount() const { return m_lineCount; }

private:
    ui::FrontEnd& m_frontEnd;
    int m_lineCount = 0;
};

} // namespace pyr

#include "ui/PyrTxtWnd.h"

#include "core/Strings.h"

#include <cstdarg>
#include <cstdio>
#include <string>

namespace pyr {

void CPyrTxtWnd::Print(const char* format, ...) {
    va_list args;
    va_start(args, format);
    std::string text = VSprintf(format, args);
    va_end(args);
    PrintText(text);
}

void CPyrTxtWnd::PrintText(std::string_view text) {
    // Each '\n' ends a line; a text that ends with one gives no empty line after it.
    size_t start = 0;
    do {
        size_t end = text.find('\n', start);
        if (end == std::string_view::npos) end = text.size();
        m_frontEnd.TextLine(text.substr(start, end - start));
        ++m_lineCount;
        start = end + 1;
    } while (start < text.size());
}

} // namespace pyr

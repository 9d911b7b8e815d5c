#include "fieldbook/ConfigSep.h"

#include "core/Strings.h"

#include <algorithm>

namespace pyr {

namespace {

constexpr char kQuote = '"';

bool IsBlank(char c) {
    return c == ' ' || c == '\t';
}

} // namespace

CDelimitedFields::CDelimitedFields(std::string separator)
    : m_separator(separator.empty() ? std::string(";") : std::move(separator)),
      m_blanks(std::all_of(m_separator.begin(), m_separator.end(), [](char c) { return c == ' '; })) {}

void CDelimitedFields::Split(std::string_view line) {
    m_line = line;
    m_fields.clear();
    m_scratch.clear();
    m_scratch.reserve(line.size());
    std::size_t position = 0;
    if (m_blanks) {
        while (position < line.size() && IsBlank(line[position]))
            ++position;
        if (position == line.size()) return;
    }
    while (position != std::string_view::npos)
        position = ReadField(position);
}

std::size_t CDelimitedFields::FindSeparator(std::size_t from) const {
    if (!m_blanks) return m_line.find(m_separator, from);
    for (std::size_t i = from; i < m_line.size(); ++i)
        if (IsBlank(m_line[i])) return i;
    return std::string_view::npos;
}

std::size_t CDelimitedFields::ReadField(std::size_t position) {
    std::size_t first = position;
    while (first < m_line.size() && m_line[first] == ' ')
        ++first;
    std::size_t separator;
    if (first < m_line.size() && m_line[first] == kQuote) {
        // The quoted text, then what follows the closing quote up to the separator. The scratch never grows
        // past the line's length: the views into it stay valid.
        const std::size_t start = m_scratch.size();
        std::size_t i = first + 1;
        while (i < m_line.size()) {
            if (m_line[i] == kQuote) {
                if (i + 1 < m_line.size() && m_line[i + 1] == kQuote) {
                    m_scratch += kQuote;
                    i += 2;
                    continue;
                }
                ++i;
                break;
            }
            m_scratch += m_line[i++];
        }
        separator = FindSeparator(i);
        const std::string_view tail = Trimmed(m_line.substr(i, std::min(separator, m_line.size()) - i));
        m_scratch += tail;
        m_fields.push_back({Trimmed(std::string_view(m_scratch).substr(start)), position});
    } else {
        separator = FindSeparator(position);
        const std::size_t end = std::min(separator, m_line.size());
        m_fields.push_back({Trimmed(m_line.substr(position, end - position)), position});
    }
    if (separator == std::string_view::npos) return separator;
    std::size_t next = separator + m_separator.size();
    if (m_blanks) {
        while (next < m_line.size() && IsBlank(m_line[next]))
            ++next;
        if (next == m_line.size()) return std::string_view::npos; // blanks at the end make no field
    }
    return next;
}

std::string_view CDelimitedFields::Field(const FieldPlace&, std::size_t index) const {
    return index < m_fields.size() ? m_fields[index].text : std::string_view();
}

std::string_view CDelimitedFields::After(const FieldPlace&, std::size_t index) const {
    if (index + 1 >= m_fields.size()) return {};
    // A single field after it is taken unquoted; several are the text of the line as it stands.
    if (index + 2 == m_fields.size()) return m_fields[index + 1].text;
    return Trimmed(m_line.substr(m_fields[index + 1].start));
}

std::size_t CDelimitedFields::Extra(std::size_t count) const {
    for (std::size_t j = m_fields.size(); j > count; --j)
        if (!m_fields[j - 1].text.empty()) return j - count;
    return 0;
}

} // namespace pyr

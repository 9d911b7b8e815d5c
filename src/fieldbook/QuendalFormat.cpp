#include "fieldbook/QuendalFormat.h"

#include "core/Strings.h"

namespace pyr::qdl {

namespace {

// Reads the field that starts at `pos`; leaves `pos` on the separator after it (or the end of the line).
std::string_view NextField(std::string_view line, std::size_t& pos, std::string& scratch, bool& quoted) {
    std::size_t start = pos;
    while (start < line.size() && (line[start] == ' ' || line[start] == '\t'))
        ++start;
    quoted = start < line.size() && line[start] == kQuote;
    if (!quoted) {
        std::size_t end = line.find(kSeparator, start);
        if (end == std::string_view::npos) end = line.size();
        pos = end;
        return Trimmed(line.substr(start, end - start));
    }
    // A quoted field: up to the quote that is not doubled; what follows it up to the separator is dropped.
    const std::size_t first = scratch.size();
    std::size_t i = start + 1;
    for (; i < line.size(); ++i) {
        if (line[i] != kQuote) {
            scratch += line[i];
        } else if (i + 1 < line.size() && line[i + 1] == kQuote) {
            scratch += kQuote;
            ++i;
        } else {
            break;
        }
    }
    std::size_t end = line.find(kSeparator, i);
    pos = end == std::string_view::npos ? line.size() : end;
    return std::string_view(scratch).substr(first);
}

} // namespace

void SplitFields(std::string_view line, Fields& fields, std::string& scratch) {
    scratch.clear();
    scratch.reserve(line.size()); // never grows further: the views into it stay valid
    fields.count = 0;
    std::size_t pos = 0;
    while (true) {
        bool quoted = false;
        const std::string_view field = NextField(line, pos, scratch, quoted);
        if (fields.count < kMaxFields) {
            fields.field[fields.count] = field;
            fields.quoted[fields.count] = quoted;
        }
        ++fields.count;
        if (pos >= line.size()) break;
        ++pos; // the separator
    }
    for (std::size_t i = fields.count; i < kMaxFields; ++i) {
        fields.field[i] = {};
        fields.quoted[i] = false;
    }
}

std::vector<std::string> SplitAllFields(std::string_view line) {
    std::vector<std::string> fields;
    std::string scratch;
    std::size_t pos = 0;
    while (true) {
        scratch.clear();
        bool quoted = false;
        fields.emplace_back(NextField(line, pos, scratch, quoted));
        if (pos >= line.size()) break;
        ++pos;
    }
    return fields;
}

void AppendField(std::string& out, std::string_view text) {
    // A line end inside a text would cut its record: it is written as a blank.
    std::string flat;
    if (text.find_first_of("\r\n") != std::string_view::npos) {
        flat.assign(text);
        for (char& c : flat)
            if (c == '\r' || c == '\n') c = ' ';
        text = flat;
    }
    const bool quote =
        text.find(kSeparator) != std::string_view::npos || text.find(kQuote) != std::string_view::npos ||
        (!text.empty() &&
         (text.front() == ' ' || text.front() == '\t' || text.back() == ' ' || text.back() == '\t'));
    if (!quote) {
        out += text;
        return;
    }
    out += kQuote;
    for (char c : text) {
        if (c == kQuote) out += kQuote;
        out += c;
    }
    out += kQuote;
}

} // namespace pyr::qdl

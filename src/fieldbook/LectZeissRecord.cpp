#include "fieldbook/LectZeissRecord.h"

#include "core/Strings.h"
#include "core/TextEncoding.h"

namespace pyr::zeiss {

namespace {

// The columns of an M5 line, counted from 0.
constexpr std::size_t kM5Kind = 17; // "PI1", "TI ", "TO "
constexpr std::size_t kM5Info = 21; // the 27-character information block
constexpr std::size_t kM5InfoWidth = kInfoWidth;
constexpr std::size_t kM5FirstBlock = 49; // a block: type 2, blank, value 14, blank, unit 4, separator
constexpr std::size_t kM5BlockWidth = 23;
constexpr std::size_t kM5ErrorFlag = 118;

// The columns of a Rec 500 line, counted from 0.
constexpr std::size_t kRecAddressWidth = 7;
constexpr std::size_t kRecText = 8;
constexpr std::size_t kRecPointEnd = 27;
constexpr std::size_t kRecCodeEnd = 36;
constexpr std::size_t kRecBlocks[] = {36, 51, 66};

// A line cut at its columns, counted in characters: a Windows-1252 field book comes here in UTF-8, where
// an accented letter takes two bytes, and no field may end in the middle of one.
class Line {
public:
    explicit Line(std::string_view text) : m_text(text), m_ascii(IsAscii(text)) {}
    std::size_t Size() const { return m_ascii ? m_text.size() : Utf8Length(m_text); }
    // The part from column `first` (from 0), `count` characters at most, cut where the line ends.
    std::string_view Columns(std::size_t first, std::size_t count) const {
        if (m_ascii) return first >= m_text.size() ? std::string_view{} : m_text.substr(first, count);
        const std::size_t begin = Offset(0, first);
        return m_text.substr(begin, Offset(begin, count) - begin);
    }
    std::string_view Field(std::size_t first, std::size_t count) const {
        return Trimmed(Columns(first, count));
    }

private:
    // The byte `characters` characters after the byte `from`, or the end of the line.
    std::size_t Offset(std::size_t from, std::size_t characters) const {
        std::size_t at = from;
        while (at < m_text.size() && characters > 0) {
            ++at;
            while (at < m_text.size() && (static_cast<unsigned char>(m_text[at]) & 0xC0) == 0x80)
                ++at;
            --characters;
        }
        return at;
    }
    std::string_view m_text;
    bool m_ascii;
};

std::string_view Columns(std::string_view line, std::size_t first, std::size_t count) {
    return Line(line).Columns(first, count);
}

std::string_view Field(std::string_view line, std::size_t first, std::size_t count) {
    return Trimmed(Columns(line, first, count));
}

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

void Keep(Record& record, Value value) {
    if (value.type.empty() && value.number.empty() && value.unit.empty()) return;
    record.values[record.valueCount++] = value;
}

bool StartsWithWord(std::string_view text, std::string_view word) {
    return text.starts_with(word) && (text.size() == word.size() || text[word.size()] == ' ');
}

// The point and code of an information block, at their places (counted from 1) and widths.
std::string_view InfoPart(std::string_view info, int place, std::size_t width) {
    if (place < 1) return {};
    return Field(info, static_cast<std::size_t>(place - 1), width);
}

} // namespace

Layout LayoutOf(std::string_view line) {
    if (line.size() < 6 || !line.starts_with("For")) return Layout::Unknown;
    if (line[3] != ' ' && line[3] != '_') return Layout::Unknown;
    const std::string_view name = line.substr(4, 2);
    if (name == "M5") return Layout::M5;
    if (name == "R4") return Layout::R4;
    if (name == "R5") return Layout::R5;
    return Layout::Unknown;
}

bool SplitM5(std::string_view line, const InfoPlaces& places, Record& record) {
    record = Record{};
    record.layout = Layout::M5;
    const Line cut(line);
    const std::string_view kind = cut.Columns(kM5Kind, 3);
    const std::string_view info = cut.Columns(kM5Info, kM5InfoWidth);
    if (kind.starts_with("TI") || kind.starts_with("TO")) {
        record.text = true;
        record.words = Trimmed(info);
    } else if (kind.size() == 3 && kind.starts_with("PI") && IsDigit(kind[2])) {
        record.point = InfoPart(info, places.point, kPointWidth);
        record.code = InfoPart(info, places.code, kCodeWidth);
        record.information = InfoPart(info, places.information, kInformationWidth);
    } else {
        return false;
    }
    for (std::size_t block = 0; block < 3; ++block) {
        const std::size_t first = kM5FirstBlock + block * kM5BlockWidth;
        Keep(record, {cut.Field(first, 2), cut.Field(first + 3, 14), cut.Field(first + 18, 4)});
    }
    record.errorFlag = !cut.Field(kM5ErrorFlag, 1).empty();
    return true;
}

std::optional<std::string> M5InfoOccupancy(std::string_view line) {
    if (LayoutOf(line) != Layout::M5) return std::nullopt;
    const Line cut(line);
    const std::string_view kind = cut.Columns(kM5Kind, 3);
    if (kind.size() != 3 || !kind.starts_with("PI") || !IsDigit(kind[2])) return std::nullopt;
    std::string occupied;
    const std::string_view info = cut.Columns(kM5Info, kM5InfoWidth);
    for (std::size_t at = 0; at < info.size(); ++at) {
        if ((static_cast<unsigned char>(info[at]) & 0xC0) == 0x80) continue; // the rest of a letter
        occupied += info[at] == ' ' ? ' ' : 'x';
    }
    return occupied;
}

bool SplitR4R5(std::string_view line, bool withAddress, Record& record) {
    record = Record{};
    record.layout = withAddress ? Layout::R5 : Layout::R4;
    std::array<std::string_view, 8> fields{};
    std::size_t count = 0;
    while (count < fields.size()) {
        const std::size_t bar = line.find('|');
        fields[count++] = line.substr(0, bar);
        if (bar == std::string_view::npos) break;
        line.remove_prefix(bar + 1);
    }
    std::size_t next = withAddress ? 2 : 1;
    if (count <= next) return false;
    if (withAddress && !Trimmed(fields[1]).starts_with("Adr")) return false;

    std::string_view ident = Trimmed(fields[next++]);
    if (StartsWithWord(ident, "TI") || StartsWithWord(ident, "TO")) {
        record.text = true;
        record.words = Trimmed(ident.substr(2));
    } else {
        if (ident.size() >= 3 && ident.starts_with("PI") && IsDigit(ident[2]))
            ident = Trimmed(ident.substr(3));
        const std::size_t blank = ident.find(' ');
        record.point = ident.substr(0, blank);
        if (blank != std::string_view::npos) record.code = Trimmed(ident.substr(blank));
    }
    for (std::size_t block = 0; block < 3 && next < count; ++block, ++next) {
        const std::string_view field = Trimmed(fields[next]);
        const std::string_view rest = Trimmed(Columns(field, 2, field.size()));
        const std::size_t blank = rest.find(' ');
        const std::string_view unit =
            blank == std::string_view::npos ? std::string_view{} : rest.substr(blank);
        Keep(record, {Field(field, 0, 2), rest.substr(0, blank), Trimmed(unit)});
    }
    if (next < count) record.errorFlag = !Trimmed(fields[next]).empty();
    return true;
}

bool SplitRec500(std::string_view line, Record& record) {
    record = Record{};
    record.layout = Layout::Rec500;
    const Line cut(line);
    const std::string_view address = cut.Columns(0, kRecAddressWidth);
    bool digits = false;
    for (char c : address) {
        if (IsDigit(c))
            digits = true;
        else if (c != ' ')
            return false;
    }
    if (!digits) return false;
    if (!cut.Field(kRecText - 1, 2).empty()) {
        record.text = true;
        record.words = cut.Field(kRecText - 1, kRecCodeEnd - kRecText + 1);
    } else {
        record.point = cut.Field(kRecText, kRecPointEnd - kRecText);
        record.code = cut.Field(kRecPointEnd, kRecCodeEnd - kRecPointEnd);
    }
    for (std::size_t block = 0; block < 3; ++block) {
        const std::size_t first = kRecBlocks[block];
        const std::size_t end = block + 1 < 3 ? kRecBlocks[block + 1] : cut.Size();
        if (first >= end) break;
        Keep(record, {cut.Field(first, 2), cut.Field(first + 2, end - first - 2), {}});
    }
    return true;
}

} // namespace pyr::zeiss

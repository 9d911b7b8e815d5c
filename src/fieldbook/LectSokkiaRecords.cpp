#include "fieldbook/LectSokkiaRecords.h"

#include "core/Strings.h"
#include "core/TextEncoding.h"

#include <algorithm>

namespace pyr::sdr {

namespace {

constexpr int kFirstField = 5; // columns 1-2 the type, 3-4 the derivation code
constexpr int kDescriptionWidth = 16;
constexpr int kNoteWidth = 60;

constexpr Layout kStation{
    6,
    {FieldKind::Id, FieldKind::Real, FieldKind::Real, FieldKind::Real, FieldKind::Real, FieldKind::Text},
    kDescriptionWidth};
constexpr Layout kTargetHeight{1, {FieldKind::Real}, 0};
constexpr Layout kBacksight{4, {FieldKind::Id, FieldKind::Id, FieldKind::Real, FieldKind::Real}, 0};
constexpr Layout kCoordinates{
    5,
    {FieldKind::Id, FieldKind::Real, FieldKind::Real, FieldKind::Real, FieldKind::Text},
    kDescriptionWidth};
constexpr Layout kObservation{
    6,
    {FieldKind::Id, FieldKind::Id, FieldKind::Real, FieldKind::Real, FieldKind::Real, FieldKind::Text},
    kDescriptionWidth};
constexpr Layout kNote{1, {FieldKind::Text}, kNoteWidth};

int Width(FieldKind kind, Variant variant, const Layout& layout) {
    switch (kind) {
    case FieldKind::Id:
        return variant == Variant::Sdr33 ? 16 : 4;
    case FieldKind::Real:
        return variant == Variant::Sdr33 ? 16 : 10;
    case FieldKind::Text:
        return layout.textWidth;
    }
    return 0;
}

} // namespace

const Layout* LayoutOf(std::string_view type) {
    if (type == "02") return &kStation;
    if (type == "03") return &kTargetHeight;
    if (type == "07") return &kBacksight;
    if (type == "08") return &kCoordinates;
    if (type == "09") return &kObservation;
    if (type == "13") return &kNote;
    return nullptr;
}

int RecordLength(const Layout& layout, Variant variant) {
    int length = kFirstField - 1;
    for (int i = 0; i < layout.count; ++i)
        length += Width(layout.kinds[static_cast<std::size_t>(i)], variant, layout);
    return length;
}

namespace {

// The byte offset `count` characters after `from`, bounded by the line's end. Columns count characters:
// an accented letter of a Latin-1 book, two bytes once read, is one column.
std::size_t Advance(std::string_view line, std::size_t from, int count) {
    std::size_t i = from;
    for (; count > 0 && i < line.size(); --count) {
        ++i;
        while (i < line.size() && (static_cast<unsigned char>(line[i]) & 0xC0) == 0x80)
            ++i;
    }
    return i;
}

} // namespace

std::string_view Column(std::string_view line, int first, int width) {
    const std::size_t start = Advance(line, 0, first - 1);
    return Trimmed(line.substr(start, Advance(line, start, width) - start));
}

std::string_view From(std::string_view line, int first) {
    return line.substr(Advance(line, 0, first - 1));
}

void SplitRecord(std::string_view line, const Layout& layout, Variant variant, Fields& fields) {
    // In a line of ASCII, the most common by far, a column is a byte.
    const bool ascii = IsAscii(line);
    const auto advance = [&](std::size_t from, int count) {
        return ascii ? std::min(line.size(), from + static_cast<std::size_t>(count))
                     : Advance(line, from, count);
    };
    std::size_t start = advance(0, kFirstField - 1);
    for (int i = 0; i < layout.count; ++i) {
        const FieldKind kind = layout.kinds[static_cast<std::size_t>(i)];
        const std::size_t end =
            kind == FieldKind::Text ? line.size() : advance(start, Width(kind, variant, layout));
        fields.text[static_cast<std::size_t>(i)] = Trimmed(line.substr(start, end - start));
        start = end;
    }
}

Variant GuessVariant(std::string_view line, const Layout& layout) {
    if (Column(line, kFirstField, 4).empty()) return Variant::Sdr33;
    const std::string_view content = line.substr(0, line.find_last_not_of(' ') + 1);
    return static_cast<int>(Utf8Length(content)) > RecordLength(layout, Variant::Sdr2x) ? Variant::Sdr33
                                                                                        : Variant::Sdr2x;
}

void Checksum::AddLine(std::string_view line) {
    for (std::size_t i = 0; i < line.size(); ++i) {
        const auto c = static_cast<unsigned char>(line[i]);
        m_bytes += c;
        // A Latin-1 letter that the reading brought to UTF-8 (two bytes, C2 or C3 first) was one byte
        // when the collector summed it.
        if ((c == 0xC2 || c == 0xC3) && i + 1 < line.size()) {
            const auto next = static_cast<unsigned char>(line[++i]);
            m_bytes += next;
            m_latin1 += static_cast<unsigned>((c & 0x1F) << 6 | (next & 0x3F));
        } else {
            m_latin1 += c;
        }
    }
    ++m_lines;
}

bool Checksum::Matches(unsigned value) const {
    for (std::uint64_t sum : {m_bytes, m_latin1})
        for (std::uint64_t lineEnd : {0u, 10u, 23u})
            for (std::uint64_t lines : {m_lines, m_lines + 1})
                if ((sum + lineEnd * lines) % 65536 == value) return true;
    return false;
}

} // namespace pyr::sdr

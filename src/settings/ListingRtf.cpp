#include "core/TextEncoding.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <cstdint>
#include <string>

// The rich-text side of the listing: the document's prologue, titles and tables in RTF 1.5, readable by
// every word processor. Text lines are set in a fixed-pitch font so that the columns of the plain-text
// patterns stay aligned; tables are real RTF tables.
namespace pyr {

namespace {

// One character of the fixed-pitch font at 10 points (6 points wide), in twips.
constexpr int kTwipsPerCharacter = 120;
// Space between a cell's text and its borders, on each side, in twips.
constexpr int kCellGap = 60;
constexpr int kDefaultColumnWidth = 10;

// Windows-1252 bytes 0x80 to 0x9F and the characters they stand for (0 where the byte is unused).
constexpr char32_t kWindows1252High[32] = {0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,
                                           0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0,      0x017D, 0,
                                           0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,
                                           0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

int Windows1252Byte(char32_t c) {
    if (c >= 0xA0 && c <= 0xFF) return static_cast<int>(c);
    for (int i = 0; i < 32; ++i)
        if (kWindows1252High[i] == c) return 0x80 + i;
    return -1;
}

// Decodes one character of valid UTF-8 at `i`, moving past it.
char32_t NextCodePoint(std::string_view text, std::size_t& i) {
    const auto byte = [&](std::size_t k) { return static_cast<std::uint8_t>(text[k]); };
    std::uint8_t lead = byte(i);
    int extra = lead < 0x80 ? 0 : lead < 0xE0 ? 1 : lead < 0xF0 ? 2 : 3;
    char32_t c = extra == 0 ? lead : lead & (0x3F >> extra);
    for (int k = 1; k <= extra; ++k)
        c = (c << 6) | (byte(i + static_cast<std::size_t>(k)) & 0x3F);
    i += static_cast<std::size_t>(extra) + 1;
    return c;
}

void AppendUnicode(std::string& out, char32_t c) {
    // RTF writes a 16-bit signed number; characters beyond it go as a UTF-16 surrogate pair.
    const auto unit = [&](unsigned u) {
        out += "\\u" + std::to_string(u > 0x7FFF ? static_cast<int>(u) - 0x10000 : static_cast<int>(u)) + "?";
    };
    if (c > 0xFFFF) {
        c -= 0x10000;
        unit(0xD800 + static_cast<unsigned>(c >> 10));
        unit(0xDC00 + static_cast<unsigned>(c & 0x3FF));
    } else {
        unit(static_cast<unsigned>(c));
    }
}

const char* AlignWord(RtfAlign align) {
    switch (align) {
    case RtfAlign::Center:
        return "\\qc";
    case RtfAlign::Right:
        return "\\qr";
    default:
        return "\\ql";
    }
}

} // namespace

std::string RtfEscape(std::string_view text) {
    std::string utf8 = IsValidUtf8(text) ? std::string(text) : Windows1252ToUtf8(text);
    std::string out;
    out.reserve(utf8.size() + 16);
    static const char kHex[] = "0123456789abcdef";
    for (std::size_t i = 0; i < utf8.size();) {
        char32_t c = NextCodePoint(utf8, i);
        if (c == '\\' || c == '{' || c == '}') {
            out += '\\';
            out += static_cast<char>(c);
        } else if (c == '\n') {
            out += "\\line ";
        } else if (c == '\t') {
            out += "\\tab ";
        } else if (c < 0x20 || c == 0x7F) {
            // other control characters have no place in a listing
        } else if (c < 0x80) {
            out += static_cast<char>(c);
        } else if (int b = Windows1252Byte(c); b >= 0) {
            out += "\\'";
            out += kHex[b >> 4];
            out += kHex[b & 15];
        } else {
            AppendUnicode(out, c);
        }
    }
    return out;
}

void CDlgCfgListing::rtfInit() {
    if (m_documentStarted || !IsRichText() || !m_writer || m_output != ListingOutput::File) return;
    m_documentStarted = true; // before Raw, which would come back here
    std::string prologue =
        "{\\rtf1\\ansi\\ansicpg1252\\deff0\\uc1\n"
        "{\\fonttbl{\\f0\\fmodern\\fcharset0 Courier New;}{\\f1\\fswiss\\fcharset0 Arial;}"
        "{\\f2\\fnil\\fcharset2 Wingdings;}}\n"
        "{\\colortbl;\\red0\\green0\\blue0;\\red192\\green0\\blue0;\\red0\\green128\\blue0;"
        "\\red0\\green0\\blue192;\\red128\\green128\\blue128;}\n"
        // A4, margins of 2 cm
        "\\paperw11906\\paperh16838\\margl1134\\margr1134\\margt1134\\margb1134\n"
        "{\\header\\pard\\plain\\f1\\fs16 PYRALIS Calculs Topo\\par}\n";
    if (m_pageCount)
        prologue +=
            "{\\footer\\pard\\qc\\plain\\f1\\fs16 Page {\\field{\\*\\fldinst PAGE}{\\fldrslt 1}}\\par}\n";
    Raw(prologue);
}

void CDlgCfgListing::rtfWriteLstTitle(std::string_view title) {
    if (m_lineOpen) EndLine();
    if (!IsRichText()) {
        Emit(SepLine(0) + "\n" + std::string(1, m_titleFrame) + CenterString(title, m_pageWidth - 2) +
             std::string(1, m_titleFrame) + "\n" + SepLine(0) + "\n");
        return;
    }
    Raw("\\pard\\qc\\box\\brdrs\\brdrw15\\brsp80\\sa240\\plain\\f1\\fs28\\b " + RtfEscape(title) +
        "\\par\n\\pard\\plain\\par\n");
    m_lineCount += 2;
}

void CDlgCfgListing::rtfWriteTabTitle(std::string_view title) {
    if (m_lineOpen) EndLine();
    if (!IsRichText()) {
        Emit(std::string(title) + "\n" + std::string(Utf8Length(title), '-') + "\n");
        return;
    }
    Raw("\\pard\\keepn\\sb120\\sa60\\plain\\f1\\fs22\\b\\ul " + RtfEscape(title) + "\\par\n");
    ++m_lineCount;
}

// --- Tables ----------------------------------------------------------------------------------------------

void CDlgCfgListing::rtfInitTab(int rows, int cols) {
    m_rows = std::max(rows, 0);
    m_colWidths.assign(static_cast<std::size_t>(std::max(cols, 0)), kDefaultColumnWidth);
    m_cells.assign(static_cast<std::size_t>(m_rows) * m_colWidths.size(), RtfCell{});
}

template <class Apply>
void CDlgCfgListing::ForCells(int row, int col, Apply apply) {
    // Only the cells named are visited: filling a table cell by cell stays linear in its size.
    const int cols = static_cast<int>(m_colWidths.size());
    const int firstRow = row < 0 ? 0 : row, endRow = row < 0 ? m_rows : std::min(row + 1, m_rows);
    const int firstCol = col < 0 ? 0 : col, endCol = col < 0 ? cols : std::min(col + 1, cols);
    for (int r = firstRow; r < endRow; ++r)
        for (int c = firstCol; c < endCol; ++c)
            apply(m_cells[static_cast<std::size_t>(r * cols + c)]);
}

void CDlgCfgListing::rtfSetColWidth(int col, int characters) {
    for (std::size_t c = 0; c < m_colWidths.size(); ++c)
        if (col < 0 || static_cast<std::size_t>(col) == c) m_colWidths[c] = std::max(characters, 1);
}
void CDlgCfgListing::rtfSetCellValue(int row, int col, std::string_view text) {
    ForCells(row, col, [&](RtfCell& cell) { cell.text = text; });
}
void CDlgCfgListing::rtfSetCellAlign(int row, int col, RtfAlign align) {
    ForCells(row, col, [&](RtfCell& cell) { cell.align = align; });
}
void CDlgCfgListing::rtfSetCellBorder(int row, int col, unsigned borders) {
    ForCells(row, col, [&](RtfCell& cell) { cell.borders = borders & kRtfBorderAll; });
}
void CDlgCfgListing::rtfSetCellColor(int row, int col, RtfColor color) {
    ForCells(row, col, [&](RtfCell& cell) { cell.color = color; });
}
void CDlgCfgListing::rtfSetCellFont(int row, int col, RtfFont font, int points) {
    ForCells(row, col, [&](RtfCell& cell) {
        cell.font = font;
        cell.points = std::clamp(points, 4, 72);
    });
}
void CDlgCfgListing::rtfSetCellShading(int row, int col, int percent) {
    ForCells(row, col, [&](RtfCell& cell) { cell.shading = std::clamp(percent, 0, 100); });
}
void CDlgCfgListing::rtfSetCellStyle(int row, int col, unsigned style) {
    ForCells(row, col, [&](RtfCell& cell) { cell.style = style; });
}
void CDlgCfgListing::rtfOffsetLeft(int characters) {
    m_offsetLeft = std::max(characters, 0);
}

// A row of a table in plain text: "| cell | cell |", each cell padded to its column's width.
void CDlgCfgListing::AppendPlainTableRow(std::string& line, std::span<const std::string_view> texts,
                                         std::span<const std::size_t> lengths, std::span<const int> widths,
                                         std::span<const RtfAlign> aligns) const {
    line.append(static_cast<std::size_t>(m_offsetLeft), ' ');
    line += '|';
    for (std::size_t c = 0; c < texts.size(); ++c) {
        const int blanks = std::max(0, widths[c] - static_cast<int>(lengths[c]));
        const int before = aligns[c] == RtfAlign::Right    ? blanks
                           : aligns[c] == RtfAlign::Center ? blanks / 2
                                                           : 0;
        line += ' ';
        line.append(static_cast<std::size_t>(before), ' ');
        line += texts[c];
        line.append(static_cast<std::size_t>(blanks - before), ' ');
        line += " |";
    }
}

int CDlgCfgListing::WritePlainTableRow(std::span<const std::string_view> texts, std::span<const int> widths,
                                       std::span<const RtfAlign> aligns) {
    m_lengths.resize(texts.size());
    for (std::size_t c = 0; c < texts.size(); ++c)
        m_lengths[c] = Utf8Length(texts[c]);
    return WritePlainTableRow(texts, m_lengths, widths, aligns);
}

int CDlgCfgListing::WritePlainTableRow(std::span<const std::string_view> texts,
                                       std::span<const std::size_t> lengths, std::span<const int> widths,
                                       std::span<const RtfAlign> aligns) {
    if (m_lineOpen) EndLine();
    const bool oneLine = std::none_of(texts.begin(), texts.end(), [](std::string_view text) {
        return text.find('\n') != std::string_view::npos;
    });
    if (!oneLine) {
        m_row.clear();
        AppendPlainTableRow(m_row, texts, lengths, widths, aligns);
        m_row += '\n';
        return Emit(m_row);
    }
    BreakPageIfFull();
    if (m_output == ListingOutput::File && m_writer && !m_echo) {
        // Formed straight into what goes to the file.
        AppendPlainTableRow(m_buffer, texts, lengths, widths, aligns);
        m_buffer += '\n';
        ++m_lineCount;
        if (m_buffer.size() >= kBufferBytes) Flush();
        return 1;
    }
    m_lineOpen = true;
    AppendPlainTableRow(m_pending, texts, lengths, widths, aligns);
    EndLine();
    return 1;
}

int CDlgCfgListing::rtfDrawTab() {
    if (m_lineOpen) EndLine();
    const int cols = static_cast<int>(m_colWidths.size());
    if (m_rows == 0 || cols == 0) return 0;
    if (!IsRichText()) {
        std::vector<std::string_view> texts(static_cast<std::size_t>(cols));
        std::vector<RtfAlign> aligns(static_cast<std::size_t>(cols));
        int lines = 0;
        for (int r = 0; r < m_rows; ++r) {
            for (std::size_t c = 0; c < texts.size(); ++c) {
                const RtfCell& cell = m_cells[static_cast<std::size_t>(r * cols) + c];
                texts[c] = cell.text;
                aligns[c] = cell.align;
            }
            lines += WritePlainTableRow(texts, m_colWidths, aligns);
        }
        return lines;
    }
    std::string rtf;
    for (int r = 0; r < m_rows; ++r) {
        rtf += "\\trowd\\trgaph" + std::to_string(kCellGap) + "\\trleft" +
               std::to_string(m_offsetLeft * kTwipsPerCharacter) + "\n";
        int right = m_offsetLeft * kTwipsPerCharacter;
        for (int c = 0; c < cols; ++c) {
            const RtfCell& cell = m_cells[static_cast<std::size_t>(r * cols + c)];
            static constexpr const char* kBorderWords[4] = {"\\clbrdrt", "\\clbrdrb", "\\clbrdrl",
                                                            "\\clbrdrr"};
            for (unsigned side = 0; side < 4; ++side)
                if (cell.borders & (1u << side)) rtf += std::string(kBorderWords[side]) + "\\brdrs\\brdrw10";
            if (cell.shading > 0) rtf += "\\clshdng" + std::to_string(cell.shading * 100);
            right += m_colWidths[static_cast<std::size_t>(c)] * kTwipsPerCharacter + 2 * kCellGap;
            rtf += "\\cellx" + std::to_string(right) + "\n";
        }
        for (int c = 0; c < cols; ++c) {
            const RtfCell& cell = m_cells[static_cast<std::size_t>(r * cols + c)];
            rtf += "\\pard\\intbl" + std::string(AlignWord(cell.align)) + "{\\plain\\f" +
                   std::to_string(static_cast<int>(cell.font)) + "\\fs" + std::to_string(cell.points * 2) +
                   "\\cf" + std::to_string(static_cast<int>(cell.color));
            if (cell.style & kRtfBold) rtf += "\\b";
            if (cell.style & kRtfItalic) rtf += "\\i";
            if (cell.style & kRtfUnderline) rtf += "\\ul";
            rtf += " " + RtfEscape(cell.text) + "}\\cell\n";
        }
        rtf += "\\row\n";
    }
    Raw(rtf + "\\pard\\plain\n");
    m_lineCount += m_rows;
    return m_rows;
}

} // namespace pyr

#include "calc/ListingTables.h"

#include "core/TextEncoding.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <span>
#include <string_view>

namespace pyr {

namespace {

// What drawing a table needs beside its texts, kept from one table to the next: a listing draws a
// hundred thousand small tables.
struct DrawScratch {
    std::vector<int> widths;
    std::vector<RtfAlign> aligns;
    std::vector<RtfAlign> centred;
    std::vector<std::string_view> texts;
    std::vector<std::size_t> lengths; // of every text, in characters, row after row
};

// A table of `rows` rows and `columns` columns whose text at (row, column) is text(r, c).
template <class Text>
void Draw(CDlgCfgListing& listing, std::size_t rows, std::size_t columns, Text text, bool heading,
          std::size_t textColumns, bool bold) {
    if (rows == 0) return;
    thread_local DrawScratch scratch;
    std::vector<int>& widths = scratch.widths;
    std::vector<RtfAlign>& aligns = scratch.aligns;
    std::vector<std::size_t>& lengths = scratch.lengths;
    widths.assign(columns, 1);
    aligns.assign(columns, RtfAlign::Left);
    lengths.resize(rows * columns);
    for (std::size_t r = 0; r < rows; ++r)
        for (std::size_t c = 0; c < columns; ++c) {
            const std::size_t length = Utf8Length(text(r, c));
            lengths[r * columns + c] = length;
            widths[c] = std::max(widths[c], static_cast<int>(length));
        }
    for (std::size_t c = textColumns; c < columns; ++c)
        aligns[c] = RtfAlign::Right;
    if (!listing.IsRichText() && columns > 0) {
        // Each row written as it is formed: a table of a hundred thousand rows needs no cells.
        std::vector<std::string_view>& texts = scratch.texts;
        texts.resize(columns);
        scratch.centred.assign(columns, RtfAlign::Center);
        for (std::size_t r = 0; r < rows; ++r) {
            for (std::size_t c = 0; c < columns; ++c)
                texts[c] = text(r, c);
            listing.WritePlainTableRow(texts, std::span(lengths).subspan(r * columns, columns), widths,
                                       heading && r == 0 ? scratch.centred : aligns);
        }
        return;
    }
    listing.rtfInitTab(static_cast<int>(rows), static_cast<int>(columns));
    for (std::size_t c = 0; c < columns; ++c) {
        listing.rtfSetColWidth(static_cast<int>(c), widths[c]);
        if (c >= textColumns) listing.rtfSetCellAlign(-1, static_cast<int>(c), RtfAlign::Right);
    }
    for (std::size_t r = 0; r < rows; ++r)
        for (std::size_t c = 0; c < columns; ++c)
            listing.rtfSetCellValue(static_cast<int>(r), static_cast<int>(c), text(r, c));
    if (heading) {
        listing.rtfSetCellStyle(0, -1, kRtfBold);
        listing.rtfSetCellShading(0, -1, 10);
        listing.rtfSetCellAlign(0, -1, RtfAlign::Center);
    }
    if (bold) listing.rtfSetCellStyle(-1, -1, kRtfBold);
    listing.rtfDrawTab();
}

} // namespace

void DrawTable(CDlgCfgListing& listing, const std::vector<ListingRow>& rows, bool heading,
               std::size_t textColumns, bool bold) {
    if (rows.empty()) return;
    Draw(
        listing, rows.size(), rows.front().size(),
        [&rows](std::size_t r, std::size_t c) -> std::string_view { return rows[r][c]; }, heading,
        textColumns, bold);
}

void DrawTable(CDlgCfgListing& listing, const ListingTable& table, bool heading, std::size_t textColumns,
               bool bold) {
    Draw(
        listing, table.Rows(), table.Columns(),
        [&table](std::size_t r, std::size_t c) { return table.Text(r, c); }, heading, textColumns, bold);
}

void DrawFrame(CDlgCfgListing& listing, const ListingRow& lines, bool bold) {
    std::vector<ListingRow> rows;
    for (const std::string& line : lines)
        rows.push_back({line});
    DrawTable(listing, rows, false, 1, bold);
}

void Blank(CDlgCfgListing& listing) {
    listing.WriteText("\n");
}

} // namespace pyr

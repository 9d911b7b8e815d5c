#include "calc/ListingTables.h"

#include "core/TextEncoding.h"
#include "settings/ListingObject.h"

#include <algorithm>
#include <string_view>

namespace pyr {

namespace {

// A table of `rows` rows and `columns` columns whose text at (row, column) is text(r, c).
template <class Text>
void Draw(CDlgCfgListing& listing, std::size_t rows, std::size_t columns, Text text, bool heading,
          std::size_t textColumns, bool bold) {
    if (rows == 0) return;
    std::vector<int> widths(columns, 1);
    std::vector<RtfAlign> aligns(columns, RtfAlign::Left);
    for (std::size_t c = 0; c < columns; ++c) {
        std::size_t width = 1;
        for (std::size_t r = 0; r < rows; ++r)
            width = std::max(width, Utf8Length(text(r, c)));
        widths[c] = static_cast<int>(width);
        if (c >= textColumns) aligns[c] = RtfAlign::Right;
    }
    if (!listing.IsRichText() && columns > 0) {
        // Each row written as it is formed: a table of a hundred thousand rows needs no cells.
        std::vector<std::string_view> texts(columns);
        const std::vector<RtfAlign> centred(columns, RtfAlign::Center);
        for (std::size_t r = 0; r < rows; ++r) {
            for (std::size_t c = 0; c < columns; ++c)
                texts[c] = text(r, c);
            listing.WritePlainTableRow(texts, widths, heading && r == 0 ? centred : aligns);
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
        listing, table.rows, table.columns,
        [&table](std::size_t r, std::size_t c) -> std::string_view {
            return table.texts[r * table.columns + c];
        },
        heading, textColumns, bold);
}

void DrawFrame(CDlgCfgListing& listing, const ListingRow& lines, bool bold) {
    std::vector<ListingRow> rows;
    for (const std::string& line : lines)
        rows.push_back({line});
    DrawTable(listing, rows, false, 1, bold);
}

void Blank(CDlgCfgListing& listing) {
    listing.WriteLine("\n");
}

} // namespace pyr

#include "calc/ListingTables.h"

#include "core/TextEncoding.h"
#include "settings/ListingObject.h"

#include <algorithm>

namespace pyr {

void DrawTable(CDlgCfgListing& listing, const std::vector<ListingRow>& rows, bool heading,
               std::size_t textColumns, bool bold) {
    if (rows.empty()) return;
    const std::size_t columns = rows.front().size();
    listing.rtfInitTab(static_cast<int>(rows.size()), static_cast<int>(columns));
    for (std::size_t c = 0; c < columns; ++c) {
        std::size_t width = 1;
        for (const ListingRow& row : rows)
            width = std::max(width, Utf8Length(row[c]));
        listing.rtfSetColWidth(static_cast<int>(c), static_cast<int>(width));
        if (c >= textColumns) listing.rtfSetCellAlign(-1, static_cast<int>(c), RtfAlign::Right);
    }
    for (std::size_t r = 0; r < rows.size(); ++r)
        for (std::size_t c = 0; c < columns; ++c)
            listing.rtfSetCellValue(static_cast<int>(r), static_cast<int>(c), rows[r][c]);
    if (heading) {
        listing.rtfSetCellStyle(0, -1, kRtfBold);
        listing.rtfSetCellShading(0, -1, 10);
        listing.rtfSetCellAlign(0, -1, RtfAlign::Center);
    }
    if (bold) listing.rtfSetCellStyle(-1, -1, kRtfBold);
    listing.rtfDrawTab();
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

#pragma once

#include <cstddef>
#include <string>
#include <vector>

// The tables of the computations' listings: drawn with '|' in plain text, as real tables in rich text.
namespace pyr {

class CDlgCfgListing;

using ListingRow = std::vector<std::string>;

// A table whose columns are as wide as their widest text; the first row, when `heading`, is the
// columns' titles. Texts are left-aligned in the first `textColumns` columns, numbers on the right.
void DrawTable(CDlgCfgListing& listing, const std::vector<ListingRow>& rows, bool heading,
               std::size_t textColumns, bool bold = false);

// Lines framed as one column: "| Remarques |".
void DrawFrame(CDlgCfgListing& listing, const ListingRow& lines, bool bold);

// An empty line.
void Blank(CDlgCfgListing& listing);

} // namespace pyr

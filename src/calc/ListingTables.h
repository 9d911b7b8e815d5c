#pragma once

#include <cstddef>
#include <string>
#include <vector>

// The tables of the computations' listings: drawn with '|' in plain text, as real tables in rich text.
namespace pyr {

class CDlgCfgListing;

using ListingRow = std::vector<std::string>;

// A table's texts in one block, row after row, `columns` texts a row: a listing of many stations fills
// one again and again without a block of memory for each row.
struct ListingTable {
    std::size_t columns = 0;
    std::vector<std::string> texts;
    std::size_t rows = 0; // the rows in use; texts beyond them are kept for the next table

    // Starts a table of that many columns; the texts of the rows added are to be set.
    void Clear(std::size_t columnCount) {
        columns = columnCount;
        rows = 0;
    }
    // The texts of a new row.
    std::string* AddRow() {
        if (texts.size() < (rows + 1) * columns) texts.resize((rows + 1) * columns);
        return &texts[rows++ * columns];
    }
};

// A table whose columns are as wide as their widest text; the first row, when `heading`, is the
// columns' titles. Texts are left-aligned in the first `textColumns` columns, numbers on the right.
void DrawTable(CDlgCfgListing& listing, const std::vector<ListingRow>& rows, bool heading,
               std::size_t textColumns, bool bold = false);
void DrawTable(CDlgCfgListing& listing, const ListingTable& table, bool heading, std::size_t textColumns,
               bool bold = false);

// Lines framed as one column: "| Remarques |".
void DrawFrame(CDlgCfgListing& listing, const ListingRow& lines, bool bold);

// An empty line.
void Blank(CDlgCfgListing& listing);

} // namespace pyr

#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// The tables of the computations' listings: drawn with '|' in plain text, as real tables in rich text.
namespace pyr {

class CDlgCfgListing;

using ListingRow = std::vector<std::string>;

// A table's texts in one block of characters, row after row, `columns` texts a row: a listing of a million
// rows fills one again and again without a string for each text.
class ListingTable {
public:
    // Starts a table of that many columns, keeping the room of the last one.
    void Clear(std::size_t columns) {
        m_columns = columns;
        m_chars.clear();
        m_ends.clear();
    }
    // The text of the next cell, the rows filled in order.
    void Add(std::string_view text) {
        m_chars += text;
        m_ends.push_back(m_chars.size());
    }
    template <class Texts>
    void AddRow(const Texts& texts) {
        for (const auto& text : texts)
            Add(text);
    }

    std::size_t Columns() const { return m_columns; }
    std::size_t Rows() const { return m_columns == 0 ? 0 : m_ends.size() / m_columns; }
    std::string_view Text(std::size_t row, std::size_t column) const {
        const std::size_t cell = row * m_columns + column;
        const std::size_t begin = cell == 0 ? 0 : m_ends[cell - 1];
        return std::string_view(m_chars).substr(begin, m_ends[cell] - begin);
    }

private:
    std::size_t m_columns = 0;
    std::string m_chars;
    std::vector<std::size_t> m_ends; // where each text ends in m_chars
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

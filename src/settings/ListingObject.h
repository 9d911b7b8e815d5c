#pragma once

#include "core/SafeFile.h"
#include "ui/FrontEnd.h"

#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

// The listing object: writes the report of a computation into a file, as plain text cut into numbered
// pages or as a rich-text (RTF) document with real tables, and formats its numbers. One is held by each
// computation dialog; ListingFlow.h runs the steps every computation shares.
namespace pyr {

// The listing's own settings in the parameter store.
inline constexpr const char* kSectionListingLayout = "Listings";
inline constexpr const char* kKeyListingFormat = "Format";
inline constexpr const char* kKeyPageLength = "LongueurPage"; // lines
inline constexpr const char* kKeyPageWidth = "LargeurPage";   // characters

enum ListingFormat : int {
    kListingRichText = 0,       // RTF, laid out in pages by the word processor
    kListingText = 1,           // plain text in numbered pages of fixed length
    kListingTextNoPageCount = 2 // plain text in one run, without page numbers or page breaks
};
inline constexpr int kDefaultListingFormat = kListingText;
inline constexpr int kDefaultPageLength = 70; // an A4 sheet printed at six lines an inch
inline constexpr int kMinPageLength = 20;
inline constexpr int kMaxPageLength = 1000;
inline constexpr int kDefaultPageWidth = 80; // characters of a fixed-pitch font across an A4 sheet
inline constexpr int kMinPageWidth = 40;
inline constexpr int kMaxPageWidth = 400;

// Where the lines go: into the open file (and into the text window while the echo is on), or into the
// text window only.
enum class ListingOutput { File, TextWindow };

// The look of one cell of a rich-text table.
enum class RtfAlign { Left, Center, Right };
enum RtfBorder : unsigned {
    kRtfBorderNone = 0,
    kRtfBorderTop = 1,
    kRtfBorderBottom = 2,
    kRtfBorderLeft = 4,
    kRtfBorderRight = 8,
    kRtfBorderAll = 15
};
enum class RtfColor { Black = 1, Red, Green, Blue, Gray };      // the document's colour table, from 1
enum class RtfFont { Fixed = 0, Proportional = 1, Symbol = 2 }; // Courier New, Arial, Wingdings
enum RtfStyle : unsigned { kRtfPlain = 0, kRtfBold = 1, kRtfItalic = 2, kRtfUnderline = 4 };

struct RtfCell {
    std::string text; // UTF-8
    RtfAlign align = RtfAlign::Left;
    unsigned borders = kRtfBorderAll;
    RtfColor color = RtfColor::Black;
    RtfFont font = RtfFont::Fixed;
    int points = 10; // font size
    int shading = 0; // percent of grey behind the text
    unsigned style = kRtfPlain;
};

// UTF-8 text as RTF: \ { } escaped, Windows-1252 characters as \'xx, any other as \uN? (with '?' for
// readers without Unicode), line ends as \line. Bytes that are not valid UTF-8 are read as Windows-1252.
std::string RtfEscape(std::string_view text);

class CDlgCfgListing {
public:
    // The front end shows the listing once written and receives the echo of the lines.
    explicit CDlgCfgListing(ui::FrontEnd& parent);
    // A listing still open is given up: its file stays as it was before OpenListing.
    ~CDlgCfgListing();
    CDlgCfgListing(const CDlgCfgListing&) = delete;
    CDlgCfgListing& operator=(const CDlgCfgListing&) = delete;

    // --- Settings ------------------------------------------------------------------------------------
    int GetFormat() const { return m_format; }
    bool IsRichText() const { return m_format == kListingRichText; }
    int GetPageLength() const { return m_pageLength; }
    int GetPageWidth() const { return m_pageWidth; }
    // Each brought within its limits.
    void SetFormat(int format);
    void SetPageLength(int lines);
    void SetPageWidth(int characters);
    // Section "Listings": "Format", "LongueurPage", "LargeurPage", with their defaults and limits.
    void ReadLastParameters(std::string_view paramPath);

    // --- Output --------------------------------------------------------------------------------------
    // The GéoBase's folder and name with the computation's extension (given without its dot).
    static std::string GetListingName(const std::string& geobasePath, const std::string& extension);
    // "w" replaces the file, "a" completes it. A rich-text document is always replaced: a second
    // document appended to the first would be unreadable. Output goes to the file from the first page.
    // The listing is written beside the file, into a copy of it for "a", and takes its place only when
    // CloseListing ends it whole: until then, and whatever fails, the file stays as it was. False when
    // the listing cannot be started (Error() tells why).
    bool OpenListing(const std::string& path, std::string_view mode);
    void InitOutput(ListingOutput target);
    // Ends the listing and puts it in place of the file; shows it when `view` is set and it was written.
    // False when something could not be written (a full disk, a size limit): the file stays as it was and
    // Error() tells why.
    bool CloseListing(const std::string& path, bool view);
    void ViewListing(const std::string& path);
    bool IsOpen() const { return m_writer != nullptr; }
    // The errno of the last listing's failure, 0 when none; the French text naming its file and the
    // reason in words.
    int Error() const { return m_error; }
    std::string FailureText() const;

    // --- Pages ---------------------------------------------------------------------------------------
    // With the page count, plain-text pages hold exactly the page length: a line that would not fit
    // above the footer starts a new page (footer, header, then the descriptor) and the footer is pushed
    // to the foot of the page. Without it the listing runs on, with unnumbered headers and footers.
    void SetPageCount(bool on = true) { m_pageCount = on; }
    bool GetPageCount() const { return m_pageCount; }
    void WriteHeader(int page);
    void WriteFooter();
    int GetPage() const { return m_page; }
    int GetLineCount() const { return m_lineCount; } // lines on the current page, its header included

    // --- Text ----------------------------------------------------------------------------------------
    void SetEcho(bool on) { m_echo = on; }
    // printf-style, numbers always with '.', whatever the user's locale. Returns the number of lines
    // ended (the '\n' written); a text without one is continued by the next write.
    int WriteLine(const char* format, ...) __attribute__((format(printf, 2, 3)));
    int WriteText(std::string_view text);
    // A width of -1 follows the page width.
    void SetSepLine1(int width, char c) { m_sep[0] = {width, c}; }
    void SetSepLine2(int width, char c) { m_sep[1] = {width, c}; }
    void SetSepLine3(int width, char c) { m_sep[2] = {width, c}; }
    std::string GetSepLine1() const { return SepLine(0); }
    std::string GetSepLine2() const { return SepLine(1); }
    std::string GetSepLine3() const { return SepLine(2); }
    void SetTitleLine(std::string_view text, char frame);
    std::string GetTitleLine() const; // the text centred between two frame characters, page-wide
    // Plain text: separator line 1, the title line, separator line 1; rich text: the framed title.
    int WriteTitle();
    // The text centred in `width` characters (the page width for -1), blanks on both sides.
    std::string CenterString(std::string_view text, int width = -1) const;
    // Lines repeated at the top of each page that an automatic break starts (a table's column heads).
    void SetDescriptor(std::string text) { m_descriptor = std::move(text); }
    int WriteDescriptor();

    // --- Numbers -------------------------------------------------------------------------------------
    // The decimals follow the store's settings (coordinates and distances: points' XY; altitudes and
    // height differences: points' Z; angles: stations') unless set here; -1 gives them back.
    int GetDeciCoor() const;
    int GetDeciAlti() const;
    int GetDeciDist() const;
    int GetDeciDeni() const;
    int GetDeciAngl() const;
    void SetDeciCoor(int n) { m_deci[0] = n; }
    void SetDeciAlti(int n) { m_deci[1] = n; }
    void SetDeciDist(int n) { m_deci[2] = n; }
    void SetDeciDeni(int n) { m_deci[3] = n; }
    void SetDeciAngl(int n) { m_deci[4] = n; }
    // With that many decimals (-1: the setting's), "-" for the undefined value. A height difference
    // carries its sign, "+" included; an angle in grads is brought into [0, 400) when `wrap` is set.
    std::string FormatCoor(double value, int decimals = -1) const;
    std::string FormatAlti(double value, int decimals = -1) const;
    std::string FormatDist(double value, int decimals = -1) const;
    std::string FormatDeni(double value, int decimals = -1) const;
    std::string FormatAngl(double value, int decimals = -1, bool wrap = false) const;
    // "lundi 03 mars 2025 à 09 h 05 mn"
    static std::string FormatTime();

    // --- Rich text (plain text draws the same tables with '|') ---------------------------------------
    void rtfInit(); // the document's fonts, colours, page and margins; done by the first write
    void rtfWriteLstTitle(std::string_view title);
    void rtfWriteTabTitle(std::string_view title);
    // A new table of empty cells, each column 10 characters wide, every border drawn. A row or a column
    // of -1 in the setters below means all of them.
    void rtfInitTab(int rows, int cols);
    int rtfDrawTab(); // returns the rows written
    void rtfSetColWidth(int col, int characters);
    void rtfSetCellValue(int row, int col, std::string_view text);
    void rtfSetCellAlign(int row, int col, RtfAlign align);
    void rtfSetCellBorder(int row, int col, unsigned borders);
    void rtfSetCellColor(int row, int col, RtfColor color);
    void rtfSetCellFont(int row, int col, RtfFont font, int points = 10);
    void rtfSetCellShading(int row, int col, int percent);
    void rtfSetCellStyle(int row, int col, unsigned style);
    void rtfOffsetLeft(int characters); // of the next tables
    // Plain text only: one row of a table as rtfDrawTab writes it, "| text | text |" after the left
    // offset, each text padded with blanks to its column's width (characters) on the sides its alignment
    // says. For a big table whose texts are at hand, drawn without filling its cells first. `widths` and
    // `aligns` have one item per text. Returns the lines written.
    int WritePlainTableRow(std::span<const std::string_view> texts, std::span<const int> widths,
                           std::span<const RtfAlign> aligns);
    // The same when the texts' lengths in characters are known already.
    int WritePlainTableRow(std::span<const std::string_view> texts, std::span<const std::size_t> lengths,
                           std::span<const int> widths, std::span<const RtfAlign> aligns);

private:
    struct Sep {
        int width;
        char c;
    };
    std::string SepLine(int index) const;
    int Deci(int index, int storeDecimals) const;
    void Raw(std::string_view bytes);
    void Flush(); // what Raw gathered, into the file
    int Emit(std::string_view text, bool mayBreak = true);
    void EndLine();
    void BreakPageIfFull();
    template <class Apply>
    void ForCells(int row, int col, Apply apply);
    void AppendPlainTableRow(std::string& line, std::span<const std::string_view> texts,
                             std::span<const std::size_t> lengths, std::span<const int> widths,
                             std::span<const RtfAlign> aligns) const;

    ui::FrontEnd& m_frontEnd;
    int m_format = kDefaultListingFormat;
    int m_pageLength = kDefaultPageLength;
    int m_pageWidth = kDefaultPageWidth;
    int m_deci[5] = {-1, -1, -1, -1, -1};

    std::unique_ptr<SafeFileWriter> m_writer; // the listing being written, null when none is open
    std::string m_buffer;                     // bytes for m_writer, not yet given to it
    std::string m_fileName;                   // shown in the plain-text header
    // What the listing gathers before writing it to its file: a listing of a million lines goes out in a
    // hundred writes, not in tens of thousands.
    static constexpr std::size_t kBufferBytes = 1 << 20;
    int m_error = 0;
    bool m_documentStarted = false; // the RTF prologue is written
    ListingOutput m_output = ListingOutput::File;
    bool m_echo = true;

    bool m_pageCount = false;
    bool m_inPage = false;
    int m_page = 0;
    int m_lineCount = 0;
    std::string m_pending; // the line being written
    std::string m_row;     // a table's row in plain text, kept to be filled again
    std::vector<std::size_t> m_lengths; // of its texts, in characters
    bool m_lineOpen = false;

    Sep m_sep[3] = {{-1, '='}, {-1, '-'}, {-1, '*'}};
    std::string m_title;
    char m_titleFrame = '#';
    std::string m_descriptor;

    std::vector<RtfCell> m_cells; // row by row
    std::vector<int> m_colWidths; // characters
    int m_rows = 0;
    int m_offsetLeft = 0; // characters
};

} // namespace pyr

#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

// The code table of a job: what the surveyor types as a point's field code ("ARB 4.5", "EXR 0.15") and
// the codification command each code stands for. A field book's codes are interpreted through it into
// the command elements of a GéoBase (the eccentric offsets, the point and symbol commands ...).
namespace pyr {

class CElement;
class CPyrTxtWnd;

// The table every installation ships; a path naming it is neither loaded again nor saved as the table
// of the job.
inline constexpr const char* kDefaultCodeTable = "Defaut.cod";
inline constexpr const char* kCodeTableFilter = "Table de Codes PYRALIS (*.cod)|*.cod||";
inline constexpr const char* kCodeTableExtension = "cod";

// Where the code begins in a point's name field: the separator setting of the table.
inline constexpr const char* kSeparatorUpper = "A...Z"; // the first upper-case letter after the digits
inline constexpr const char* kSeparatorLower = "a...z"; // the first lower-case letter after the digits
inline constexpr const char* kSeparatorSign = "±";      // the first '+' or '-'

class CTableCode {
public:
    CTableCode();
    ~CTableCode();
    CTableCode(const CTableCode&) = delete;
    CTableCode& operator=(const CTableCode&) = delete;

    // Loads the table from its file, replacing what it held. Lines it cannot read are reported with
    // their number in the text window (when given) and skipped. False when the file cannot be read: the
    // table is then empty.
    bool Init(const std::string& path, CPyrTxtWnd* txt = nullptr);
    // Writes the table to a file in its own layout.
    bool Save(const std::string& path) const;
    // The file it was loaded from ("" for a table never loaded).
    const std::string& FileName() const;

    // The separator setting: kSeparatorUpper, kSeparatorLower, kSeparatorSign or any literal text.
    const std::string& Separator() const;
    void SetSeparator(std::string separator);

    // Splits a field code into its words (the code, then its parameters); returns their number.
    int Make_str_cmd(std::string_view text, std::vector<std::string>& words) const;
    // The command element the words stand for, with its kind (1010 to 1065) in `kind`; null when the
    // first word is no code of the table (the caller then keeps the text as an uninterpreted command).
    std::unique_ptr<CElement> InterpreteTexte(const std::vector<std::string>& words, int& kind) const;

private:
    struct Impl;
    std::unique_ptr<Impl> m_impl;
};

// The index in a point's name field at which its code starts, by the table's separator setting; the
// length of the field when no character matches (the whole field is the name).
std::size_t CodePosition(std::string_view nameAndCode, std::string_view separator);

} // namespace pyr

#pragma once

#include "core/SafeFile.h"

#include <cerrno>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

// Initialisation files: "[Section]" lines, then "Clé=valeur" lines. Sections and keys are compared
// without regard to case (ASCII letters only, as the files' own writers did). Everything of the file
// that is not the value being written survives a write: comments, other sections and keys, and even
// stray lines that are neither (a note typed by hand without "=" or ";").
//
// Any bytes may be stored and read back exactly, while the file stays text: a file name given by the
// system in Latin-1 ("relev\xE9.geo"), or holding a line end. Each byte of a text that UTF-8 cannot carry
// (a byte of an invalid sequence), and each control character but tab (NUL, CR, LF ...), is kept in the
// file as the private-use character U+EF00 + byte ("\xE9" as U+EFE9); reading maps every character from
// U+EF00 to U+EFFF back to its byte. A character of that range in the text given is stored byte by byte
// the same way, so that it too reads back as given. Section and key names are the program's own and are
// kept as they are (UTF-8; a name that is not is taken as Windows-1252).
namespace pyr {

// What Load answers for a file that is there but is no parameter file (see IsParamFileText): the
// document is left empty and the file must not be written over.
inline constexpr int kNotParamText = EILSEQ;

// Whether the bytes can be an initialisation file that a person or a program wrote: text in UTF-8 or a
// Windows code page, with any line ends. Not text:
//  - a NUL byte anywhere: binary files, and UTF-16 or UTF-32 of any Latin letter (every key, "=" and line
//    end of a parameter file), hold NULs, which no text editor writes. A byte-order mark alone proves
//    nothing: "ÿþ" opens a Windows-1252 text as well, and a file written from a text must stay text;
//  - more than eight control characters other than tab, line feed, vertical and form feed, carriage
//    return and the old end-of-file mark (Ctrl-Z): binary data. A vertical tab pasted from a word
//    processor, or an escape or two slipped into a hand-edited file, stay below it. The program writes no
//    such character (its values escape them): a file it writes from a text is text.
// A text without any section or key is text all the same: its lines are kept and the program's sections
// follow them.
bool IsParamFileText(std::string_view bytes);

class IniFile {
public:
    IniFile();
    ~IniFile();
    IniFile(IniFile&&) noexcept;
    IniFile& operator=(IniFile&&) noexcept;
    IniFile(const IniFile&) = delete;
    IniFile& operator=(const IniFile&) = delete;

    // Reads the file. Returns 0 when it was read, ENOENT (the document left empty, ready to become a new
    // file) when it does not exist, kNotParamText (the document left empty) when it is not text, or the
    // errno of any other failure.
    int Load(const std::string& path);

    // Takes the bytes of a file: UTF-8, or Windows-1252 when they are not valid UTF-8; CRLF or LF. A NUL
    // byte, which no text holds, is read as its escape.
    void Parse(std::string_view bytes);

    bool HasSection(std::string_view section) const;

    // The value of the first line of that key in that section, blanks around it removed and a pair of
    // surrounding double quotes taken off, its escaped bytes given back. False when the section or the
    // key is absent.
    bool Get(std::string_view section, std::string_view key, std::string& value) const;

    // Replaces the value of the key, appending the key to its section, or the section to the file, when
    // they are new. Get gives back exactly the bytes given, whatever they are.
    void Set(std::string_view section, std::string_view key, std::string_view value);

    struct Entry {
        std::string section;
        std::string key;
        std::string value; // as Get gives it
        bool operator==(const Entry&) const = default;
    };
    // Every value, section by section and key by key in the file's order, each line of a repeated key;
    // the names as the file spells them.
    std::vector<Entry> Entries() const;

    // The file's bytes, in the encoding, line ending and byte-order mark the file was read with (UTF-8
    // and the platform's line ending for a new file). A Windows-1252 file that has come to hold a
    // character its code page lacks ("≠", an escaped byte) is written whole in UTF-8 rather than lose it;
    // so is one whose bytes in the code page would read as UTF-8 next time (the value that was not UTF-8
    // replaced), so that its accents read the same.
    std::string Bytes() const;

    // Writes Bytes() to the file through a temporary file beside it, renamed over it, so that the file is
    // never left half written. Returns 0, or the errno of the failure (the file then is unchanged).
    int Save(const std::string& path) const;

private:
    struct Impl;
    std::unique_ptr<Impl> impl_;
};

// --- Parameter files that are not text -------------------------------------------------------------
//
// A parameter file (or a registry hive file) that is not text is never written over: it may be the
// settings of a person in a form this program does not know, or a file put in its place by mistake.

// Loads a parameter file to read from it. A file that is not text gives the empty document (the
// defaults) and a message naming it, once for each file in the life of the program. Returns Load's code.
int LoadParamFileToRead(IniFile& file, const std::string& path);

// Loads a parameter file to write into it. A file that is not text is first moved aside, under the first
// free name of "<name>.illisible", "<name>.illisible.2" ... in its folder (a link is moved as a link),
// and a message says where it went; the empty document is then given, to become a new file. Returns 0,
// ENOENT for a file that does not exist yet, or the errno of the failure (of the move included).
int LoadParamFileToWrite(IniFile& file, const std::string& path);

// The name a file that is not text is moved aside to: the first of "<path>.illisible",
// "<path>.illisible.2" ... that no file holds.
std::string FreeAsideName(const std::string& path);

// Forgets which files were said not to be text (for the tests, as a new run of the program would).
void ForgetUnreadableParamFiles();

} // namespace pyr

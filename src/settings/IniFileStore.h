#pragma once

#include "core/SafeFile.h"

#include <memory>
#include <string>
#include <string_view>

// Initialisation files: "[Section]" lines, then "Clé=valeur" lines. Sections and keys are compared
// without regard to case (ASCII letters only, as the files' own writers did). Everything of the file
// that is not the value being written survives a write: comments, other sections and keys, and even
// stray lines that are neither (a note typed by hand without "=" or ";").
namespace pyr {

class IniFile {
public:
    IniFile();
    ~IniFile();
    IniFile(IniFile&&) noexcept;
    IniFile& operator=(IniFile&&) noexcept;
    IniFile(const IniFile&) = delete;
    IniFile& operator=(const IniFile&) = delete;

    // Reads the file. Returns 0 when it was read, ENOENT (the document left empty, ready to become a new
    // file) when it does not exist, or the errno of any other failure.
    int Load(const std::string& path);

    // Takes the bytes of a file: UTF-8, or Windows-1252 when they are not valid UTF-8; CRLF or LF.
    void Parse(std::string_view bytes);

    bool HasSection(std::string_view section) const;

    // The value of the first line of that key in that section, blanks around it removed and a pair of
    // surrounding double quotes taken off. False when the section or the key is absent.
    bool Get(std::string_view section, std::string_view key, std::string& value) const;

    // Replaces the value of the key, appending the key to its section, or the section to the file, when
    // they are new. A text that is not valid UTF-8 is taken as Windows-1252.
    void Set(std::string_view section, std::string_view key, std::string_view value);

    // The file's bytes, in the encoding, line ending and byte-order mark the file was read with (UTF-8
    // and the platform's line ending for a new file).
    std::string Bytes() const;

    // Writes Bytes() to the file through a temporary file beside it, renamed over it, so that the file is
    // never left half written. Returns 0, or the errno of the failure (the file then is unchanged).
    int Save(const std::string& path) const;

private:
    struct Impl;
    std::unique_ptr<Impl> impl_;
};

} // namespace pyr

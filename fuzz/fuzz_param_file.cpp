// Any bytes read as a parameter file. Nothing may crash, and what the reader keeps is kept:
//  - every value read (each line of each key) reads the same from the bytes written back, and writing
//    those again gives the same bytes;
//  - a value set, whatever its bytes (the end of the input), reads back exactly, at once and from the
//    bytes written, and no other value changes;
//  - telling text from what is not never crashes, and a file that is text stays text once written.
#include "core/Strings.h"
#include "settings/IniFileStore.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <tuple>
#include <vector>

namespace {

using namespace pyr;

[[noreturn]] void Broken(const char* what, std::string_view detail) {
    std::fprintf(stderr, "\n*** fuzz_param_file : %s\n%.*s\n", what, static_cast<int>(detail.size()),
                 detail.data());
    std::abort();
}

// The values by section and key, each key's lines in their order. Sections may come out in another
// order: the library writes the keys of no section ("[]") first.
std::vector<IniFile::Entry> Sorted(std::vector<IniFile::Entry> entries) {
    std::stable_sort(entries.begin(), entries.end(), [](const IniFile::Entry& a, const IniFile::Entry& b) {
        return std::tie(a.section, a.key) < std::tie(b.section, b.key);
    });
    return entries;
}

// The values of the file but those of one key of one section.
std::vector<IniFile::Entry> Without(std::vector<IniFile::Entry> entries, std::string_view section,
                                    std::string_view key) {
    std::erase_if(entries, [&](const IniFile::Entry& entry) {
        return EqualIgnoringCase(entry.section, section) && EqualIgnoringCase(entry.key, key);
    });
    return entries;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const bool text = IsParamFileText(bytes);

    IniFile ini;
    ini.Parse(bytes);
    const std::vector<IniFile::Entry> entries = ini.Entries();
    for (const IniFile::Entry& entry : entries) {
        std::string value;
        if (!ini.Get(entry.section, entry.key, value)) Broken("une valeur lue ne se retrouve pas", entry.key);
    }
    const std::string written = ini.Bytes();
    if (text && !IsParamFileText(written)) Broken("un fichier texte ne l'est plus une fois écrit", written);
    IniFile again;
    again.Parse(written);
    if (Sorted(again.Entries()) != Sorted(entries)) Broken("relues, les valeurs ont changé", written);
    if (again.Bytes() != written) Broken("écrit deux fois, le fichier change", written);

    // A value of any bytes, in the first section of the file (or a new one).
    const std::string section = entries.empty() ? std::string("GeoBase") : entries.front().section;
    const std::string value(bytes.substr(size - std::min<std::size_t>(size, 24)));
    ini.Set(section, "Derniere", value);
    std::string read;
    if (!ini.Get(section, "Derniere", read) || read != value)
        Broken("la valeur écrite se lit autrement", value);
    const std::string withValue = ini.Bytes();
    IniFile third;
    third.Parse(withValue);
    if (!third.Get(section, "Derniere", read) || read != value)
        Broken("la valeur écrite se relit autrement", withValue);
    if (Sorted(Without(third.Entries(), section, "Derniere")) !=
        Sorted(Without(entries, section, "Derniere")))
        Broken("une valeur écrite en a changé d'autres", withValue);
    return 0;
}

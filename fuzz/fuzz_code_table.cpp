// Any bytes read as a code table (".cod"), then every line of them taken as a field code. Nothing may
// crash, and:
//  - the lines reported are lines of the table;
//  - the table written is valid UTF-8 and reads back as the same table (same separator, same codes with the
//    same command and complement), and written again gives the same bytes;
//  - the code of a point's name field starts within the field, on a character;
//  - a field code interpreted gives a command of the table's kinds, with valid UTF-8 parameters.
#include "MemoryFile.h"
#include "core/Lines.h"
#include "core/TextEncoding.h"
#include "fieldbook/TableCode.h"
#include "fieldbook/TableCodeFile.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>
#include <vector>

namespace {

using namespace pyr;

[[noreturn]] void Broken(const char* what, std::string_view detail) {
    std::fprintf(stderr, "\n*** fuzz_code_table : %s\n%.*s\n", what, static_cast<int>(detail.size()),
                 detail.data());
    std::abort();
}

int LineCount(std::string_view text) {
    int count = 0;
    ForEachLine(text, [&count](std::string_view, int number) { count = number; });
    return count;
}

// What a table means, whatever its layout: the separator, and each code with its command and complement.
std::string Meaning(const CodeTableContent& table) {
    std::string meaning = "séparateur <" + table.separator + ">\n";
    for (const CodeTableLine& line : table.lines) {
        if (line.kind != CodeTableLine::Kind::Code) continue;
        meaning += "<" + line.code + "> <" + std::string(line.command) + ">";
        for (const std::string& word : line.complement)
            meaning += " <" + word + ">";
        meaning += "\n";
    }
    return meaning;
}

CodeTableContent Parse(std::string_view text, const char* what) {
    const int lines = LineCount(text);
    return ParseCodeTable(text, [&](int line, const std::string& reason) {
        if (line < 1 || line > lines) Broken(what, "ligne " + std::to_string(line) + " : " + reason);
        if (!IsValidUtf8(reason)) Broken("un message n'est pas de l'UTF-8", reason);
    });
}

void CheckFieldCode(const CTableCode& table, std::string_view field, std::vector<std::string>& words) {
    const std::size_t at = CodePosition(field, table.Separator());
    if (at > field.size()) Broken("le code commence après la fin du champ", field);
    if (!IsValidUtf8(field.substr(0, at)) || !IsValidUtf8(field.substr(at)))
        Broken("le code commence au milieu d'un caractère", field);

    table.Make_str_cmd(field.substr(at), words);
    int kind = 0;
    const std::unique_ptr<CElement> command = table.InterpreteTexte(words, kind);
    if (!command) return;
    if (!IsCommandKind(kind) || kind == kKindCommand) Broken("commande interprétée d'un autre type", field);
    const auto* interpreted = dynamic_cast<const CCommande*>(command.get());
    if (!interpreted) Broken("l'élément interprété n'est pas une commande", field);
    if (!IsValidUtf8(interpreted->word()) || !IsValidUtf8(interpreted->par()))
        Broken("les paramètres interprétés ne sont pas de l'UTF-8", field);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::string text = FileBytesToUtf8(bytes);

    const CodeTableContent table = Parse(text, "ligne signalée hors de la table");
    const std::string written = FormatCodeTable(table);
    if (!IsValidUtf8(written)) Broken("la table écrite n'est pas de l'UTF-8", written);
    const CodeTableContent back = Parse(written, "ligne signalée hors de la table écrite");
    if (Meaning(back) != Meaning(table))
        Broken("relue, la table écrite dit autre chose", Meaning(table) + "----\n" + Meaning(back));
    if (FormatCodeTable(back) != written) Broken("écrite deux fois, la table change", written);

    // The same table loaded from its file, as a conversion loads it, interprets the lines as field codes.
    fuzz::MemoryFile file("table", bytes);
    CTableCode loaded;
    if (!loaded.Init(file.Path())) Broken("le fichier en mémoire ne se lit pas", {});
    std::vector<std::string> words;
    ForEachLine(text, [&](std::string_view line, int) { CheckFieldCode(loaded, line, words); });
    return 0;
}

// pyr_make_book FORMAT LINES FOLDER: writes a generated field book of that format and about that many
// lines into FOLDER, named after the format's reading command with the format's usual extension
// ("LecWild.gsi"), and beside it, for the delimited and columnar formats, the layout that reads it
// (".sep", ".col"); prints the book's path. FORMAT is a reading command or a format's name ("LecWild",
// "Quendal-Pc").
#include "FieldBookGenerator.h"

#include <charconv>
#include <cstdio>
#include <fstream>
#include <string>
#include <string_view>

namespace {

bool WriteFile(const std::string& path, const std::string& text) {
    std::ofstream out(path, std::ios::binary);
    out << text;
    return static_cast<bool>(out.flush());
}

} // namespace

int main(int argc, char** argv) {
    using namespace pyr;
    if (argc != 4) {
        std::fprintf(stderr, "usage : pyr_make_book FORMAT LIGNES DOSSIER\nformats : %s\n",
                     FieldBookFormatNames().c_str());
        return 2;
    }
    const auto format = FindFieldBookFormat(argv[1]);
    const std::string_view count(argv[2]);
    int lines = 0;
    const auto parsed = std::from_chars(count.data(), count.data() + count.size(), lines);
    if (!format || parsed.ec != std::errc() || parsed.ptr != count.data() + count.size() || lines < 1) {
        std::fprintf(stderr, "pyr_make_book : format ou nombre de lignes inconnu (%s %s)\n", argv[1],
                     argv[2]);
        return 2;
    }
    const std::string file =
        std::string(argv[3]) + "/" + FormatInfo(*format).command + "." + books::BookExtension(*format);
    if (!WriteFile(file, books::MakeFieldBook(*format, lines))) {
        std::fprintf(stderr, "pyr_make_book : impossible d'écrire %s\n", file.c_str());
        return 1;
    }
    const std::string layout = books::BookLayout(*format);
    if (!layout.empty() && !WriteFile(BesideCarnet(file, FormatInfo(*format).paramExtension), layout)) {
        std::fprintf(stderr, "pyr_make_book : impossible d'écrire la mise en page de %s\n", file.c_str());
        return 1;
    }
    std::printf("%s\n", file.c_str());
    return 0;
}

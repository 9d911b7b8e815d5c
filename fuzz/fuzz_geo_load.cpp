// Any bytes read as a GéoBase. Nothing may crash, and reading is a fixed point of writing:
//  - a line that reads as an element is written back as a line that reads as the same element;
//  - a file read then saved, read again and saved again gives the same bytes twice, and the second
//    reading holds as many elements as the first (no line is lost or split on the way).
#include "MemoryFile.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "geobase/Carnet.h"
#include "geobase/GeoFile.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace {

using namespace pyr;

[[noreturn]] void Broken(const char* what, std::string_view detail) {
    std::fprintf(stderr, "\n*** fuzz_geo_load : %s\n%.*s\n", what, static_cast<int>(detail.size()),
                 detail.data());
    std::abort();
}

// The folder of the files saved by this process: in memory when the system has one. Kept for the whole
// run and removed at its end.
const std::string& Folder() {
    static const std::string* folder = [] {
        std::filesystem::path base = std::filesystem::exists("/dev/shm")
                                         ? std::filesystem::path("/dev/shm")
                                         : std::filesystem::temp_directory_path();
        auto* path = new std::string((base / "pyr_fuzz.XXXXXX").string());
        if (!mkdtemp(path->data())) Broken("impossible de créer le dossier temporaire", *path);
        return path;
    }();
    static const bool removedAtExit = std::atexit([] {
                                          std::error_code ignored;
                                          std::filesystem::remove_all(*folder, ignored);
                                      }) == 0;
    (void)removedAtExit;
    return *folder;
}

void CheckLine(std::string_view line) {
    std::string error;
    for (bool lenient : {false, true}) {
        int kind = 0;
        auto element = ParseElementLine(line, kind, error, lenient);
        if (!element) continue;
        const std::string written = ElementLine(*element, kind);
        int kindAgain = 0;
        auto again = ParseElementLine(written, kindAgain, error, false);
        if (!again) Broken("une ligne écrite ne se relit pas", written + "\n" + error);
        if (kindAgain != kind || ElementLine(*again, kindAgain) != written)
            Broken("une ligne écrite se relit autrement", written);
    }
}

std::string Saved(CCarnet& carnet, const std::string& path) {
    if (!carnet.Save(path)) Broken("échec de l'enregistrement", path);
    std::string bytes;
    if (!ReadWholeFile(path, bytes)) Broken("le fichier enregistré ne se relit pas", path);
    return bytes;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    ForEachLine(bytes, [](std::string_view line, int) { CheckLine(line); });

    ui::ScriptedFrontEnd frontEnd;
    ui::ScopedApplicationFrontEnd scope(frontEnd);
    CPyrTxtWnd txt(frontEnd);
    const std::string first = Folder() + "/premier.geo";
    const std::string second = Folder() + "/second.geo";

    fuzz::MemoryFile input("geobase", bytes);
    CCarnet carnet;
    if (!carnet.Load(&txt, input.Path(), {}, 1, &frontEnd)) Broken("le fichier en mémoire ne se lit pas", {});
    const std::string saved = Saved(carnet, first);

    CCarnet again;
    if (!again.Load(&txt, first, {}, 1, &frontEnd)) Broken("le fichier enregistré ne se lit pas", first);
    if (again.GetSize() != carnet.GetSize())
        Broken("relu, le fichier enregistré n'a pas le même nombre d'éléments", saved);
    if (Saved(again, second) != saved) Broken("enregistré deux fois, le fichier change", saved);
    return 0;
}

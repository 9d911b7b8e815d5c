#pragma once

// What every fuzz target of a field-book reader checks besides "no crash": the GéoBase read is a GéoBase
// like any other, that writes and reads back with as many elements, each of the same kind and name.
#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace pyr::fuzz {

[[noreturn]] inline void Broken(const char* target, const char* what, std::string_view detail) {
    std::fprintf(stderr, "\n*** %s : %s\n%.*s\n", target, what, static_cast<int>(detail.size()),
                 detail.data());
    std::abort();
}

// The store written to a file in memory and read back by its path.
inline void CheckRoundTrip(const char* target, const CCarnet& read, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    const int fd = memfd_create("geobase", 0);
    if (fd < 0) Broken(target, "impossible de créer le fichier en mémoire", {});
    std::FILE* file = fdopen(dup(fd), "w");
    if (!file || !read.Write(file, true)) Broken(target, "la GéoBase lue ne s'écrit pas", {});
    std::fclose(file);
    CCarnet back;
    if (!back.Load(&txt, "/proc/self/fd/" + std::to_string(fd), {}, 0, &frontEnd))
        Broken(target, "la GéoBase écrite ne se relit pas", {});
    close(fd);
    if (back.GetSize() != read.GetSize())
        Broken(target, "relue, la GéoBase n'a pas le même nombre d'éléments", {});
    for (int i = 0; i < read.GetSize(); ++i)
        if (back.GetType(i) != read.GetType(i) || back.matAt(i) != read.matAt(i))
            Broken(target, "relu, un élément a changé", read.matAt(i));
}

} // namespace pyr::fuzz

#pragma once

// What every fuzz target of a field-book reader checks besides "no crash": the GéoBase read is a GéoBase
// like any other, its texts in UTF-8 (a reader that cut a letter in two would garble the file), that writes
// and reads back with as many elements, each of the same kind and name.
#include "core/TextEncoding.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookReaders.h"
#include "fieldbook/ParamDriver.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdint>
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

// Every text of every element in UTF-8, as the readers convert the field books' code pages.
inline void CheckTexts(const char* target, const CCarnet& read) {
    for (int i = 0; i < read.GetSize(); ++i) {
        const auto* comment = dynamic_cast<const CComment*>(read.GetAt(i));
        for (const std::string& text : {read.matAt(i), read.cmdAt(i), read.symAt(i), read.parAt(i),
                                        comment ? comment->text() : std::string()})
            if (!IsValidUtf8(text)) Broken(target, "un texte lu n'est pas en UTF-8", text);
    }
}

// The store written to a file in memory and read back by its path.
inline void CheckRoundTrip(const char* target, const CCarnet& read, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    CheckTexts(target, read);
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

// The bytes read from memory by `reader` with `choices`, its messages and lines going to a scripted front
// end, then the round trip of what it built.
inline void ReadAndCheckRoundTrip(const char* target, CFieldBookReader& reader, const ReadingChoices& choices,
                                  std::string_view bytes) {
    ui::ScriptedFrontEnd frontEnd;
    ui::ScopedApplicationFrontEnd scope(frontEnd);
    CPyrTxtWnd txt(frontEnd);
    reader.SetChoices(choices);
    reader.SetTextWindow(&txt);
    reader.SetParent(&frontEnd);
    CCarnet read;
    reader.ReadText(bytes, read);
    CheckRoundTrip(target, read, txt, frontEnd);
}

// The settings of a format's parameter file that the first byte of an input picks.
using SettingsChooser = void (*)(CParamDriver& driver, std::uint8_t choice);

// The settings that change what most instrument readers make of a record, each from its own part of the
// first byte: how the reference sightings are told (choice % 3, the codes "REF" and "99"), the unit of
// the angles (choice / 3 % 4), feet (0x40), coordinates in the order Y, X (0x80) and the points computed
// by the instrument kept (0x20). A format without one of these keys ignores it.
inline void ChooseReaderSettings(CParamDriver& driver, std::uint8_t choice) {
    static const char* const references[] = {"aucune", "premiere", "codes"};
    static const char* const angles[] = {"grades", "degres", "dms", "mils"};
    driver.SetText(kKeyReferences, references[choice % 3]);
    driver.SetText(kKeyCodesReference, "REF,99");
    driver.SetText(kKeyUniteAngles, angles[(choice / 3) % 4]);
    driver.SetText(kKeyUniteDistances, choice & 0x40 ? "pieds" : "metres");
    driver.SetText(kKeyOrdreCoordonnees, choice & 0x80 ? "YX" : "XY");
    driver.SetText(kKeyPointsCalcules, choice & 0x20 ? "1" : "0");
}

// The whole body of a reader's fuzz target: the first byte chooses the settings of `format`, the rest is
// the field book, read by the format's reader with the default choices (codes kept as they stand).
inline int FuzzFieldBookReader(const char* target, FieldBookFormat format, SettingsChooser choose,
                               const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    CParamDriver driver("", "", format);
    choose(driver, data[0]);
    const auto reader = MakeFieldBookReader(format);
    if (!reader) Broken(target, "aucun lecteur pour ce format", {});
    reader->SetDriver(&driver);
    const ReadingChoices choices;
    ReadAndCheckRoundTrip(target, *reader, choices,
                          std::string_view(reinterpret_cast<const char*>(data) + 1, size - 1));
    return 0;
}

} // namespace pyr::fuzz

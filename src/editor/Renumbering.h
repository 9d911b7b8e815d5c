#pragma once

#include "editor/ElementReplacement.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

// Renumbering the points of a GéoBase and renaming a station, as edits of the GéoBase editor: each
// computes, without touching the GéoBase, the new state of every element to change, all or nothing.
//
// An identifier is one point of the ground, whatever element bears it: the point with its coordinates
// (1006), its sightings (1002, 1003), the levelling readings on its staff (1004, 1005), the codification
// commands that name it, and the stations set up on it (1001) — a station is the point it stands on. So
// when an identifier changes, every element of those kinds bearing it changes with it, and the traverses
// (1007) that list a station of that name follow, each designation keeping its reprise ("S1(2)" becomes
// "B1(2)", "S1" becomes "B1"). A traverse's own name, an instrument's name and the comments are not
// points: they never change, even when they spell a renamed identifier.
//
// The work is linear in the size of the GéoBase: the identifiers are handled by their rank in the
// store's index, and a text is hashed once per renamed identifier and per traverse designation.
namespace pyr {

class CCarnet;

namespace msg {

inline constexpr const char* kRenumberPointExists =
    "Le point <%s> existe déjà : la renumérotation est refusée.";
inline constexpr const char* kRenumberSameNew =
    "Les points <%s> et <%s> recevraient tous deux le matricule <%s> : la renumérotation est refusée.";
inline constexpr const char* kRenumberOutOfRange =
    "Le numéro du point <%s> sortirait des numéros possibles (0 à 999 999 999 999 999 999) : la "
    "renumérotation est refusée.";
inline constexpr const char* kRenumberBadNew = "Le point <%s> deviendrait <%s>, qui n'est pas un matricule "
                                               "correct : %s. La renumérotation est refusée.";
inline constexpr const char* kRenumberNothing = "Aucun point à renuméroter.";
inline constexpr const char* kRenumberMoreRefusals = "... et %lld autres refus.";
inline constexpr const char* kRenameNoStation = "La station <%s> n'existe pas dans la GéoBase.";
inline constexpr const char* kRenameSameName = "La station <%s> porte déjà ce nom.";
inline constexpr const char* kRenameStationExists =
    "La station <%s> existe déjà : le changement de nom de la station est refusé.";
inline constexpr const char* kRenamePointExists =
    "Le point <%s> existe déjà : le changement de nom de la station est refusé.";

} // namespace msg

// The number of refusals written out one by one; the others are counted in a last line.
inline constexpr int kRenumberRefusalsListed = 20;

// Which points to renumber, and how.
//
// The points are the identifiers borne by stations, sightings, levelling readings, points and
// commands, taken in the order of their first such element in the GéoBase; `selection` keeps those it
// designates ("100-150, A1-A9"), an empty selection keeps them all.
//
// Shift: each keeps its number plus `offset` ("100" + 1000 gives "1100"), and its prefix unless
// `newPrefix` replaces it ("A12" gives "B12"; both: "A12" + 100 gives "B112"); the digits keep the width
// they were written with ("A009" + 1 gives "A010"). An identifier without a trailing number cannot be
// shifted: it stays as it is and is listed in RenumberResult::unnumbered.
//
// Start: the points get `start`, `start` + 1 ... in that order, behind `newPrefix` (none when not
// given), zero-padded to `minDigits`; an identifier without a number is renumbered like the others.
struct RenumberRequest {
    enum class Mode { Shift, Start };
    std::string selection; // empty: every point
    Mode mode = Mode::Shift;
    long long offset = 0; // Shift: added to the number, may be negative
    long long start = 1;  // Start: the first number
    std::optional<std::string> newPrefix;
    int minDigits = 0; // the least count of digits of a number ("A" and 7 on 3 digits give "A007")
};

// One identifier changed, for the log of the edit.
struct RenamedIdentifier {
    std::string from;
    std::string to;
};

// What a renumbering or a station's renaming would do. When refused, `refusals` says why in French and
// nothing else is filled: no replacement, no identifier renamed.
struct RenumberResult {
    std::vector<RenamedIdentifier> renamed; // in the order of the points in the GéoBase
    // Every element to change, in increasing index order, each a copy with its new identifier (or, for
    // a traverse, its new designations).
    ElementReplacements replacements;
    std::vector<std::string> unnumbered; // selected in a shift, left as they are: no number to shift
    std::vector<std::string> refusals;

    bool Refused() const { return !refusals.empty(); }
};

// The renumbering of the points of `request`. Refused, all of it, when the selection is not correct
// (msg::kNoSelection), when nothing would change, when a new identifier would be incorrect or its number
// out of range, when it already names a point that is not itself renumbered away, or when two points
// would get the same one. A point may take the identifier that another renumbered point leaves
// ("1" to "2" while "2" goes to "3").
RenumberResult RenumberPoints(const CCarnet& carnet, const RenumberRequest& request);

// The renaming of the station `oldName`, every reprise of it, with everything that bears its name: its
// point, its sightings from the other stations, the levelling readings on it, the commands that name it,
// and the traverses that list it (reprise numbers kept). This is how the station "INCONNUE", opened by a
// reader for the sightings found before any station, is given its real name. The new name is normalised
// first. Refused when it is empty or not a correct identifier (the messages of a dialog's identifier
// field), when there is no station `oldName`, when the name does not change, and when another station or
// a point with coordinates already bears the new name. A name borne only by sightings or readings is
// free: the station then becomes the point that was sighted, which is what giving "INCONNUE" the name of
// the point it stood on means.
RenumberResult RenameStation(const CCarnet& carnet, std::string_view oldName, std::string_view newName);

} // namespace pyr

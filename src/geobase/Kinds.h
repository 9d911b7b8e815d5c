#pragma once

#include <string_view>

// The kind code kept beside every element of a GéoBase.
namespace pyr {

inline constexpr int kKindComment = 1000;
inline constexpr int kKindStation = 1001;
inline constexpr int kKindReference = 1002;    // sighting of a known point, used to orient the station
inline constexpr int kKindMesure = 1003;       // sighting of a point to compute
inline constexpr int kKindLectAR = 1004;       // levelling back reading
inline constexpr int kKindLectAV = 1005;       // levelling fore reading
inline constexpr int kKindPoint = 1006;        // point with known coordinates
inline constexpr int kKindChemin = 1007;       // traverse
inline constexpr int kKindAppareil = 1008;     // instrument: its constants apply to what follows
inline constexpr int kKindCommand = 1009;      // codification command kept as text, uninterpreted
inline constexpr int kKindExcentrement = 1010; // eccentric offsets: "ExcentRad", "ExcentTan", "ExcentVer"
inline constexpr int kKindLastCommand = 1065;  // interpreted codification commands run up to here

constexpr bool IsKnownKind(int kind) {
    return kind >= kKindComment && kind <= kKindLastCommand;
}
constexpr bool IsCommandKind(int kind) {
    return kind >= kKindCommand && kind <= kKindLastCommand;
}
constexpr bool IsSightingKind(int kind) {
    return kind == kKindReference || kind == kKindMesure;
}
constexpr bool IsLevellingKind(int kind) {
    return kind == kKindLectAR || kind == kKindLectAV;
}
// Stations, sightings, levelling readings, points and traverses: the elements that end the reach of
// the eccentric offsets and instruments written in front of them.
constexpr bool IsObservationOrPointKind(int kind) {
    return kind >= kKindStation && kind <= kKindChemin;
}

// Command words of the eccentric offsets (kind 1010).
inline constexpr std::string_view kExcentRad = "ExcentRad";
inline constexpr std::string_view kExcentTan = "ExcentTan";
inline constexpr std::string_view kExcentVer = "ExcentVer";

// The command word of a command kind ("Commande" for 1009, "ExcentRad" for 1010, "PT_Sans_Ori" for
// 1011 ...), empty for the other kinds.
std::string_view CommandWord(int kind);
// The description of a command word ("Excentrement radial"), empty when the word is unknown.
std::string_view CommandDescription(std::string_view word);
// The kind of a command word, compared without regard to case; 1009 when the word is unknown.
int CommandKind(std::string_view word);

// What the editor says when an element of that kind is added ("Station <%s> ajoutée dans la GéoBase");
// the text holds one %s for the identifier, except for comments and commands.
std::string_view AddedReport(int kind);

// A short French name of the kind, for lists and counts ("Station", "Référence", "Point" ...).
std::string_view KindLabel(int kind);

} // namespace pyr

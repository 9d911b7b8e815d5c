#pragma once

// The words the dialogs that compute a station share: the combo of stations, the lines of the two lists,
// the result fields and their lines in the text window.
namespace pyr::station {

inline constexpr const char* kChoice = "%s (%d)";        // a station and its occurrence in the combo
inline constexpr const char* kLineResection = "---> %s"; // a sighting from the station on a known point
inline constexpr const char* kLineIntersection = "<--- %s (%d)"; // a sighting on it from another station
inline constexpr const char* kTooltip = "%s %s : %s";

inline constexpr const char* kMsgNoStation =
    "La GéoBase <%s> n'a aucune station qui vise des points connus en coordonnées !";
inline constexpr const char* kMsgStationNotOffered =
    "La station <%s> n'existe pas dans la GéoBase ou ne vise aucun point connu en coordonnées !";
inline constexpr const char* kMsgNoSightingKept = "Aucune visée de la station <%s> ne porte sur <%s> !";
inline constexpr const char* kMsgNoStationAsked = "Aucune station à calculer : indiquez --station.";

// The window.
inline constexpr const char* kLabelStation = "&Station :";
inline constexpr const char* kLabelWrite = "É&crire la station";
inline constexpr const char* kLabelX = "X =";
inline constexpr const char* kLabelY = "Y =";
inline constexpr const char* kLabelV0 = "V0 =";
inline constexpr const char* kLabelZ = "Z =";

// Lines of the text window: the result as the dialog shows it.
inline constexpr const char* kLinePlace = "Station %s : %s %s  %s %s  EMQ %s %s  EMQ %s %s";
inline constexpr const char* kLineV0 = "Station %s : V0 = %s  EMQ V0 = %s";
inline constexpr const char* kLineAltitude = "Station %s : Z = %s  EMQ Z = %s (%d visée(s))";
inline constexpr const char* kLineSighting = "    %-16s v = %9s mgon  e = %8s m  vz = %9s mgon  ez = %8s m";
inline constexpr const char* kLineStatus = "Station %s : %s";

} // namespace pyr::station

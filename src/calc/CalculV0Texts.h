#pragma once

// The words of the orientation of stations: its dialog, its settings, its messages, the remarks of its
// listing and the lines it writes in the text window. Those with %s, %d or %f are printf formats.
namespace pyr::v0 {

inline constexpr const char* kCaption = "PYRALIS - Calcul des V0 de stations";

// The dialog's own settings in the parameter file.
inline constexpr const char* kSection = "Calcul_V0";
inline constexpr const char* kKeyType = "TypDeCalcul";
inline constexpr const char* kKeyWeighting = "Ponderation";

// Warnings, shown as message boxes.
inline constexpr const char* kMsgHeightOutOfTolerance =
    "L'écart entre les dénivelées mesurées et calculées\nvers la référence <%s> est hors tolérance!\n"
    "Calculée : %11.3fm / Mesurée : %11.3fm\nEcart : %11.3fm";
inline constexpr const char* kMsgDistanceOutOfTolerance =
    "L'écart entre les distances horizontales mesurées et calculées\nvers la référence <%s> est hors "
    "tolérance!\nCalculée : %11.3fm / Mesurée : %11.3fm\nEcart : %11.3fm";
inline constexpr const char* kMsgNoValidReference = "Aucune référence valide pour le calcul du V0 !";
inline constexpr const char* kMsgStationsNotComputable = "%d stations de la liste non calculables";
inline constexpr const char* kQuestionAddStationPoint =
    "Voulez-vous ajouter dans la GéoBase le point %dD\ndéfinissant les coordonnées de la station ?";
inline constexpr const char* kMsgStationUnknown = "La station <%s> n'existe pas dans la GéoBase !";
inline constexpr const char* kMsgStationWithoutCoordinates =
    "Les coordonnées de la station <%s> ne sont pas connues :\nson V0 ne peut pas être calculé !";
inline constexpr const char* kMsgStationCoordinatesKnown =
    "La station <%s> a déjà ses coordonnées dans la GéoBase :\nelles ne peuvent pas être remplacées ici.";
inline constexpr const char* kMsgCoordinatesIncomplete =
    "Les coordonnées X et Y de la station vont ensemble !";
inline constexpr const char* kMsgNoStation = "La GéoBase <%s> ne contient aucune station !";
inline constexpr const char* kMsgNoStationInList = "Aucune station de la GéoBase n'est dans la liste <%s> !";
inline constexpr const char* kMsgNoReferenceChosen = "Aucune référence choisie pour la station <%s> !";
inline constexpr const char* kMsgReferenceNotOffered =
    "La station <%s> n'a pas de visée sur un point connu <%s> !";
inline constexpr const char* kMsgHandV0OutOfRange = "Le V0 fixé doit être compris entre 0 et 400 gr !";
inline constexpr const char* kMsgHandV0OnlyUnique = "Un V0 fixé ne s'entre que pour une station unique !";

// The command line.
inline constexpr const char* kBadType = "Type de calcul inconnu : « %s » (unique, liste ou toutes).";
inline constexpr const char* kBadNumber = "--%s : « %s » n'est pas un nombre.";
inline constexpr const char* kBadStation =
    "Désignation de station incorrecte : « %s » (S1, ou S1(2) pour une reprise).";

// Remarks, written in the listing under the station.
inline constexpr const char* kRemarkAtStation = "La référence <%s> est confondue avec la station !";
inline constexpr const char* kRemarkOutOfTolerance = " -> V0 hors tolérance pour la référence <%s> !";
inline constexpr const char* kRemarkDeviation = "    (écart = %s Gr > %s Gr)";
inline constexpr const char* kRemarkNoDirection = "La référence <%s> n'a pas de lecture horizontale !";
inline constexpr const char* kRemarkHandV0 = "V0 fixé à la main, sans calcul sur les références.";
inline constexpr const char* kRemarkNone = "Aucune remarque.";

// Lines of the text window.
inline constexpr const char* kLineComputed = "Station %s : V0 = %s gr (%d référence(s) retenue(s) sur %d)";
inline constexpr const char* kLineHandV0 = "Station %s : V0 fixé = %s gr";
inline constexpr const char* kLineReference = "    %-12s V0 partiel = %s gr  écart = %s gr%s";
inline constexpr const char* kLineEliminated = "  (éliminée)";
inline constexpr const char* kLineNotComputed = "Station %s : %s";
inline constexpr const char* kLineWritten = "%d V0 de station(s) écrit(s) dans la GéoBase.";
inline constexpr const char* kLinePointAdded = "Point <%s> ajouté dans la GéoBase";

// The listing.
inline constexpr const char* kListStation = "Calcul de la station %s, reprise %d";
inline constexpr const char* kListSupportTitle = "Coordonnées des points d'appui";
inline constexpr const char* kListStationRole = "Station  ";
inline constexpr const char* kListReferenceRole = "Référence";
inline constexpr const char* kListMatricule = "Matricule      ";
inline constexpr const char* kListPreviousV0 = "Valeur précédente du V0 = %s";
inline constexpr const char* kListFixedV0 = "Valeur fixée pour le V0 = %s";
inline constexpr const char* kListCalculationTitle = "Calcul du V0 de la station (tolérance = %s Gr)";
inline constexpr const char* kListColumns[] = {"Référence", "Gis.", "DH", "AH", "V0", "eV0 Gr"};
inline constexpr const char* kListSummary = "%s : %s";
inline constexpr const char* kListBefore = "Valeur du V0 avant calcul            ";
inline constexpr const char* kListAfterWeighted = "Valeur du V0 après calcul pondéré    ";
inline constexpr const char* kListAfterUnweighted = "Valeur du V0 après calcul non pondéré";
inline constexpr const char* kListRemarks = "Remarques";
inline constexpr const char* kListOptions =
    "Options : pondération par les distances : %s ; références choisies "
    "forcées : %s";

} // namespace pyr::v0

#pragma once

// The words of the computation of an eccentric station: the dialog's and the listing's titles, columns and
// labels. Those with %s or %d are printf formats.
namespace pyr::excent {

// ---- The dialog
inline constexpr const char* kCaption = "Calcul de la station excentrée %s";
inline constexpr const char* kLabelCentre = "C&entre :";
inline constexpr const char* kMsgNoStation =
    "La GéoBase <%s> n'a aucune station qui vise avec une distance un point connu en coordonnées !";
inline constexpr const char* kMsgStationNotOffered =
    "La station <%s> n'existe pas dans la GéoBase ou ne vise avec une distance aucun point connu en "
    "coordonnées !";
inline constexpr const char* kMsgCentreNotSighted =
    "Le point <%s> n'est pas visé avec une distance depuis la station <%s> !";
inline constexpr const char* kMsgNoReference = "La station <%s> ne vise aucun point d'appui autre que <%s> !";
inline constexpr const char* kMsgNoCentreAsked = "Aucun centre de station : indiquez --centre.";

// Lines of the text window: the result as the dialog shows it.
inline constexpr const char* kLineCentre = "Station %s : centre %s à DH = %s m";
inline constexpr const char* kLinePlace = "Station %s : %s %s  %s %s";
inline constexpr const char* kLineV0 = "Station %s : V0 = %s";
inline constexpr const char* kLineAltitudeFromCentre = "Station %s : Z = %s (depuis le centre %s)";
inline constexpr const char* kLineAltitude = "Station %s : Z = %s  EMQ (cm) = %s (%d point(s) d'appui)";
inline constexpr const char* kLineReference = "    %-16s eV0 = %9s mgon  eAV = %9s mgon";

// ---- The listing
inline constexpr const char* kListTitle = "Calcul de la station %s, reprise %d";
inline constexpr const char* kListSupport = "Coordonnées des points d'appui";
inline constexpr const char* kListMatricule = "   Matricule   ";
inline constexpr const char* kListRole = "Rôle";
inline constexpr const char* kListRoleCentre = "centre";
inline constexpr const char* kListRoleReference = "appui";
inline constexpr const char* kListV0 = "Calcul du V0 de la station";
inline constexpr const char* kListV0Tolerance = "Calcul du V0 de la station (tolérance = %s Gr)";
inline constexpr const char* kListStationEccentric = "St exc. ";
inline constexpr const char* kListReference = "Réf.    ";
inline constexpr const char* kListResidualV0 = "eV0 Gr";
inline constexpr const char* kListFinalV0 = "Valeur du V0 définitif";
inline constexpr const char* kListPlanimetry = "Calcul en planimétrie";
inline constexpr const char* kListStationComputed = "St calc.";
inline constexpr const char* kListCentre = "Centre";
inline constexpr const char* kListBearingCentreToStation = "Gis. C-St";
inline constexpr const char* kListAltimetry = "Calcul en altimétrie, hauteur d'instrument = %s";
inline constexpr const char* kListAltitudeOfStation = "Z St.";
inline constexpr const char* kListResidualAV = "eAV Gr";
inline constexpr const char* kListComputedZ = "Z calculé :";
inline constexpr const char* kListApproximateZ = "Z approché :";
inline constexpr const char* kListAdjustedZ = "Z compensé :";
inline constexpr const char* kListEmqZ = "EMQ (cm) :";
inline constexpr const char* kListSummary = "Tableau récapitulatif des résultats";
inline constexpr const char* kListStation = "Station";

} // namespace pyr::excent

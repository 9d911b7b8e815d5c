#pragma once

// The words of the polygonal traverses: their messages, the lines of the text window and of the listing.
// Those with %s, %d or %f are printf formats.
namespace pyr::chem {

inline constexpr const char* kCaption = "PYRALIS - Calcul de cheminements polygonaux";
inline constexpr const char* kJournal = "Calcul de cheminements polygonaux";

// The switches of the traverses, "Cheminements" of "Options_Calculs", bit by bit.
inline constexpr const char* kKeySwitches = "Cheminements";
inline constexpr int kByCoordinates = 1;   // the planimetric closure shared by the coordinate differences
inline constexpr int kKeepAngular = 2;     // the angular closure measured, not distributed
inline constexpr int kKeepPlanimetric = 4; // the planimetric closure measured, not distributed
inline constexpr int kKeepHeight = 8;      // the height closure measured, not distributed
inline constexpr int kNoV0 = 16;           // the stations' V0 not written
inline constexpr int kRadiate = 32; // the points sighted from the stations radiated once they are written

// The tolerances of the closures, section "Options_Tolerances".
inline constexpr const char* kKeyAngular = "FermAngulaire";
inline constexpr const char* kKeyPlanimetric = "FermPlanimetr";
inline constexpr const char* kKeyHeight = "FermAltimetr";

// The kinds, as the listing and the text window name them.
inline constexpr const char* kKindLinked = "encadré";
inline constexpr const char* kKindPosition = "encadré en position seulement";
inline constexpr const char* kKindClosed = "fermé";
inline constexpr const char* kKindOpen = "en antenne, sans contrôle";

// Messages.
inline constexpr const char* kMsgNoTraverse =
    "La GéoBase <%s> ne contient aucun cheminement !\nLancez la recherche automatique des cheminements.";
inline constexpr const char* kMsgTraverseUnknown = "Le cheminement <%s> n'est pas dans la GéoBase !";
inline constexpr const char* kMsgNothingComputed = "Aucun cheminement n'a pu être calculé !";
inline constexpr const char* kQuestionOutOfTolerance =
    "Le cheminement <%s> est hors tolérance (%s).\nVoulez-vous quand même enregistrer ses stations ?";

// Lines of the text window.
inline constexpr const char* kLineTraverse = "Cheminement %s (%s), %d station(s), %.3f m";
inline constexpr const char* kLineNotComputed = "Cheminement %s non calculé : %s";
inline constexpr const char* kLineAngular = "    Fermeture angulaire %s gr, tolérance %s gr%s";
inline constexpr const char* kLinePlanimetric =
    "    Fermeture planimétrique fx = %s  fy = %s  f = %s m%s, tolérance %s m%s";
// The precision of a traverse: its length over its planimetric misclosure.
inline constexpr const char* kRatio = " (1/%.0f)";
inline constexpr const char* kLineHeight = "    Fermeture altimétrique %s m, tolérance %s m%s";
inline constexpr const char* kOutOfTolerance = "  HORS TOLÉRANCE";
inline constexpr const char* kLineLegWarning =
    "    Tronçon %s - %s : %s aller %.4f, retour %.4f m, écart hors tolérance (%.4f m)";
inline constexpr const char* kDistance = "distance";
inline constexpr const char* kHeight = "dénivelée";
inline constexpr const char* kLineFound = "Cheminement %s trouvé : %s%s";
inline constexpr const char* kClosedMark = " (fermé)";
inline constexpr const char* kLineSearch =
    "Recherche des cheminements : %d trouvé(s), %d ajouté(s) dans la GéoBase.";
inline constexpr const char* kLineRadiated = "%d point(s) rayonné(s) depuis les stations des cheminements.";
inline constexpr const char* kLineRadiatedOut =
    "Point <%s> rayonné plusieurs fois avec un écart hors tolérance : non enregistré.";
inline constexpr const char* kLineWritten = "%d station(s) et %d V0 écrit(s) dans la GéoBase.";
inline constexpr const char* kLineNotWritten = "Cheminement <%s> hors tolérance : non enregistré.";

// The listing.
inline constexpr const char* kListTraverse = "Cheminement %s : %s";
inline constexpr const char* kListAngularTitle = "Fermeture angulaire";
inline constexpr const char* kListAngular =
    "Fermeture = %s gr sur %d angles, tolérance %s gr, correction %s gr par angle";
inline constexpr const char* kListLegsTitle = "Tronçons";
inline constexpr const char* kListLegColumns[] = {"De", "A", "Gis. compensé", "Distance", "dX", "dY",
                                                  "cX", "cY"};
inline constexpr const char* kListPlanimetric = "fx = %s  fy = %s  f = %s m%s, tolérance %s m";
inline constexpr const char* kListStationsTitle = "Stations compensées";
inline constexpr const char* kListStationColumns[] = {"Station", "X", "Y", "Z", "V0"};
inline constexpr const char* kListHeightsTitle = "Altimétrie";
inline constexpr const char* kListHeightColumns[] = {"De", "A", "Dénivelée", "Correction"};
inline constexpr const char* kListHeight = "Fermeture altimétrique = %s m, tolérance %s m";
inline constexpr const char* kListOutOfTolerance = "HORS TOLÉRANCE";
inline constexpr const char* kListOpen = "Cheminement en antenne : aucune fermeture, aucun contrôle.";
inline constexpr const char* kListTolerances =
    "Tolérances de fermeture : angulaire %s, planimétrique %s m, altimétrique %s m";
inline constexpr const char* kListAngularFromInstruments =
    "2.7 sigma x racine(2n) gr (sigma de l'appareil, %s gr par direction à défaut)";

} // namespace pyr::chem

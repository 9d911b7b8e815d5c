#pragma once

// The words of direct levelling: its messages, the lines of the text window and of the listing. Those
// with %s or %d are printf formats; numbers come already formatted.
namespace pyr::niv {

inline constexpr const char* kCaptionSimple = "PYRALIS - Calcul de cheminement altimétrique";
inline constexpr const char* kCaptionDouble = "PYRALIS - Calcul de nivellement par double station";
inline constexpr const char* kJournalSimple = "Calcul de cheminements altimétriques";
inline constexpr const char* kJournalDouble = "Calcul de nivellement par double station";

// Messages.
inline constexpr const char* kMsgNoReading = "La GéoBase <%s> ne contient aucune lecture sur mire !";
inline constexpr const char* kMsgNothingComputed =
    "Aucun cheminement altimétrique n'a pu être calculé :\naucun ne va d'un repère d'altitude connue à un "
    "autre !";
inline constexpr const char* kMsgNoRunChosen =
    "Aucun cheminement altimétrique ne correspond au départ et à l'arrivée demandés (%s) !";
inline constexpr const char* kQuestionOutOfTolerance =
    "Le cheminement altimétrique de <%s> à <%s> est hors tolérance\n(fermeture %s m, tolérance %s m).\n"
    "Voulez-vous quand même enregistrer ses altitudes ?";
inline constexpr const char* kQuestionFlagged =
    "Le cheminement altimétrique de <%s> à <%s> a des dénivelées mal contrôlées\nen double station.\n"
    "Voulez-vous quand même enregistrer ses altitudes ?";

// Lines of the text window.
inline constexpr const char* kLineRun = "Cheminement %s - %s%s : %d dénivelée(s), longueur %s m";
inline constexpr const char* kClosedMark = " (fermé)";
inline constexpr const char* kUnknownLength = "inconnue";
inline constexpr const char* kLineClosure = "    Fermeture %s m, tolérance %s m%s";
inline constexpr const char* kOutOfTolerance = "  HORS TOLÉRANCE";
inline constexpr const char* kLineWarning = "    Attention : %s";
inline constexpr const char* kLineProblem = "Remarque : %s";
inline constexpr const char* kLineWritten = "%d altitude(s) écrite(s) dans la GéoBase.";
inline constexpr const char* kLineNotWritten = "Cheminement %s - %s : non enregistré.";
// The choice shown in kMsgNoRunChosen.
inline constexpr const char* kChoiceStart = "départ %s";
inline constexpr const char* kChoiceEnd = "arrivée %s";

// The listing.
inline constexpr const char* kListRunSimple = "Cheminement altimétrique de %s à %s%s";
inline constexpr const char* kListRunDouble = "Nivellement par double station de %s à %s%s";
inline constexpr const char* kListBenchmarks = "Repères : %s  Z = %s     %s  Z = %s";
inline constexpr const char* kListSetUpsTitle = "Stations du niveau";
inline constexpr const char* kListSetUpColumns[] = {"Arrière",   "Avant",      "Lect. AR",
                                                    "Lect. AV",  "Portée AR",  "Portée AV",
                                                    "Dénivelée", "Correction", "Altitude"};
inline constexpr const char* kListPairColumns[] = {"Arrière",   "Avant",      "Lect. AR",  "Lect. AV",
                                                   "Portée AR", "Portée AV",  "Dénivelée", "Moyenne",
                                                   "Écart",     "Correction", "Altitude"};
inline constexpr const char* kListPairOut = " *";
inline constexpr const char* kListSidesTitle = "Points rayonnés";
inline constexpr const char* kListSideColumns[] = {"Station sur", "Point",       "Lecture", "Portée",
                                                   "Altitude",    "Alt. connue", "Écart"};
inline constexpr const char* kListClosure = "Fermeture = %s m sur %s (%d dénivelée(s)), tolérance %s m";
inline constexpr const char* kListLength = "%s m";
inline constexpr const char* kListNoLength = "une longueur inconnue";
inline constexpr const char* kListByDistance = "Compensation proportionnelle aux portées.";
inline constexpr const char* kListBySetUp = "Compensation en parts égales par dénivelée.";
inline constexpr const char* kListByHeightDifference = "Compensation proportionnelle aux dénivelées.";
inline constexpr const char* kListOutOfTolerance = "HORS TOLÉRANCE";
inline constexpr const char* kListWarningsTitle = "Remarques";
inline constexpr const char* kListToleranceFixed = "Tolérance de fermeture : %s m";
inline constexpr const char* kListTolerancePerKm =
    "Tolérance de fermeture : %s m x racine de la longueur en km";
inline constexpr const char* kListTolerancePerSetUp =
    "Tolérance de fermeture : %s m x racine du nombre de dénivelées";
inline constexpr const char* kListPairTolerance =
    "Écart toléré entre les deux dénivelées d'une double station : %s m";

} // namespace pyr::niv

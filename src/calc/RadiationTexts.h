#pragma once

// The words of the radiated points: their dialog, settings, messages, the lines of the text window and
// of the listing. Those with %s, %d or %f are printf formats.
namespace pyr::rayon {

inline constexpr const char* kCaption = "PYRALIS - Calcul de points rayonnés";
inline constexpr const char* kJournal = "Calcul de points rayonnés";

// The dialog's own setting in the parameter file, and the calculation options it reads.
inline constexpr const char* kSection = "Calcul_Rayonnement";
inline constexpr const char* kKeyType = "TypDeCalcul";
inline constexpr const char* kKeyZeroTarget = "RayonHp0Check";
inline constexpr const char* kKeyZeroTargetValue = "ValeurDeHp0";
inline constexpr const char* kKeyComputeV0 = "RayonV0Calcule";
inline constexpr const char* kKeyCheckKnown = "ControleV0Rayonne";
inline constexpr const char* kKeyColumns = "RayonContenu";
inline constexpr const char* kDefaultColumns = "N,X,Y,Z,GI,DH";

// Messages.
inline constexpr const char* kMsgNothingRadiated = "Aucun point n'a pu être rayonné !";
inline constexpr const char* kMsgStationsNotUsed =
    "%d station(s) non utilisée(s) : voir les raisons affichées.";
inline constexpr const char* kMsgOutOfTolerance =
    "%d point(s) déterminé(s) plusieurs fois hors tolérance :\nchacun sera proposé à l'enregistrement.";
inline constexpr const char* kQuestionOutOfTolerance =
    "Le point <%s> est déterminé %d fois avec un écart de %.3f m en planimétrie\net de %.3f m en altitude, "
    "hors tolérance.\nVoulez-vous quand même l'enregistrer ?";

// Why a station or a sighting gave nothing.
inline constexpr const char* kReasonNoPlace = "pas de coordonnées";
inline constexpr const char* kReasonNoV0 = "pas de V0";
inline constexpr const char* kReasonNoReference = "aucune référence valide";
inline constexpr const char* kReasonNoDistance = "sans distance";
inline constexpr const char* kReasonNoDirection = "sans angle horizontal";
inline constexpr const char* kReasonNoZenith = "sans angle vertical";
inline constexpr const char* kReasonNoName = "sans matricule";

// Lines of the text window.
inline constexpr const char* kLineStation = "Station %s : %d point(s) rayonné(s), %d contrôle(s)%s";
inline constexpr const char* kLineV0Computed = ", V0 calculé = %s gr";
inline constexpr const char* kLineV0Kept =
    "    V0 non calculé sur les références : celui de la GéoBase est gardé.";
inline constexpr const char* kLineStationNotUsed = "Station %s non utilisée : %s";
inline constexpr const char* kLineSkipped = "    Visée sur <%s> non calculée : %s";
inline constexpr const char* kLineOutOfTolerance =
    "Point <%s> : %d déterminations, écarts %.3f m en XY et %.3f m en Z, HORS TOLÉRANCE";
inline constexpr const char* kLineTotal = "%d point(s) nouveau(x) rayonné(s) depuis %d station(s).";
inline constexpr const char* kLineWritten = "%d point(s) et %d V0 de station(s) écrit(s) dans la GéoBase.";
inline constexpr const char* kLineNotWritten = "Point <%s> hors tolérance : non enregistré.";

// The listing.
inline constexpr const char* kListStation = "Station %s, reprise %d";
inline constexpr const char* kListStationPlace = "X = %s   Y = %s   Z = %s   HI = %s";
inline constexpr const char* kListV0Own = "V0 = %s (celui de la GéoBase)";
inline constexpr const char* kListV0Computed = "V0 = %s calculé sur %d référence(s) (avant : %s)";
inline constexpr const char* kListPointsTitle = "Points rayonnés";
inline constexpr const char* kListChecksTitle = "Contrôle des points connus";
inline constexpr const char* kListCheckColumns[] = {"Matricule",   "Gis.",          "DH",
                                                    "Ecart long.", "Ecart transv.", "Ecart Z"};
inline constexpr const char* kListSkippedTitle = "Visées non calculées";
inline constexpr const char* kListSkipped = "%s : %s";
inline constexpr const char* kListMultipleTitle = "Points déterminés plusieurs fois";
inline constexpr const char* kListMultipleColumns[] = {"Matricule", "Station", "X", "Y", "Z"};
inline constexpr const char* kListMean = "Moyenne";
inline constexpr const char* kListSpread = "Ecarts : %s m en XY, %s m en Z%s";
inline constexpr const char* kListOutOfTolerance = "  HORS TOLERANCE";
inline constexpr const char* kListUnusedTitle = "Stations non utilisées";
inline constexpr const char* kListTolerances =
    "Tolérances des déterminations multiples : %s m en XY, %s m en Z";
inline constexpr const char* kListOptions =
    "Options : hauteur de voyant nulle remplacée : %s ; V0 calculé : %s ; contrôle des points connus : %s";

} // namespace pyr::rayon

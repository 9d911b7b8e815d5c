#pragma once

#include <string>
#include <string_view>

// The listings of the computations: the extension and file-dialog label of each, the title of its
// heading and the question that offers it, together with the texts that every listing shares.
namespace pyr {

enum class ListingKind {
    BlockAdjustment,
    EccentricStation,
    Intersection,
    Recoupement,
    Resection,
    Triangulation,
    StationV0,
    CoherenceCheck,
    PrecisionCheck,
    DuplicatePoints,
    LevellingDoubleRun,
    LevellingSimple,
    Traverse,
    RadiatedPoints,
};
inline constexpr int kListingKindCount = 14;

struct ListingKindInfo {
    ListingKind kind;
    std::string_view label;     // the plain-text form's label, "Listing d'intersection (*.cin)"
    std::string_view extension; // of the plain-text form, without its dot: "cin"
    // The label of the rich-text form, before " (*.rtf)": the plain-text label's words, except for
    // the recoupement, which offers its rich-text file under the intersection's words.
    std::string_view rtfWords;
    std::string_view title;    // the first line of every result's heading
    std::string_view question; // offers the listing when the dialog closes with results
};

const ListingKindInfo& ListingKindOf(ListingKind kind);

// The label, pattern, filter and extension of the form a listing takes: rich text (extension "rtf")
// or plain text (the computation's own extension).
std::string ListingLabel(ListingKind kind, bool richText);     // "Listing d'intersection (*.rtf)"
std::string ListingFilter(ListingKind kind, bool richText);    // "Listing d'intersection (*.rtf)|*.rtf||"
std::string ListingExtension(ListingKind kind, bool richText); // "rtf" or "cin"

// --- Texts shared by every listing -----------------------------------------------------------------

inline constexpr const char* kListingQuestionCalculations =
    "Voulez-vous enregistrer les résultats des différents\ncalculs effectués dans un fichier listing ?";
inline constexpr const char* kListingQuestionV0 =
    "Voulez-vous enregistrer les résultats des différents\ncalculs de V0 effectués dans un fichier listing ?";
inline constexpr const char* kListingQuestionTreatments =
    "Voulez-vous enregistrer les résultats des différents\ntraitements effectués dans un fichier listing ?";
inline constexpr const char* kListingQuestionPrecisionCheck =
    "Voulez-vous enregistrer les résultats du contrôle\ndans un fichier listing ?";

inline constexpr const char* kListingFileChoiceTitle = "Choix du fichier listing";
inline constexpr const char* kMsgListingExists =
    "<%s>\nLe fichier listing existe déjà !\nVoulez-vous compléter le fichier existant ?\n\n"
    "(Répondre NON pour remplacer ce fichier.)";

inline constexpr const char* kListingTitlePrefix = "PYRALIS CALCULS TOPOMETRIQUES - ";
inline constexpr const char* kListingGeoBaseLine = "Nom de la GéoBase traitée : %s\n";
inline constexpr const char* kListingDateLine = "Calculs effectués le      : %s\n";

// The keys of the listing options read by the flow, in the section kSectionListings.
inline constexpr const char* kKeyChooseListingName = "ChoixNomListing";
inline constexpr const char* kKeyWriteTolerances = "EcrireTolérances";
inline constexpr const char* kKeyShowListing = "AfficherListing";

} // namespace pyr

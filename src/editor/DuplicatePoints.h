#pragma once

#include "editor/ElementReplacement.h"
#include "settings/ListingFlow.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// The duplicate points of a GéoBase: one place of the ground surveyed twice and written under two
// identifiers, found by the planimetric distance between the points (kind 1006) that have an X and a Y.
//
// An identifier is one point: when it is written several times, its first element with a planimetry
// stands for it. Written again farther than the tolerance from that first place, it is not the same
// point any more but a conflict of its own ("même matricule, places différentes"), listed apart; written
// again within the tolerance, it is the same point and is not listed. Points without an identifier are
// not looked at: they cannot be named in a listing.
//
// The search is linear in the size of the GéoBase: the points fall into a hash grid of square cells wider
// than the tolerance, and each is compared only with the points of the cells within its reach: its own
// and, near a border, those beside it (at most the eight around it).
namespace pyr {

class CCarnet;
class CDlgCfgListing;

namespace msg {

inline constexpr const char* kDuplicateToleranceRefused =
    "La tolérance des points doubles doit être un nombre compris entre 0 et 100 m.";

// The text window.
inline constexpr const char* kDuplicateSummary = "%zu couple(s) de points doubles à moins de %s m.";
inline constexpr const char* kDuplicateSummaryConflicts =
    " %zu point(s) de même matricule à des places différentes.";
inline constexpr const char* kDuplicateSummaryTruncated = " Recherche arrêtée après %zu couples.";

// The listing.
inline constexpr const char* kDuplicateListFrame = "Recherche des points doubles";
inline constexpr const char* kDuplicateListTolerance = "Tolérance de recherche             : %s m\n";
inline constexpr const char* kDuplicateListExamined = "Points examinés                    : %d\n";
inline constexpr const char* kDuplicateListPairCount = "Couples de points doubles          : %zu\n";
inline constexpr const char* kDuplicateListConflictCount = "Même matricule, places différentes : %zu\n";
inline constexpr const char* kDuplicateListPairsTitle =
    "Points doubles : matricules différents à moins de %s m";
inline constexpr const char* kDuplicateListConflictsTitle =
    "Même matricule, places différentes : à plus de %s m";
inline constexpr const char* kDuplicateListNone = "Aucun point double.";
inline constexpr const char* kDuplicateListTruncated =
    "Recherche arrêtée après %zu couples : les suivants ne sont pas listés.\n";
inline constexpr const char* kDuplicateListColumns[] = {"Couple", "Matricule", "Elément",
                                                        "X",      "Y",         "Distance"};

} // namespace msg

inline constexpr double kMaxDuplicateTolerance = 100.0; // m
// Two points at the tolerance to within this (m) are within it: far below the 0.1 mm of a coordinate
// written to four decimals, and above the rounding of the difference of two Lambert coordinates.
inline constexpr double kDuplicateDistanceSlack = 1e-9;
// The search stops past this many couples: a GéoBase whose unknown points were all written at (0, 0)
// under their own identifiers would otherwise give a couple for every two of them.
inline constexpr std::size_t kMaxDuplicatePairs = 1'000'000;

// Whether a tolerance (m) may be searched with: a number from 0 (coincident points only) to 100.
bool IsValidDuplicateTolerance(double toleranceMetre);

// Two points of a GéoBase by their element indices (from 0), the earlier first.
struct DuplicatePair {
    int first = -1;
    int second = -1;
    double distance = 0.0; // planimetric (m)
};

struct DuplicatePoints {
    double tolerance = 0.0; // m
    int examined = 0;       // identifiers with a planimetry
    // Different identifiers within the tolerance, by the first element's index, then the second's.
    std::vector<DuplicatePair> pairs;
    // One identifier written again farther than the tolerance from its first place, in the same order.
    std::vector<DuplicatePair> conflicts;
    bool truncated = false; // kMaxDuplicatePairs reached: the couples past it are not in `pairs`
};

// The duplicate points of the GéoBase within `toleranceMetre`, a valid tolerance (the caller refuses the
// others with msg::kDuplicateToleranceRefused).
DuplicatePoints FindDuplicatePoints(const CCarnet& carnet, double toleranceMetre);

// The later point of each couple (never a conflict's) given `code` as its code: copies of the elements,
// each once, in increasing index order, for the editor to apply as one edit. Nothing when `code` is empty
// or when each already bears it.
ElementReplacements CodeDuplicates(const CCarnet& carnet, const DuplicatePoints& results,
                                   const std::string& code);

// The line of the text window: "3 couple(s) de points doubles à moins de 0.0500 m." and, when there are
// some, the conflicts and the stop of the search.
std::string DuplicatePointsSummary(const DuplicatePoints& results);

// The listing's block after its heading: the tolerance, the count of points examined and of couples, the
// couples (two lines each: the pair's number and distance, then each point's identifier, element
// number from 1, X and Y), then the conflicts in the same form.
void WriteDuplicatePoints(CDlgCfgListing& listing, const CCarnet& carnet, const DuplicatePoints& results);

// The listing of the search, for WriteComputationListing: the kind ".ptd", the GéoBase's path and one
// result written by WriteDuplicatePoints. `carnet` and `results` must outlive the request.
ListingRequest DuplicatePointsListing(std::string_view paramPath, const CCarnet& carnet,
                                      const DuplicatePoints& results);

} // namespace pyr

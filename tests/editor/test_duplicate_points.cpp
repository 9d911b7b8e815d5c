// The duplicate points of a GéoBase. The geometries are constructed: 3-4-5 right triangles scaled to the
// centimetre give distances known exactly (0.03 m and 0.04 m apart: 0.05 m), to be found at the
// tolerance and not 0.1 mm beyond it; a random cloud is checked against every pair compared one by one.
#include "TestSupport.h"
#include "editor/DuplicatePoints.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "settings/ListingObject.h"
#include "ui/ScriptedFrontEnd.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <memory>
#include <random>
#include <regex>
#include <string>
#include <tuple>
#include <vector>

namespace pyr {
namespace {

constexpr double kTenthOfMm = 1e-4; // m

void AddPoint(CCarnet& carnet, const std::string& mat, double x, double y, double z = kUndefined,
              const std::string& code = {}) {
    ASSERT_GE(carnet.Add(std::make_unique<CPointGen>(mat, x, y, z, code), kKindPoint), 0) << mat;
}

// The couples as (first, second) element indices.
std::vector<std::pair<int, int>> Indices(const std::vector<DuplicatePair>& pairs) {
    std::vector<std::pair<int, int>> indices;
    for (const DuplicatePair& pair : pairs)
        indices.emplace_back(pair.first, pair.second);
    return indices;
}
using Couples = std::vector<std::pair<int, int>>;

TEST(DuplicatePoints, FoundAtTheToleranceAndNotJustBeyondIt) {
    CCarnet carnet;
    AddPoint(carnet, "A", 651234.5600, 6862345.7800);
    AddPoint(carnet, "B", 651234.5900, 6862345.8200); // 0.03, 0.04 from A: 0.05 m
    AddPoint(carnet, "C", 651300.0000, 6862400.0000);
    AddPoint(carnet, "D", 651300.0300, 6862400.0401); // 0.0500800 m from C
    AddPoint(carnet, "E", 651400.0000, 6862500.0000); // alone

    const DuplicatePoints at = FindDuplicatePoints(carnet, 0.05);
    EXPECT_EQ(Indices(at.pairs), (Couples{{0, 1}}));
    EXPECT_NEAR(at.pairs[0].distance, 0.05, 1e-9);
    EXPECT_EQ(at.examined, 5);
    EXPECT_TRUE(at.conflicts.empty());
    EXPECT_FALSE(at.truncated);

    const DuplicatePoints wider = FindDuplicatePoints(carnet, 0.0501);
    EXPECT_EQ(Indices(wider.pairs), (Couples{{0, 1}, {2, 3}}));
    EXPECT_NEAR(wider.pairs[1].distance, std::hypot(0.03, 0.0401), 1e-9);
}

TEST(DuplicatePoints, ToleranceZeroFindsCoincidentPointsOnly) {
    CCarnet carnet;
    AddPoint(carnet, "10", -12.5, 40.0);
    AddPoint(carnet, "11", -12.5 + kTenthOfMm, 40.0);
    AddPoint(carnet, "12", -12.5, 40.0);
    AddPoint(carnet, "13", -12.5, 40.0 - kTenthOfMm);
    const DuplicatePoints found = FindDuplicatePoints(carnet, 0.0);
    EXPECT_EQ(Indices(found.pairs), (Couples{{0, 2}}));
    EXPECT_EQ(found.pairs[0].distance, 0.0);
}

// Only the points (1006) with both X and Y are looked at: stations, sightings, points known in altitude
// only or without their Y, whatever their identifier.
TEST(DuplicatePoints, ElementsWithoutPlanimetryAreIgnored) {
    CCarnet carnet;
    ASSERT_GE(carnet.Add(std::make_unique<CStation>("S1", 1.5), kKindStation), 0);
    ASSERT_GE(carnet.Add(std::make_unique<CMesure>("P2", 1.3, 50.0, 100.0, 20.0), kKindMesure), 0);
    AddPoint(carnet, "P1", 100.0, 200.0);
    ASSERT_GE(carnet.Add(std::make_unique<CPointGen>("P3", 45.2), kKindPoint), 0); // Z only
    AddPoint(carnet, "P4", 100.0, kUndefined, 45.2);
    AddPoint(carnet, "P5", kUndefined, 200.0);
    AddPoint(carnet, "P6", 100.01, 200.0);
    const DuplicatePoints found = FindDuplicatePoints(carnet, 0.05);
    EXPECT_EQ(Indices(found.pairs), (Couples{{2, 6}}));
    EXPECT_EQ(found.examined, 2);
}

// An identifier is one point at its first planimetric element: written again at the same place it is the
// same point, written again elsewhere it is a conflict, and that later place has no neighbours of its own.
TEST(DuplicatePoints, TheSameIdentifierWrittenAgainElsewhereIsAConflict) {
    CCarnet carnet;
    ASSERT_GE(carnet.Add(std::make_unique<CPointGen>("P1", 45.2), kKindPoint), 0); // altitude first
    AddPoint(carnet, "P1", 500.0, 500.0);
    AddPoint(carnet, "P1", 500.03, 500.04); // 0.05 m: the same point
    AddPoint(carnet, "P1", 530.0, 540.0);   // 50 m away
    AddPoint(carnet, "Q", 530.01, 540.0);   // beside that later place only
    AddPoint(carnet, "P1", 500.0, 500.0);
    const DuplicatePoints found = FindDuplicatePoints(carnet, 0.05);
    EXPECT_TRUE(found.pairs.empty());
    ASSERT_EQ(Indices(found.conflicts), (Couples{{1, 3}}));
    EXPECT_NEAR(found.conflicts[0].distance, 50.0, 1e-9);
    EXPECT_EQ(found.examined, 2);
}

// Points on both sides of cell borders, across the axes (negative coordinates round down), sideways and
// across a corner: the search must look into the neighbouring cells, the diagonal ones too. The cells
// are at least as wide as the tolerance; the points straddle every multiple of it.
TEST(DuplicatePoints, NeighboursAcrossCellBordersAndCorners) {
    for (double tolerance : {0.05, 1.0, 100.0}) {
        SCOPED_TRACE(tolerance);
        CCarnet carnet;
        Couples expected;
        int n = 0;
        for (int k = -3; k <= 3; ++k) {
            const double border = k * tolerance;
            const double near = 0.3 * tolerance;
            // Sideways in X, sideways in Y, across a corner (0.3 and 0.3: 0.42 of the tolerance apart).
            for (auto [ax, ay, bx, by] :
                 {std::tuple{border - near / 2, 7.0, border + near / 2, 7.0},
                  std::tuple{-7.0, border - near / 2, -7.0, border + near / 2},
                  std::tuple{border - near / 2, border - near / 2, border + near / 2, border + near / 2}}) {
                const std::string name = std::to_string(n);
                AddPoint(carnet, name + "a", 1000.0 * n + ax, 1000.0 * n + ay);
                AddPoint(carnet, name + "b", 1000.0 * n + bx, 1000.0 * n + by);
                expected.emplace_back(2 * n, 2 * n + 1);
                ++n;
            }
        }
        EXPECT_EQ(Indices(FindDuplicatePoints(carnet, tolerance).pairs), expected);
    }
}

// A random cloud with clusters, coincident points and a spread of a few tolerances, against every pair
// compared one by one: the same couples, in the order of the first element, then the second.
TEST(DuplicatePoints, SameCouplesInTheSameOrderAsComparingEveryPair) {
    std::mt19937_64 random(20260125);
    for (double tolerance : {0.0, 0.05, 2.5}) {
        SCOPED_TRACE(tolerance);
        CCarnet carnet;
        std::uniform_real_distribution<double> spread(-5.0, 5.0);
        std::uniform_int_distribution<int> pick(0, 9);
        std::vector<std::pair<double, double>> places;
        for (int i = 0; i < 1500; ++i) {
            double x = 651000.0 + std::round(spread(random) * 1e4) / 1e4 * std::max(tolerance, 0.05) * 4;
            double y = -20.0 + std::round(spread(random) * 1e4) / 1e4 * std::max(tolerance, 0.05) * 4;
            if (pick(random) == 0 && !places.empty())
                std::tie(x, y) = places[places.size() / 2]; // coincident
            places.emplace_back(x, y);
            AddPoint(carnet, "N" + std::to_string(i), x, y);
        }
        Couples expected;
        for (std::size_t i = 0; i < places.size(); ++i)
            for (std::size_t j = i + 1; j < places.size(); ++j)
                if (std::hypot(places[j].first - places[i].first, places[j].second - places[i].second) <=
                    tolerance + 1e-9)
                    expected.emplace_back(static_cast<int>(i), static_cast<int>(j));
        ASSERT_GT(expected.size(), 50u);
        EXPECT_EQ(Indices(FindDuplicatePoints(carnet, tolerance).pairs), expected);
    }
}

// Fifteen hundred unknown points all written at (0, 0), a million couples and more: the couples stop at the
// limit, keeping the first ones in order.
TEST(DuplicatePoints, TheSearchStopsAtTheLimitKeepingTheFirstCouples) {
    CCarnet carnet;
    for (int i = 0; i < 1500; ++i)
        AddPoint(carnet, std::to_string(i + 1), 0.0, 0.0);
    const DuplicatePoints found = FindDuplicatePoints(carnet, 0.0);
    EXPECT_TRUE(found.truncated);
    ASSERT_EQ(found.pairs.size(), kMaxDuplicatePairs);
    // Point i is first in 1499 - i couples: the limit falls within point 940's.
    EXPECT_EQ(Indices({found.pairs.front()}), (Couples{{0, 1}}));
    long long before = 0;
    int first = 0;
    while (before + 1499 - first <= static_cast<long long>(kMaxDuplicatePairs))
        before += 1499 - first++;
    EXPECT_EQ(found.pairs.back().first, first);
    EXPECT_EQ(found.pairs.back().second, first + static_cast<int>(kMaxDuplicatePairs - before));
    EXPECT_NE(DuplicatePointsSummary(found).find("Recherche arrêtée après 1000000 couples."),
              std::string::npos);
}

TEST(DuplicatePoints, ToleranceFromZeroToAHundredMetres) {
    for (double valid : {0.0, 0.05, 100.0})
        EXPECT_TRUE(IsValidDuplicateTolerance(valid)) << valid;
    for (double refused :
         {-0.001, 100.001, std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity()})
        EXPECT_FALSE(IsValidDuplicateTolerance(refused)) << refused;
}

// Three points within the tolerance of each other, a fourth beside the last, and a conflict: each later
// point of a couple is coded once, the first never, the conflict not at all; the copies keep everything
// else, so that applying them changes the codes only.
TEST(DuplicatePoints, TheLaterPointOfEachCoupleIsCodedOnce) {
    CCarnet carnet;
    AddPoint(carnet, "A", 10.0, 10.0, 5.0, "BORNE");
    AddPoint(carnet, "B", 10.01, 10.0, 5.1, "PIQUET");
    AddPoint(carnet, "C", 10.0, 10.01);
    AddPoint(carnet, "A", 90.0, 90.0, kUndefined, "BORNE");
    AddPoint(carnet, "D", 10.0, 10.055, kUndefined, "DOUBLE"); // beside C only, and coded already
    const DuplicatePoints found = FindDuplicatePoints(carnet, 0.05);
    ASSERT_EQ(Indices(found.pairs), (Couples{{0, 1}, {0, 2}, {1, 2}, {2, 4}}));
    ASSERT_EQ(found.conflicts.size(), 1u);

    EXPECT_TRUE(CodeDuplicates(carnet, found, "").empty());
    ElementReplacements replacements = CodeDuplicates(carnet, found, "DOUBLE");
    ASSERT_EQ(replacements.size(), 2u);
    EXPECT_EQ(replacements[0].index, 1);
    EXPECT_EQ(replacements[1].index, 2);

    for (ElementReplacement& replacement : replacements)
        ASSERT_TRUE(carnet.ExchangeAt(replacement.index, replacement.element));
    const char* codes[] = {"BORNE", "DOUBLE", "DOUBLE", "BORNE", "DOUBLE"};
    for (int i = 0; i < carnet.GetSize(); ++i)
        EXPECT_EQ(carnet.symAt(i), codes[i]) << i;
    EXPECT_EQ(carnet.matAt(1), "B");
    EXPECT_EQ(carnet.xAt(1), 10.01);
    EXPECT_EQ(carnet.zAt(1), 5.1);
    EXPECT_EQ(carnet.matAt(2), "C");
    EXPECT_EQ(carnet.GetType(2), kKindPoint);
}

TEST(DuplicatePoints, SummaryOfTheTextWindow) {
    SetStoreDecimals(4, 3, 5);
    CCarnet carnet;
    AddPoint(carnet, "A", 0.0, 0.0);
    EXPECT_EQ(DuplicatePointsSummary(FindDuplicatePoints(carnet, 0.05)),
              "0 couple(s) de points doubles à moins de 0.0500 m.");
    AddPoint(carnet, "B", 0.03, 0.04);
    AddPoint(carnet, "A", 3.0, 4.0);
    EXPECT_EQ(DuplicatePointsSummary(FindDuplicatePoints(carnet, 0.05)),
              "1 couple(s) de points doubles à moins de 0.0500 m. 1 point(s) de même matricule à des places "
              "différentes.");
}

class DuplicateListing : public ::testing::Test {
protected:
    // The listing as WriteComputationListing writes it, in plain text in one run, its date masked.
    std::string Write(const CCarnet& carnet, const DuplicatePoints& results) {
        CDlgCfgListing listing{frontEnd};
        listing.SetFormat(kListingTextNoPageCount);
        listing.SetDeciCoor(4);
        listing.SetDeciDist(4);
        EXPECT_TRUE(listing.OpenListing(file, "w"));
        listing.SetEcho(false);
        const ListingRequest request = DuplicatePointsListing("", carnet, results);
        EXPECT_EQ(request.kind, ListingKind::DuplicatePoints);
        EXPECT_EQ(request.resultCount, 1u);
        WriteListingHeading(listing, request, false);
        request.writeResult(listing, 0);
        EXPECT_TRUE(listing.CloseListing(file, false));
        const std::string text = ReadBytes(file);
        return std::regex_replace(text, std::regex("(Calculs effectués le      : ).*"), "$1<date>");
    }

    ui::ScriptedFrontEnd frontEnd;
    TempDir folder;
    const std::string file = folder / "chantier.ptd";
};

TEST_F(DuplicateListing, CouplesThenConflictsWithTheirElementsAndCoordinates) {
    CCarnet carnet;
    carnet.SetPathName("/chantiers/chantier.geo");
    ASSERT_GE(carnet.Add(std::make_unique<CStation>("S1", 1.5), kKindStation), 0);
    AddPoint(carnet, "1001", 651234.5600, 6862345.7800);
    AddPoint(carnet, "1002", 651300.0000, 6862400.0000);
    AddPoint(carnet, "A17", 651234.5900, 6862345.8200);
    AddPoint(carnet, "1002", 651310.0000, 6862400.0000);
    const DuplicatePoints results = FindDuplicatePoints(carnet, 0.05);
    EXPECT_EQ(Write(carnet, results), R"(
################################################################################
#         PYRALIS CALCULS TOPOMETRIQUES - RECHERCHE DES POINTS DOUBLES         #
################################################################################
Nom de la GéoBase traitée : /chantiers/chantier.geo
Calculs effectués le      : <date>

| Recherche des points doubles |

Tolérance de recherche             : 0.0500 m
Points examinés                    : 3
Couples de points doubles          : 1
Même matricule, places différentes : 1

Points doubles : matricules différents à moins de 0.0500 m
----------------------------------------------------------
| Couple | Matricule | Elément |      X      |      Y       | Distance |
| 1      | 1001      |       2 | 651234.5600 | 6862345.7800 |   0.0500 |
|        | A17       |       4 | 651234.5900 | 6862345.8200 |          |

Même matricule, places différentes : à plus de 0.0500 m
-------------------------------------------------------
| Couple | Matricule | Elément |      X      |      Y       | Distance |
| 1      | 1002      |       3 | 651300.0000 | 6862400.0000 |  10.0000 |
|        | 1002      |       5 | 651310.0000 | 6862400.0000 |          |
)");
}

TEST_F(DuplicateListing, NoCoupleSaysSo) {
    CCarnet carnet;
    AddPoint(carnet, "1", 0.0, 0.0);
    const std::string text = Write(carnet, FindDuplicatePoints(carnet, 0.0));
    EXPECT_NE(text.find("Couples de points doubles          : 0\nMême matricule, places différentes : 0\n\n"
                        "Aucun point double.\n"),
              std::string::npos)
        << text;
    EXPECT_EQ(text.find("Matricule"), std::string::npos) << text;
}

} // namespace
} // namespace pyr

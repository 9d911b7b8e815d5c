// Renumbering points and renaming a station: the new states computed, exchanged into the GéoBase, and
// the GéoBase compared as saved with the job edited by hand. The job has a station S1 in two reprises, a
// traverse through them, sightings, levelling readings on a staff, a command naming a point, and two
// elements that spell identifiers without being points (an instrument "100", a traverse "S1").
#include "TestSupport.h"
#include "core/Strings.h"
#include "editor/Renumbering.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Matricule.h"

#include <gtest/gtest.h>

namespace {

using pyr::RenumberRequest;
using pyr::RenumberResult;

constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1000\tLevé du 12 mars : points 100 à 102\n"
                             "1008\t100\t0\t0\t0\t0\t0\t0\n"
                             "1006\tS1\t1000\t2000\t50\t-\n"
                             "1006\t100\t1010\t2000\t-999999\t-\tBORNE\n"
                             "1001\tS1\t1.5\t-999999\n"
                             "1002\t100\t1.3\t100\t100\t10\n"
                             "1003\t101\t1.3\t150\t100\t12\n"
                             "1011\tPT_Sans_Ori\t\t101\n"
                             "1003\tS2\t1.3\t200\t100\t50\n"
                             "1001\tS2\t1.6\t-999999\n"
                             "1003\tS1\t1.3\t0\t100\t50\n"
                             "1003\t102\t1.3\t300\t100\t8\n"
                             "1001\tS1\t1.5\t-999999\n"
                             "1002\tS2\t1.3\t200\t100\t50\n"
                             "1004\t100\t1.234\t20\n"
                             "1005\t102\t1.456\t20\n"
                             "1007\tS1\t1\t3\tS1(1)\tS2\tS1(2)\n";

std::string Text(const pyr::CCarnet& carnet) {
    std::FILE* file = std::tmpfile();
    carnet.Write(file);
    std::string text = Contents(file);
    std::fclose(file);
    return text;
}

// Exchanges every replacement into the store, leaving in each the state it replaced.
void Apply(pyr::CCarnet& carnet, pyr::ElementReplacements& replacements) {
    for (pyr::ElementReplacement& replacement : replacements)
        ASSERT_TRUE(carnet.ExchangeAt(replacement.index, replacement.element)) << replacement.index;
}

class Renumbering : public ::testing::Test {
protected:
    void SetUp() override {
        WriteBytes(dir / "a.geo", kJob);
        ASSERT_EQ(carnet.Load(nullptr, dir / "a.geo"), 1);
        ASSERT_EQ(Text(carnet), kJob);
    }
    // Applies an accepted edit, checks the job then reads `expected`, and that the old states put back
    // give the job again, byte for byte.
    void ExpectEdit(RenumberResult result, const std::string& expected) {
        ASSERT_FALSE(result.Refused()) << result.refusals.front();
        Apply(carnet, result.replacements);
        EXPECT_EQ(Text(carnet), expected);
        Apply(carnet, result.replacements);
        EXPECT_EQ(Text(carnet), kJob);
    }
    static void ExpectRefused(const RenumberResult& result, const std::string& message) {
        ASSERT_FALSE(result.refusals.empty());
        EXPECT_EQ(result.refusals.front(), message);
        EXPECT_TRUE(result.replacements.empty());
        EXPECT_TRUE(result.renamed.empty());
    }

    TempDir dir;
    pyr::CCarnet carnet;
};

TEST_F(Renumbering, AnOffsetMovesAPointWithItsSightingsReadingsAndCommandsAndNothingElse) {
    RenumberRequest request;
    request.selection = "100-102";
    request.offset = 1000;
    RenumberResult result = RenumberPoints(carnet, request);
    ASSERT_EQ(result.renamed.size(), 3u);
    EXPECT_EQ(result.renamed[0].from, "100");
    EXPECT_EQ(result.renamed[0].to, "1100");
    EXPECT_EQ(result.renamed[2].to, "1102");
    EXPECT_EQ(result.replacements.size(), 7u);
    // The comment and the instrument "100" are no points: they stay.
    ExpectEdit(std::move(result), "GEOBASE PYRALIS\t1\n"
                                  "1000\tLevé du 12 mars : points 100 à 102\n"
                                  "1008\t100\t0\t0\t0\t0\t0\t0\n"
                                  "1006\tS1\t1000\t2000\t50\t-\n"
                                  "1006\t1100\t1010\t2000\t-999999\t-\tBORNE\n"
                                  "1001\tS1\t1.5\t-999999\n"
                                  "1002\t1100\t1.3\t100\t100\t10\n"
                                  "1003\t1101\t1.3\t150\t100\t12\n"
                                  "1011\tPT_Sans_Ori\t\t1101\n"
                                  "1003\tS2\t1.3\t200\t100\t50\n"
                                  "1001\tS2\t1.6\t-999999\n"
                                  "1003\tS1\t1.3\t0\t100\t50\n"
                                  "1003\t1102\t1.3\t300\t100\t8\n"
                                  "1001\tS1\t1.5\t-999999\n"
                                  "1002\tS2\t1.3\t200\t100\t50\n"
                                  "1004\t1100\t1.234\t20\n"
                                  "1005\t1102\t1.456\t20\n"
                                  "1007\tS1\t1\t3\tS1(1)\tS2\tS1(2)\n");
}

// Stations are points: a new prefix on every point renames the stations, both reprises of S1, and the
// traverse's designations with their reprises; the traverse's own name stays.
TEST_F(Renumbering, ANewPrefixOnEveryPointTakesTheStationsAndTheTraverseAlong) {
    RenumberRequest request;
    request.newPrefix = "B";
    ExpectEdit(RenumberPoints(carnet, request), "GEOBASE PYRALIS\t1\n"
                                                "1000\tLevé du 12 mars : points 100 à 102\n"
                                                "1008\t100\t0\t0\t0\t0\t0\t0\n"
                                                "1006\tB1\t1000\t2000\t50\t-\n"
                                                "1006\tB100\t1010\t2000\t-999999\t-\tBORNE\n"
                                                "1001\tB1\t1.5\t-999999\n"
                                                "1002\tB100\t1.3\t100\t100\t10\n"
                                                "1003\tB101\t1.3\t150\t100\t12\n"
                                                "1011\tPT_Sans_Ori\t\tB101\n"
                                                "1003\tB2\t1.3\t200\t100\t50\n"
                                                "1001\tB2\t1.6\t-999999\n"
                                                "1003\tB1\t1.3\t0\t100\t50\n"
                                                "1003\tB102\t1.3\t300\t100\t8\n"
                                                "1001\tB1\t1.5\t-999999\n"
                                                "1002\tB2\t1.3\t200\t100\t50\n"
                                                "1004\tB100\t1.234\t20\n"
                                                "1005\tB102\t1.456\t20\n"
                                                "1007\tS1\t1\t3\tB1(1)\tB2\tB1(2)\n");
}

TEST_F(Renumbering, NewIdentifiersAreBuiltFromPrefixNumberAndWidth) {
    const auto renamed = [](const pyr::CCarnet& store, const RenumberRequest& request) {
        std::string text;
        for (const auto& entry : RenumberPoints(store, request).renamed)
            text += entry.from + ">" + entry.to + " ";
        return text;
    };
    pyr::CCarnet store;
    for (const char* id : {"A009", "A12", "7", "BORNE", "PT12B"})
        store.Add(std::make_unique<pyr::CPointGen>(id, 1.0, 2.0), pyr::kKindPoint);
    RenumberRequest shift;
    shift.offset = 1;
    EXPECT_EQ(renamed(store, shift), "A009>A010 A12>A13 7>8 ");
    EXPECT_EQ(RenumberPoints(store, shift).unnumbered, (std::vector<std::string>{"BORNE", "PT12B"}));
    shift.offset = -7;
    shift.newPrefix = "P-";
    EXPECT_EQ(renamed(store, shift), "A009>P-002 A12>P-05 7>P-0 ");
    // From a start number, in GéoBase order, every point gets a number, numbered or not.
    RenumberRequest start;
    start.mode = RenumberRequest::Mode::Start;
    start.start = 98;
    start.newPrefix = "R";
    start.minDigits = 3;
    EXPECT_EQ(renamed(store, start), "A009>R098 A12>R099 7>R100 BORNE>R101 PT12B>R102 ");
    start.newPrefix.reset();
    start.selection = "A1-A20";
    EXPECT_EQ(renamed(store, start), "A009>98 A12>99 ");
}

// A point may take the identifier another one leaves: a chain shifted by one is accepted whole.
TEST_F(Renumbering, APointMayTakeTheIdentifierThatAnotherLeaves) {
    RenumberRequest request;
    request.selection = "100-102";
    request.offset = 1;
    RenumberResult result = RenumberPoints(carnet, request);
    ASSERT_FALSE(result.Refused()) << result.refusals.front();
    Apply(carnet, result.replacements);
    EXPECT_EQ(carnet.matAt(3), "101");
    EXPECT_EQ(carnet.matAt(6), "102");
    EXPECT_EQ(carnet.matAt(11), "103");
    EXPECT_EQ(carnet.matAt(14), "101");
}

TEST_F(Renumbering, ARefusalRenumbersNothingAndSaysWhy) {
    const std::string before = Text(carnet);
    RenumberRequest request;
    request.selection = "150-100";
    request.offset = 1;
    ExpectRefused(RenumberPoints(carnet, request), "La liste de sélection des points n'est pas correcte !");
    request.selection = "100-101"; // 101 goes to 102, which stays
    ExpectRefused(RenumberPoints(carnet, request),
                  "Le point <102> existe déjà : la renumérotation est refusée.");
    request.selection = "S2";
    request.offset = -1; // onto the station S1, kept
    ExpectRefused(RenumberPoints(carnet, request),
                  "Le point <S1> existe déjà : la renumérotation est refusée.");
    request.selection = "999";
    ExpectRefused(RenumberPoints(carnet, request), pyr::msg::kRenumberNothing);
    request.selection.clear();
    request.offset = 0;
    ExpectRefused(RenumberPoints(carnet, request), pyr::msg::kRenumberNothing);
    request.newPrefix = "B,";
    ExpectRefused(RenumberPoints(carnet, request),
                  "Le point <S1> deviendrait <B,1>, qui n'est pas un matricule correct : il contient « , », "
                  "qui sépare les points d'une sélection. La renumérotation est refusée.");
    request.newPrefix.reset();
    request.offset = pyr::kMaxMatNumber;
    ExpectRefused(RenumberPoints(carnet, request),
                  pyr::Sprintf(pyr::msg::kRenumberOutOfRange, "S1")); // S1 + the largest number
    EXPECT_EQ(Text(carnet), before);

    // Two points sent to one identifier; a long list of refusals ends with a count.
    pyr::CCarnet store;
    for (int i = 1; i <= 30; ++i)
        for (const char* prefix : {"A", "B"})
            store.Add(std::make_unique<pyr::CPointGen>(prefix + std::to_string(i), 1.0, 2.0),
                      pyr::kKindPoint);
    RenumberRequest merge;
    merge.newPrefix = "C";
    const RenumberResult result = RenumberPoints(store, merge);
    ExpectRefused(result,
                  "Les points <A1> et <B1> recevraient tous deux le matricule <C1> : la renumérotation "
                  "est refusée.");
    ASSERT_EQ(result.refusals.size(), pyr::kRenumberRefusalsListed + 1u);
    EXPECT_EQ(result.refusals.back(), "... et 10 autres refus.");
}

// The station and everything that bears its name: both reprises, its point, its sightings from S2, the
// traverse's designations (reprises kept). The traverse named "S1" and the other points stay.
TEST_F(Renumbering, ARenamedStationTakesItsRepriseSightingsPointAndTraversesAlong) {
    RenumberResult result = RenameStation(carnet, "S1", " B7 ");
    ASSERT_EQ(result.renamed.size(), 1u);
    EXPECT_EQ(result.renamed[0].to, "B7");
    ExpectEdit(std::move(result), "GEOBASE PYRALIS\t1\n"
                                  "1000\tLevé du 12 mars : points 100 à 102\n"
                                  "1008\t100\t0\t0\t0\t0\t0\t0\n"
                                  "1006\tB7\t1000\t2000\t50\t-\n"
                                  "1006\t100\t1010\t2000\t-999999\t-\tBORNE\n"
                                  "1001\tB7\t1.5\t-999999\n"
                                  "1002\t100\t1.3\t100\t100\t10\n"
                                  "1003\t101\t1.3\t150\t100\t12\n"
                                  "1011\tPT_Sans_Ori\t\t101\n"
                                  "1003\tS2\t1.3\t200\t100\t50\n"
                                  "1001\tS2\t1.6\t-999999\n"
                                  "1003\tB7\t1.3\t0\t100\t50\n"
                                  "1003\t102\t1.3\t300\t100\t8\n"
                                  "1001\tB7\t1.5\t-999999\n"
                                  "1002\tS2\t1.3\t200\t100\t50\n"
                                  "1004\t100\t1.234\t20\n"
                                  "1005\t102\t1.456\t20\n"
                                  "1007\tS1\t1\t3\tB7(1)\tS2\tB7(2)\n");
}

TEST_F(Renumbering, AStationIsNotRenamedOntoAnotherStationOrPointNorToABadName) {
    ExpectRefused(RenameStation(carnet, "S1", "  "), pyr::msg::kMatMissing);
    ExpectRefused(RenameStation(carnet, "S1", "A 1"),
                  "Le matricule <A 1> n'est pas correct : il contient un espace !");
    ExpectRefused(RenameStation(carnet, "S1", "-A1"),
                  "Le matricule <-A1> n'est pas correct : il commence par un tiret !");
    ExpectRefused(RenameStation(carnet, "S1", "S2"),
                  "La station <S2> existe déjà : le changement de nom de la station est refusé.");
    ExpectRefused(RenameStation(carnet, "S2", "100"),
                  "Le point <100> existe déjà : le changement de nom de la station est refusé.");
    ExpectRefused(RenameStation(carnet, "101", "S9"), "La station <101> n'existe pas dans la GéoBase.");
    ExpectRefused(RenameStation(carnet, "S2", "S2"), "La station <S2> porte déjà ce nom.");
    EXPECT_EQ(Text(carnet), kJob);
}

// The sightings a reader found before any station hang from "INCONNUE"; the surveyor knows the station
// stood on P5, a point only sighted so far (from S2): the station takes that name, in the traverse too,
// and S2's sighting of P5 is now a sighting of that station.
TEST_F(Renumbering, TheUnknownStationIsGivenTheNameOfThePointItStoodOn) {
    WriteBytes(dir / "b.geo", "GEOBASE PYRALIS\t1\n"
                              "1001\tINCONNUE\t0\t-999999\n"
                              "1003\t1\t1.3\t10\t100\t20\n"
                              "1003\t2\t1.3\t20\t100\t30\n"
                              "1001\tS2\t1.6\t-999999\n"
                              "1003\tP5\t1.3\t0\t100\t40\n"
                              "1007\tC1\t0\t2\tS2\tINCONNUE(1)\n");
    pyr::CCarnet job;
    ASSERT_EQ(job.Load(nullptr, dir / "b.geo"), 1);
    RenumberResult result = RenameStation(job, "INCONNUE", "P5");
    ASSERT_FALSE(result.Refused()) << result.refusals.front();
    EXPECT_EQ(result.replacements.size(), 2u);
    Apply(job, result.replacements);
    EXPECT_EQ(Text(job), "GEOBASE PYRALIS\t1\n"
                         "1001\tP5\t0\t-999999\n"
                         "1003\t1\t1.3\t10\t100\t20\n"
                         "1003\t2\t1.3\t20\t100\t30\n"
                         "1001\tS2\t1.6\t-999999\n"
                         "1003\tP5\t1.3\t0\t100\t40\n"
                         "1007\tC1\t0\t2\tS2\tP5(1)\n");
}

} // namespace

// Topcon GTS-7 keyword field books read into GéoBases. The field books tests/data/fieldbook/topcon-*.gts7
// were written for these tests; every expected value is worked out by hand from the text as written:
// 123°45'30" = 123.758333° = 137.50926 gr, 87°30'15" = 97.22685 gr, 359°59'59.9" = 399.99997 gr; a
// horizontal distance of 30 m with a height difference of 40 m is the 3-4-5 triangle, slope distance
// 50 m and zenith angle atan(3/4) = 36.869898° = 40.96655 gr; one foot is 0.3048 m.
#include "FieldBookTestSupport.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectTopcon.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

constexpr double kNone = kUndefined;
using TopconRun = DriverRun<CLectTopcon, FieldBookFormat::TopconGT7>;

// A station with its known point, ready for one sighting.
const std::string kStation = "STN     S1,1.500,\nXYZ     1000.000,2000.000,100.000\n";

} // namespace

TEST(LectTopcon, AMetreAndDmsFieldBookGivesItsStationReferenceAndSightings) {
    TopconRun run;
    const CCarnet& read = run.ReadFile("topcon-metres-dms.gts7");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Logiciel             = GTS-7 export; 1000 Chantier             = ESSAI; "
              "1000 Date                 = 01/02/24 08:30:00; "
              "1000 Appareil             = GTS-701; "
              "1000 Unités               = mètres, degrés (ddd.mmss); "
              "1009 BORNE; 1006 S1; 1001 S1; "
              "1000 Orientation sur <A1> : gisement 100.00000 gr, lecture 0.00000 gr; 1006 A1; "
              "1002 A1; 1009 ARB; 1003 101; 1003 102; 1009 MUR; 1003 103; 1000 fin de station; ");
    ExpectValues(read, 6, {1000.0, 2000.0, 100.0});
    EXPECT_NEAR(read.hiAt(7), 1.55, 1e-4);
    EXPECT_EQ(read.v0At(7), kUndefined); // left to the orientation computation
    ExpectValues(read, 9, {1100.0, 2000.0, 100.0});
    ExpectValues(read, 10, {1.3, 0.0, 100.0, kNone});            // HV: no distance, not 0
    ExpectValues(read, 12, {1.3, 137.50926, 97.22685, 25.1234}); // to the 0.1 mm written
    ExpectValues(read, 13, {1.3, 50.0, 40.96655, 50.0});         // HD 30, VD 40: the 3-4-5 triangle
    ExpectValues(read, 15, {1.3, 399.99997, 300.0, kNone});      // face II kept as read
}

TEST(LectTopcon, AFeetAndGradsFieldBookIsReadInMetres) {
    TopconRun run;
    // The parameter file says degrees: the field book's own UNITS line wins.
    const CCarnet& read = run.Set(kKeyUniteAngles, "dms").ReadFile("topcon-feet-grads.gts7");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Unités               = pieds, grades; 1006 S2; 1001 S2; 1003 201; 1003 202; ");
    ExpectValues(read, 1, {304.8, 609.6, kNone});
    EXPECT_NEAR(read.hiAt(2), 1.524, 1e-4);
    ExpectValues(read, 3, {1.524, 150.0, 100.0, 30.48});
    // No target height, no height difference: the horizontal distance is kept on a level sighting.
    ExpectValues(read, 4, {kNone, 250.0, 100.0, 3.048});
}

TEST(LectTopcon, UnitsComeFromTheFieldBookElseFromTheParameterFile) {
    struct Case {
        const char* angles;
        const char* lengths;
        const char* units; // the UNITS line, or none
        const char* sd;
        double ah, av, di;
    };
    const Case cases[] = {
        {"dms", "metres", "", "123.45300,90.00000,10.000", 137.50926, 100.0, 10.0},
        {"mils", "pieds", "", "1600,3200,10.000", 100.0, 200.0, 3.048},
        {"dms", "pieds", "UNITS   M,G\n", "123.4567,99.1234,10.000", 123.4567, 99.1234, 10.0},
        {"grades", "metres", "UNITS   f,d\n", "0.00010,90.00000,10.000", 0.00031, 100.0, 3.048},
        {"grades", "pieds", "UNITS   ,D\n", "45.00000,90.00000,10.000", 50.0, 100.0, 3.048},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(std::string(c.angles) + " " + c.lengths + " " + c.units);
        TopconRun run;
        run.Set(kKeyUniteAngles, c.angles).Set(kKeyUniteDistances, c.lengths);
        const CCarnet& read =
            run.Read(std::string(c.units) + "STN     S1,,\nSS      1,,\nSD      " + c.sd + "\n");
        EXPECT_EQ(ReportText(run), "");
        ASSERT_EQ(read.GetType(read.GetSize() - 1), kKindMesure);
        ExpectValues(read, read.GetSize() - 1, {kNone, c.ah, c.av, c.di});
    }
}

TEST(LectTopcon, MissingValuesStayUndefined) {
    TopconRun run;
    const CCarnet& read = run.Read("STN     S1\nBS      A1\nHV      12.3456,\nSS      2,1.2,\nSD      ,,7.5\n"
                                   "SS      3,0.000\nSD      1.0,100.0,\nXYZ     ,,55.5\n");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read), "1001 S1; 1002 A1; 1003 2; 1003 3; ");
    EXPECT_EQ(read.hiAt(0), kUndefined);
    ExpectValues(read, 1, {kNone, 12.3456, kNone, kNone});
    ExpectValues(read, 2, {1.2, kNone, kNone, 7.5});
    ExpectValues(read, 3, {0.0, 1.0, 100.0, kNone}); // a target height of 0 is a value
}

TEST(LectTopcon, TheCoordinateOrderAndTheComputedPointsFollowTheSettings) {
    const std::string text = "STN     S1,1.5,\nXYZ     2000.000,1000.000,100.000\n"
                             "SS      7,1.3,\nSD      0.0,100.0,10.0\nXYZ     2010.000,1000.000,100.000\n";
    TopconRun run;
    const CCarnet& read = run.Set(kKeyOrdreCoordonnees, "YX").Set(kKeyPointsCalcules, "1").Read(text);
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read), "1006 S1; 1001 S1; 1003 7; 1006 7; ");
    ExpectValues(read, 0, {1000.0, 2000.0, 100.0}); // the northing first: X stays the easting
    ExpectValues(read, 3, {1000.0, 2010.0, 100.0});

    TopconRun without;
    EXPECT_EQ(ElementsSummary(without.Read(text)), "1006 S1; 1001 S1; 1003 7; ");
    EXPECT_EQ(ReportText(without), "");
    ExpectValues(without.result, 0, {2000.0, 1000.0, 100.0});
}

TEST(LectTopcon, ReferencesAreBacksightsOrMarkedBySettings) {
    // BS, a fore sight at the BKB point, the first sighting, a coded one.
    const std::string text =
        kStation + "BKB     A1,0.0,0.0\nSS      1,1.3,\nHV      0,100\nFS      A1,1.3,\n"
                   "HV      0,100\nBS      B2,1.3\nHV      0,100\nSS      3,1.3,ref\nHV      0,100\n";
    EXPECT_EQ((KindsByMarking<CLectTopcon, FieldBookFormat::TopconGT7>(text, "REF,99")),
              (std::vector<std::string>{"1003 1002 1002 1003 ", "1002 1002 1002 1003 ", "1003 1002 1002 1002 "}));
}

// Each report by its line and gravity: the wordings are the reader's constants.
TEST(LectTopcon, EveryLineIsReadOrReportedWithItsNumber) {
    const std::pair<std::string, const char*> cases[] = {
        {"STN     S1,1.5,\nCTLX    1,2\n", "Erreur ligne 2\n"},
        {"STN     S1,1.5,\nSS      101,1.3,\nSS      102,1.3,\nHV      1,2\n", "Erreur ligne 2\n"},
        {"STN     S1,1.5,\nHV      1,2\n", "Erreur ligne 2\n"},
        {"JOB     X\nXYZ     1,2,3\n", "Erreur ligne 2\n"},
        {"STN     ,1.5\n", "Erreur ligne 1\n"},
        {"STN     S1\nSS      1,1.3\nSD      1.2.3,100,5\n", "Erreur ligne 3\nErreur ligne 2\n"},
        {"UNITS   X,G\n", "Erreur ligne 1\n"},
        {"STN     S1\nSS      9,1.3\nSD      1,100,5\nOFFSET  0.5,0,0\n", "Attention : ligne 4\n"},
        {"SS      1,1.3\nHV      1,100\n", "Attention : ligne 1\n"},
        {"STN     S1,1.5,\nSS      101,1.3,\n", "Erreur ligne 2\n"}, // a sighting without observation, last
        {"STN     S1,1.5,\nSS      1,1.3,\nHV      1,2\nHV      3,4\n", "Erreur ligne 4\n"},
        {"STN     S1\nSS      ,1.3\n", "Erreur ligne 2\n"},
        {"STN     S1\nXYZ     1000.0,,5\n", "Erreur ligne 2\n"},
        {"STN     S1\nSS      1,1.3\nSD      nan,100,inf\n", "Erreur ligne 3\nErreur ligne 2\n"},
        {"STN     S1\nSS      1,1.3\nHV      ,\n", "Erreur ligne 3\nErreur ligne 2\n"},
    };
    for (const auto& [text, heads] : cases) {
        TopconRun run;
        run.Read(text);
        EXPECT_EQ(ReportHeads(run), heads) << text;
    }
}

// This reader's own message: the field book named, then the reason in words.
TEST(LectTopcon, AFieldBookThatCannotBeOpenedIsNamedInTheMessage) {
    TopconRun run;
    const std::string path = FieldBookData("topcon-absent.gts7");
    EXPECT_FALSE(run.reader.Read(path, run.result));
    EXPECT_EQ(MessageTexts(run.frontEnd), Sprintf(fb::kMsgCannotOpenCarnetForReading, path.c_str()) +
                                              "\n(fichier ou dossier inexistant)");
    EXPECT_EQ(run.result.GetSize(), 0);
}

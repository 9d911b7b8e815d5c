// Trimble GDM (Geodimeter) label files read into GéoBases. The field books tests/data/fieldbook/gdm-* were
// written for these tests; every expected value is worked out by hand from the labels as written
// (123°45'30" = 123.758333° = 137.50926 gr; 89°18'05" = 99.22377 gr; a face II circle reading is half a
// turn from face I and its zenith angle the complement to 400 gr).
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "fieldbook/LectGeodim.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

using GeodimRun = DriverRun<CLectGeodim, FieldBookFormat::Geotronics>;

} // namespace

// The job file: header labels, the units of label 23 (DMS, metres), a station with its coordinates
// oriented on A1 (62) with its circle reading on A1 (21), both faces of A1 measured again, a value repeated
// in a block (the last counts), a signal height (its block's, holding until the next one), and a face II
// sighting alone.
TEST(LectGeodim, AJobFileGivesItsStationFacesAndSightingsInGradsAndMetres) {
    GeodimRun run;
    const CCarnet& read = run.ReadFile("gdm-chantier.job");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Chantier             = CHANTIER TEST; 1000 Date                 = 12.06.2024; "
              "1000 Appareil             = GDM 640; 1000 Unités               = 3111; 1006 S1; 1001 S1; "
              "1002 A1; 1009 REF; 1002 A1; 1002 A1; 1003 104; 1003 105; 1003 106; ");
    ExpectValues(read, 4, {1000.0, 2000.0, 100.0}); // 38 is X (east), 37 is Y (north)
    EXPECT_NEAR(read.hiAt(5), 1.55, 1e-4);
    ExpectValues(read, 6, {kUndefined, 100.0, kUndefined, kUndefined}); // 21: 90°
    ExpectValues(read, 8, {1.3, 100.0, 100.0, 100.0});                  // face I from 24/25, not the mean 7
    ExpectValues(read, 9, {1.3, 100.0, 100.0, kUndefined}); // face II turned; the distance went with face I
    ExpectValues(read, 10, {1.3, 0.0, 99.2237654, 10.0007434});      // DI = DH / sin V
    ExpectValues(read, 11, {0.0, 137.5092593, 102.7777778, 25.125}); // its own 6, after its angles
    ExpectValues(read, 12, {0.0, 0.0, 100.0, 12.5}); // face II alone, horizontal distance alone
}

// A station block as the instruments write it: the station's coordinates, its orientation point (62)
// followed by that point's coordinates, the circle reading set on it (21) and a distance of 0 (none
// measured). Each point block carries the instrument's own coordinates of the point (37/38/39). The
// geometry is constructed: S1 (1000, 2000, 100), HI 1.550, oriented on B1 (1180, 2075, 103.5) with V0 =
// 37.1234 gr; from S1 the points 101, 102 and S2 (1060, 1950, 98.4); S2, HI 1.420, oriented back on S1
// with V0 = 312.0457 gr, then 201 and 202. The recorded coordinates were computed from the angles and
// distances as written (4 decimals in grads, mm), so that each sighting radiated from the GéoBase finds
// its point within the rounding of the book.
TEST(LectGeodim, StationBlocksOrientedAsTheInstrumentDidGiveItsOwnCoordinates) {
    GeodimRun run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile("gdm-station-orientee.job");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read), "1000 Chantier             = CONTROLE RAYONNEMENT; "
                                     "1000 Unités               = 1111; 1006 S1; 1006 B1; 1001 S1; 1002 B1; "
                                     "1003 101; 1006 101; 1003 102; 1006 102; 1003 S2; 1006 S2; 1006 S2; "
                                     "1001 S2; 1002 S1; 1003 201; 1006 201; 1003 202; 1006 202; ");
    ExpectValues(read, 2, {1000.0, 2000.0, 100.0}); // the station's, not its orientation point's
    ExpectValues(read, 3, {1180.0, 2075.0, 103.5});
    ExpectValues(read, 5, {kUndefined, 37.7434, kUndefined, kUndefined}); // 21, and no distance of 0
    EXPECT_TRUE(AgreesWithInstrument(read, 5)); // 101, 102, S2 from S1; 201, 202 from S2

    // A distance of 0 alone is no sighting: without 21, the orientation point is not sighted.
    GeodimRun bare;
    EXPECT_EQ(ElementsSummary(bare.Read("2=S\n62=R\n11=0.000\n5=P\n7=1\n9=0\n")), "1001 S; 1003 P; ");
    ExpectValues(bare.result, 1, {kUndefined, 1.0, kUndefined, kUndefined});
}

// Angle units from label 23 (first digit) or, without it, from "UniteAngles"; distances from its second
// digit. What the file declares wins.
TEST(LectGeodim, UnitsComeFromLabel23BeforeTheSettings) {
    const std::tuple<const char*, const char*, double, double, double> cases[] = {
        {"23=1111\n", "dms", 137.50926, 99.22376, 25.125}, // 7=137.50926 8=99.22376 read as grads
        {"23=3111\n", "grades", 137.5092593, 99.2237654, 25.125},
        {"", "dms", 137.5092593, 99.2237654, 25.125},
        {"23=2211\n", "grades", 123.45300 / 0.9, 89.18050 / 0.9, 25.125 * 0.3048},
        {"23=4111\n", "grades", 123.45300 / 16.0, 89.18050 / 16.0, 25.125},
        {"23=9111\n", "grades", 123.453, 89.1805, 25.125}, // unknown digits: the settings stay
    };
    for (const auto& [units, setting, ah, av, di] : cases) {
        GeodimRun run;
        const bool grads = std::string(units) == "23=1111\n";
        const std::string book = std::string(units) + "2=S\n5=P\n7=" + (grads ? "137.50926" : "123.4530") +
                                 "\n8=" + (grads ? "99.22376" : "89.1805") + "\n9=25.125\n";
        const CCarnet& read = run.Set(kKeyUniteAngles, setting).Read(book);
        ASSERT_EQ(read.GetSize(), units[0] ? 3 : 2) << units << setting;
        ExpectValues(read, read.GetSize() - 1, {kUndefined, ah, av, di});
    }
}

// References: the point a station is oriented on (62), a point known earlier in the field book, or the
// settings; everything else is measured.
TEST(LectGeodim, ReferencesAreTheOrientationKnownPointsOrWhatTheSettingsSay) {
    // Station T, its sightings unmarked, shows the first sighting marked.
    const std::string book = "5=K\n38=10\n37=20\n2=S\n62=R\n5=R\n7=1\n5=K\n7=2\n5=M\n4=AV\n7=3\n5=N\n7=4\n"
                             "2=T\n5=A\n7=1\n5=B\n7=2\n";
    EXPECT_EQ((KindsByMarking<CLectGeodim, FieldBookFormat::Geotronics>(book, "av,X")),
              (std::vector<std::string>{"1002 1002 1003 1003 1003 1003 ", "1002 1002 1003 1003 1002 1003 ",
                                        "1002 1002 1002 1003 1003 1003 "}));
}

// The area file: negative coordinates, a code in front of its point, planimetry or altimetry alone.
TEST(LectGeodim, AnAreaFileGivesKnownPointsWithTheirCodes) {
    GeodimRun run;
    const CCarnet& read = run.ReadFile("gdm-points.are");
    EXPECT_EQ(ReportHeads(run), "Erreur ligne 6\n");
    ASSERT_EQ(ElementsSummary(read), "1009 BORNE; 1006 B1; 1006 B3; ");
    ExpectValues(read, 1, {-23779.46, 12273.89, -3.25});
    ExpectValues(read, 2, {kUndefined, kUndefined, 12.345});
}

// Slope distances from the horizontal one: by the zenith angle, or with the height difference; the
// instrument's coordinates of a sighted point kept only when asked.
TEST(LectGeodim, DistancesAndComputedPoints) {
    GeodimRun run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1")
                              .Read("2=S\n5=A\n7=0\n8=80\n11=100\n5=B\n7=0\n11=30\n10=4\n38=5\n37=6\n");
    ASSERT_EQ(ElementsSummary(read), "1001 S; 1003 A; 1003 B; 1006 B; ");
    ExpectValues(read, 1, {kUndefined, 0.0, 80.0, 105.1462224});
    ExpectValues(read, 2, {kUndefined, 0.0, 91.5615074, 30.2654919});
    ExpectValues(read, 3, {5.0, 6.0, kUndefined});
}

// Every line is read or reported with its number, and the reading goes on; the bytes of a transmission
// (STX, ETX, Ctrl-Z, CR line ends, trailing blanks) are no data.
TEST(LectGeodim, EveryLineIsReadOrReportedWithItsNumber) {
    GeodimRun run;
    const CCarnet& read = run.Read("\x02"
                                   "7=1\r2=S \r\r5=A\r8=\r9=x\rbonjour\r99=1\r99=2\r5=\r7=5\r"
                                   "5=B\r4=C\r5=C\r7=3\r6\r\x03\x1a");
    // The incomplete commands are told as the lines are cut, the rest as the blocks are read.
    EXPECT_EQ(ReportHeads(run), "Erreur ligne 5\n -> Chaîne lue = <8=>\nErreur ligne 7\n -> Chaîne lue = "
                                "<bonjour>\nErreur ligne 10\n -> Chaîne lue = <5=>\nErreur ligne 16\n -> "
                                "Chaîne lue = <6>\nErreur ligne 1\nErreur ligne 6\nAttention : ligne 8\n"
                                "Erreur ligne 4\nErreur ligne 12\n");
    EXPECT_EQ(ElementsSummary(read), "1001 S; 1009 C; 1003 C; ");
}

// The records go through a temporary file beside the field book, deleted at the end; a field book that
// itself ends in ".tmp" is read where it lies and kept, and so is a ".tmp" already there.
TEST(LectGeodim, TheTemporaryCopyIsDeletedAndNeverReplacesTheFieldBook) {
    TempDir dir;
    const std::string job = dir / "levé.job", copy = dir / "levé.tmp";
    for (const std::string& path : {job, copy}) {
        WriteBytes(path, "2=S\n5=A\n7=1\n");
        GeodimRun run;
        ASSERT_TRUE(run.reader.Read(path, run.result));
        EXPECT_EQ(ElementsSummary(run.result),
                  "1000 Fichier              = " + std::filesystem::path(path).filename().string() +
                      "; 1001 S; 1003 A; ");
        EXPECT_EQ(std::filesystem::exists(copy), path == copy);
    }
    // A ".tmp" of the surveyor's beside the field book is neither written over nor deleted.
    GeodimRun again;
    ASSERT_TRUE(again.reader.Read(job, again.result));
    EXPECT_EQ(ReadBytes(copy), "2=S\n5=A\n7=1\n");
    EXPECT_FALSE(std::filesystem::exists(copy + ".tmp"));
}

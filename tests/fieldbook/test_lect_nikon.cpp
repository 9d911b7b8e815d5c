// Nikon comma field books read into GéoBases. The field books of tests/data/fieldbook/nikon-* were written
// for these tests from the record layouts of the instruments' manuals. Their geometry is constructed:
// station S1 at (1000, 2000, 100) with an instrument height of 1.550, the known point A1 100 m to the east
// (bearing 100 gr, read at Hz 100 gr), point 104 10 m to the north, level. Every expected value is worked
// out by hand from the record as written: 123°45'30" = 123.758333° = 137.509259 gr, 91°23'45" = 101.550926
// gr, 89°52'43" = 99.865123 gr, 10 ft = 3.048 m.
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "fieldbook/LectNikon.h"

#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

using NikonRun = DriverRun<CLectNikon, FieldBookFormat::NikonAtlas>;

int Last(const CCarnet& carnet) {
    return carnet.GetSize() - 1;
}

} // namespace

TEST(LectNikon, ARawFieldBookGivesItsPointsStationBacksightsAndShots) {
    NikonRun run;
    const CCarnet& read = run.ReadFile("nikon-raw-gons.raw");
    // The superseded shot (*SS) is skipped without a word; the calculated point CC is not kept without the
    // setting; the Ctrl-Z at the end is no line.
    EXPECT_EQ(ReportText(run), "Erreur ligne 19 : donnée non reconnue !\n");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = Nikon RAW data format V2.00; "
              "1000 Unité des distances  = Metres; 1000 Unité des angles     = Gons; "
              "1000 Zéro vertical        = Zenith; 1000 Ordre coordonnées    = NEZ; "
              "1000 Appareil             = Nikon DTM-352; "
              "1000 Transfert            = 02-Mar-2024 10:15:00; 1009 STA; 1006 S1; 1006 A1; "
              "1001 S1; 1000 Station <S1> : référence <A1>, gisement 100.00000 gr, lecture Hz "
              "100.00000 gr; 1002 A1; 1002 A1; 1009 ARB; 1003 104; 1003 105; 1002 A1; 1003 106; ");
    ExpectValues(read, 8, {1000.0, 2000.0, 100.0}); // N, E, Z in the file: X is the easting
    ExpectValues(read, 9, {1100.0, 2000.0, 100.0});
    EXPECT_NEAR(read.hiAt(10), 1.55, 1e-4);
    EXPECT_EQ(read.v0At(10), kUndefined);
    ExpectValues(read, 12, {1.3, 100.0, 99.8563, 100.001});  // F1 without a point: the station's backsight
    ExpectValues(read, 13, {1.3, 300.0, 300.1437, 100.001}); // face II kept as read
    ExpectValues(read, 15, {1.3, 0.0, 100.0, 10.0});
    ExpectValues(read, 16, {1.3, 50.0, 100.0, 12.5});          // the point's number, its identifier beside it
    ExpectValues(read, 17, {1.3, 100.0002, 99.8563, 100.002}); // a check shot on a known point
    ExpectValues(read, 18, {1.3, 200.0, 100.0, 5.0});

    NikonRun computed;
    const CCarnet& withComputed = computed.Set(kKeyPointsCalcules, "1").ReadFile("nikon-raw-gons.raw");
    ASSERT_EQ(read.GetSize() + 1, withComputed.GetSize());
    ExpectValues(withComputed, Last(withComputed), {1000.0, 2010.0, 100.25});
}

// The same survey in grads, easting first, S1 oriented on an azimuth alone: its station record names no
// backsight point, gives the azimuth 60.2735 gr told to the instrument and the reading 22.8585 gr set on
// it, and its backsight shot names no point and measures no distance. The instrument computed with V0 =
// 60.2735 - 22.8585 = 37.4150 gr: the station keeps that orientation, since no reference can give it.
TEST(LectNikon, AStationOrientedOnAnAzimuthAloneKeepsItsOrientation) {
    NikonRun run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile("nikon-raw-gisement.raw");
    EXPECT_EQ(ReportText(run), "");
    EXPECT_TRUE(AgreesWithInstrument(read, 8)); // 101, 102, S2, 103; S1 in both faces, 201, 202
    const int s1 = read.Find(kKindStation, "S1", 0, 0), s2 = read.Find(kKindStation, "S2", 0, 0);
    EXPECT_NEAR(read.v0At(s1), 37.415, 1e-9);
    EXPECT_EQ(read.v0At(s2), kUndefined); // oriented on S1: left to the V0 computation

    // A V0 of 0 is one; below 0 it comes round; without the azimuth or the reading, or with a backsight
    // point, there is none, and a backsight shot without a point is reported.
    const std::tuple<const char*, double, const char*> cases[] = {
        {"ST,S1,,,,1.500,0.0000,0.0000", 0.0, ""},
        {"ST,S1,,,,1.500,10.0000,30.0000", 380.0, ""},
        {"ST,S1,,,,1.500,,30.0000", kUndefined, "Erreur ligne 2\n"},
        {"ST,S1,,A1,,1.500,10.0000,30.0000", kUndefined, ""},
    };
    for (const auto& [station, v0, heads] : cases) {
        NikonRun one;
        const CCarnet& oriented = one.Read(std::string(station) + "\nF1,,1.500,,30.0000,100.0000,10:00:00\n");
        SCOPED_TRACE(station);
        EXPECT_EQ(ReportHeads(one), heads);
        EXPECT_NEAR(oriented.v0At(oriented.Find(kKindStation, "S1", 0, 0)), v0, 1e-9);
    }
}

TEST(LectNikon, ADtmFieldBookGivesStationsFromTheirHeightAndUnitsPerRecord) {
    NikonRun run;
    const CCarnet& read = run.ReadFile("nikon-dtm.nik");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = Nikon DTM (virgules); 1006 S1; 1001 S1; 1006 A1; "
              "1002 A1; 1003 104; 1003 105; 1003 106; ");
    ExpectValues(read, 1, {1000.0, 2000.0, kUndefined});
    EXPECT_NEAR(read.hiAt(2), 1.55, 1e-4);
    ExpectValues(read, 3, {1100.0, 2000.0, 100.0});
    ExpectValues(read, 4, {1.3, 100.0, 99.865123, 100.001});       // MD: 90°00'00", 89°52'43"
    ExpectValues(read, 5, {1.3, 0.0, 100.0, 10.0});                // MG: grads
    ExpectValues(read, 6, {1.524, 137.509259, 101.550926, 3.048}); // FD: feet, 123°45'30", 91°23'45"
    ExpectValues(read, 7, {kUndefined, 200.0, 100.0, 8.0});        // MM: 3200 and 1600 mils; no target height
}

// The instrument height follows the first hyphen after which a number stands; an identifier may hold
// hyphens of its own.
TEST(LectNikon, ADtmIdentifierWithAnInstrumentHeightSetsUpAStation) {
    const std::tuple<const char*, const char*, double> cases[] = {
        {"1001--1.455", "1001", -1.455},
        {"A-1-1.5", "A-1", 1.5},
        {"B-2", "B", 2.0},
        {"S1-", "S1-", kUndefined}, // no height: an observation of point S1-
    };
    for (const auto& [field, name, hi] : cases) {
        NikonRun run;
        const CCarnet& read = run.Read(std::string("1 , 0 , MG , S0-1.5\n1 , 0 , MG , ") + field +
                                       " , 10.000 , 50.0000 , 100.0000 , 1.300\n");
        SCOPED_TRACE(field);
        EXPECT_EQ(ReportText(run), "");
        ASSERT_EQ(read.matAt(Last(read)), name);
        ASSERT_EQ(read.GetType(Last(read)), IsUndefined(hi) ? kKindMesure : kKindStation);
        if (!IsUndefined(hi)) {
            EXPECT_NEAR(read.hiAt(Last(read)), hi, 1e-4);
        }
    }
}

// One side shot under a declaration of the header and the settings of the parameter file: the file's
// declaration wins, the settings hold where it says nothing.
TEST(LectNikon, AnglesAndLengthsComeInGradsAndMetresWhateverTheUnit) {
    struct Case {
        const char* declaration;
        const char* angles;
        const char* distances;
        const char* hzV; // of a shot with a target height of 5 and a slope distance of 10
        double ah, av, metresPerUnit;
    };
    const Case cases[] = {
        {"Angle Units: DDDMMSS", "grades", "metres", "123.4530,91.2345", 137.509259, 101.550926, 1},
        {"Angle Units: Dec.Degrees", "grades", "metres", "45.0,90.0", 50.0, 100.0, 1},
        {"Angle Units: Mils", "grades", "metres", "1600,1600", 100.0, 100.0, 1},
        {"Angle Units: Gons", "dms", "metres", "123.4530,91.2345", 123.453, 91.2345, 1},
        {"Comments: none", "dms", "metres", "123.4530,91.2345", 137.509259, 101.550926, 1},
        {"Dist Units: Feet", "grades", "metres", "100,100", 100.0, 100.0, 0.3048},
        {"Dist Units: Metres", "grades", "pieds", "100,100", 100.0, 100.0, 1},
        {"Comments: none", "grades", "pieds", "100,100", 100.0, 100.0, 0.3048},
        {"Zero VA: Horizontal", "grades", "metres", "100,10.0000", 100.0, 90.0, 1},
        {"Zero VA: Horizontal", "grades", "metres", "100,-5.0000", 100.0, 105.0, 1},
        {"Zero VA: Horizontal", "dms", "metres", "100,9.0000", 111.111111, 90.0, 1},
    };
    for (const Case& c : cases) {
        NikonRun run;
        const std::string text = std::string("CO,") + c.declaration +
                                 "\nST,S1,,,,1.500,,\nSS,P,5.000,10.000," + c.hzV + ",10:00:00,\n";
        const CCarnet& read =
            run.Set(kKeyUniteAngles, c.angles).Set(kKeyUniteDistances, c.distances).Read(text);
        SCOPED_TRACE(text);
        EXPECT_EQ(ReportText(run), "");
        ASSERT_EQ(read.GetType(Last(read)), kKindMesure);
        ExpectValues(read, Last(read), {5 * c.metresPerUnit, c.ah, c.av, 10 * c.metresPerUnit});
    }
    NikonRun blanks;
    const CCarnet& read = blanks.Read("ST,S1,,,,1.500,,\nSS,P,,,100,,10:00:00,\n");
    ExpectValues(read, Last(read), {kUndefined, 100.0, kUndefined, kUndefined}); // missing, never 0
}

TEST(LectNikon, TheAxisOrderOfTheFileWinsOverTheSettings) {
    const std::tuple<const char*, const char*, double, double> cases[] = {
        {"", "XY", 1.0, 2.0},
        {"", "YX", 2.0, 1.0},
        {"Coord Order: NEZ", "XY", 2.0, 1.0},
        {"Coord Order: ENZ", "YX", 1.0, 2.0},
    };
    for (const auto& [declaration, order, x, y] : cases) {
        NikonRun run;
        const CCarnet& read = run.Set(kKeyOrdreCoordonnees, order)
                                  .Read(std::string("CO,") + declaration + "\nMP,P,,1.000,2.000,,\n");
        SCOPED_TRACE(declaration + std::string(" ") + order);
        ASSERT_EQ(read.GetType(Last(read)), kKindPoint);
        ExpectValues(read, Last(read), {x, y, kUndefined}); // no elevation: missing, not 0
    }
}

// Sightings that the file does not mark as backsights: references by the settings or by their point's
// coordinates.
TEST(LectNikon, ReferenceSightingsAreTheBacksightsAndWhatTheSettingsMark) {
    const char* book = "MP,K,,5.000,5.000,0.000,\nST,S1,,,,1.500,,\nSS,P1,1.3,10,0,100,10:00:00,\n"
                       "SS,P2,1.3,10,0,100,10:00:00,REF\nSS,K,1.3,10,0,100,10:00:00,\n";
    EXPECT_EQ((KindsByMarking<CLectNikon, FieldBookFormat::NikonAtlas>(book, "REF")),
              (std::vector<std::string>{"1003 1003 1002 ", "1002 1003 1002 ", "1003 1002 1002 "}));
}

TEST(LectNikon, EveryLineIsReadOrReportedWithItsNumber) {
    NikonRun run;
    const CCarnet& read = run.Read("SS,P0,1.3,10,0,100,10:00:00,\n" // no station yet
                                   "ST,S1,,,,1.500,,\n"
                                   "SS,P1,1.3,1O.5,0,100,10:00:00,\n" // a letter O for a zero
                                   "ZZ,1,2,3\n"
                                   "MP,P2,,100.000,,5.0,\n"
                                   "SS,,1.3,10,0,100,10:00:00,\n"
                                   "SS,P3,1.3,,,,10:00:00,\n"
                                   "CO,Angle Units: Radians\n"
                                   "1 , 7 , MD , 5 , 1 , 2 , 3 , 1.5\n"
                                   "1 , 0 , XX , 5 , 1 , 2 , 3 , 1.5\n"
                                   "SS,P4,1.3,10,0,450,10:00:00,\n"
                                   "SS,P5,1.3,10,0,100,10:00:00,\n");
    EXPECT_EQ(ReportHeads(run), "Attention : ligne 1\nErreur ligne 3\nErreur ligne 4\nErreur ligne 5\n"
                                "Erreur ligne 6\nErreur ligne 7\nAttention : ligne 8\nErreur ligne 9\n"
                                "Erreur ligne 10\nVisée <P4> : angle zénithal incorrect (450 gr, entre 0 et "
                                "400) : elle n'est pas ajoutée à la GéoBase !\nErreur ligne 11\n");
    // The sighting before any station is kept, under a station to rename.
    EXPECT_TRUE(ElementsSummary(read).starts_with("1001 INCONNUE; 1003 P0; 1001 S1;"))
        << ElementsSummary(read);
    EXPECT_TRUE(
        ElementsSummary(read).ends_with("1001 S1; 1000 Unité des angles     = Radians; "
                                        "1000 Format               = Nikon DTM (virgules); 1003 P5; "))
        << ElementsSummary(read);
}

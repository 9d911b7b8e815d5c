// Wild / Leica GSI field books read into GéoBases: the field books of tests/data/fieldbook/wild-*.gsi
// were written for these tests. Their geometry is constructed: station S1 at (1000, 2000, 100) with an
// instrument height of 1.550, the known point A1 100 m to the east (bearing 100 gr, read at Hz 100 gr:
// V0 = 0), point 104 10 m to the north, level, sighted with a reflector at 1.300 (so at 100.250). Every
// value below is worked out by hand from the words as written.
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "core/Angles.h"
#include "fieldbook/LectWild.h"
#include "fieldbook/TableCode.h"

#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

constexpr double kMetres = 1e-4; // 0.1 mm

struct WildRun : DriverRun<CLectWild, FieldBookFormat::Wild> {
    CTableCode table;

    WildRun& Interpreting() {
        EXPECT_TRUE(table.Init(DefaultCodeTable()));
        reader.SetCodeTable(&table);
        choices.interpret = true;
        return *this;
    }
};

const std::string kGsi8 = "1000 Format               = GSI-8; ";

} // namespace

TEST(LectWild, AGsi16FieldBookWithStationBlocksGivesItsStationSightingsAndPoints) {
    WildRun run;
    const CCarnet& read = run.ReadFile("wild-gsi16-84.gsi");
    EXPECT_EQ(ReportText(run), "");
    // The station's coordinates, then the station; A1 has coordinates: a reference; the code comes before
    // its sighting; the instrument's coordinates of 104 are not kept without the setting.
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = GSI-16; 1000 Numéro de série      = 640054; "
              "1000 Appareil             = TCRP1201; 1000 Date                 = 01/02/2024; "
              "1006 S1; 1001 S1; 1006 A1; 1000 Correction atmosphérique = 0 ppm; "
              "1000 Constante de prisme  = 34 mm; 1002 A1; 1003 101; 1003 101; 1003 102; "
              "1003 A007; 1009 ARB 4.5; 1003 103; 1003 104; ");
    ExpectValues(read, 4, {1000.0, 2000.0, 100.0});
    EXPECT_NEAR(read.hiAt(5), 1.55, kMetres);
    EXPECT_EQ(read.v0At(5), kUndefined);
    ExpectValues(read, 6, {1100.0, 2000.0, 100.0});
    ExpectValues(read, 9, {1.3, 100.0, 100.0, 100.0});
    ExpectValues(read, 10, {1.3, 50.0, 100.0, 50.0});  // 45°00'00", 90°00'00", 50.0000 m (0.1 mm)
    ExpectValues(read, 11, {1.3, 250.0, 300.0, 50.0}); // face II kept as read; 50.00000 m (0.01 mm)
    ExpectValues(read, 12, {1.3, 123.45678, 98.76543, kUndefined}); // distance missing, not 0
    ExpectValues(read, 13, {1.3, 50.0, 100.0, 3.048});              // 45.00000°, 1600.0000 mils, 10.000 ft
    ExpectValues(read, 15, {1.3, 50.0, 100.0, 12.345});
    ExpectValues(read, 16, {1.3, 0.0, 100.0, 10.0});

    WildRun computed; // the sighting, then the instrument's coordinates of its point
    const CCarnet& withPoints = computed.Set(kKeyPointsCalcules, "1").ReadFile("wild-gsi16-84.gsi");
    EXPECT_TRUE(ElementsSummary(withPoints).ends_with("1003 103; 1003 104; 1006 104; "));
    ExpectValues(withPoints, 17, {1000.0, 2010.0, 100.0 + 1.55 - 1.3});
}

// A GSI-16 book in degrees-minutes-seconds, as the instruments write it with their own coordinates of each
// point (81/82/83) beside the observations. Constructed: ST1 (1000, 2000, 100), HI 1.550, its Hz oriented
// (bearings), the backsight on K1 (1150, 2080, 102), then 101 (1020, 2030, 99.2) and 102 (985, 2044,
// 101.7); 103 is read at 281°04'59.97", which the instrument rounds and writes 281°04'60.0". The
// recorded coordinates were computed from the words as written (0.1", mm): radiated from the GéoBase,
// every sighting finds its point within the rounding of the book.
TEST(LectWild, RadiatedObservationsFindTheInstrumentsOwnCoordinates) {
    WildRun run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile("wild-gsi16-calcule.gsi");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = GSI-16; 1006 K1; 1006 ST1; 1001 ST1; 1002 K1; "
              "1003 101; 1006 101; 1003 102; 1006 102; 1003 103; 1006 103; ");
    EXPECT_NEAR(read.ahAt(9), (281.0 + 5.0 / 60.0) / 0.9, 1e-7); // 60.0" is the next minute
    EXPECT_TRUE(AgreesWithInstrument(read, 4));                  // K1, 101, 102, 103
}

// Its first line ends in CR only. Word 43 is typed "1.55"; STA2 gives no height in its code block, the 88
// of its first sighting does. Interpreted, the offset code goes in front of the next sighting only.
TEST(LectWild, AGsi8FieldBookWithCodeBlockStationsAndCrLineEnds) {
    WildRun run;
    const CCarnet& read = run.Set(kKeyReferences, "premiere").ReadFile("wild-gsi8-41.gsi");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              kGsi8 + "1001 STA1; 1002 1; 1009 EXR 0.15; 1003 2; 1003 3; 1001 STA2; 1002 STA1; ");
    EXPECT_NEAR(read.hiAt(1), 1.55, kMetres);
    ExpectValues(read, 2, {1.6, 0.0, 100.0, 25.0});
    ExpectValues(read, 4, {1.6, 50.0, 95.0, 30.0});
    ExpectValues(read, 5, {1.6, 100.0, 105.0, kUndefined});
    EXPECT_NEAR(read.hiAt(6), 1.48, kMetres);
    ExpectValues(read, 7, {1.6, 200.0, 100.0, 50.0});

    WildRun interpreting;
    const CCarnet& interpreted = interpreting.Interpreting().ReadFile("wild-gsi8-41.gsi");
    EXPECT_TRUE(ElementsSummary(interpreted).find("; 1010 ExcentRad 0.15; 1003 2; ") != std::string::npos);
    EXPECT_NEAR(interpreted.findER(4, 1), 0.15, kMetres);
    EXPECT_EQ(interpreted.findER(5, 1), 0.0);
}

// With "84", code blocks 2 and 21 are plain codes and the sightings before any station go to one to rename;
// with "41", a block of words 84 to 88 gives a point, not a station, and its 88 has no station to go to.
TEST(LectWild, TheStationConventionSaysWhichBlocksAreStations) {
    const std::tuple<const char*, const char*, std::string, const char*> cases[] = {
        {"wild-gsi8-41.gsi", "84",
         "1009 2 STA1 1.55; 1001 INCONNUE; 1003 1; 1009 EXR 0.15; 1003 2; 1003 3; 1009 21 STA2; 1003 STA1; ",
         "Attention : ligne 7\n"},
        {"wild-gsi8-41.gsi", "auto",
         "1001 STA1; 1003 1; 1009 EXR 0.15; 1003 2; 1003 3; 1001 STA2; 1003 STA1; ", ""},
        {"wild-gsi16-84.gsi", "41",
         "1006 S1; 1006 A1; 1000 Correction atmosphérique = 0 ppm; 1000 Constante de prisme  = 34 mm; "
         "1001 INCONNUE; 1002 A1; 1003 101; 1003 101; 1003 102; 1003 A007; 1009 ARB 4.5; 1003 103; 1003 "
         "104; ",
         "Erreur ligne 2\nAttention : ligne 4\n"},
    };
    for (const auto& [file, convention, elements, reports] : cases) {
        WildRun run;
        const std::string summary =
            ElementsSummary(run.Set(kKeyConventionStation, convention).ReadFile(file));
        EXPECT_TRUE(summary.ends_with(elements)) << file << " " << convention << ": " << summary;
        EXPECT_EQ(ReportHeads(run), reports) << file << " " << convention;
    }
}

TEST(LectWild, EveryLineIsReadOrReportedWithItsNumber) {
    WildRun run;
    const CCarnet& read = run.ReadFile("wild-erreurs.gsi");
    EXPECT_EQ(ReportHeads(run),
              "Attention : ligne 1\nErreur ligne 3\nErreur ligne 4\n -> Chaîne lue = "
              "<2X.102+10000000>\nErreur ligne 5\nAttention : ligne 6\nAttention : ligne 8\n"
              "Erreur ligne 9\nErreur ligne 10\nAttention : ligne 11\nVisée <210> : angle "
              "zénithal incorrect (450 gr, entre 0 et 400) : elle n'est pas ajoutée à la "
              "GéoBase !\nErreur ligne 13\n");
    EXPECT_EQ(ElementsSummary(read), kGsi8 +
                                         "1001 INCONNUE; 1003 200; 1006 ST10; 1001 ST10; 1003 204; 1003 205; "
                                         "1003 206; 1003 208; 1003 209; ");
    ExpectValues(read, 3, {10.0, 20.0, kUndefined});
    ExpectValues(read, 7, {kUndefined, 100.0, kUndefined, kUndefined}); // unit digit 0 read in grads
}

// Point 205 has coordinates: a reference whatever the marking. The codes marking references are matched
// whatever their case, from a code block or on the sighting.
TEST(LectWild, ReferencesAreKnownPointsOrMarkedByTheirCodes) {
    const std::string text = "110001+00000S10 88..10+00001500 \n"
                             "410002+00000099 \n"
                             "110003+00000201 21.102+10000000 \n"
                             "110004+00000202 21.102+10000000 71....+00000REF \n"
                             "110005+00000203 21.102+10000000 71....+00000ref \n"
                             "110006+00000204 21.102+10000000 71....+00000ARB \n"
                             "110007+00000205 81..10+00001000 82..10+00002000 \n"
                             "110008+00000205 21.102+10000000 \n";
    EXPECT_EQ((KindsByMarking<CLectWild, FieldBookFormat::Wild>(text, " REF, 99 ,")),
              (std::vector<std::string>{"1003 1003 1003 1003 1002 ", "1002 1003 1003 1003 1002 ",
                                        "1002 1002 1002 1003 1002 "}));
}

// Ids are kept as written but for their padding.
TEST(LectWild, IdsAreKeptAsWrittenButForTheirPadding) {
    const std::string text = "110001+00000S10 88..10+00001500 \n"
                             "110002+0000A007 21.102+10000000 \n"
                             "110003+00000007 21.102+10000000 \n"
                             "110004+   A  12 21.102+10000000 \n"
                             "110005+00001.50 21.102+10000000 \n"
                             "110006+0000007B 21.102+10000000 \n"
                             "*110007+0000000000000012 21.102+0000000010000000 \n";
    WildRun run;
    EXPECT_EQ(ElementsSummary(run.Read(text)),
              kGsi8 +
                  "1001 S10; 1003 A007; 1003 7; 1003 A  12; 1003 1.50; 1003 7B; 1000 Format               = "
                  "GSI-16; 1003 12; ");
    EXPECT_EQ(ReportText(run), "");
}

TEST(LectWild, TheSettingsGiveTheUnitsAndTheOrderTheWordsDoNotSay) {
    const std::string text = "110001+00000S10 84....+00010000 85....+00020000 88....+00001500 \n"
                             "110002+00000101 21....+04530000 22....+09000000 31....+00010000 \n";
    WildRun run;
    const CCarnet& read = run.Set(kKeyUniteAngles, "DMS")
                              .Set(kKeyUniteDistances, "pieds")
                              .Set(kKeyOrdreCoordonnees, "yx")
                              .Read(text);
    ASSERT_EQ(ElementsSummary(read), kGsi8 + "1006 S10; 1001 S10; 1003 101; ");
    ExpectValues(read, 1, {20.0 * 0.3048, 10.0 * 0.3048, kUndefined}); // 84 held the northing
    EXPECT_NEAR(read.hiAt(2), 1.5 * 0.3048, kMetres);
    ExpectValues(read, 3, {kUndefined, 45.5 * 400.0 / 360.0, 100.0, 10.0 * 0.3048});
}

// sin(50 gr) = √2 / 2; a 3-4-5 triangle (horizontal 3, height difference 4, cos AV = 4 / 5); a horizontal
// distance alone is taken as level; the slope distance is preferred when given.
TEST(LectWild, AHorizontalDistanceGivesTheSlopeDistance) {
    const std::tuple<const char*, double, double> cases[] = {
        {"21.102+10000000 22.102+05000000 32..00+00010000", 50.0, 10.0 * std::sqrt(2.0)},
        {"21.102+10000000 32..00+00003000 33..00+00004000", RadiansToGrads(std::acos(0.8)), 5.0},
        {"21.102+10000000 32..00+00003000", 100.0, 3.0},
        {"21.102+10000000 22.102+05000000 31..00+00012000 32..00+00010000", 50.0, 12.0}};
    for (const auto& [words, av, di] : cases) {
        WildRun run;
        const CCarnet& read =
            run.Read("110001+00000S10 88..10+00001500 \n110002+00000101 " + std::string(words));
        ASSERT_EQ(read.GetSize(), 3) << words;
        ExpectValues(read, 2, {kUndefined, 100.0, av, di});
    }
}

TEST(LectWild, LevellingStaffReadingsBecomeBackAndForeReadings) {
    const std::string text = "110001+000000R1 32...8+02500000 331.08+00123456 \n"
                             "110002+000000R2 32...8+02400000 332.08+00098765 \n"
                             "110003+000000R2 83..18+04825000 \n";
    WildRun run;
    const CCarnet& read = run.Read(text);
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read), kGsi8 + "1004 R1; 1005 R2; 1006 R2; ");
    EXPECT_NEAR(read.lmAt(1), 1.23456, kMetres);
    EXPECT_NEAR(read.dhAt(1), 25.0, kMetres);
    EXPECT_NEAR(read.lmAt(2), 0.98765, kMetres);
    ExpectValues(read, 3, {kUndefined, kUndefined, 48.25});
}

// The time of a sighting is no header; constants repeated are said once. 220.0000 ppm (unit digit 6), a
// prism constant of 0.0020 m.
TEST(LectWild, HeaderInformationAndConstantsAreCommentsWrittenWhenTheyChange) {
    const std::string text = "12....+00640054 13....+00TCR305 17....+00010224 19....+02081029 \n"
                             "110001+00000S10 88..10+00001500 58..16+00000020 59..16+02200000 \n"
                             "110002+00000101 21.102+10000000 19....+02081031 58..16+00000020 \n"
                             "110003+00000102 21.102+10000000 51..1.+0012-017 17....+01032024 \n";
    WildRun run;
    EXPECT_EQ(ElementsSummary(run.Read(text)),
              kGsi8 +
                  "1000 Numéro de série      = 640054; 1000 Appareil             = TCR305; "
                  "1000 Date                 = 01/02/24; 1000 Date et heure        = 08/02 10:29; "
                  "1000 Correction atmosphérique = 220 ppm; 1000 Constante de prisme  = 2 mm; 1001 S10; "
                  "1003 101; 1000 Date                 = 01/03/2024; 1000 Correction atmosphérique = 12 ppm; "
                  "1000 Constante de prisme  = -17 mm; 1003 102; ");
    EXPECT_EQ(ReportText(run), "");
}

TEST(LectWild, AStationNumberOnTheMeasurementsOpensItsStation) {
    const std::string text =
        "110001+00000101 16....+00000S20 21.102+10000000 84..10+00010000 85..10+00020000 88..10+00001500 \n"
        "110002+00000102 16....+00000S20 21.102+20000000 88..10+00001500 \n"
        "110003+00000103 16....+00000S21 21.102+30000000 \n";
    for (const char* convention : {"auto", "84"}) {
        WildRun run;
        const CCarnet& read = run.Set(kKeyConventionStation, convention).Read(text);
        EXPECT_EQ(ReportText(run), "");
        EXPECT_EQ(ElementsSummary(read),
                  kGsi8 + "1006 S20; 1001 S20; 1003 101; 1003 102; 1001 S21; 1003 103; ");
        ExpectValues(read, 1, {10.0, 20.0, kUndefined});
        EXPECT_NEAR(read.hiAt(2), 1.5, kMetres);
        EXPECT_EQ(read.hiAt(5), kUndefined);
    }
}

// SDR2x and SDR33 field books read into GéoBases. The field books tests/data/fieldbook/sokkia-*.sdr were
// written for these tests from the record layouts; their geometry is constructed: station S1 at
// E 1000, N 2000, Z 100 with an instrument height of 1.550, its backsight A1 100 m to the east (azimuth
// 100 gr) read at 50 gr on the circle. Every expected value is worked out by hand from the text written:
// 1 ft = 0.3048 m, 1° = 10/9 gr, 1 mil = 1/16 gr, 123.758333° = 137.509259 gr.
#include "FieldBookTestSupport.h"
#include "fieldbook/LectSokkia.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

constexpr double U = kUndefined;
using SokkiaRun = DriverRun<CLectSokkia, FieldBookFormat::Sokkia>;

// SDR33 fields: identifiers right-justified, reals and texts left-justified, 16 characters each.
std::string Id(std::string_view id) {
    return std::string(16 - id.size(), ' ') + std::string(id);
}
std::string Re(std::string_view value) {
    return std::string(value) + std::string(16 - value.size(), ' ');
}
std::string Station(std::string_view name, std::string_view north, std::string_view east,
                    std::string_view hi = "1.550", std::string_view z = "100.000") {
    return "02TP" + Id(name) + Re(north) + Re(east) + Re(z) + Re(hi) + Re("") + "\n";
}
std::string Observation(std::string_view to, std::string_view sd, std::string_view v, std::string_view hz,
                        std::string_view code = "", std::string_view derivation = "F1",
                        std::string_view from = "S1") {
    return "09" + std::string(derivation) + Id(from) + Id(to) + Re(sd) + Re(v) + Re(hz) + Re(code) + "\n";
}
std::string Backsight(std::string_view to, std::string_view azimuth, std::string_view hz) {
    return "07TP" + Id("S1") + Id(to) + Re(azimuth) + Re(hz) + "\n";
}
std::string Point(std::string_view name, std::string_view north, std::string_view east,
                  std::string_view derivation = "KI") {
    return "08" + std::string(derivation) + Id(name) + Re(north) + Re(east) + Re("") + "\n";
}

} // namespace

TEST(LectSokkia, Sdr33BookInGradsNorthFirstFramedWithItsChecksum) {
    SokkiaRun run;
    const CCarnet& read = run.ReadFile("sokkia-sdr33.sdr");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Version              = SDR33 V04-04.02; 1000 Format               = SDR33; "
              "1000 Date                 = 22-Nov-26 10:15; 1000 Unité des angles     = grades; "
              "1000 Unité des distances  = mètres; 1000 Ordre des coordonnées = N-E-Z; "
              "1000 Chantier             = CHANTIER A; 1000 Appareil             = SET5F V01-00; "
              "1000 Numéro de série      = 123456; 1000 Angle vertical       = zénithal; "
              "1000 Constante de prisme  = -30.0000; 1009 BORNE; 1006 S1; 1001 S1; "
              "1000 Gisement de référence = S1 -> A1 : 100.00000 gr; 1002 A1; 1002 A1; 1009 ARB; 1003 104; "
              "1003 105; 1006 A1; 1000 Brouillard léger; ");
    ExpectValues(read, 12, {1000.0, 2000.0, 100.0});
    EXPECT_NEAR(read.hiAt(13), 1.55, 1e-4);
    ExpectValues(read, 15, {1.3, 50.0, 100.0, 100.0}); // the backsight sighted in both faces
    ExpectValues(read, 16, {1.3, 250.0, 300.0, 100.0});
    ExpectValues(read, 18, {1.3, 350.0, 99.9, 10.0}); // the 08 computed for 104 after it is not kept
    ExpectValues(read, 19, {1.3, 375.1234, U, U});
    ExpectValues(read, 20, {1100.0, 2000.0, U});
}

TEST(LectSokkia, Sdr2xBookInDegreesAndFeetEastFirstWithTouchingReals) {
    SokkiaRun run;
    const CCarnet& read = run.ReadFile("sokkia-sdr2x.sdr");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Version              = SDR20 V03-05; 1000 Format               = SDR2x; "
              "1000 Date                 = 01-Jan-99 08:30; 1000 Unité des angles     = degrés décimaux; "
              "1000 Unité des distances  = pieds; 1000 Ordre des coordonnées = E-N-Z; 1006 1; 1001 1; "
              "1000 Gisement de référence = 1 -> 2 : 100.00000 gr; 1002 2; 1009 MUR; 1003 3; 1003 4; "
              "1009 PIQUET; 1006 5; ");
    const double foot = 0.3048, hp = 4.5 * foot;
    ExpectValues(read, 6, {1000 * foot, 2000 * foot, 100 * foot});
    EXPECT_NEAR(read.hiAt(7), 5 * foot, 1e-4);
    ExpectValues(read, 9, {hp, 50.0, 100.0, 100 * foot});
    ExpectValues(read, 11, {hp, 137.509259, 99.444444, 50 * foot});
    ExpectValues(read, 12, {hp, 150.0, 300.0, 20 * foot}); // MC: bearing 200 gr - (100 - 50) on the circle
    ExpectValues(read, 14, {1100 * foot, 2100 * foot, 110 * foot});
}

// The header's units and axis order win over the settings, which hold when the book says nothing.
TEST(LectSokkia, UnitsAndAxisOrderFromTheHeaderOrTheSettings) {
    struct Case {
        const char* header; // angle, distance and order digits; "" for no header
        const char* angles;
        const char* order;
        const char* hz; // the vertical circle reads 100 in the unit
        double x, y, ah, av, di;
    };
    const Case cases[] = {
        {"211", "grades", "YX", "90", 1000, 2000, 90, 100, 10},
        {"111", "grades", "YX", "90", 1000, 2000, 100, 111.111111, 10},
        {"311", "grades", "YX", "1600", 1000, 2000, 100, 6.25, 10},
        {"411", "grades", "YX", "3200", 1000, 2000, 200, 6.25, 10},
        {"221", "grades", "YX", "90", 304.8, 609.6, 90, 100, 3.048},
        {"212", "grades", "YX", "90", 2000, 1000, 90, 100, 10},
        {"211", "degres", "YX", "90", 1000, 2000, 90, 100, 10},
        {"", "degres", "YX", "90", 1000, 2000, 100, 111.111111, 10},
        {"", "grades", "XY", "90", 2000, 1000, 90, 100, 10},
    };
    for (const Case& c : cases) {
        SokkiaRun run;
        std::string text;
        if (*c.header)
            text = std::string("00NMSDR33 V04-04.02     22-Nov-26 10:15 ") + c.header[0] + c.header[1] +
                   "11" + c.header[2] + "1\n";
        const CCarnet& read =
            run.Set(kKeyUniteAngles, c.angles)
                .Set(kKeyOrdreCoordonnees, c.order)
                .Read(text + Station("S1", "2000", "1000") + Observation("P", "10", "100", c.hz));
        SCOPED_TRACE(std::string("header ") + c.header + ", " + c.angles + ", " + c.order);
        EXPECT_EQ(ReportText(run), "");
        // 100 and 10 units of length: 30.48 and 3.048 m in feet
        ExpectValues(read, read.Find(kKindPoint, "S1", 0, 0), {c.x, c.y, c.di * 10});
        ExpectValues(read, read.GetSize() - 1, {U, c.ah, c.av, c.di});
    }
    // Columns count characters: a Latin-1 identifier, two bytes a letter once read, moves no field.
    SokkiaRun latin1;
    const CCarnet& read = latin1.Read(Point("\xC9T\xC9", "2000", "1000"));
    ExpectValues(read, read.Find(kKindPoint, "ÉTÉ", 0, 0), {1000.0, 2000.0, U});
}

// Header records of a book written on Windows: their columns count characters, so an accented letter is
// never split and moves neither the values after it nor the unit codes.
TEST(LectSokkia, HeaderRecordsOfAWindows1252BookAreCutAtCharacters) {
    const struct {
        const char* record;
        const char* comments;
    } cases[] = {
        {"04N\xE9 1.000", "1000 Collimation          = 1.000; "},
        {"04\xE9\xE9  1.000   2.5", "1000 Collimation          = 1.000 2.5; "},
        {"05\xE9N 15.0 1013.25 \xB0"
         "C",
         "1000 Atmosphère           = 15.0 1013.25 °C; "},
        {"06NM1.000 \xE9"
         "chelle",
         "1000 Facteur d'échelle    = 1.000 échelle; "},
        {"10NMCHANTIER \xC9T\xC9", "1000 Chantier             = CHANTIER ÉTÉ; "},
        {"00NMSDR33 V\xE9"
         "4-04.02     22-Nov-26 10:15 211111",
         "1000 Version              = SDR33 Vé4-04.02; 1000 Format               = SDR33; "
         "1000 Date                 = 22-Nov-26 10:15; 1000 Unité des angles     = grades; "
         "1000 Unité des distances  = mètres; 1000 Ordre des coordonnées = N-E-Z; "},
    };
    for (const auto& c : cases) {
        SokkiaRun run;
        const CCarnet& read = run.Read(std::string(c.record) + "\r\n");
        EXPECT_EQ(ElementsSummary(read), c.comments) << c.record;
        EXPECT_EQ(ReportText(run), "") << c.record;
    }
}

TEST(LectSokkia, VerticalAnglesFromTheHorizonBecomeZenithAngles) {
    SokkiaRun run;
    const std::string instrument = "01NM:" + std::string(16, ' ') + "123456" + std::string(22, ' ') + "32\n";
    const CCarnet& read = run.Read(instrument + Station("S1", "", "") + Observation("P", "10", "10", "0") +
                                   Observation("Q", "10", "-5", "0"));
    EXPECT_NEAR(read.avAt(read.Find(kKindMesure, "P", 0, 0)), 90.0, 1e-4);
    EXPECT_NEAR(read.avAt(read.Find(kKindMesure, "Q", 0, 0)), 105.0, 1e-4);
}

// The backsight is always a reference; the settings may mark others, the first sighting or codes.
TEST(LectSokkia, ReferenceSightings) {
    const std::string book = Station("S1", "2000", "1000") + Backsight("A1", "100", "50") +
                             Observation("B", "10", "100", "10") + Observation("A1", "100", "100", "50") +
                             Observation("C", "10", "100", "20", "REF");
    EXPECT_EQ((KindsByMarking<CLectSokkia, FieldBookFormat::Sokkia>(book, "ref,X")),
              (std::vector<std::string>{"1003 1002 1003 ", "1002 1002 1003 ", "1003 1002 1002 "}));
    // A backsight that no observation sights leaves its circle reading as the station's reference.
    SokkiaRun run;
    const CCarnet& read =
        run.Read(Station("S1", "", "", "1.550", "") + Backsight("A1", "", "12.3456") +
                 Observation("B", "10", "100", "10") + Station("S2", "", "", "1.550", "100"));
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = SDR33; 1001 S1; 1003 B; 1002 A1; 1006 S2; 1001 S2; ");
    ExpectValues(read, 2, {U, 10.0, 100.0, 10.0});
    ExpectValues(read, 3, {U, 12.3456, U, U});
    ExpectValues(read, 4, {U, U, 100.0});
}

// Blanks are values the instrument did not record: they stay missing, never 0. The point computed after an
// observation is kept when the settings ask for it.
TEST(LectSokkia, MissingValuesStayMissingAndComputedPointsFollowTheSetting) {
    SokkiaRun run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1")
                              .Read(Station("S1", "", "", "", "") + Observation("P", "", "99.5", "10") +
                                    Point("P", "2010", "1000", "TP"));
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read), "1000 Format               = SDR33; 1001 S1; 1003 P; 1006 P; ");
    EXPECT_EQ(read.hiAt(1), U);
    ExpectValues(read, 2, {U, 10.0, 99.5, U});
    ExpectValues(read, 3, {1000.0, 2010.0, U});
}

// Each line that cannot be used is reported with its number and gravity, and the reading goes on.
TEST(LectSokkia, LinesReportedWithTheirNumbers) {
    const std::pair<std::string, const char*> cases[] = {
        {"11NM whatever\nXYZ\n", "Erreur ligne 1\nErreur ligne 2\n"},
        {Station("S1", "20O0", "1000"), "Erreur ligne 1\n"},
        {Station("S1", "2000", ""), "Erreur ligne 1\n"},
        {"03NM" + Re("1.5") + "1234567890\n", "Attention : ligne 1\n"},
        {Observation("P", "10", "100", "0", "", "F1", ""), "Attention : ligne 1\n"},
        {Observation("P", "10", "100", "0", "", "F1", "S9"), "Attention : ligne 1\n"},
        {Station("S1", "", "") + Observation("P", "10", "100", "0", "", "MC"), "Attention : ligne 2\n"},
        {"00NMSDR33 V04-04.02     22-Nov-26 10:15 711111\n", "Attention : ligne 1\n"},
        {"00NMSDR33 V04-04.02     22-Nov-26 10:15 \xE9"
         "11111\n",
         "Attention : ligne 1\n"}, // accented: no code
        {"\002\n03NM1.5\n\00300403\n", "Attention : ligne 3\n"},
        {Station("", "2000", "1000"), "Erreur ligne 1\n"},
        {"03NM" + Re("") + "\n", "Erreur ligne 1\n"},
        {Station("S1", "", "") + Observation("P", "", "", ""), "Erreur ligne 2\n"},
        // The checksum of "03NM1.5" is 48+51+78+77+49+46+53 = 402; 00000 is no checksum.
        {"\002\n03NM1.5\n\00300402\n", ""},
        {"\002\n03NM1.5\n\00300000\n", ""},
    };
    for (const auto& [book, heads] : cases) {
        SokkiaRun run;
        run.Read(book);
        EXPECT_EQ(ReportHeads(run), heads) << book;
    }
}

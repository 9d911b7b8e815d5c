// Trimble (Zeiss) field books read into GéoBases. The field books tests/data/fieldbook/zeiss-*-mesures.txt
// were written for these tests in the columns of their layout. Their geometry is constructed: station S1
// at E 1000, N 2000, Z 100 (the file's X 2000, Y 1000, X being the northing), instrument height 1.550,
// set up on a known station so that its Hz are bearings. Each expected value is worked out by hand from
// the value as written and its unit.
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "core/Strings.h"
#include "fieldbook/LectZeiss.h"

#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

using ZeissRun = DriverRun<CLectZeiss, FieldBookFormat::Zeiss>;

// An M5 line in its columns: "For M5|Adr nnnnn|T2a <27>|T3 <14> <4>|T4 ...|T5 ...|" and the error flag.
struct Block {
    const char* type;
    const char* value;
    const char* unit;
};
std::string M5(int address, const char* kind, const std::string& info, std::vector<Block> blocks = {},
               char flag = ' ') {
    std::string line = Sprintf("For M5|Adr %05d|%-3s %-27s|", address, kind, info.c_str());
    for (std::size_t i = 0; i < 3; ++i) {
        const Block b = i < blocks.size() ? blocks[i] : Block{"", "", ""};
        line += Sprintf("%-2s %14s %-4s|", b.type, b.value, b.unit);
    }
    return line + flag;
}
// The information block of a point: its id ending in column 19, its code from column 20.
std::string Pi(const char* point, const char* code = "") {
    return Sprintf("%19s%-5s", point, code);
}

} // namespace

// Every value carries its unit: feet, DMS, decimal degrees, mils, and the vertical systems V1 (zenith),
// V2 (from the horizon), V3 (from the nadir), V4 (in %). The header says X is the northing.
TEST(LectZeiss, AnM5FieldBookGivesEveryValueInGradsAndMetres) {
    ZeissRun run;
    const CCarnet& read = run.ReadFile("zeiss-m5-mesures.txt");
    EXPECT_EQ(ReportText(run), "");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = M5; 1000 Appareil             = M3 5\"DR; "
              "1000 Numéro de série      = 131500; 1000 Version du logiciel  = 1.00; "
              "1000 Axes des coordonnées = X = nord, Y = est; "
              "1000 Facteur d'échelle    = 1.000000; 1000 KN STAT; 1001 S1; 1006 S1; 1002 A1; "
              "1000 POLAR; 1009 MUR; 1003 101; 1003 102; 1003 103; 1003 104; 1003 105; 1003 106; "
              "1009 BORNE; 1006 200; 1006 201; ");
    EXPECT_NEAR(read.hiAt(7), 1.55, 1e-4);
    EXPECT_EQ(read.v0At(7), 0.0); // set up on a known station: its Hz are bearings
    ExpectValues(read, 8, {1000.0, 2000.0, 100.0});
    ExpectValues(read, 9, {1.3, 100.0, 100.0, 100.0});
    const double cases[][5] = {
        // element, HP, Hz, zenith, slope distance
        {12, 1.3, 137.50926, 106.11111, 100.0000032}, // 123°45'30", 95.5°, 328.084 ft × 0.3048
        {13, 1.8, 100.0, 95.0, 50.154610},            // 1600 mil; V2 5 gr; HD 50 / cos 4.5°
        {14, 1.8, 10.0, 90.0, 20.0},                  // V3 110 gr from the nadir
        {15, 1.8, 20.0, 93.65490, 30.149627},         // 10 %: 100 - atan 0.1; HD 30 × √1.01
        {16, 1.8, 30.0, 74.86682, 13.0},              // HD 12, h 5: the 5-12-13 triangle
        {17, 1.8, 40.0, 250.0, kUndefined},           // face right, no distance
    };
    for (const auto& c : cases)
        ExpectValues(read, static_cast<int>(c[0]), {c[1], c[2], c[3], c[4]});
    ExpectValues(read, 19, {1005.0, 2010.0, 101.0});
    ExpectValues(read, 20, {1010.0, 1990.0, kUndefined});
}

// Rec 500 writes no units: those of the settings hold. S2 at E 3000, N 5000.
TEST(LectZeiss, ARec500FieldBookTakesItsUnitsFromTheSettings) {
    const std::tuple<const char*, const char*, double, double, double> cases[] = {
        // angles, lengths, Hz of 301, its zenith, its slope distance
        {"grades", "metres", 50.5, 99.5, 25.432},
        {"degres", "pieds", 56.11111, 110.55556, 7.7516736}, // 50.5°, 99.5°, 25.432 ft
        {"dms", "metres", 56.48148, 110.92593, 25.432},      // 50°50'00", 99°50'00"
    };
    for (const auto& [angles, lengths, hz, zenith, slope] : cases) {
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyUniteAngles, angles)
                                  .Set(kKeyUniteDistances, lengths)
                                  .ReadFile("zeiss-rec500-mesures.txt");
        EXPECT_EQ(ReportText(run), "") << angles;
        ASSERT_EQ(ElementsSummary(read),
                  "1000 Format               = Rec 500; 1000 KN STAT; 1001 S2; 1006 S2; 1002 R1; "
                  "1000 POLAR; 1009 12; 1003 301; 1009 ARB; 1006 302; ")
            << angles;
        const double foot = std::string_view(lengths) == "pieds" ? 0.3048 : 1.0;
        EXPECT_NEAR(read.hiAt(2), 1.6 * foot, 1e-4);
        ExpectValues(read, 3, {3000.0 * foot, 5000.0 * foot, 50.0 * foot});
        ExpectValues(read, 7, {2.0 * foot, hz, zenith, slope});
        ExpectValues(read, 9, {3006.789 * foot, 5012.345 * foot, 51.234 * foot});
    }
}

// The settings say which axis X is; the header of the instrument (word 05, its coordinate system) wins
// over them: in system 1 (XY) X is the northing, in system 2 (YX) the easting.
TEST(LectZeiss, TheAxesFollowTheHeaderThenTheSettings) {
    const std::string point = M5(2, "PI1", Pi("7"), {{"X", "100.000", "m"}, {"Y", "200.000", "m"}}) + "\r\n";
    const std::string xEast = M5(1, "TI", "", {{"05", "2", ""}}) + "\r\n";
    const std::string xNorth = M5(1, "TI", "", {{"05", "1", ""}}) + "\r\n";
    const std::tuple<const char*, std::string, double, double> cases[] = {
        {"YX", point, 200.0, 100.0},
        {"XY", point, 100.0, 200.0},
        {"YX", xEast + point, 100.0, 200.0},
        {"XY", xNorth + point, 200.0, 100.0},
    };
    for (const auto& [order, text, east, north] : cases) {
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyOrdreCoordonnees, order).Read(text);
        ASSERT_EQ(read.GetType(read.GetSize() - 1), kKindPoint) << order;
        ExpectValues(read, read.GetSize() - 1, {east, north, kUndefined});
    }
}

// The sightings of a set-up program are references; elsewhere the settings mark them.
TEST(LectZeiss, ReferencesComeFromSetUpProgramsOrTheSettings) {
    const std::string text = M5(1, "TI", "OR.COOR") + "\n" +
                             M5(2, "PI1", Pi("ST", "S"), {{"X", "10.000", "m"}, {"Y", "20.000", "m"}}) +
                             "\n" + M5(3, "PI1", Pi("R1"), {{"Hz", "10.0000", "gon"}}) + "\n" +
                             M5(4, "TI", "POLAR") + "\n" +
                             M5(5, "PI1", Pi("1", "REF"), {{"Hz", "20.0000", "gon"}}) + "\n" +
                             M5(6, "PI1", Pi("2", "ARB"), {{"Hz", "30.0000", "gon"}}) + "\n";
    EXPECT_EQ(
        (KindsByMarking<CLectZeiss, FieldBookFormat::Zeiss>(text, "ref")),
        (std::vector<std::string>{"1002 1003 1003 ", "1002 1003 1003 ", "1002 1002 1003 "})); // R1 first
    ZeissRun run;
    EXPECT_EQ(run.Read(text).v0At(2), kUndefined) << "only a known-station set-up is oriented";
}

// An instrument height given before the station's first sighting is the station's when a sighting comes
// next (the instrument asks for it again at the start of the polar measurements), the next station's when
// a station line comes first; given after sightings, it waits for the next station. A reflector height
// holds until the next one.
TEST(LectZeiss, HeightsGoToTheStationOfTheirSetUp) {
    const std::string a = M5(1, "PI1", Pi("A", "S"), {{"Z", "10.000", "m"}});
    const std::string aAgain = M5(1, "PI1", Pi("A", "S"), {{"X", "5.000", "m"}, {"Y", "6.000", "m"}});
    const std::string b = M5(9, "PI1", Pi("B", "S"));
    const std::string polar = M5(3, "TI", "POLAR");
    const auto Input = [](const char* hi) {
        return M5(2, "TI", "INPUT", {{"ih", hi, "m"}, {"th", "1.100", "m"}});
    };
    const auto Sight = [](const char* point) { return M5(5, "PI1", Pi(point), {{"Hz", "1.0000", "gon"}}); };
    const struct {
        std::vector<std::string> lines;
        double hiA, hiB;
    } cases[] = {
        {{a, Input("1.400"), Sight("1"), polar, Input("1.700"), b, Sight("2")}, 1.4, 1.7},
        {{a, polar, Input("1.400"), Sight("1"), b, Sight("2")}, 1.4, 1.4}, // B: the last one given
        {{a, polar, Input("1.400"), b, Sight("2")}, kUndefined, 1.4},
        {{a, Input("1.400"), aAgain, Sight("1")}, 1.4, kUndefined},
        {{a, Sight("1"), Input("1.400"), Sight("2"), b}, kUndefined, 1.4},
        {{a, Input("1.400")}, 1.4, kUndefined}, // the book ends: nothing else to take it
    };
    for (const auto& c : cases) {
        std::string text;
        for (const std::string& line : c.lines)
            text += line + "\n";
        ZeissRun run;
        const CCarnet& read = run.Read(text);
        EXPECT_EQ(ReportText(run), "");
        for (const auto& [station, hi] : {std::pair{"A", c.hiA}, std::pair{"B", c.hiB}}) {
            const int at = read.Find(kKindStation, station);
            if (at < 0) {
                EXPECT_EQ(hi, kUndefined) << text;
                continue;
            }
            EXPECT_NEAR(read.hiAt(at), hi, 1e-4) << station << " in\n" << text;
        }
        const int last = read.GetSize() - 1;
        if (IsSightingKind(read.GetType(last))) {
            EXPECT_NEAR(read.hpAt(last), 1.1, 1e-4);
        }
    }
}

// A set-up program writes the station once its backsights are measured: those backsights are the station's
// references, each with its own reflector height and the instrument's coordinates on the line after it.
// Backsights that no station line follows stay where they were read.
TEST(LectZeiss, BacksightsWrittenBeforeTheirStationLineAreItsReferences) {
    const std::string knStat = M5(1, "TI", "KN STAT") + "\n";
    const std::string backsight =
        M5(2, "PI1", Pi("R"), {{"SD", "20.000", "m"}, {"Hz", "50.0000", "gon"}, {"V1", "100.0000", "gon"}}) +
        "\n" + M5(3, "PI1", Pi("R"), {{"X", "14.142", "m"}, {"Y", "14.142", "m"}}) + "\n";
    const std::string th = M5(4, "TI", "INPUT", {{"th", "1.600", "m"}}) + "\n";
    const std::string station =
        M5(5, "PI1", Pi("ST", "S"), {{"X", "0.000", "m"}, {"Y", "0.000", "m"}}) + "\n";
    const std::string polar = M5(6, "TI", "POLAR") + "\n";
    const std::string sighting = M5(7, "PI1", Pi("1"), {{"Hz", "1.0000", "gon"}}) + "\n";
    const std::string reflector = M5(1, "TI", "INPUT", {{"th", "1.300", "m"}}) + "\n";
    const struct {
        std::string text;
        const char* elements;
        const char* reports;
    } cases[] = {
        {reflector + knStat + backsight + th + station + polar + sighting,
         "1000 KN STAT; 1001 ST; 1006 ST; 1002 R; 1006 R; 1000 POLAR; 1003 1; ", ""},
        {station + sighting + knStat + backsight + polar + sighting,
         "1001 ST; 1006 ST; 1003 1; 1000 KN STAT; 1002 R; 1006 R; 1000 POLAR; 1003 1; ", ""},
        {reflector + knStat + backsight, "1000 KN STAT; 1001 INCONNUE; 1002 R; 1006 R; ",
         "Attention : ligne 3 : visées sans station, rattachées à la station <INCONNUE> (à renommer).\n"},
    };
    for (const auto& c : cases) {
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyPointsCalcules, "1").Read(c.text);
        EXPECT_EQ(ReportText(run), c.reports) << c.text;
        ASSERT_EQ(ElementsSummary(read), std::string("1000 Format               = M5; ") + c.elements)
            << c.text;
        const int at = read.Find(kKindReference, "R");
        ASSERT_GE(at, 0);
        if (std::string_view(c.elements).starts_with("1000 KN STAT; 1001 ST")) {
            EXPECT_NEAR(read.hpAt(at), 1.3, 1e-4) << "the reflector height of its own line";
        }
        ExpectValues(read, at + 1, {14.142, 14.142, kUndefined});
    }
}

// A sighting line holds three values: the instrument writes the coordinates that it computed for the point
// on the next line, under the same point id. They give the point with "PointsCalcules" only, and its code
// once; coordinates of a point that was not just sighted are a known point.
TEST(LectZeiss, TheInstrumentsCoordinatesFollowTheirSightingLine) {
    const std::string text =
        M5(1, "PI1", Pi("ST", "S"), {{"X", "0.000", "m"}, {"Y", "0.000", "m"}}) + "\n" +
        M5(2, "PI1", Pi("1", "MUR"),
           {{"SD", "10.000", "m"}, {"Hz", "0.0000", "gon"}, {"V1", "100.0000", "gon"}}) +
        "\n" +
        M5(3, "PI1", Pi("1", "MUR"), {{"X", "10.000", "m"}, {"Y", "0.000", "m"}, {"Z", "1.000", "m"}}) +
        "\n" + M5(4, "PI1", Pi("2", "MUR"), {{"Hz", "20.0000", "gon"}}) + "\n" + M5(5, "TI", "INPUT") + "\n" +
        M5(6, "PI1", Pi("2", "MUR"), {{"X", "20.000", "m"}, {"Y", "7.000", "m"}}) + "\n" +
        M5(7, "PI1", Pi("3", "ARB"), {{"X", "30.000", "m"}, {"Y", "8.000", "m"}}) + "\n";
    const std::pair<const char*, const char*> cases[] = {
        {"0", "1001 ST; 1006 ST; 1009 MUR; 1003 1; 1009 MUR; 1003 2; 1009 MUR; 1006 2; 1009 ARB; 1006 3; "},
        {"1", "1001 ST; 1006 ST; 1009 MUR; 1003 1; 1006 1; 1009 MUR; 1003 2; 1009 MUR; 1006 2; 1009 ARB; "
              "1006 3; "},
    };
    for (const auto& [keep, elements] : cases) {
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyPointsCalcules, keep).Read(text);
        EXPECT_EQ(ReportText(run), "");
        ASSERT_EQ(ElementsSummary(read), std::string("1000 Format               = M5; ") + elements) << keep;
        if (*keep == '1') ExpectValues(read, 5, {0.0, 10.0, 1.0}); // X the northing
    }
}

// Without the places in a header, the point id and the code are read where the point lines put them; the
// surveyor is told when they are not the usual ones. Lines after the first fifty point lines are read as
// they come, and every report keeps its line and its order.
TEST(LectZeiss, AnM5BookWithoutHeaderHasItsFieldsFoundFromItsPointLines) {
    using Info = std::string (*)(const char* point, const char* code, const char* information);
    const Info usual = [](const char* point, const char* code, const char* information) {
        return Pi(point, code) + information;
    };
    const Info m3 = [](const char* point, const char* code, const char* information) {
        return Sprintf("%-7s   %5s%12s", information, code, point);
    };
    const Info pointFirst = [](const char* point, const char* code, const char* information) {
        return Sprintf("%12s%5s%-7s", point, code, information);
    };
    // The wording of the places found is checked with the M3 books below.
    const std::pair<Info, bool> cases[] = {{usual, false}, {m3, true}, {pointFirst, true}};
    for (const auto& [info, told] : cases) {
        std::string text =
            M5(1, "PI1", info("ST", "S", ""), {{"X", "0.000", "m"}, {"Y", "0.000", "m"}}) + "\n";
        std::string expected = "1000 Format               = M5; 1001 ST; 1006 ST; ";
        for (int i = 2; i <= 60; ++i) {
            const std::string point = std::to_string(1000 + i);
            const char* code = i % 3 == 0 ? "MUR" : "";
            if (i == 55) {
                text += "bonjour\n"; // read after the places are found
                continue;
            }
            text +=
                M5(i, "PI1", info(point.c_str(), code, i % 4 == 0 ? "H2" : ""), {{"Hz", "10.0000", "gon"}}) +
                "\n";
            const std::string label =
                std::string(code) + (*code && i % 4 == 0 ? " " : "") + (i % 4 == 0 ? "H2" : "");
            expected += (label.empty() ? "" : "1009 " + label + "; ") + "1003 " + point + "; ";
        }
        ZeissRun run;
        const CCarnet& read = run.Read(text);
        EXPECT_EQ(ReportHeads(run), std::string(told ? "Attention : ligne 1\n" : "") +
                                        "Erreur ligne 55\n -> Chaîne lue = <bonjour>\n");
        EXPECT_EQ(ElementsSummary(read), expected);
    }

    // Nothing that the instrument could write: the surveyor is told where the point ids are read.
    ZeissRun run;
    const CCarnet& read = run.Read(M5(1, "PI1", std::string(27, 'x'), {{"Hz", "10.0000", "gon"}}) + "\n");
    EXPECT_EQ(
        ReportText(run),
        "Attention : ligne 1 : aucune disposition connue du bloc d'information n'explique les lignes de "
        "points ; matricule lu en colonnes 8 à 19 et code en colonnes 20 à 24.\n"
        "Attention : ligne 1 : visées sans station, rattachées à la station <INCONNUE> (à renommer).\n");
    EXPECT_EQ(ElementsSummary(read), "1000 Format               = M5; 1001 INCONNUE; 1009 xxxxx xxx; 1003 "
                                     "xxxxxxxxxxxx; ");
}

TEST(LectZeiss, EveryLineIsReadOrReportedWithItsNumber) {
    const std::string lines[] = {
        M5(1, "PI1", Pi("1"), {{"Hz", "1.0000", "gon"}}),
        M5(2, "XX", "texte"),
        M5(3, "PI1", Pi("3"), {{"Hz", "1.2x", "gon"}}),
        M5(4, "PI1", Pi("")).substr(0, 49),
        M5(5, "PI1", Pi("5"), {{"Qz", "1.0", ""}, {"Hz", "5.0000", "gon"}}),
        M5(6, "PI1", Pi("6"), {{"Qz", "1.0", ""}, {"Hz", "6.0000", "m"}}),
        M5(7, "PI1", Pi("7"), {{"X", "1.000", "m"}}),
        M5(8, "PI1", Pi("8"), {{"SD", "8.000", "m"}}, 'e'),
        "bonjour",
        M5(10, "PI1", Pi("10")),
    };
    std::string text;
    for (const std::string& line : lines)
        text += line + "\n";
    ZeissRun run;
    const CCarnet& read = run.Read(text);
    EXPECT_EQ(ReportHeads(run), "Attention : ligne 1\nErreur ligne 2\n -> Chaîne lue = <" +
                                    lines[1].substr(0, 118) +
                                    ">\nErreur ligne 3\nAttention : ligne 4\nErreur ligne 4\nAttention : "
                                    "ligne 5\nAttention : ligne 6\nErreur ligne 7\nAttention : ligne 8\n"
                                    "Erreur ligne 9\n -> Chaîne lue = <bonjour>\nErreur ligne 10\n");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = M5; 1001 INCONNUE; 1003 1; 1003 5; 1003 6; 1003 8; ");
    ExpectValues(read, 4, {kUndefined, 6.0, kUndefined, kUndefined}); // read in the settings' grads
}

// R4 and R5 lines are found by their separators; line ends, blanks and transmission bytes change nothing.
TEST(LectZeiss, EveryLayoutAndLineEndGivesTheSameSighting) {
    const std::string m5 = M5(1, "PI1", Pi("9", "C1"),
                              {{"SD", "12.345", "m"}, {"Hz", "123.4567", "gon"}, {"V1", "98.7654", "gon"}});
    const std::string r4 = "For R4|9 C1|SD  12.345 m|Hz  123.4567 gon|V1  98.7654 gon|";
    const std::string r5 = "For_R5|Adr 0001|PI1 9 C1|SD 12.345 m|Hz 123.4567 gon|V1 98.7654 gon| ";
    const std::pair<std::string, const char*> cases[] = {{m5 + "\r", "M5"},
                                                         {m5 + "   \n\n", "M5"},
                                                         {"\x02" + m5 + "\r\n\x03\r\n\x1a", "M5"},
                                                         {r4 + "\n", "R4"},
                                                         {r5 + "\r\nEND\r\n", "R5"}};
    for (const auto& [text, layout] : cases) {
        ZeissRun run;
        const CCarnet& read = run.Read(text);
        EXPECT_EQ(ReportHeads(run), "Attention : ligne 1\n") << text;
        ASSERT_EQ(ElementsSummary(read),
                  "1000 Format               = " + std::string(layout) + "; 1001 INCONNUE; 1009 C1; 1003 9; ")
            << text;
        ExpectValues(read, 3, {kUndefined, 123.4567, 98.7654, 12.345});
    }
}

// A Windows-1252 field book comes to the reader in UTF-8: its columns are still counted in characters.
TEST(LectZeiss, AnAccentedCodeKeepsTheColumnsOfARec500Line) {
    const std::string line =
        "      6                 301  \xC9TE    Hz     50.5000 V1     99.5000 SD    25.432 \r\n";
    ZeissRun run;
    const CCarnet& read = run.Read(Sprintf("%-79s\r\n", "      1 POLAR") + line);
    EXPECT_EQ(ReportHeads(run), "Attention : ligne 2\n");
    ASSERT_EQ(ElementsSummary(read),
              "1000 Format               = Rec 500; 1000 POLAR; 1001 INCONNUE; 1009 ÉTE; 1003 301; ");
    ExpectValues(read, 4, {kUndefined, 50.5, 99.5, 25.432});
}

// M5 books of an instrument whose information block holds the information in columns 1-7, the code in
// 11-15 and the point id in 16-27: zeiss-m3-entete.txt says so in its header (words 20, 21, 22; word 05 = 1,
// X the northing), zeiss-m3-sans-entete.txt holds the same lines without it. Constructed: known points R1
// (E 1080, N 2060, Z 101.234) and R2 (E 1130, N 1900, Z 98.765); S1 at E 1000, N 2000, Z 100, HI 1.550, set
// up on a known station (Hz = bearings), its backsight to R1 written before its station line; S2 at E 1050,
// N 1950, Z 99.5, HI 1.620, its circle 41.2345 gon short of the bearings, oriented on R2, its backsight also
// written first; each height given after the start of the polar measurements. The observations were
// computed from the coordinates and rounded as the instrument writes them (0.1 mgon, mm); the coordinates
// after each sighting computed apart from this program from the observations as written, to the mm.
TEST(LectZeiss, AnM3BookRadiatesOntoTheInstrumentsCoordinates) {
    const std::pair<const char*, const char*> cases[] = {
        {"zeiss-m3-entete.txt", ""},
        {"zeiss-m3-sans-entete.txt",
         "Attention : ligne 1 : places du matricule et du code non données par l'en-tête ; d'après les "
         "lignes "
         "de points, matricule lu en colonnes 16 à 27 et code en colonnes 11 à 15 du bloc d'information.\n"},
    };
    for (const auto& [file, reports] : cases) {
        SCOPED_TRACE(file);
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile(file);
        EXPECT_EQ(ReportText(run), reports);
        EXPECT_TRUE(ElementsSummary(read).ends_with(
            "1009 BORNE; 1006 R1; 1009 BORNE; 1006 R2; 1000 KN STAT; 1001 S1; 1006 S1; 1002 R1; 1000 POLAR; "
            "1009 MUR HAUT; 1003 101; 1006 101; 1009 ARBRE; 1003 102; 1006 102; 1009 MUR; 1003 103; 1006 "
            "103; "
            "1000 OR.COOR; 1001 S2; 1006 S2; 1002 R2; 1000 POLAR; 1009 BORNE FER; 1003 201; 1006 201; 1009 "
            "MUR; "
            "1003 202; 1006 202; "))
            << ElementsSummary(read);
        // The radiation compares heights only where the station has one: its own check first.
        EXPECT_NEAR(read.hiAt(read.Find(kKindStation, "S1")), 1.55, 1e-4);
        EXPECT_NEAR(read.hiAt(read.Find(kKindStation, "S2")), 1.62, 1e-4);
        EXPECT_TRUE(AgreesWithInstrument(read, 7)); // R1, 101, 102, 103 from S1; R2, 201, 202 from S2
    }
}

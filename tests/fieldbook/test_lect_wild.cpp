// Wild / Leica GSI field books read into GéoBases: the field books of tests/data/fieldbook/wild-*.gsi
// were written for these tests. Their geometry is constructed: station S1 at (1000, 2000, 100) with an
// instrument height of 1.550, the known point A1 100 m to the east (bearing 100 gr, read at Hz 100 gr:
// V0 = 0), point 104 10 m to the north, level, sighted with a reflector at 1.300 (so at 100.250). Every
// value below is worked out by hand from the words as written.
#include "FieldBookTestSupport.h"
#include "core/Angles.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/LectWild.h"
#include "fieldbook/ParamDriver.h"
#include "fieldbook/TableCode.h"
#include "geobase/GeoFile.h"

#include <cmath>
#include <filesystem>
#include <gtest/gtest.h>

using namespace pyr;

namespace {

constexpr double kMetres = 1e-4; // 0.1 mm
constexpr double kGrads = 1e-4;  // 0.1 mgon

struct WildRun : ReaderRun<CLectWild> {
    CParamDriver driver{"", "", FieldBookFormat::Wild};
    CTableCode table;

    WildRun() { reader.SetDriver(&driver); }
    WildRun& Set(const char* key, std::string value) {
        driver.SetText(key, std::move(value));
        return *this;
    }
    WildRun& Interpreting() {
        EXPECT_TRUE(table.Init(DefaultCodeTable()));
        reader.SetCodeTable(&table);
        choices.interpret = true;
        return *this;
    }
    CCarnet& ReadFile(const std::string& name) { return Read(ReadBytes(FieldBookData(name))); }
};

// Each element as "kind name": the text of a comment, the word and parameters of a command.
std::vector<std::string> Summary(const CCarnet& carnet) {
    std::vector<std::string> lines;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        std::string line = std::to_string(kind) + ' ';
        if (kind == kKindComment)
            line += carnet.As<CComment>(i)->text();
        else if (IsCommandKind(kind))
            line += carnet.cmdAt(i) + (carnet.parAt(i).empty() ? "" : " " + carnet.parAt(i));
        else
            line += carnet.matAt(i);
        lines.push_back(line);
    }
    return lines;
}

void ExpectValue(double actual, double expected, double tolerance, const char* what, int index) {
    if (IsUndefined(expected))
        EXPECT_EQ(actual, kUndefined) << what << " of element " << index;
    else
        EXPECT_NEAR(actual, expected, tolerance) << what << " of element " << index;
}

struct Observation {
    double hp, ah, av, di;
};
void ExpectSighting(const CCarnet& carnet, int index, Observation o) {
    ExpectValue(carnet.hpAt(index), o.hp, kMetres, "HP", index);
    ExpectValue(carnet.ahAt(index), o.ah, kGrads, "AH", index);
    ExpectValue(carnet.avAt(index), o.av, kGrads, "AV", index);
    ExpectValue(carnet.diAt(index), o.di, kMetres, "DI", index);
}

void ExpectPoint(const CCarnet& carnet, int index, double x, double y, double z) {
    ExpectValue(carnet.xAt(index), x, kMetres, "X", index);
    ExpectValue(carnet.yAt(index), y, kMetres, "Y", index);
    ExpectValue(carnet.zAt(index), z, kMetres, "Z", index);
}

// "*110001+..." blocks as a surveyor's instrument writes them, for the short field books of the tests.
std::string Gsi8(std::initializer_list<const char*> words) {
    std::string line;
    for (const char* word : words)
        line += std::string(word) + ' ';
    return line;
}

} // namespace

TEST(LectWild, AGsi16FieldBookWithStationBlocksGivesItsStationSightingsAndPoints) {
    WildRun run;
    const CCarnet& read = run.ReadFile("wild-gsi16-84.gsi");
    EXPECT_TRUE(run.Reports().empty()) << run.Reports().front();
    const std::vector<std::string> expected{
        "1000 Format               = GSI-16",
        "1000 Numéro de série      = 640054",
        "1000 Appareil             = TCRP1201",
        "1000 Date                 = 01/02/2024",
        "1006 S1", // the station's coordinates, then the station
        "1001 S1",
        "1006 A1",
        "1000 Correction atmosphérique = 0 ppm",
        "1000 Constante de prisme  = 34 mm",
        "1002 A1", // A1 has coordinates: a reference
        "1003 101",
        "1003 101",
        "1003 102",
        "1003 A007",
        "1009 ARB 4.5", // the code comes before its sighting
        "1003 103",
        "1003 104", // the instrument's coordinates of 104 are not kept without the setting
    };
    ASSERT_EQ(Summary(read), expected);
    ExpectPoint(read, 4, 1000.0, 2000.0, 100.0);
    EXPECT_NEAR(read.hiAt(5), 1.55, kMetres);
    EXPECT_EQ(read.v0At(5), kUndefined);
    ExpectPoint(read, 6, 1100.0, 2000.0, 100.0);
    ExpectSighting(read, 9, {1.3, 100.0, 100.0, 100.0});
    ExpectSighting(read, 10, {1.3, 50.0, 100.0, 50.0});  // 45°00'00", 90°00'00", 50.0000 m (0.1 mm)
    ExpectSighting(read, 11, {1.3, 250.0, 300.0, 50.0}); // face II kept as read; 50.00000 m (0.01 mm)
    ExpectSighting(read, 12, {1.3, 123.45678, 98.76543, kUndefined}); // distance missing, not 0
    ExpectSighting(read, 13, {1.3, 50.0, 100.0, 3.048});              // 45.00000°, 1600.0000 mils, 10.000 ft
    ExpectSighting(read, 15, {1.3, 50.0, 100.0, 12.345});
    ExpectSighting(read, 16, {1.3, 0.0, 100.0, 10.0});
}

TEST(LectWild, TheInstrumentsCoordinatesOfAMeasuredPointAreKeptWhenAsked) {
    TempDir dir;
    WriteBytes(dir / "Wild.ini", "[Parametrage]\nPointsCalcules=1\n");
    for (const char* keep : {"1", "oui", "file"}) {
        WildRun run;
        if (keep == std::string("file"))
            ASSERT_TRUE(run.driver.Load(dir / "Wild.ini", &run.frontEnd));
        else
            run.Set(kKeyPointsCalcules, keep);
        const CCarnet& read = run.ReadFile("wild-gsi16-84.gsi");
        ASSERT_EQ(read.GetSize(), 18);
        EXPECT_EQ(Summary(read).back(), "1006 104");
        ExpectPoint(read, 17, 1000.0, 2010.0, 100.0 + 1.55 - 1.3);
        EXPECT_EQ(read.GetType(16), kKindMesure); // still a measured sighting, its point after it
    }
}

TEST(LectWild, AGsi8FieldBookWithCodeBlockStationsAndCrLineEnds) {
    WildRun run;
    const CCarnet& read = run.Set(kKeyReferences, "premiere").ReadFile("wild-gsi8-41.gsi");
    EXPECT_TRUE(run.Reports().empty()) << run.Reports().front();
    const std::vector<std::string> expected{
        "1000 Format               = GSI-8",
        "1001 STA1",
        "1002 1", // the first sighting of each station is its reference
        "1009 EXR 0.15",
        "1003 2",
        "1003 3",
        "1001 STA2",
        "1002 STA1",
    };
    ASSERT_EQ(Summary(read), expected);
    EXPECT_NEAR(read.hiAt(1), 1.55, kMetres); // word 43 typed "1.55"
    ExpectSighting(read, 2, {1.6, 0.0, 100.0, 25.0});
    ExpectSighting(read, 4, {1.6, 50.0, 95.0, 30.0});
    ExpectSighting(read, 5, {1.6, 100.0, 105.0, kUndefined});
    // STA2 gives no height in its code block; the 88 of its first sighting does.
    EXPECT_NEAR(read.hiAt(6), 1.48, kMetres);
    ExpectSighting(read, 7, {1.6, 200.0, 100.0, 50.0});
}

TEST(LectWild, AnEccentricOffsetCodeIsInterpretedInFrontOfItsSighting) {
    WildRun run;
    const CCarnet& read = run.Interpreting().ReadFile("wild-gsi8-41.gsi");
    ASSERT_EQ(Summary(read)[3], "1010 ExcentRad 0.15");
    EXPECT_EQ(read.matAt(4), "2");
    EXPECT_NEAR(read.findER(4, 1), 0.15, kMetres);
    EXPECT_EQ(read.findER(5, 1), 0.0); // the offset applies to the next sighting only
}

TEST(LectWild, TheStationConventionSaysWhichBlocksAreStations) {
    struct Case {
        const char* file;
        const char* convention;
        std::vector<std::string> kinds; // the elements after the header comments
        std::vector<std::string> reports;
    };
    const Case cases[] = {
        // Code blocks 2 and 21 are plain codes; the sightings before any station go to one to rename.
        {"wild-gsi8-41.gsi",
         "84",
         {"1009 2 STA1 1.55", "1001 INCONNUE", "1003 1", "1009 EXR 0.15", "1003 2", "1003 3", "1009 21 STA2",
          "1003 STA1"},
         {"Attention : ligne 7 : visées sans station, rattachées à la station <INCONNUE> (à renommer)."}},
        {"wild-gsi8-41.gsi",
         "auto",
         {"1001 STA1", "1003 1", "1009 EXR 0.15", "1003 2", "1003 3", "1001 STA2", "1003 STA1"},
         {}},
        // A block of words 84 to 88 gives a point, not a station; its 88 has no station to go to.
        {"wild-gsi16-84.gsi",
         "41",
         {"1006 S1", "1006 A1", "1000 Correction atmosphérique = 0 ppm", "1000 Constante de prisme  = 34 mm",
          "1001 INCONNUE", "1002 A1", "1003 101", "1003 101", "1003 102", "1003 A007", "1009 ARB 4.5",
          "1003 103", "1003 104"},
         {"Erreur ligne 2 : pas de station pour cette hauteur d'instrument !",
          "Attention : ligne 4 : visées sans station, rattachées à la station <INCONNUE> (à renommer)."}},
    };
    for (const Case& c : cases) {
        WildRun run;
        std::vector<std::string> summary =
            Summary(run.Set(kKeyConventionStation, c.convention).ReadFile(c.file));
        std::erase_if(summary, [](const std::string& line) {
            return line.starts_with("1000 ") && line.find("Correction") == std::string::npos &&
                   line.find("prisme") == std::string::npos;
        });
        EXPECT_EQ(summary, c.kinds) << c.file << " " << c.convention;
        EXPECT_EQ(run.Reports(), c.reports) << c.file << " " << c.convention;
    }
}

TEST(LectWild, EveryLineIsReadOrReportedWithItsNumber) {
    WildRun run;
    const CCarnet& read = run.ReadFile("wild-erreurs.gsi");
    const std::vector<std::string> expected{
        "Attention : ligne 1 : visées sans station, rattachées à la station <INCONNUE> (à renommer).",
        "Erreur ligne 3 : valeur numérique incorrecte <21.102+1234567X> !",
        "Erreur ligne 4 : donnée non reconnue !",
        " -> Chaîne lue = <2X.102+10000000>",
        "Erreur ligne 5 : donnée manquante pour les observations ou les coordonnées du point !",
        "Attention : ligne 6 : mot 99 inconnu, ignoré dans tout le carnet.",
        "Attention : ligne 8 : unité « 0 » impossible pour le mot 21, unité du fichier de paramétrage prise.",
        "Erreur ligne 9 : donnée manquante pour la coordonnée Nord !",
        "Erreur ligne 10 : donnée manquante pour le nom de la station !",
        "Attention : ligne 11 : hauteur d'instrument 1.600 différente de celle de la station <ST10> (1.500), "
        "celle de la station est gardée.",
        "Visée <210> : angle zénithal incorrect (450 gr, entre 0 et 400) : elle n'est pas ajoutée à la "
        "GéoBase !",
        "Erreur ligne 13 : donnée refusée par les contrôles de la GéoBase !",
    };
    EXPECT_EQ(run.Reports(), expected);
    const std::vector<std::string> kept{"1000 Format               = GSI-8",
                                        "1001 INCONNUE",
                                        "1003 200",
                                        "1006 ST10",
                                        "1001 ST10",
                                        "1003 204",
                                        "1003 205",
                                        "1003 206",
                                        "1003 208",
                                        "1003 209"};
    EXPECT_EQ(Summary(read), kept);
    ExpectPoint(read, 3, 10.0, 20.0, kUndefined);
    ExpectSighting(read, 7, {kUndefined, 100.0, kUndefined, kUndefined}); // unit digit 0 read in grads
}

TEST(LectWild, EveryLineEndBlankAndControlLineGivesTheSameElements) {
    const std::string station = Gsi8({"110001+00000S10", "84..10+00010000", "85..10+00020000"});
    const std::string sighting =
        Gsi8({"110002+00000101", "21.102+12345678", "22.102+09876543", "31..00+00012345"});
    const std::string cases[] = {
        station + "\n" + sighting + "\n",
        station + "\r\n" + sighting + "\r\n",
        station + "\r" + sighting,
        station + "\r\r\r" + sighting + "\r\r\r",
        "!Commentaire du chantier\n" + station + "    \n\n" + sighting + "      \n\x03\n\x04\n\x1a",
        "\x02" + station + "\r\n  " + sighting + "\r\n\x03",
    };
    for (const std::string& text : cases) {
        WildRun run;
        const CCarnet& read = run.Read(text);
        EXPECT_TRUE(run.Reports().empty()) << text;
        ASSERT_EQ(Summary(read), (std::vector<std::string>{"1000 Format               = GSI-8", "1006 S10",
                                                           "1001 S10", "1003 101"}))
            << text;
        ExpectSighting(read, 3, {kUndefined, 123.45678, 98.76543, 12.345});
    }
}

TEST(LectWild, ReferencesAreKnownPointsOrMarkedByTheirCodes) {
    const std::string text = Gsi8({"110001+00000S10", "88..10+00001500"}) + "\n" + Gsi8({"410002+00000099"}) +
                             "\n" +                                                // a code block
                             Gsi8({"110003+00000201", "21.102+10000000"}) + "\n" + // marked by it
                             Gsi8({"110004+00000202", "21.102+10000000", "71....+00000REF"}) + "\n" +
                             Gsi8({"110005+00000203", "21.102+10000000", "71....+00000ref"}) + "\n" +
                             Gsi8({"110006+00000204", "21.102+10000000", "71....+00000ARB"}) + "\n" +
                             Gsi8({"110007+00000205", "81..10+00001000", "82..10+00002000"}) + "\n" +
                             Gsi8({"110008+00000205", "21.102+10000000"}) + "\n";
    struct Case {
        const char* marking;
        std::vector<int> kinds; // of the five sightings
    };
    const Case cases[] = {
        {"codes", {kKindReference, kKindReference, kKindReference, kKindMesure, kKindReference}},
        {"aucune", {kKindMesure, kKindMesure, kKindMesure, kKindMesure, kKindReference}},
        {"premiere", {kKindReference, kKindMesure, kKindMesure, kKindMesure, kKindReference}},
    };
    for (const Case& c : cases) {
        WildRun run;
        const CCarnet& read =
            run.Set(kKeyReferences, c.marking).Set(kKeyCodesReference, "REF, 99").Read(text);
        EXPECT_TRUE(run.Reports().empty()) << c.marking;
        std::vector<int> kinds;
        for (int i = 0; i < read.GetSize(); ++i)
            if (IsSightingKind(read.GetType(i))) kinds.push_back(read.GetType(i));
        EXPECT_EQ(kinds, c.kinds) << c.marking;
    }
}

TEST(LectWild, IdsAreKeptAsWrittenButForTheirPadding) {
    const std::string text =
        Gsi8({"110001+00000S10", "88..10+00001500"}) + "\n" + Gsi8({"110002+0000A007", "21.102+10000000"}) +
        "\n" + Gsi8({"110003+00000007", "21.102+10000000"}) + "\n" +
        Gsi8({"110004+   A  12", "21.102+10000000"}) + "\n" + Gsi8({"110005+00001.50", "21.102+10000000"}) +
        "\n" + Gsi8({"110006+0000007B", "21.102+10000000"}) + "\n" + "*" +
        "110007+0000000000000012 21.102+0000000010000000 \n";
    WildRun run;
    CCarnet& read = run.Read(text);
    EXPECT_TRUE(run.Reports().empty());
    std::vector<std::string> mats;
    for (int i = 0; i < read.GetSize(); ++i)
        if (IsSightingKind(read.GetType(i))) mats.push_back(read.matAt(i));
    EXPECT_EQ(mats, (std::vector<std::string>{"A007", "7", "A  12", "1.50", "7B", "12"}));
    // And so they stay in the GéoBase written and read back.
    TempDir dir;
    ASSERT_TRUE(read.Save(dir / "ids.geo"));
    CCarnet back;
    ASSERT_TRUE(back.Load(nullptr, dir / "ids.geo"));
    ASSERT_EQ(back.GetSize(), read.GetSize());
    for (int i = 0; i < read.GetSize(); ++i)
        EXPECT_EQ(back.matAt(i), read.matAt(i));
}

TEST(LectWild, TheSettingsGiveTheUnitsAndTheOrderTheWordsDoNotSay) {
    const std::string text =
        Gsi8({"110001+00000S10", "84....+00010000", "85....+00020000", "88....+00001500"}) + "\n" +
        Gsi8({"110002+00000101", "21....+04530000", "22....+09000000", "31....+00010000"}) + "\n";
    WildRun run;
    const CCarnet& read = run.Set(kKeyUniteAngles, "dms")
                              .Set(kKeyUniteDistances, "pieds")
                              .Set(kKeyOrdreCoordonnees, "YX")
                              .Read(text);
    ASSERT_EQ(Summary(read), (std::vector<std::string>{"1000 Format               = GSI-8", "1006 S10",
                                                       "1001 S10", "1003 101"}));
    ExpectPoint(read, 1, 20.0 * 0.3048, 10.0 * 0.3048, kUndefined); // 84 held the northing
    EXPECT_NEAR(read.hiAt(2), 1.5 * 0.3048, kMetres);
    ExpectSighting(read, 3, {kUndefined, 45.5 * 400.0 / 360.0, 100.0, 10.0 * 0.3048});
}

TEST(LectWild, AHorizontalDistanceGivesTheSlopeDistance) {
    const std::string station = Gsi8({"110001+00000S10", "88..10+00001500"}) + "\n";
    struct Case {
        const char* words;
        double av, di;
    };
    const Case cases[] = {
        // sin(50 gr) = √2 / 2
        {"21.102+10000000 22.102+05000000 32..00+00010000", 50.0, 10.0 * std::sqrt(2.0)},
        // A 3-4-5 triangle: horizontal 3, height difference 4; cos(AV) = 4 / 5.
        {"21.102+10000000 32..00+00003000 33..00+00004000", RadiansToGrads(std::acos(0.8)), 5.0},
        // Alone, it is taken as horizontal.
        {"21.102+10000000 32..00+00003000", 100.0, 3.0},
        // The slope distance is preferred when given.
        {"21.102+10000000 22.102+05000000 31..00+00012000 32..00+00010000", 50.0, 12.0},
    };
    for (const Case& c : cases) {
        WildRun run;
        const CCarnet& read = run.Read(station + "110002+00000101 " + c.words + "\n");
        ASSERT_EQ(read.GetSize(), 3) << c.words;
        ExpectSighting(read, 2, {kUndefined, 100.0, c.av, c.di});
    }
}

TEST(LectWild, LevellingStaffReadingsBecomeBackAndForeReadings) {
    const std::string text = Gsi8({"110001+000000R1", "32...8+02500000", "331.08+00123456"}) + "\n" +
                             Gsi8({"110002+000000R2", "32...8+02400000", "332.08+00098765"}) + "\n" +
                             Gsi8({"110003+000000R2", "83..18+04825000"}) + "\n";
    WildRun run;
    const CCarnet& read = run.Read(text);
    EXPECT_TRUE(run.Reports().empty());
    ASSERT_EQ(Summary(read), (std::vector<std::string>{"1000 Format               = GSI-8", "1004 R1",
                                                       "1005 R2", "1006 R2"}));
    EXPECT_NEAR(read.lmAt(1), 1.23456, kMetres);
    EXPECT_NEAR(read.dhAt(1), 25.0, kMetres);
    EXPECT_NEAR(read.lmAt(2), 0.98765, kMetres);
    ExpectPoint(read, 3, kUndefined, kUndefined, 48.25);
}

TEST(LectWild, AWildConversionWritesItsGeoBase) {
    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    const std::string install = dir / "installation/";
    std::filesystem::create_directories(install + "Config");
    std::filesystem::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/Wild.ini",
                               install + "Config/Wild.ini");
    std::filesystem::copy_file(FieldBookData("wild-gsi16-84.gsi"), dir / "levé.gsi");
    frontEnd.dialogArguments = {dir / "levé.gsi"};
    FieldBookConverter converter(FieldBookFormat::Wild, &frontEnd, dir / "Pyralis.ini", install, &txt,
                                 nullptr);
    ASSERT_EQ(RunConversion(converter, nullptr), ui::DialogResult::Ok);
    CCarnet written;
    ASSERT_TRUE(written.Load(nullptr, dir / "levé.geo"));
    ASSERT_EQ(written.GetSize(), 18);
    EXPECT_EQ(written.As<CComment>(0)->text(), "Fichier              = levé.gsi");
    EXPECT_EQ(written.GetType(10), kKindReference);
}

TEST(LectWild, HeaderInformationAndConstantsAreCommentsWrittenWhenTheyChange) {
    const std::string text =
        Gsi8({"12....+00640054", "13....+00TCR305", "17....+00010224", "19....+02081029"}) + "\n" +
        Gsi8({"110001+00000S10", "88..10+00001500", "58..16+00000020", "59..16+02200000"}) + "\n" +
        // The time of a sighting is no header; constants repeated are said once.
        Gsi8({"110002+00000101", "21.102+10000000", "19....+02081031", "58..16+00000020"}) + "\n" +
        Gsi8({"110003+00000102", "21.102+10000000", "51..1.+0012-017", "17....+01032024"}) + "\n";
    WildRun run;
    const std::vector<std::string> expected{
        "1000 Format               = GSI-8",
        "1000 Numéro de série      = 640054",
        "1000 Appareil             = TCR305",
        "1000 Date                 = 01/02/24",
        "1000 Date et heure        = 08/02 10:29",
        "1000 Correction atmosphérique = 220 ppm", // 220.0000 ppm (unit digit 6)
        "1000 Constante de prisme  = 2 mm",        // 0.0020 m
        "1001 S10",
        "1003 101",
        "1000 Date                 = 01/03/2024",
        "1000 Correction atmosphérique = 12 ppm",
        "1000 Constante de prisme  = -17 mm",
        "1003 102",
    };
    EXPECT_EQ(Summary(run.Read(text)), expected);
    EXPECT_TRUE(run.Reports().empty());
}

TEST(LectWild, AStationNumberOnTheMeasurementsOpensItsStation) {
    const std::string text =
        Gsi8({"110001+00000101", "16....+00000S20", "21.102+10000000", "84..10+00010000", "85..10+00020000",
              "88..10+00001500"}) +
        "\n" + Gsi8({"110002+00000102", "16....+00000S20", "21.102+20000000", "88..10+00001500"}) + "\n" +
        Gsi8({"110003+00000103", "16....+00000S21", "21.102+30000000"}) + "\n";
    for (const char* convention : {"auto", "84"}) {
        WildRun run;
        const CCarnet& read = run.Set(kKeyConventionStation, convention).Read(text);
        EXPECT_TRUE(run.Reports().empty());
        EXPECT_EQ(Summary(read),
                  (std::vector<std::string>{"1000 Format               = GSI-8", "1006 S20", "1001 S20",
                                            "1003 101", "1003 102", "1001 S21", "1003 103"}));
        ExpectPoint(read, 1, 10.0, 20.0, kUndefined);
        EXPECT_NEAR(read.hiAt(2), 1.5, kMetres);
        EXPECT_EQ(read.hiAt(5), kUndefined);
    }
}

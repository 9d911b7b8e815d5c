// Points of a GéoBase exported as a DXF drawing through the delivered settings file and variants of it,
// read back by ezdxf (dxf_check.py): where each point and each text stands, on which layer; the points
// that cannot be drawn; the settings that cannot serve, and the files that cannot be written.
#include "DxfTestSupport.h"
#include "FieldBookTestSupport.h"
#include "core/Undefined.h"
#include "fieldbook/ExportDxf.h"

#include <clocale>
#include <gtest/gtest.h>
#include <map>

using namespace pyr;

namespace {

using Point = SurveyPoint;

// Lambert-93 points, and what a GéoBase may hold besides: two codes that make one layer name, a point
// without altitude, one in altitude only, a zero altitude that is a value, accents, a point without code.
const std::vector<Point> kSurvey = {
    {"1", 651200.1234, 6862300.5678, 45.6789, "MUR"},
    {"2", 651210.0, 6862310.0, kUndefined, "mur"},
    {"3", kUndefined, kUndefined, 50.0, "REPERE"},
    {"Éa4", 651220.5, 6862290.25, 0.0, "Bordure béton"},
    {"5", -12.5, 3.25, -1.5, ""},
};

std::string Shipped() {
    return std::string(PYR_SOURCE_DIR) + "/data/Config/Export_Dxf.ini";
}

// The delivered settings file with some keys given other values, its comments kept.
std::string SettingsText(const std::map<std::string, std::string>& changes) {
    std::string text;
    const std::string shipped = ReadBytes(Shipped());
    std::size_t start = 0;
    while (start < shipped.size()) {
        std::size_t end = shipped.find('\n', start);
        if (end == std::string::npos) end = shipped.size();
        std::string line = shipped.substr(start, end - start);
        const std::size_t equal = line.find('=');
        if (equal != std::string::npos && line[0] != ';')
            if (auto change = changes.find(line.substr(0, equal)); change != changes.end())
                line = change->first + "=" + change->second;
        text += line + "\n";
        start = end + 1;
    }
    return text;
}

class ExportDxfTest : public ::testing::Test {
protected:
    std::string Settings(const std::map<std::string, std::string>& changes = {}) {
        const std::string path = dir / "Export_Dxf.ini";
        WriteBytes(path, SettingsText(changes));
        return path;
    }

    PointExportJob Job(const std::string& settings, const std::string& output) {
        return ExportJob(survey, settings, output, frontEnd, txt);
    }

    // ezdxf's reading of the file agrees with the lists: points "x y z LAYER", texts "LAYER\ttext\tx y",
    // layers "NAME colour".
    void ExpectDrawing(const std::string& file, const std::string& points, const std::string& texts,
                       const std::string& layers) {
        WriteBytes(dir / "points", points);
        WriteBytes(dir / "texts", texts);
        WriteBytes(dir / "layers", layers);
        std::string report;
        EXPECT_EQ(dxftest::CheckWithEzdxf(file,
                                          "--points '" + dir / "points" + "' --texts '" + dir / "texts" +
                                              "' --layers '" + dir / "layers" + "'",
                                          report),
                  0)
            << report;
    }

    // The export with the delivered settings, and what ezdxf finds in it.
    void ExportWithDeliveredSettings() {
        const std::string output = dir / "levé.dxf";
        ASSERT_TRUE(CDlgConfigDxf::Export(Job(Settings(), output))) << MessageTexts(frontEnd);
        // Texts 0.5 m high, the first 0.3 m right of the point and 0.1 m above it, the next 0.75 m lower.
        ExpectDrawing(output,
                      "651200.1234 6862300.5678 45.6789 MUR\n"
                      "651210 6862310 0 MUR\n"
                      "651220.5 6862290.25 0 BORDURE_BETON\n"
                      "-12.5 3.25 -1.5 POINTS\n",
                      "MUR\t1\t651200.4234 6862300.6678\n"
                      "MUR\t45.679\t651200.4234 6862299.9178\n"
                      "MUR\t2\t651210.3 6862310.1\n"
                      "BORDURE_BETON\tÉa4\t651220.8 6862290.35\n"
                      "BORDURE_BETON\t0.000\t651220.8 6862289.6\n"
                      "POINTS\t5\t-12.2 3.35\n"
                      "POINTS\t-1.500\t-12.2 2.6\n",
                      "0 7\nPOINTS 7\nMUR 1\nBORDURE_BETON 3\n");
        EXPECT_EQ(frontEnd.AllLines(),
                  "Point <3> non exporté : point sans coordonnées X, Y, il ne peut pas être dessiné.");
        ASSERT_EQ(frontEnd.messages.size(), 1u);
        EXPECT_NE(frontEnd.messages[0].text.find("1 point(s) non exporté(s)"), std::string::npos);
    }

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    CCarnet survey = Survey(kSurvey);
};

TEST_F(ExportDxfTest, DeliveredSettingsDrawEachPointOnTheLayerOfItsCodeWithItsTexts) {
    ExportWithDeliveredSettings();
}

TEST_F(ExportDxfTest, UnderAFrenchLocaleNumbersKeepTheirPoint) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    ExportWithDeliveredSettings();
    std::setlocale(LC_ALL, previous.c_str());
    const std::string text = ReadBytes(dir / "levé.dxf");
    EXPECT_NE(text.find("\r\n651200.1234\r\n"), std::string::npos);
    EXPECT_EQ(text.find("45,679"), std::string::npos);
}

TEST_F(ExportDxfTest, OneLayerTurnedTextsOnLayersOfTheirOwn) {
    const std::string output = dir / "plan.dxf";
    const std::string settings = Settings({{"CalquesParCode", "0"},
                                           {"NomCalque", "Levé"},
                                           {"CouleurCalque", "5"},
                                           {"CalquesTextes", "1"},
                                           {"EcrireCode", "1"},
                                           {"RotationTexte", "100"},
                                           {"HauteurTexte", "1"},
                                           {"DecimalesZ", "2"}});
    ASSERT_TRUE(CDlgConfigDxf::Export(Job(settings, output))) << MessageTexts(frontEnd);
    // Turned 100 gr, the texts read northward: the offset 0.3 along them goes north, the 0.1 across
    // them west, and each next line 1.5 m further east.
    ExpectDrawing(output,
                  "651200.1234 6862300.5678 45.6789 LEVE\n"
                  "651210 6862310 0 LEVE\n"
                  "651220.5 6862290.25 0 LEVE\n"
                  "-12.5 3.25 -1.5 LEVE\n",
                  "LEVE_MAT\t1\t651200.0234 6862300.8678\n"
                  "LEVE_ALT\t45.68\t651201.5234 6862300.8678\n"
                  "LEVE_COD\tMUR\t651203.0234 6862300.8678\n"
                  "LEVE_MAT\t2\t651209.9 6862310.3\n"
                  "LEVE_COD\tmur\t651211.4 6862310.3\n"
                  "LEVE_MAT\tÉa4\t651220.4 6862290.55\n"
                  "LEVE_ALT\t0.00\t651221.9 6862290.55\n"
                  "LEVE_COD\tBordure béton\t651223.4 6862290.55\n"
                  "LEVE_MAT\t5\t-12.6 3.55\n"
                  "LEVE_ALT\t-1.50\t-11.1 3.55\n",
                  "LEVE 5\nLEVE_MAT 5\nLEVE_ALT 5\nLEVE_COD 5\n");
    const std::string text = ReadBytes(output);
    EXPECT_NE(text.find("\r\n50\r\n90\r\n"), std::string::npos) << "100 gr are 90 degrees";
}

TEST_F(ExportDxfTest, SettingsThatCannotServeWriteNothing) {
    const std::string output = dir / "plan.dxf";
    struct Case {
        std::map<std::string, std::string> changes;
        std::string said;
    };
    const std::vector<Case> cases = {
        {{{"HauteurTexte", "abc"}}, "valeur « abc » incorrecte pour HauteurTexte"},
        {{{"HauteurTexte", "0"}}, "valeur « 0 » incorrecte pour HauteurTexte"},
        {{{"CalquesParCode", "2"}},
         "valeur « 2 » incorrecte pour CalquesParCode (valeurs possibles : 0 ou 1)"},
        {{{"CouleurCalque", "256"}}, "incorrecte pour CouleurCalque"},
        {{{"DecimalesZ", "7"}}, "incorrecte pour DecimalesZ"},
        {{{"TypePoint", "5"}}, "valeur « 5 » incorrecte pour TypePoint"},
        {{{"DecalageTexteX", "1e9"}}, "incorrecte pour DecalageTexteX"},
        {{{"RotationTexte", "12 gr"}}, "incorrecte pour RotationTexte"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.said);
        frontEnd.messages.clear();
        EXPECT_FALSE(CDlgConfigDxf::Export(Job(Settings(c.changes), output)));
        EXPECT_NE(MessageTexts(frontEnd).find(c.said), std::string::npos) << MessageTexts(frontEnd);
        EXPECT_FALSE(std::filesystem::exists(output));
    }

    frontEnd.messages.clear();
    EXPECT_FALSE(CDlgConfigDxf::Export(Job(dir / "absent.ini", output)));
    EXPECT_NE(MessageTexts(frontEnd).find("absent.ini> n'existe pas"), std::string::npos)
        << MessageTexts(frontEnd);
    EXPECT_FALSE(std::filesystem::exists(output));

    // A decimal comma reads as a point; a key without value, or absent, keeps its default.
    CDlgConfigDxf dialog;
    WriteBytes(dir / "short.ini", "[Exportation]\nHauteurTexte=0,25\nNomCalque=\n");
    ASSERT_TRUE(dialog.Load(dir / "short.ini", &frontEnd)) << MessageTexts(frontEnd);
    DxfExportSettings expected;
    expected.textHeight = 0.25;
    EXPECT_EQ(dialog.Settings(), expected);
}

TEST_F(ExportDxfTest, NothingToDrawOrNowhereToWriteLeavesNoFile) {
    const std::string settings = Settings();
    const std::string output = dir / "plan.dxf";

    const std::vector<int> nothing;
    PointExportJob empty = Job(settings, output);
    empty.selection = &nothing;
    EXPECT_FALSE(CDlgConfigDxf::Export(empty));
    EXPECT_NE(MessageTexts(frontEnd).find("Aucun point à dessiner"), std::string::npos)
        << MessageTexts(frontEnd);

    // Only the point without planimetry: told, and still no drawing.
    frontEnd.messages.clear();
    const std::vector<int> third = {2};
    PointExportJob unplaced = Job(settings, output);
    unplaced.selection = &third;
    EXPECT_FALSE(CDlgConfigDxf::Export(unplaced));
    EXPECT_NE(MessageTexts(frontEnd).find("Aucun point à dessiner"), std::string::npos);
    EXPECT_NE(MessageTexts(frontEnd).find("1 point(s) non exporté(s)"), std::string::npos);
    EXPECT_FALSE(std::filesystem::exists(output));

    frontEnd.messages.clear();
    const std::string nowhere = dir / "absent/plan.dxf";
    EXPECT_FALSE(CDlgConfigDxf::Export(Job(settings, nowhere)));
    EXPECT_NE(MessageTexts(frontEnd).find(nowhere), std::string::npos) << MessageTexts(frontEnd);
    EXPECT_EQ(FileNames(dir.Root()), (std::vector<std::string>{"Export_Dxf.ini"}));
}

TEST_F(ExportDxfTest, ADrawingIsReplacedNeverAppendedTo) {
    const std::string output = dir / "plan.dxf";
    WriteBytes(output, "an older drawing\r\n");
    PointExportJob job = Job(Settings(), output);
    job.append = true;
    ASSERT_TRUE(CDlgConfigDxf::Export(job)) << MessageTexts(frontEnd);
    EXPECT_TRUE(ReadBytes(output).starts_with("0\r\nSECTION\r\n2\r\nHEADER\r\n"));
}

TEST_F(ExportDxfTest, SettingsSavedAreReadBackAndTheFileKeepsItsComments) {
    CDlgConfigDxf delivered;
    ASSERT_TRUE(delivered.Load(Shipped(), &frontEnd)) << MessageTexts(frontEnd);
    EXPECT_EQ(delivered.Settings(), DxfExportSettings())
        << "the delivered file says what the program assumes";

    const std::string path = Settings();
    CDlgConfigDxf dialog;
    DxfExportSettings& s = dialog.Settings();
    s = {.layersByCode = false,
         .layerName = "Plan topo",
         .layerColour = 42,
         .colourByCode = false,
         .textLayers = true,
         .writeIdentifier = false,
         .writeAltitude = false,
         .writeCode = true,
         .textHeight = 1.25,
         .textOffsetX = -0.4,
         .textOffsetY = 0.05,
         .textRotationGrads = 133.3333,
         .altitudeDecimals = 1,
         .pointMode = 35,
         .pointSize = -2.5};
    ASSERT_TRUE(dialog.Save(path)) << MessageTexts(frontEnd);
    CDlgConfigDxf back;
    ASSERT_TRUE(back.Load(path, &frontEnd)) << MessageTexts(frontEnd);
    EXPECT_EQ(back.Settings(), s);
    const std::string text = ReadBytes(path);
    EXPECT_NE(text.find("; Hauteur des textes, en mètres"), std::string::npos);
    EXPECT_NE(text.find("HauteurTexte=1.25"), std::string::npos);
}

} // namespace

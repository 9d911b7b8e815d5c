// Points of a GéoBase exported as delimited and columnar field books through the delivered settings files
// (and variants of them), read back by our own readers with the same settings; the lines checked by hand
// against the layout; completing a file; the points the columns cannot hold; settings that cannot serve.
#include "FieldBookTestSupport.h"
#include "core/Undefined.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/ExportLayout.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <limits>
#include <map>

using namespace pyr;
namespace fs = std::filesystem;

namespace {

using Point = SurveyPoint;

// Lambert-93 points to the 0.1 mm, and what a GéoBase may hold besides: negative values, a point without
// altitude, one in altitude only, a zero that is a value, identifiers with leading zeros or accents, codes
// with blanks, with the separator, with quotes.
const std::vector<Point> kSurvey = {
    {"0012", 652110.2141, 6861845.6372, 61.2085, "BORNE"},
    {"P2", -1250.5003, -0.0001, -12.3456, "ARB 6"},
    {"B3", 651200.0, 6862300.0, kUndefined, "Lampadaire ; double"},
    {"S10", 652215.48, 6861830.215, 61.734, R"(Poteau "bois")"},
    {"NGF12", kUndefined, kUndefined, 58.412, "REPERE"},
    {"Éé1", 1.5, 2.5, 0.0, ""},
};

class ExportLayoutTest : public ::testing::Test {
protected:
    // A copy of the delivered settings file of the format, some keys given other values.
    std::string Settings(FieldBookFormat format, const std::map<std::string, std::string>& changes = {}) {
        const char* extension = format == FieldBookFormat::Separateur ? "sep" : "col";
        const std::string path = dir / (std::string("export.") + extension);
        fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/Param_Export." + extension, path,
                      fs::copy_options::overwrite_existing);
        CParamDriver settings("", path, format);
        EXPECT_TRUE(settings.Load(nullptr));
        for (const auto& [key, value] : changes)
            settings.SetText(key, value);
        EXPECT_TRUE(settings.Save());
        return path;
    }

    PointExportJob Job(const std::string& settings, const std::string& output) {
        return ExportJob(survey, settings, output, frontEnd, txt);
    }

    static bool Export(FieldBookFormat format, const PointExportJob& job) {
        return format == FieldBookFormat::Separateur ? CDlgConfigSep::Export(job)
                                                     : CDlgConfigCol::Export(job);
    }

    // The file read back by the reader of the format with the same settings; nothing may be reported.
    CCarnet ReadBack(FieldBookFormat format, const std::string& settings, const std::string& output) {
        CParamDriver layout("", settings, format);
        EXPECT_TRUE(layout.Load(&frontEnd)) << MessageTexts(frontEnd);
        CCarnet back;
        ui::ScriptedFrontEnd readFrontEnd;
        CPyrTxtWnd readTxt{readFrontEnd};
        if (format == FieldBookFormat::Separateur)
            CDlgConfigSep::ImportText(layout, ReadBytes(output), back, &readTxt);
        else
            CDlgConfigCol::ImportText(layout, ReadBytes(output), back, &readTxt);
        EXPECT_EQ(readFrontEnd.AllLines(), "");
        return back;
    }

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    CCarnet survey = Survey(kSurvey);
};

// Each point of `expected` found in `back`, in order, its coordinates within `metres` (a missing value
// still missing), its identifier and code unchanged.
void ExpectSamePoints(const CCarnet& back, const std::vector<Point>& expected, double metres) {
    ASSERT_EQ(back.GetSize(), static_cast<int>(expected.size()));
    for (int i = 0; i < back.GetSize(); ++i) {
        const Point& p = expected[static_cast<std::size_t>(i)];
        SCOPED_TRACE(p.mat);
        EXPECT_EQ(back.GetType(i), kKindPoint);
        EXPECT_EQ(back.matAt(i), p.mat);
        EXPECT_EQ(back.symAt(i), p.code);
        const double actual[] = {back.xAt(i), back.yAt(i), back.zAt(i)};
        const double wanted[] = {p.x, p.y, p.z};
        for (int k = 0; k < 3; ++k) {
            if (IsUndefined(wanted[k]))
                EXPECT_EQ(actual[k], kUndefined) << "coordinate " << k;
            else if (metres == 0.0)
                EXPECT_EQ(actual[k], wanted[k]) << "coordinate " << k;
            else
                EXPECT_NEAR(actual[k], wanted[k], metres) << "coordinate " << k;
        }
    }
}

struct Variant {
    const char* name;
    std::map<std::string, std::string> changes;
    double metres; // how close the coordinates come back; 0: the same doubles
};

} // namespace

// A delimited line carries every digit: in metres the very same doubles come back; in feet, to the
// rounding of the conversion (1 nm). Texts holding the separator, blanks or quotes come back whole.
TEST_F(ExportLayoutTest, DelimitedPointsComeBackThroughEveryLayout) {
    const std::vector<Variant> variants = {
        {"livré", {}, 0.0},
        {"tabulation", {{"Separateur", "TAB"}}, 0.0},
        {"blancs", {{"Separateur", "ESPACE"}}, 0.0},
        {"blancs, code d'abord",
         {{"Separateur", "ESPACE"},
          {"ChampsStation", ""},
          {"ChampsVisee", ""},
          {"ChampsPoint", "CODE,MATRICULE,X,Y,Z"}},
         0.0},
        {"tableur français", {{"SeparateurDecimal", ","}, {"LignesEntete", "2"}}, 0.0},
        {"virgule des deux côtés", {{"Separateur", ","}, {"SeparateurDecimal", ","}}, 0.0},
        {"plusieurs caractères", {{"Separateur", " | "}}, 0.0},
        {"pieds", {{"UniteDistances", "pieds"}}, 1e-9},
        {"sans TYPE, nord d'abord",
         {{"ChampsStation", ""}, {"ChampsVisee", ""}, {"ChampsPoint", "CODE,MATRICULE,Y,IGNORE,X,Z,IGNORE"}},
         0.0},
        {"mot de type à guillemets", {{"TypePoint", R"("P;T")"}}, 0.0},
    };
    for (const Variant& v : variants) {
        SCOPED_TRACE(v.name);
        const std::string settings = Settings(FieldBookFormat::Separateur, v.changes);
        const std::string output = dir / "points.csv";
        ASSERT_TRUE(CDlgConfigSep::Export(Job(settings, output)));
        ExpectSamePoints(ReadBack(FieldBookFormat::Separateur, settings, output), kSurvey, v.metres);
    }
    EXPECT_EQ(MessageTexts(frontEnd), "");
    EXPECT_EQ(frontEnd.AllLines(), "");
}

// A columnar number is the shortest exact text when it fits its columns, as all of the survey's do in the
// delivered layout (X and Y 14 columns, Z 10): the same doubles again. In feet the text is rounded to the
// decimals the columns leave (5 for a Lambert-93 northing in feet: 1.5 µm).
TEST_F(ExportLayoutTest, ColumnarPointsComeBackThroughEveryLayout) {
    const std::vector<Variant> variants = {
        {"livré", {}, 0.0},
        {"pieds", {{"UniteDistances", "pieds"}}, 1e-5},
        {"virgule, en-tête", {{"SeparateurDecimal", ","}, {"LignesEntete", "3"}}, 0.0},
        {"sans TYPE, dans le désordre, code jusqu'au bout",
         {{"ChampsStation", ""},
          {"ChampsVisee", ""},
          {"ChampsPoint", "CODE:56-,Y:15-28,MATRICULE:1-10,IGNORE:11-13,X:30-43,Z:45-54"}},
         0.0},
        {"code borné, type d'une lettre",
         {{"ChampsPoint", "TYPE:1-1,MATRICULE:2-9,X:10-23,Y:24-37,Z:38-47,CODE:48-70"}, {"TypePoint", "P"}},
         0.0},
    };
    for (const Variant& v : variants) {
        SCOPED_TRACE(v.name);
        const std::string settings = Settings(FieldBookFormat::Colonne, v.changes);
        const std::string output = dir / "points.txt";
        ASSERT_TRUE(CDlgConfigCol::Export(Job(settings, output)));
        ExpectSamePoints(ReadBack(FieldBookFormat::Colonne, settings, output), kSurvey, v.metres);
    }
    EXPECT_EQ(MessageTexts(frontEnd), "");
    EXPECT_EQ(frontEnd.AllLines(), "");
}

// The lines written out by hand from the layouts, the header line naming the fields.
TEST_F(ExportLayoutTest, TheLinesAreThoseTheLayoutDescribes) {
    survey = Survey({kSurvey[0], kSurvey[2], kSurvey[3]});
    const std::string sepFile = dir / "points.csv";
    ASSERT_TRUE(
        CDlgConfigSep::Export(Job(Settings(FieldBookFormat::Separateur, {{"LignesEntete", "1"}}), sepFile)));
    EXPECT_EQ(ReadBytes(sepFile), "TYPE;MATRICULE;X;Y;Z;CODE\n"
                                  "PT;0012;652110.2141;6861845.6372;61.2085;BORNE\n"
                                  "PT;B3;651200;6862300;;\"Lampadaire ; double\"\n"
                                  "PT;S10;652215.48;6861830.215;61.734;\"Poteau \"\"bois\"\"\"\n");
    // TYPE:1-2,MATRICULE:4-19,X:21-34,Y:36-49,Z:51-60,CODE:62-, numbers right-aligned.
    survey = Survey({kSurvey[0], kSurvey[1], kSurvey[2]});
    const std::string colFile = dir / "points.txt";
    ASSERT_TRUE(
        CDlgConfigCol::Export(Job(Settings(FieldBookFormat::Colonne, {{"LignesEntete", "2"}}), colFile)));
    //                      1         2         3         4         5         6
    //             123456789012345678901234567890123456789012345678901234567890123456789
    const char* expected =
        "\n"
        "TY MATRICULE        X              Y              Z          CODE\n"
        "PT 0012                652110.2141   6861845.6372    61.2085 BORNE\n"
        "PT P2                   -1250.5003        -0.0001   -12.3456 ARB 6\n"
        "PT B3                       651200        6862300            Lampadaire ; double\n";
    EXPECT_EQ(ReadBytes(colFile), expected);
}

// "Compléter": the points follow what the file holds, its header lines are not written again, and a last
// line without its end is ended first. A new or empty file gets them.
TEST_F(ExportLayoutTest, CompletingAFileKeepsWhatItHolds) {
    for (FieldBookFormat format : {FieldBookFormat::Separateur, FieldBookFormat::Colonne}) {
        SCOPED_TRACE(static_cast<int>(format));
        const std::string settings = Settings(format, {{"LignesEntete", "1"}});
        const std::string output = dir / "points.txt";
        fs::remove(output);
        PointExportJob job = Job(settings, output);
        job.range = IdentifierRange::Make("P1", "P9");
        job.append = true; // a file that does not exist yet is a new file
        ASSERT_TRUE(Export(format, job));
        job.range = IdentifierRange::Make("S1", "S99");
        ASSERT_TRUE(Export(format, job));
        const std::string text = ReadBytes(output);
        EXPECT_EQ(text.find("MATRICULE"), text.rfind("MATRICULE")) << text;
        ExpectSamePoints(ReadBack(format, settings, output), {kSurvey[1], kSurvey[3]}, 0.0);

        // A file of the surveyor's own, whose last line does not end: the header is not written, the line is
        // ended.
        WriteBytes(output, "PT;ancien");
        ASSERT_TRUE(Export(format, job));
        EXPECT_EQ(ReadBytes(output).substr(0, 10), "PT;ancien\n");
        EXPECT_EQ(ReadBytes(output).find("MATRICULE"), std::string::npos);
        // An empty file is a new one.
        WriteBytes(output, "");
        ASSERT_TRUE(Export(format, job));
        EXPECT_EQ(ReadBytes(output).rfind("TY", 0), 0u);
    }
    EXPECT_EQ(MessageTexts(frontEnd), "");
}

// What the columns cannot hold is left out and told, never cut: the other points are written; a number
// that only loses decimals is rounded to those its columns leave.
TEST_F(ExportLayoutTest, PointsTheColumnsCannotHoldAreLeftOut) {
    survey = Survey({
        {"P1", 100.25, 200.5, 10.0, "BORNE"},
        {"LONGMAT1", 1.0, 2.0, 3.0, ""},
        {"P3", 12345678901.5, 2.0, 3.0, ""},
        {"P4", 1.0, 2.0, 1234.56789, ""},
        {"P5", 1.0, 2.0, 3.0, "TROPLONGCODE"},
        {"P6", 1.0, 2.0, 999999.7, ""},
        {"P7", 1.0, -123456789.1, kUndefined, ""},
        {"", 1.0, 2.0, 3.0, ""},
    });
    const std::string settings =
        Settings(FieldBookFormat::Colonne,
                 {{"ChampsPoint", "TYPE:1-2,MATRICULE:4-8,X:10-19,Y:21-30,Z:32-37,CODE:39-44"}});
    const std::string output = dir / "points.txt";
    ASSERT_TRUE(CDlgConfigCol::Export(Job(settings, output)));
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{
                                  "Point <LONGMAT1> non exporté : matricule de plus de 5 caractères.",
                                  "Point <P3> non exporté : X trop grand pour le format (colonnes 10 à 19).",
                                  "Point <P5> non exporté : code de plus de 6 caractères.",
                                  "Point <P6> non exporté : Z trop grand pour le format (colonnes 32 à 37).",
                                  "Point <> non exporté : point sans matricule.",
                              }));
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text.rfind("5 point(s) non exporté(s)", 0), 0u)
        << frontEnd.messages[0].text;
    // Z of P4 in six columns keeps one decimal; Y of P7 fills its ten columns with its sign and none.
    ExpectSamePoints(ReadBack(FieldBookFormat::Colonne, settings, output),
                     {{"P1", 100.25, 200.5, 10.0, "BORNE"},
                      {"P4", 1.0, 2.0, 1234.6, ""},
                      {"P7", 1.0, -123456789.0, kUndefined, ""}},
                     1e-9);

    // A delimited line holds any number and any text, but not a line end or what is no number.
    survey = Survey({{"P1", 1.0, 2.0, 3.0, "BORNE\nARBRE"},
                     {"P2", std::numeric_limits<double>::infinity(), 2.0, 3.0, ""},
                     kSurvey[0]});
    frontEnd.lines.clear();
    frontEnd.messages.clear();
    const std::string sepSettings = Settings(FieldBookFormat::Separateur);
    ASSERT_TRUE(CDlgConfigSep::Export(Job(sepSettings, output)));
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{
                  "Point <P1> non exporté : matricule ou code sur plusieurs lignes.",
                  "Point <P2> non exporté : X trop grand pour le format (pas un nombre fini).",
              }));
    ExpectSamePoints(ReadBack(FieldBookFormat::Separateur, sepSettings, output), {kSurvey[0]}, 0.0);
}

// A settings file that is missing, that its reader refuses, or whose points could not be read back: the
// message names it, the command fails, and the file to write is left as it was. So with no folder to write
// in.
TEST_F(ExportLayoutTest, SettingsThatCannotServeWriteNothing) {
    using Changes = std::map<std::string, std::string>;
    struct Case {
        FieldBookFormat format;
        Changes changes;
        const char* why; // in the message
    };
    const Case cases[] = {
        {FieldBookFormat::Separateur, {{"ChampsPoint", "TYPE,MATRICULE,W"}}, "champ inconnu « W »"},
        {FieldBookFormat::Separateur, {{"UniteDistances", "toises"}}, "toises"},
        {FieldBookFormat::Separateur, {{"ChampsPoint", ""}}, "ChampsPoint incorrect : la liste est vide"},
        {FieldBookFormat::Separateur, {{"ChampsPoint", "TYPE,MATRICULE,X,Z"}}, "le champ Y manque"},
        {FieldBookFormat::Separateur, {{"TypePoint", ""}}, "TypePoint incorrect : le mot est vide"},
        {FieldBookFormat::Separateur, {{"TypePoint", "st"}}, "« st » est aussi celui de TypeStation"},
        {FieldBookFormat::Colonne,
         {{"ChampsPoint", "TYPE:1-2,MATRICULE:4-19,X:21-34,Y:30-49"}},
         "les champs X et Y se chevauchent"},
        {FieldBookFormat::Colonne,
         {{"ChampsPoint", "TYPE:1-2,MATRICULE:4-,X:21-34,Y:36-49"}},
         "les champs MATRICULE et X se chevauchent"},
        {FieldBookFormat::Colonne,
         {{"TypePoint", "POINT"}},
         "« POINT » ne tient pas dans les colonnes 1 à 2"},
    };
    const std::string output = dir / "points.txt";
    WriteBytes(output, "à garder\n");
    for (const Case& c : cases) {
        frontEnd.messages.clear();
        frontEnd.ResetFailures();
        const std::string settings = Settings(c.format, c.changes);
        SCOPED_TRACE(settings + " " + c.why);
        PointExportJob job = Job(settings, output);
        EXPECT_FALSE(Export(c.format, job));
        ASSERT_EQ(frontEnd.messages.size(), 1u);
        EXPECT_NE(frontEnd.messages[0].text.find("<" + settings + ">"), std::string::npos)
            << frontEnd.messages[0].text;
        EXPECT_NE(frontEnd.messages[0].text.find(c.why), std::string::npos) << frontEnd.messages[0].text;
        EXPECT_EQ(frontEnd.Failures(), 1);
        EXPECT_EQ(ReadBytes(output), "à garder\n");
    }
    // No settings file at all.
    frontEnd.messages.clear();
    const std::string missing = dir / "absent.sep";
    EXPECT_FALSE(CDlgConfigSep::Export(Job(missing, output)));
    EXPECT_EQ(MessageTexts(frontEnd), "Le fichier de paramètres d'export <" + missing + "> n'existe pas !");
    EXPECT_EQ(ReadBytes(output), "à garder\n");
    EXPECT_FALSE(fs::exists(missing));

    // A folder that does not exist: the writing fails with its message, and nothing is made.
    frontEnd.messages.clear();
    const std::string nowhere = dir / "absent/points.txt";
    EXPECT_FALSE(CDlgConfigCol::Export(Job(Settings(FieldBookFormat::Colonne), nowhere)));
    EXPECT_EQ(MessageTexts(frontEnd).rfind("Impossible d'écrire le fichier\n<" + nowhere + ">", 0), 0u);
    EXPECT_FALSE(fs::exists(dir / "absent"));
}

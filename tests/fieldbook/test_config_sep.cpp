// Delimited and columnar field books: how a line is cut into fields or columns, how each record is
// recognised and read by the layout of its settings, and what is reported of the lines that cannot be used.
#include "FieldBookTestSupport.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

// The layout of the format with its defaults, changed key by key, and the records imported with the lines
// of the text window.
template <class Config, FieldBookFormat kFormat>
class LayoutImportTest : public ::testing::Test {
protected:
    void Import(std::string_view text) { Config::ImportText(layout, text, records, &txt); }

    CParamDriver layout{"", "", kFormat};
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
    CCarnet records;
};

using Delimited = LayoutImportTest<CDlgConfigSep, FieldBookFormat::Separateur>;
using Columnar = LayoutImportTest<CDlgConfigCol, FieldBookFormat::Colonne>;

} // namespace

TEST(DelimitedFields, ALineIsCutAtItsSeparator) {
    struct Case {
        const char* separator;
        std::string_view line;
        std::vector<std::string> fields;
    };
    // Empty fields are fields and blanks around a field do not count; a quoted field holds the separator, a
    // doubled quote standing for one, and a quote never closed runs to the end of the line. Blanks are any
    // run of spaces and tabs, those at the ends of the line making no field; two tabulations enclose one.
    const Case cases[] = {
        {";", "PT;P1;;10.5; 20 ;", {"PT", "P1", "", "10.5", "20", ""}},
        {";", R"(CO;"Texte ; avec ""guillemets""";x)", {"CO", R"(Texte ; avec "guillemets")", "x"}},
        {";", R"(PT; " P1 " ;1)", {"PT", "P1", "1"}},
        {";", R"(PT;"non fermé;1)", {"PT", "non fermé;1"}},
        {" ", "  PT   P1\t 10.5   20  ", {"PT", "P1", "10.5", "20"}},
        {"\t", "PT\tP1\t\t10.5", {"PT", "P1", "", "10.5"}},
        {" | ", "PT | P1 | 10.5", {"PT", "P1", "10.5"}},
    };
    for (const Case& c : cases) {
        CDelimitedFields fields(c.separator);
        fields.Split(c.line);
        std::vector<std::string> texts;
        for (std::size_t i = 0; i < fields.Count(); ++i)
            texts.emplace_back(fields.Field({RecordField::Ignore}, i));
        EXPECT_EQ(texts, c.fields) << c.line;
    }
}

// Every kind of record of the shipped layout, its type word in any case, and the lines that cannot be used
// reported with their number and skipped.
TEST_F(Delimited, TheRecordsOfTheShippedLayoutAndTheLinesThatCannotBeUsed) {
    Import("CO;Levé du 12 mars ; temps clair \n"
           "PT;B1;652110.214;6861845.637;61.208;BORNE\n"
           "st;S10;1.574;ST\n"
           "RF;B1;1.3;221.82868;100.47842;106.3933\n"
           "MS;203;1.8;43.05682;99.80803;40.4778;ARBRE\n"
           "CD;ARB 6\n"
           "XX;P2;1;2;3\n"
           "PT;;1;2;3\n"
           "PT;P4;1;2,5;3\n"
           "PT;P5;1;inf;3\n"
           "CD\n"
           "PT;P8;1;2;3;BORNE;;en trop;\n"
           "\n"
           "   \n"
           "ST;;1.5\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{
                                  "Erreur ligne 7 : donnée non reconnue !",
                                  "Erreur ligne 8 : donnée manquante pour le matricule du point !",
                                  "Erreur ligne 9 : valeur numérique incorrecte <2,5> !",
                                  "Erreur ligne 10 : valeur numérique incorrecte <inf> !",
                                  "Erreur ligne 11 : donnée manquante pour le code !",
                                  "Attention : ligne 12 : 2 champ(s) en trop, ignoré(s).",
                                  "Erreur ligne 15 : donnée manquante pour le nom de la station !",
                              }));
    ASSERT_EQ(records.GetSize(), 7);
    EXPECT_EQ(Kinds(records), (std::vector<int>{kKindComment, kKindPoint, kKindStation, kKindReference,
                                                kKindMesure, kKindCommand, kKindPoint}));
    EXPECT_EQ(records.As<CComment>(0)->text(), "Levé du 12 mars ; temps clair");
    EXPECT_EQ((std::vector<std::string>{records.matAt(1), records.symAt(1), records.symAt(4),
                                        records.cmdAt(5), records.matAt(6), records.symAt(6)}),
              (std::vector<std::string>{"B1", "BORNE", "ARBRE", "ARB 6", "P8", "BORNE"}));
    EXPECT_EQ(
        (std::vector<double>{records.xAt(1), records.yAt(1), records.zAt(1), records.hiAt(2), records.hpAt(4),
                             records.ahAt(4), records.avAt(4), records.diAt(4)}),
        (std::vector<double>{652110.214, 6861845.637, 61.208, 1.574, 1.8, 43.05682, 99.80803, 40.4778}));
    // A kind whose fields are not given is not read.
    layout.SetText(kKeyChampsVisee, "");
    frontEnd.lines.clear();
    Import("MS;101;1.5\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{"Erreur ligne 1 : donnée non reconnue !"}));
    EXPECT_EQ(records.GetSize(), 7);
}

// Angles come to grads and lengths to metres: 400 gr = 360° = 6400 mils, 1 ft = 0.3048 m exactly.
TEST_F(Delimited, AnglesAndLengthsAreBroughtToGradsAndMetres) {
    struct Case {
        const char *angles, *distances, *angle; // the angle written as AH, AV and V0
        double grads;
        const char* length; // written as HI, HP, DI, X, Y and Z
        double metres;
    };
    const Case cases[] = {
        {"degres", "metres", "45.5", 50.555556, "1", 1.0},   // 45.5 × 400 / 360
        {"dms", "metres", "123.4530", 137.509259, "1", 1.0}, // 123° 45' 30" = 123.758333°
        {"mils", "metres", "4800", 300.0, "1", 1.0},
        {"grades", "pieds", "100", 100.0, "5.5", 1.6764},
    };
    layout.SetText(kKeyChampsStation, "TYPE,MATRICULE,HI,V0");
    for (const Case& c : cases) {
        layout.SetText(kKeyUniteAngles, c.angles);
        layout.SetText(kKeyUniteDistances, c.distances);
        records.RemoveAll();
        const std::string a = c.angle, l = c.length;
        Import("ST;S1;" + l + ";" + a + "\nMS;101;" + l + ";" + a + ";" + a + ";" + l + "\nPT;P1;" + l + ";" +
               l + ";" + l + "\n");
        ASSERT_EQ(records.GetSize(), 3) << frontEnd.AllLines();
        SCOPED_TRACE(std::string(c.angles) + " " + c.distances + " " + a + " " + l);
        for (double grads : {records.v0At(0), records.ahAt(1), records.avAt(1)})
            EXPECT_NEAR(grads, c.grads, 1e-4);
        for (double metres : {records.hiAt(0), records.hpAt(1), records.diAt(1), records.xAt(2),
                              records.yAt(2), records.zAt(2)})
            EXPECT_NEAR(metres, c.metres, 1e-4);
    }
    // The undefined value and the fields not given stay missing, in any unit; zero is a value.
    layout.SetText(kKeyUniteAngles, "degres");
    records.RemoveAll();
    Import("MS;101;-999999;-999999;0\n");
    EXPECT_EQ((std::vector<double>{records.hpAt(0), records.ahAt(0), records.avAt(0), records.diAt(0)}),
              (std::vector<double>{kUndefined, kUndefined, 0.0, kUndefined}));
}

// A list of points "matricule X Y Z" aligned with blanks, without a TYPE field, from a spreadsheet set to
// French: decimal commas (a decimal point still read), a line of titles counted in the numbers of the lines.
TEST_F(Delimited, AListOfPointsWithBlanksDecimalCommasAndTitles) {
    layout.SetText(kKeySeparateur, "ESPACE");
    layout.SetText(kKeySeparateurDecimal, ",");
    layout.SetText(kKeyLignesEntete, "1");
    layout.SetText(kKeyChampsStation, "");
    layout.SetText(kKeyChampsVisee, "");
    layout.SetText(kKeyChampsPoint, "MATRICULE,X,Y,Z,CODE");
    ASSERT_EQ(layout.Validate(), "");
    Import(
        "Matricule X Y Z\n  1001   652110,214  6861845.637   61,208  BORNE\n  1002   652215,48  6861830,215\n"
        "ST S1 1.5\n");
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"Erreur ligne 4 : valeur numérique incorrecte <S1> !"}));
    ASSERT_EQ(records.GetSize(), 2);
    EXPECT_EQ(records.GetType(1), kKindPoint);
    EXPECT_EQ((std::vector<std::string>{records.matAt(0), records.symAt(0), records.matAt(1)}),
              (std::vector<std::string>{"1001", "BORNE", "1002"}));
    EXPECT_EQ(
        (std::vector<double>{records.xAt(0), records.yAt(0), records.zAt(0), records.xAt(1), records.zAt(1)}),
        (std::vector<double>{652110.214, 6861845.637, 61.208, 652215.48, kUndefined}));
}

// A field book that cannot be opened is said so; one written on Windows with the shipped layout has its
// accents read, one column each.
TEST_F(Columnar, TheRecordsOfTheShippedLayoutInAWindows1252File) {
    TempDir dir;
    EXPECT_FALSE(CDlgConfigCol::Import(layout, dir / "absent.txt", records, &txt, &frontEnd));
    EXPECT_EQ(frontEnd.messages.size(), 1u); // worded as every reader's, checked with the reader skeleton
    // TYPE 1-2, MATRICULE 4-19, then HI 21-30; HP 21-30, AH 32-43, AV 45-56, DI 58-69, CODE 71-;
    // X 21-34, Y 36-49, Z 51-60, CODE 62-.
    const std::string carnet = dir / "carnet.txt";
    WriteBytes(carnet, "CO Lev\xE9 du 12 mars ; temps clair\r\n"
                       "PT \xC9glise1              652110.214    6861845.637     61.208 CLOCHER\r\n"
                       "ST S10                   1.574 ST\r\n"
                       "MS 203                     1.8     43.05682     99.80803      40.4778 ARBRE\r\n"
                       "MS 204                     1.3 57.84162\r\n"
                       "CD ARB 6\r\n");
    ASSERT_TRUE(CDlgConfigCol::Import(layout, carnet, records, &txt, &frontEnd));
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"Carnet <" + carnet + "> : fichier lu en Windows-1252."}));
    ASSERT_EQ(records.GetSize(), 6);
    EXPECT_EQ(records.As<CComment>(0)->text(), "Levé du 12 mars ; temps clair");
    EXPECT_EQ((std::vector<std::string>{records.matAt(1), records.symAt(1), records.symAt(2),
                                        records.symAt(3), records.cmdAt(5)}),
              (std::vector<std::string>{"Église1", "CLOCHER", "ST", "ARBRE", "ARB 6"}));
    // A line that stops inside a field or before it leaves its last values missing.
    EXPECT_EQ((std::vector<double>{records.xAt(1), records.yAt(1), records.zAt(1), records.hiAt(2),
                                   records.hpAt(3), records.ahAt(3), records.avAt(3), records.diAt(3),
                                   records.ahAt(4), records.avAt(4), records.diAt(4)}),
              (std::vector<double>{652110.214, 6861845.637, 61.208, 1.574, 1.8, 43.05682, 99.80803, 40.4778,
                                   57.84162, kUndefined, kUndefined}));
}

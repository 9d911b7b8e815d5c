// Delimited field books: how a line is cut into fields, how each record is recognised and read by the
// layout of its settings, and what is reported of the lines that cannot be used.
#include "fieldbook/ConfigSep.h"
#include "test_config_sep_support.h"

using namespace pyr;

namespace {

// Tolerances of the unit's terms: 0.1 mgon, 0.1 mm.
constexpr double kGrads = 1e-4;
constexpr double kMetres = 1e-4;

std::vector<std::string> Fields(const char* separator, std::string_view line) {
    CDelimitedFields fields(separator);
    fields.Split(line);
    std::vector<std::string> texts;
    for (std::size_t i = 0; i < fields.Count(); ++i)
        texts.emplace_back(fields.Field({RecordField::Ignore}, i));
    return texts;
}

using Delimited = LayoutImportTest<CDlgConfigSep, FieldBookFormat::Separateur>;

} // namespace

TEST(DelimitedFields, ALineIsCutAtItsSeparator) {
    struct Case {
        const char* separator;
        std::string_view line;
        std::vector<std::string> fields;
    };
    const Case cases[] = {
        // Empty fields are fields; blanks around a field do not count.
        {";", "PT;P1;;10.5; 20 ;", {"PT", "P1", "", "10.5", "20", ""}},
        // A quoted field holds the separator, and a doubled quote stands for one.
        {";", R"(CO;"Texte ; avec ""guillemets""";x)", {"CO", R"(Texte ; avec "guillemets")", "x"}},
        {";", R"(PT; " P1 " ;1)", {"PT", "P1", "1"}},
        // A quote never closed runs to the end of the line.
        {";", R"(PT;"non fermé;1)", {"PT", "non fermé;1"}},
        // Blanks: any run of spaces and tabs, those at both ends of the line making no field.
        {" ", "  PT   P1\t 10.5   20  ", {"PT", "P1", "10.5", "20"}},
        // A tabulation is one separator: two in a row enclose an empty field.
        {"\t", "PT\tP1\t\t10.5", {"PT", "P1", "", "10.5"}},
        // A separator of several characters.
        {" | ", "PT | P1 | 10.5", {"PT", "P1", "10.5"}},
        {",", R"(PT,P1,"1,5")", {"PT", "P1", "1,5"}},
    };
    for (const Case& c : cases)
        EXPECT_EQ(Fields(c.separator, c.line), c.fields) << c.line;
}

TEST(DelimitedFields, TheTextAfterAFieldRunsToTheEndOfTheLine) {
    CDelimitedFields fields(";");
    const FieldPlace type{RecordField::Type};
    fields.Split("CO;Levé du 12 mars ; temps clair ");
    EXPECT_EQ(fields.After(type, 0), "Levé du 12 mars ; temps clair");
    fields.Split(R"(CO;"Levé ; ""clair""")");
    EXPECT_EQ(fields.After(type, 0), R"(Levé ; "clair")");
    fields.Split("CO");
    EXPECT_EQ(fields.After(type, 0), "");
    CDelimitedFields blanks(" ");
    blanks.Split("CO   Levé  du 12 mars");
    EXPECT_EQ(blanks.After(type, 0), "Levé  du 12 mars");
}

TEST_F(Delimited, EveryKindOfRecordOfTheShippedLayout) {
    Import("CO;Chantier des Tilleuls\n"
           "PT;B1;652110.214;6861845.637;61.208;BORNE\n"
           "st;S10;1.574;ST\n"
           "RF;B1;1.3;221.82868;100.47842;106.3933\n"
           "MS;203;1.8;43.05682;99.80803;40.4778;ARBRE\n"
           "CD;ARB 6\n");
    EXPECT_TRUE(frontEnd.lines.empty()) << frontEnd.AllLines();
    ASSERT_EQ(records.GetSize(), 6);
    EXPECT_EQ(records.As<CComment>(0)->text(), "Chantier des Tilleuls");
    EXPECT_EQ(records.GetType(1), kKindPoint);
    EXPECT_EQ(records.matAt(1), "B1");
    EXPECT_DOUBLE_EQ(records.xAt(1), 652110.214);
    EXPECT_DOUBLE_EQ(records.yAt(1), 6861845.637);
    EXPECT_DOUBLE_EQ(records.zAt(1), 61.208);
    EXPECT_EQ(records.symAt(1), "BORNE");
    // The type words are compared without regard to case.
    EXPECT_EQ(records.GetType(2), kKindStation);
    EXPECT_DOUBLE_EQ(records.hiAt(2), 1.574);
    EXPECT_EQ(records.v0At(2), kUndefined);
    EXPECT_EQ(records.GetType(3), kKindReference);
    EXPECT_EQ(records.GetType(4), kKindMesure);
    EXPECT_DOUBLE_EQ(records.hpAt(4), 1.8);
    EXPECT_DOUBLE_EQ(records.ahAt(4), 43.05682);
    EXPECT_DOUBLE_EQ(records.avAt(4), 99.80803);
    EXPECT_DOUBLE_EQ(records.diAt(4), 40.4778);
    EXPECT_EQ(records.symAt(4), "ARBRE");
    // A field code is kept as it was typed, for the Quendal reader to interpret.
    EXPECT_EQ(records.GetType(5), kKindCommand);
    EXPECT_EQ(records.cmdAt(5), "ARB 6");
}

TEST_F(Delimited, ValuesNotGivenStayMissingAndZeroIsAValue) {
    Import("ST;S1\n"
           "MS;101;;12.5\n"
           "MS;102;0;-999999;0;\n"
           "PT;P1;;;48.25\n");
    ASSERT_EQ(records.GetSize(), 4);
    EXPECT_EQ(records.hiAt(0), kUndefined);
    for (double value : {records.hpAt(1), records.avAt(1), records.diAt(1)})
        EXPECT_EQ(value, kUndefined);
    EXPECT_DOUBLE_EQ(records.ahAt(1), 12.5);
    EXPECT_EQ(records.hpAt(2), 0.0);
    EXPECT_EQ(records.ahAt(2), kUndefined);
    EXPECT_EQ(records.avAt(2), 0.0);
    EXPECT_EQ(records.diAt(2), kUndefined);
    EXPECT_EQ(records.xAt(3), kUndefined);
    EXPECT_EQ(records.yAt(3), kUndefined);
    EXPECT_DOUBLE_EQ(records.zAt(3), 48.25);
}

TEST_F(Delimited, LinesThatCannotBeUsedAreReportedWithTheirNumberAndSkipped) {
    layout.SetText(kKeyChampsStation, ""); // stations are not read with this layout
    Import("PT;P1;1;2;3\n"
           "XX;P2;1;2;3\n"
           "PT;;1;2;3\n"
           "PT;P4;1;2,5;3\n"
           "PT;P5;1;inf;3\n"
           "CD\n"
           "ST;S1;1.5\n"
           "PT;P8;1;2;3;BORNE;;en trop;\n"
           "\n"
           "   \n"
           "PT;P11;1;2;3\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{
                                  "Erreur ligne 2 : donnée non reconnue !",
                                  "Erreur ligne 3 : donnée manquante pour le matricule du point !",
                                  "Erreur ligne 4 : valeur numérique incorrecte <2,5> !",
                                  "Erreur ligne 5 : valeur numérique incorrecte <inf> !",
                                  "Erreur ligne 6 : donnée manquante pour le code !",
                                  "Erreur ligne 7 : donnée non reconnue !",
                                  "Attention : ligne 8 : 2 champ(s) en trop, ignoré(s).",
                              }));
    ASSERT_EQ(records.GetSize(), 3);
    EXPECT_EQ(records.matAt(0), "P1");
    EXPECT_EQ(records.matAt(1), "P8");
    EXPECT_EQ(records.symAt(1), "BORNE");
    EXPECT_EQ(records.matAt(2), "P11");
}

TEST_F(Delimited, AStationWithoutItsNameIsReported) {
    Import("ST;;1.5\n");
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"Erreur ligne 1 : donnée manquante pour le nom de la station !"}));
    EXPECT_TRUE(records.IsEmpty());
}

// Angles come to grads and lengths to metres: 400 gr = 360° = 6400 mils, 1 ft = 0.3048 m exactly.
TEST_F(Delimited, AnglesAndLengthsAreBroughtToGradsAndMetres) {
    struct Case {
        const char* angles;
        const char* distances;
        const char* angle; // written as AH, AV and V0
        double grads;
        const char* length; // written as HI, HP, DI, X, Y and Z
        double metres;
    };
    const Case cases[] = {
        {"grades", "metres", "123.4567", 123.4567, "12.345", 12.345},
        {"degres", "metres", "90", 100.0, "1", 1.0},
        {"degres", "metres", "45.5", 50.555556, "1", 1.0}, // 45.5 × 400 / 360
        // 123° 45' 30" = 123.758333° = 137.509259 gr
        {"dms", "metres", "123.4530", 137.509259, "1", 1.0},
        // 30" alone = 0.0083333° = 0.0092593 gr
        {"dms", "metres", "0.0030", 0.0092593, "1", 1.0},
        // 359° 59' 59.9" = 399.999969 gr
        {"dms", "metres", "359.59599", 399.999969, "1", 1.0},
        {"mils", "metres", "1600", 100.0, "1", 1.0},
        {"mils", "metres", "4800", 300.0, "1", 1.0},
        {"grades", "pieds", "100", 100.0, "100", 30.48},
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
            EXPECT_NEAR(grads, c.grads, kGrads);
        for (double metres : {records.hiAt(0), records.hpAt(1), records.diAt(1), records.xAt(2),
                              records.yAt(2), records.zAt(2)})
            EXPECT_NEAR(metres, c.metres, kMetres);
    }
    // The undefined value is no length in feet nor angle in degrees: it stays undefined.
    records.RemoveAll();
    Import("MS;101;-999999;-999999\n");
    EXPECT_EQ(records.hpAt(0), kUndefined);
    EXPECT_EQ(records.ahAt(0), kUndefined);
}

// A spreadsheet set to French: tabulations, decimal commas, a line of titles.
TEST_F(Delimited, TheSeparatorsAndTheHeaderLinesOfTheLayout) {
    layout.SetText(kKeySeparateur, "TAB");
    layout.SetText(kKeySeparateurDecimal, ",");
    layout.SetText(kKeyLignesEntete, "2");
    Import("Levé des Tilleuls\n"
           "Type\tMatricule\tX\tY\tZ\tCode\n"
           "PT\tP1\t652110,214\t6861845,637\t61.2\n"
           "XX\n");
    // The titles are not reported; the lines keep their numbers in the file.
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{"Erreur ligne 4 : donnée non reconnue !"}));
    ASSERT_EQ(records.GetSize(), 1);
    EXPECT_DOUBLE_EQ(records.xAt(0), 652110.214);
    EXPECT_DOUBLE_EQ(records.yAt(0), 6861845.637);
    // A decimal point is still read with a decimal comma.
    EXPECT_DOUBLE_EQ(records.zAt(0), 61.2);
}

// Without a TYPE field, the field book is a list of points: "matricule X Y Z" aligned with blanks.
TEST_F(Delimited, WithoutATypeFieldEveryLineIsAPoint) {
    layout.SetText(kKeySeparateur, "ESPACE");
    PointsOnly("MATRICULE,X,Y,Z,CODE");
    Import("  1001   652110.214  6861845.637   61.208  BORNE\n"
           "  1002   652215.480  6861830.215\n"
           "ST S1 1.5\n");
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"Erreur ligne 3 : valeur numérique incorrecte <S1> !"}));
    ASSERT_EQ(records.GetSize(), 2);
    EXPECT_EQ(records.GetType(1), kKindPoint);
    EXPECT_EQ(records.matAt(1), "1002");
    EXPECT_DOUBLE_EQ(records.xAt(1), 652215.48);
    EXPECT_EQ(records.zAt(1), kUndefined);
}

TEST_F(Delimited, AFieldBookThatCannotBeReadIsSaidSo) {
    TempDir dir;
    EXPECT_FALSE(CDlgConfigSep::Import(layout, dir / "absent.txt", records, &txt, &frontEnd));
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text, "Impossible d'ouvrir le fichier carnet !");
    EXPECT_TRUE(records.IsEmpty());
}

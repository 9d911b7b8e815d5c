// Columnar field books: fields taken at their columns, counted in characters whatever the file's encoding,
// and the records read by the layout of their settings.
#include "fieldbook/ConfigCol.h"
#include "test_config_sep_support.h"

using namespace pyr;

namespace {

using Columnar = LayoutImportTest<CDlgConfigCol, FieldBookFormat::Colonne>;

} // namespace

TEST(ColumnarFields, AFieldIsTakenAtItsColumns) {
    struct Case {
        std::string_view line;
        FieldPlace place;
        std::string_view field;
        std::string_view after;
    };
    const Case cases[] = {
        {"PT P1       12.5", {RecordField::Matricule, 4, 11}, "P1", "12.5"},
        {"PT P1       12.5", {RecordField::X, 13, 20}, "12.5", ""},
        // A line that stops inside or before a field.
        {"PT P1", {RecordField::X, 13, 20}, "", ""},
        {"PT P1", {RecordField::Matricule, 4, 11}, "P1", ""},
        // To the end of the line.
        {"PT P1 ARBRE 6 ", {RecordField::Code, 7, 0}, "ARBRE 6", ""},
        // An accented letter is one column.
        {"PT Pré1     12.5", {RecordField::X, 13, 20}, "12.5", ""},
        {"CO Levé du 12 mars", {RecordField::Type, 1, 2}, "CO", "Levé du 12 mars"},
        {"PT Éé       12.5", {RecordField::Matricule, 4, 11}, "Éé", "12.5"},
    };
    CColumnarFields fields;
    for (const Case& c : cases) {
        fields.Split(c.line);
        EXPECT_EQ(fields.Field(c.place, 0), c.field) << c.line;
        EXPECT_EQ(fields.After(c.place, 0), c.after) << c.line;
    }
}

TEST_F(Columnar, TheRecordsOfTheShippedLayout) {
    // Columns of Param_Export.col: TYPE 1-2, MATRICULE 4-19, then HI 21-30; HP 21-30, AH 32-43, AV 45-56,
    // DI 58-69, CODE 71-; X 21-34, Y 36-49, Z 51-60, CODE 62-.
    Import("CO Chantier des Tilleuls ; le 12 mars\n"
           "PT B1                   652110.214    6861845.637     61.208 BORNE\n"
           "ST S10                   1.574 ST\n"
           "MS 203                     1.8     43.05682     99.80803      40.4778 ARBRE\n"
           "MS 204                     1.3     57.84162\n"
           "CD ARB 6\n"
           "ZZ 205\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{"Erreur ligne 7 : donnée non reconnue !"}));
    ASSERT_EQ(records.GetSize(), 6);
    EXPECT_EQ(records.As<CComment>(0)->text(), "Chantier des Tilleuls ; le 12 mars");
    EXPECT_DOUBLE_EQ(records.xAt(1), 652110.214);
    EXPECT_DOUBLE_EQ(records.yAt(1), 6861845.637);
    EXPECT_DOUBLE_EQ(records.zAt(1), 61.208);
    EXPECT_EQ(records.symAt(1), "BORNE");
    EXPECT_DOUBLE_EQ(records.hiAt(2), 1.574);
    EXPECT_EQ(records.symAt(2), "ST");
    EXPECT_DOUBLE_EQ(records.hpAt(3), 1.8);
    EXPECT_DOUBLE_EQ(records.ahAt(3), 43.05682);
    EXPECT_DOUBLE_EQ(records.avAt(3), 99.80803);
    EXPECT_DOUBLE_EQ(records.diAt(3), 40.4778);
    // A line that stops early leaves its last values missing.
    EXPECT_DOUBLE_EQ(records.ahAt(4), 57.84162);
    EXPECT_EQ(records.avAt(4), kUndefined);
    EXPECT_EQ(records.diAt(4), kUndefined);
    EXPECT_EQ(records.cmdAt(5), "ARB 6");
}

// Degrees, minutes and seconds in columns with decimal commas; the units are those of the layout.
TEST_F(Columnar, UnitsAndDecimalCommaOfTheLayout) {
    layout.SetText(kKeyUniteAngles, "dms");
    layout.SetText(kKeyUniteDistances, "pieds");
    layout.SetText(kKeySeparateurDecimal, ",");
    layout.SetText(kKeyChampsVisee, "TYPE:1-2,MATRICULE:4-8,AH:10-19,DI:21-28");
    Import("ST S1\n"
           "MS 101      90,0000   100,00\n"
           "MS 102      45,3000      0,5\n");
    ASSERT_EQ(records.GetSize(), 3) << frontEnd.AllLines();
    // 90° = 100 gr; 45° 30' = 50.555556 gr; 100 ft = 30.48 m; 0.5 ft = 0.1524 m.
    EXPECT_NEAR(records.ahAt(1), 100.0, 1e-4);
    EXPECT_NEAR(records.diAt(1), 30.48, 1e-4);
    EXPECT_NEAR(records.ahAt(2), 50.555556, 1e-4);
    EXPECT_NEAR(records.diAt(2), 0.1524, 1e-4);
    EXPECT_EQ(records.avAt(2), kUndefined);
    EXPECT_EQ(records.hiAt(0), kUndefined);
}

// A file written on Windows: its accents are read, each one column wide.
TEST_F(Columnar, AWindows1252FieldBookKeepsItsColumns) {
    TempDir dir;
    const std::string carnet = dir / "carnet.txt";
    WriteBytes(carnet, "CO Lev\xE9 du 12 mars\r\n"
                       "PT \xC9glise1"
                       "              652110.214    6861845.637     61.208 CLOCHER\r\n");
    ASSERT_TRUE(CDlgConfigCol::Import(layout, carnet, records, &txt, &frontEnd));
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"Carnet <" + carnet + "> : fichier lu en Windows-1252."}));
    ASSERT_EQ(records.GetSize(), 2);
    EXPECT_EQ(records.As<CComment>(0)->text(), "Levé du 12 mars");
    EXPECT_EQ(records.matAt(1), "Église1");
    EXPECT_DOUBLE_EQ(records.xAt(1), 652110.214);
    EXPECT_DOUBLE_EQ(records.zAt(1), 61.208);
    EXPECT_EQ(records.symAt(1), "CLOCHER");
}

// Without a TYPE column, every line is a point.
TEST_F(Columnar, WithoutATypeColumnEveryLineIsAPoint) {
    PointsOnly("MATRICULE:1-8,X:9-20,Y:21-32");
    Import("1001      652110.21  6861845.64\n"
           "\n"
           "1002\n");
    EXPECT_TRUE(frontEnd.lines.empty()) << frontEnd.AllLines();
    ASSERT_EQ(records.GetSize(), 2);
    EXPECT_DOUBLE_EQ(records.yAt(0), 6861845.64);
    EXPECT_EQ(records.xAt(1), kUndefined);
}

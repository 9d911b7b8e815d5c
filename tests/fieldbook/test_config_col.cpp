// Columnar field books: fields taken at their columns, counted in characters whatever the file's encoding,
// and the records read by the layout of their settings.
#include "fieldbook/ConfigCol.h"
#include "test_config_sep_support.h"

using namespace pyr;

namespace {

using Columnar = LayoutImportTest<CDlgConfigCol, FieldBookFormat::Colonne>;

} // namespace

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

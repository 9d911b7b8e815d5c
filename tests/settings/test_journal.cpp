// The journal's lines, byte for byte; expected texts worked out by hand from the printf formats
// ("%7s" pads the identifier to 7, "%12.4f" and "%9.4f" the coordinates, "%9.5f" the V0).
#include "TestSupport.h"
#include "core/Undefined.h"
#include "settings/Journal.h"

#include <gtest/gtest.h>

namespace {

using namespace pyr;

TEST(JournalLine, EachCombinationOfKnownCoordinatesInBothAxisOrders) {
    const double x = 651200.1234, y = 6862300.5, z = 52.3107, none = kUndefined;
    struct Case {
        double x, y, z;
        const char *xFirst, *yFirst; // null: the same in both orders
    } const cases[] = {
        {x, y, z, "\nPoint     P12 : X =  651200.1234 Y = 6862300.5000 Z =   52.3107",
         "\nPoint     P12 : Y = 6862300.5000 X =  651200.1234 Z =   52.3107"},
        {x, y, none, "\nPoint     P12 : X =  651200.1234 Y = 6862300.5000",
         "\nPoint     P12 : Y = 6862300.5000 X =  651200.1234"},
        {none, none, z, "\nPoint     P12 : Z =   52.3107", nullptr},
        {none, none, none, "\nPoint     P12 : Pas de coordonnées calculées", nullptr},
        {x, none, z, "\nPoint     P12 : Z =   52.3107", nullptr}, // half a position is no position
        {0, 0, 0, "\nPoint     P12 : X =       0.0000 Y =       0.0000 Z =    0.0000", // zero is a value
         "\nPoint     P12 : Y =       0.0000 X =       0.0000 Z =    0.0000"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(JournalPointLine("P12", c.x, c.y, c.z, false), c.xFirst);
        EXPECT_EQ(JournalPointLine("P12", c.x, c.y, c.z, true), c.yFirst ? c.yFirst : c.xFirst);
    }
    EXPECT_EQ(JournalPointLine("BORNE1234", x, y, none, false),
              "\nPoint BORNE1234 : X =  651200.1234 Y = 6862300.5000");
    EXPECT_EQ(JournalStationLine("S1", 12.345678), "\nStation      S1 : V0 =  12.34568");
}

TEST(JournalFile, BesideTheGeoBaseAppendedComputationAfterComputation) {
    EXPECT_EQ(JournalPath("/chantiers/lotissement.geo"), "/chantiers/lotissement.jnl");
    EXPECT_EQ(JournalPath("/chantiers/sans-extension"), "/chantiers/sans-extension.jnl");

    TempDir dir;
    std::tm day{}; // a Monday
    day.tm_year = 125, day.tm_mon = 2, day.tm_mday = 3, day.tm_wday = 1, day.tm_hour = 9, day.tm_min = 5;
    EXPECT_TRUE(CJournal(dir / "a.geo", kJournalIntersection).Append(day));
    EXPECT_FALSE(std::filesystem::exists(dir / "a.jnl")); // no point written, no journal

    CJournal intersection(dir / "a.geo", kJournalIntersection);
    intersection.AddPoint("100", 10.0, 20.0, kUndefined, false);
    ASSERT_TRUE(intersection.Append(day));
    EXPECT_TRUE(intersection.IsEmpty());
    CJournal resection(dir / "a.geo", kJournalResection);
    resection.AddPoint("S9", kUndefined, kUndefined, 51.5, false);
    resection.AddStation("S9", 399.99999);
    ASSERT_TRUE(resection.Append(day));
    EXPECT_EQ(ReadBytes(dir / "a.jnl"),
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par intersection"
              "\nPoint     100 : X =      10.0000 Y =      20.0000"
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par relèvement"
              "\nPoint      S9 : Z =   51.5000"
              "\nStation      S9 : V0 = 399.99999");

    // A journal that cannot be written keeps its lines for another try.
    CJournal lost(dir / "absent/b.geo", kJournalEccentric);
    lost.AddStation("S2", 1.0);
    EXPECT_FALSE(lost.Append(day));
    EXPECT_FALSE(lost.IsEmpty());
}

} // namespace

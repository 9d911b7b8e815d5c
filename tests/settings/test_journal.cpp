// The journal's lines, byte for byte; expected texts worked out by hand from the printf formats
// ("%7s" pads the identifier to 7, "%12.4f" and "%9.4f" the coordinates, "%9.5f" the V0).
#include "TestSupport.h"
#include "core/Undefined.h"
#include "settings/Journal.h"

#include <gtest/gtest.h>

namespace {

using pyr::JournalPointLine;
using pyr::kUndefined;

TEST(JournalLine, EachCombinationOfKnownCoordinatesInBothAxisOrders) {
    const double x = 651200.1234, y = 6862300.5, z = 52.3107;
    struct Case {
        double x, y, z;
        const char* xFirst;
        const char* yFirst;
    };
    const Case cases[] = {
        {x, y, z, "\nPoint     P12 : X =  651200.1234 Y = 6862300.5000 Z =   52.3107",
         "\nPoint     P12 : Y = 6862300.5000 X =  651200.1234 Z =   52.3107"},
        {x, y, kUndefined, "\nPoint     P12 : X =  651200.1234 Y = 6862300.5000",
         "\nPoint     P12 : Y = 6862300.5000 X =  651200.1234"},
        {kUndefined, kUndefined, z, "\nPoint     P12 : Z =   52.3107", "\nPoint     P12 : Z =   52.3107"},
        {kUndefined, kUndefined, kUndefined, "\nPoint     P12 : Pas de coordonnées calculées",
         "\nPoint     P12 : Pas de coordonnées calculées"},
        // Half a position is no position; zero is a value.
        {x, kUndefined, z, "\nPoint     P12 : Z =   52.3107", "\nPoint     P12 : Z =   52.3107"},
        {0.0, 0.0, 0.0, "\nPoint     P12 : X =       0.0000 Y =       0.0000 Z =    0.0000",
         "\nPoint     P12 : Y =       0.0000 X =       0.0000 Z =    0.0000"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(JournalPointLine("P12", c.x, c.y, c.z, false), c.xFirst);
        EXPECT_EQ(JournalPointLine("P12", c.x, c.y, c.z, true), c.yFirst);
    }
    EXPECT_EQ(JournalPointLine("BORNE1234", x, y, kUndefined, false),
              "\nPoint BORNE1234 : X =  651200.1234 Y = 6862300.5000");
    EXPECT_EQ(pyr::JournalStationLine("S1", 12.345678), "\nStation      S1 : V0 =  12.34568");
}

TEST(JournalFile, BesideTheGeoBaseAppendedComputationAfterComputation) {
    EXPECT_EQ(pyr::JournalPath("/chantiers/lotissement.geo"), "/chantiers/lotissement.jnl");
    EXPECT_EQ(pyr::JournalPath("/chantiers/sans-extension"), "/chantiers/sans-extension.jnl");

    TempDir dir;
    std::tm monday{};
    monday.tm_year = 125, monday.tm_mon = 2, monday.tm_mday = 3, monday.tm_wday = 1, monday.tm_hour = 9,
    monday.tm_min = 5;

    pyr::CJournal nothing(dir / "a.geo", pyr::kJournalIntersection);
    EXPECT_TRUE(nothing.Append(monday));
    EXPECT_FALSE(std::filesystem::exists(dir / "a.jnl")); // no point written, no journal

    pyr::CJournal intersection(dir / "a.geo", pyr::kJournalIntersection);
    intersection.AddPoint("100", 10.0, 20.0, kUndefined, false);
    ASSERT_TRUE(intersection.Append(monday));
    EXPECT_TRUE(intersection.IsEmpty());
    pyr::CJournal resection(dir / "a.geo", pyr::kJournalResection);
    resection.AddPoint("S9", kUndefined, kUndefined, 51.5, false);
    resection.AddStation("S9", 399.99999);
    ASSERT_TRUE(resection.Append(monday));

    EXPECT_EQ(ReadBytes(dir / "a.jnl"),
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par intersection"
              "\nPoint     100 : X =      10.0000 Y =      20.0000"
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par relèvement"
              "\nPoint      S9 : Z =   51.5000"
              "\nStation      S9 : V0 = 399.99999");

    // A journal that cannot be written keeps its lines for another try.
    pyr::CJournal lost(dir / "absent/b.geo", pyr::kJournalEccentric);
    lost.AddStation("S2", 1.0);
    EXPECT_FALSE(lost.Append(monday));
    EXPECT_FALSE(lost.IsEmpty());
}

} // namespace

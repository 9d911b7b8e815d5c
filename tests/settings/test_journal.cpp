// The journal's lines, byte for byte; expected texts worked out by hand from the printf formats
// ("%7s" pads the identifier to 7, "%12.4f" and "%9.4f" the coordinates, "%9.5f" the V0).
#include "SettingsTestSupport.h"
#include "core/SafeFile.h"
#include "core/Undefined.h"
#include "settings/Journal.h"

namespace {

using namespace pyr;
using pyr::test::InChildWithFileSizeLimit;

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

std::tm Monday() {
    std::tm day{};
    day.tm_year = 125, day.tm_mon = 2, day.tm_mday = 3, day.tm_wday = 1, day.tm_hour = 9, day.tm_min = 5;
    return day;
}

TEST(JournalFile, BesideTheGeoBaseAppendedComputationAfterComputation) {
    EXPECT_EQ(JournalPath("/chantiers/lotissement.geo"), "/chantiers/lotissement.jnl");
    EXPECT_EQ(JournalPath("/chantiers/sans-extension"), "/chantiers/sans-extension.jnl");

    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    const std::tm day = Monday();
    EXPECT_TRUE(CJournal(dir / "a.geo", kJournalIntersection).Append(frontEnd, day));
    EXPECT_FALSE(std::filesystem::exists(dir / "a.jnl")); // no point written, no journal

    CJournal intersection(dir / "a.geo", kJournalIntersection);
    intersection.AddPoint("100", 10.0, 20.0, kUndefined, false);
    ASSERT_TRUE(intersection.Append(frontEnd, day));
    EXPECT_TRUE(intersection.IsEmpty());
    CJournal resection(dir / "a.geo", kJournalResection);
    resection.AddPoint("S9", kUndefined, kUndefined, 51.5, false);
    resection.AddStation("S9", 399.99999);
    ASSERT_TRUE(resection.Append(frontEnd, day));
    EXPECT_EQ(ReadBytes(dir / "a.jnl"),
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par intersection"
              "\nPoint     100 : X =      10.0000 Y =      20.0000"
              "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par relèvement"
              "\nPoint      S9 : Z =   51.5000"
              "\nStation      S9 : V0 = 399.99999");
    EXPECT_TRUE(frontEnd.messages.empty());
}

// The journal is the history of the job: an append that fails, however late, leaves it as it was, and
// the person is told which file and why.
TEST(JournalFile, AnAppendThatFailsLeavesTheJournalWholeKeepsItsLinesAndIsReported) {
    TempDir dir;
    const std::tm day = Monday();
    ui::ScriptedFrontEnd frontEnd;
    CJournal lost(dir / "absent/b.geo", kJournalEccentric);
    lost.AddStation("S2", 1.0);
    EXPECT_FALSE(lost.Append(frontEnd, day));
    EXPECT_FALSE(lost.IsEmpty());
    ASSERT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_EQ(frontEnd.messages[0].text, FileWriteFailure(dir / "absent/b.jnl", ENOENT));
    EXPECT_EQ(frontEnd.Failures(), 1);

    // Past the size a file may reach, as on a full disk: the old lines fit, the new ones do not.
    std::string history;
    for (int i = 0; i < 20; ++i)
        history += "\n\nlundi 03 mars 2025 à 09 h 05 mn - Calcul de points par intersection";
    WriteBytes(dir / "a.jnl", history);
    const int status = InChildWithFileSizeLimit(history.size() + 40, [&] {
        ui::ScriptedFrontEnd child;
        CJournal journal(dir / "a.geo", kJournalIntersection);
        for (int i = 0; i < 5; ++i)
            journal.AddPoint("P" + std::to_string(i), 10.0, 20.0, 30.0, false);
        const bool reported = !journal.Append(child, day) && !journal.IsEmpty() && child.Failures() == 1 &&
                              child.messages[0].text == FileWriteFailure(dir / "a.jnl", EFBIG);
        return reported ? 0 : 1;
    });
    EXPECT_EQ(status, 0) << "the append did not fail, or was not reported";
    EXPECT_EQ(ReadBytes(dir / "a.jnl"), history);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(dir.Root()), {}), 1) << "no copy left";
}

} // namespace

#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/Undefined.h"
#include "settings/ListingObject.h"

#include <clocale>
#include <utility>

namespace pyr::test {
namespace {

class ListingObject : public SettingsTest {
protected:
    CDlgCfgListing listing{frontEnd};
    const std::string file = folder / "chantier.cin";
};

TEST_F(ListingObject, PlainTextPagesHoldThePageLengthWithHeaderFooterAndDescriptor) {
    listing.SetPageLength(20);
    listing.SetPageWidth(40);
    listing.SetPageCount();
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.WriteHeader(1);
    listing.SetDescriptor("| Station | V0 |");
    std::string lines; // seventeen lines of nine bytes
    for (int i = 1; i <= 17; ++i)
        lines += Sprintf("ligne %02d\n", i);
    listing.WriteText(lines);
    listing.WriteFooter();
    listing.CloseListing(file, false);
    // Header 3 lines and footer 2 leave 15 a page, the descriptor taking one from the second page on.
    const std::string rule(40, '-'), head = "PYRALIS Calculs Topo        chantier.cin\n" + rule + "\n\n";
    const std::string foot = rule + "\n" + std::string(17, ' ') + "Page ";
    EXPECT_EQ(ReadBytes(file), head + lines.substr(0, 135) + foot + "1\n" + head + "| Station | V0 |\n" +
                                   lines.substr(135) + std::string(12, '\n') + foot + "2\n");
}

// Under fr_FR printf's "%f" writes a decimal comma; the listings keep the point of the surveyor's files.
TEST_F(ListingObject, LinesAreCountedEchoedAndCompletedAcrossWritesWithADecimalPoint) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    char probe[8];
    std::snprintf(probe, sizeof probe, "%.1f", 1.5);
    EXPECT_TRUE(listing.OpenListing(file, "w"));
    EXPECT_EQ(listing.WriteLine("a\nb\n"), 2);
    EXPECT_EQ(listing.WriteLine("Point %s", "P1"), 0);
    EXPECT_EQ(listing.WriteLine(" : X = %.3f, D = %s\n", 1.5, listing.FormatDist(12.5, 2).c_str()), 1);
    listing.InitOutput(ListingOutput::TextWindow); // from here into the text window only
    listing.WriteLine("fenêtre\n");
    listing.CloseListing(file, false);
    std::setlocale(LC_ALL, previous.c_str());
    EXPECT_STREQ(probe, "1,5") << "without a decimal comma in the locale this test proves nothing";
    EXPECT_EQ(ReadBytes(file), "a\nb\nPoint P1 : X = 1.500, D = 12.50\n");
    EXPECT_EQ(frontEnd.lines,
              (std::vector<std::string>{"a", "b", "Point P1 : X = 1.500, D = 12.50", "fenêtre"}));
}

TEST_F(ListingObject, TitleIsFramedAndCentredInCharactersNotBytes) {
    listing.SetPageWidth(40);
    listing.SetSepLine1(-1, '#');
    listing.SetTitleLine("RELÈVEMENT", '#');
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.WriteTitle();
    listing.CloseListing(file, false);
    const std::string frame(40, '#'), margin(14, ' ');
    EXPECT_EQ(ReadBytes(file), frame + "\n#" + margin + "RELÈVEMENT" + margin + "#\n" + frame + "\n");
}

TEST_F(ListingObject, NumbersFollowTheStoreDecimalsAndNeverShowTheUndefinedMarker) {
    SetStoreDecimals(2, 3, 4);
    EXPECT_EQ(listing.FormatCoor(1234.5678), "1234.57");
    EXPECT_EQ(listing.FormatAlti(101.23456), "101.235");
    EXPECT_EQ(listing.FormatAngl(123.456789), "123.4568");
    listing.SetDeciCoor(4);
    EXPECT_EQ(listing.FormatCoor(1234.5678), "1234.5678");

    for (const std::string& text :
         {listing.FormatCoor(kUndefined), listing.FormatAlti(kUndefined), listing.FormatDist(kUndefined),
          listing.FormatDeni(kUndefined), listing.FormatAngl(kUndefined, 4, true)})
        EXPECT_EQ(text, "-");
    EXPECT_EQ(listing.FormatCoor(-0.0001, 3), "0.000"); // no "-0.000"
    EXPECT_EQ(listing.FormatDeni(1.5, 3), "+1.500");
    // Directions into [0, 400); a residual keeps its sign.
    EXPECT_EQ(listing.FormatAngl(-10.0, 4, true), "390.0000");
    EXPECT_EQ(listing.FormatAngl(399.999996, 5, true), "0.00000");
    EXPECT_EQ(listing.FormatAngl(-0.0123, 4), "-0.0123");
}

TEST_F(ListingObject, LayoutIsReadWithinItsLimits) {
    WriteBytes(path, "[Listings]\nFormat=7\nLongueurPage=5\n");
    listing.ReadLastParameters(path);
    EXPECT_EQ(listing.GetFormat(), kListingTextNoPageCount);
    EXPECT_EQ(listing.GetPageLength(), kMinPageLength);
}

TEST(RtfEscape, BracesWindows1252AndOtherScriptsAreEscaped) {
    const std::pair<std::string, std::string> cases[] = {
        {"a\\b{c}", "a\\\\b\\{c\\}"},
        {"5 €", "5 \\'80"},                          // Windows-1252's own place for the euro
        {"σ0", "\\u963?0"},                          // outside Windows-1252
        {"\xF0\x9F\x98\x80", "\\u-10179?\\u-8704?"}, // beyond 16 bits: a surrogate pair
        {"ligne 1\nligne 2\t!", "ligne 1\\line ligne 2\\tab !"},
        {"\xE9t\xE9", "\\'e9t\\'e9"}, // a Windows-1252 name read from an old file
    };
    for (const auto& [text, rtf] : cases)
        EXPECT_EQ(RtfEscape(text), rtf) << text;
}

} // namespace
} // namespace pyr::test

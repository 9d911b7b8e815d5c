#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/Undefined.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <clocale>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace pyr::test {
namespace {

std::vector<std::string> SplitLines(const std::string& text) {
    std::vector<std::string> lines;
    std::size_t begin = 0;
    while (begin < text.size()) {
        std::size_t end = text.find('\n', begin);
        if (end == std::string::npos) end = text.size();
        lines.push_back(text.substr(begin, end - begin));
        begin = end + 1;
    }
    return lines;
}

class ListingObject : public SettingsTest {
protected:
    CDlgCfgListing listing{frontEnd};
    const std::string file = folder / "chantier.cin";
};

TEST_F(ListingObject, PlainTextPagesHoldExactlyThePageLengthWithHeaderFooterAndDescriptor) {
    listing.SetFormat(kListingText);
    listing.SetPageLength(20);
    listing.SetPageWidth(40);
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.SetPageCount(true);
    listing.SetEcho(false);
    listing.WriteHeader(1);
    listing.SetDescriptor("| Station | V0 |");
    for (int i = 1; i <= 40; ++i)
        listing.WriteLine("ligne %d\n", i);
    listing.WriteFooter();
    ASSERT_TRUE(listing.CloseListing(file, false));

    // Header: 3 lines, footer: 2 lines; 15 lines of body a page, the descriptor taking one of them from
    // the second page on: 15 + 14 + 11 lines.
    const std::vector<std::string> lines = SplitLines(ReadBytes(file));
    ASSERT_EQ(lines.size(), 60u);
    std::vector<std::string> body;
    for (int page = 0; page < 3; ++page) {
        const auto first = lines.begin() + page * 20;
        SCOPED_TRACE(page + 1);
        EXPECT_EQ(first[0].rfind("PYRALIS Calculs Topo", 0), 0u);
        EXPECT_NE(first[0].find("chantier.cin"), std::string::npos);
        EXPECT_EQ(first[1], std::string(40, '-'));
        EXPECT_EQ(first[18], std::string(40, '-'));
        EXPECT_EQ(Trimmed(first[19]), "Page " + std::to_string(page + 1));
        if (page > 0) {
            EXPECT_EQ(first[3], "| Station | V0 |");
        }
        for (int k = page > 0 ? 4 : 3; k < 18; ++k)
            if (!first[k].empty()) body.push_back(first[k]);
    }
    ASSERT_EQ(body.size(), 40u);
    for (int i = 0; i < 40; ++i)
        EXPECT_EQ(body[static_cast<std::size_t>(i)], "ligne " + std::to_string(i + 1));
}

TEST_F(ListingObject, WithoutPageCountTheListingRunsOnWithoutBreaksOrNumbers) {
    listing.SetPageLength(20);
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.SetEcho(false);
    listing.WriteHeader(1);
    for (int i = 1; i <= 40; ++i)
        listing.WriteLine("ligne %d\n", i);
    listing.WriteFooter();
    listing.CloseListing(file, false);

    const std::string text = ReadBytes(file);
    EXPECT_EQ(SplitLines(text).size(), 3u + 40u + 1u);
    EXPECT_EQ(text.find("Page"), std::string::npos);
}

TEST_F(ListingObject, LinesAreCountedEchoedAndCompletedAcrossWrites) {
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    EXPECT_EQ(listing.WriteLine("a\nb\n"), 2);
    EXPECT_EQ(listing.WriteLine("Point %s", "P1"), 0);
    EXPECT_EQ(listing.WriteLine(" : X = %.3f\n", 1.5), 1);
    EXPECT_EQ(listing.GetLineCount(), 3);
    listing.SetEcho(false);
    listing.WriteLine("sans écho\n");
    listing.CloseListing(file, false);

    EXPECT_EQ(ReadBytes(file), "a\nb\nPoint P1 : X = 1.500\nsans écho\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{"a", "b", "Point P1 : X = 1.500"}));

    // Into the text window only, nothing in the file.
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.InitOutput(ListingOutput::TextWindow);
    listing.WriteLine("fenêtre\n");
    listing.CloseListing(file, false);
    EXPECT_EQ(ReadBytes(file), "");
    EXPECT_EQ(frontEnd.lines.back(), "fenêtre");
}

TEST_F(ListingObject, SeparatorsTitleAndCentringFollowThePageWidthInCharacters) {
    listing.SetPageWidth(50);
    listing.SetSepLine1(-1, '#');
    listing.SetSepLine2(5, '-');
    EXPECT_EQ(listing.GetSepLine1(), std::string(50, '#'));
    EXPECT_EQ(listing.GetSepLine2(), "-----");
    EXPECT_EQ(listing.CenterString("Référence", 11), " Référence "); // characters, not bytes

    listing.SetTitleLine("CALCUL PAR RELEVEMENT", '#');
    const std::string title = listing.GetTitleLine();
    EXPECT_EQ(title.size(), 50u);
    EXPECT_EQ(title.front(), '#');
    EXPECT_EQ(title.back(), '#');
    EXPECT_EQ(Trimmed(title.substr(1, 48)), "CALCUL PAR RELEVEMENT");

    ASSERT_TRUE(listing.OpenListing(file, "w"));
    EXPECT_EQ(listing.WriteTitle(), 3);
    listing.CloseListing(file, false);
    EXPECT_EQ(ReadBytes(file), listing.GetSepLine1() + "\n" + title + "\n" + listing.GetSepLine1() + "\n");
}

TEST_F(ListingObject, NumbersFollowTheStoreDecimalsAndNeverShowTheUndefinedMarker) {
    const int savedXY = CPointGen::DeciXY(), savedZ = CPointGen::DeciZ(), savedAng = CStation::DeciAng();
    CPointGen::setDeciXY(2);
    CPointGen::setDeciZ(3);
    CStation::setDeciAng(4);
    EXPECT_EQ(listing.FormatCoor(1234.5678), "1234.57");
    EXPECT_EQ(listing.FormatDist(12.344), "12.34");
    EXPECT_EQ(listing.FormatAlti(101.23456), "101.235");
    EXPECT_EQ(listing.FormatAngl(123.456789), "123.4568");
    listing.SetDeciCoor(4);
    EXPECT_EQ(listing.FormatCoor(1234.5678), "1234.5678");
    listing.SetDeciCoor(-1);
    EXPECT_EQ(listing.GetDeciCoor(), 2);
    CPointGen::setDeciXY(savedXY);
    CPointGen::setDeciZ(savedZ);
    CStation::setDeciAng(savedAng);

    for (const std::string& text :
         {listing.FormatCoor(kUndefined), listing.FormatAlti(kUndefined), listing.FormatDist(kUndefined),
          listing.FormatDeni(kUndefined), listing.FormatAngl(kUndefined, 4, true)})
        EXPECT_EQ(text, "-");
    EXPECT_EQ(listing.FormatCoor(0.0, 3), "0.000");
    EXPECT_EQ(listing.FormatCoor(-0.0001, 3), "0.000"); // no "-0.000"
    EXPECT_EQ(listing.FormatDeni(1.5, 3), "+1.500");
    EXPECT_EQ(listing.FormatDeni(-1.5, 3), "-1.500");
    // Directions into [0, 400); a residual keeps its sign.
    EXPECT_EQ(listing.FormatAngl(-10.0, 4, true), "390.0000");
    EXPECT_EQ(listing.FormatAngl(399.999996, 5, true), "0.00000");
    EXPECT_EQ(listing.FormatAngl(-0.0123, 4), "-0.0123");
}

TEST_F(ListingObject, NumbersKeepTheirDecimalPointUnderAFrenchLocale) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "fr_FR.UTF-8")) GTEST_SKIP() << "fr_FR.UTF-8 is not installed";
    const std::string localeText = Sprintf("%.1f", 2.5);
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.WriteLine("X = %.3f | %s\n", 1234.5, listing.FormatDist(12.5, 2).c_str());
    listing.CloseListing(file, false);
    const std::string angle = listing.FormatAngl(-0.5, 3, true);
    std::setlocale(LC_ALL, previous.c_str());

    EXPECT_EQ(localeText, "2,5") << "without a decimal comma in the locale this test proves nothing";
    EXPECT_EQ(ReadBytes(file), "X = 1234.500 | 12.50\n");
    EXPECT_EQ(angle, "399.500");
}

TEST_F(ListingObject, SettingsAreReadWithDefaultsAndLimits) {
    listing.ReadLastParameters(path);
    EXPECT_EQ(listing.GetFormat(), kListingText);
    EXPECT_EQ(listing.GetPageLength(), 70);
    EXPECT_EQ(listing.GetPageWidth(), 80);

    WriteBytes(path, "[Listings]\nFormat=7\nLongueurPage=5\nLargeurPage=132\n");
    listing.ReadLastParameters(path);
    EXPECT_EQ(listing.GetFormat(), kListingTextNoPageCount);
    EXPECT_EQ(listing.GetPageLength(), kMinPageLength);
    EXPECT_EQ(listing.GetPageWidth(), 132);
}

TEST(RtfEscape, SpecialCharactersAccentsAndOtherScripts) {
    const struct {
        std::string text, rtf;
    } cases[] = {
        {"a\\b{c}", "a\\\\b\\{c\\}"},
        {"Référence", "R\\'e9f\\'e9rence"},
        {"5 €", "5 \\'80"},                          // Windows-1252's own place for the euro
        {"σ0", "\\u963?0"},                          // outside Windows-1252
        {"\xF0\x9F\x98\x80", "\\u-10179?\\u-8704?"}, // beyond 16 bits: a surrogate pair
        {"ligne 1\nligne 2\t!", "ligne 1\\line ligne 2\\tab !"},
        {"\xE9t\xE9", "\\'e9t\\'e9"}, // a Windows-1252 name read from an old file
    };
    for (const auto& c : cases)
        EXPECT_EQ(RtfEscape(c.text), c.rtf) << c.text;
}

} // namespace
} // namespace pyr::test

#include "SettingsTestSupport.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "core/Undefined.h"
#include "settings/ListingObject.h"

#include <clocale>
#include <cmath>
#include <cstdint>
#include <string_view>
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

// Listings write their numbers from the digits directly; they must be the very texts that the general
// conversion gives: ties of the exact binary value to the even digit, values a hair on either side of a
// half, the sign of what rounds to zero, sizes beyond the direct writing.
TEST_F(ListingObject, NumbersAreTheTextsOfTheGeneralConversion) {
    std::vector<double> values = {0.0,    -0.0,   0.5,    1.5,       2.5,          -2.5,         0.125,
                                  0.375,  1.0625, 1e-300, -1e-300,   123.456789,   -0.0004,      399.999996,
                                  4.5e15, 1e300,  -1e300, 9.9999999, 651234.56785, 6862000.00005};
    std::uint64_t state = 12345;
    auto next = [&state] {
        state = state * 6364136223846793005u + 1442695040888963407u;
        return state >> 11;
    };
    for (int i = 0; i < 5000; ++i) {
        const double unit = static_cast<double>(next()) / 9007199254740992.0; // [0, 1)
        const int decimals = static_cast<int>(next() % 10);
        double scaled = std::ldexp(unit, static_cast<int>(next() % 80) - 30);
        values.push_back(i % 2 ? scaled : -scaled);
        // A half of the last decimal, and the doubles beside it.
        const double half = (std::floor(unit * 1e7) + 0.5) / std::pow(10.0, decimals);
        values.insert(values.end(), {half, std::nextafter(half, 0.0), std::nextafter(half, 1e9)});
    }
    for (const double value : values)
        for (int decimals = 0; decimals <= 12; ++decimals) {
            ASSERT_EQ(listing.FormatCoor(value, decimals), FormatFixedShown(value, decimals))
                << std::hexfloat << value << " " << decimals;
            const double direction = WrapGrads(value);
            const std::string turn =
                FormatFixedShown(RoundToDecimals(direction, decimals) >= 400.0 ? 0.0 : direction, decimals);
            ASSERT_EQ(listing.FormatAngl(value, decimals, true), turn) << std::hexfloat << value;
        }
}

// A table in plain text: columns as wide as their widest text counted in characters, the left offset, the
// alignments; a table that reaches the foot of a page goes on on the next one under the descriptor.
TEST_F(ListingObject, PlainTableRowsArePaddedAlignedAndBrokenAcrossPages) {
    listing.SetPageLength(20);
    listing.SetPageWidth(40);
    listing.SetPageCount();
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.WriteHeader(1);
    listing.SetDescriptor("| Point |");
    listing.WriteText("ligne ouverte");
    listing.rtfOffsetLeft(2);
    listing.rtfInitTab(15, 3);
    listing.rtfSetColWidth(0, 5);
    listing.rtfSetColWidth(1, 4);
    listing.rtfSetColWidth(2, 6);
    listing.rtfSetCellAlign(-1, 1, RtfAlign::Right);
    listing.rtfSetCellAlign(0, -1, RtfAlign::Center);
    listing.rtfSetCellValue(0, 0, "Nom");
    listing.rtfSetCellValue(0, 1, "X");
    listing.rtfSetCellValue(0, 2, "Côté");
    for (int r = 1; r < 15; ++r) {
        listing.rtfSetCellValue(r, 0, "Pé" + std::to_string(r));
        listing.rtfSetCellValue(r, 1, std::to_string(r * 7));
    }
    EXPECT_EQ(listing.rtfDrawTab(), 15);
    const std::string_view texts[] = {"été", "1", "trop long"};
    const int widths[] = {4, 3, 2};
    const RtfAlign aligns[] = {RtfAlign::Left, RtfAlign::Right, RtfAlign::Center};
    EXPECT_EQ(listing.WritePlainTableRow(texts, widths, aligns), 1);
    listing.WriteFooter();
    listing.CloseListing(file, false);

    const std::string rule(40, '-'), head = "PYRALIS Calculs Topo        chantier.cin\n" + rule + "\n\n";
    const std::string foot = rule + "\n" + std::string(17, ' ') + "Page ";
    std::string rows = "ligne ouverte\n  |  Nom  |  X   |  Côté  |\n";
    for (int r = 1; r < 15; ++r) {
        const std::string name = "Pé" + std::to_string(r), x = std::to_string(r * 7);
        rows += "  | " + name + std::string(5 - Utf8Length(name), ' ') + " | " +
                std::string(4 - x.size(), ' ') + x + " |        |\n";
        if (r == 13) rows += foot + "1\n" + head + "| Point |\n"; // 15 lines a page
    }
    rows += "  | été  |   1 | trop long |\n";
    EXPECT_EQ(ReadBytes(file), head + rows + std::string(12, '\n') + foot + "2\n");
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

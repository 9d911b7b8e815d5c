#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "core/Undefined.h"
#include "geobase/Elements.h"
#include "settings/ListingObject.h"

#include <clocale>
#include <gtest/gtest.h>
#include <sstream>
#include <string>
#include <vector>

namespace pyr::test {
namespace {

std::vector<std::string> SplitLines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        lines.push_back(line);
    return lines;
}

class ListingObject : public SettingsTest {
protected:
    // Forty numbered lines on pages of 20 lines, 40 characters wide, under a column descriptor.
    std::string WriteFortyLines(bool pageCount) {
        listing.SetPageLength(20);
        listing.SetPageWidth(40);
        EXPECT_TRUE(listing.OpenListing(file, "w"));
        listing.SetPageCount(pageCount);
        listing.WriteHeader(1);
        listing.SetDescriptor("| Station | V0 |");
        for (int i = 1; i <= 40; ++i)
            listing.WriteLine("ligne %d\n", i);
        listing.WriteFooter();
        EXPECT_TRUE(listing.CloseListing(file, false));
        return ReadBytes(file);
    }

    CDlgCfgListing listing{frontEnd};
    const std::string file = folder / "chantier.cin";
};

TEST_F(ListingObject, PlainTextPagesHoldThePageLengthWithHeaderFooterAndDescriptor) {
    // Header 3 lines, footer 2: 15 body lines a page, the descriptor taking one from the second page on.
    const std::vector<std::string> lines = SplitLines(WriteFortyLines(true));
    ASSERT_EQ(lines.size(), 60u);
    int next = 1;
    for (int page = 0; page < 3; ++page) {
        const auto first = lines.begin() + page * 20;
        SCOPED_TRACE(page + 1);
        EXPECT_EQ(first[0], "PYRALIS Calculs Topo" + std::string(8, ' ') + "chantier.cin");
        EXPECT_EQ(first[1], std::string(40, '-'));
        EXPECT_EQ(first[18], first[1]);
        EXPECT_EQ(Trimmed(first[19]), "Page " + std::to_string(page + 1));
        for (int k = 3; k < 18; ++k) {
            if (page > 0 && k == 3) {
                EXPECT_EQ(first[k], "| Station | V0 |");
            } else if (!first[k].empty()) {
                EXPECT_EQ(first[k], "ligne " + std::to_string(next++));
            }
        }
    }
    EXPECT_EQ(next, 41);

    const std::string runOn = WriteFortyLines(false);
    EXPECT_EQ(SplitLines(runOn).size(), 3u + 40u + 1u) << "without page count: no breaks";
    EXPECT_EQ(runOn.find("Page"), std::string::npos);
}

// Under a French locale (where it is installed), printf's "%f" writes a decimal comma; the listings keep
// the point of the surveyor's files.
TEST_F(ListingObject, LinesAreCountedEchoedAndCompletedAcrossWritesWithADecimalPoint) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    std::setlocale(LC_ALL, "fr_FR.UTF-8");
    EXPECT_TRUE(listing.OpenListing(file, "w"));
    EXPECT_EQ(listing.WriteLine("a\nb\n"), 2);
    EXPECT_EQ(listing.WriteLine("Point %s", "P1"), 0);
    EXPECT_EQ(listing.WriteLine(" : X = %.3f, D = %s\n", 1.5, listing.FormatDist(12.5, 2).c_str()), 1);
    listing.CloseListing(file, false);
    std::setlocale(LC_ALL, previous.c_str());
    EXPECT_EQ(ReadBytes(file), "a\nb\nPoint P1 : X = 1.500, D = 12.50\n");
    EXPECT_EQ(frontEnd.lines, (std::vector<std::string>{"a", "b", "Point P1 : X = 1.500, D = 12.50"}));

    // Into the text window only, nothing in the file.
    ASSERT_TRUE(listing.OpenListing(file, "w"));
    listing.InitOutput(ListingOutput::TextWindow);
    listing.WriteLine("fenêtre\n");
    listing.CloseListing(file, false);
    EXPECT_EQ(ReadBytes(file), "");
    EXPECT_EQ(frontEnd.lines.back(), "fenêtre");
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
    CPointGen::setDeciXY(savedXY);
    CPointGen::setDeciZ(savedZ);
    CStation::setDeciAng(savedAng);

    for (const std::string& text :
         {listing.FormatCoor(kUndefined), listing.FormatAlti(kUndefined), listing.FormatDist(kUndefined),
          listing.FormatDeni(kUndefined), listing.FormatAngl(kUndefined, 4, true)})
        EXPECT_EQ(text, "-");
    EXPECT_EQ(listing.FormatCoor(-0.0001, 3), "0.000"); // no "-0.000"
    EXPECT_EQ(listing.FormatDeni(1.5, 3), "+1.500");
    EXPECT_EQ(listing.FormatDeni(-1.5, 3), "-1.500");
    // Directions into [0, 400); a residual keeps its sign.
    EXPECT_EQ(listing.FormatAngl(-10.0, 4, true), "390.0000");
    EXPECT_EQ(listing.FormatAngl(399.999996, 5, true), "0.00000");
    EXPECT_EQ(listing.FormatAngl(-0.0123, 4), "-0.0123");
}

TEST_F(ListingObject, LayoutIsReadWithinItsLimits) {
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

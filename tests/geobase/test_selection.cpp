#include "geobase/Matricule.h"
#include "geobase/Selection.h"

#include <climits>
#include <gtest/gtest.h>
#include <random>
#include <string>
#include <vector>

namespace pyr {
namespace {

long long CountOf(std::string_view text) {
    auto selection = CSelection::Parse(text);
    EXPECT_TRUE(selection.has_value()) << text;
    return selection ? selection->Count() : -1;
}

TEST(SelectionGrammar, SeparatorsInAnyMix) {
    EXPECT_EQ(CountOf("1,2;3 4"), 4);
    EXPECT_EQ(CountOf(",,1;; 2 ,\t3\r\n"), 3);
    EXPECT_EQ(CountOf("1\u00A02"), 2);
}

TEST(SelectionGrammar, Ranges) {
    EXPECT_EQ(CountOf("100-150"), 51);
    EXPECT_EQ(CountOf("A1-A9"), 9);
    EXPECT_EQ(CountOf("A5-A5"), 1);
    EXPECT_EQ(CountOf("A0-A0009"), 10);
    // The end without a prefix takes the prefix of the first.
    EXPECT_EQ(CountOf("A1-9"), 9);
    EXPECT_EQ(CountOf("1-999999999999999999"), 999999999999999999);
}

TEST(SelectionGrammar, BlanksAroundTheDash) {
    EXPECT_EQ(CountOf("100 - 150"), 51);
    EXPECT_EQ(CountOf("100 -150"), 51);
    EXPECT_EQ(CountOf("100-  150, 7"), 52);
    EXPECT_EQ(CountOf("A1 - 9 B2"), 10);
}

TEST(SelectionGrammar, DashesInsideIdentifiers) {
    // Not a range when one side has no number: the identifier P-12.
    auto selection = CSelection::Parse("P-12 12-B A-5");
    ASSERT_TRUE(selection);
    EXPECT_EQ(selection->Count(), 3);
    EXPECT_TRUE(selection->Contains("P-12"));
    EXPECT_TRUE(selection->Contains("12-B"));
    EXPECT_TRUE(selection->Contains("A-5"));
    EXPECT_FALSE(selection->Contains("12"));

    // Identifiers with dashes make ranges too.
    auto dashed = CSelection::Parse("A-5-A-9");
    ASSERT_TRUE(dashed);
    EXPECT_EQ(dashed->Count(), 5);
    EXPECT_TRUE(dashed->Contains("A-7"));
    EXPECT_FALSE(dashed->Contains("A-10"));
    EXPECT_EQ(CountOf("A-5-9"), 5);
}

TEST(SelectionGrammar, CountsEachIdentifierOnce) {
    EXPECT_EQ(CountOf("A5, A1-A9"), 9);
    EXPECT_EQ(CountOf("A1-A5, A3-A9"), 9);
    EXPECT_EQ(CountOf("A1-A3 A7-A9"), 6);
    EXPECT_EQ(CountOf("12 12 0012"), 1);
    // A05 and A5 are two points, but one number of a range.
    EXPECT_EQ(CountOf("A05 A5"), 2);
    EXPECT_EQ(CountOf("A05 A5 A1-A9"), 9);
    EXPECT_EQ(CountOf("1-5 B1-B5 b1-b5"), 15);
    EXPECT_EQ(CountOf("A1-A9 PT12B A"), 11);
}

TEST(SelectionGrammar, CountSaturates) {
    std::string text;
    for (char prefix = 'A'; prefix <= 'J'; ++prefix)
        text += std::string(1, prefix) + "0-" + prefix + "999999999999999999 ";
    EXPECT_EQ(CountOf(text), LLONG_MAX);
}

void ExpectInvalid(std::string_view text, std::string_view reason) {
    std::string why;
    EXPECT_FALSE(CSelection::Parse(text, &why).has_value()) << text;
    EXPECT_EQ(why, reason) << text;
    EXPECT_FALSE(IsValidSelString(text)) << text;
    EXPECT_EQ(GetSelStringCount(text), 0) << text;
}

TEST(SelectionGrammar, InvalidTexts) {
    ExpectInvalid("", msg::kSelWhyEmpty);
    ExpectInvalid("  \t ", msg::kSelWhyEmpty);
    ExpectInvalid(",; ,", msg::kSelWhyEmpty);
    ExpectInvalid("1, 150-100",
                  "« 150-100 » : plage à l'envers, le premier numéro est plus grand que le dernier");
    ExpectInvalid("A9-1", std::string("« A9-1 » : ") + msg::kSelWhyReversed);
    ExpectInvalid("A1-B5", "« A1-B5 » : les deux bornes de la plage n'ont pas le même préfixe");
    ExpectInvalid("1-A5", std::string("« 1-A5 » : ") + msg::kSelWhyPrefixes);
    ExpectInvalid("1-99999999999999999999",
                  std::string("« 1-99999999999999999999 » : ") + msg::kSelWhyTooLarge);
}

TEST(SelectionGrammar, UnfinishedRanges) {
    const std::string unfinished = std::string(" : ") + msg::kSelWhyUnfinished;
    ExpectInvalid("100-", "« 100- »" + unfinished);
    ExpectInvalid("100 -", "« 100- »" + unfinished);
    ExpectInvalid("-150", "« -150 »" + unfinished);
    ExpectInvalid("- 150", "« -150 »" + unfinished);
    // A comma ends the item: the dash is left alone.
    ExpectInvalid("100, - 150", "« -150 »" + unfinished);
    ExpectInvalid("A1- -A9", std::string("« A1--A9 » : ") + msg::kSelWhyPrefixes);
}

TEST(SelectionGrammar, InvalidItems) {
    // Blanks around a dash ask for a range.
    ExpectInvalid("P - 12", std::string("« P-12 » : ") + msg::kSelWhyNoNumbers);
    ExpectInvalid("A\x01", std::string("« A\x01 » : ") + msg::kMatWhyControl);
    ExpectInvalid("A\xFF", std::string("« A\xFF » : ") + msg::kMatWhyNotText);
}

TEST(SelectionMembership, ExactIdentifiers) {
    auto selection = CSelection::Parse("P7, A05; 0012 a3");
    ASSERT_TRUE(selection);
    EXPECT_TRUE(selection->Contains("P7"));
    EXPECT_TRUE(selection->Contains("A05"));
    EXPECT_FALSE(selection->Contains("A5")); // another point
    EXPECT_FALSE(selection->Contains("p7")); // letter case counts
    EXPECT_FALSE(selection->Contains("A3"));
    EXPECT_TRUE(selection->Contains("a3"));
    EXPECT_TRUE(selection->Contains("12"));    // the item is normalised
    EXPECT_TRUE(selection->Contains(" 0012")); // and so is the question
    EXPECT_FALSE(selection->Contains("P"));
    EXPECT_FALSE(selection->Contains(""));
}

TEST(SelectionMembership, RangesCompareThePrefixAndTheNumber) {
    auto selection = CSelection::Parse("A1-A9, 100-150, B10-20");
    ASSERT_TRUE(selection);
    EXPECT_TRUE(selection->Contains("A007"));
    EXPECT_TRUE(selection->Contains("A9"));
    EXPECT_FALSE(selection->Contains("A0"));
    EXPECT_FALSE(selection->Contains("A10"));
    EXPECT_FALSE(selection->Contains("a5"));
    EXPECT_FALSE(selection->Contains("AA5"));
    EXPECT_FALSE(selection->Contains("5"));
    EXPECT_TRUE(selection->Contains("0000000000000150"));
    EXPECT_FALSE(selection->Contains("151"));
    EXPECT_TRUE(selection->Contains("B15"));
    EXPECT_FALSE(selection->Contains("15"));
    EXPECT_FALSE(selection->Contains("A99999999999999999999999"));
}

// Many overlapping ranges over few prefixes, checked against the plain reading of the text.
TEST(SelectionMembership, AgreesWithAPlainReadingOfManyRanges) {
    std::mt19937 random(20240611);
    const std::vector<std::string> prefixes = {"", "A", "PT", "a"};
    struct Written {
        std::string prefix;
        int first;
        int last;
    };
    std::vector<Written> ranges;
    std::string text;
    for (int i = 0; i < 300; ++i) {
        const std::string& prefix = prefixes[random() % prefixes.size()];
        const int first = static_cast<int>(random() % 2000);
        const int last = first + static_cast<int>(random() % 40);
        ranges.push_back({prefix, first, last});
        text += prefix + std::to_string(first) + "-" + prefix + std::to_string(last) + (i % 2 ? ", " : " ");
    }
    auto selection = CSelection::Parse(text);
    ASSERT_TRUE(selection);

    long long count = 0;
    for (const std::string& prefix : prefixes) {
        for (int number = 0; number < 2100; ++number) {
            bool expected = false;
            for (const Written& range : ranges)
                expected =
                    expected || (range.prefix == prefix && range.first <= number && number <= range.last);
            count += expected;
            const std::string id = FormMat(prefix, number, 0);
            ASSERT_EQ(selection->Contains(id), expected) << id;
            ASSERT_EQ(selection->Contains(FormMat(prefix, number, 5)), expected) << id;
        }
    }
    EXPECT_EQ(selection->Count(), count);
}

TEST(SelectionTextForms, FollowTheTextTheyAreGiven) {
    EXPECT_TRUE(IsPointInSel("5", "1-9"));
    EXPECT_FALSE(IsPointInSel("5", "10-20"));
    EXPECT_TRUE(IsPointInSel("15", "10-20"));
    EXPECT_TRUE(IsPointInSel("5", "1-9"));
    EXPECT_FALSE(IsPointInSel("5", "9-1"));
    EXPECT_EQ(GetSelStringCount("1-9"), 9);
    EXPECT_TRUE(IsValidSelString("1-9"));
    EXPECT_FALSE(IsValidSelString("9-1"));
    EXPECT_EQ(GetSelStringCount("10-20 A"), 12);
}

} // namespace
} // namespace pyr

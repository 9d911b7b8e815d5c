#include "geobase/Matricule.h"
#include "geobase/Selection.h"

#include <climits>
#include <gtest/gtest.h>
#include <random>
#include <set>
#include <string>
#include <tuple>
#include <utility>

namespace pyr {
namespace {

TEST(SelectionGrammar, ReadsItemsAndRangesAndCountsEachPointOnce) {
    // clang-format off
    const std::pair<std::string_view, long long> cases[] = {
        {"1,2;3 4", 4}, {",,1;; 2 ,\t3\r\n", 3}, {"1\u00A02", 2}, // separators in any mix
        {"100-150", 51}, {"A1-A9", 9}, {"A5-A5", 1}, {"A0-A0009", 10}, {"A1-9", 9}, {"A1 - 9 B2", 10},
        {"100 - 150", 51}, {"100 -150", 51}, {"100-  150, 7", 52}, {"1-999999999999999999", kMaxMatNumber},
        // A dash with no number on one side is part of a name; names with dashes make ranges too.
        {"P-12 12-B A-5", 3}, {"A-5-A-9", 5}, {"A-5-9", 5},
        // Overlaps and repeats count once; A05 and A5 are two points but one number of a range.
        {"A5, A1-A9", 9}, {"A1-A5, A3-A9", 9}, {"A1-A3 A7-A9", 6}, {"12 12 0012", 1}, {"A05 A5", 2},
        {"A05 A5 A1-A9", 9}, {"1-5 B1-B5 b1-b5", 15}, {"A1-A9 PT12B A", 11}};
    // clang-format on
    for (auto [text, count] : cases) {
        auto selection = CSelection::Parse(text);
        ASSERT_TRUE(selection) << text;
        EXPECT_EQ(selection->Count(), count) << text;
        EXPECT_EQ(GetSelStringCount(text), count) << text;
    }

    std::string huge;
    for (char prefix = 'A'; prefix <= 'J'; ++prefix)
        huge += std::string(1, prefix) + "0-" + prefix + "999999999999999999 ";
    EXPECT_EQ(GetSelStringCount(huge), LLONG_MAX);
}

TEST(SelectionGrammar, RefusesWithTheFaultyItemAndTheReason) {
    using namespace msg;
    // clang-format off
    const std::tuple<std::string_view, std::string_view, std::string_view> cases[] = {
        {"", "", kSelWhyEmpty}, {"  \t ", "", kSelWhyEmpty}, {",; ,", "", kSelWhyEmpty},
        {"1, 150-100", "150-100", kSelWhyReversed}, {"A9-1", "A9-1", kSelWhyReversed},
        {"A1-B5", "A1-B5", kSelWhyPrefixes}, {"1-A5", "1-A5", kSelWhyPrefixes},
        {"A1- -A9", "A1--A9", kSelWhyPrefixes}, {"P - 12", "P-12", kSelWhyNoNumbers}, // blanks make a range
        {"1-99999999999999999999", "1-99999999999999999999", kSelWhyTooLarge},
        {"100-", "100-", kSelWhyUnfinished}, {"100 -", "100-", kSelWhyUnfinished},
        {"-", "-", kSelWhyUnfinished}, {"- 150", "-150", kSelWhyUnfinished},
        {"100, - 150", "-150", kSelWhyUnfinished}, // a comma ends the item
        {"A\x01", "A\x01", kMatWhyControl}, {"A\xFF", "A\xFF", kMatWhyNotText}};
    // clang-format on
    for (auto [text, item, reason] : cases) {
        std::string why;
        EXPECT_FALSE(CSelection::Parse(text, &why)) << text;
        EXPECT_EQ(why, item.empty() ? std::string(reason)
                                    : "« " + std::string(item) + " » : " + std::string(reason))
            << text;
        EXPECT_FALSE(IsValidSelString(text)) << text;
        EXPECT_EQ(GetSelStringCount(text), 0) << text;
        EXPECT_FALSE(IsPointInSel("1", text)) << text;
    }
}

TEST(SelectionMembership, SameNormalisedNameOrSamePrefixWithANumberInARange) {
    auto selection = CSelection::Parse("P7, C05; 0012 c3 P-12 12-B, A1-A9, 100-150, B10-20 A-5-A-9");
    ASSERT_TRUE(selection);
    for (std::string_view id : {"P7", "C05", "c3", "12", " 0012", "P-12", "12-B", "A007", "A1", "A9", "B15",
                                "0000000000000150", "A-7"})
        EXPECT_TRUE(selection->Contains(id)) << id;
    for (std::string_view id : {"C5", "C3", "p7", "P", "", "A", "A0", "A10", "a5", "AA5", "5", "15", "151",
                                "A-10", "A99999999999999999999999"})
        EXPECT_FALSE(selection->Contains(id)) << id;

    // The text forms read the text they are given, not the last one.
    EXPECT_TRUE(IsPointInSel("5", "1-9"));
    EXPECT_FALSE(IsPointInSel("5", "10-20"));
    EXPECT_TRUE(IsValidSelString("1-9"));
    EXPECT_TRUE(IsPointInSel("5", "1-9"));
}

// Many overlapping ranges over few prefixes, against the set of the points they name.
TEST(SelectionMembership, AgreesWithTheMembersOfManyRandomRanges) {
    std::mt19937 random(20240611);
    const std::string prefixes[] = {"", "A", "PT", "a"};
    std::set<std::string> members;
    std::string text;
    for (int i = 0; i < 150; ++i) {
        const std::string& prefix = prefixes[random() % 4];
        const int first = static_cast<int>(random() % 600);
        const int last = first + static_cast<int>(random() % 30);
        text += prefix + std::to_string(first) + "-" + prefix + std::to_string(last) + (i % 2 ? ", " : " ");
        for (int number = first; number <= last; ++number)
            members.insert(prefix + std::to_string(number));
    }
    auto selection = CSelection::Parse(text);
    ASSERT_TRUE(selection);
    EXPECT_EQ(selection->Count(), static_cast<long long>(members.size()));
    for (const std::string& prefix : prefixes) {
        for (int number = 0; number < 650; ++number) {
            const std::string id = prefix + std::to_string(number);
            ASSERT_EQ(selection->Contains(id), members.contains(id)) << id;
            ASSERT_EQ(selection->Contains(FormMat(prefix, number, 5)), members.contains(id)) << id;
        }
    }
}

} // namespace
} // namespace pyr

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
        {"1,2;3 4", 4}, {",,1;; 2 ,\t3\r\n", 3}, {"1\u00A02", 2}, {"100-150", 51}, {"A1-A9", 9}, {"A1-9", 9},
        {"A0-A0009", 10}, {"A1 - 9 B2", 10}, {"100 -150", 51}, {"1-999999999999999999", kMaxMatNumber},
        // A dash without a number on both sides is part of a name; overlaps and repeats count once (A05
        // and A5 are two points, but one number of a range).
        {"P-12 12-B A-5", 3}, {"A-5-A-9", 5}, {"A5, A1-A9", 9}, {"12 12 0012", 1}, {"A05 A5 A1-A9", 9}};
    // clang-format on
    for (auto [text, count] : cases)
        EXPECT_EQ(GetSelStringCount(text), count) << text;

    std::string huge;
    for (char prefix = 'A'; prefix <= 'J'; ++prefix)
        huge += std::string(1, prefix) + "0-" + prefix + "999999999999999999 ";
    EXPECT_EQ(GetSelStringCount(huge), LLONG_MAX);
}

TEST(SelectionGrammar, RefusesWithTheFaultyItemAndTheReason) {
    using namespace msg;
    // clang-format off
    const std::tuple<std::string_view, std::string_view, std::string_view> cases[] = {
        {",; ,", "", kSelWhyEmpty}, {"1, 150-100", "« 150-100 » : ", kSelWhyReversed},
        {"A1-B5", "« A1-B5 » : ", kSelWhyPrefixes}, {"P - 12", "« P-12 » : ", kSelWhyNoNumbers},
        {"1-99999999999999999999", "« 1-99999999999999999999 » : ", kSelWhyTooLarge},
        {"100 -", "« 100- » : ", kSelWhyUnfinished}, {"100, - 150", "« -150 » : ", kSelWhyUnfinished},
        {"A\x01", "« A\x01 » : ", kMatWhyControl}};
    // clang-format on
    for (auto [text, item, reason] : cases) {
        std::string why;
        EXPECT_FALSE(CSelection::Parse(text, &why)) << text;
        EXPECT_EQ(why, std::string(item).append(reason)) << text;
        EXPECT_FALSE(IsValidSelString(text)) << text;
        EXPECT_EQ(GetSelStringCount(text), 0) << text;
    }
}

TEST(SelectionMembership, SameNormalisedNameOrSamePrefixWithANumberInARange) {
    auto selection = CSelection::Parse("P7, C05; 0012 c3 P-12 12-B, A1-A9, 100-150, B10-20 A-5-A-9");
    ASSERT_TRUE(selection);
    for (std::string_view id : {"C05", "c3", " 0012", "P-12", "12-B", "A007", "A1", "A9", "B15", "A-7"})
        EXPECT_TRUE(selection->Contains(id)) << id;
    for (std::string_view id :
         {"C5", "C3", "P", "", "A", "A0", "A10", "a5", "AA5", "151", "A-10", "A99999999999999999999999"})
        EXPECT_FALSE(selection->Contains(id)) << id;

    EXPECT_TRUE(IsPointInSel("5", "1-9"));
    EXPECT_FALSE(IsPointInSel("5", "10-20")); // the text given is read, not the last one kept
}

// Many overlapping ranges over few prefixes, against the set of the points they name.
TEST(SelectionMembership, AgreesWithTheMembersOfManyRandomRanges) {
    std::mt19937 random(20240611);
    const std::string prefixes[] = {"", "A", "a"};
    std::set<std::string> members;
    std::string text;
    for (int i = 0; i < 150; ++i) {
        const std::string& prefix = prefixes[random() % 3];
        const int first = static_cast<int>(random() % 600);
        const int last = first + static_cast<int>(random() % 30);
        text += prefix + std::to_string(first) + "-" + prefix + std::to_string(last) + (i % 2 ? ", " : " ");
        for (int number = first; number <= last; ++number)
            members.insert(prefix + std::to_string(number));
    }
    auto selection = CSelection::Parse(text);
    ASSERT_TRUE(selection);
    EXPECT_EQ(selection->Count(), static_cast<long long>(members.size()));
    for (const std::string& prefix : prefixes)
        for (int number = 0; number < 650; ++number)
            ASSERT_EQ(selection->Contains(FormMat(prefix, number, 4)),
                      members.contains(FormMat(prefix, number, 0)));
}

} // namespace
} // namespace pyr

#include "geobase/Matricule.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <set>
#include <string>
#include <tuple>
#include <utility>

namespace pyr {
namespace {

TEST(FormMat, NormalisesTheNameAndBuildsItFromPrefixNumberAndWidth) {
    // clang-format off
    const std::pair<std::string_view, std::string_view> cases[] = {
        {"0000000000000012", "12"}, {"\t A12\r\n", "A12"}, {std::string_view("A12\0\0\0", 6), "A12"},
        {"\u00A0A12\u202F", "A12"}, {"   ", ""}, {"  00 ", "0"}, // a name of zeros keeps one
        // Case and inner signs are kept; one zero in front of a sign other than a letter or a digit stays.
        {"a12", "a12"}, {"A 12", "A 12"}, {"000-1", "0-1"}, {"00\u00C91", "\u00C91"}};
    // clang-format on
    for (auto [id, normal] : cases) {
        std::string formed(id);
        FormMat(formed);
        EXPECT_EQ(formed, normal) << id;
        EXPECT_EQ(FormMatView(id), normal) << id;
    }
    EXPECT_EQ(FormMat("A", 12, 4), "A0012");
    EXPECT_EQ(FormMat("A", 12345, 3), "A12345"); // never cut
    EXPECT_EQ(FormMat("", 12, 4), "12");         // padding a numeric name would make another name
    EXPECT_EQ(FormMat("PT12B", -1, 0), "PT12B"); // no number: what ExtrMat splits builds back
}

TEST(ExtrMat, SplitsTheTrailingNumberOrGivesTheWholeName) {
    // clang-format off
    const std::tuple<std::string_view, bool, std::string_view, long long> cases[] = {
        {"0012", true, "", 12}, {" A0012 ", true, "A", 12}, {"PT12B7", true, "PT12B", 7},
        {"A-5", true, "A-", 5}, {"PT12B", false, "PT12B", -1}, // numbers are never negative
        // At most 18 significant digits; beyond, the digits are text.
        {"A999999999999999999", true, "A", kMaxMatNumber}, {"A0000000000000000000000000000007", true, "A", 7},
        {"A1000000000000000000", false, "A1000000000000000000", -1}};
    // clang-format on
    for (auto [id, split, wantPrefix, wantNumber] : cases) {
        // The outputs start with stale values: a refusal must overwrite them too.
        std::string prefix = "stale";
        long long number = 99;
        EXPECT_EQ(ExtrMat(id, prefix, number), split) << id;
        EXPECT_EQ(prefix, wantPrefix) << id;
        EXPECT_EQ(number, wantNumber) << id;
    }
}

TEST(NextMat, SkipsUsedOnesKeepsPrefixAndWidthNumbersNamesWithoutNumberAndStopsAtTheLargest) {
    const std::set<std::string, std::less<>> used = {"A10", "A11", "A13", "B1", "B2"};
    auto isUsed = [&](std::string_view id) { return used.contains(id); };
    // clang-format off
    const std::pair<std::string_view, std::string_view> cases[] = {
        {"A09", "A12"}, {"  A0009 ", "A0010"}, {"A99", "A100"}, {"0009", "10"}, {"B", "B3"}, {"", "1"},
        {"A999999999999999998", "A999999999999999999"}, {"A999999999999999999", ""},
        {"A99999999999999999999999", ""}};
    // clang-format on
    for (auto [id, next] : cases)
        EXPECT_EQ(NextMat(id, isUsed), next) << id;
    auto allUsed = [](std::string_view) { return true; };
    EXPECT_EQ(NextMat("A1", allUsed, 1000), ""); // gives up after so many tries
}

TEST(IsValidMat, AcceptsUsualNamesAndRefusesWithTheReason) {
    // clang-format off
    const std::pair<std::string_view, std::string_view> cases[] = {
        {"P-12", ""}, {"S1.P3", ""}, {"\u00C9GL1", ""}, {" 0012 ", ""},
        {"", msg::kMatWhyEmpty}, {"A\u00A012", msg::kMatWhyBlank}, {"A\x01Z", msg::kMatWhyControl},
        {"A\u0085", msg::kMatWhyControl}, {"A\xFF", msg::kMatWhyNotText},
        {"A;1", "il contient « ; », qui sépare les points d'une sélection"},
        {"-5", msg::kMatWhyLeadingDash}, {"5-", msg::kMatWhyTrailingDash}};
    // clang-format on
    for (auto [id, reason] : cases) {
        std::string why;
        EXPECT_EQ(IsValidMat(id, &why), reason.empty()) << id;
        EXPECT_EQ(why, reason) << id;
    }
}

TEST(DDV_Mat, WarnsTheParentOrElseTheApplicationAboutAnEmptyOrMalformedIdentifier) {
    ui::ScriptedFrontEnd application;
    ui::ScopedApplicationFrontEnd scope(application);
    ui::ScriptedFrontEnd person;
    EXPECT_FALSE(DDV_Mat(&person, "   "));
    EXPECT_FALSE(DDV_Mat(&person, "  A 12 "));
    ASSERT_EQ(person.messages.size(), 2u);
    EXPECT_EQ(person.messages[0].text, "Le matricule du point doit être indiqué !");
    EXPECT_EQ(person.messages[1].text, "Le matricule <A 12> n'est pas correct : il contient un espace !");

    EXPECT_FALSE(DDV_Mat(nullptr, ""));
    ASSERT_EQ(application.messages.size(), 1u);
}

TEST(DDX_Mat, SavingNormalisesTheFieldOrChangesNothingAndLoadingShowsTheValue) {
    ui::ScriptedFrontEnd person;
    std::string field = " A 12";
    std::string value = "A11";
    EXPECT_FALSE(DDX_Mat(&person, true, field, value));
    EXPECT_EQ(value, "A11");

    field = "  0000000000000012 ";
    EXPECT_TRUE(DDX_Mat(&person, true, field, value));
    EXPECT_EQ(field, "12");
    EXPECT_EQ(value, "12");

    value = "A0009";
    EXPECT_TRUE(DDX_Mat(&person, false, field, value));
    EXPECT_EQ(field, "A0009");
}

} // namespace
} // namespace pyr

#include "geobase/Matricule.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

namespace pyr {
namespace {

std::string Formed(std::string id) {
    FormMat(id);
    return id;
}

TEST(FormMat, RemovesThePaddingOfFieldBooks) {
    EXPECT_EQ(Formed("0000000000000012"), "12");
    EXPECT_EQ(Formed("        A12"), "A12");
    EXPECT_EQ(Formed("A12        "), "A12");
    EXPECT_EQ(Formed("\t A12\r\n"), "A12");
    EXPECT_EQ(Formed(std::string("A12\0\0\0", 6)), "A12");
    EXPECT_EQ(Formed("\u00A0A12\u202F"), "A12");
    EXPECT_EQ(Formed("  0012  "), "12");
    EXPECT_EQ(Formed("000000000000PT12"), "PT12");
    EXPECT_EQ(Formed("   "), "");
    // A name of zeros keeps one.
    EXPECT_EQ(Formed("0000000000000000"), "0");
    EXPECT_EQ(Formed("  00 "), "0");
}

TEST(FormMat, KeepsWhatIsPartOfTheName) {
    EXPECT_EQ(Formed("a12"), "a12");
    EXPECT_EQ(Formed("A0012"), "A0012");
    EXPECT_EQ(Formed("A 12"), "A 12");
    EXPECT_EQ(Formed("P-12"), "P-12");
    // A zero in front of a sign other than a letter or a digit belongs to the name.
    EXPECT_EQ(Formed("0.5"), "0.5");
    EXPECT_EQ(Formed("000-1"), "0-1");
    // Zeros in front of an accented letter are padding like any other.
    EXPECT_EQ(Formed("00\u00C91"), "\u00C91");
}

TEST(FormMat, IsIdempotent) {
    for (std::string id : {"0000000000000012", " A0012 ", "000", "000-1", "00A", "\t0.5"}) {
        const std::string once = Formed(id);
        EXPECT_EQ(Formed(once), once) << id;
        EXPECT_EQ(FormMatView(id), once) << id;
    }
}

TEST(FormMat, BuildsFromPrefixAndNumber) {
    EXPECT_EQ(FormMat("A", 12, 4), "A0012");
    EXPECT_EQ(FormMat("A", 12, 0), "A12");
    EXPECT_EQ(FormMat("A", 0, 3), "A000");
    EXPECT_EQ(FormMat("A", 12345, 3), "A12345"); // never cut
    EXPECT_EQ(FormMat(" A", 5, 2), "A05");
    // A purely numeric name is stored without zeros in front: padding it would make another name.
    EXPECT_EQ(FormMat("", 12, 4), "12");
    EXPECT_EQ(FormMat("", 0, 4), "0");
    // No number: the prefix alone, so that what ExtrMat splits builds back.
    EXPECT_EQ(FormMat("PT12B", -1, 0), "PT12B");
}

// The outputs start with stale values: a refusal must overwrite them too.
void ExpectSplit(std::string_view id, bool ok, std::string_view prefix, long long number) {
    std::string gotPrefix = "stale";
    long long gotNumber = 99;
    EXPECT_EQ(ExtrMat(id, gotPrefix, gotNumber), ok) << id;
    EXPECT_EQ(gotPrefix, prefix) << id;
    EXPECT_EQ(gotNumber, number) << id;
}

TEST(ExtrMat, SplitsTheTrailingNumber) {
    ExpectSplit("A12", true, "A", 12);
    ExpectSplit("12", true, "", 12);
    ExpectSplit("0", true, "", 0);
    ExpectSplit("A0012", true, "A", 12);
    ExpectSplit("PT12B7", true, "PT12B", 7);
    ExpectSplit("  A12  ", true, "A", 12);
    ExpectSplit("0000000000000012", true, "", 12);
    // Numbers are never negative: the dash belongs to the prefix.
    ExpectSplit("A-5", true, "A-", 5);
    ExpectSplit("-5", true, "-", 5);
}

TEST(ExtrMat, WithoutTrailingNumberGivesTheWholeName) {
    ExpectSplit("PT12B", false, "PT12B", -1);
    ExpectSplit("A", false, "A", -1);
    ExpectSplit("12-", false, "12-", -1);
    ExpectSplit("", false, "", -1);
}

TEST(ExtrMat, NumbersTooLargeAreText) {
    ExpectSplit("A999999999999999999", true, "A", kMaxMatNumber);
    ExpectSplit("A1000000000000000000", false, "A1000000000000000000", -1);
    ExpectSplit("99999999999999999999999999999", false, "99999999999999999999999999999", -1);
    // Leading zeros are not significant digits.
    ExpectSplit("A0000000000000000000000000000007", true, "A", 7);
}

// Identifiers already in a GéoBase; the function counts how often it is asked.
struct UsedSet {
    std::set<std::string, std::less<>> ids;
    std::vector<std::string> asked;
    std::function<bool(std::string_view)> Query() {
        return [this](std::string_view id) {
            asked.emplace_back(id);
            return ids.find(id) != ids.end();
        };
    }
};

TEST(NextMat, KeepsThePrefixAndTheWidth) {
    const std::function<bool(std::string_view)> none;
    EXPECT_EQ(NextMat("A09", none), "A10");
    EXPECT_EQ(NextMat("A0009", none), "A0010");
    EXPECT_EQ(NextMat("A99", none), "A100");
    EXPECT_EQ(NextMat("9", none), "10");
    EXPECT_EQ(NextMat("A-5", none), "A-6");
    EXPECT_EQ(NextMat("  A0009 ", none), "A0010");
    // A numeric name is read in its normal form, without its padding.
    EXPECT_EQ(NextMat("0009", none), "10");
}

TEST(NextMat, SkipsUsedIdentifiers) {
    UsedSet used{{"A10", "A11", "A13"}, {}};
    EXPECT_EQ(NextMat("A09", used.Query()), "A12");
    EXPECT_EQ(used.asked, (std::vector<std::string>{"A10", "A11", "A12"}));
}

TEST(NextMat, NumbersANameWithoutNumber) {
    const std::function<bool(std::string_view)> none;
    EXPECT_EQ(NextMat("B", none), "B1");
    EXPECT_EQ(NextMat("PT12B", none), "PT12B1");
    EXPECT_EQ(NextMat("", none), "1");
    UsedSet used{{"B1", "B2"}, {}};
    EXPECT_EQ(NextMat("B", used.Query()), "B3");
}

TEST(NextMat, GivesUpRatherThanLoopingForever) {
    int asked = 0;
    auto allUsed = [&asked](std::string_view) {
        ++asked;
        return true;
    };
    EXPECT_EQ(NextMat("A1", allUsed, 1000), "");
    EXPECT_EQ(asked, 1000);

    const std::function<bool(std::string_view)> none;
    EXPECT_EQ(NextMat("A999999999999999998", none), "A999999999999999999");
    EXPECT_EQ(NextMat("A999999999999999999", none), "");
    EXPECT_EQ(NextMat("A99999999999999999999999", none), "");
}

TEST(IsValidMat, AcceptsUsualNames) {
    for (std::string_view id : {"A12", "12", "0", "P-12", "S1.P3", "a_b/3", "BORNE", "\u00C9GL1", " 0012 "})
        EXPECT_TRUE(IsValidMat(id)) << id;
}

void ExpectRefused(std::string_view id, std::string_view reason) {
    std::string why;
    EXPECT_FALSE(IsValidMat(id, &why)) << id;
    EXPECT_EQ(why, reason) << id;
}

TEST(IsValidMat, RefusesWithTheReason) {
    ExpectRefused("", msg::kMatWhyEmpty);
    ExpectRefused("A 12", msg::kMatWhyBlank);
    ExpectRefused("A\t12", msg::kMatWhyBlank);
    ExpectRefused("A\u00A012", msg::kMatWhyBlank);
    ExpectRefused("A\u00012", msg::kMatWhyControl);
    ExpectRefused("A\x7F", msg::kMatWhyControl);
    ExpectRefused("A\u0085", msg::kMatWhyControl);
    ExpectRefused("A\xFF", msg::kMatWhyNotText);
    ExpectRefused("A,1", "il contient « , », qui sépare les points d'une sélection");
    ExpectRefused("-5", msg::kMatWhyLeadingDash);
    ExpectRefused("5-", msg::kMatWhyTrailingDash);
}

TEST(DDV_Mat, RefusesAnEmptyOrMalformedIdentifierWithAWarning) {
    ui::ScriptedFrontEnd person;
    EXPECT_FALSE(DDV_Mat(&person, "   "));
    EXPECT_FALSE(DDV_Mat(&person, "  A 12 "));
    EXPECT_FALSE(DDV_Mat(&person, "A,12"));
    EXPECT_TRUE(DDV_Mat(&person, "0000000000000012"));
    ASSERT_EQ(person.messages.size(), 3u);
    EXPECT_EQ(person.messages[0].text, "Le matricule du point doit être indiqué !");
    EXPECT_EQ(person.messages[0].caption, "PYRALIS");
    EXPECT_EQ(person.messages[0].icon, ui::kIconWarning);
    EXPECT_EQ(person.messages[1].text, "Le matricule <A 12> n'est pas correct : il contient un espace !");
    EXPECT_EQ(
        person.messages[2].text,
        "Le matricule <A,12> n'est pas correct : il contient « , », qui sépare les points d'une sélection !");
}

TEST(DDV_Mat, WithoutParentSpeaksToTheApplicationFrontEnd) {
    ui::ScriptedFrontEnd person;
    ui::ScopedApplicationFrontEnd scope(person);
    EXPECT_FALSE(DDV_Mat(nullptr, ""));
    ASSERT_EQ(person.messages.size(), 1u);
    EXPECT_EQ(person.messages[0].text, msg::kMatMissing);
}

TEST(DDX_Mat, SavingNormalisesTheFieldOrChangesNothing) {
    ui::ScriptedFrontEnd person;
    std::string field = " A 12";
    std::string value = "A11";
    EXPECT_FALSE(DDX_Mat(&person, true, field, value));
    EXPECT_EQ(value, "A11");
    EXPECT_EQ(field, " A 12");
    EXPECT_EQ(person.messages.size(), 1u);

    field = "  0000000000000012 ";
    EXPECT_TRUE(DDX_Mat(&person, true, field, value));
    EXPECT_EQ(value, "12");
    EXPECT_EQ(field, "12");
    EXPECT_EQ(person.messages.size(), 1u);
}

} // namespace
} // namespace pyr

// Where the code starts in a point's name field, and how a field code is split into words.
#include "fieldbook/TableCode.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

struct PositionCase {
    const char* field;
    const char* separator;
    std::size_t position;
};

// Accented letters count by their case; positions are byte indices of the UTF-8 field.
constexpr PositionCase kPositionCases[] = {
    {"125ARB 0.60", kSeparatorUpper, 3},
    {"125", kSeparatorUpper, 3}, // no code: the whole field is the name
    {"", kSeparatorUpper, 0},
    {"12a3ARB", kSeparatorUpper, 4}, // a lower-case letter belongs to the name
    {"12ÉCL", kSeparatorUpper, 2},
    {"12éARB", kSeparatorUpper, 4},
    {"12×3ARB", kSeparatorUpper, 5}, // × is no letter
    {"125arb", kSeparatorLower, 3},
    {"125ARB", kSeparatorLower, 6},
    {"12ARBé", kSeparatorLower, 5},
    {"12œil", kSeparatorLower, 2},
    {"12+EXR", kSeparatorSign, 2},
    {"12-EXR", kSeparatorSign, 2},
    {"AB-C+D", kSeparatorSign, 2}, // both signs: the earlier cuts
    {"AB+C-D", kSeparatorSign, 2},
    {"P12", kSeparatorSign, 3},
    {"12/ARB", "/", 2},
    {"12-3--ARB", "--", 4}, // a literal of several characters is matched whole
    {"12-3-ARB", "--", 8},
    {"12 ARB", " ", 2},
    {"12ÉARB", "É", 2},
    {"12ARB", "", 5}, // an empty setting marks no code
};

} // namespace

TEST(CodePosition, FollowsTheSeparatorSetting) {
    for (const PositionCase& c : kPositionCases)
        EXPECT_EQ(CodePosition(c.field, c.separator), c.position) << c.field << " / " << c.separator;
}

TEST(CodePosition, ReadsTheSignSettingOnlyAsItIsWritten) {
    // "+-" is a literal of two characters, not the sign setting.
    EXPECT_EQ(CodePosition("12+EXR", "+-"), 6u);
    EXPECT_EQ(CodePosition("12+-EXR", "+-"), 2u);
}

TEST(MakeStrCmd, SplitsOnBlanksAndKeepsQuotedTextsWhole) {
    struct Case {
        const char* text;
        std::vector<std::string> words;
    };
    const Case cases[] = {
        {"ARB 0.60", {"ARB", "0.60"}},
        {"  EXR\t0.15  ", {"EXR", "0.15"}},
        {"TXT \"Mur de soutènement\" 2.5", {"TXT", "Mur de soutènement", "2.5"}},
        {"TXT \"non fermé", {"TXT", "non fermé"}},
        {"TXT \"\" 1", {"TXT", "", "1"}},
        {"L'allée \"B\"x", {"L'allée", "B", "x"}},
        {"A\"B C", {"A\"B", "C"}}, // a quote inside a word is a character
        {"", {}},
        {" \t ", {}},
    };
    CTableCode table;
    std::vector<std::string> words{"left", "from", "before", "this", "call"};
    for (const Case& c : cases) {
        EXPECT_EQ(table.Make_str_cmd(c.text, words), static_cast<int>(c.words.size())) << c.text;
        EXPECT_EQ(words, c.words) << c.text;
    }
}

// The words of a GSI block and their values. Every expected value is worked out by hand from the unit
// digit's definition (decimals, 400 gr = 360° = 6400 mils, 1 ft = 0.3048 m), never taken from a run.
#include "fieldbook/LectWildValues.h"
#include "fieldbook/LectWildWord.h"

#include <gtest/gtest.h>
#include <string>
#include <tuple>
#include <utility>

using namespace pyr;
using namespace pyr::gsi;

namespace {

constexpr double kMetreTolerance = 1e-7; // 0.1 µm: far below the 0.01 mm of the finest unit
constexpr double kGradTolerance = 1e-9;  // 1e-6 mgon

// The word views the text it was cut from: a literal, which outlives it.
Word OneWord(std::string_view line) {
    Block block;
    std::string_view bad;
    EXPECT_TRUE(SplitBlock(line, block, bad)) << line;
    EXPECT_EQ(block.count, 1u) << line;
    return block.count ? block.words[0] : Word{};
}

} // namespace

// Levelling readings carry three-digit indices; headers may lack their dots, the sign ending them (a dash
// may stand where the sign of a full header would); a last word may be cut short, an id end a line in
// blanks; a GSI-16 block may lack its star.
TEST(GsiWords, BlocksAreCutIntoTheirWordsInGsi8AndGsi16) {
    // clang-format off
    const std::tuple<const char*, bool, const char*> cases[] = {
        {"110012+0000A 12 21.102+11545200 31..00+00005165   ", false, "11:0000A 12 21:11545200 31:00005165 "},
        {"*110002+00000000GDEM5415 21.024+0000000003545100 83..10-0000000000001234 ", true,
         "11:00000000GDEM5415 21:0000000003545100 83:0000000000001234 "},
        {"110004+000000A1 331.08+00123456 32...8+00250000", false, "11:000000A1 331:00123456 32:00250000 "},
        {"410004+00000013 42....+0000TREE", false, "41:00000013 42:0000TREE "},
        {"11+00000100 21+11545200 22.2+09885300", false, "11:00000100 21:11545200 22:09885300 "},
        {"31+000-----", false, "31:000----- "},
        {"110001+00000100 21.102+1154", false, "11:00000100 21:1154 "},
        {"21.102+11545200 110001+  A  12", false, "21:11545200 11:  A  12 "},
        {"110002+00000000GDEM5415 21.024+0000000003545100", true, "11:00000000GDEM5415 21:0000000003545100 "}};
    // clang-format on
    for (const auto& [line, gsi16, expected] : cases) {
        Block block;
        std::string_view bad;
        ASSERT_TRUE(SplitBlock(line, block, bad)) << line;
        EXPECT_EQ(block.gsi16, gsi16) << line;
        std::string words;
        for (const Word& word : block)
            words += std::to_string(word.index) + ":" + std::string(word.data) + " ";
        EXPECT_EQ(words, expected) << line;
    }
    for (const char* line : {"110001+00000100 2X.102+11545200", "110001+00000100 21.1020011545200",
                             "Station 1", "110001+00000100 +11545200"}) {
        Block block;
        std::string_view bad;
        EXPECT_FALSE(SplitBlock(line, block, bad)) << line;
        EXPECT_FALSE(bad.empty()) << line;
    }
    Block block;
    std::string_view bad;
    ASSERT_TRUE(SplitBlock(std::get<0>(cases[1]), block, bad));
    EXPECT_EQ(block.words[0].info, "0002"); // the block number
    EXPECT_EQ(block.words[2].sign, '-');
    EXPECT_EQ(block.words[2].text, "83..10-0000000000001234");
    const std::pair<const char*, int> units[] = {{"110012+0000A 12", 0},   {"21.102+11545200", '2'},
                                                 {"31..00+00005165", '0'}, {"*21.024+0000000003545100", '4'},
                                                 {"22.2+09885300", '2'},   {"21+11545200", 0}};
    for (const auto& [word, unit] : units)
        EXPECT_EQ(OneWord(word).unit, unit) << word;
    // Texts lose their padding only: zeros pad every id, so 007 and 7 read alike.
    EXPECT_EQ(WordText(OneWord("110001+00000000")), "0");
    EXPECT_EQ(WordText(OneWord("*110001+00000000GDEM5415")), "GDEM5415");
}

// Without a unit digit, or with one of the other kind, the settings say the unit.
TEST(GsiValues, EveryUnitDigitGivesGradsAndMetres) {
    struct Case {
        const char* word;
        bool angle;
        double expected;
        AngleUnit angleUnit = AngleUnit::Grads;
        DistanceUnit distanceUnit = DistanceUnit::Metres;
    };
    // Decimal degrees, 91°17'51.0", 35°45'10.5", 100 mils; mm, 10.000 ft, 0.1 mm, 1.0000 ft, 0.01 mm, a
    // Lambert-93 northing to 0.1 mm in GSI-16, a height typed with its decimal point.
    const double dms = 400.0 / 360.0;
    // clang-format off
    const Case cases[] = {
        {"21.102+11545200", true, 115.452}, {"21.103+04512345", true, 45.12345 * dms},
        {"22.104+09117510", true, (91.0 + 17.0 / 60.0 + 51.0 / 3600.0) * dms},
        {"22.104+03545105", true, (35.0 + 45.0 / 60.0 + 10.5 / 3600.0) * dms},
        // 60.0" is what the instruments write for a reading rounded up to the next minute
        {"21.104+28104600", true, (281.0 + 5.0 / 60.0) * dms}, {"21.104+35959600", true, 400.0},
        {"21.105+01000000", true, 100.0 * 400.0 / 6400.0}, {"*21.102+0000000039999999", true, 399.99999},
        {"31..00+00012345", false, 12.345}, {"31..01+00010000", false, 3.048}, {"31..06+00012345", false, 1.2345},
        {"31..07+00010000", false, 0.3048}, {"31..08+00012345", false, 0.12345},
        {"*82..16+0000068623012345", false, 6862301.2345}, {"83..10-00001234", false, -1.234},
        {"43....+00001.55", false, 1.55}, {"21....+10000000", true, 100.0 * dms, AngleUnit::Degrees},
        {"21....+04530000", true, 45.5 * dms, AngleUnit::Dms}, {"21....+32000000", true, 200.0, AngleUnit::Mils},
        {"21.100+10000000", true, 100.0}, {"31....+00010000", false, 3.048, AngleUnit::Grads, DistanceUnit::Feet}};
    // clang-format on
    for (const Case& c : cases) {
        const Word word = OneWord(c.word);
        double value = 0.0;
        const Value read =
            c.angle ? ReadAngle(word, c.angleUnit, value) : ReadLength(word, c.distanceUnit, value);
        ASSERT_EQ(read, Value::Read) << c.word;
        EXPECT_NEAR(value, c.expected, c.angle ? kGradTolerance : kMetreTolerance) << c.word;
    }
}

// Dashes and blanks are missing values, zero is a value, other characters, 60 minutes and seconds past 60.0
// are no number; word 51 holds the ppm and the prism constant.
TEST(GsiValues, MissingValuesAreToldFromZeroAndFromBadNumbers) {
    // clang-format off
    const std::pair<const char*, Value> cases[] = {
        {"*31..00+00000000000-----", Value::Missing}, {"31..00+0000----", Value::Missing},
        {"31..00+--------", Value::Missing}, {"31..00+        ", Value::Missing}, {"31..00+0000000", Value::Read},
        {"31..00+00000000", Value::Read}, {"31..00+0001234X", Value::Bad}, {"31..00+00.12.34", Value::Bad},
        {"22.104+09160000", Value::Bad}, {"22.104+09100610", Value::Bad}, {"22.104+09100601", Value::Bad}};
    // clang-format on
    for (const auto& [text, expected] : cases) {
        double value = -1.0;
        const Word word = OneWord(text);
        const Value read = word.index == 22 ? ReadAngle(word, AngleUnit::Grads, value)
                                            : ReadLength(word, DistanceUnit::Metres, value);
        EXPECT_EQ(read, expected) << text;
        if (expected == Value::Read) {
            EXPECT_EQ(value, 0.0) << text;
        }
    }
    // clang-format off
    const std::tuple<const char*, Value, double, double> ppmCases[] = {
        {"51..1.+0000+034", Value::Read, 0.0, 34.0}, {"*51....+000000000017+000", Value::Read, 17.0, 0.0},
        {"51....-0012-017", Value::Read, -12.0, -17.0}, {"*51....+00000000000-----", Value::Missing, 0, 0},
        {"51....+00A0+034", Value::Bad, 0.0, 0.0}};
    // clang-format on
    for (const auto& [text, expected, ppm, prism] : ppmCases) {
        double readPpm = 0.0, readPrism = 0.0;
        EXPECT_EQ(ReadPpmAndPrism(OneWord(text), readPpm, readPrism), expected) << text;
        if (expected == Value::Read) {
            EXPECT_EQ(std::pair(readPpm, readPrism), std::pair(ppm, prism)) << text;
        }
    }
}

// The words of a GSI block and their values. Every expected value is worked out by hand from the unit
// digit's definition (decimals, 400 gr = 360° = 6400 mils, 1 ft = 0.3048 m), never taken from a run.
#include "fieldbook/LectWildValues.h"
#include "fieldbook/LectWildWord.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

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

std::vector<std::string> Datas(const Block& block) {
    std::vector<std::string> datas;
    for (const Word& word : block)
        datas.emplace_back(word.data);
    return datas;
}

} // namespace

TEST(GsiWords, ABlockIsCutIntoItsWordsInGsi8AndGsi16) {
    Block block;
    std::string_view bad;
    ASSERT_TRUE(SplitBlock("110012+0000A 12 21.102+11545200 31..00+00005165   ", block, bad));
    EXPECT_FALSE(block.gsi16);
    ASSERT_EQ(block.count, 3u);
    EXPECT_EQ(Datas(block), (std::vector<std::string>{"0000A 12", "11545200", "00005165"}));
    EXPECT_EQ(block.words[0].index, 11);
    EXPECT_EQ(block.words[0].info, "0012"); // the block number
    EXPECT_EQ(block.words[0].unit, 0);
    EXPECT_EQ(block.words[1].index, 21);
    EXPECT_EQ(block.words[1].unit, '2');
    EXPECT_EQ(block.words[2].unit, '0');

    ASSERT_TRUE(
        SplitBlock("*110002+00000000GDEM5415 21.024+0000000003545100 83..10-0000000000001234 ", block, bad));
    EXPECT_TRUE(block.gsi16);
    ASSERT_EQ(block.count, 3u);
    EXPECT_EQ(block.words[0].data, "00000000GDEM5415");
    EXPECT_EQ(block.words[1].unit, '4');
    EXPECT_EQ(block.words[2].sign, '-');
    EXPECT_EQ(block.words[2].text, "83..10-0000000000001234");
}

TEST(GsiWords, ThreeDigitIndicesShortenedHeadersAndCutLinesAreRead) {
    struct Case {
        const char* line;
        std::vector<int> indices;
        std::vector<std::string> datas;
    };
    const Case cases[] = {
        // Levelling readings carry three digits; 11 and 41 keep their block number.
        {"110004+000000A1 331.08+00123456 32...8+00250000",
         {11, 331, 32},
         {"000000A1", "00123456", "00250000"}},
        {"410004+00000013 42....+0000TREE", {41, 42}, {"00000013", "0000TREE"}},
        // Headers without their dots: the sign ends them.
        {"11+00000100 21+11545200 22.2+09885300", {11, 21, 22}, {"00000100", "11545200", "09885300"}},
        {"31+000-----", {31}, {"000-----"}}, // a dash where the sign of a full header would stand
        // A last word cut short, and an id holding blanks at the end of a line without its blanks.
        {"110001+00000100 21.102+1154", {11, 21}, {"00000100", "1154"}},
        {"21.102+11545200 110001+  A  12", {21, 11}, {"11545200", "  A  12"}},
        // A GSI-16 block without its star: the data runs to the next word.
        {"110002+00000000GDEM5415 21.024+0000000003545100",
         {11, 21},
         {"00000000GDEM5415", "0000000003545100"}},
    };
    for (const Case& c : cases) {
        Block block;
        std::string_view bad;
        ASSERT_TRUE(SplitBlock(c.line, block, bad)) << c.line;
        EXPECT_EQ(block.gsi16, block.words[0].data.size() == 16) << c.line;
        std::vector<int> indices;
        for (const Word& word : block)
            indices.push_back(word.index);
        EXPECT_EQ(indices, c.indices) << c.line;
        EXPECT_EQ(Datas(block), c.datas) << c.line;
    }
    EXPECT_EQ(OneWord("22.2+09885300").unit, '2');
    EXPECT_EQ(OneWord("21+11545200").unit, 0);
}

TEST(GsiWords, AWordWithoutIndexOrSignIsNoWord) {
    for (const char* line : {"110001+00000100 2X.102+11545200", "110001+00000100 21.1020011545200",
                             "Station 1", "110001+00000100 +11545200"}) {
        Block block;
        std::string_view bad;
        EXPECT_FALSE(SplitBlock(line, block, bad)) << line;
        EXPECT_FALSE(bad.empty()) << line;
    }
}

TEST(GsiValues, EveryUnitDigitGivesGradsAndMetres) {
    struct Case {
        const char* word;
        bool angle;
        double expected;
    };
    const Case cases[] = {
        {"21.102+11545200", true, 115.452},                                              // grads, 5 decimals
        {"21.103+09000000", true, 100.0},                                                // 90.00000°
        {"21.103+04512345", true, 45.12345 * 400.0 / 360.0},                             // decimal degrees
        {"22.104+09117510", true, (91.0 + 17.0 / 60.0 + 51.0 / 3600.0) * 400.0 / 360.0}, // 91°17'51.0"
        {"22.104+03545105", true, (35.0 + 45.0 / 60.0 + 10.5 / 3600.0) * 400.0 / 360.0}, // 35°45'10.5"
        {"21.105+32000000", true, 200.0},                                                // 3200.0000 mils
        {"21.105+01000000", true, 100.0 * 400.0 / 6400.0},                               // 100 mils
        {"*21.102+0000000039999999", true, 399.99999},
        {"31..00+00012345", false, 12.345},                // metre, mm
        {"31..01+00010000", false, 3.048},                 // 10.000 ft
        {"31..06+00012345", false, 1.2345},                // metre, 0.1 mm
        {"31..07+00010000", false, 0.3048},                // 1.0000 ft
        {"31..08+00012345", false, 0.12345},               // metre, 0.01 mm
        {"*81..10+0000000652301234", false, 652301.234},   // a Lambert-93 easting
        {"*82..16+0000068623012345", false, 6862301.2345}, // its northing to 0.1 mm
        {"83..10-00001234", false, -1.234},
        {"43....+00001.55", false, 1.55}, // typed with its decimal point
    };
    for (const Case& c : cases) {
        const Word word = OneWord(c.word);
        double value = 0.0;
        const Value read = c.angle ? ReadAngle(word, AngleUnit::Grads, value)
                                   : ReadLength(word, DistanceUnit::Metres, value);
        ASSERT_EQ(read, Value::Read) << c.word;
        EXPECT_NEAR(value, c.expected, c.angle ? kGradTolerance : kMetreTolerance) << c.word;
    }
}

TEST(GsiValues, WithoutAUnitDigitTheSettingsSayTheUnit) {
    double value = 0.0;
    ASSERT_EQ(ReadAngle(OneWord("21....+10000000"), AngleUnit::Degrees, value), Value::Read);
    EXPECT_NEAR(value, 100.0 * 400.0 / 360.0, kGradTolerance);
    ASSERT_EQ(ReadAngle(OneWord("21....+04530000"), AngleUnit::Dms, value), Value::Read);
    EXPECT_NEAR(value, 45.5 * 400.0 / 360.0, kGradTolerance);
    ASSERT_EQ(ReadAngle(OneWord("21....+32000000"), AngleUnit::Mils, value), Value::Read);
    EXPECT_NEAR(value, 200.0, kGradTolerance);
    ASSERT_EQ(ReadLength(OneWord("31....+00010000"), DistanceUnit::Feet, value), Value::Read);
    EXPECT_NEAR(value, 3.048, kMetreTolerance);
    // A unit digit of the other kind is no unit of this word.
    ASSERT_EQ(ReadAngle(OneWord("21.100+10000000"), AngleUnit::Grads, value), Value::Read);
    EXPECT_NEAR(value, 100.0, kGradTolerance);
}

TEST(GsiValues, DashesAndBlanksAreMissingAndOtherCharactersAreNoNumber) {
    struct Case {
        const char* word;
        Value expected;
    };
    const Case cases[] = {
        {"*31..00+00000000000-----", Value::Missing},
        {"31..00+0000----", Value::Missing},
        {"31..00+--------", Value::Missing},
        {"31..00+        ", Value::Missing},
        {"31..00+0000000", Value::Read},
        {"31..00+00000000", Value::Read},
        {"31..00+0001234X", Value::Bad},
        {"31..00+00.12.34", Value::Bad},
        {"22.104+09160000", Value::Bad}, // 60 minutes
        {"22.104+09100600", Value::Bad}, // 60 seconds
    };
    for (const Case& c : cases) {
        double value = -1.0;
        const Word word = OneWord(c.word);
        const Value read = word.index == 22 ? ReadAngle(word, AngleUnit::Grads, value)
                                            : ReadLength(word, DistanceUnit::Metres, value);
        EXPECT_EQ(read, c.expected) << c.word;
        if (c.expected == Value::Read) {
            EXPECT_EQ(value, 0.0) << c.word; // zero is a value
        }
    }
}

TEST(GsiValues, PpmAndPrismConstantShareWord51) {
    struct Case {
        const char* word;
        double ppm, prism;
    };
    const Case cases[] = {
        {"51..1.+0000+034", 0.0, 34.0},
        {"*51....+000000000017+000", 17.0, 0.0},
        {"51....-0012-017", -12.0, -17.0},
    };
    for (const Case& c : cases) {
        double ppm = 0.0, prism = 0.0;
        ASSERT_EQ(ReadPpmAndPrism(OneWord(c.word), ppm, prism), Value::Read) << c.word;
        EXPECT_EQ(ppm, c.ppm) << c.word;
        EXPECT_EQ(prism, c.prism) << c.word;
    }
    double ppm = 0.0, prism = 0.0;
    EXPECT_EQ(ReadPpmAndPrism(OneWord("*51....+00000000000-----"), ppm, prism), Value::Missing);
    EXPECT_EQ(ReadPpmAndPrism(OneWord("51....+00A0+034"), ppm, prism), Value::Bad);
}

TEST(GsiValues, TextsLoseTheirPaddingOnly) {
    EXPECT_EQ(WordText(OneWord("110001+0000A007")), "A007");
    EXPECT_EQ(WordText(OneWord("110001+00000007")), "7"); // zeros pad every id: 007 and 7 read alike
    EXPECT_EQ(WordText(OneWord("110001+  A  12 ")), "A  12");
    EXPECT_EQ(WordText(OneWord("110001+00001.50")), "1.50");
    EXPECT_EQ(WordText(OneWord("110001+00000000")), "0");
    EXPECT_EQ(WordText(OneWord("*110001+00000000GDEM5415")), "GDEM5415");
}

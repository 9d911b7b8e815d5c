#include "core/Files.h"
#include "core/Lines.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

using namespace pyr;

TEST(TextEncoding, Windows1252BytesBecomeTheirUtf8Letters) {
    // "Opérateur : Lefèvre, 12 €" as a Windows machine writes it.
    std::string ansi = "Op\xE9rateur : Lef\xE8vre, 12 \x80";
    EXPECT_FALSE(IsValidUtf8(ansi));
    bool converted = false;
    EXPECT_EQ(FileBytesToUtf8(ansi, &converted), "Opérateur : Lefèvre, 12 €");
    EXPECT_TRUE(converted);
    // The holes of the code page are kept as the control characters of the same number.
    EXPECT_EQ(Windows1252ToUtf8("\x81"), "\xC2\x81");
}

TEST(TextEncoding, Utf8IsKeptAndItsByteOrderMarkDropped) {
    bool converted = true;
    EXPECT_EQ(FileBytesToUtf8("\xEF\xBB\xBFGéoBase", &converted), "GéoBase");
    EXPECT_FALSE(converted);
    EXPECT_FALSE(IsValidUtf8("\xC0\xAF"));            // overlong
    EXPECT_FALSE(IsValidUtf8("\xED\xA0\x80"));        // surrogate
    EXPECT_FALSE(IsValidUtf8("\xE9t\xE9"));           // Latin-1 "été"
    EXPECT_TRUE(IsValidUtf8("été \xF0\x9F\x93\x90")); // 4-byte sequence
}

TEST(TextEncoding, PaddingCountsCharactersNotBytes) {
    EXPECT_EQ(Utf8Length("Référence"), 9u);
    // Counted eight bytes at a time: characters of every length across the edges of the words.
    EXPECT_EQ(Utf8Length("Point levé près de l'église, côté nord \xF0\x9F\x93\x90 ÀÉÈ"), 44u);
    EXPECT_EQ(Utf8Length("1234567é"), 8u);
    EXPECT_EQ(Utf8Length(""), 0u);
    EXPECT_EQ(FindNonAscii("abcdefghijklmnopé"), 16u);
    EXPECT_EQ(FindNonAscii("abcé"), 3u);
    EXPECT_TRUE(IsAscii("seulement de l'ASCII, plus de huit octets"));
    EXPECT_EQ(PadRight("Référence", 12), "Référence   ");
    EXPECT_EQ(PadRight("Station", 3), "Station");
}

TEST(Lines, EveryLineEndIsALineEnd) {
    std::vector<std::pair<std::string, int>> lines;
    ForEachLine("a\nb\r\nc\rd\r\re",
                [&](std::string_view l, int n) { lines.emplace_back(std::string(l), n); });
    std::vector<std::pair<std::string, int>> expected{{"a", 1}, {"b", 2}, {"c", 3},
                                                      {"d", 4}, {"", 5},  {"e", 6}};
    EXPECT_EQ(lines, expected);
    int count = 0;
    ForEachLine("", [&](std::string_view, int) { ++count; });
    ForEachLine("x\n", [&](std::string_view, int) { ++count; });
    EXPECT_EQ(count, 1);
}

TEST(Files, ExtensionsAreReplacedInTheFileNameOnly) {
    EXPECT_EQ(ReplaceExtension("/chantiers/job.geo", "bak"), "/chantiers/job.bak");
    EXPECT_EQ(ReplaceExtension("/chantiers/v1.2/job", "tmp"), "/chantiers/v1.2/job.tmp");
    EXPECT_EQ(ReplaceExtension("C:\\Releves\\job.gsi", "geo"), "C:\\Releves\\job.geo");
    EXPECT_EQ(SystemErrorText(2), "fichier ou dossier inexistant");
}

TEST(FindControl, FindsTheFirstControlOfTheSetPastOtherControlsAndBlanks) {
    const std::string_view ends{"\x03\x04\x1a", 3};
    EXPECT_EQ(FindControl("pas de fin de transmission\t\r\n", ends), std::string_view::npos);
    EXPECT_EQ(FindControl("\t\t\t\t\t\t\t\t\t\ttexte\x1a", ends), 15u);
    EXPECT_EQ(FindControl("110001+0000000000000001 \x03 suite\x04", ends), 24u);
    EXPECT_EQ(FindControl("", ends), std::string_view::npos);
}

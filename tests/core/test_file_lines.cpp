// A file read by chunks gives the lines the whole text gives, wherever the chunks end: in a CRLF, inside a
// UTF-8 letter, in the byte-order mark, or within a line longer than a chunk; and its encoding is told
// from all its bytes, even when the first letter outside ASCII lies chunks away from the start.
#include "TestSupport.h"
#include "core/FileLines.h"
#include "core/Lines.h"
#include "core/TextEncoding.h"

#include <cerrno>
#include <gtest/gtest.h>
#include <string>
#include <unistd.h>
#include <vector>

using namespace pyr;

namespace {

struct Seen {
    std::vector<std::string> lines;
    std::vector<std::uint64_t> ends;
    bool unterminated = false;
    int windows1252 = 0;
};

Seen ReadByChunks(const std::string& path, std::size_t chunkBytes) {
    Seen seen;
    FileLines file(chunkBytes);
    EXPECT_TRUE(file.Open(path));
    EXPECT_TRUE(file.ForEach(
        [&](const FileLines::Line& line) {
            EXPECT_EQ(line.number, static_cast<int>(seen.lines.size()) + 1);
            EXPECT_FALSE(seen.unterminated) << "a line after the last one";
            seen.lines.emplace_back(line.text);
            seen.ends.push_back(line.end);
            seen.unterminated = line.unterminated;
        },
        [&] {
            EXPECT_EQ(seen.windows1252, 0) << "said twice";
            ++seen.windows1252;
        }));
    return seen;
}

// What the whole text, cut by ForEachLine, gives: the lines in UTF-8, and where each ends in the bytes.
Seen ReadWhole(std::string_view bytes) {
    Seen seen;
    std::size_t bom = 0;
    if (bytes.starts_with("\xEF\xBB\xBF")) bom = 3;
    std::string_view text = bytes.substr(bom);
    const bool utf8 = IsValidUtf8(text);
    seen.windows1252 = utf8 ? 0 : 1;
    ForEachLine(text, [&](std::string_view line, int) {
        seen.lines.push_back(utf8 ? std::string(line) : Windows1252ToUtf8(line));
        std::size_t end = static_cast<std::size_t>(line.data() - text.data()) + line.size();
        if (end < text.size() && text[end] == '\r' && end + 1 < text.size() && text[end + 1] == '\n') ++end;
        seen.ends.push_back(bom + std::min(end + 1, text.size()));
        seen.unterminated = end == text.size();
    });
    return seen;
}

} // namespace

TEST(FileLines, EveryChunkSizeGivesTheLinesOfTheWholeText) {
    const std::string longLine(40, 'x');
    const std::vector<std::string> texts = {
        "",
        "a",
        "\r\n",
        "un\r\ndeux\r\ntrois\r\n",
        "un\ndeux\rtrois\r\n\r\nquatre", // every line end, an empty line, a last line without an end
        "fin en CR seul\r",
        "\xEF\xBB\xBF"
        "avec BOM\r\nlevé\r\n",                                              // a BOM, then UTF-8
        "COMMENTAIRE;" + longLine + "\r\nLev\xE9 \xE0 " + longLine + "\r\n", // Windows-1252 far down
        "ascii\r\n" + longLine + "\r\nch\xC3\xA2teau \xE2\x82\xAC\r\n" +
            longLine, // UTF-8 letters of 2 and 3 bytes
        "coup\xC3",   // a file ending in the middle of a letter is not UTF-8
        "tab\tbed\x0B\x0C\tline\r\nnext\n",
    };
    TempDir dir;
    for (const std::string& text : texts) {
        const std::string path = dir / "carnet.txt";
        WriteBytes(path, text);
        const Seen whole = ReadWhole(text);
        for (std::size_t chunk : {1, 2, 3, 4, 5, 7, 8, 9, 16, 64, 1 << 20}) {
            SCOPED_TRACE(::testing::Message()
                         << "texte " << ::testing::PrintToString(text) << ", par " << chunk);
            const Seen read = ReadByChunks(path, chunk);
            EXPECT_EQ(read.lines, whole.lines);
            EXPECT_EQ(read.ends, whole.ends);
            EXPECT_EQ(read.unterminated, whole.unterminated);
            EXPECT_EQ(read.windows1252, whole.windows1252);
        }
    }
}

TEST(FileLines, APipeIsReadWholeAndCutTheSameWay) {
    const std::string text = "COMMENTAIRE;Lev\xE9\r\nPOINT;1;2;3\rfin";
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    ASSERT_EQ(write(ends[1], text.data(), text.size()), static_cast<ssize_t>(text.size()));
    close(ends[1]);
    const Seen read = ReadByChunks("/proc/self/fd/" + std::to_string(ends[0]), 4);
    close(ends[0]);
    const Seen whole = ReadWhole(text);
    EXPECT_EQ(read.lines, whole.lines);
    EXPECT_EQ(read.ends, whole.ends);
    EXPECT_TRUE(read.unterminated);
    EXPECT_EQ(read.windows1252, 1);
}

TEST(FileLines, AFolderOrAMissingFileIsNotOpened) {
    TempDir dir;
    FileLines folder;
    EXPECT_FALSE(folder.Open(dir.Root().string()));
    EXPECT_EQ(errno, EISDIR);
    FileLines missing;
    EXPECT_FALSE(missing.Open(dir / "absent.txt"));
    EXPECT_EQ(errno, ENOENT);
}

TEST(FindLineEnd, FindsTheFirstLineEndPastTabulationsAndOtherControls) {
    const std::string text = "\t\x0B\x0C\x01\x02\x03\x04\x05 abcdefgh\tij\rk\nl";
    EXPECT_EQ(FindLineEnd(text.data(), text.data() + text.size()) - text.data(), text.find('\r'));
    const std::string none = "\t\t\t\t\t\t\t\t\t\tabc";
    EXPECT_EQ(FindLineEnd(none.data(), none.data() + none.size()), none.data() + none.size());
}

#pragma once

#include "core/Lines.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace pyr {

// A text file read line by line through a buffer of a few megabytes, never whole: a field book of a
// million lines is as large as the GéoBase made of it, and holding both at once would double what a
// conversion needs. Lines are cut as ForEachLine cuts them (LF, CRLF or a lone CR, a last line without an
// end still a line) and handed over as UTF-8: a leading byte-order mark is dropped, and a file that is not
// valid UTF-8 is read as Windows-1252, as a whole (the lines before its first letter outside ASCII are the
// same in both). Only what is told from all the bytes of the file needs a look ahead: where the first such
// letter lies, the rest of the file is read once to know whether it is valid UTF-8.
class FileLines {
public:
    // `chunkBytes`: how many bytes are read at a time.
    explicit FileLines(std::size_t chunkBytes = kChunkBytes)
        : m_chunkBytes(chunkBytes > 0 ? chunkBytes : 1) {}
    ~FileLines();
    FileLines(const FileLines&) = delete;
    FileLines& operator=(const FileLines&) = delete;

    // False, with errno telling why, when the file cannot be opened for reading or is a folder.
    bool Open(const std::string& path);
    // The size of the file when opened (0 for what is not a regular file).
    std::uint64_t Size() const { return m_size; }

    struct Line {
        std::string_view text;     // without its end, UTF-8
        int number = 0;            // from 1
        std::uint64_t end = 0;     // the offset in the file just past the line and its end
        bool unterminated = false; // the last line, ending the file without a line end
    };
    // Calls `each` for every line, in order, and `windows1252` once, before the first line converted,
    // when the file proves not to be UTF-8. False when a read fails (errno tells why): the lines handed
    // over until then stand.
    bool ForEach(const std::function<void(const Line&)>& each, const std::function<void()>& windows1252 = {});

    static constexpr std::size_t kChunkBytes = std::size_t{4} << 20;

private:
    bool RestIsValidUtf8(std::uint64_t from, std::string_view inBuffer);

    std::size_t m_chunkBytes;
    int m_fd = -1;
    std::uint64_t m_size = 0;
    bool m_regular = false;
};

} // namespace pyr

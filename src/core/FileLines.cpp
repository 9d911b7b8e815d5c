#include "FileLines.h"

#include "core/Files.h"
#include "core/TextEncoding.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <future>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace pyr {

namespace {

// How many bytes at the end of `bytes` begin a UTF-8 sequence that goes on beyond it (0 to 3).
std::size_t UnfinishedSequence(std::string_view bytes) {
    for (std::size_t back = 1; back <= 3 && back <= bytes.size(); ++back) {
        const auto byte = static_cast<unsigned char>(bytes[bytes.size() - back]);
        if (byte < 0x80) return 0;
        if (byte >= 0xC0) {
            const std::size_t length = byte >= 0xF0 ? 4 : byte >= 0xE0 ? 3 : 2;
            return length > back ? back : 0;
        }
    }
    return 0;
}

} // namespace

FileLines::~FileLines() {
    if (m_fd >= 0) close(m_fd);
}

bool FileLines::Open(const std::string& path) {
    if (m_fd >= 0) close(m_fd);
    m_fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (m_fd < 0) return false;
    struct stat info {};
    if (fstat(m_fd, &info) != 0) info.st_mode = 0;
    if (S_ISDIR(info.st_mode)) {
        close(m_fd);
        m_fd = -1;
        errno = EISDIR;
        return false;
    }
    m_regular = S_ISREG(info.st_mode);
    m_size = m_regular ? static_cast<std::uint64_t>(info.st_size) : 0;
    return true;
}

bool FileLines::RestIsValidUtf8(std::uint64_t from, std::string_view inBuffer) {
    // The bytes still in the buffer, then the rest of the file, a chunk at a time; a sequence cut by the
    // end of a chunk is carried over to the next.
    std::vector<char> chunk(m_chunkBytes + 4);
    std::size_t carried = UnfinishedSequence(inBuffer);
    if (!IsValidUtf8(inBuffer.substr(0, inBuffer.size() - carried))) return false;
    std::memcpy(chunk.data(), inBuffer.data() + inBuffer.size() - carried, carried);
    const int saved = errno;
    while (true) {
        const ssize_t n = pread(m_fd, chunk.data() + carried, m_chunkBytes, static_cast<off_t>(from));
        if (n < 0 && errno == EINTR) continue;
        if (n <= 0) break; // the end, or a failure the reading itself will meet and report
        from += static_cast<std::uint64_t>(n);
        const std::string_view bytes(chunk.data(), carried + static_cast<std::size_t>(n));
        const std::size_t next = UnfinishedSequence(bytes);
        if (!IsValidUtf8(bytes.substr(0, bytes.size() - next))) return false;
        std::memmove(chunk.data(), bytes.data() + bytes.size() - next, next);
        carried = next;
    }
    errno = saved;
    return carried == 0; // a file cut in the middle of a sequence is not UTF-8
}

bool FileLines::ForEach(const std::function<void(const Line&)>& each,
                        const std::function<void()>& windows1252) {
    if (m_fd < 0) {
        errno = EBADF;
        return false;
    }
    enum class Encoding { Ascii, Utf8, Windows1252 } encoding = Encoding::Ascii;
    std::size_t scanned = 0; // bytes of the text known to be ASCII, from its origin
    std::uint64_t base = 0;  // the offset in the file of the text's origin
    bool first = true;
    std::string converted;
    Line line;
    // Cuts the whole lines of `text` (at `base` in the file; all of the file when `ended`), from `from`;
    // returns how many bytes were used, the rest being the start of a line that goes on in the next chunk.
    const auto cut = [&](std::string_view text, std::size_t from, bool ended) -> std::size_t {
        if (first) {
            first = false;
            if (text.starts_with("\xEF\xBB\xBF")) from = scanned = 3;
        }
        if (encoding == Encoding::Ascii) {
            const std::size_t other = FindNonAscii(text.substr(scanned));
            scanned = other == std::string_view::npos ? text.size() : scanned + other;
            if (scanned < text.size()) {
                const std::string_view rest = text.substr(scanned);
                encoding = (ended ? IsValidUtf8(rest) : RestIsValidUtf8(base + text.size(), rest))
                               ? Encoding::Utf8
                               : Encoding::Windows1252;
                if (encoding == Encoding::Windows1252 && windows1252) windows1252();
            }
        }
        // Every whole line; a CR at the very end waits for the next byte, which may be an LF.
        const char* const end = text.data() + text.size();
        const char* p = text.data() + from;
        while (p < end) {
            const char* lineEnd = FindLineEnd(p, end);
            const char* next = nullptr;
            if (lineEnd == end) {
                if (!ended) break;
                next = end;
            } else if (*lineEnd == '\n') {
                next = lineEnd + 1;
            } else if (lineEnd + 1 < end) {
                next = lineEnd + (lineEnd[1] == '\n' ? 2 : 1);
            } else {
                if (!ended) break;
                next = end;
            }
            line.text = std::string_view(p, static_cast<std::size_t>(lineEnd - p));
            if (encoding == Encoding::Windows1252) {
                converted = Windows1252ToUtf8(line.text);
                line.text = converted;
            }
            ++line.number;
            line.end = base + static_cast<std::uint64_t>(next - text.data());
            line.unterminated = lineEnd == end;
            each(line);
            p = next;
        }
        const auto used = static_cast<std::size_t>(p - text.data());
        scanned = scanned > used ? scanned - used : 0;
        base += used;
        return used;
    };

    if (!m_regular) {
        // What cannot be read ahead (a pipe) is read whole before its lines are cut.
        std::string text;
        char block[1 << 16];
        for (ssize_t n; (n = ReadFully(m_fd, block, sizeof block)) != 0;) {
            if (n < 0) return false;
            text.append(block, static_cast<std::size_t>(n));
        }
        cut(text, 0, true);
        return true;
    }

    // Two buffers: while the lines of one are cut, the next chunk is read into the other by a second
    // thread. Each keeps, before its chunk, room for the start of a line that the previous chunk left.
    const std::size_t chunk = m_chunkBytes;
    std::size_t room = std::max<std::size_t>(chunk / 16, 16); // grown for a longer line
    std::unique_ptr<char[]> current(new char[room + chunk]);
    std::unique_ptr<char[]> ahead(new char[room + chunk]);
    const auto readAt = [fd = m_fd, chunk](char* into, std::uint64_t offset) -> ssize_t {
        std::size_t done = 0;
        while (done < chunk) {
            const ssize_t n = pread(fd, into + done, chunk - done, static_cast<off_t>(offset + done));
            if (n < 0 && errno == EINTR) continue;
            if (n < 0) return -static_cast<ssize_t>(errno != 0 ? errno : EIO); // errno is the thread's own
            if (n == 0) break;
            done += static_cast<std::size_t>(n);
        }
        return static_cast<ssize_t>(done);
    };
    std::uint64_t offset = 0; // of the next chunk
    std::size_t left = 0;     // bytes of a line begun, at the end of the room of `current`
    ssize_t n = readAt(current.get() + room, offset);
    while (true) {
        if (n < 0) {
            errno = static_cast<int>(-n);
            return false;
        }
        offset += static_cast<std::uint64_t>(n);
        // A short read is the end of the file (a file that grows meanwhile is read to where it was).
        const bool ended = static_cast<std::size_t>(n) < chunk;
        std::future<ssize_t> next;
        if (!ended) next = std::async(std::launch::async, readAt, ahead.get() + room, offset);
        char* const origin = current.get() + room - left;
        const std::size_t size = left + static_cast<std::size_t>(n);
        // The byte-order mark is looked for in three whole bytes.
        const std::size_t used = (first && size < 3 && !ended) ? 0 : cut({origin, size}, 0, ended);
        if (ended) return true;
        n = next.get();
        left = size - used;
        if (left > room) {
            // A line longer than the room: the buffers grow, the chunk just read going over.
            const std::size_t wider = 2 * left;
            std::unique_ptr<char[]> larger(new char[wider + chunk]);
            std::memcpy(larger.get() + wider, ahead.get() + room,
                        static_cast<std::size_t>(std::max<ssize_t>(n, 0)));
            ahead = std::move(larger);
            std::memcpy(ahead.get() + wider - left, origin + used, left);
            room = wider;
            current.reset(new char[room + chunk]);
        } else {
            std::memcpy(ahead.get() + room - left, origin + used, left);
        }
        std::swap(current, ahead);
    }
}

} // namespace pyr

#include "FileLines.h"

#include "core/TextEncoding.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace pyr {

namespace {

// Reads up to `size` bytes; fewer only at the end of the file or on an error.
ssize_t ReadFully(int fd, char* data, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        const ssize_t n = read(fd, data + done, size - done);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) return -1;
        if (n == 0) break;
        done += static_cast<std::size_t>(n);
    }
    return static_cast<ssize_t>(done);
}

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
    // What cannot be read ahead (a pipe) is read whole before its lines are cut.
    std::size_t capacity = m_regular ? m_chunkBytes : std::size_t{1} << 20;
    std::unique_ptr<char[]> buffer(new char[capacity]);
    std::size_t filled = 0;  // bytes in the buffer
    std::size_t scanned = 0; // bytes of the buffer known to be ASCII
    std::uint64_t base = 0;  // the offset in the file of the buffer's first byte
    bool first = true, ended = false;
    std::string converted;
    Line line;
    while (!ended) {
        if (filled == capacity) {
            // A line longer than the buffer, or a pipe read whole: the buffer grows.
            std::unique_ptr<char[]> larger(new char[capacity * 2]);
            std::memcpy(larger.get(), buffer.get(), filled);
            buffer = std::move(larger);
            capacity *= 2;
        }
        const ssize_t n = ReadFully(m_fd, buffer.get() + filled, capacity - filled);
        if (n < 0) return false;
        filled += static_cast<std::size_t>(n);
        ended = filled < capacity;
        // The byte-order mark is looked for in three whole bytes.
        if ((!m_regular || (first && filled < 3)) && !ended) continue;
        std::size_t start = 0;
        if (first) {
            first = false;
            if (filled >= 3 && std::memcmp(buffer.get(), "\xEF\xBB\xBF", 3) == 0) start = scanned = 3;
        }
        if (encoding == Encoding::Ascii) {
            const std::size_t other =
                FindNonAscii(std::string_view(buffer.get() + scanned, filled - scanned));
            scanned = other == std::string_view::npos ? filled : scanned + other;
            if (scanned < filled) {
                const std::string_view rest(buffer.get() + scanned, filled - scanned);
                encoding = (ended ? IsValidUtf8(rest) : RestIsValidUtf8(base + filled, rest))
                               ? Encoding::Utf8
                               : Encoding::Windows1252;
                if (encoding == Encoding::Windows1252 && windows1252) windows1252();
            }
        }
        // Every whole line of the buffer; a CR at its very end waits for the next byte, which may be an LF.
        const char* const end = buffer.get() + filled;
        const char* p = buffer.get() + start;
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
            line.end = base + static_cast<std::uint64_t>(next - buffer.get());
            line.unterminated = lineEnd == end;
            each(line);
            p = next;
        }
        // What is left, the beginning of a line, goes to the front of the buffer.
        const auto used = static_cast<std::size_t>(p - buffer.get());
        std::memmove(buffer.get(), p, filled - used);
        filled -= used;
        scanned = scanned > used ? scanned - used : 0;
        base += used;
    }
    return true;
}

} // namespace pyr

#include "core/SafeFile.h"

#include "core/Files.h"
#include "core/Strings.h"

#include <cerrno>
#include <climits>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace pyr {

namespace {

// The temporary files being written, so that a signal handler may remove them before the program ends.
// Fixed buffers: a handler may neither allocate nor lock.
constexpr int kPendingSlots = 8;
char g_pending[kPendingSlots][PATH_MAX];
volatile std::sig_atomic_t g_pendingUsed[kPendingSlots];

int RegisterPending(const std::string& path) {
    if (path.size() >= PATH_MAX) return -1;
    for (int i = 0; i < kPendingSlots; ++i) {
        if (g_pendingUsed[i]) continue;
        std::memcpy(g_pending[i], path.c_str(), path.size() + 1);
        g_pendingUsed[i] = 1;
        return i;
    }
    return -1;
}

void ReleasePending(int& slot) {
    if (slot >= 0) g_pendingUsed[slot] = 0;
    slot = -1;
}

// The file a path names, symbolic links followed; the path itself when it is no link (or a link to
// nowhere yet, which then makes a file at the link's place).
std::string FollowLinks(const std::string& path) {
    struct stat info {};
    if (lstat(path.c_str(), &info) != 0 || !S_ISLNK(info.st_mode)) return path;
    if (char* resolved = realpath(path.c_str(), nullptr)) {
        std::string target = resolved;
        std::free(resolved);
        return target;
    }
    return path;
}

bool HasNoWriteRight(const struct stat& info, const std::string& path) {
    return (info.st_mode & 0222) == 0 || access(path.c_str(), W_OK) != 0;
}

std::string FolderOf(const std::string& path) {
    std::string folder = std::filesystem::path(path).parent_path().string();
    return folder.empty() ? std::string(".") : folder;
}

// The rename is only sure to survive a power cut once the folder that holds it is on the disk. A file
// system that cannot sync a folder (some network ones) is not a failure: the rename is done.
void SyncFolder(const std::string& folder) {
    const int fd = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (fd < 0) return;
    fsync(fd);
    close(fd);
}

bool CopyInto(int from, std::FILE* to) {
    char buffer[1 << 16];
    while (true) {
        const ssize_t n = read(from, buffer, sizeof buffer);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) return false;
        if (n == 0) return true;
        if (std::fwrite(buffer, 1, static_cast<size_t>(n), to) != static_cast<size_t>(n)) return false;
    }
}

} // namespace

std::string FileWriteFailure(const std::string& path, int code) {
    const bool exists = FileExists(path);
    return Sprintf("Impossible d'écrire le fichier\n<%s>\n(%s).%s", path.c_str(),
                   SystemErrorText(code).c_str(), exists ? "\nLe fichier est resté tel qu'il était." : "");
}

bool IsReadOnlyFile(const std::string& path) {
    const std::string target = FollowLinks(path);
    struct stat info {};
    return stat(target.c_str(), &info) == 0 && S_ISREG(info.st_mode) && HasNoWriteRight(info, target);
}

SafeFileWriter::SafeFileWriter(std::string path, Start start) : m_path(std::move(path)) {
    if (m_path.empty()) {
        Fail(ENOENT);
        return;
    }
    m_target = FollowLinks(m_path);
    struct stat info {};
    m_exists = stat(m_target.c_str(), &info) == 0;
    if (m_exists) {
        if (S_ISDIR(info.st_mode)) {
            Fail(EISDIR);
            return;
        }
        if (!S_ISREG(info.st_mode)) {
            Fail(EINVAL);
            return;
        }
        if (HasNoWriteRight(info, m_target)) {
            Fail(EACCES);
            return;
        }
        m_mode = info.st_mode & 07777;
        m_uid = info.st_uid;
        m_gid = info.st_gid;
    } else if (errno != ENOENT) {
        Fail(errno);
        return;
    } else {
        const mode_t mask = umask(0);
        umask(mask);
        m_mode = 0666 & ~mask;
    }

    // A hidden name of the target's, with a suffix that mkostemp makes unique: never a file already there.
    const std::filesystem::path target(m_target);
    std::string temporary =
        (std::filesystem::path(FolderOf(m_target)) / ("." + target.filename().string() + ".XXXXXX")).string();
    const int fd = mkostemp(temporary.data(), O_CLOEXEC);
    if (fd < 0) {
        Fail(errno);
        return;
    }
    m_temporary = std::move(temporary);
    m_slot = RegisterPending(m_temporary);
    m_file = fdopen(fd, "wb");
    if (!m_file) {
        const int code = errno;
        close(fd);
        Abandon();
        Fail(code);
        return;
    }
    if (start == Start::CopyOfFile && m_exists) {
        const int from = open(m_target.c_str(), O_RDONLY | O_CLOEXEC);
        if (from < 0 || !CopyInto(from, m_file)) {
            const int code = errno != 0 ? errno : EIO;
            if (from >= 0) close(from);
            Abandon();
            Fail(code);
            return;
        }
        close(from);
    }
}

SafeFileWriter::~SafeFileWriter() {
    Abandon();
}

bool SafeFileWriter::Fail(int code) {
    if (m_error == 0) m_error = code != 0 ? code : EIO;
    return false;
}

bool SafeFileWriter::Write(std::string_view bytes) {
    if (!m_file || m_error != 0) return false;
    if (std::fwrite(bytes.data(), 1, bytes.size(), m_file) != bytes.size()) return Fail(errno);
    return true;
}

bool SafeFileWriter::WriteThrough(std::string_view bytes) {
    if (!m_file || m_error != 0) return false;
    const int fd = fileno(m_file);
    if (!m_through) {
        if (std::fflush(m_file) != 0) return Fail(errno);
        const off_t position = lseek(fd, 0, SEEK_CUR);
        if (position < 0) return Fail(errno);
        m_position = m_sent = position;
        m_through = true;
    }
    while (!bytes.empty()) {
        const ssize_t n = write(fd, bytes.data(), bytes.size());
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) return Fail(errno);
        if (n == 0) return Fail(EIO);
        bytes.remove_prefix(static_cast<size_t>(n));
        m_position += n;
    }
#ifdef SYNC_FILE_RANGE_WRITE
    // A few megabytes at a time: the disk works while the next ones are made. Only a start: Commit's
    // fsync is what makes them safe, and a system that cannot do it loses nothing.
    constexpr long long kWriteBackStep = 4 << 20;
    if (m_position - m_sent >= kWriteBackStep) {
        const int saved = errno;
        sync_file_range(fd, m_sent, m_position - m_sent, SYNC_FILE_RANGE_WRITE);
        errno = saved;
        m_sent = m_position;
    }
#endif
    return true;
}

bool SafeFileWriter::Commit() {
    if (!m_file) return Fail(EIO);
    const int fd = fileno(m_file);
    bool ok = m_error == 0;
    if (ok && std::fflush(m_file) != 0) ok = Fail(errno);
    if (ok && std::ferror(m_file)) ok = Fail(EIO);
    if (ok && fchmod(fd, m_mode) != 0) ok = Fail(errno);
    if (ok && m_exists && geteuid() == 0) {
        [[maybe_unused]] const int ignored = fchown(fd, m_uid, m_gid);
    }
    if (ok && fsync(fd) != 0) ok = Fail(errno);
    const int closed = std::fclose(m_file);
    m_file = nullptr;
    if (ok && closed != 0) ok = Fail(errno);
    if (ok && rename(m_temporary.c_str(), m_target.c_str()) != 0) ok = Fail(errno);
    if (!ok) {
        Abandon();
        return false;
    }
    ReleasePending(m_slot);
    m_temporary.clear();
    SyncFolder(FolderOf(m_target));
    return true;
}

void SafeFileWriter::Abandon() {
    if (m_file) {
        std::fclose(m_file);
        m_file = nullptr;
    }
    if (!m_temporary.empty()) {
        unlink(m_temporary.c_str());
        m_temporary.clear();
    }
    ReleasePending(m_slot);
}

int ReplaceFileContents(const std::string& path, std::string_view bytes) {
    SafeFileWriter writer(path);
    writer.Write(bytes);
    return writer.Commit() ? 0 : writer.Error();
}

int AppendToFile(const std::string& path, std::string_view bytes) {
    SafeFileWriter writer(path, SafeFileWriter::Start::CopyOfFile);
    writer.Write(bytes);
    return writer.Commit() ? 0 : writer.Error();
}

int CopyFileContents(const std::string& from, const std::string& to) {
    const int source = open(from.c_str(), O_RDONLY | O_CLOEXEC);
    if (source < 0) return errno;
    SafeFileWriter writer(to);
    if (writer.File() && !CopyInto(source, writer.File())) {
        const int code = errno != 0 ? errno : EIO;
        close(source);
        return code;
    }
    close(source);
    return writer.Commit() ? 0 : writer.Error();
}

void RemovePendingTemporaryFiles() {
    for (int i = 0; i < kPendingSlots; ++i)
        if (g_pendingUsed[i]) unlink(g_pending[i]);
}

} // namespace pyr

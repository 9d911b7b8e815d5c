#include "Files.h"

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace pyr {

namespace {

// Maps the pages of a buffer about to be filled in one call rather than one fault at a time: on some
// virtual machines a page fault costs several microseconds, which made reading a big file slower than
// interpreting it. Only a hint: nothing changes where the system does not know it.
void PrepareForWriting(char* data, size_t size) {
#ifdef MADV_POPULATE_WRITE
    const auto page = static_cast<uintptr_t>(sysconf(_SC_PAGESIZE));
    const uintptr_t begin = (reinterpret_cast<uintptr_t>(data) + page - 1) & ~(page - 1);
    const uintptr_t end = (reinterpret_cast<uintptr_t>(data) + size) & ~(page - 1);
    if (end > begin) {
        int saved = errno;
        madvise(reinterpret_cast<void*>(begin), end - begin, MADV_POPULATE_WRITE);
        errno = saved;
    }
#else
    (void)data;
    (void)size;
#endif
}

} // namespace

ssize_t ReadFully(int fd, char* data, size_t size) {
    size_t done = 0;
    while (done < size) {
        ssize_t n = read(fd, data + done, size - done);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) return -1;
        if (n == 0) break;
        done += static_cast<size_t>(n);
    }
    return static_cast<ssize_t>(done);
}

bool ReadWholeFile(const std::string& path, std::string& bytes) {
    int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return false;
    bytes.clear();
    struct stat info {};
    if (fstat(fd, &info) == 0 && S_ISDIR(info.st_mode)) {
        close(fd);
        errno = EISDIR;
        return false;
    }
    bool ok = true;
    // A regular file is read straight into a buffer of its size; whatever follows (a file that grew
    // meanwhile, a pipe) is read by blocks.
    if (S_ISREG(info.st_mode) && info.st_size > 0) {
        const auto size = static_cast<size_t>(info.st_size);
        bytes.reserve(size);
        PrepareForWriting(bytes.data(), size);
        bytes.resize(size);
        ssize_t n = ReadFully(fd, bytes.data(), size);
        ok = n >= 0;
        bytes.resize(ok ? static_cast<size_t>(n) : 0);
    }
    char buffer[1 << 16];
    while (ok) {
        ssize_t n = ReadFully(fd, buffer, sizeof buffer);
        if (n < 0) ok = false;
        if (n <= 0) break;
        bytes.append(buffer, static_cast<size_t>(n));
    }
    int saved = errno;
    close(fd);
    errno = saved;
    return ok;
}

bool FileExists(const std::string& path) {
    struct stat info {};
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode);
}

std::string SystemErrorText(int errnum) {
    switch (errnum) {
    case ENOENT:
        return "fichier ou dossier inexistant";
    case EACCES:
    case EPERM:
        return "accès refusé";
    case EISDIR:
        return "c'est un dossier, pas un fichier";
    case ENOTDIR:
        return "un élément du chemin n'est pas un dossier";
    case ENOSPC:
        return "plus de place sur le disque";
    case EROFS:
        return "support en lecture seule";
    case ENAMETOOLONG:
        return "nom de fichier trop long";
    case EMFILE:
    case ENFILE:
        return "trop de fichiers ouverts";
    case EIO:
        return "erreur d'entrée-sortie";
    case EFBIG:
        return "fichier trop grand pour la limite de taille permise";
    case EDQUOT:
        return "quota du disque dépassé";
    case EEXIST:
        return "un fichier de ce nom existe déjà";
    case ELOOP:
        return "trop de liens symboliques";
    case EBUSY:
    case ETXTBSY:
        return "fichier en cours d'utilisation";
    case EXDEV:
        return "déplacement impossible d'un disque à un autre";
    case EINVAL:
        return "ce n'est pas un fichier ordinaire";
    case ENOTEMPTY:
        return "dossier non vide";
    case ENXIO:
    case ENODEV:
        return "périphérique absent";
    default:
        return "erreur du système (code " + std::to_string(errnum) + ")";
    }
}

std::string ReplaceExtension(const std::string& path, const std::string& extension) {
    size_t nameStart = path.find_last_of("/\\");
    nameStart = nameStart == std::string::npos ? 0 : nameStart + 1;
    size_t dot = path.rfind('.');
    std::string stem = (dot != std::string::npos && dot > nameStart) ? path.substr(0, dot) : path;
    return stem + "." + extension;
}

std::string WholePath(const std::string& path) {
    std::error_code error;
    const std::filesystem::path whole = std::filesystem::absolute(path, error);
    return error ? path : whole.lexically_normal().string();
}

} // namespace pyr

#pragma once

// The input of a fuzz target as a file that a reader opens by its path, without touching a disk.
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace pyr::fuzz {

class MemoryFile {
public:
    MemoryFile(const char* name, std::string_view bytes) : m_fd(memfd_create(name, 0)) {
        if (m_fd < 0 || write(m_fd, bytes.data(), bytes.size()) != static_cast<ssize_t>(bytes.size())) {
            std::fputs("\n*** impossible d'écrire le fichier en mémoire\n", stderr);
            std::abort();
        }
    }
    ~MemoryFile() { close(m_fd); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    std::string Path() const { return "/proc/self/fd/" + std::to_string(m_fd); }

private:
    int m_fd;
};

} // namespace pyr::fuzz

#include "MemoryUse.h"

#include <cstdio>
#include <malloc.h>
#include <stdexcept>
#include <unistd.h>

namespace pyr::bench {

std::size_t HeapInUse() {
    struct mallinfo2 info = mallinfo2();
    return info.uordblks + info.hblkhd;
}

std::size_t ResidentBytes() {
    std::FILE* file = std::fopen("/proc/self/statm", "r");
    if (!file) return 0;
    unsigned long long total = 0, resident = 0;
    int read = std::fscanf(file, "%llu %llu", &total, &resident);
    std::fclose(file);
    return read == 2 ? static_cast<std::size_t>(resident) * static_cast<std::size_t>(sysconf(_SC_PAGESIZE))
                     : 0;
}

TemporaryFolder::TemporaryFolder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "pyr_bench.XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("impossible de créer le dossier temporaire " + pattern);
    m_path = pattern;
}

TemporaryFolder::~TemporaryFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(m_path, ignored);
}

} // namespace pyr::bench

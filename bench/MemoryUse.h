#pragma once

#include <cstddef>
#include <filesystem>
#include <string>

namespace pyr::bench {

// The bytes that the program's allocations hold now (the allocator's own count: small blocks and
// mapped ones), and the process's resident memory.
std::size_t HeapInUse();
std::size_t ResidentBytes();

// A folder of its own in the temporary folder ($TMPDIR), removed with everything in it at the end.
class TemporaryFolder {
public:
    TemporaryFolder();
    ~TemporaryFolder();
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    std::string File(const std::string& name) const { return (m_path / name).string(); }

private:
    std::filesystem::path m_path;
};

} // namespace pyr::bench

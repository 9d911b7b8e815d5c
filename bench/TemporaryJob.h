#pragma once

#include "geobase/Carnet.h"

#include <filesystem>
#include <string>
#include <system_error>
#include <unistd.h>

namespace pyr::bench {

// A folder of its own for the GéoBase and the parameters of one benchmark, removed at the end.
class TemporaryJob {
public:
    TemporaryJob(CCarnet& carnet, const std::string& name)
        : m_folder(std::filesystem::temp_directory_path() /
                   ("pyralis-bench-" + name + "-" + std::to_string(getpid()))) {
        std::filesystem::create_directories(m_folder);
        carnet.Save(GeoBase());
    }
    ~TemporaryJob() {
        std::error_code ignored;
        std::filesystem::remove_all(m_folder, ignored);
    }
    TemporaryJob(const TemporaryJob&) = delete;
    TemporaryJob& operator=(const TemporaryJob&) = delete;

    std::string GeoBase() const { return (m_folder / "job.geo").string(); }
    std::string Params() const { return (m_folder / "Pyralis.ini").string(); }
    std::string Folder() const { return m_folder.string(); }

private:
    std::filesystem::path m_folder;
};

} // namespace pyr::bench

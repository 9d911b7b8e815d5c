#pragma once

#include <string>

namespace pyr {

// Reads the whole file into `bytes`. Returns false, with errno telling why, when it cannot be read.
bool ReadWholeFile(const std::string& path, std::string& bytes);

bool FileExists(const std::string& path);

} // namespace pyr

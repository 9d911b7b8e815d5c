#pragma once

#include <cstddef>
#include <string>
#include <sys/types.h>

namespace pyr {

// Reads up to `size` bytes from `fd`, going on after an interrupted read; fewer only at the end of the
// file or on an error (-1, errno telling why).
ssize_t ReadFully(int fd, char* data, std::size_t size);

// Reads the whole file into `bytes`. Returns false, with errno telling why, when it cannot be read.
bool ReadWholeFile(const std::string& path, std::string& bytes);

bool FileExists(const std::string& path);

// A short French reason for a system error number ("fichier ou dossier inexistant").
std::string SystemErrorText(int errnum);

// The path with its extension (after the last '.' of the file name) replaced by `extension`, given
// without its dot; added when the name has none. "C:/job/chantier.geo", "bak" gives ".../chantier.bak".
std::string ReplaceExtension(const std::string& path, const std::string& extension);

// The path whole and without "." or ".." steps, as a file is recorded in the settings (the last GéoBase,
// the last parameter file): the next command finds it from whatever folder it is run. The path as given
// when the current folder cannot be known.
std::string WholePath(const std::string& path);

} // namespace pyr

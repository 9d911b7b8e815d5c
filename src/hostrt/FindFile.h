#pragma once

#include "hostrt/AcRx.h"

#include <string>
#include <string_view>
#include <vector>

// Looks for a file: first the name as given (an absolute path, or relative to the current folder), then
// relative to each folder of the support path, in order. '\' in the name is read as '/'. The found path
// is absolute and without "." or ".." steps. RTERROR when nothing is found.
int acedFindFile(std::string_view name, std::string& found);

namespace pyr {

// The folders that acedFindFile searches after the current one, in order.
void SetSupportPath(std::vector<std::string> folders);
const std::vector<std::string>& SupportPath();

} // namespace pyr

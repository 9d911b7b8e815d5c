#pragma once

#include <string>

namespace pyr {

// The user's configuration folder of the program: $XDG_CONFIG_HOME/pyralis when that variable holds an
// absolute path, else ~/.config/pyralis ($HOME, else the home folder of the user's account).
std::string PyralisConfigFolder();

} // namespace pyr

#pragma once

#include <QIcon>
#include <string>

namespace pyr::bureau {

// The icon of a command of the toolbar, drawn for it: a field book for the readings, a sheet going out
// for the exports, the sightings of the computation for the computations. Told by the local name.
QIcon CommandIcon(const std::string& localName);

} // namespace pyr::bureau

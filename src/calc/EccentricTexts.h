#pragma once

// The words of the computation of an eccentric station: the failure of the computation, and the dialog's
// and the listing's titles, columns and labels. Those with %s or %d are printf formats.
namespace pyr::excent {

// The station could not be placed: a reference sighting, the distance to the centre or the centre's X
// and Y missing, or an orientation and a place that never settle.
inline constexpr const char* kMsgNotComputed = "Le point n'a pas pu être calculé !";

} // namespace pyr::excent

#pragma once

// The words of the computation of a station by resection (its place, orientation and altitude from its
// sightings on known points): the failures of its planimetry.
// Those with %s or %d are printf formats.
namespace pyr::resec {

// Failures of the planimetry, kept as the result's status.
inline constexpr const char* kMsgTooFew = "Calcul impossible : il faut au moins trois visées !";
inline constexpr const char* kMsgAligned = "Calcul trop imprécis : les visées sont alignées";
inline constexpr const char* kMsgCocyclic = "Calcul impossible : les points sont cocycliques !";

} // namespace pyr::resec

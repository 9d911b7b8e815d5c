#pragma once

#include "fieldbook/LectZeissRecord.h"

#include <string>
#include <vector>

// Where the point id and the code lie in the information block of an M5 field book whose instrument does
// not say it in a header. Each instrument has its default (the point id ending in column 19 followed by
// its code; on others the information in 1-7, the code in 11-15, the point id in 16-27) and the surveyor
// may swap the point id and the code and move the information. The layout kept is the one that explains
// the most point lines of the book.
namespace pyr::zeiss {

// The places of the instruments that write the information first, the code in 11-15 and the point id
// in 16-27.
inline constexpr InfoPlaces kInformationCodePoint{1, 11, 16};

// The layouts tried, in the order in which they win a tie: the reader's default, then the information,
// code and point id of the instruments above, then every order of the three fields with the three free
// columns before, between or after them.
std::vector<InfoPlaces> CandidatePlaces();

// Whether `places` explain an information block (M5InfoOccupancy): a point id written and ending in its
// last column, a code, if any, against one end of its field, an information, if any, starting in its
// first column, and nothing written outside the three fields.
bool Explains(const InfoPlaces& places, const std::string& occupancy);

struct FoundPlaces {
    InfoPlaces places; // the layout kept, the reader's default when no line is explained
    int explained = 0; // the point lines that it explains
    int lines = 0;     // the point lines looked at
};

// The layout that explains the most of `occupancies` (one per point line); the first of
// CandidatePlaces() among equals.
FoundPlaces FindPlaces(const std::vector<std::string>& occupancies);

} // namespace pyr::zeiss

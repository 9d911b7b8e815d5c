#pragma once

#include <string>
#include <string_view>
#include <vector>

// The names under which a surveyor designates a projection system, and the EPSG code of each.
// Case, blanks, '-' and '_' do not matter, nor the accent of "étendu": "lambert-93", "CC 46",
// "Lambert 2 etendu", "utm 31 n" are understood.
namespace pyr {

// What a name designates: local coordinates, a projected system by its EPSG code, or nothing known
// (`error` then says why, in French).
struct ProjectionName {
    bool none = false; // "Aucune"
    int epsg = 0;
    std::string error;
};

ProjectionName ResolveProjectionName(std::string_view name);

// The names offered to a surveyor (a choice list of the options), each with its EPSG code (0 for
// "Aucune"), in the order they are offered. The UTM zones and "EPSG:nnnn" are accepted besides.
struct NamedProjection {
    const char* name;
    int epsg;
};
const std::vector<NamedProjection>& OfferedProjections();

} // namespace pyr

#pragma once

// GéoBases built from exact coordinates for the tests of the orientation of stations: every sighting is
// what a perfect instrument set up on the station would read, the zero of its horizontal circle turned
// to a chosen bearing V0. Plain plane trigonometry, not the program's helpers.
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <cmath>
#include <memory>
#include <string>

namespace pyr::test {

constexpr double kGonPerRadian = 200.0 / 3.14159265358979323846;

struct Place {
    double x, y, z;
};

inline void AddPoint(CCarnet& carnet, const std::string& name, Place p) {
    carnet.Add(std::make_unique<CPointGen>(name, p.x, p.y, p.z), kKindPoint);
}

inline int AddStation(CCarnet& carnet, const std::string& name, double hi, double v0 = -999999.0) {
    return carnet.Add(std::make_unique<CStation>(name, hi, v0), kKindStation);
}

// The reference (or measured) sighting of the target `hp` over `t` read by the instrument `hi` over `s`; the
// line of sight bends down by curvature and refraction, 0.84 / 12 768 000 m per square metre of distance.
inline int AddSighting(CCarnet& carnet, const std::string& name, Place s, double hi, Place t, double hp,
                       double v0, int kind = kKindReference) {
    const double dx = t.x - s.x, dy = t.y - s.y, horizontal = std::hypot(dx, dy);
    const double rise = (t.z + hp) - (s.z + hi) - 0.84 / 12768000.0 * horizontal * horizontal;
    const double ah = std::fmod(std::atan2(dx, dy) * kGonPerRadian - v0 + 800.0, 400.0); // clockwise
    const double av = std::atan2(horizontal, rise) * kGonPerRadian, di = std::hypot(horizontal, rise);
    if (kind == kKindMesure) return carnet.Add(std::make_unique<CMesure>(name, hp, ah, av, di), kKindMesure);
    return carnet.Add(std::make_unique<CReference>(name, hp, ah, av, di), kKindReference);
}

} // namespace pyr::test

#pragma once

// GéoBases built from exact coordinates for the tests of the orientation of stations: every sighting is
// what a perfect instrument set up on the station would read, the zero of its horizontal circle turned
// to a chosen bearing V0. Computed here with the plain trigonometry of the sphere-free plane, not with
// the program's helpers.
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <cmath>
#include <memory>
#include <string>

namespace pyr::test {

constexpr double kGonPerRadian = 200.0 / 3.14159265358979323846;
// The curvature and refraction of a line of sight, per square metre of horizontal distance.
constexpr double kCurvature = 0.84 / 12768000.0;

struct Place {
    double x, y, z;
};

struct Reading {
    double ah, av, di;
};

// What the instrument (height `hi` over the station `s`) reads on a target `hp` over the point `t`.
inline Reading Read(Place s, double hi, Place t, double hp, double v0) {
    const double dx = t.x - s.x, dy = t.y - s.y;
    const double horizontal = std::sqrt(dx * dx + dy * dy);
    double bearing = std::atan2(dx, dy) * kGonPerRadian; // clockwise from north
    const double rise = (t.z + hp) - (s.z + hi) - kCurvature * horizontal * horizontal;
    double ah = std::fmod(bearing - v0 + 800.0, 400.0);
    return {ah, std::atan2(horizontal, rise) * kGonPerRadian,
            std::sqrt(horizontal * horizontal + rise * rise)};
}

inline void AddPoint(CCarnet& carnet, const std::string& name, Place p) {
    carnet.Add(std::make_unique<CPointGen>(name, p.x, p.y, p.z), kKindPoint);
}

inline int AddStation(CCarnet& carnet, const std::string& name, double hi, double v0 = -999999.0) {
    return carnet.Add(std::make_unique<CStation>(name, hi, v0), kKindStation);
}

// A sighting of `name` read exactly; `kind` 1002 or 1003.
inline int AddSighting(CCarnet& carnet, const std::string& name, Place s, double hi, Place t, double hp,
                       double v0, int kind = kKindReference) {
    const Reading r = Read(s, hi, t, hp, v0);
    if (kind == kKindMesure) return carnet.Add(std::make_unique<CMesure>(name, hp, r.ah, r.av, r.di), kind);
    return carnet.Add(std::make_unique<CReference>(name, hp, r.ah, r.av, r.di), kind);
}

} // namespace pyr::test

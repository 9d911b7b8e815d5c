#pragma once

// What a perfect instrument reads between places known exactly, for the tests of the computations of
// points and stations: plain plane trigonometry (std::atan2), not the program's helpers.
#include "calc/Intersection.h"
#include "calc/Resection.h"
#include "test_v0_geometry.h"

#include <cmath>
#include <gtest/gtest.h>
#include <initializer_list>

namespace pyr::test {

inline constexpr double kTenthMm = 1e-4, kHundredthMm = 1e-5, kTenthMgon = 1e-4, kHundredthMgon = 1e-5;
// Curvature and refraction: the line of sight bends down by 0.84 / 12 768 000 m per square metre.
inline constexpr double kCurvature = 0.84 / 12768000.0;

// The bearing from (xa, ya) to (xb, yb), gr, clockwise from +Y, in [0, 400).
inline double BearingTo(double xa, double ya, double xb, double yb) {
    return std::fmod(std::atan2(xb - xa, yb - ya) * kGonPerRadian + 400.0, 400.0);
}
// An angle difference within [-200, 200] gr.
inline double Gap(double grads) {
    return std::remainder(grads, 400.0);
}

struct Reading {
    double ah, av, di, dh;
};
// An instrument `hi` above `from`, its circle reading 0 along the bearing `v0`, on a target `hp` above
// `to`; the line of sight bent by curvature and refraction unless told.
inline Reading Read(const Place& from, double hi, double v0, const Place& to, double hp, bool bent = true) {
    const double dh = std::hypot(to.x - from.x, to.y - from.y);
    const double rise = to.z + hp - from.z - hi - (bent ? kCurvature * dh * dh : 0.0);
    return {std::fmod(BearingTo(from.x, from.y, to.x, to.y) - v0 + 400.0, 400.0),
            std::atan2(dh, rise) * kGonPerRadian, std::hypot(dh, rise), dh};
}

// The sighting of the known point `p` from a station `hi` above `st` oriented at `v0`.
inline StationSighting SightPoint(const Place& st, double hi, double v0, const Place& p, double hp) {
    const Reading r = Read(st, hi, v0, p, hp);
    StationSighting s;
    s.x = p.x, s.y = p.y, s.z = p.z, s.hp = hp, s.ah = r.ah, s.av = r.av, s.dh = r.dh;
    return s;
}

// A station placed and oriented, and its instrument height.
struct KnownStation {
    const char* name;
    double x, y, z;
    double hi;
    double v0;
};
// The sighting of `p` on a target `hp` high, read face left from the station.
inline InterSighting SightP(const KnownStation& s, const Place& p, double hp = 0.0) {
    const Reading r = Read({s.x, s.y, s.z}, s.hi, s.v0, p, hp);
    InterSighting sighting;
    sighting.station = s.name;
    sighting.reference = "P";
    sighting.xs = s.x, sighting.ys = s.y, sighting.zs = s.z;
    sighting.v0 = s.v0, sighting.hi = s.hi, sighting.hp = hp;
    sighting.ah = r.ah, sighting.av = r.av, sighting.di = r.di, sighting.dh = r.dh;
    return sighting;
}

// Every value a number: a value or the undefined marker, never NaN or infinity.
inline void ExpectFinite(std::initializer_list<double> values) {
    for (double value : values)
        EXPECT_TRUE(std::isfinite(value)) << value;
}
inline void ExpectAllFinite(const StationResult& r) {
    ExpectFinite({r.x0, r.y0, r.v0Approx, r.x, r.y, r.v0, r.emqX, r.emqY, r.emqV0, r.sigma0, r.crossing, r.z0,
                  r.z, r.emqZ});
    for (const StationSighting& s : r.sightings)
        ExpectFinite({s.dh, s.v0, s.v, s.e, s.vz, s.ez, s.zi});
}

} // namespace pyr::test

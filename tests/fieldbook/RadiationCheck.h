#pragma once

// A read field book checked against the coordinates that its instrument computed in the field: each
// sighting is radiated from the GéoBase alone (the station's point, HI, V0, and the sighting's HP, AH, AV,
// DI) and compared with the point of the same name, which holds what the instrument recorded. A reader that
// misplaces a station, loses an instrument height, swaps the axes or drops an orientation shows here by
// metres, whatever its own tests say.
//
// The formulas are written out here, apart from the program's: face II brought to face I, the horizontal
// distance DI sin AV, the bearing V0 + AH from north clockwise, the height Zs + HI + DI cos AV - HP,
// without curvature and refraction (the books of these tests are short-range). A station without a known
// V0 is oriented on its references to points of known planimetry: the mean of bearing - AH.
#include "geobase/Carnet.h"
#include "geobase/Kinds.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace radiation {

constexpr double kPi = 3.14159265358979323846;

inline double Wrap(double grads) {
    grads = std::fmod(grads, 400.0);
    return grads < 0.0 ? grads + 400.0 : grads;
}

inline double Rad(double grads) {
    return grads * kPi / 200.0;
}

inline bool Known(double value) {
    return value > -999998.0;
}

struct Sighting {
    std::string name;
    double hp, ah, av, di;
    bool reference;
};

struct Station {
    std::string name;
    double hi, v0;
    std::vector<Sighting> sightings;
};

inline std::vector<Station> Stations(const pyr::CCarnet& carnet) {
    std::vector<Station> stations;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        if (kind == pyr::kKindStation)
            stations.push_back({carnet.matAt(i), carnet.hiAt(i), carnet.v0At(i), {}});
        if ((kind == pyr::kKindReference || kind == pyr::kKindMesure) && !stations.empty()) {
            double ah = carnet.ahAt(i), av = carnet.avAt(i);
            if (Known(av) && av > 200.0) { // face II: the circle read half a turn round
                av = 400.0 - av;
                if (Known(ah)) ah = Wrap(ah + 200.0);
            }
            stations.back().sightings.push_back(
                {carnet.matAt(i), carnet.hpAt(i), ah, av, carnet.diAt(i), kind == pyr::kKindReference});
        }
    }
    return stations;
}

// V0 from the station's own value, or from its references to points of known planimetry.
inline bool Orientation(const pyr::CCarnet& carnet, const Station& station, double x, double y, double& v0) {
    if (Known(station.v0) && station.v0 >= 0.0) {
        v0 = station.v0;
        return true;
    }
    double sumSin = 0.0, sumCos = 0.0;
    int count = 0;
    for (const Sighting& s : station.sightings) {
        double xr = 0.0, yr = 0.0;
        if (!s.reference || !Known(s.ah) || s.name == station.name || !carnet.hasXY(s.name, xr, yr)) continue;
        const double bearing = std::atan2(xr - x, yr - y);
        sumSin += std::sin(bearing - Rad(s.ah));
        sumCos += std::cos(bearing - Rad(s.ah));
        ++count;
    }
    if (count == 0) return false;
    v0 = Wrap(std::atan2(sumSin, sumCos) * 200.0 / kPi);
    return true;
}

} // namespace radiation

// The book agrees with its instrument: `compared` sightings with an angle, a zenith angle and a distance
// radiated, each within a millimetre of the coordinates recorded for its point, and no station left without
// place, orientation or height.
inline ::testing::AssertionResult AgreesWithInstrument(const pyr::CCarnet& carnet, int compared) {
    using namespace radiation;
    constexpr double kTolerance = 0.001; // m
    int radiated = 0;
    std::vector<std::string> faults;
    for (const Station& station : Stations(carnet)) {
        double xs = 0.0, ys = 0.0, zs = 0.0, v0 = 0.0;
        if (!carnet.hasXY(station.name, xs, ys) || !Orientation(carnet, station, xs, ys, v0)) {
            faults.push_back("station " + station.name + " sans coordonnées ou sans orientation");
            continue;
        }
        const bool heights = carnet.hasZ(station.name, zs) && Known(station.hi);
        bool heightLost = false; // a station with an altitude but no HI, whose points have recorded heights
        for (const Sighting& s : station.sightings) {
            double x = 0.0, y = 0.0, z = 0.0;
            if (!Known(s.ah) || !Known(s.av) || !Known(s.di) || s.di <= 0.0 || !carnet.hasXY(s.name, x, y))
                continue;
            const double dh = s.di * std::sin(Rad(s.av));
            const double bearing = Rad(v0 + s.ah);
            const double dx = xs + dh * std::sin(bearing) - x;
            const double dy = ys + dh * std::cos(bearing) - y;
            double dz = 0.0;
            if (heights && Known(s.hp) && carnet.hasZ(s.name, z))
                dz = zs + station.hi + s.di * std::cos(Rad(s.av)) - s.hp - z;
            if (!heights && carnet.hasZ(station.name, zs) && carnet.hasZ(s.name, z)) heightLost = true;
            ++radiated;
            if (std::hypot(dx, dy) > kTolerance || std::abs(dz) > kTolerance)
                faults.push_back(s.name + " depuis " + station.name + " : dX " + std::to_string(dx) + " dY " +
                                 std::to_string(dy) + " dZ " + std::to_string(dz));
        }
        if (heightLost) faults.push_back("station " + station.name + " sans hauteur d'instrument");
    }
    if (faults.empty() && radiated == compared) return ::testing::AssertionSuccess();
    auto failure = ::testing::AssertionFailure() << radiated << " visées comparées sur " << compared;
    for (const std::string& fault : faults)
        failure << "\n  " << fault;
    return failure;
}

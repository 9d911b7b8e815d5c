#include "calc/Traverse.h"

#include "core/Angles.h"
#include "core/Strings.h"

#include <cmath>

namespace pyr {

namespace {

constexpr const char* kWhyTooShort = "un cheminement compte au moins deux stations (trois s'il est fermé)";
constexpr const char* kWhyStartUnknown = "la station de départ <%s> n'a pas de coordonnées connues";
constexpr const char* kWhyStartNotOriented = "la station de départ <%s> n'est pas orientée";
constexpr const char* kWhyEndUnknown = "la station d'arrivée <%s> n'a pas de coordonnées connues";
constexpr const char* kWhyEndNotOriented = "la station d'arrivée <%s> n'est pas orientée";
constexpr const char* kWhyNoForward = "la station <%s> ne vise pas la station suivante <%s>";
constexpr const char* kWhyNoBack = "la station <%s> ne vise pas la station précédente <%s>";
constexpr const char* kWhyNoDistance = "pas de distance entre <%s> et <%s>";

bool Known(double value) {
    return IsKnown(value) && std::isfinite(value);
}

TraverseResult Refuse(std::string why) {
    TraverseResult result;
    result.why = std::move(why);
    return result;
}

// The legs' shares of a misclosure: in proportion to `weights`, all equal when they sum to nothing.
std::vector<double> Shares(double misclosure, const std::vector<double>& weights) {
    double total = 0.0;
    for (double weight : weights)
        total += weight;
    std::vector<double> shares(weights.size(), 0.0);
    for (std::size_t k = 0; k < weights.size(); ++k)
        shares[k] =
            -misclosure * (total > 0.0 ? weights[k] / total : 1.0 / static_cast<double>(weights.size()));
    return shares;
}

} // namespace

TraverseResult ComputeTraverse(const TraverseInput& input) {
    const std::vector<TraverseStation>& stations = input.stations;
    const bool closed = input.kind == TraverseKind::Closed;
    const std::size_t count = stations.size();
    if (count < (closed ? 3u : 2u)) return Refuse(kWhyTooShort);
    const std::size_t legs = closed ? count : count - 1;
    // The station a leg arrives at.
    const auto next = [count](std::size_t k) { return (k + 1) % count; };
    const char* first = stations.front().name.c_str();
    const char* last = stations.back().name.c_str();

    if (!Known(input.x0) || !Known(input.y0)) return Refuse(Sprintf(kWhyStartUnknown, first));
    if (!Known(input.v00)) return Refuse(Sprintf(kWhyStartNotOriented, first));
    const bool endPlace = input.kind == TraverseKind::Linked || input.kind == TraverseKind::Position;
    if (endPlace && (!Known(input.xn) || !Known(input.yn))) return Refuse(Sprintf(kWhyEndUnknown, last));
    if (input.kind == TraverseKind::Linked && !Known(input.v0n))
        return Refuse(Sprintf(kWhyEndNotOriented, last));
    for (std::size_t k = 0; k < legs; ++k) {
        const TraverseStation& from = stations[k];
        const TraverseStation& to = stations[next(k)];
        if (!Known(from.forward)) return Refuse(Sprintf(kWhyNoForward, from.name.c_str(), to.name.c_str()));
        if (!Known(from.distance) || from.distance <= 0.0)
            return Refuse(Sprintf(kWhyNoDistance, from.name.c_str(), to.name.c_str()));
        // The back reading carries the orientation on: needed wherever a leg follows, and at the end of a
        // traverse whose closing orientation is known.
        const std::size_t j = next(k);
        const bool departs = j != 0 && j < legs;
        const bool closing = (input.kind == TraverseKind::Linked && j == count - 1) || (closed && j == 0);
        if ((departs || closing) && !Known(to.back))
            return Refuse(Sprintf(kWhyNoBack, to.name.c_str(), from.name.c_str()));
    }

    TraverseResult result;
    result.legs.resize(legs);
    result.stations.resize(count);
    for (std::size_t i = 0; i < count; ++i)
        result.stations[i].name = stations[i].name;

    // ---- Bearings: the orientation carried from station to station, the angular closure shared.
    std::vector<double> bearings(legs);
    double v0 = input.v00;
    for (std::size_t k = 0; k < legs; ++k) {
        bearings[k] = WrapGrads(v0 + stations[k].forward);
        const std::size_t j = next(k);
        if (Known(stations[j].back)) v0 = bearings[k] + 200.0 - stations[j].back;
    }
    const bool angular = input.kind == TraverseKind::Linked || closed;
    double correction = 0.0;
    if (angular) {
        const double known = closed ? input.v00 : input.v0n;
        result.angularMisclosure = CentredGrads(v0 - known);
        result.angles = static_cast<int>(legs) + 1;
        if (input.distributeAngular) correction = -result.angularMisclosure / result.angles;
    }
    for (std::size_t k = 0; k < legs; ++k) {
        TraverseLegResult& leg = result.legs[k];
        leg.bearing = WrapGrads(bearings[k] + correction * static_cast<double>(k + 1));
        leg.distance = stations[k].distance;
        double s = 0.0;
        double c = 1.0;
        SinCosGrads(leg.bearing, s, c);
        leg.dx = leg.distance * s;
        leg.dy = leg.distance * c;
        leg.dz = stations[k].dz;
        result.length += leg.distance;
        result.stations[k].v0 = WrapGrads(leg.bearing - stations[k].forward);
        result.stations[k].angleCorrection = correction;
    }
    // The first station keeps the orientation it has on its references; so does a linked traverse's last.
    result.stations.front().v0 = input.v00;
    if (!closed) {
        TraverseStationResult& end = result.stations.back();
        end.angleCorrection = angular ? correction : 0.0;
        end.v0 = Known(stations.back().back) ? WrapGrads(result.legs.back().bearing + 200.0 -
                                                         stations.back().back + (angular ? correction : 0.0))
                                             : kUndefined;
    }

    // ---- Planimetry: the closure shared by the rule chosen.
    std::vector<double> lengths(legs), eastings(legs), northings(legs);
    double sumX = input.x0;
    double sumY = input.y0;
    for (std::size_t k = 0; k < legs; ++k) {
        lengths[k] = result.legs[k].distance;
        eastings[k] = std::fabs(result.legs[k].dx);
        northings[k] = std::fabs(result.legs[k].dy);
        sumX += result.legs[k].dx;
        sumY += result.legs[k].dy;
    }
    if (input.kind != TraverseKind::Open) {
        result.fx = sumX - (closed ? input.x0 : input.xn);
        result.fy = sumY - (closed ? input.y0 : input.yn);
        result.f = std::hypot(result.fx, result.fy);
        const bool compass = input.rule == TraverseRule::Compass;
        const double share = input.distributePlanimetric ? 1.0 : 0.0;
        const std::vector<double> cx = Shares(result.fx, compass ? lengths : eastings);
        const std::vector<double> cy = Shares(result.fy, compass ? lengths : northings);
        for (std::size_t k = 0; k < legs; ++k) {
            result.legs[k].cx = share * cx[k];
            result.legs[k].cy = share * cy[k];
        }
    }
    double x = input.x0;
    double y = input.y0;
    result.stations[0].x = x;
    result.stations[0].y = y;
    for (std::size_t k = 0; k + 1 < count; ++k) {
        x += result.legs[k].dx + result.legs[k].cx;
        y += result.legs[k].dy + result.legs[k].cy;
        result.stations[k + 1].x = x;
        result.stations[k + 1].y = y;
    }

    // ---- Heights: known at the start and measured on every leg; their closure shared by the lengths.
    bool heights = Known(input.z0);
    double sumZ = input.z0;
    for (std::size_t k = 0; k < legs && heights; ++k) {
        heights = Known(result.legs[k].dz);
        sumZ += heights ? result.legs[k].dz : 0.0;
    }
    if (heights) {
        const double zEnd = closed ? input.z0 : input.zn;
        if (input.kind != TraverseKind::Open && Known(zEnd)) {
            result.fz = sumZ - zEnd;
            const std::vector<double> cz = Shares(result.fz, lengths);
            for (std::size_t k = 0; k < legs && input.distributeHeight; ++k)
                result.legs[k].cz = cz[k];
        }
        double z = input.z0;
        result.stations[0].z = z;
        for (std::size_t k = 0; k + 1 < count; ++k) {
            z += result.legs[k].dz + result.legs[k].cz;
            result.stations[k + 1].z = z;
        }
    }
    result.ok = true;
    return result;
}

} // namespace pyr

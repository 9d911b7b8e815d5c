#include "calc/TraverseGathering.h"

#include "core/Angles.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"

#include <cmath>

namespace pyr {

namespace {

constexpr const char* kWhyBadName = "« %s » ne désigne pas une station";
constexpr const char* kWhyNoStation = "la station <%s> n'est pas dans la GéoBase";

// The sightings of one station occurrence to one point, reduced and merged: the mean reading, horizontal
// distance and height difference (station ground to target ground).
struct Toward {
    double reading = kUndefined;
    double dh = kUndefined;
    double dz = kUndefined;
};

Toward SightingsTo(const CCarnet& carnet, const StationPlace& station, std::string_view mat,
                   const SightingReductionOptions& options) {
    double first = kUndefined;
    double readings = 0.0, distances = 0.0, heights = 0.0;
    int readingCount = 0, distanceCount = 0, heightCount = 0;
    for (int i = station.index + 1; i < carnet.GetSize() && carnet.GetType(i) != kKindStation; ++i) {
        if (!IsSightingKind(carnet.GetType(i)) || carnet.GetAt(i)->mat() != mat) continue;
        const ReducedSighting r = ReduceSighting(carnet, station, i, options);
        if (!IsKnown(r.ah)) continue;
        if (readingCount == 0) first = r.ah;
        readings += NearGrads(r.ah, first);
        ++readingCount;
        if (!IsKnown(r.dh) || r.dh <= 0.0) continue;
        distances += r.dh;
        ++distanceCount;
        if (IsKnown(station.hi) && IsKnown(r.av) && IsKnown(r.hp)) {
            heights += TrigonometricHeightDifference(r.dh, r.av, station.hi, r.hp);
            ++heightCount;
        }
    }
    Toward toward;
    if (readingCount > 0) toward.reading = WrapGrads(readings / readingCount);
    if (distanceCount > 0) toward.dh = distances / distanceCount;
    if (heightCount > 0) toward.dz = heights / heightCount;
    return toward;
}

// The mean of a measure taken both ways (`backward` already turned into the forward sense), checked.
double BothWays(double forward, double backward, double tolerance, bool height, const std::string& from,
                const std::string& to, std::vector<TraverseLegWarning>& warnings) {
    if (!IsKnown(forward)) return backward;
    if (!IsKnown(backward)) return forward;
    if (std::fabs(forward - backward) > tolerance)
        warnings.push_back({from, to, forward, backward, tolerance, height});
    return (forward + backward) / 2;
}

// The orientation of an end station on its references by the V0 rules, else its own.
double EndOrientation(const CCarnet& carnet, const StationPlace& place,
                      const TraverseGatherSettings& settings, V0Result& v0) {
    v0 = ComputeStationV0(carnet, place, DefaultReferences(carnet, place.index), settings.v0);
    if (v0.computed) return v0.v0;
    return place.IsOriented() ? place.v0 : kUndefined;
}

} // namespace

GatheredTraverse GatherTraverse(const CCarnet& carnet, const CChemin& traverse,
                                const TraverseGatherSettings& settings) {
    GatheredTraverse gathered;
    const std::vector<std::string>& names = traverse.stations();
    for (const std::string& designation : names) {
        std::string name;
        int reprise = 1;
        if (!CCarnet::extrStaRep(designation, name, reprise)) {
            gathered.why = Sprintf(kWhyBadName, designation.c_str());
            return gathered;
        }
        const int index = carnet.findStaRep(name, reprise);
        if (index < 0) {
            gathered.why = Sprintf(kWhyNoStation, designation.c_str());
            return gathered;
        }
        gathered.places.push_back(StationPlaceAt(carnet, index));
    }
    const bool closed = traverse.isClosed();
    const std::size_t count = gathered.places.size();
    TraverseInput& input = gathered.input;
    input.rule = settings.rule;
    if (count == 0) {
        gathered.ok = true;
        return gathered;
    }

    // Each station's sightings to its neighbours.
    std::vector<Toward> backs(count), forwards(count);
    for (std::size_t i = 0; i < count; ++i) {
        const StationPlace& place = gathered.places[i];
        if (closed || i > 0)
            backs[i] =
                SightingsTo(carnet, place, gathered.places[(i + count - 1) % count].name, settings.reduction);
        if (closed || i + 1 < count)
            forwards[i] =
                SightingsTo(carnet, place, gathered.places[(i + 1) % count].name, settings.reduction);
    }
    const std::size_t legs = closed ? count : count - 1;
    for (std::size_t i = 0; i < count; ++i) {
        TraverseStation station{names[i], backs[i].reading, forwards[i].reading};
        if (i < legs) {
            const std::size_t j = (i + 1) % count;
            const double f = forwards[i].dh;
            const double b = backs[j].dh;
            const double length = IsKnown(f) ? f : IsKnown(b) ? b : 0.0;
            station.distance = BothWays(f, b, settings.tolerances.Distance(length), false, names[i], names[j],
                                        gathered.warnings);
            station.dz =
                BothWays(forwards[i].dz, IsKnown(backs[j].dz) ? -backs[j].dz : kUndefined,
                         settings.tolerances.customHeight, true, names[i], names[j], gathered.warnings);
        }
        input.stations.push_back(station);
    }

    // The ends: what the GéoBase knows of them.
    const StationPlace& start = gathered.places.front();
    input.x0 = start.x, input.y0 = start.y, input.z0 = start.z;
    if (start.HasPlace()) input.v00 = EndOrientation(carnet, start, settings, gathered.startV0);
    const StationPlace& end = gathered.places.back();
    if (closed) {
        input.kind = TraverseKind::Closed;
    } else if (!end.HasPlace()) {
        input.kind = TraverseKind::Open;
    } else {
        input.xn = end.x, input.yn = end.y, input.zn = end.z;
        input.v0n = EndOrientation(carnet, end, settings, gathered.endV0);
        input.kind = IsKnown(input.v0n) ? TraverseKind::Linked : TraverseKind::Position;
    }
    gathered.ok = true;
    return gathered;
}

double AngularClosureTolerance(const CCarnet& carnet, const GatheredTraverse& gathered, int angles,
                               double direction) {
    // A tolerance is 2.7 standard deviations, the convention of French surveying regulations.
    constexpr double kToleranceOverSigma = 2.7;
    if (angles <= 0) return 0.0;
    double sum = 0.0;
    for (const StationPlace& place : gathered.places) {
        const CAppareil* instrument = carnet.findAppAt(place.index);
        const double t = instrument && instrument->sigmaAh() > 0.0
                             ? kToleranceOverSigma * instrument->sigmaAh()
                             : direction;
        sum += t * t;
    }
    const double meanSquare = gathered.places.empty() ? direction * direction : sum / gathered.places.size();
    return std::sqrt(2.0 * angles * meanSquare);
}

} // namespace pyr

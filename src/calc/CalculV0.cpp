#include "calc/CalculV0.h"

#include "calc/CalculV0Texts.h"
#include "calc/Corrections.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"

#include <cmath>
#include <limits>

namespace pyr {

namespace {

// A reference closer than this to the station gives no direction.
constexpr double kSamePlace = 0.0001;
// Residuals below this are the rounding of the mean, not a spread of the references.
constexpr double kNoResidual = 1e-10;
constexpr int kV0Decimals = 6;

std::string AngleText(double grads) {
    return FormatFixed(grads, CStation::DeciAng());
}

// The sighting's sine and cosine of its zenith angle serve both the height difference and its tolerance.
void CheckReference(const StationPlace& station, const V0Reference& ref, const ReducedSighting& sighting,
                    const V0Settings& settings, std::vector<std::string>& warnings) {
    const double dh = ref.measuredDistance;
    if (IsKnown(station.z) && IsKnown(ref.z) && IsKnown(station.hi) && IsKnown(sighting.hp)) {
        const double computed = ref.z - station.z;
        const double measured =
            TrigonometricHeightDifference(dh, sighting.sinAv, sighting.cosAv, station.hi, sighting.hp);
        if (std::fabs(computed - measured) >
            settings.tolerances.HeightDifference(dh, sighting.sinAv, sighting.cosAv, kHeightTermsV0))
            warnings.push_back(Sprintf(v0::kMsgHeightOutOfTolerance, ref.mat.c_str(), computed, measured,
                                       computed - measured));
    }
    if (std::fabs(dh - ref.distance) > settings.tolerances.Distance(dh))
        warnings.push_back(
            Sprintf(v0::kMsgDistanceOutOfTolerance, ref.mat.c_str(), ref.distance, dh, ref.distance - dh));
}

// The sightings of a kind (or of both kinds, for 0) of the station that aim at points with known planimetry.
std::vector<int> SightingsOfKnownPoints(PointPlaces& places, int stationIndex, int kind) {
    const CCarnet& carnet = places.Carnet();
    std::vector<int> sightings;
    int end = carnet.Find(kKindStation, "", stationIndex + 1);
    if (end < 0) end = carnet.GetSize();
    double x, y, z;
    for (int i = stationIndex + 1; i < end; ++i) {
        const int found = carnet.GetType(i);
        if (IsSightingKind(found) && (kind == 0 || found == kind) && places.Of(i, x, y, z))
            sightings.push_back(i);
    }
    return sightings;
}

} // namespace

PointPlaces::PointPlaces(const CCarnet& carnet, bool remember) : m_carnet(carnet) {
    if (remember)
        m_places.assign(static_cast<std::size_t>(carnet.NameCount()),
                        {std::numeric_limits<double>::quiet_NaN(), kUndefined, kUndefined});
}

bool PointPlaces::Of(int index, double& x, double& y, double& z) {
    // The element leads to its point's elements through its identifier's rank, its name never searched.
    const int rank = m_places.empty() ? -1 : m_carnet.NameRank(index);
    if (rank < 0) return PointPlaceOf(m_carnet, index, x, y, z);
    Place& place = m_places[static_cast<std::size_t>(rank)];
    if (std::isnan(place.x)) PointPlaceOf(m_carnet, index, place.x, place.y, place.z);
    x = place.x, y = place.y, z = place.z;
    return IsKnown(x);
}

StationPlace PointPlaces::Station(int stationIndex) {
    double x, y, z;
    Of(stationIndex, x, y, z);
    return StationPlaceAt(m_carnet, stationIndex, x, y, z);
}

std::vector<int> OfferedReferences(const CCarnet& carnet, int stationIndex) {
    PointPlaces places(carnet, false);
    return SightingsOfKnownPoints(places, stationIndex, 0);
}

std::vector<int> DefaultReferences(PointPlaces& places, int stationIndex) {
    std::vector<int> references = SightingsOfKnownPoints(places, stationIndex, kKindReference);
    return references.empty() ? SightingsOfKnownPoints(places, stationIndex, 0) : references;
}

std::vector<int> DefaultReferences(const CCarnet& carnet, int stationIndex) {
    PointPlaces places(carnet, false);
    return DefaultReferences(places, stationIndex);
}

V0Reference PrepareReference(const CCarnet& carnet, const StationPlace& station, int sighting,
                             const V0Settings& settings, std::vector<std::string>& warnings) {
    PointPlaces places(carnet, false);
    return PrepareReference(places, station, sighting, settings, warnings);
}

V0Reference PrepareReference(PointPlaces& places, const StationPlace& station, int sighting,
                             const V0Settings& settings, std::vector<std::string>& warnings) {
    const CCarnet& carnet = places.Carnet();
    V0Reference ref;
    ref.index = sighting;
    // The store keeps each element under the kind of its class: a sighting's kind tells it is one.
    const auto* visee = IsSightingKind(carnet.GetType(sighting))
                            ? static_cast<const CVisee*>(carnet.GetAt(sighting))
                            : nullptr;
    if (!visee) {
        ref.valid = false;
        return ref;
    }
    ref.mat = visee->mat();
    if (!places.Of(sighting, ref.x, ref.y, ref.z) || !station.HasPlace()) {
        ref.valid = false;
        return ref;
    }

    const ReducedSighting reduced = ReduceSighting(carnet, station, sighting, settings.reduction);
    ref.ah = reduced.ah;
    ref.distance = std::hypot(ref.x - station.x, ref.y - station.y);
    ref.bearing = Bearing(station.x, station.y, ref.x, ref.y);
    // A distance and a zenith angle give the horizontal distance to check against the coordinates.
    if (IsKnown(reduced.dh)) {
        ref.measuredDistance = reduced.dh;
        CheckReference(station, ref, reduced, settings, warnings);
    }

    if (IsKnown(reduced.ah))
        ref.partialV0 = WrapGrads(ref.bearing - reduced.ah); // else dropped, with its remark
    return ref;
}

void SolveV0(V0Result& result, const V0Settings& settings) {
    result.weighted = settings.weighted;
    result.computed = false;
    result.v0 = kUndefined;
    for (V0Reference& ref : result.references)
        if (ref.valid && !IsKnown(ref.partialV0)) {
            ref.valid = false;
            result.remarks.push_back(Sprintf(v0::kRemarkNoDirection, ref.mat.c_str()));
        }

    double v0 = 0.0;
    int n = 0;
    while (true) {
        n = 0;
        double sumD = 0.0, sumDV = 0.0, sumV = 0.0, first = kUndefined;
        for (V0Reference& ref : result.references) {
            if (!ref.valid) continue;
            if (ref.distance < kSamePlace) {
                result.remarks.push_back(Sprintf(v0::kRemarkAtStation, ref.mat.c_str()));
                ref.valid = false;
                ref.residual = kUndefined;
                continue;
            }
            // Every partial V0 is brought within half a turn of the first: 399.99 and 0.01 average to 0.
            ref.wrappedV0 = IsKnown(first) ? NearGrads(ref.partialV0, first) : ref.partialV0;
            if (!IsKnown(first)) first = ref.partialV0;
            ++n;
            sumD += ref.distance;
            sumDV += ref.distance * ref.wrappedV0;
            sumV += ref.wrappedV0;
        }
        if (n == 0) {
            result.warnings.push_back(v0::kMsgNoValidReference);
            result.used = 0;
            return;
        }
        v0 = settings.weighted ? sumDV / sumD : sumV / n;

        V0Reference* worst = nullptr;
        for (V0Reference& ref : result.references) {
            if (!ref.valid) continue;
            ref.residual = v0 - ref.wrappedV0;
            if (std::fabs(ref.residual) > kNoResidual &&
                (!worst || std::fabs(ref.residual) > std::fabs(worst->residual)))
                worst = &ref;
        }
        result.tolerance = settings.tolerances.V0(n);
        if (settings.forced || !worst || std::fabs(worst->residual) <= result.tolerance) break;

        // Only the worst goes, and the mean is made again without it.
        result.remarks.push_back(Sprintf(v0::kRemarkOutOfTolerance, worst->mat.c_str()));
        result.remarks.push_back(Sprintf(v0::kRemarkDeviation, AngleText(std::fabs(worst->residual)).c_str(),
                                         AngleText(result.tolerance).c_str()));
        worst->valid = false;
        worst->partialV0 = worst->wrappedV0 = worst->residual = kUndefined;
    }

    if (settings.forced)
        for (const V0Reference& ref : result.references)
            if (ref.valid && std::fabs(ref.residual) > result.tolerance) {
                result.remarks.push_back(Sprintf(v0::kRemarkOutOfTolerance, ref.mat.c_str()));
                result.remarks.push_back(Sprintf(v0::kRemarkDeviation,
                                                 AngleText(std::fabs(ref.residual)).c_str(),
                                                 AngleText(result.tolerance).c_str()));
            }
    result.used = n;
    result.v0 = RoundV0(v0);
    result.computed = true;
}

V0Result ComputeStationV0(PointPlaces& places, const StationPlace& station, const std::vector<int>& sightings,
                          const V0Settings& settings) {
    V0Result result;
    result.station = station;
    result.references.reserve(sightings.size());
    for (int sighting : sightings)
        result.references.push_back(PrepareReference(places, station, sighting, settings, result.warnings));
    SolveV0(result, settings);
    return result;
}

V0Result ComputeStationV0(const CCarnet& carnet, const StationPlace& station,
                          const std::vector<int>& sightings, const V0Settings& settings) {
    PointPlaces places(carnet, false);
    return ComputeStationV0(places, station, sightings, settings);
}

double RoundV0(double v0) {
    return WrapGrads(RoundToDecimals(WrapGrads(v0), kV0Decimals));
}

} // namespace pyr

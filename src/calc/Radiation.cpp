#include "calc/Radiation.h"

#include "calc/RadiationTexts.h"
#include "calc/RepriseBlock.h"
#include "core/Angles.h"
#include "geobase/Carnet.h"
#include "geobase/Selection.h"

#include <algorithm>
#include <cmath>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace pyr {

namespace {

// One sighting of the station, reduced, waiting to be merged with the other sightings of its point.
struct Entry {
    ReducedSighting reduced;
    int next = -1;           // the next sighting of the same point, in GéoBase order
    bool repetition = false; // not the first sighting of its point: merged into that one
};

// The horizontal distance of a reduced slope distance and zenith angle, corrected for scale at the
// station; kUndefined when there is none to use.
double CorrectedHorizontal(double di, double av, const StationPlace& station,
                           const DistanceCorrection& correction) {
    if (!(di > 0.0) || !IsKnown(av)) return kUndefined;
    double dh = di * SinGrads(av);
    if (!(dh > 0.0)) return kUndefined;
    CorrectHorizontalDistance(dh, station.x, station.y, station.z, correction);
    return dh;
}

// Merges the repetitions of a point into its first sighting, as the reduction of a station merges them:
// each one already reduced to face left and for its offsets, its target height as used.
void MergeRepetitions(const std::vector<Entry>& entries, int first, RadiatedSighting& out,
                      const StationPlace& station, const DistanceCorrection& correction) {
    const ReducedSighting& head = entries[static_cast<std::size_t>(first)].reduced;
    CMesure merged({}, head.hp, head.ah, head.av, head.di);
    CRepetitionMean mean(merged);
    for (int i = entries[static_cast<std::size_t>(first)].next; i >= 0;
         i = entries[static_cast<std::size_t>(i)].next) {
        const ReducedSighting& r = entries[static_cast<std::size_t>(i)].reduced;
        mean.Add(CMesure({}, r.hp, r.ah, r.av, r.di));
        ++out.repetitions;
    }
    mean.WriteInto(merged);
    out.hp = merged.hp(), out.ah = merged.ah(), out.av = merged.av(), out.di = merged.di();
    out.dh = CorrectedHorizontal(out.di, out.av, station, correction);
}

} // namespace

RadiatedStation RadiateStation(const CCarnet& carnet, int stationIndex, const RadiationSettings& settings,
                               const CSelection* points) {
    RadiatedStation result;
    RadiateStation(carnet, stationIndex, settings, points, result);
    return result;
}

void RadiateStation(const CCarnet& carnet, int stationIndex, const RadiationSettings& settings,
                    const CSelection* points, RadiatedStation& result) {
    result.Clear();
    result.station = StationPlaceAt(carnet, stationIndex);
    StationPlace& station = result.station;
    if (!station.HasPlace()) {
        result.reason = rayon::kReasonNoPlace;
        return;
    }
    if (settings.computeV0) {
        result.v0 = ComputeStationV0(carnet, station, DefaultReferences(carnet, stationIndex), settings.v0);
        if (result.v0.computed) {
            station.v0 = result.v0.v0;
            result.v0Computed = true;
        }
    }
    if (!station.IsOriented()) {
        result.reason = settings.computeV0 ? rayon::kReasonNoReference : rayon::kReasonNoV0;
        return;
    }
    result.usable = true;

    int end = carnet.Find(kKindStation, "", stationIndex + 1);
    if (end < 0) end = carnet.GetSize();

    // The sightings reduced, then each point's repetitions linked behind its first sighting: sorted by the
    // rank of their identifier, those of one point follow one another in GéoBase order.
    const int stationKey = carnet.NameRank(stationIndex);
    std::vector<Entry> entries;
    std::vector<std::pair<int, int>> byPoint; // identifier's rank, entry
    entries.reserve(static_cast<std::size_t>(end - stationIndex));
    byPoint.reserve(static_cast<std::size_t>(end - stationIndex));
    for (int i = stationIndex + 1; i < end; ++i) {
        if (!IsSightingKind(carnet.GetType(i))) continue;
        const int key = carnet.NameRank(i);
        if (key == stationKey) continue;
        const auto* visee = static_cast<const CVisee*>(carnet.GetAt(i));
        if (points && !points->Contains(visee->mat())) continue;
        Entry entry{ReduceSighting(carnet, station, i, settings.reduction)};
        // A target height of 0 is the one the surveyor wrote, not what the vertical offset made of it: the
        // replacement takes its place, still lowered by that offset. Without target heights every height
        // is 0 by choice and stays so.
        if (settings.replaceZeroTargetHeight && settings.reduction.targetHeights && visee->hp() == 0.0)
            entry.reduced.hp += settings.zeroTargetHeight;
        byPoint.emplace_back(key, static_cast<int>(entries.size()));
        entries.push_back(std::move(entry));
    }
    std::sort(byPoint.begin(), byPoint.end());
    result.points.reserve(entries.size());
    for (std::size_t k = 1; k < byPoint.size(); ++k)
        if (byPoint[k].first == byPoint[k - 1].first) {
            entries[static_cast<std::size_t>(byPoint[k - 1].second)].next = byPoint[k].second;
            entries[static_cast<std::size_t>(byPoint[k].second)].repetition = true;
        }

    for (int first = 0; first < static_cast<int>(entries.size()); ++first) {
        Entry& head = entries[static_cast<std::size_t>(first)];
        if (head.repetition) continue;
        // Built in its place among the new points, and taken out again when it is none.
        RadiatedSighting& s = result.points.emplace_back();
        s.index = head.reduced.index;
        const CElement& sighted = *carnet.GetAt(s.index);
        s.mat = sighted.mat();
        s.code = sighted.sym();
        s.reference = carnet.GetType(s.index) == kKindReference;
        if (head.next < 0) {
            s.hp = head.reduced.hp, s.ah = head.reduced.ah, s.av = head.reduced.av, s.di = head.reduced.di;
            s.dh = head.reduced.dh;
        } else {
            MergeRepetitions(entries, first, s, station, settings.reduction.correction);
            for (int i = head.next; i >= 0; i = entries[static_cast<std::size_t>(i)].next) {
                const int index = entries[static_cast<std::size_t>(i)].reduced.index;
                if (s.code.empty()) s.code = carnet.GetAt(index)->sym();
                if (carnet.GetType(index) == kKindReference) s.reference = true;
            }
        }

        if (s.mat.empty() || !IsKnown(s.ah) || !IsKnown(s.dh) || !(s.dh > 0.0)) {
            // A point without identifier could be neither written nor told from another. A measured
            // distance without its zenith angle cannot be brought to the horizontal.
            const char* reason = s.mat.empty()                  ? rayon::kReasonNoName
                                 : !IsKnown(s.ah)               ? rayon::kReasonNoDirection
                                 : s.di > 0.0 && !IsKnown(s.av) ? rayon::kReasonNoZenith
                                                                : rayon::kReasonNoDistance;
            result.skipped.push_back({s.index, s.mat, reason});
            result.points.pop_back();
            continue;
        }
        s.bearing = WrapGrads(station.v0 + s.ah);
        double sinG = 0.0, cosG = 0.0;
        SinCosGrads(s.bearing, sinG, cosG);
        s.x = station.x + s.dh * sinG;
        s.y = station.y + s.dh * cosG;
        // A zenith angle of 0 or 200 gr is no line of sight that a height difference can follow.
        if (IsKnown(station.z) && IsKnown(station.hi) && IsKnown(s.hp) && s.av > 0.0 && s.av < 200.0)
            s.z = station.z + TrigonometricHeightDifference(s.dh, s.av, station.hi, s.hp);

        RadiationCheck check;
        if (PointPlaceOf(carnet, s.index, check.knownX, check.knownY, check.knownZ)) {
            const double dx = s.x - check.knownX, dy = s.y - check.knownY;
            check.along = dx * sinG + dy * cosG;
            check.across = dx * cosG - dy * sinG;
            if (IsKnown(s.z) && IsKnown(check.knownZ)) check.dz = s.z - check.knownZ;
            check.sighting = s;
            result.checks.push_back(check);
            result.points.pop_back();
        } else {
            s.key = carnet.NameRank(s.index);
        }
    }
}

Determinations& Determinations::operator=(const Determinations& other) {
    if (this == &other) return *this;
    m_first = other.m_first;
    m_size = other.m_size;
    m_capacity = other.m_size > 1 ? other.m_size : 0;
    m_all.reset();
    if (m_capacity > 0) {
        m_all = std::make_unique<Determination[]>(m_capacity);
        std::copy(other.begin(), other.end(), m_all.get());
    }
    return *this;
}

Determinations& Determinations::operator=(Determinations&& other) noexcept {
    m_first = other.m_first;
    m_size = std::exchange(other.m_size, 0);
    m_capacity = std::exchange(other.m_capacity, 0);
    m_all = std::move(other.m_all);
    return *this;
}

void Determinations::push_back(const Determination& determination) {
    if (m_size >= 1 && m_size == m_capacity) {
        const std::uint32_t capacity = std::max<std::uint32_t>(4, 2 * m_capacity);
        auto all = std::make_unique<Determination[]>(capacity);
        std::copy(begin(), end(), all.get());
        m_all = std::move(all);
        m_capacity = capacity;
    } else if (m_size == 1) {
        m_all = std::make_unique<Determination[]>(4);
        m_all[0] = m_first;
        m_capacity = 4;
    }
    if (m_size == 0)
        m_first = determination;
    else
        m_all[m_size] = determination;
    ++m_size;
}

namespace {

// The mean of a point's determinations, their spread, and whether it is within the tolerances.
void Summarise(RadiatedPoint& point, const std::vector<RadiatedStation>& stations,
               const Tolerances& tolerances) {
    double sumX = 0.0, sumY = 0.0, sumZ = 0.0, minZ = 0.0, maxZ = 0.0;
    int withZ = 0;
    const Determinations& determinations = point.determinations;
    auto sighting = [&](const Determination& d) -> const RadiatedSighting& {
        return stations[d.station].points[d.point];
    };
    for (const Determination& d : determinations) {
        const RadiatedSighting& s = sighting(d);
        sumX += s.x, sumY += s.y;
        if (!IsKnown(s.z)) continue;
        sumZ += s.z;
        minZ = withZ == 0 ? s.z : std::min(minZ, s.z);
        maxZ = withZ == 0 ? s.z : std::max(maxZ, s.z);
        ++withZ;
    }
    const auto n = static_cast<double>(determinations.size());
    point.x = sumX / n;
    point.y = sumY / n;
    point.z = withZ > 0 ? sumZ / withZ : kUndefined;
    point.spreadZ = maxZ - minZ;
    point.spreadXY = 0.0;
    // Every pair: a point is seldom determined from more than a few stations.
    for (std::size_t a = 0; a < determinations.size(); ++a)
        for (std::size_t b = a + 1; b < determinations.size(); ++b) {
            const RadiatedSighting &sa = sighting(determinations[a]), &sb = sighting(determinations[b]);
            point.spreadXY = std::max(point.spreadXY, std::hypot(sa.x - sb.x, sa.y - sb.y));
        }
    point.outOfTolerance =
        point.spreadXY > tolerances.customDistance || point.spreadZ > tolerances.customHeight;
}

} // namespace

RadiatedPoints MergeDeterminations(const std::vector<RadiatedStation>& stations,
                                   const Tolerances& tolerances) {
    RadiatedPoints merged;
    MergeDeterminations(stations, tolerances, merged);
    return merged;
}

void MergeDeterminations(const std::vector<RadiatedStation>& stations, const Tolerances& tolerances,
                         RadiatedPoints& merged) {
    merged.clear();
    std::size_t total = 0;
    // The points are grouped by their key, which RadiateStation gives: the rank of their identifier, read
    // nearly in order since the points mostly come in the order of their first sighting. When some
    // sightings were made elsewhere, without a key, every point is grouped by its identifier.
    bool byName = false;
    int lastKey = -1;
    for (const RadiatedStation& station : stations) {
        total += station.points.size();
        for (const RadiatedSighting& s : station.points) {
            byName = byName || s.key < 0;
            lastKey = std::max(lastKey, s.key);
        }
    }
    merged.reserve(total);
    std::vector<std::size_t> multiple; // the points determined more than once
    std::vector<int> rankOfKey;        // -1 for a key not seen yet
    std::unordered_map<std::string_view, std::size_t> rankOfName;
    if (byName)
        rankOfName.reserve(total);
    else
        rankOfKey.assign(static_cast<std::size_t>(lastKey + 1), -1);
    auto rankOf = [&](const RadiatedSighting& s) {
        const std::size_t next = merged.size();
        if (byName) return rankOfName.try_emplace(s.mat, next).first->second;
        int& rank = rankOfKey[static_cast<std::size_t>(s.key)];
        if (rank < 0) rank = static_cast<int>(next);
        return static_cast<std::size_t>(rank);
    };
    for (std::size_t st = 0; st < stations.size(); ++st) {
        const RadiatedSightings& points = stations[st].points;
        for (std::size_t p = 0; p < points.size(); ++p) {
            const RadiatedSighting& s = points[p];
            const std::size_t rank = rankOf(s);
            const Determination determination{static_cast<std::uint32_t>(st), static_cast<std::uint32_t>(p)};
            if (rank == merged.size()) {
                // Most points have no other determination: one is its own mean, without spread.
                RadiatedPoint& point = merged.emplace_back();
                point.mat = s.mat;
                point.determinations.push_back(determination);
                point.x = s.x, point.y = s.y, point.z = s.z;
                continue;
            }
            RadiatedPoint& point = merged[rank];
            point.determinations.push_back(determination);
            if (point.determinations.size() == 2) multiple.push_back(rank);
        }
    }
    for (std::size_t rank : multiple)
        Summarise(merged[rank], stations, tolerances);
}

} // namespace pyr

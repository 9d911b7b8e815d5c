#pragma once

#include "geobase/Carnet.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// A GéoBase such as a big survey job produces, built in memory through the store's public operations:
// control points, then station after station with its references, measured sightings, eccentric
// offsets and the points computed from them; now and then an instrument, a comment, a traverse.
namespace pyr::bench {

class JobGenerator {
public:
    explicit JobGenerator(std::uint64_t seed = 20240611) : m_state(seed) {}

    // Known points "A1".."An" with their Lambert-93 coordinates, declared invariant.
    void AddControlPoints(CCarnet& carnet, int count);
    // One station set-up and everything written after it. One station in four is a reprise of a
    // station set up two set-ups earlier. Returns the index of the station element.
    int AddStation(CCarnet& carnet);

    int StationOccurrences() const { return m_occurrences; }

private:
    double Uniform(double low, double high);
    static double Rounded(double value, int decimals);
    static std::string Named(std::string_view prefix, long long number);
    static std::string StationName(int number) { return Named("S", number); }
    static std::string ControlName(int number) { return Named("A", number); }

    std::uint64_t m_state;
    int m_controlCount = 0;
    int m_occurrences = 0;
    int m_stationNames = 0;
    std::vector<int> m_recentStations; // station numbers of the last set-ups, for reprises
    long long m_nextPoint = 1000;
    double m_east = 651200.0;
    double m_north = 6862300.0;
};

// A job of `stationCount` station set-ups with control points in proportion.
CCarnet MakeJob(int stationCount);
// A job of exactly `elementCount` elements (the last station may be cut short).
CCarnet MakeJobOfSize(int elementCount);
// A survey of `count` points, as the exports write them: identifiers "1" to "count", Lambert-93
// coordinates to the 0.1 mm, altitudes to the millimetre (one point in fifty without), a code among a
// surveyor's usual ones.
CCarnet MakePointSurvey(int count);

// What a job holds, gathered once so that look-ups can be timed alone.
struct JobContents {
    std::vector<std::string> stationNames;             // distinct, in order of first set-up
    std::vector<std::pair<std::string, int>> reprises; // every station set-up: name and rank from 1
    std::vector<std::string> pointNames;               // every point element's identifier
    std::vector<int> sightings;                        // indices of every reference and measure
};
JobContents Contents(const CCarnet& carnet);

// ---- Jobs for the intersection: new points sighted from stations whose place and V0 are known. Every
// sighting is read from the coordinates as a good instrument reads it (directions and zenith angles to
// 0.01 mgon, distances to 0.1 mm), face left, the circle turned by the V0 written in the station element.

// The new point of the star, and where it truly is.
inline constexpr const char* kStarPoint = "P";
inline constexpr double kStarX = 651480.0;
inline constexpr double kStarY = 6862760.0;
inline constexpr double kStarZ = 72.5;
// `stations` stations "S1".."Sn" set up all around P, 40 m to 600 m from it, each point known in X, Y
// and Z, each station oriented and measuring P once.
CCarnet MakeIntersectionStar(int stations);

// Stations "S1".."Sn" on a grid of `columns` x `rows` nodes 100 m apart, each station point known and
// the station oriented. Every square of the grid holds five new points "P1".."Pm", each measured from
// two corners of its square (the two ends of one side): ten sightings for each station inside the grid.
struct IntersectionGrid {
    CCarnet carnet;
    int stations = 0;
    int points = 0;
    int sightings = 0;
};
IntersectionGrid MakeIntersectionGrid(int columns, int rows);

// ---- A job for the resection: the free station "E" (its point not in the GéoBase) set up at
// (kStarX, kStarY, kStarZ) and measuring `points` known points "A1".."An" spread all around it, 80 m to
// 1.5 km away.
inline constexpr const char* kFreeStation = "E";
CCarnet MakeResectionStation(int points);

// ---- A job for the graphic view: `sightings` / 20 stations on a square grid 100 m apart, walked row
// by row as traverses, each station point known one time in ten. Every station sights four of its
// neighbours as references and measures its own new points (scattered up to 60 m around it) and some of
// those of the station before. With 100 000 points and 200 000 sightings: 10 000 stations, each with nine
// new points, four references and sixteen measures.
struct MappedJob {
    CCarnet carnet;
    int stations = 0;
    int points = 0;
    int sightings = 0;
};
MappedJob MakeMappedJob(int points, int sightings);

} // namespace pyr::bench

#include "JobGenerator.h"

#include "calc/Corrections.h"
#include "core/Angles.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <array>
#include <cmath>
#include <memory>
#include <unordered_map>

namespace pyr::bench {

namespace {

constexpr int kReferencesPerStation = 6;
constexpr int kMeasuresPerStation = 8;
// About 26 elements for each set-up once the control points, instruments and comments are counted.
constexpr int kElementsPerStation = 26;

const char* const kCodes[] = {"BORNE", "ANGLE BAT", "POTEAU", "ARBRE", "REGARD", "", "", ""};

} // namespace

double JobGenerator::Uniform(double low, double high) {
    // A 64-bit linear congruential step: the same job on every machine and every run.
    m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
    double unit = static_cast<double>(m_state >> 11) / static_cast<double>(1ULL << 53);
    return low + (high - low) * unit;
}

double JobGenerator::Rounded(double value, int decimals) {
    // Dividing by a power of ten gives the double nearest to the decimal value, as a reader would.
    const double scale = std::pow(10.0, decimals);
    return std::round(value * scale) / scale;
}

std::string JobGenerator::Named(std::string_view prefix, long long number) {
    std::string name(prefix);
    name += std::to_string(number);
    return name;
}

void JobGenerator::AddControlPoints(CCarnet& carnet, int count) {
    for (int i = 0; i < count; ++i) {
        auto point = std::make_unique<CPointGen>(
            ControlName(++m_controlCount), Rounded(m_east + Uniform(-2000, 2000), 3),
            Rounded(m_north + Uniform(-2000, 2000), 3), Rounded(Uniform(40, 120), 3), "BORNE");
        point->setInvariantXY(true);
        point->setInvariantZ(true);
        carnet.Add(std::move(point), kKindPoint);
    }
}

int JobGenerator::AddStation(CCarnet& carnet) {
    const int occurrence = m_occurrences++;
    if (occurrence % 100 == 0) {
        auto instrument = std::make_unique<CAppareil>(Named("Tachéomètre ", occurrence / 100 % 3 + 1),
                                                      Rounded(Uniform(-0.002, 0.002), 5), 0.0);
        instrument->setSigmaAh(0.0003);
        instrument->setSigmaAv(0.0003);
        instrument->setSigmaDi(0.002);
        instrument->setSigmaPpm(2.0);
        carnet.Add(std::move(instrument), kKindAppareil);
    }
    if (occurrence % 10 == 0)
        carnet.Add(std::make_unique<CComment>("Opérateur = J. Martin, mise en station " +
                                              std::to_string(occurrence + 1) + ", temps couvert"),
                   kKindComment);

    int number;
    const bool reprise = occurrence % 4 == 3 && m_recentStations.size() >= 2;
    if (reprise) {
        number = m_recentStations[m_recentStations.size() - 2];
    } else {
        number = ++m_stationNames;
        m_east += Uniform(-60, 80);
        m_north += Uniform(-60, 80);
        // A new station is itself a point, computed or known.
        carnet.Add(std::make_unique<CPointGen>(StationName(number), Rounded(m_east, 3), Rounded(m_north, 3),
                                               Rounded(Uniform(40, 120), 3)),
                   kKindPoint);
    }
    m_recentStations.push_back(number);
    if (m_recentStations.size() > 4) m_recentStations.erase(m_recentStations.begin());

    const int stationIndex = carnet.Add(
        std::make_unique<CStation>(StationName(number), Rounded(Uniform(1.4, 1.7), 3)), kKindStation);

    // References: four control points around, and the stations before and after in the traverse.
    for (int r = 0; r < kReferencesPerStation; ++r) {
        std::string target;
        if (r == 4 && number > 1)
            target = StationName(number - 1);
        else if (r == 5)
            target = StationName(number + 1);
        else
            target = ControlName(1 + (number * 3 + r * 7) % std::max(m_controlCount, 1));
        carnet.Add(std::make_unique<CReference>(target, 1.3, Rounded(Uniform(0, 400), 5),
                                                Rounded(Uniform(98, 102), 5), Rounded(Uniform(50, 600), 4)),
                   kKindReference);
    }

    // Measured detail points, some of them eccentric, then the points computed from them.
    std::vector<std::pair<long long, const char*>> measured;
    for (int m = 0; m < kMeasuresPerStation; ++m) {
        long long point = m_nextPoint++;
        const char* code = kCodes[(point * 7) % std::size(kCodes)];
        if (point % 5 == 0)
            carnet.Add(std::make_unique<CCommande>(std::string(kExcentRad), "0.150"), kKindExcentrement);
        carnet.Add(std::make_unique<CMesure>(std::to_string(point), m % 3 == 0 ? 2.0 : 1.3,
                                             Rounded(Uniform(0, 400), 5), Rounded(Uniform(95, 105), 5),
                                             Rounded(Uniform(3, 250), 4), code),
                   kKindMesure);
        measured.emplace_back(point, code);
    }
    for (auto [point, code] : measured)
        carnet.Add(std::make_unique<CPointGen>(std::to_string(point), Rounded(m_east + Uniform(-250, 250), 3),
                                               Rounded(m_north + Uniform(-250, 250), 3),
                                               Rounded(Uniform(40, 120), 3), code),
                   kKindPoint);

    if (occurrence % 200 == 199) {
        auto traverse = std::make_unique<CChemin>(Named("CHEM", occurrence / 200 + 1));
        for (int s = std::max(1, number - 4); s <= number; ++s)
            traverse->add(StationName(s) + "(1)");
        carnet.Add(std::move(traverse), kKindChemin);
    }
    return stationIndex;
}

CCarnet MakeJob(int stationCount) {
    CCarnet carnet;
    JobGenerator generator;
    generator.AddControlPoints(carnet, stationCount / 2 + 6);
    for (int s = 0; s < stationCount; ++s)
        generator.AddStation(carnet);
    return carnet;
}

CCarnet MakeJobOfSize(int elementCount) {
    CCarnet carnet;
    JobGenerator generator;
    const int stationCount = elementCount / kElementsPerStation + 1;
    generator.AddControlPoints(carnet, stationCount / 2 + 6);
    while (carnet.GetSize() < elementCount)
        generator.AddStation(carnet);
    carnet.RemoveRange(elementCount, carnet.GetSize());
    return carnet;
}

CCarnet MakePointSurvey(int count) {
    static const char* const codes[] = {"BORNE", "ARBRE", "MUR", "BORDURE", "REGARD", "POTEAU", "FACADE",
                                        "CANIVEAU", "TN", "AVALOIR", "HAIE", ""};
    CCarnet carnet;
    std::uint64_t state = 20261125;
    const auto uniform = [&state](double low, double high) {
        state = state * 6364136223846793005ULL + 1442695040888963407ULL;
        return low + (high - low) * static_cast<double>(state >> 11) / 9007199254740992.0;
    };
    for (int i = 1; i <= count; ++i) {
        const double z = i % 50 == 0 ? kUndefined : std::round(uniform(40, 120) * 1e3) / 1e3;
        carnet.Add(std::make_unique<CPointGen>(std::to_string(i), std::round(uniform(650000, 660000) * 1e4) / 1e4,
                                               std::round(uniform(6860000, 6870000) * 1e4) / 1e4, z,
                                               codes[static_cast<std::size_t>(i) % std::size(codes)]),
                   kKindPoint);
    }
    return carnet;
}

JobContents Contents(const CCarnet& carnet) {
    JobContents contents;
    std::unordered_map<std::string, int> setUps;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        int kind = carnet.GetType(i);
        if (kind == kKindStation) {
            std::string name = carnet.matAt(i);
            int rank = ++setUps[name];
            if (rank == 1) contents.stationNames.push_back(name);
            contents.reprises.emplace_back(std::move(name), rank);
        } else if (kind == kKindPoint) {
            contents.pointNames.push_back(carnet.matAt(i));
        } else if (IsSightingKind(kind)) {
            contents.sightings.push_back(i);
        }
    }
    return contents;
}

namespace {

// A point known in three dimensions.
struct Place {
    double x, y, z;
};

// A sighting from a station (its point, the instrument height, its V0) to a target at a target height,
// read from their coordinates and written after the station.
void AddMeasureFromCoordinates(CCarnet& carnet, const Place& station, double hi, double v0,
                               const std::string& target, const Place& at, double hp) {
    const double horizontal = std::hypot(at.x - station.x, at.y - station.y);
    const double rise = at.z + hp - station.z - hi - CurvatureRefraction(horizontal);
    const double ah = WrapGrads(Bearing(station.x, station.y, at.x, at.y) - v0);
    const double av = RadiansToGrads(std::atan2(horizontal, rise));
    const double di = std::hypot(horizontal, rise);
    auto round = [](double value, double scale) { return std::round(value * scale) / scale; };
    carnet.Add(std::make_unique<CMesure>(target, hp, round(ah, 1e5), round(av, 1e5), round(di, 1e4)),
               kKindMesure);
}

// One station set-up: its point, then the station element carrying its V0.
void AddPlacedStation(CCarnet& carnet, const std::string& name, const Place& place, double hi, double v0) {
    carnet.Add(std::make_unique<CPointGen>(name, place.x, place.y, place.z), kKindPoint);
    carnet.Add(std::make_unique<CStation>(name, hi, v0), kKindStation);
}

// The same deterministic draws as the job generator's, for the jobs built without it.
class Draws {
public:
    double Uniform(double low, double high) {
        m_state = m_state * 6364136223846793005ULL + 1442695040888963407ULL;
        return low + (high - low) * (static_cast<double>(m_state >> 11) / static_cast<double>(1ULL << 53));
    }
    double Rounded(double low, double high, double scale) {
        return std::round(Uniform(low, high) * scale) / scale;
    }

private:
    std::uint64_t m_state = 20240611;
};

} // namespace

CCarnet MakeIntersectionStar(int stations) {
    CCarnet carnet;
    Draws draws;
    const Place point{kStarX, kStarY, kStarZ};
    for (int s = 0; s < stations; ++s) {
        // Spread over the whole horizon, each a little off its share of it.
        const double bearing = (s + draws.Uniform(0.1, 0.9)) * 400.0 / stations;
        const double distance = draws.Uniform(40, 600);
        const Place place{std::round((kStarX + distance * SinGrads(bearing)) * 1e3) / 1e3,
                          std::round((kStarY + distance * CosGrads(bearing)) * 1e3) / 1e3,
                          draws.Rounded(55, 90, 1e3)};
        const double hi = draws.Rounded(1.45, 1.70, 1e3);
        const double v0 = draws.Rounded(0, 400, 1e5);
        AddPlacedStation(carnet, "S" + std::to_string(s + 1), place, hi, v0);
        AddMeasureFromCoordinates(carnet, place, hi, v0, kStarPoint, point, s % 3 == 0 ? 2.0 : 1.3);
    }
    return carnet;
}

CCarnet MakeResectionStation(int points) {
    CCarnet carnet;
    Draws draws;
    const Place station{kStarX, kStarY, kStarZ};
    std::vector<Place> known;
    for (int p = 0; p < points; ++p) {
        const double bearing = (p + draws.Uniform(0.1, 0.9)) * 400.0 / points;
        const double distance = draws.Uniform(80, 1500);
        known.push_back({std::round((kStarX + distance * SinGrads(bearing)) * 1e3) / 1e3,
                         std::round((kStarY + distance * CosGrads(bearing)) * 1e3) / 1e3,
                         draws.Rounded(55, 90, 1e3)});
        carnet.Add(std::make_unique<CPointGen>("A" + std::to_string(p + 1), known.back().x, known.back().y,
                                               known.back().z),
                   kKindPoint);
    }
    constexpr double kHi = 1.6, kV0 = 271.3456;
    carnet.Add(std::make_unique<CStation>(kFreeStation, kHi, kUndefined), kKindStation);
    for (int p = 0; p < points; ++p)
        AddMeasureFromCoordinates(carnet, station, kHi, kV0, "A" + std::to_string(p + 1), known[p], 1.3);
    return carnet;
}

IntersectionGrid MakeIntersectionGrid(int columns, int rows) {
    constexpr double kSpacing = 100.0;
    constexpr double kEast = 651200.0;
    constexpr double kNorth = 6862300.0;
    constexpr int kPointsPerSquare = 5;
    // The side of its square from which each point is measured: bottom, right, top, left, bottom again,
    // as the corners (column offset, row offset) at its two ends.
    constexpr std::array<std::array<std::array<int, 2>, 2>, 4> kSides{
        {{{{0, 0}, {1, 0}}}, {{{1, 0}, {1, 1}}}, {{{1, 1}, {0, 1}}}, {{{0, 1}, {0, 0}}}}};

    IntersectionGrid grid;
    Draws draws;
    const int squareColumns = columns - 1, squareRows = rows - 1;
    std::vector<Place> points;
    points.reserve(static_cast<std::size_t>(std::max(squareColumns * squareRows, 0) * kPointsPerSquare));
    for (int r = 0; r < squareRows; ++r)
        for (int c = 0; c < squareColumns; ++c)
            for (int k = 0; k < kPointsPerSquare; ++k)
                // Away from the sides, so that the two rays always meet under a wide angle.
                points.push_back({std::round((kEast + (c + draws.Uniform(0.2, 0.8)) * kSpacing) * 1e3) / 1e3,
                                  std::round((kNorth + (r + draws.Uniform(0.2, 0.8)) * kSpacing) * 1e3) / 1e3,
                                  draws.Rounded(45, 65, 1e3)});

    for (int r = 0; r < rows; ++r) {
        for (int c = 0; c < columns; ++c) {
            const Place place{kEast + c * kSpacing, kNorth + r * kSpacing, draws.Rounded(50, 60, 1e3)};
            const double hi = draws.Rounded(1.45, 1.70, 1e3);
            const double v0 = draws.Rounded(0, 400, 1e5);
            AddPlacedStation(grid.carnet, "S" + std::to_string(r * columns + c + 1), place, hi, v0);
            ++grid.stations;
            // The four squares this station is a corner of, and the points measured from that corner.
            for (int dr = -1; dr <= 0; ++dr) {
                for (int dc = -1; dc <= 0; ++dc) {
                    const int sc = c + dc, sr = r + dr;
                    if (sc < 0 || sr < 0 || sc >= squareColumns || sr >= squareRows) continue;
                    for (int k = 0; k < kPointsPerSquare; ++k) {
                        const auto& side = kSides[static_cast<std::size_t>(k) % kSides.size()];
                        const bool fromHere = (side[0][0] == -dc && side[0][1] == -dr) ||
                                              (side[1][0] == -dc && side[1][1] == -dr);
                        if (!fromHere) continue;
                        const int number = (sr * squareColumns + sc) * kPointsPerSquare + k;
                        AddMeasureFromCoordinates(
                            grid.carnet, place, hi, v0, "P" + std::to_string(number + 1),
                            points[static_cast<std::size_t>(number)], k % 2 == 0 ? 1.3 : 2.0);
                        ++grid.sightings;
                    }
                }
            }
        }
    }
    grid.points = static_cast<int>(points.size());
    return grid;
}

MappedJob MakeMappedJob(int pointCount, int sightingCount) {
    constexpr double kSpacing = 100.0;
    constexpr double kEast = 651200.0;
    constexpr double kNorth = 6862300.0;
    constexpr int kReferences = 4;
    constexpr int kSightingsPerStation = 20;
    MappedJob job;
    Draws draws;
    const int stations = std::max(1, sightingCount / kSightingsPerStation);
    const int columns = static_cast<int>(std::ceil(std::sqrt(static_cast<double>(stations))));
    const int newPoints = std::max(1, (pointCount - stations) / stations);

    // The station points first, as a control survey gives them; the grid is walked in a serpentine.
    std::vector<Place> places;
    std::vector<std::pair<int, int>> nodes; // column and row of each station
    for (int s = 0; s < stations; ++s) {
        const int row = s / columns, step = s % columns;
        const int column = row % 2 == 0 ? step : columns - 1 - step;
        nodes.emplace_back(column, row);
        places.push_back({kEast + column * kSpacing + draws.Rounded(-10, 10, 1e3),
                          kNorth + row * kSpacing + draws.Rounded(-10, 10, 1e3), draws.Rounded(50, 60, 1e3)});
        auto point = std::make_unique<CPointGen>("S" + std::to_string(s + 1), places.back().x,
                                                 places.back().y, places.back().z);
        if (s % 10 == 0) point->setInvariantXY(true);
        job.carnet.Add(std::move(point), kKindPoint);
        ++job.points;
    }
    auto stationAt = [&](int column, int row) {
        if (column < 0 || row < 0 || column >= columns) return -1;
        const int s = row * columns + (row % 2 == 0 ? column : columns - 1 - column);
        return s < stations ? s : -1;
    };

    std::vector<Place> previous, current;
    long long number = 1;
    for (int s = 0; s < stations; ++s) {
        const Place& place = places[static_cast<std::size_t>(s)];
        const double hi = draws.Rounded(1.45, 1.70, 1e3);
        const double v0 = draws.Rounded(0, 400, 1e5);
        job.carnet.Add(std::make_unique<CStation>("S" + std::to_string(s + 1), hi, v0), kKindStation);
        ++job.stations;
        // References: the nearest neighbours on the grid, across and then diagonally.
        const auto [column, row] = nodes[static_cast<std::size_t>(s)];
        int references = 0;
        for (auto [dc, dr] :
             {std::pair(1, 0), {-1, 0}, {0, 1}, {0, -1}, {1, 1}, {-1, -1}, {1, -1}, {-1, 1}}) {
            const int other = stationAt(column + dc, row + dr);
            if (other < 0 || references == kReferences) continue;
            AddMeasureFromCoordinates(job.carnet, place, hi, v0, "S" + std::to_string(other + 1),
                                      places[static_cast<std::size_t>(other)], 1.3);
            job.carnet.SetKindAt(job.carnet.GetSize() - 1, kKindReference);
            ++references;
            ++job.sightings;
        }
        // Its new points, then some of the station before's again (its own, for the first station).
        current.clear();
        const long long first = number;
        for (int k = 0; k < newPoints; ++k)
            current.push_back({std::round((place.x + draws.Uniform(-60, 60)) * 1e3) / 1e3,
                               std::round((place.y + draws.Uniform(-60, 60)) * 1e3) / 1e3,
                               draws.Rounded(45, 65, 1e3)});
        const std::vector<Place>& again = previous.empty() ? current : previous;
        const long long againFirst = previous.empty() ? first : first - newPoints;
        // A corner station with fewer neighbours measures more.
        for (int m = 0; m < kSightingsPerStation - references; ++m) {
            const bool own = m < newPoints;
            const int k = own ? m : (m - newPoints) % static_cast<int>(again.size());
            const long long target = own ? first + k : againFirst + k;
            AddMeasureFromCoordinates(job.carnet, place, hi, v0, std::to_string(target),
                                      own ? current[static_cast<std::size_t>(k)]
                                          : again[static_cast<std::size_t>(k)],
                                      k % 3 == 0 ? 2.0 : 1.3);
            ++job.sightings;
        }
        for (const Place& point : current) {
            job.carnet.Add(std::make_unique<CPointGen>(std::to_string(number++), point.x, point.y, point.z),
                           kKindPoint);
            ++job.points;
        }
        previous = current;
        // Each row of the grid is a traverse through its stations.
        if ((s + 1) % columns == 0 || s + 1 == stations) {
            auto traverse = std::make_unique<CChemin>("CHEM" + std::to_string(s / columns + 1));
            for (int t = s - s % columns; t <= s; ++t)
                traverse->add("S" + std::to_string(t + 1) + "(1)");
            job.carnet.Add(std::move(traverse), kKindChemin);
        }
    }
    return job;
}

} // namespace pyr::bench

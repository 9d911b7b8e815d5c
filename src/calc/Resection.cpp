#include "calc/Resection.h"

#include "calc/Corrections.h"
#include "calc/Rays.h"
#include "calc/ResectionTexts.h"
#include "calc/SessionTexts.h"
#include "core/Angles.h"

#include <Eigen/Dense>
#include <cmath>
#include <optional>
#include <vector>

namespace pyr {

namespace {

// Two directions within this (gr) of each other or of the opposite make a triple useless: the station
// lies on the line through their two points, which the triple cannot place it along.
constexpr double kAlignedDirections = 1e-6;
// Below this p² + q² (m²) the station lies on the circle through the triple's three points: from
// anywhere on that circle they are seen under the same angles, and the place is not fixed.
constexpr double kCocyclicLimit = 0.001;
// Two rays whose bearings differ by less than about 0.64 gr (|sine| up to 0.01) from 0 or 200 cross too
// flatly to place the station.
constexpr double kPairMinSine = 0.01;
// Two sightings on points closer than this (m) are on one point, read twice (in both faces, or in two
// rounds): they make no angle between two points, and no triple with a third.
constexpr double kSamePoint = 0.001;
// The least-squares step on X, Y and V0 needs one direction more than its three unknowns.
constexpr int kMinAdjusted = 4;

// A sighting from the station on a known point whose direction was read.
bool IsResectionSighting(const StationSighting& s) {
    return !s.onStation && IsKnown(s.x) && IsKnown(s.y) && IsKnown(s.ah);
}

// A sighting that gives a direction equation on the station's place: a resection sighting, or a sighting
// taken on the station from a placed station whose orientation is known.
bool GivesDirection(const StationSighting& s) {
    if (IsUndefined(s.x) || IsUndefined(s.y) || IsUndefined(s.ah)) return false;
    return !s.onStation || IsKnown(s.v0s);
}

// The computed less the observed direction of a sighting, were the station at (x, y) with the
// orientation v0, gr within [-200, 200]: for a resection sighting the bearing from the station to the
// point less V0 + AH; for an intersection sighting the bearing from the other station to this one less
// that station's V0 + AH. Undefined when the station lies on the known end.
double DirectionGap(const StationSighting& s, double x, double y, double v0) {
    if (s.x == x && s.y == y) return kUndefined;
    if (s.onStation) return CentredGrads(Bearing(s.x, s.y, x, y) - s.v0s - s.ah);
    return CentredGrads(Bearing(x, y, s.x, s.y) - v0 - s.ah);
}

bool NearlyAligned(double direction) {
    return std::fabs(direction) < kAlignedDirections || std::fabs(direction - 200.0) < kAlignedDirections ||
           std::fabs(direction - 400.0) < kAlignedDirections;
}

double Cotangent(double grads) {
    return CosGrads(grads) / SinGrads(grads);
}

// The approximate place from the best triple of resection sightings, by the classic solution of the
// three-point problem. With the directions alpha = AH(B) - AH(A) and beta = AH(C) - AH(A), the bearing
// GA from the station to A satisfies tan GA = p / q; the station then lies where the lines through A, B
// and C along GA, GA + alpha and GA + beta meet. The arctangent of the quotient leaves GA known only to
// 200 gr, which does not matter: a line along G is the line along G + 200.
//
// The triple with the largest p² + q² is taken; on a tie the later one in list order. The largest value
// met is kept even when its triple is then refused (on the circle, or without a pair of rays that cross
// well), so that it may shut out later triples: the station stays unplaced rather than taken from a
// weaker triple. The place is the mean of the crossings of the pairs of rays that meet well enough.
void ApproximatePlace(StationResult& result, const std::vector<int>& known) {
    // The angle from each sighting's direction to each later one's, and its cotangent, worked out once:
    // every triple (i, j, k) needs those from i to j and from i to k, and there are n³/6 triples.
    struct Angle {
        double grads = 0.0;
        double cot = 0.0;
        bool aligned = true;
        bool samePoint = false;
    };
    const std::size_t n = known.size();
    std::vector<Angle> angles(n * n);
    for (std::size_t i = 0; i < n; ++i)
        for (std::size_t j = i + 1; j < n; ++j) {
            Angle& angle = angles[i * n + j];
            const StationSighting& from = result.sightings[known[i]];
            const StationSighting& to = result.sightings[known[j]];
            angle.grads = WrapGrads(to.ah - from.ah);
            angle.samePoint = std::hypot(to.x - from.x, to.y - from.y) < kSamePoint;
            angle.aligned = angle.samePoint || NearlyAligned(angle.grads);
            if (!angle.aligned) angle.cot = Cotangent(angle.grads);
        }

    double most = 0.0;
    bool aligned = false, cocyclic = false;
    int chosen[3] = {-1, -1, -1};
    for (std::size_t i = 0; i < n; ++i)
        for (std::size_t j = i + 1; j < n; ++j)
            for (std::size_t k = j + 1; k < n; ++k) {
                const StationSighting& a = result.sightings[known[i]];
                const StationSighting& b = result.sightings[known[j]];
                const StationSighting& c = result.sightings[known[k]];
                const Angle& ab = angles[i * n + j];
                const Angle& ac = angles[i * n + k];
                if (ab.aligned || ac.aligned || angles[j * n + k].samePoint) {
                    aligned = true;
                    continue;
                }
                const double alpha = ab.grads, beta = ac.grads, cotAlpha = ab.cot, cotBeta = ac.cot;
                const double p = cotAlpha * (b.x - a.x) - cotBeta * (c.x - a.x) + (c.y - b.y);
                const double q = cotAlpha * (b.y - a.y) - cotBeta * (c.y - a.y) - (c.x - b.x);
                const double pq = p * p + q * q;
                if (!std::isfinite(pq) || pq < most) continue;
                most = pq;
                if (pq < kCocyclicLimit) {
                    cocyclic = true;
                    continue;
                }
                // q = 0: the station sees A due east or due west.
                const double ga = q == 0.0 ? 100.0 : RadiansToGrads(std::atan(p / q));
                const double gb = ga + alpha, gc = ga + beta;
                const struct {
                    const StationSighting& from;
                    double g1;
                    const StationSighting& to;
                    double g2;
                } pairs[] = {{a, ga, b, gb}, {b, gb, c, gc}, {a, ga, c, gc}};
                double sumX = 0.0, sumY = 0.0;
                int crossings = 0;
                for (const auto& pair : pairs) {
                    if (std::fabs(SinGrads(pair.g1 - pair.g2)) <= kPairMinSine) continue;
                    double x = 0.0, y = 0.0;
                    if (!IntersectRays(pair.from.x, pair.from.y, pair.g1, pair.to.x, pair.to.y, pair.g2, x,
                                       y))
                        continue;
                    sumX += x;
                    sumY += y;
                    ++crossings;
                }
                if (crossings == 0) {
                    aligned = true;
                    continue;
                }
                result.x0 = sumX / crossings;
                result.y0 = sumY / crossings;
                chosen[0] = known[i], chosen[1] = known[j], chosen[2] = known[k];
            }

    if (chosen[0] < 0) {
        if (aligned) return FailStation(result, kStationAligned, resec::kMsgAligned);
        if (cocyclic) return FailStation(result, kStationCocyclic, resec::kMsgCocyclic);
        return FailStation(result, kStationFailed, session::kMsgNotComputed);
    }
    for (int rank : chosen)
        result.sightings[rank].used = true;
}

// One unweighted least-squares step on the directions from the approximate place and orientation. The
// unknowns are the corrections to X, Y and V0; each row holds the derivatives of the computed direction
// (gr per metre, and -1 for V0 in a resection sighting), its misclosure is the computed less the
// observed direction. The step s solves (AtA) s = Atw, and since the computed direction moves by A s
// for a move s, the place moves by -s. Sets the computed place and orientation and returns the cofactor
// matrix (AtA)^-1; when the normal matrix is singular the approximate values stand, without cofactors.
std::optional<Eigen::Matrix3d> AdjustDirections(StationResult& result, const std::vector<int>& rows) {
    Eigen::MatrixXd a(static_cast<Eigen::Index>(rows.size()), 3);
    Eigen::VectorXd w(static_cast<Eigen::Index>(rows.size()));
    for (std::size_t k = 0; k < rows.size(); ++k) {
        const StationSighting& s = result.sightings[rows[k]];
        const auto row = static_cast<Eigen::Index>(k);
        if (s.onStation) {
            // The bearing from S to the station: d/dX = (Y - YS) / D², d/dY = -(X - XS) / D².
            const double dx = result.x0 - s.x, dy = result.y0 - s.y, d2 = dx * dx + dy * dy;
            a(row, 0) = RadiansToGrads(dy / d2);
            a(row, 1) = -RadiansToGrads(dx / d2);
            a(row, 2) = 0.0;
        } else {
            // The bearing from the station to the point: d/dX = -(Yi - Y) / D², d/dY = (Xi - X) / D².
            const double dx = s.x - result.x0, dy = s.y - result.y0, d2 = dx * dx + dy * dy;
            a(row, 0) = -RadiansToGrads(dy / d2);
            a(row, 1) = RadiansToGrads(dx / d2);
            a(row, 2) = -1.0;
        }
        w(row) = DirectionGap(s, result.x0, result.y0, result.v0Approx);
    }
    const Eigen::FullPivLU<Eigen::Matrix3d> lu(a.transpose() * a);
    if (!lu.isInvertible()) return std::nullopt;
    const Eigen::Vector3d step = lu.solve(a.transpose() * w);
    const Eigen::Matrix3d q = lu.inverse();
    if (!step.allFinite() || !q.allFinite()) return std::nullopt;
    result.x = result.x0 - step(0);
    result.y = result.y0 - step(1);
    result.v0 = WrapGrads(result.v0Approx - step(2));
    return q;
}

void ComputePlanimetry(StationResult& result) {
    std::vector<int> known;
    for (std::size_t i = 0; i < result.sightings.size(); ++i)
        if (IsResectionSighting(result.sightings[i])) known.push_back(static_cast<int>(i));
    if (known.size() < 3) return FailStation(result, kStationTooFew, resec::kMsgTooFew);

    ApproximatePlace(result, known);
    if (result.flags != 0) return;
    if (!ApproximateOrientation(result)) {
        for (StationSighting& s : result.sightings)
            s.used = false;
        result.x0 = result.y0 = kUndefined;
        return FailStation(result, kStationFailed, session::kMsgNotComputed);
    }
    AdjustStation(result);
    result.flags = kStationComputed;
}

// The height relation of a sighting with the station's altitude Z. The line of sight rises from the
// instrument to the target by `sign` x Z + `base`: for a resection sighting from the station (Z + HI) to
// the point (Zpoint + HP), sign -1; for an intersection sighting from the other station (ZS + HIS) to
// the target on this one (Z + HP), sign +1.
struct Levelling {
    double sign;
    double base;
};
bool LevellingOf(const StationSighting& s, double hi, Levelling& l) {
    if (IsUndefined(s.z) || IsUndefined(s.hp)) return false;
    if (s.onStation) {
        if (IsUndefined(s.his)) return false;
        l = {1.0, s.hp - s.z - s.his};
    } else {
        if (IsUndefined(hi)) return false;
        l = {-1.0, s.z + s.hp - hi};
    }
    return true;
}

// The zenith angle under which the sighting would be read were the station at altitude z, and its
// coefficient a: the change of that angle for a metre of altitude, negated, in gr/m. The curvature and
// refraction lower the target's apparent height by the same term the altitudes take into account.
struct Zenith {
    double angle;
    double a;
};
Zenith ZenithAt(const StationSighting& s, const Levelling& l, double z) {
    const double h = (l.sign * z + l.base - CurvatureRefraction(s.dh)) / s.dh;
    const double zc = 100.0 - RadiansToGrads(std::atan(h));
    const double sine = SinGrads(zc);
    return {zc, l.sign * RadiansToGrads(sine * sine / s.dh)};
}

} // namespace

void ResetStationOutputs(StationResult& result) {
    result.x0 = result.y0 = result.v0Approx = kUndefined;
    result.x = result.y = result.v0 = kUndefined;
    result.emqX = result.emqY = result.emqV0 = result.sigma0 = kUndefined;
    result.crossing = kUndefined;
    result.altitudes = 0;
    result.z0 = result.z = result.emqZ = kUndefined;
    result.flags = 0;
    result.status.clear();
    for (StationSighting& s : result.sightings) {
        s.used = false;
        s.v0 = s.v = s.e = s.vz = s.ez = s.zi = kUndefined;
    }
}

void FailStation(StationResult& result, int flag, const char* status) {
    result.flags = flag;
    result.status = status;
}

bool ApproximateOrientation(StationResult& result) {
    result.v0Approx = kUndefined;
    if (IsUndefined(result.x0) || IsUndefined(result.y0)) return false;
    double first = kUndefined, sum = 0.0;
    int count = 0;
    for (StationSighting& s : result.sightings) {
        if (!IsResectionSighting(s)) continue;
        s.v0 = kUndefined;
        if (s.x == result.x0 && s.y == result.y0) continue; // no bearing to the station's own place
        s.v0 = WrapGrads(Bearing(result.x0, result.y0, s.x, s.y) - s.ah);
        // Brought within 200 gr of the first, so that 399.99 and 0.01 average to 0, not 200.
        if (count == 0) first = s.v0;
        sum += NearGrads(s.v0, first);
        ++count;
    }
    if (count == 0) return false;
    result.v0Approx = WrapGrads(sum / count);
    return true;
}

void AdjustStation(StationResult& result) {
    result.x = result.y = result.v0 = kUndefined;
    result.emqX = result.emqY = result.emqV0 = result.sigma0 = kUndefined;
    if (IsUndefined(result.x0) || IsUndefined(result.y0) || IsUndefined(result.v0Approx)) return;
    result.x = result.x0;
    result.y = result.y0;
    result.v0 = result.v0Approx;

    // The sightings that give a direction at the approximate place; one whose known end lies on it has
    // none.
    std::vector<int> rows;
    for (std::size_t i = 0; i < result.sightings.size(); ++i) {
        const StationSighting& s = result.sightings[i];
        if (GivesDirection(s) && IsKnown(DirectionGap(s, result.x0, result.y0, result.v0Approx)))
            rows.push_back(static_cast<int>(i));
    }
    std::optional<Eigen::Matrix3d> cofactors;
    if (rows.size() >= static_cast<std::size_t>(kMinAdjusted)) cofactors = AdjustDirections(result, rows);

    // From the computed place: every sighting with a known end gets its horizontal distance, and every
    // direction its residual. Three sightings fix the place without residual.
    for (StationSighting& s : result.sightings) {
        s.v = s.e = kUndefined;
        if (IsUndefined(s.x) || IsUndefined(s.y)) continue;
        s.dh = std::hypot(result.x - s.x, result.y - s.y);
        if (!GivesDirection(s)) continue;
        s.v = DirectionGap(s, result.x, result.y, result.v0);
        if (IsKnown(s.v)) s.e = s.dh * SinGrads(s.v);
    }

    // The spread of the direction residuals, with three unknowns taken out, scales the cofactors.
    if (!cofactors) return;
    double sum = 0.0;
    int counted = 0;
    for (int i : rows) {
        const StationSighting& s = result.sightings[i];
        if (IsUndefined(s.v)) continue;
        sum += s.v * s.v;
        ++counted;
    }
    if (counted < kMinAdjusted) return;
    result.sigma0 = std::sqrt(sum / (counted - 3));
    const Eigen::Matrix3d& q = *cofactors;
    if (q(0, 0) >= 0.0) result.emqX = std::sqrt(q(0, 0)) * result.sigma0;
    if (q(1, 1) >= 0.0) result.emqY = std::sqrt(q(1, 1)) * result.sigma0;
    if (q(2, 2) >= 0.0) result.emqV0 = std::sqrt(q(2, 2)) * result.sigma0;
}

int ComputeResection(StationResult& result, bool plani, bool alti) {
    ResetStationOutputs(result);
    if (plani) ComputePlanimetry(result);
    if (alti) ComputeStationAltimetry(result);
    return result.flags;
}

// Altimetry over both kinds of sightings. Each sighting with a zenith angle and a horizontal distance
// gives the station's altitude: DH / tan z + the curvature and refraction is the rise of its line of
// sight. Their mean starts one least-squares step on the zenith angles, all of one precision. Each
// angle's coefficient a is (200/pi) sin² z / DH with the sign of the kind: negative for a resection
// sighting (a higher station sees its point lower), positive for an intersection sighting (a higher
// station is seen higher). The unweighted step on the angles is thus the mean of the altitudes weighted
// by a², the inverse variance of a height difference DH / tan z for an error of the zenith angle: short
// and level sightings count most. On exact data every altitude is the same and the step is zero.
void ComputeStationAltimetry(StationResult& result) {
    struct Used {
        StationSighting* s;
        Levelling l;
    };
    std::vector<Used> used;
    double sum = 0.0;
    for (StationSighting& s : result.sightings) {
        Levelling l;
        if (IsUndefined(s.av) || IsUndefined(s.dh) || !(s.dh > 0.0) || !LevellingOf(s, result.hi, l))
            continue;
        const double zenith = FoldedZenith(s.av);
        const double sine = SinGrads(zenith);
        if (sine == 0.0) continue; // vertical: no height difference from a horizontal distance
        const double rise = s.dh * CosGrads(zenith) / sine + CurvatureRefraction(s.dh);
        const double zi = l.sign * (rise - l.base);
        if (!std::isfinite(zi)) continue;
        s.zi = zi;
        sum += zi;
        used.push_back({&s, l});
    }
    if (used.empty()) return;
    const int m = static_cast<int>(used.size());
    result.altitudes = m;
    result.z0 = sum / m;
    result.z = result.z0;
    if (m == 1) return;

    double saa = 0.0, sar = 0.0;
    for (const Used& u : used) {
        const Zenith c = ZenithAt(*u.s, u.l, result.z0);
        saa += c.a * c.a;
        sar += c.a * (c.angle - FoldedZenith(u.s->av));
    }
    if (saa > 0.0 && std::isfinite(result.z0 + sar / saa)) result.z = result.z0 + sar / saa;

    // The residuals and the error from the computed altitude.
    saa = 0.0;
    double svv = 0.0;
    for (const Used& u : used) {
        const Zenith c = ZenithAt(*u.s, u.l, result.z);
        saa += c.a * c.a;
        u.s->vz = c.angle - FoldedZenith(u.s->av);
        u.s->ez = (CosGrads(c.angle) - CosGrads(u.s->av)) * u.s->dh;
        svv += u.s->vz * u.s->vz;
    }
    if (saa > 0.0) result.emqZ = std::sqrt(1.0 / saa) * std::sqrt(svv / (m - 1));
}

} // namespace pyr

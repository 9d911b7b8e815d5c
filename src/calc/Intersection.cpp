#include "calc/Intersection.h"

#include "calc/IntersectionTexts.h"
#include "calc/Rays.h"
#include "calc/SightingReduction.h"
#include "core/Angles.h"

#include <Eigen/Dense>
#include <cmath>
#include <optional>

namespace pyr {

namespace {

void ResetOutputs(InterResult& result) {
    result.first = result.second = -1;
    result.angle = kUndefined;
    result.x0 = result.y0 = result.x = result.y = kUndefined;
    result.emqX = result.emqY = result.sigma0 = kUndefined;
    result.altitudes = result.iterations = 0;
    result.z0 = result.z = result.emqZ = kUndefined;
    result.flags = 0;
    result.status.clear();
    for (InterSighting& s : result.sightings)
        s.v = s.e = s.vz = s.ez = s.zi = kUndefined;
}

void Fail(InterResult& result, int flag, const char* status) {
    result.flags = flag;
    result.status = status;
}

// One least-squares step on the directions from the approximate point, unweighted. The unknowns are the
// corrections to X0 and Y0; each direction's row holds the derivatives of its bearing in gr per metre.
// A sighting whose station lies on the approximate point has no direction there and no row. Sets the
// computed point and returns the cofactor matrix (AtA)^-1 in (m/gr)²; when the normal matrix is singular
// the approximate point stands and there is no cofactor matrix.
std::optional<Eigen::Matrix2d> AdjustDirections(InterResult& result, const std::vector<int>& usable) {
    result.x = result.x0;
    result.y = result.y0;
    std::vector<int> rows;
    for (int i : usable) {
        const InterSighting& s = result.sightings[i];
        const double dx = result.x0 - s.xs, dy = result.y0 - s.ys;
        if (dx * dx + dy * dy > 0.0) rows.push_back(i);
    }
    if (rows.size() < 2) return std::nullopt;

    Eigen::MatrixXd a(static_cast<Eigen::Index>(rows.size()), 2);
    Eigen::VectorXd w(static_cast<Eigen::Index>(rows.size()));
    for (std::size_t k = 0; k < rows.size(); ++k) {
        const InterSighting& s = result.sightings[rows[k]];
        const double dx = result.x0 - s.xs, dy = result.y0 - s.ys;
        const double d2 = dx * dx + dy * dy;
        const auto row = static_cast<Eigen::Index>(k);
        a(row, 0) = RadiansToGrads(dy / d2);
        a(row, 1) = -RadiansToGrads(dx / d2);
        // Computed less observed direction.
        w(row) = CentredGrads(WrapGrads(RadiansToGrads(std::atan2(dx, dy)) - s.v0) - s.ah);
    }
    const Eigen::FullPivLU<Eigen::Matrix2d> lu(a.transpose() * a);
    if (!lu.isInvertible()) return std::nullopt;
    const Eigen::Vector2d step = lu.solve(a.transpose() * w);
    const Eigen::Matrix2d q = lu.inverse();
    if (!step.allFinite() || !q.allFinite()) return std::nullopt;
    result.x = result.x0 - step(0);
    result.y = result.y0 - step(1);
    return q;
}

void ComputePlanimetry(InterResult& result) {
    std::vector<int> usable;
    for (std::size_t i = 0; i < result.sightings.size(); ++i)
        if (UsableInPlanimetry(result.sightings[i])) usable.push_back(static_cast<int>(i));
    if (usable.size() < 2) return Fail(result, kInterTooFew, inters::kMsgOneSighting);

    // The pair of rays from two different stations that meet under the widest angle; on a tie the first
    // pair in list order stays. Parallel rays meet under 0 gr and never make the pair.
    double best = 0.0;
    for (std::size_t p = 0; p < usable.size(); ++p)
        for (std::size_t q = p + 1; q < usable.size(); ++q) {
            const InterSighting& si = result.sightings[usable[p]];
            const InterSighting& sj = result.sightings[usable[q]];
            if (si.station == sj.station) continue;
            const double angle = IntersectionAngle(SightedBearing(si), SightedBearing(sj));
            if (angle > best) {
                best = angle;
                result.first = usable[p];
                result.second = usable[q];
            }
        }
    if (result.first < 0) return Fail(result, kInterParallel, inters::kMsgAllConfounded);
    result.angle = best;

    const InterSighting& a = result.sightings[result.first];
    const InterSighting& b = result.sightings[result.second];
    if (!IntersectRays(a.xs, a.ys, SightedBearing(a), b.xs, b.ys, SightedBearing(b), result.x0, result.y0))
        return Fail(result, kInterParallel, inters::kMsgAllConfounded);

    std::optional<Eigen::Matrix2d> cofactors;
    if (usable.size() == 2) {
        result.x = result.x0;
        result.y = result.y0;
    } else {
        cofactors = AdjustDirections(result, usable);
    }

    // From the computed point: every station with coordinates gets its horizontal distance, and every
    // direction its residual. Two rays meet without residual, unless they meet behind a station (200 gr).
    for (InterSighting& s : result.sightings) {
        if (IsUndefined(s.xs) || IsUndefined(s.ys)) continue;
        s.dh = std::hypot(result.x - s.xs, result.y - s.ys);
        if (s.dh == 0.0 || !UsableInPlanimetry(s)) continue;
        s.v = CentredGrads(Bearing(s.xs, s.ys, result.x, result.y) - s.ah - s.v0);
        s.e = s.dh * SinGrads(s.v);
    }

    // The spread of the direction residuals, with two unknowns taken out, scales the cofactors.
    if (cofactors) {
        double sum = 0.0;
        int counted = 0;
        for (int i : usable) {
            const InterSighting& s = result.sightings[i];
            if (IsUndefined(s.v)) continue;
            sum += s.v * s.v;
            ++counted;
        }
        if (counted > 2) {
            result.sigma0 = std::sqrt(sum / (counted - 2));
            const Eigen::Matrix2d& q = *cofactors;
            if (q(0, 0) >= 0.0) result.emqX = std::sqrt(q(0, 0)) * result.sigma0;
            if (q(1, 1) >= 0.0) result.emqY = std::sqrt(q(1, 1)) * result.sigma0;
        }
    }
    result.flags = kInterComputed;
    if (best < kInterMinAngle) result.flags |= kInterTooClose;
}

// The zenith angle, in gr, under which a station sees the point at altitude z, and the derivative of
// that angle with respect to z, negated (gr per metre). The curvature and refraction lift the point's
// apparent height by the same term the altitudes add.
struct Zenith {
    double angle;
    double slope;
};
Zenith ZenithTo(const InterSighting& s, double z) {
    const double h = (z - s.zs - s.hi + s.hp - CurvatureRefraction(s.dh)) / s.dh;
    const double zc = 100.0 - RadiansToGrads(std::atan(h));
    const double sine = SinGrads(zc);
    return {zc, RadiansToGrads(sine * sine / s.dh)};
}

void ComputeAltimetry(InterResult& result) {
    std::vector<InterSighting*> used;
    double sum = 0.0;
    for (InterSighting& s : result.sightings) {
        if (IsUndefined(s.av) || IsUndefined(s.zs) || IsUndefined(s.hi) || IsUndefined(s.hp)) continue;
        if (IsUndefined(s.dh) || !(s.dh > 0.0)) continue;
        const double zenith = FoldedZenith(s.av);
        const double sine = SinGrads(zenith);
        if (sine == 0.0) continue; // vertical: no height difference from a horizontal distance
        const double zi = s.zs + s.hi - s.hp + s.dh * CosGrads(zenith) / sine + CurvatureRefraction(s.dh);
        if (!std::isfinite(zi)) continue;
        s.zi = zi;
        sum += zi;
        used.push_back(&s);
    }
    if (used.empty()) return;
    const int m = static_cast<int>(used.size());
    result.altitudes = m;
    result.z0 = sum / m;
    result.z = result.z0;
    if (m == 1) return;

    // Gauss-Newton on the zenith angles from the mean altitude.
    double z = result.z0;
    while (result.iterations < kInterMaxIterations) {
        double sff = 0.0, sfr = 0.0;
        for (const InterSighting* s : used) {
            const Zenith c = ZenithTo(*s, z);
            sff += c.slope * c.slope;
            sfr += c.slope * (c.angle - FoldedZenith(s->av));
        }
        if (!(sff > 0.0)) break;
        const double delta = sfr / sff;
        if (!std::isfinite(delta) || !std::isfinite(z + delta)) break;
        z += delta;
        ++result.iterations;
        if (std::fabs(delta) <= kInterAltitudeStep) break;
    }
    result.z = z;

    // The residuals and the error from the computed altitude.
    double sff = 0.0, svv = 0.0;
    for (InterSighting* s : used) {
        const Zenith c = ZenithTo(*s, z);
        sff += c.slope * c.slope;
        s->vz = c.angle - FoldedZenith(s->av);
        s->ez = (CosGrads(c.angle) - CosGrads(s->av)) * s->dh;
        svv += s->vz * s->vz;
    }
    if (sff > 0.0) result.emqZ = std::sqrt(1.0 / sff) * std::sqrt(svv / (m - 1));
}

} // namespace

double SightedBearing(const InterSighting& s) {
    return IsKnown(s.v0) && IsKnown(s.ah) ? WrapGrads(s.v0 + s.ah) : kUndefined;
}

bool UsableInPlanimetry(const InterSighting& s) {
    return IsKnown(s.xs) && IsKnown(s.ys) && IsKnown(s.v0) && IsKnown(s.ah);
}

int ComputeIntersection(InterResult& result, bool plani, bool alti) {
    ResetOutputs(result);
    if (plani) ComputePlanimetry(result);
    if (alti) ComputeAltimetry(result);
    return result.flags;
}

} // namespace pyr

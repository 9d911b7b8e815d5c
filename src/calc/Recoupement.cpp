#include "calc/Recoupement.h"

#include "calc/Corrections.h"
#include "calc/Rays.h"
#include "calc/RecoupementTexts.h"
#include "calc/SessionTexts.h"
#include "core/Angles.h"

#include <cmath>
#include <vector>

namespace pyr {

namespace {

// A place that sees its two known points under an angle that differs from the measured one by more than
// this (gr) lies on the other arc of the circle: there the angle is the measured one plus 200.
constexpr double kMaxAngleGap = 100.0;

// A sighting that takes part in the planimetry: its known end placed and its direction read; for an
// intersection sighting, the orientation of the station that took it.
bool UsableInPlanimetry(const StationSighting& s) {
    if (IsUndefined(s.x) || IsUndefined(s.y) || IsUndefined(s.ah)) return false;
    return !s.onStation || IsKnown(s.v0s);
}

// The circle of the places from which B is seen at `gamma` gr clockwise from A. Its centre lies on the
// perpendicular bisector of AB, at (d / 2) cot(gamma) from the midpoint on the right of A -> B (the
// bisector makes 100 - gamma / 2 with AB at A), and its radius is (d / 2) / |sin(gamma)|. A and B on one
// place, or an angle within 0.06 mgon of 0 or 200 (the station on the line AB), give no circle.
struct Circle {
    double xc = 0.0, yc = 0.0, r = 0.0;
};
bool SeeingCircle(double xa, double ya, double xb, double yb, double gamma, Circle& circle) {
    const double bx = xb - xa, by = yb - ya;
    const double d = std::hypot(bx, by);
    const double sine = SinGrads(gamma);
    if (!(d > 0.0) || std::fabs(sine) < kParallelRaysSine) return false;
    const double halfCot = 0.5 * CosGrads(gamma) / sine;
    // (by, -bx) / d points to the right of A -> B, at the bearing G(A -> B) + 100.
    circle.xc = 0.5 * (xa + xb) + halfCot * by;
    circle.yc = 0.5 * (ya + yb) - halfCot * bx;
    circle.r = 0.5 * d / std::fabs(sine);
    return std::isfinite(circle.xc) && std::isfinite(circle.yc) && std::isfinite(circle.r);
}

// One approximate place: where the line of an intersection sighting meets the circle of a pair of
// resection sightings, with the angle under which they cross, gr, in [0, 100].
struct Candidate {
    double x, y;
    double quality;
    int line, first, second; // ranks of the three sightings in result.sightings
};

// Every place that the lines and the circles give and that the checks keep: intersection sightings in
// list order, then the pairs of resection sightings in list order, then the places along the line from
// the station that sighted.
std::vector<Candidate> Candidates(const StationResult& result, const std::vector<int>& lines,
                                  const std::vector<int>& known) {
    std::vector<Candidate> candidates;
    for (int i : lines) {
        const StationSighting& s = result.sightings[i];
        const double g = WrapGrads(s.v0s + s.ah);
        // The line from the sighting station, given by that station and the point 100 m along it.
        const double x2 = s.x + 100.0 * SinGrads(g), y2 = s.y + 100.0 * CosGrads(g);
        for (std::size_t p = 0; p < known.size(); ++p)
            for (std::size_t q = p + 1; q < known.size(); ++q) {
                const StationSighting& a = result.sightings[known[p]];
                const StationSighting& b = result.sightings[known[q]];
                const double gamma = WrapGrads(b.ah - a.ah);
                Circle c;
                if (!SeeingCircle(a.x, a.y, b.x, b.y, gamma, c)) continue;
                const LineCircle cut = IntersectLineCircle(s.x, s.y, x2, y2, c.xc, c.yc, c.r);
                for (int k = 0; k < cut.count; ++k) {
                    const double x = cut.x[k], y = cut.y[k];
                    if (std::hypot(x - a.x, y - a.y) <= kRecoupNearKnown ||
                        std::hypot(x - b.x, y - b.y) <= kRecoupNearKnown)
                        continue;
                    const double seen = Bearing(x, y, b.x, b.y) - Bearing(x, y, a.x, a.y);
                    if (std::fabs(CentredGrads(seen - gamma)) > kMaxAngleGap) continue;
                    // The tangent to the circle at the place is square to the radius: 100 gr off the
                    // bearing from the centre.
                    const double tangent = Bearing(c.xc, c.yc, x, y) + 100.0;
                    candidates.push_back({x, y, IntersectionAngle(g, tangent), i, known[p], known[q]});
                }
            }
    }
    return candidates;
}

// The place that most others agree with. The places are grouped in order: each joins the first group
// whose representative lies within kRecoupAgreement, and replaces it when it crosses under a strictly
// wider angle. The largest group wins (the first on a tie), provided it holds two places at least,
// unless only one place was found in all. The rank of the chosen place, or -1.
int ChooseCandidate(const std::vector<Candidate>& candidates) {
    struct Group {
        int representative;
        int members;
    };
    std::vector<Group> groups;
    for (std::size_t i = 0; i < candidates.size(); ++i) {
        const Candidate& c = candidates[i];
        bool joined = false;
        for (Group& group : groups) {
            const Candidate& r = candidates[group.representative];
            if (std::hypot(c.x - r.x, c.y - r.y) > kRecoupAgreement) continue;
            ++group.members;
            if (c.quality > r.quality) group.representative = static_cast<int>(i);
            joined = true;
            break;
        }
        if (!joined) groups.push_back({static_cast<int>(i), 1});
    }
    const int least = candidates.size() == 1 ? 1 : 2;
    int chosen = -1, most = 0;
    for (const Group& group : groups)
        if (group.members >= least && group.members > most) {
            most = group.members;
            chosen = group.representative;
        }
    return chosen;
}

void ComputePlanimetry(StationResult& result) {
    std::vector<int> lines, known;
    for (std::size_t i = 0; i < result.sightings.size(); ++i) {
        const StationSighting& s = result.sightings[i];
        if (!UsableInPlanimetry(s)) continue;
        (s.onStation ? lines : known).push_back(static_cast<int>(i));
    }
    if (lines.empty() || known.size() < 2) return FailStation(result, kStationTooFew, recoup::kMsgTooFew);

    const std::vector<Candidate> candidates = Candidates(result, lines, known);
    const int chosen = ChooseCandidate(candidates);
    // A crossing of exactly 0 gr is a line that touches its circle: the place along it is not fixed.
    if (chosen < 0 || candidates[chosen].quality == 0.0)
        return FailStation(result, kStationFailed, session::kMsgNotComputed);
    const Candidate& c = candidates[chosen];
    result.sightings[c.line].used = true;
    result.sightings[c.first].used = true;
    result.sightings[c.second].used = true;
    result.x0 = c.x;
    result.y0 = c.y;
    result.crossing = c.quality;

    if (!ApproximateOrientation(result)) {
        for (StationSighting& s : result.sightings)
            s.used = false;
        result.x0 = result.y0 = result.crossing = kUndefined;
        return FailStation(result, kStationFailed, session::kMsgNotComputed);
    }
    AdjustStation(result);
    result.flags = kStationComputed;
    if (c.quality < kRecoupMinCrossing) result.flags |= kStationWeakCrossing;
}

} // namespace

LineCircle IntersectLineCircle(double x1, double y1, double x2, double y2, double xc, double yc, double r) {
    LineCircle cut;
    const double length = std::hypot(x2 - x1, y2 - y1);
    if (!(length > 0.0) || !(r > 0.0) || !std::isfinite(length) || !std::isfinite(r)) return cut;
    // Unit vector along the line; the foot of the perpendicular from the centre lies at t0 along it from
    // the first point, and the centre at the distance |h| from the line.
    const double ux = (x2 - x1) / length, uy = (y2 - y1) / length;
    const double wx = xc - x1, wy = yc - y1;
    const double t0 = wx * ux + wy * uy;
    const double h = std::fabs(wx * uy - wy * ux);
    if (h > r + kTangentTolerance) return cut;
    if (std::fabs(h - r) <= kTangentTolerance) {
        cut.count = 1;
        cut.x[0] = x1 + t0 * ux;
        cut.y[0] = y1 + t0 * uy;
        return cut;
    }
    // Half the chord; (r - h)(r + h) keeps its precision when h is close to r.
    const double half = std::sqrt((r - h) * (r + h));
    cut.count = 2;
    for (int k = 0; k < 2; ++k) {
        const double t = k == 0 ? t0 - half : t0 + half;
        cut.x[k] = x1 + t * ux;
        cut.y[k] = y1 + t * uy;
    }
    return cut;
}

int ComputeRecoupement(StationResult& result, bool plani, bool alti) {
    ResetStationOutputs(result);
    if (plani) ComputePlanimetry(result);
    if (alti) ComputeStationAltimetry(result);
    return result.flags;
}

} // namespace pyr

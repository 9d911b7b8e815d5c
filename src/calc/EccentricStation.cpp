#include "calc/EccentricStation.h"

#include "calc/Corrections.h"
#include "calc/EccentricTexts.h"
#include "calc/SessionTexts.h"
#include "core/Angles.h"

#include <cmath>
#include <vector>

namespace pyr {

namespace {

void ResetSightingPlanimetry(EccentricSighting& s) {
    s.d = s.g = s.v0 = s.ev0 = kUndefined;
}

void ResetOutputs(EccentricResult& result) {
    result.x = result.y = result.v0 = kUndefined;
    result.iterations = 0;
    result.z = result.z0 = result.emqZ = kUndefined;
    result.altitudes = 0;
    result.flags = 0;
    result.status.clear();
    for (EccentricSighting& s : result.sightings) {
        ResetSightingPlanimetry(s);
        s.zi = s.eav = kUndefined;
    }
}

void Fail(EccentricResult& result, int flag) {
    result.flags = flag;
    result.status = session::kMsgNotComputed;
    for (EccentricSighting& s : result.sightings)
        ResetSightingPlanimetry(s);
}

bool UsableInPlanimetry(const EccentricSighting& s) {
    return IsKnown(s.x) && IsKnown(s.y) && IsKnown(s.ah);
}

// The orientation of a station set up at (x, y): each reference sighting gives V0i = G(E -> point) - AH,
// brought within 200 gr of the first one's so that values either side of the zero average, and V0 is
// their mean weighted by the distances. A direction on a far point fixes the orientation better than one
// on a near point, whose bearing a centimetre of E swings by much more. A point on E itself has no
// bearing and no weight. Fills the sightings' d, g, v0 and ev0; false when no sighting gives a V0.
bool OrientFrom(EccentricResult& result, double x, double y, double& v0) {
    double first = kUndefined, weights = 0.0, weighted = 0.0;
    for (EccentricSighting& s : result.sightings) {
        ResetSightingPlanimetry(s);
        if (!UsableInPlanimetry(s)) continue;
        s.d = std::hypot(s.x - x, s.y - y);
        if (!(s.d > 0.0)) continue;
        s.g = Bearing(x, y, s.x, s.y);
        double v = WrapGrads(s.g - s.ah);
        if (IsUndefined(first))
            first = v;
        else
            v = NearGrads(v, first);
        s.v0 = v;
        weights += s.d;
        weighted += s.d * v;
    }
    if (!(weights > 0.0)) return false;
    const double mean = weighted / weights;
    if (!std::isfinite(mean)) return false;
    for (EccentricSighting& s : result.sightings)
        if (IsKnown(s.v0)) s.ev0 = mean - s.v0;
    v0 = WrapGrads(mean);
    return true;
}

// The fixed point: from E = C, orient the station from where E is, then put E back at the distance dhC
// from C, on the reverse of the bearing that this orientation gives to the sighting on C; until a pass
// moves E by less than kExcentConvergence in X and in Y.
void ComputePlanimetry(EccentricResult& result) {
    bool usable = false;
    for (const EccentricSighting& s : result.sightings)
        usable = usable || UsableInPlanimetry(s);
    if (!usable || IsUndefined(result.xC) || IsUndefined(result.yC) || IsUndefined(result.ahC) ||
        IsUndefined(result.dhC) || !(result.dhC > 0.0))
        return Fail(result, kExcentIncomplete);

    double x = result.xC, y = result.yC, v0 = kUndefined;
    for (int pass = 1; pass <= kExcentMaxIterations; ++pass) {
        if (!OrientFrom(result, x, y, v0)) return Fail(result, kExcentNoConvergence);
        const double fromC = WrapGrads(v0 + result.ahC + 200.0); // bearing C -> E
        const double nx = result.xC + result.dhC * SinGrads(fromC);
        const double ny = result.yC + result.dhC * CosGrads(fromC);
        result.iterations = pass;
        const bool settled = std::fabs(nx - x) < kExcentConvergence && std::fabs(ny - y) < kExcentConvergence;
        x = nx;
        y = ny;
        if (settled) {
            result.x = x;
            result.y = y;
            result.v0 = v0;
            result.flags = kExcentComputed;
            return;
        }
    }
    Fail(result, kExcentNoConvergence);
}

// From the sighting on C: E lies HI + DH cot z + the curvature and refraction term below C's target.
void AltitudeFromCentre(EccentricResult& result) {
    if (IsUndefined(result.hi) || IsUndefined(result.hpC) || IsUndefined(result.avC)) return;
    if (IsUndefined(result.dhC) || !(result.dhC > 0.0)) return;
    const double zenith = FoldedZenith(result.avC);
    const double sine = SinGrads(zenith);
    if (sine == 0.0) return; // vertical: no height difference from a horizontal distance
    const double z = result.zC + result.hpC - result.hi - result.dhC * CosGrads(zenith) / sine -
                     CurvatureRefraction(result.dhC);
    if (std::isfinite(z)) result.z = z;
}

// From the reference points, from E's place: each one with an altitude and a zenith angle gives
// Zi = Zpoint + HP - HI - D cot z (with no curvature term on these sightings). Two or more are weighted
// by a² with a = sin²z / D, the sensitivity of the zenith angle to the altitude of E (per metre, in
// radians): a near, level sighting fixes the altitude best.
void AltitudeFromReferences(EccentricResult& result) {
    if (IsUndefined(result.hi) || IsUndefined(result.x)) return;
    struct Used {
        EccentricSighting* s;
        double zenith, a;
    };
    std::vector<Used> used;
    double sum = 0.0;
    for (EccentricSighting& s : result.sightings) {
        if (IsUndefined(s.z) || IsUndefined(s.av) || IsUndefined(s.hp)) continue;
        if (IsUndefined(s.d) || !(s.d > 0.0)) continue;
        const double zenith = FoldedZenith(s.av);
        const double sine = SinGrads(zenith);
        if (sine == 0.0) continue;
        const double zi = s.z - result.hi + s.hp - s.d * CosGrads(zenith) / sine;
        if (!std::isfinite(zi)) continue;
        s.zi = zi;
        sum += zi;
        used.push_back({&s, zenith, sine * sine / s.d});
    }
    if (used.empty()) return;
    const int m = static_cast<int>(used.size());
    result.altitudes = m;
    result.z0 = sum / m;
    result.z = result.z0;

    // One Gauss-Newton step from the mean: the mean of the Zi weighted by a².
    double saa = 0.0;
    if (m >= 2) {
        double sad = 0.0;
        for (const Used& u : used) {
            saa += u.a * u.a;
            sad += u.a * u.a * (u.s->zi - result.z0);
        }
        if (saa > 0.0 && std::isfinite(result.z0 + sad / saa)) result.z = result.z0 + sad / saa;
    }

    // The zenith angle each point is seen under from the computed altitude: atan(D / height difference),
    // on the far side of the horizon (beyond 100 gr) for a point lower than the instrument, level for none.
    double svv = 0.0;
    for (const Used& u : used) {
        const double rise = u.s->z - result.z - result.hi + u.s->hp;
        double computed = 100.0;
        if (rise != 0.0) computed = RadiansToGrads(std::atan(u.s->d / rise)) + (rise < 0.0 ? 200.0 : 0.0);
        u.s->eav = computed - u.zenith;
        svv += u.s->eav * u.s->eav;
    }
    // The figure shown in the listing under "EMQ (cm)": √(1/Σa²), in metres, times the root-mean-square
    // zenith residual taken in grads, with no conversion between grads and radians, so neither metres nor
    // centimetres. It is kept exactly so because it is the figure surveyors have always read on this listing
    // and compare from one job to the next.
    if (m >= 2 && saa > 0.0) {
        const double emq = std::sqrt(1.0 / saa) * std::sqrt(svv / (m - 1));
        if (std::isfinite(emq)) result.emqZ = emq;
    }
}

} // namespace

int ComputeEccentricStation(EccentricResult& result, bool plani, bool alti) {
    ResetOutputs(result);
    if (plani) ComputePlanimetry(result);
    if (alti) {
        if (IsKnown(result.zC))
            AltitudeFromCentre(result);
        else
            AltitudeFromReferences(result);
    }
    return result.flags;
}

} // namespace pyr

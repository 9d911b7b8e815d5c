#pragma once

#include "core/Undefined.h"

#include <string>
#include <vector>

// The computation of a station by resection: the station's place (X, Y), orientation (V0) and altitude
// from its sightings on known points. The best triple of sightings gives an approximate place, one
// least-squares step on X, Y and V0 refines it from four sightings on, and one Gauss-Newton step on the
// zenith angles gives the altitude. The combined method (Recoupement.h) shares these records: its
// sightings may also be taken on the station from other stations already placed and oriented. Angles in
// grads, bearings clockwise from the +Y axis (X is the easting), lengths and coordinates in metres. A
// value that is not known, or that the geometry cannot give, is kUndefined: never NaN or infinity.
namespace pyr {

// One sighting of the computation: inputs filled by the gathering, outputs by the computation. The
// sighting arrives turned to face left and reduced for eccentric offsets and instrument constants; its
// horizontal distance is corrected for scale.
struct StationSighting {
    // Inputs.
    int index = -1; // the sighting element in the GéoBase
    // False for a sighting taken from the station on a known point (a resection sighting); true for a
    // sighting taken on the station from another station already placed and oriented (an intersection
    // sighting, in the combined method only).
    bool onStation = false;
    std::string reference; // the known point sighted, or the station that sighted, as the list shows it
    int reprise = 0;       // that other station's occurrence (intersection sightings)
    // The known end of the line of sight: the point sighted, or the station that sighted, m.
    double x = kUndefined;
    double y = kUndefined;
    double z = kUndefined;
    double v0s = kUndefined; // the orientation of that other station, gr (intersection sightings)
    double his = kUndefined; // its instrument height with its vertical offset, m (intersection sightings)
    double hp = kUndefined;  // target height, m (0 when target heights are not used)
    double ah = kUndefined;  // horizontal direction, gr
    double av = kUndefined;  // zenith angle, gr (0 at the zenith, 100 level)
    double di = kUndefined;  // slope distance, m
    // Horizontal distance, m: measured (corrected) on input; once the station's planimetry is computed,
    // the distance between the station and the known end, which is also the one the altimetry uses.
    double dh = kUndefined;

    // Outputs.
    bool used = false;      // one of the three sightings of the approximate solution
    double v0 = kUndefined; // the V0 this sighting alone gives from the approximate place (resection)
    double v = kUndefined;  // direction residual, gr, within [-200, 200]
    double e = kUndefined;  // its linear value across the line of sight, m: DH x sin(v)
    double vz = kUndefined; // zenith residual, gr: computed zenith angle less the measured one
    double ez = kUndefined; // its linear value, m: (cos zc - cos AV) x DH
    double zi = kUndefined; // the station's altitude this sighting alone gives, m
};

// Flags of a computation, in StationResult::flags.
enum : int {
    kStationComputed = 1,     // the planimetry was computed
    kStationWeakCrossing = 4, // computed, but the line meets the circle under less than 5 gr (combined)
    kStationTooFew = 8,       // too few sightings for the planimetry
    kStationAligned = 0x100,  // every triple aligned, or no pair of rays that meet
    kStationCocyclic = 0x200, // the station lies on the circle through its known points
    kStationFailed = 0x400,   // no solution (the combined method's checks left none)
};

// One station and its computation.
struct StationResult {
    int stationIndex = -1;  // the station element
    std::string station;    // the station's name: the point that receives X, Y and Z
    int reprise = 1;        // its occurrence, "%s (%d)"
    double hi = kUndefined; // its instrument height with its vertical offset, m
    std::vector<StationSighting> sightings;

    // Planimetry.
    double x0 = kUndefined; // approximate place, m
    double y0 = kUndefined;
    double v0Approx = kUndefined; // approximate orientation, gr
    double x = kUndefined;        // computed place, m
    double y = kUndefined;
    double v0 = kUndefined;   // computed orientation, gr, in [0, 400)
    double emqX = kUndefined; // root-mean-square errors, m and gr (four sightings or more)
    double emqY = kUndefined;
    double emqV0 = kUndefined;
    double sigma0 = kUndefined;   // root-mean-square direction residual, gr
    double crossing = kUndefined; // combined: the angle between the line and the circle, gr, in [0, 100]

    // Altimetry.
    int altitudes = 0;        // sightings that gave an altitude
    double z0 = kUndefined;   // mean of the sightings' altitudes, m
    double z = kUndefined;    // computed altitude, m
    double emqZ = kUndefined; // its root-mean-square error, m (two altitudes or more)

    int flags = 0;
    std::string status; // the French text of a failure of the planimetry, "" otherwise
};

// Computes the station from its resection sightings (onStation false): the planimetry when `plani`, the
// altimetry when `alti`. The outputs of the result and of its sightings are reset first, and those of a
// part switched off stay undefined. With the planimetry off or failed, the altimetry works from the
// measured horizontal distances and the station's place stays unknown. Returns result.flags.
int ComputeResection(StationResult& result, bool plani, bool alti);

// ---- Steps the combined method shares.
// Every output of the result and of its sightings back to unknown, the flags and status cleared.
void ResetStationOutputs(StationResult& result);
// A planimetry that failed: its flag and the French text of the status line.
void FailStation(StationResult& result, int flag, const char* status);
// Once its approximate place (x0, y0) is found:
// The approximate orientation from the resection sightings: each one's V0 (the bearing from the
// approximate place to its point, less AH) brought within 200 gr of the first one's, and their mean, in
// [0, 400). Sets result.v0Approx and each resection sighting's v0; false when no sighting gives one.
bool ApproximateOrientation(StationResult& result);
// From the approximate place and orientation: with four sightings or more, one unweighted least-squares
// step on X, Y and V0 over both kinds of sightings, with its errors; with three, the approximate values
// stand. Then every sighting's distance from the computed place and its direction residual. Sets x, y,
// v0, emqX, emqY, emqV0, sigma0 and the sightings' dh, v and e.
void AdjustStation(StationResult& result);
// The station's altitude from the zenith angles of both kinds of sightings (those with an angle, a
// horizontal distance and the heights they need): each gives an altitude, their mean starts one
// least-squares step on the angles, which gives Z and its error from two altitudes on. Sets altitudes,
// z0, z, emqZ and the sightings' zi, vz and ez; uses the sightings' dh as they stand.
void ComputeStationAltimetry(StationResult& result);

} // namespace pyr

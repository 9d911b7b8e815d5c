#pragma once

#include "calc/Corrections.h"
#include "core/Undefined.h"
#include "settings/CalcOptions.h"
#include "settings/OptionInstruments.h"

#include <string>
#include <string_view>

// A sighting as every computation uses it: taken from the GéoBase with the place and orientation of its
// station, corrected for the instrument's constants, turned to face left, reduced for the target's
// eccentric offsets, and its horizontal distance corrected for scale. Angles in grads, lengths in metres;
// an unknown value is kUndefined.
namespace pyr {

class CCarnet;

// A station occurrence and its place: the station point's coordinates, the instrument height above it
// (with the station's own vertical eccentric offset) and the orientation the GéoBase gives it.
struct StationPlace {
    int index = -1; // of the station element
    std::string name;
    int reprise = 1; // its rank among the set-ups on the same point
    double x = kUndefined;
    double y = kUndefined;
    double z = kUndefined;
    double hi = kUndefined;
    double v0 = kUndefined; // known when >= 0

    bool HasPlace() const { return IsKnown(x) && IsKnown(y); }
    bool IsOriented() const { return IsKnown(v0) && v0 >= 0.0; }
    std::string Designation() const; // "S1(2)"
};

// The station occurrence at that index, placed by the points of the GéoBase.
StationPlace StationPlaceAt(const CCarnet& carnet, int stationIndex);
// The same with the place of its point already found (as PointPlaceOf finds it, kept for many stations).
StationPlace StationPlaceAt(const CCarnet& carnet, int stationIndex, double x, double y, double z);

// The planimetry and altitude of a point, each from the first of its elements that holds it. False when
// its planimetry is unknown (x and y are then kUndefined; z may still be known).
bool PointPlace(const CCarnet& carnet, std::string_view mat, double& x, double& y, double& z);
// The same for the point the element at `index` names (a sighting of it, say), without a search by name.
bool PointPlaceOf(const CCarnet& carnet, int index, double& x, double& y, double& z);

// The eccentric offsets written in front of an element, back to `limit` (excluded): radial along the line
// of sight, tangential across it, vertical upwards, in metres; 0 when none.
struct EccentricOffsets {
    double radial = 0.0;
    double tangential = 0.0;
    double vertical = 0.0;
};
EccentricOffsets EccentricOffsetsOf(const CCarnet& carnet, int element, int limit);

// The systematic corrections of an instrument: its vertical collimation (grads, added to zenith angles)
// and its prism constant (metres, added to measured distances).
struct InstrumentConstants {
    double verticalCollimation = 0.0;
    double prismConstant = 0.0;
};
// Those of the instrument element in force at the station, else of the options' default instrument.
InstrumentConstants InstrumentConstantsAt(const CCarnet& carnet, int stationIndex,
                                          const InstrumentOptions& byDefault);
// Adds them to a known zenith angle and a measured (positive) distance.
void ApplyInstrumentConstants(double& av, double& di, const InstrumentConstants& constants);
// The instrument of the stations that follow no instrument element: its number in the list of instruments.
inline constexpr const char* kKeyDefaultInstrument = "AppareilParDefaut";
InstrumentOptions DefaultInstrument(std::string_view paramPath); // from the calculation options

// How a computation reduces its sightings.
struct SightingReductionOptions {
    bool instrumentConstants = false; // add the instrument's collimation and prism constant
    bool targetHeights = true;        // use the target heights and vertical offsets; else HP is 0
    InstrumentOptions defaultInstrument{kStandardInstrument};
    DistanceCorrection correction;
};

// One sighting reduced for a computation.
struct ReducedSighting {
    int index = -1;  // of the sighting element
    std::string mat; // the point sighted
    double hp = kUndefined;
    double ah = kUndefined; // face left, reduced for the radial and tangential offsets
    double av = kUndefined; // face left (< 200), with the collimation
    double di = kUndefined; // reduced slope distance, with the prism constant; not positive when unmeasured
    double dh = kUndefined; // di × sin(av) corrected for scale at the station, kUndefined without distance
    // sin(av) and cos(av), for the height difference and its tolerance: known when di is positive and
    // av known, that is whenever dh is known.
    double sinAv = kUndefined;
    double cosAv = kUndefined;
    bool faceRight = false; // it was read face right and turned
};

// Reduces the sighting element `sighting` of that station: the instrument constants (when asked), the
// turn to face left, the target's eccentric offsets (the vertical one only with target heights), then the
// horizontal distance, corrected for scale at the station's place. An element that is no sighting gives
// a record whose index is -1.
ReducedSighting ReduceSighting(const CCarnet& carnet, const StationPlace& station, int sighting,
                               const SightingReductionOptions& options);

// The trigonometric height difference from the station's ground to the target's ground over a corrected
// horizontal distance Dh and a zenith angle: Dh / tan(AV) + HI − HP + curvature and refraction.
double TrigonometricHeightDifference(double dh, double zenith, double hi, double hp);
// The same from the sine and cosine of the zenith angle (a reduced sighting's sinAv and cosAv).
double TrigonometricHeightDifference(double dh, double sinZ, double cosZ, double hi, double hp);

} // namespace pyr

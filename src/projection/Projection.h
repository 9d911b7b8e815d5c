#pragma once

#include <memory>
#include <string>
#include <string_view>

// The projection of a job's coordinates: its linear alteration (the scale of the map against the
// ellipsoid at a place) and the reduction of a distance to the level surface, both in parts per
// million, and the conversion of coordinates into another system.
//
// Names: "Aucune" (local coordinates: no alteration), "Lambert 93", "CC42" to "CC50", the NTF Lambert
// zones ("Lambert I" to "Lambert IV", "Lambert II étendu", "Lambert II Centre" ...), "UTM 31N" and the
// other UTM zones of WGS 84, or any "EPSG:nnnn" of a projected system. Case and blanks do not matter
// (ProjectionNames.h). Coordinates are always easting X, northing Y, in the system's own unit.
//
// The systems come from PROJ and its database, offline: no grid is ever fetched from the network.
// The changes between NTF and RGF93 use the IGN grid when it is installed.
namespace pyr {

class CProjection {
public:
    // A projection by name, with the earth radius (kilometres) used when no ellipsoid is known.
    explicit CProjection(std::string_view name = "Aucune", double earthRadiusKm = 6366.0);
    ~CProjection();
    CProjection(CProjection&&) noexcept;
    CProjection& operator=(CProjection&&) noexcept;
    CProjection(const CProjection&) = delete;
    CProjection& operator=(const CProjection&) = delete;

    // False when the name is not understood: Error() then says why, in French.
    bool IsValid() const { return m_error.empty(); }
    const std::string& Error() const { return m_error; }
    bool IsNone() const; // "Aucune": local coordinates
    const std::string& Name() const { return m_name; }
    int Epsg() const; // the EPSG code of the system, 0 for "Aucune" or an invalid name

    // Linear alteration at (X, Y) in parts per million: (k - 1) x 10^6, k the point scale factor of the
    // projection. 0 for "Aucune", for an invalid projection or a place outside the projection.
    // The last place is remembered: a computation asks again and again at the same station.
    double CalcLinearAlter(double x, double y) const;
    // Reduction of a horizontal distance measured at height Z to the level surface, in parts per
    // million (negative above the surface). `direction` 1 reduces a measured distance; -1 gives the
    // opposite correction (a distance on the surface brought up to height Z). The surface is the
    // ellipsoid of the projection, with its Gaussian mean radius at the latitude of (X, Y); for
    // "Aucune", or when (X, Y) is unknown, the sphere of the earth radius given to the constructor.
    // Z is the altitude as it stands (no geoid undulation is added).
    double CalcEllipsReduc(double x, double y, double z, int direction) const;

    // Converts a point's easting and northing from this system into `to`. False (values untouched)
    // when either system is "Aucune" or invalid, or the point cannot be converted. The transformation
    // is kept for the next points converted into the same system.
    bool Convert(const CProjection& to, double& x, double& y) const;

private:
    struct Impl;
    std::string m_name;
    std::string m_error;
    bool m_none = false;
    double m_earthRadiusKm;
    std::unique_ptr<Impl> m_impl;
};

} // namespace pyr

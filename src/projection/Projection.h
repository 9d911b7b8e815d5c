#pragma once

#include <memory>
#include <string>
#include <string_view>

// The projection of a job's coordinates: its linear alteration (the scale of the map against the
// ellipsoid at a place) and the reduction of a distance to the level surface, both in parts per
// million, and the conversion of coordinates into another system.
//
// Names: "Aucune" (local coordinates: no alteration), "Lambert 93", "CC42" to "CC50", the NTF Lambert
// zones ("Lambert I" to "Lambert IV", "Lambert II étendu"), "UTM 31N" and the other UTM zones, or any
// "EPSG:nnnn" of a projected system. Case and blanks do not matter.
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

    // Linear alteration at (X, Y) in parts per million: (k - 1) x 10^6, k the point scale factor of the
    // projection. 0 for "Aucune", for an invalid projection or a place outside the projection.
    double CalcLinearAlter(double x, double y) const;
    // Reduction of a horizontal distance measured at height Z to the level surface, in parts per
    // million (negative above the surface). `direction` 1 reduces a measured distance; -1 gives the
    // opposite correction (a distance on the surface brought up to height Z).
    double CalcEllipsReduc(double x, double y, double z, int direction) const;

    // Converts a point's easting and northing from this system into `to`. False (values untouched)
    // when either system is "Aucune" or invalid, or the point cannot be converted.
    bool Convert(const CProjection& to, double& x, double& y) const;

private:
    struct Impl;
    std::string m_name;
    std::string m_error;
    double m_earthRadiusKm;
    std::unique_ptr<Impl> m_impl;
};

} // namespace pyr

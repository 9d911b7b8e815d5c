// Radiated points against the coordinates a total station computed in the field. The book is read twice:
// without the instrument's coordinates, as the GéoBase to compute, and with them, as the answer. The first
// GéoBase's stations are radiated in field order, each with the place and V0 the reader gives it, or
// oriented on its backsights when the reader leaves its V0 undefined. S2 is placed in the book only by the
// instrument's own computation: it takes the place its radiation from S1 gave, written back as a
// computation writes it, as a surveyor going on from station to station does. Every new point must then
// fall on the instrument's record within its rounding, 1 mm, and every known point sighted (K1 and S1, the
// backsights) on the book's coordinates. The instrument levels without curvature and refraction, as the
// backsight on K1, 308 m away, shows by the 6.2 mm of the term: the term is taken off our altitudes (and,
// for the points of S2, off the altitude we gave S2) before they are compared.
// This check lives with the editor's tests because it needs both the readers and the computations.
#include "calc/Radiation.h"
#include "fieldbook/FieldBookTestSupport.h"
#include "fieldbook/LectNikon.h"

#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <memory>
#include <string>

namespace pyr {
namespace {

TEST(RadiatedPoints, AFieldBookRadiatedFindsTheCoordinatesItsInstrumentComputed) {
    DriverRun<CLectNikon, FieldBookFormat::NikonAtlas> bare, computed;
    CCarnet geo = bare.Set(kKeyPointsCalcules, "0").ReadFile("nikon-raw-calcule.raw");
    const CCarnet& instrument = computed.Set(kKeyPointsCalcules, "1").ReadFile("nikon-raw-calcule.raw");
    ASSERT_EQ(ReportText(bare), "");

    std::map<std::string, double, std::less<>> curvature; // the term in our altitudes, the station's included
    int points = 0, checks = 0;
    for (int s = geo.Find(kKindStation, "", 0); s >= 0; s = geo.Find(kKindStation, "", s + 1)) {
        RadiationSettings settings;
        settings.computeV0 = !(geo.v0At(s) >= 0.0);
        const RadiatedStation r = RadiateStation(geo, s, settings);
        ASSERT_TRUE(r.usable) << geo.matAt(s) << " : " << r.reason;
        EXPECT_EQ(r.v0Computed, settings.computeV0);
        const double carried = curvature[r.station.name];
        for (const RadiatedSighting& p : r.points) {
            SCOPED_TRACE(p.mat);
            double x = 0.0, y = 0.0, z = 0.0;
            ASSERT_TRUE(instrument.hasXY(p.mat, x, y) && instrument.hasZ(p.mat, z));
            curvature[std::string(p.mat)] = carried + CurvatureRefraction(p.dh);
            EXPECT_NEAR(p.x, x, 0.001);
            EXPECT_NEAR(p.y, y, 0.001);
            EXPECT_NEAR(p.z - curvature.find(p.mat)->second, z, 0.001);
            ++points;
            auto point = std::make_unique<CPointGen>(std::string(p.mat), 0.0, 0.0, 0.0);
            point->setPt(p.x, p.y, p.z);
            geo.Add(std::move(point), kKindPoint); // after the last station: it belongs to no station
        }
        for (const RadiationCheck& c : r.checks) {
            SCOPED_TRACE(c.sighting.mat);
            EXPECT_LT(std::hypot(c.along, c.across), 0.001);
            EXPECT_NEAR(c.dz - carried - CurvatureRefraction(c.sighting.dh), 0.0, 0.001);
            ++checks;
        }
    }
    EXPECT_EQ(points, 6); // 101, 102, S2 and 103 from S1; 201 and 202 from S2
    EXPECT_EQ(checks, 2); // K1 from S1; S1, in both faces, from S2
}

} // namespace
} // namespace pyr

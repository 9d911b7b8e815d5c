// Elements that come from field books and the editor: checked, reported, and only then kept.
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>

using namespace pyr;

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

struct Validation : ::testing::Test {
    CMesure* Sighting(std::string mat, double hp, double ah, double av, double di) {
        return c.validMesure(&txt, std::make_unique<CMesure>(std::move(mat), hp, ah, av, di));
    }
    CPointGen* Point(std::string mat, double x, double y, double z) {
        return c.validPoint(&txt, std::make_unique<CPointGen>(std::move(mat), x, y, z));
    }

    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
    CCarnet c;
};

} // namespace

TEST_F(Validation, StationsAreNamedAndTheirV0IsKnownOnlyWhenPositive) {
    EXPECT_EQ(c.validStation(&txt, std::make_unique<CStation>("   "), true), nullptr);
    CStation* s = c.validStation(&txt, std::make_unique<CStation>(" 0012 ", 1.55, 412.5), true);
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(s->v0(), 12.5);
    EXPECT_EQ(c.validStation(&txt, std::make_unique<CStation>("S3", kNaN)), nullptr);
    EXPECT_EQ(c.GetSize(), 1);
    EXPECT_EQ(fe.lines, (std::vector<std::string>{
                            "Station sans nom : elle n'est pas ajoutée à la GéoBase !",
                            "Station <12> ajoutée dans la GéoBase", // padding of the field book gone
                            "Station <S3> : hauteur d'instrument incorrecte (nan m) : elle n'est pas "
                            "ajoutée à la GéoBase !"}));
}

TEST_F(Validation, SightingsNeedAStationANameAndSensibleValues) {
    EXPECT_EQ(Sighting("P1", 1.3, 10, 100, 20), nullptr);
    EXPECT_EQ(fe.lines.back(), "Visée <P1> sans station avant elle : elle n'est pas ajoutée à la GéoBase !");
    CStation* unoriented = c.validStation(&txt, std::make_unique<CStation>("S1", 1.5, -1.0));
    ASSERT_NE(unoriented, nullptr);
    EXPECT_EQ(unoriented->v0(), kUndefined);

    CReference* r = c.validReference(&txt, std::make_unique<CReference>("A1", 1.3, -0.5, 100, 20));
    ASSERT_NE(r, nullptr);
    EXPECT_EQ(r->ah(), 399.5); // a direction is brought into one turn
    EXPECT_NE(Sighting("P2", kUndefined, 0, kUndefined, kUndefined), nullptr);
    EXPECT_NE(Sighting("P3", 1.3, 10, 400, 0), nullptr); // the limits are values
    // Out of its limits, no name, no measure at all, a value that is not a number.
    EXPECT_EQ(Sighting("P4", 1.3, 10, 400.5, 20), nullptr);
    EXPECT_EQ(Sighting("", 1.3, 10, 100, 20), nullptr);
    EXPECT_EQ(Sighting("P5", 1.3, kUndefined, kUndefined, kUndefined), nullptr);
    EXPECT_EQ(c.validReference(&txt, std::make_unique<CReference>("P6", kNaN, 1, 100, 2)), nullptr);
    EXPECT_EQ(c.GetSize(), 4);
}

TEST_F(Validation, PointsHoldAPlanimetryOrAnAltitude) {
    EXPECT_NE(Point("P1", 0.0, 0.0, kUndefined), nullptr);
    EXPECT_NE(Point("P2", kUndefined, kUndefined, 12.5), nullptr);
    EXPECT_EQ(Point("P3", 1.0, kUndefined, 5.0), nullptr);
    EXPECT_EQ(fe.lines.back(),
              "Point <P3> : X et Y doivent être donnés ensemble : il n'est pas ajouté à la GéoBase !");
    EXPECT_EQ(Point("P4", kUndefined, kUndefined, kUndefined), nullptr);
    EXPECT_EQ(Point("P5", 1.0, INFINITY, kUndefined), nullptr);
    EXPECT_EQ(Point("", 1.0, 2.0, kUndefined), nullptr);
    EXPECT_EQ(fe.lines.back(), "Point sans matricule : il n'est pas ajouté à la GéoBase !");
    EXPECT_EQ(c.GetSize(), 2);
    EXPECT_EQ(c.validPoint(nullptr, std::make_unique<CPointGen>("P6", kUndefined)), nullptr); // silent
}

TEST_F(Validation, CommentsAreMadeOfALabelAndAValue) {
    EXPECT_EQ(c.validComment(10, "Unités", "grades")->text(), "Unités     = grades"); // width in letters
    std::string label, value;
    EXPECT_TRUE(CCarnet::validComment("Appareil     = TCR 705", label, value));
    EXPECT_EQ(label, "Appareil");
    EXPECT_EQ(value, "TCR 705");
    EXPECT_FALSE(CCarnet::validComment("simple remarque", label, value));
}

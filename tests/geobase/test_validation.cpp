// Elements that come from field books and the editor: checked, reported, and only then kept.
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>

using namespace pyr;

namespace {

struct Validation : ::testing::Test {
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
    CCarnet c;
};

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

} // namespace

TEST_F(Validation, StationsAreNamedAndTheirV0IsKnownOnlyWhenPositive) {
    EXPECT_EQ(c.validStation(&txt, std::make_unique<CStation>("   "), true), nullptr);
    CStation* s = c.validStation(&txt, std::make_unique<CStation>(" 0012 ", 1.55, 412.5), true);
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(s->mat(), "12"); // padding of the field book gone
    EXPECT_EQ(s->v0(), 12.5);
    CStation* unoriented = c.validStation(&txt, std::make_unique<CStation>("S2", 1.5, -1.0));
    ASSERT_NE(unoriented, nullptr);
    EXPECT_EQ(unoriented->v0(), kUndefined);
    EXPECT_EQ(c.validStation(&txt, std::make_unique<CStation>("S3", kNaN)), nullptr);
    EXPECT_EQ(c.GetSize(), 2);
    std::vector<std::string> expected{
        "Station sans nom : elle n'est pas ajoutée à la GéoBase !", "Station <12> ajoutée dans la GéoBase",
        "Station <S3> : hauteur d'instrument incorrecte (nan m) : elle n'est pas "
        "ajoutée à la GéoBase !"};
    EXPECT_EQ(fe.lines, expected);
}

TEST_F(Validation, SightingsNeedAStationANameAndSensibleValues) {
    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("P1", 1.3, 10, 100, 20)), nullptr);
    EXPECT_EQ(fe.lines.back(), "Visée <P1> sans station avant elle : elle n'est pas ajoutée à la GéoBase !");
    ASSERT_NE(c.validStation(&txt, std::make_unique<CStation>("S1")), nullptr);

    CReference* r = c.validReference(&txt, std::make_unique<CReference>("A1", 1.3, -0.5, 100, 20), true);
    ASSERT_NE(r, nullptr);
    EXPECT_EQ(r->ah(), 399.5); // a direction is brought into one turn
    EXPECT_EQ(fe.lines.back(), "Référence <A1> ajoutée dans la GéoBase");
    EXPECT_NE(c.validMesure(&txt, std::make_unique<CMesure>("P2", kUndefined, 0, kUndefined, kUndefined)),
              nullptr);
    EXPECT_NE(c.validMesure(&txt, std::make_unique<CMesure>("P3", 1.3, 10, 400, 0)), nullptr);

    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("", 1.3, 10, 100, 20)), nullptr);
    EXPECT_EQ(fe.lines.back(), "Visée sans matricule de point : elle n'est pas ajoutée à la GéoBase !");
    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("P4", 1.3, kUndefined, kUndefined, kUndefined)),
              nullptr);
    EXPECT_EQ(fe.lines.back(), "Visée <P4> sans aucune mesure : elle n'est pas ajoutée à la GéoBase !");
    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("P5", 1.3, 10, 400.5, 20)), nullptr);
    EXPECT_EQ(fe.lines.back(), "Visée <P5> : angle zénithal incorrect (400.5 gr, entre 0 et 400) : elle "
                               "n'est pas ajoutée à la GéoBase !");
    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("P6", 1.3, 10, 100, -2.5)), nullptr);
    EXPECT_EQ(fe.lines.back(),
              "Visée <P6> : distance incorrecte (-2.5 m) : elle n'est pas ajoutée à la GéoBase !");
    EXPECT_EQ(c.validMesure(&txt, std::make_unique<CMesure>("P7", 1.3, kNaN, 100, 2)), nullptr);
    EXPECT_EQ(c.validReference(&txt, std::make_unique<CReference>("P8", kNaN, 1, 100, 2)), nullptr);
    EXPECT_EQ(c.GetSize(), 4);
    EXPECT_EQ(c.GetType(1), kKindReference);
    EXPECT_EQ(c.GetType(3), kKindMesure);
}

TEST_F(Validation, PointsHoldAPlanimetryOrAnAltitude) {
    EXPECT_NE(c.validPoint(&txt, std::make_unique<CPointGen>("P1", 0.0, 0.0)), nullptr);
    EXPECT_NE(c.validPoint(&txt, std::make_unique<CPointGen>("P2", 12.5)), nullptr);
    EXPECT_EQ(c.validPoint(&txt, std::make_unique<CPointGen>("P3", 1.0, kUndefined, 5.0)), nullptr);
    EXPECT_EQ(fe.lines.back(),
              "Point <P3> : X et Y doivent être donnés ensemble : il n'est pas ajouté à la GéoBase !");
    EXPECT_EQ(c.validPoint(&txt, std::make_unique<CPointGen>("P4", kUndefined, kUndefined, kUndefined)),
              nullptr);
    EXPECT_EQ(fe.lines.back(), "Point <P4> sans coordonnées : il n'est pas ajouté à la GéoBase !");
    EXPECT_EQ(c.validPoint(&txt, std::make_unique<CPointGen>("P5", 1.0, INFINITY)), nullptr);
    EXPECT_EQ(c.validPoint(&txt, std::make_unique<CPointGen>("", 1.0, 2.0)), nullptr);
    EXPECT_EQ(fe.lines.back(), "Point sans matricule : il n'est pas ajouté à la GéoBase !");
    EXPECT_EQ(c.GetSize(), 2);
    // Without a text window, a refusal is silent but still a refusal.
    EXPECT_EQ(c.validPoint(nullptr, std::make_unique<CPointGen>("P6", kUndefined)), nullptr);
}

TEST_F(Validation, CommentsAreMadeOfALabelAndAValue) {
    CComment* comment = c.validComment(12, "Appareil", "TCR 705");
    ASSERT_NE(comment, nullptr);
    EXPECT_EQ(comment->text(), "Appareil     = TCR 705");
    EXPECT_EQ(c.validComment(8, "Opérateur", "Lefèvre")->text(), "Opérateur = Lefèvre");
    EXPECT_EQ(c.validComment(10, "Unités", "grades")->text(), "Unités     = grades");
    std::string label, value;
    EXPECT_TRUE(CCarnet::validComment("Appareil     = TCR 705", label, value));
    EXPECT_EQ(label, "Appareil");
    EXPECT_EQ(value, "TCR 705");
    EXPECT_FALSE(CCarnet::validComment("simple remarque", label, value));
    EXPECT_EQ(c.GetType(2), kKindComment);
}

TEST(Editing, ProjectionIsRefusedUntilTheProjectionLibraryIsThere) {
    ui::ScriptedFrontEnd fe;
    CCarnet c;
    c.Add(std::make_unique<CPointGen>("P1", 651000.0, 6862000.0), kKindPoint);
    EXPECT_FALSE(c.Projection("Lambert 93", "CC49", &fe));
    ASSERT_EQ(fe.messages.size(), 1u);
    EXPECT_EQ(c.xAt(0), 651000.0);
}

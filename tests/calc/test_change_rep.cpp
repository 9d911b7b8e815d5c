// The change of reference frame on GéoBases built here. Expected coordinates come from the construction:
// frame 2 is frame 1 turned by a known angle about point A and carried onto a known place, so that any
// point's frame-2 coordinates follow from its distance and bearing from A (std::atan2, not the code's
// bearing), or from values worked out by hand in the comments.
#include "TestSupport.h"
#include "calc/ChangeRep.h"
#include "calc/ChangeRepTexts.h"
#include "core/Angles.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string>

namespace pyr {
namespace {

constexpr double kTenthMm = 1e-4;
constexpr double kMgon = 1e-4;

struct Place {
    double x, y;
};

// Frame 2 made from frame 1: turned by `turn` gr (bearings lessen by it) about A, A carried onto `a2`.
Place Constructed(Place p, Place a1, Place a2, double turn) {
    const double d = std::hypot(p.x - a1.x, p.y - a1.y);
    const double g = std::atan2(p.x - a1.x, p.y - a1.y) - turn * M_PI / 200.0;
    return {a2.x + d * std::sin(g), a2.y + d * std::cos(g)};
}

TEST(ChangeRepFormulas, RotationTranslationAndTheirInverseAgreeWithTheConstruction) {
    // θ = 50 gr by hand: P 100 m due east of A comes out on the bearing 50 gr, 100 m from A2, at
    // A2 + (70.7107, 70.7107).
    const CommonPoints one{1000.0, 2000.0, 1100.0, 2000.0};
    const CommonPoints two{500.0, 300.0, 500.0 + 100.0 * std::sqrt(0.5), 300.0 + 100.0 * std::sqrt(0.5)};
    FrameChange change = FrameChangeFrom(one, two);
    EXPECT_NEAR(change.rotation, 50.0, kMgon);
    double x = 1100.0, y = 2000.0;
    IntoFrame2(change, x, y);
    EXPECT_NEAR(x, 570.7107, kTenthMm);
    EXPECT_NEAR(y, 370.7107, kTenthMm);

    // Exactly 100 gr: frame 1's north is frame 2's west; (10, 20) goes to (-20, 10), with no rounding left.
    change = FrameChangeFrom({0, 0, 0, 100}, {0, 0, -100, 0});
    EXPECT_EQ(change.rotation, 100.0);
    EXPECT_EQ(change.cosRotation, 0.0);
    x = 10.0, y = 20.0;
    IntoFrame2(change, x, y);
    EXPECT_EQ(x, -20.0);
    EXPECT_EQ(y, 10.0);

    // A general turn across zero, and the change back bringing the point home to a nanometre.
    const Place a1{651050.118, 6862512.447}, a2{1234.5, 987.6}, b1{651310.2, 6862401.9};
    const Place b2 = Constructed(b1, a1, a2, 371.25);
    const CommonPoints f1{a1.x, a1.y, b1.x, b1.y}, f2{a2.x, a2.y, b2.x, b2.y};
    change = FrameChangeFrom(f1, f2);
    EXPECT_NEAR(change.rotation, 371.25, kMgon);
    const Place p{651120.33, 6862700.81}, expected = Constructed(p, a1, a2, 371.25);
    x = p.x, y = p.y;
    IntoFrame2(change, x, y);
    EXPECT_NEAR(x, expected.x, kTenthMm);
    EXPECT_NEAR(y, expected.y, kTenthMm);
    IntoFrame2(FrameChangeFrom(f2, f1), x, y);
    EXPECT_NEAR(x, p.x, 1e-9);
    EXPECT_NEAR(y, p.y, 1e-9);

    // The V0 turns the other way, into [0, 400).
    EXPECT_NEAR(TurnedV0(50.0, 100.0), 350.0, kMgon);
    EXPECT_NEAR(TurnedV0(399.0, 371.25), 27.75, kMgon);
}

TEST(ChangeRepFormulas, APointIsProjectedOntoTheLineUnlessItIsShorterThanAMillimetre) {
    double x = 30.0, y = 47.0;
    ASSERT_TRUE(ProjectOntoLine({0, 0, 100, 100}, x, y)); // foot of (30, 47) on y = x: (38.5, 38.5)
    EXPECT_NEAR(x, 38.5, 1e-12);
    EXPECT_NEAR(y, 38.5, 1e-12);
    EXPECT_FALSE(ProjectOntoLine({5, 5, 5.0005, 5.0005}, x, y));
    EXPECT_EQ(x, 38.5);
}

// A job: S1 oriented (V0 50), S2 not (V0 undefined); P1 and P2 known, F fixed, H an altitude only, P3
// with an altitude.
class ChangeRep : public ::testing::Test {
protected:
    void SetUp() override {
        geo.Add(std::make_unique<CStation>("S1", 1.5, 50.0), kKindStation);
        geo.Add(std::make_unique<CStation>("S2", 1.5, kUndefined), kKindStation);
        geo.Add(std::make_unique<CPointGen>("P1", 10.0, 20.0), kKindPoint);
        geo.Add(std::make_unique<CPointGen>("P2", -35.5, 4.25), kKindPoint);
        auto fixed = std::make_unique<CPointGen>("F", 7.0, 8.0);
        fixed->setInvariantXY(true);
        geo.Add(std::move(fixed), kKindPoint);
        geo.Add(std::make_unique<CPointGen>("H", 102.5), kKindPoint);
        geo.Add(std::make_unique<CPointGen>("P3", 30.0, 7.0, 112.25), kKindPoint);
        dialog.SetInputs({"", dir / "Pyralis.ini", "", rep::kCaption});
        dialog.SetCarnet(&geo);
        dialog.OnInitDialog();
    }
    void Frames(const CommonPoints& one, const CommonPoints& two) {
        const double values[] = {one.xa, one.ya, one.xb, one.yb, two.xa, two.ya, two.xb, two.yb};
        for (int i = 0; i < CChange_Rep::kFieldCount; ++i)
            ASSERT_TRUE(dialog.SetField(i, std::to_string(values[i])));
    }
    // The frame-1 north turned to frame-2 west, as above.
    void QuarterTurn() { Frames({0, 0, 0, 100}, {0, 0, -100, 0}); }
    void ExpectPoint(const char* mat, double x, double y, double z = kUndefined) {
        SCOPED_TRACE(mat);
        const int i = geo.findMat(mat);
        EXPECT_NEAR(geo.xAt(i), x, kTenthMm);
        EXPECT_NEAR(geo.yAt(i), y, kTenthMm);
        EXPECT_NEAR(geo.zAt(i), z, kTenthMm);
    }
    std::string LastMessage() const { return frontEnd.messages.empty() ? "" : frontEnd.messages.back().text; }
    // The GéoBase as its file holds it: every element's every field, to the last digit written.
    std::string GeoBaseText() const {
        std::string text;
        for (int i = 0; i < geo.GetSize(); ++i)
            text += ElementLine(*geo.GetAt(i), geo.GetType(i)) + '\n';
        return text;
    }

    TempDir dir;
    CCarnet geo;
    CChange_Rep dialog;
    ui::ScriptedFrontEnd frontEnd;
};

TEST_F(ChangeRep, EmptyOrWrongFieldsLeaveOkDisabledAndShowOnlyTheCompleteFrame) {
    EXPECT_FALSE(dialog.CanOK());
    for (int i = 0; i < 4; ++i)
        dialog.SetField(i, i == 3 ? "100" : "0");
    EXPECT_EQ(dialog.DistanceStatus(), "Distance dans le repère 1 = 100.0000 m");
    EXPECT_FALSE(dialog.SetField(4, "abc"));
    EXPECT_FALSE(dialog.SetField(5, "nan")); // never a NaN into a coordinate
    for (int i = 6; i < 8; ++i)
        dialog.SetField(i, "1");
    EXPECT_FALSE(dialog.CanOK());
    EXPECT_EQ(dialog.RotationText(), "");
    EXPECT_FALSE(dialog.OnOK(frontEnd));
    EXPECT_EQ(geo.xAt(geo.findMat("P1")), 10.0);
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ChangeRep, IdenticalFramesRewriteEveryPointUnchangedAndCountIt) {
    Frames({1000, 2000, 1100, 2050}, {1000, 2000, 1100, 2050});
    EXPECT_EQ(dialog.RotationText(), "0.00000");
    EXPECT_EQ(dialog.TranslationXText(), "0.0000");
    EXPECT_EQ(dialog.TranslationYText(), "0.0000");
    dialog.Options().modifyV0 = true;
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    ExpectPoint("P1", 10.0, 20.0);
    ExpectPoint("P3", 30.0, 7.0, 112.25);
    ExpectPoint("F", 7.0, 8.0); // fixed: not counted
    EXPECT_EQ(LastMessage(), "3 Points ont été calculés\n1 Orientations de station modifiées");
    EXPECT_EQ(geo.v0At(0), 50.0);
}

TEST_F(ChangeRep, AQuarterTurnMovesPointsAndTurnsOnlyKnownV0) {
    QuarterTurn();
    EXPECT_EQ(dialog.RotationText(), "100.00000");
    dialog.Options().modifyV0 = true;
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    ExpectPoint("P1", -20.0, 10.0);
    ExpectPoint("P2", -4.25, -35.5);
    ExpectPoint("P3", -7.0, 30.0, 112.25);
    ExpectPoint("F", 7.0, 8.0);
    EXPECT_NEAR(geo.v0At(0), 350.0, kMgon);
    EXPECT_EQ(geo.v0At(1), kUndefined);
    EXPECT_EQ(dialog.StationsTurned(), 1);

    // What the editor's undo gets: each element as it was before, in GéoBase order.
    ASSERT_EQ(dialog.Changes().size(), 4u);
    const ElementChange& first = dialog.Changes()[1];
    EXPECT_EQ(first.index, geo.findMat("P1"));
    EXPECT_EQ(static_cast<const CPointGen&>(*first.other).x(), 10.0);
}

TEST_F(ChangeRep, ExchangingEachChangeUndoesItExactlyAndExchangingAgainRedoesIt) {
    // A general turn, so that the coordinates written are rounded, with the V0 turned as well.
    Frames({0, 0, 30, 40}, {1000, 2000, 1040.1, 2029.9});
    dialog.Options().modifyV0 = true;
    const std::string before = GeoBaseText();
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    const std::string after = GeoBaseText();
    ASSERT_NE(after, before);
    ASSERT_EQ(dialog.Changes().size(), 4u); // S1 and the three points that are not fixed

    ElementChanges& changes = dialog.Changes();
    for (auto change = changes.rbegin(); change != changes.rend(); ++change)
        ASSERT_TRUE(change->Exchange(geo));
    EXPECT_EQ(GeoBaseText(), before);
    for (ElementChange& change : changes)
        ASSERT_TRUE(change.Exchange(geo));
    EXPECT_EQ(GeoBaseText(), after);

    // A record put on another kind of element is refused and leaves both as they are.
    ElementChange misplaced{geo.findMat("P1"), std::move(changes[0].other)};
    EXPECT_FALSE(misplaced.Exchange(geo));
    EXPECT_EQ(GeoBaseText(), after);
    EXPECT_EQ(misplaced.other->mat(), "S1");
}

TEST_F(ChangeRep, DistancesThatDifferAreShownAndTheChangeIsMadeWithoutScale) {
    // B is 100 m from A in frame 1, 100.05 m in frame 2, on the same bearing.
    Frames({0, 0, 0, 100}, {500, 500, 500, 600.05});
    EXPECT_EQ(dialog.DistanceStatus(), "Distance dans le repère 1 = 100.0000 m\nDistance dans le repère 2 = "
                                       "100.0500 m\nDifférence des distances = 0.0500 m");
    EXPECT_EQ(dialog.TranslationXText(), "-500.0000");
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    ExpectPoint("P1", 510.0, 520.0);
}

TEST_F(ChangeRep, FixedPointsMoveOnlyWhenAskedAndAWrongSelectionChangesNothing) {
    QuarterTurn();
    dialog.Options().allPoints = false;
    dialog.SetSelection("P3-P1"); // backwards
    dialog.Options().modifyV0 = true;
    EXPECT_FALSE(dialog.OnOK(frontEnd));
    EXPECT_EQ(LastMessage(), msg::kNoSelection);
    ExpectPoint("P1", 10.0, 20.0);
    EXPECT_EQ(geo.v0At(0), 50.0);

    dialog.SetSelection("P1 F S2");
    dialog.Options().fixedPoints = true;
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    ExpectPoint("P1", -20.0, 10.0);
    ExpectPoint("F", -8.0, 7.0);
    ExpectPoint("P2", -35.5, 4.25);
    EXPECT_EQ(geo.v0At(0), 50.0); // S1 not in the selection
    EXPECT_EQ(LastMessage(), "2 Points ont été calculés\n0 Orientations de station modifiées");
}

TEST_F(ChangeRep, ProjectedPointsLieOnTheLineOfFrame1AndSwappedOnesCarryTheirAltitudeInY) {
    // The line of frame 1 runs along X; frame 2 puts A at (1000, 0): the points become abscissas.
    Frames({0, 0, 100, 0}, {1000, 0, 1100, 0});
    dialog.Options().projection = true;
    dialog.Options().swapYZ = true;
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    ExpectPoint("P3", 1030.0, 112.25, 0.0); // (30, 7) projected to (30, 0): abscissa 1030, offset 0
    ExpectPoint("P1", 10.0, 20.0);          // no altitude to draw: left alone
    EXPECT_EQ(dialog.PointsComputed(), 1);

    // Without projection and with the altitude kept: (X', Z, Z), the offset dropped.
    CChange_Rep again(&geo);
    again.SetInputs(dialog.Inputs());
    again.OnInitDialog();
    for (int i = 0; i < CChange_Rep::kFieldCount; ++i)
        again.SetField(i, i == 0 ? "5" : i == 2 ? "105" : i == 6 ? "100" : "0"); // 5 m along X
    again.Options() = ChangeRepOptions{.swapYZ = true, .keepZ = true};
    geo.As<CPointGen>(geo.findMat("P3"))->setPt(30.0, 7.0, 112.25);
    ASSERT_TRUE(again.OnOK(frontEnd));
    ExpectPoint("P3", 25.0, 112.25, 112.25);
}

TEST_F(ChangeRep, AProjectionLineOfNoLengthChangesNothing) {
    Frames({5, 5, 5, 5}, {0, 0, 0, 100});
    dialog.Options().projection = true;
    ASSERT_TRUE(dialog.OnOK(frontEnd));
    EXPECT_EQ(LastMessage(), msg::kNoChange);
    ExpectPoint("P1", 10.0, 20.0);
}

TEST_F(ChangeRep, TheSwitchesAreKeptInTheParameterFileAndGivenOnesHoldOverIt) {
    dialog.Options().modifyV0 = true;
    dialog.Options().changeFrame = false;
    dialog.SaveOptions();
    int value = -1;
    ReadParamInt(dir / "Pyralis.ini", "Changement_Repere", "Modif_V0", 0, 0, 1, value);
    EXPECT_EQ(value, 1);
    CChange_Rep next;
    next.SetInputs(dialog.Inputs());
    next.GiveSwitch(kSwitchModifyV0, false);
    next.OnInitDialog();
    EXPECT_FALSE(next.Options().modifyV0);
    EXPECT_FALSE(next.Options().changeFrame);
    EXPECT_TRUE(next.Options().allPoints);
}

} // namespace
} // namespace pyr

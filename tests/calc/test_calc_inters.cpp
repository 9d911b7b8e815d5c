// The dialog of points by intersection, driven through its actions on GéoBases built from exact
// coordinates: P is read exactly from three oriented stations, so the computed point must be P itself.
#include "IntersectionJob.h"
#include "TestSupport.h"
#include "calc/CalcInters.h"
#include "calc/IntersectionTexts.h"
#include "calc/SessionTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "settings/ParamStore.h"
#include "ui/ScriptedFrontEnd.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace pyr::test {
namespace {

constexpr double kTenthMm = 1e-4;

const Place kS1{1000.0, 2000.0, 100.0}, kS2{1100.0, 2000.0, 101.0}, kS3{1120.0, 2150.0, 99.0};

class Intersection : public ::testing::Test, public IntersectionJob {
protected:
    // Besides P and Q, a fourth station, not oriented, and a fifth, not placed: not offered.
    Intersection() {
        AddStation(job, "S1", 1.55);
        AddSighting(job, "R", kS1, 1.55, {900.0, 2100.0, 100.0}, 1.3, 0.0, kKindMesure);
        AddStation(job, "S9", 1.5, 10.0);
        AddSighting(job, "R", {0.0, 0.0, 0.0}, 1.5, {900.0, 2100.0, 100.0}, 1.3, 10.0, kKindMesure);
    }

    bool Open() {
        EXPECT_EQ(job.Save(geo), 1);
        dialog.SetInputs({geo, params, "", "calcul d'un point par intersections de visées"});
        dialog.SetGeoBase(geo);
        dialog.Listen([this](int parts) { notices |= parts; });
        return dialog.Open(frontEnd);
    }
    CCarnet Saved() const {
        CCarnet carnet;
        carnet.Load(nullptr, geo);
        return carnet;
    }
    bool Said(const std::string& text) const {
        return std::any_of(frontEnd.messages.begin(), frontEnd.messages.end(),
                           [&](const auto& message) { return message.text == text; });
    }

    TempDir dir;
    const std::string geo = dir / "chantier.geo";
    const std::string params = dir / "Pyralis.ini";
    ui::ScriptedFrontEnd frontEnd;
    CCalcInters dialog;
    int notices = 0;
};

TEST_F(Intersection, PointsOfferedThenComputedAgainOnEveryMove) {
    ASSERT_TRUE(Open());
    EXPECT_EQ(dialog.Points(), (std::vector<std::string>{"P", "Q"}));
    EXPECT_FALSE(dialog.ChoosePoint("R"));
    EXPECT_TRUE(Said(Sprintf(inters::kMsgPointNotOffered, "R")));
    frontEnd.messages.clear();

    ASSERT_TRUE(dialog.ChoosePoint("P"));
    EXPECT_EQ(dialog.Caption(), "Calcul du point P par intersection");
    ASSERT_EQ(dialog.Available().size(), 3u);
    EXPECT_EQ(dialog.Available()[1].text, "S2(1)  P");
    EXPECT_NE(dialog.Available()[1].tooltip.find(" P : "), std::string::npos);
    EXPECT_TRUE(dialog.CanAddAll() && dialog.CanFinish());
    EXPECT_FALSE(dialog.CanAddOne() || dialog.CanRemoveOne() || dialog.CanRemoveAll() || dialog.CanWrite());
    EXPECT_TRUE(notices & CCalcInters::kPartSubject && notices & CCalcInters::kPartLists);

    dialog.HighlightAvailable(0);
    ASSERT_TRUE(dialog.CanAddOne());
    notices = 0;
    dialog.AddOne();
    EXPECT_TRUE(notices & CCalcInters::kPartResult);
    EXPECT_EQ(dialog.Status(), inters::kMsgOneSighting);
    EXPECT_EQ(dialog.XText(), "");
    EXPECT_NEAR(dialog.Result().z, kP.z, kTenthMm); // one sighting with its distance still gives Z
    EXPECT_TRUE(dialog.CanWrite() && dialog.CanRemoveAll() && !dialog.CanRemoveOne());

    dialog.AddAll();
    const InterResult& result = dialog.Result();
    EXPECT_EQ(result.flags, kInterComputed);
    EXPECT_NEAR(result.x, kP.x, kTenthMm);
    EXPECT_NEAR(result.y, kP.y, kTenthMm);
    EXPECT_NEAR(result.z, kP.z, kTenthMm);
    EXPECT_EQ(dialog.XText(), "1050.0000"); // the GéoBase's 4 decimals of coordinates
    EXPECT_EQ(dialog.ZText(), "103.200");   // and 3 of heights
    EXPECT_EQ(dialog.EmqXText(), "0.0000");

    dialog.HighlightSelected(1);
    dialog.RemoveOne();
    EXPECT_EQ(dialog.Selected().size(), 2u);
    EXPECT_TRUE(IsKnown(dialog.Result().x) && !IsKnown(dialog.Result().emqX)); // two rays: no EMQ
    dialog.RemoveAll();
    EXPECT_FALSE(IsKnown(dialog.Result().x) || IsKnown(dialog.Result().z));
    EXPECT_EQ(dialog.Results().size(), 1u); // P's last result is kept for the listing
    EXPECT_TRUE(frontEnd.messages.empty());

    dialog.SetPlani(false);
    dialog.AddAll();
    EXPECT_FALSE(IsKnown(dialog.Result().x));
    EXPECT_NEAR(dialog.Result().z, kP.z, kTenthMm);
}

// S2 reads P face right; S3 reads it on a target 0.30 m beyond it, the offset written in front.
TEST_F(Intersection, FaceRightAndEccentricSightingsAreReducedFirst) {
    auto* s2 = job.As<CVisee>(job.Find(kKindMesure, "P", job.findStaRep("S2", 1)));
    s2->setAV(400.0 - s2->av());
    s2->setAH(std::fmod(s2->ah() + 200.0, 400.0));
    const int s3 = job.Find(kKindMesure, "P", job.findStaRep("S3", 1));
    const double horizontal = std::hypot(kP.x - kS3.x, kP.y - kS3.y) + 0.30;
    const double rise = (kP.z + 1.3) - (kS3.z + 1.45) - 0.84 / 12768000.0 * horizontal * horizontal;
    job.As<CVisee>(s3)->setAV(std::atan2(horizontal, rise) * kGonPerRadian);
    job.As<CVisee>(s3)->setDI(std::hypot(horizontal, rise));
    job.InsertAt(s3, std::make_unique<CCommande>("ExcentRad", "-0.3"), kKindExcentrement);
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChoosePoint("P"));
    dialog.AddAll();
    EXPECT_NEAR(dialog.Result().x, kP.x, kTenthMm);
    EXPECT_NEAR(dialog.Result().y, kP.y, kTenthMm);
    EXPECT_NEAR(dialog.Result().z, kP.z, 1e-3); // the level line bent over 0.30 m more: under a millimetre
}

// Q seen again from a second set-up of S2: two rays from one station point never make the pair.
TEST_F(Intersection, SightingsFromOneStationAloneAreConfounded) {
    AddStation(job, "S2", 1.7, 120.0);
    AddSighting(job, "Q", kS2, 1.7, {1180.0, 2050.0, 100.0}, 1.3, 120.0, kKindMesure);
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChoosePoint("Q"));
    dialog.AddAll();
    EXPECT_EQ(dialog.Result().flags, kInterParallel);
    EXPECT_EQ(dialog.Status(), inters::kMsgAllConfounded);
    EXPECT_EQ(dialog.XText(), "");
    EXPECT_NEAR(dialog.Result().z, 100.0, kTenthMm); // the heights still come from the distances
    EXPECT_TRUE(frontEnd.messages.empty());          // a status, not a message box
    EXPECT_FALSE(dialog.SelectStations("S7"));
}

TEST_F(Intersection, WrittenWithTheInvariantQuestionsJournalledAndSavedOnLeaving) {
    auto invariant = std::make_unique<CPointGen>("P", 1.0, 2.0, 3.0);
    invariant->setInvariantXY(true);
    job.Add(std::move(invariant), kKindPoint);
    ASSERT_TRUE(Open());
    ASSERT_TRUE(dialog.ChoosePoint("P"));
    dialog.AddAll();
    frontEnd.answers = {ui::Answer::No, ui::Answer::Yes, ui::Answer::Yes}; // keep X Y; save on leaving;
    ASSERT_TRUE(dialog.WritePoint());                                      // listing
    EXPECT_EQ(frontEnd.questions.front(), Sprintf(session::kQuestionInvariantXY, "P"));
    EXPECT_TRUE(dialog.Modified());
    const std::string listing = dialog.Close();
    EXPECT_EQ(frontEnd.questions.at(1), session::kQuestionSaveModified);

    const CCarnet saved = Saved();
    const int p = saved.findMat("P");
    EXPECT_DOUBLE_EQ(saved.xAt(p), 1.0); // kept
    EXPECT_NEAR(saved.zAt(p), kP.z, 1e-9);
    EXPECT_NE(
        ReadBytes(dir / "chantier.jnl").find(" - Calcul de points par intersection\nPoint       P : Z ="),
        std::string::npos);
    EXPECT_NE(ReadBytes(listing).find("Calcul du point P"), std::string::npos);
    int plani = 0;
    ReadParamInt(params, inters::kSection, kKeyCalculPlani, 0, 0, 1, plani);
    EXPECT_EQ(plani, 1);
}

} // namespace
} // namespace pyr::test

// The windows of the computations driven as a desktop host drives them: the person's actions sent to the
// form, the states read back after each one. The GéoBases are built from exact coordinates, so that the
// points and orientations found are known beforehand.
#include "FormPerson.h"
#include "TestSupport.h"
#include "calc/CalcChemDriver.h"
#include "calc/CalcExcentDriver.h"
#include "calc/CalcExcentForm.h"
#include "calc/CalcIntersDriver.h"
#include "calc/CalcIntersForm.h"
#include "calc/CalcNivDriver.h"
#include "calc/CalculV0Driver.h"
#include "calc/CalculV0Form.h"
#include "calc/GeoLines.h"
#include "calc/IntersectionJob.h"
#include "calc/IntersectionTexts.h"
#include "calc/StationReductionDriver.h"
#include "calc/StationReductionForm.h"
#include "core/Numbers.h"
#include "geobase/Elements.h"
#include "test_v0_geometry.h"
#include "ui/ScriptedFrontEnd.h"

#include <cctype>
#include <gtest/gtest.h>
#include <set>

namespace pyr::test {
namespace {

using ui::EventKind;
using ui::kIdCancel;
using ui::kIdOk;

constexpr double kTenthMm = 1e-4, kTenthMgon = 1e-4;

CCarnet Load(const std::string& path) {
    CCarnet carnet;
    carnet.Load(nullptr, path);
    return carnet;
}

// Every window a host may build: controls it can tell apart, labels that give the focus to a control
// that exists, frames that hold them, one button for Enter and no accelerator twice.
TEST(ComputationForms, TemplatesAreConsistentAndEveryAcceleratorIsUnique) {
    CCalcIntersDriver intersection;
    CCalculV0Driver v0;
    CReductionDriver reduction;
    CCalcExcentDriver excent;
    CCalcChemDriver traverses;
    CCalcNivDriver simple(LevellingMethod::Simple), doubleStation(LevellingMethod::DoubleStation);
    for (ui::Dialog* dialog : std::initializer_list<ui::Dialog*>{&intersection, &v0, &reduction, &excent,
                                                                 &traverses, &simple, &doubleStation}) {
        const auto form = dialog->MakeForm();
        ASSERT_TRUE(form);
        std::set<int> ids{0, ui::kButtonRow};
        std::set<std::string> names;
        std::set<char> keys;
        int defaults = 0;
        for (const ui::Control& control : form->Controls()) {
            EXPECT_TRUE(ids.insert(control.id).second && ids.count(control.parent)) << control.name;
            EXPECT_TRUE(!control.name.empty() && names.insert(control.name).second) << control.id;
            defaults += control.isDefault;
            const std::size_t mark = control.text.find('&');
            const char key =
                mark == std::string::npos ? 0 : static_cast<char>(std::tolower(control.text[mark + 1]));
            EXPECT_TRUE(key == 0 || keys.insert(key).second) << control.name;
        }
        for (const ui::Control& control : form->Controls())
            EXPECT_TRUE(control.buddy == 0 || ids.count(control.buddy)) << control.name;
        EXPECT_EQ(defaults, 1);
    }
}

class IntersectionForm : public ::testing::Test, public IntersectionJob {
protected:
    ui::ScriptedFrontEnd frontEnd;
};

// The enabling of the buttons and the messages are the model's, tested with it: here, the actions reach
// the model through the form and the form shows its results.
TEST_F(IntersectionForm, PointChosenSightingsMovedWrittenThenFinishedWithTheListing) {
    using F = CCalcIntersForm;
    TempDir dir;
    const std::string geo = Prepare(dir);
    CCalcIntersDriver dialog;
    dialog.SetInputs({geo, dir / "Pyralis.ini", "", "calcul d'un point par intersections de visées"});
    const auto form = dialog.MakeForm();
    Person person{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_EQ(person[F::kSubject].items, (std::vector<std::string>{"P", "Q"}));

    person.Select(F::kSubject, 0);
    EXPECT_EQ(form->Caption(), "Calcul du point P par intersection");
    const ui::ControlState available = person[F::kAvailable];
    ASSERT_EQ(available.items.size(), 3u);
    ASSERT_EQ(available.tips.size(), 3u);
    person.Select(F::kAvailable, 1);
    person.Click(F::kAddOne);
    EXPECT_EQ(person[F::kSelected].items, std::vector<std::string>{available.items[1]});

    person.Click(F::kAddAll);
    EXPECT_EQ(person[F::ResultValue(F::kLineFirst)].text, "1050.0000");
    EXPECT_EQ(person[F::ResultValue(F::kLineSecond)].text, "2080.0000");
    EXPECT_EQ(person[F::ResultValue(F::kLineZ)].text, "103.200");
    person.Check(F::kPlani, false); // the altitude alone
    EXPECT_EQ(person[F::ResultValue(F::kLineFirst)].text, "");
    EXPECT_EQ(person[F::ResultValue(F::kLineZ)].text, "103.200");
    person.Check(F::kPlani, true);
    person.Click(F::kWrite);

    frontEnd.answers = {ui::Answer::Yes}; // save the GéoBase on leaving
    person.Click(kIdOk);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Ok);
    const CCarnet saved = Load(geo);
    const int p = saved.findMat("P");
    ASSERT_GE(p, 0);
    EXPECT_NEAR(saved.xAt(p), kP.x, kTenthMm);
    EXPECT_NEAR(saved.yAt(p), kP.y, kTenthMm);
    EXPECT_NEAR(saved.zAt(p), kP.z, kTenthMm);
    EXPECT_NE(ReadBytes(dir / "chantier.cin").find("Calcul du point P"), std::string::npos);

    // The same actions on the model leave the same GéoBase.
    EXPECT_EQ(ByTheModel(frontEnd), ReadBytes(geo));
}

TEST_F(IntersectionForm, ClosedWithoutWritingTheListingIsOfferedAndNothingSaved) {
    TempDir dir;
    const std::string geo = Prepare(dir);
    CCalcIntersDriver dialog;
    dialog.SetInputs({geo, dir / "Pyralis.ini", "", ""});
    const auto form = dialog.MakeForm();
    Person person{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    person.Type(CCalcIntersForm::kSubject, "P"); // typed in the combo
    form->Act(frontEnd, CCalcIntersForm::kAvailable, {EventKind::Activate, 2, false, {}}); // double-click
    EXPECT_EQ(person[CCalcIntersForm::kSelected].items.size(), 1u);
    frontEnd.answers = {ui::Answer::No}; // no listing
    person.Click(kIdCancel);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Cancel);
    EXPECT_EQ(frontEnd.questions.size(), 1u);
    EXPECT_EQ(Load(geo).findMat("P"), -1);
}

// S1 oriented at 50 gr on A, B, C and D, D read 0.02 gr off, then fixed by hand; S2, which the GéoBase
// does not place, at 120 gr on A and B. X and Y are shown in the order Y, X.
TEST(V0Form, StationsOrientedFromTheWindowTheirCoordinatesTypedInTheAxesShown) {
    using F = CCalculV0Form;
    const Place s1{1000.0, 2000.0, 100.0}, s2{1100.0, 2100.0, 102.0};
    const std::pair<const char*, Place> points[] = {{"A", {1000.0, 2100.0, 101.0}},
                                                    {"B", {1200.0, 2000.0, 99.2}},
                                                    {"C", {700.0, 2000.0, 104.5}},
                                                    {"D", {1000.0, 1900.0, 100.0}}};
    TempDir dir;
    const std::string geo = dir / "chantier.geo", params = dir / "Pyralis.ini";
    WriteBytes(params, "[Options_Listings]\nChoixNomListing=0\nAfficherListing=0\nInverser_XY=1\n"
                       "[Listings]\nFormat=2\n");
    // The axes' order is the store's, for the whole program: set back for the tests that follow.
    struct Unswap {
        ~Unswap() { CPointGen::setSwapXY(false); }
    } unswap;
    CCarnet job;
    AddPoint(job, "S1", s1);
    for (const auto& [name, place] : points)
        AddPoint(job, name, place);
    AddStation(job, "S1", 1.5, 49.5);
    for (const auto& [name, place] : points)
        AddSighting(job, name, s1, 1.5, place, 1.3, 50.0);
    job.As<CVisee>(job.GetSize() - 1)->setAH(149.98);
    AddStation(job, "S2", 1.6);
    for (int i : {0, 1})
        AddSighting(job, points[i].first, s2, 1.6, points[i].second, 1.3, 120.0);
    ASSERT_EQ(job.Save(geo), 1);

    CCalculV0Driver dialog;
    dialog.SetInputs({geo, params, "", ""});
    ui::ScriptedFrontEnd frontEnd;
    const auto form = dialog.MakeForm();
    Person person{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_EQ(person[F::kStation].items, (std::vector<std::string>{"S1", "S2"}));
    EXPECT_EQ(person[F::kLabelFirst].text, "&Y :");
    EXPECT_EQ(person[F::kFirst].text, "2000.0000");
    EXPECT_FALSE(person[F::kFirst].enabled); // placed by the GéoBase

    person.Click(F::kCalculate);
    auto* model = static_cast<CCalculV0Sta*>(&form->Model());
    EXPECT_NEAR(model->V0(), 50.0, kTenthMgon);
    EXPECT_EQ(person[F::kV0].text, FormatFixed(50.0, CStation::DeciAng()));
    const std::vector<std::string> lines = person[F::kResults].items;
    ASSERT_EQ(lines.size(), 4u);
    EXPECT_EQ(lines[3].substr(lines[3].size() - 2), "\t-"); // D dropped: no residual
    person.CheckLine(F::kReferences, 3, false);
    EXPECT_FALSE(model->References()[3].chosen);
    person.Click(F::kCalculate);
    EXPECT_EQ(person[F::kResults].items.size(), 3u);

    person.Type(F::kFixed, "49,9"); // S1's V0 fixed by hand
    EXPECT_EQ(person[F::kV0].text, FormatFixed(49.9, CStation::DeciAng()));

    person.Select(F::kStation, 1);
    EXPECT_TRUE(person[F::kFirst].enabled && person[F::kZ].enabled);
    person.Type(F::kFirst, "2100,0"); // Y, with a decimal comma: the station waits for its X
    EXPECT_FALSE(model->Station().HasPlace());
    EXPECT_EQ(person[F::kFirst].text, "2100.0000");
    person.Type(F::kSecond, "1100");
    person.Type(F::kZ, "102");
    EXPECT_TRUE(frontEnd.messages.empty());
    person.Click(F::kCalculate);
    EXPECT_NEAR(model->V0(), 120.0, kTenthMgon);

    frontEnd.answers = {ui::Answer::Yes, ui::Answer::Yes}; // add S2's point; write the listing
    person.Click(kIdOk);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Ok);
    const CCarnet saved = Load(geo);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S1", 1)), 49.9, 1e-9);
    EXPECT_NEAR(saved.v0At(saved.findStaRep("S2", 1)), 120.0, kTenthMgon);
    double x = 0, y = 0;
    ASSERT_TRUE(saved.hasXY("S2", x, y));
    EXPECT_EQ(x, 1100.0);
    EXPECT_EQ(y, 2100.0);
    EXPECT_NE(ReadBytes(dir / "chantier.cv0").find("Calcul de la station S2, reprise 1"), std::string::npos);
}

// The station E stands 2 m from C. The nearest point is the centre offered; another one taken for the
// centre changes the references offered.
TEST(ExcentForm, TheNearestPointIsTheCentreOfferedAndAnotherOneChangesTheReferences) {
    using F = CCalcExcentForm;
    const Place e{1001.2, 2001.6, 98.4};
    const std::pair<const char*, Place> points[] = {{"B", {1090.0, 1950.0, 97.0}},
                                                    {"C", {1000.0, 2000.0, 100.0}},
                                                    {"A", {1060.0, 2080.0, 105.0}},
                                                    {"D", {940.0, 1930.0, 102.0}}};
    TempDir dir;
    const std::string geo = dir / "chantier.geo";
    CCarnet job;
    for (const auto& [name, place] : points)
        AddPoint(job, name, place);
    AddStation(job, "E", 1.5);
    // B is read before C, and A for its direction only: no candidate for the centre.
    for (const auto& [name, place] : points)
        AddSighting(job, name, e, 1.5, place, 1.3, 37.5);
    job.As<CVisee>(job.Find(kKindReference, "A"))->setDI(-999999.0);
    ASSERT_EQ(job.Save(geo), 1);

    CCalcExcentDriver dialog;
    dialog.SetInputs({geo, dir / "Pyralis.ini", "", ""});
    ui::ScriptedFrontEnd frontEnd;
    const auto form = dialog.MakeForm();
    Person person{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_FALSE(person[F::kCentre].enabled);
    person.Select(F::kSubject, 0);
    EXPECT_EQ(form->Caption(), "Calcul de la station excentrée E");
    EXPECT_EQ(person[F::kCentre].items, (std::vector<std::string>{"B", "C", "D"}));
    EXPECT_EQ(person[F::kCentre].current, 1);
    EXPECT_EQ(person[F::kAvailable].items, (std::vector<std::string>{"---> B", "---> A", "---> D"}));

    person.Click(F::kAddAll);
    EXPECT_EQ(person[F::ResultValue(F::kLineFirst)].text, "1001.2000");
    EXPECT_EQ(person[F::ResultValue(F::kLineSecond)].text, "2001.6000");
    EXPECT_EQ(person[F::ResultValue(F::kLineV0)].text, FormatFixed(37.5, CStation::DeciAng()));
    EXPECT_EQ(person[F::ResultValue(F::kLineZ)].text, "98.400");
    EXPECT_EQ(person[F::ResultEmq(F::kLineZ)].text, "") << "from the centre: no error";
    EXPECT_TRUE(person[F::kWrite].enabled);

    person.Select(F::kCentre, 0); // B taken for the centre
    EXPECT_EQ(person[F::kAvailable].items, (std::vector<std::string>{"---> C", "---> A", "---> D"}));
    EXPECT_TRUE(person[F::kSelected].items.empty());
    EXPECT_EQ(person[F::ResultValue(F::kLineFirst)].text, "");
    EXPECT_TRUE(frontEnd.messages.empty());
}

// Two set-ups on S1, the second one's circle turned back by 5 gr: merged by their common sightings.
Geo TwoSetUps() {
    Geo geo;
    geo.Sta("S1", 1.60).Ref("A", 1.3, 2.0, 100.0, 50.0).Ref("B", 1.3, 110.0, 100.0, 60.0);
    geo.Sta("S1", 1.60).Ref("A", 1.3, 397.0, 100.0, 50.0).Ref("B", 1.3, 105.0, 100.0, 60.0);
    return geo;
}

TEST(StationReductionForm, SwitchesReadTickedAndKeptOnOkLeftAsTheyWereOnCancel) {
    TempDir dir;
    const std::string ini = dir / "Pyralis.ini";
    WriteBytes(ini, "[Reduction_des_Stations]\nSuppress=1\n");
    constexpr int kVisComm = CStationReductionForm::kFirstSwitch, kSuppress = kVisComm + 3;
    ui::ScriptedFrontEnd frontEnd;

    CReductionDriver dialog;
    dialog.SetInputs({"", ini, "", ""});
    EXPECT_FALSE(dialog.MakeForm()->Open(frontEnd)) << "no GéoBase given";
    Geo geo = TwoSetUps();
    dialog.Reduction().SetCarnet(&geo);
    auto form = dialog.MakeForm();
    Person person{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_TRUE(person[kVisComm].checked);  // by default
    EXPECT_TRUE(person[kSuppress].checked); // as the file says
    person.Check(kSuppress, false);
    person.Click(kIdOk);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Ok);
    EXPECT_EQ(frontEnd.messages.size(), 1u); // the warning on the codes
    ASSERT_EQ(geo.GetSize(), 6 + 5);         // the old set-ups kept, the merged station after them
    EXPECT_EQ(geo.findStaRep("S1", 3), 6);
    EXPECT_NEAR(geo.ahAt(9), 2.0, kTenthMgon); // the second set-up turned by 5 gr
    EXPECT_NE(ReadBytes(ini).find("Suppress=0"), std::string::npos);

    // The same actions on the model give the same GéoBase.
    const std::string fromFile = dir / "Suppress.ini";
    WriteBytes(fromFile, "[Reduction_des_Stations]\nSuppress=1\n");
    Geo same = TwoSetUps();
    CReduction_Station model(&same);
    model.SetInputs({"", fromFile, "", ""});
    model.OnInitDialog();
    model.Options().suppress = false;
    model.OnOK(frontEnd);
    ASSERT_EQ(geo.Save(dir / "form.geo"), 1);
    ASSERT_EQ(same.Save(dir / "model.geo"), 1);
    EXPECT_EQ(ReadBytes(dir / "form.geo"), ReadBytes(dir / "model.geo"));

    // Opened again: the box cleared is read back; Cancel leaves the GéoBase and the file alone.
    form = dialog.MakeForm();
    Person again{*form, frontEnd};
    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_FALSE(again[kSuppress].checked);
    again.Check(kSuppress, true);
    const std::string file = ReadBytes(ini);
    again.Click(kIdCancel);
    EXPECT_EQ(form->Ended(), ui::DialogResult::Cancel);
    EXPECT_EQ(geo.GetSize(), 11);
    EXPECT_EQ(ReadBytes(ini), file);
}

} // namespace
} // namespace pyr::test

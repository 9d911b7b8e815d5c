// The window of the eccentric station driven as a desktop host drives it: what the command line cannot
// show, the centre's combo (the nearest point offered first, another one changing the references
// offered) and the template with its own controls. The station E stands 2 m from C; every sighting is
// what a perfect instrument would read (test_v0_geometry.h).
#include "TestSupport.h"
#include "calc/CalcExcentDriver.h"
#include "calc/CalcExcentForm.h"
#include "core/Numbers.h"
#include "test_v0_geometry.h"
#include "ui/ScriptedFrontEnd.h"

#include <cctype>
#include <gtest/gtest.h>
#include <set>

namespace pyr::test {
namespace {

using F = CCalcExcentForm;
using ui::EventKind;

TEST(ExcentForm, TheNearestPointIsTheCentreOfferedAndAnotherOneChangesTheReferences) {
    const Place e{1001.2, 2001.6, 98.4}, c{1000.0, 2000.0, 100.0};
    const std::pair<const char*, Place> points[] = {{"B", {1090.0, 1950.0, 97.0}},
                                                    {"C", c},
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
    auto act = [&](int id, EventKind kind, int rank = -1) {
        form->Act(frontEnd, id, {kind, rank, false, {}});
    };
    auto text = [&](int id) { return form->State(id).text; };

    // Every control told apart, the centre's label giving the focus to its combo, no accelerator twice.
    std::set<int> ids;
    std::set<char> keys;
    for (const ui::Control& control : form->Controls()) {
        EXPECT_TRUE(ids.insert(control.id).second) << control.name;
        const std::size_t mark = control.text.find('&');
        const char key =
            mark == std::string::npos ? 0 : static_cast<char>(std::tolower(control.text[mark + 1]));
        EXPECT_TRUE(key == 0 || keys.insert(key).second) << control.name;
    }
    ASSERT_TRUE(ids.count(F::kCentre));

    ASSERT_TRUE(form->Open(frontEnd));
    EXPECT_FALSE(form->State(F::kCentre).enabled);
    act(F::kSubject, EventKind::Select, 0);
    EXPECT_EQ(form->Caption(), "Calcul de la station excentrée E");
    const ui::ControlState centre = form->State(F::kCentre);
    EXPECT_EQ(centre.items, (std::vector<std::string>{"B", "C", "D"}));
    EXPECT_EQ(centre.current, 1);
    EXPECT_EQ(form->State(F::kAvailable).items, (std::vector<std::string>{"---> B", "---> A", "---> D"}));

    act(F::kAddAll, EventKind::Click);
    EXPECT_EQ(text(F::ResultValue(F::kLineFirst)), "1001.2000");
    EXPECT_EQ(text(F::ResultValue(F::kLineSecond)), "2001.6000");
    EXPECT_EQ(text(F::ResultValue(F::kLineV0)), FormatFixed(37.5, CStation::DeciAng()));
    EXPECT_EQ(text(F::ResultValue(F::kLineZ)), "98.400");
    EXPECT_EQ(text(F::ResultEmq(F::kLineZ)), "") << "from the centre: no error";
    EXPECT_TRUE(form->State(F::kWrite).enabled);

    act(F::kCentre, EventKind::Select, 0); // B taken for the centre
    EXPECT_EQ(form->State(F::kAvailable).items, (std::vector<std::string>{"---> C", "---> A", "---> D"}));
    EXPECT_TRUE(form->State(F::kSelected).items.empty());
    EXPECT_EQ(text(F::ResultValue(F::kLineFirst)), "");
    EXPECT_TRUE(frontEnd.messages.empty());
}

} // namespace
} // namespace pyr::test

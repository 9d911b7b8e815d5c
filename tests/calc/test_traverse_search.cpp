// The automatic search of traverses: chains of set-ups sighting one another between known stations, closed
// loops, what is no traverse, and the traverses already written kept as they are.
#include "calc/TraverseSearch.h"
#include "geobase/Carnet.h"

#include <gtest/gtest.h>

namespace pyr {
namespace {

// A GéoBase whose known points are `known`, and whose set-ups each sight the points listed after it:
// {"T1", {"A", "T2"}} is a set-up on T1 sighting A and T2.
CCarnet SetUps(const std::vector<std::string>& known,
               const std::vector<std::pair<std::string, std::vector<std::string>>>& setUps) {
    CCarnet carnet;
    double x = 1000.0;
    for (const std::string& name : known)
        carnet.Add(std::make_unique<CPointGen>(name, x += 100.0, 2000.0, 100.0), kKindPoint);
    for (const auto& [station, sighted] : setUps) {
        carnet.Add(std::make_unique<CStation>(station, 1.5), kKindStation);
        for (const std::string& point : sighted)
            carnet.Add(std::make_unique<CMesure>(point, 1.3, 100.0, 100.0, 50.0), kKindMesure);
    }
    return carnet;
}

std::string Text(const std::vector<FoundTraverse>& found) {
    std::string text;
    for (const FoundTraverse& traverse : found) {
        for (const std::string& station : traverse.stations)
            text += station + " ";
        text += traverse.closed ? "fermé; " : "; ";
    }
    return text;
}

TEST(TraverseSearch, ChainsBetweenKnownStationsAndClosedLoopsAreFound) {
    // A linked traverse A - T1 - T2 - B (A and B also sight their references), and a loop from C back to C.
    const CCarnet carnet = SetUps({"A", "B", "C", "R1"}, {{"A", {"R1", "T1"}},
                                                          {"T1", {"A", "T2"}},
                                                          {"T2", {"T1", "B"}},
                                                          {"B", {"T2", "R1"}},
                                                          {"C", {"L1", "L2"}},
                                                          {"L1", {"C", "L2"}},
                                                          {"L2", {"L1", "C"}}});
    EXPECT_EQ(Text(FindTraverses(carnet)), "A T1 T2 B ; C L1 L2 fermé; ");
}

TEST(TraverseSearch, DeadEndsJunctionsAndOneWaySightingsMakeNoTraverse) {
    // T2 is a junction (T1, B and T3 see it and it sees them); U1 is a dead end; V1 is sighted by D but does
    // not sight D back.
    const CCarnet carnet = SetUps({"A", "B", "D"}, {{"A", {"T1", "U1"}},
                                                    {"T1", {"A", "T2"}},
                                                    {"T2", {"T1", "B", "T3"}},
                                                    {"T3", {"T2"}},
                                                    {"B", {"T2"}},
                                                    {"U1", {"A"}},
                                                    {"D", {"V1"}},
                                                    {"V1", {"B"}}});
    EXPECT_EQ(Text(FindTraverses(carnet)), "");
}

TEST(TraverseSearch, TraversesAlreadyWrittenStayAndNewOnesTakeFreeNames) {
    CCarnet carnet = SetUps({"A", "B", "C"}, {{"A", {"T1"}},
                                              {"T1", {"A", "T2"}},
                                              {"T2", {"T1", "B"}},
                                              {"B", {"T2", "U1"}},
                                              {"U1", {"B", "C"}},
                                              {"C", {"U1"}}});
    // The surveyor wrote the second one the other way round, and named a traverse CH1.
    auto written = std::make_unique<CChemin>("CH1");
    for (const char* name : {"C", "U1", "B"})
        written->add(name);
    carnet.Add(std::move(written), kKindChemin);
    const std::vector<FoundTraverse> found = FindTraverses(carnet);
    EXPECT_EQ(Text(found), "A T1 T2 B ; B U1 C ; ");
    EXPECT_EQ(AddFoundTraverses(carnet, found), std::vector<std::string>{"CH2"});
    const int added = carnet.Find(kKindChemin, "CH2");
    ASSERT_GE(added, 0);
    EXPECT_EQ(carnet.As<CChemin>(added)->stations(), (std::vector<std::string>{"A", "T1", "T2", "B"}));
    // A second search adds nothing.
    EXPECT_TRUE(AddFoundTraverses(carnet, FindTraverses(carnet)).empty());
}

TEST(TraverseSearch, ASecondSetUpOnAStationIsNamedWithItsReprise) {
    const CCarnet carnet = SetUps({"A", "B"}, {{"T1", {"X9"}}, // a first set-up on T1, elsewhere in the job
                                               {"A", {"T1"}},
                                               {"T1", {"A", "B"}},
                                               {"B", {"T1"}}});
    EXPECT_EQ(Text(FindTraverses(carnet)), "A T1(2) B ; ");
}

} // namespace
} // namespace pyr

// The change of projection of a whole GéoBase: every point with a planimetry, all or none.
#include "TestSupport.h"
#include "geobase/Carnet.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <memory>
#include <tuple>

using namespace pyr;

namespace {

constexpr double kTenthMm = 1e-4;

// A small job in Lambert-93: its origin (3°E, 46°30'N) lies at (1 700 000, 5 255 574.0521) in CC46
// (hand computation from the published constants of both projections, see the projection tests).
struct CarnetProjection : ::testing::Test {
    CarnetProjection() {
        c.Add(std::make_unique<CPointGen>("ORIG", 700000.0, 6600000.0, 312.456), kKindPoint); // 0
        c.Add(std::make_unique<CPointGen>("P2", 843210.1234, 6521098.7654), kKindPoint);      // 1
        c.Add(std::make_unique<CPointGen>("NGF", 57.25), kKindPoint);                // 2: an altitude alone
        c.Add(std::make_unique<CStation>("ORIG", 1.55), kKindStation);               // 3
        c.Add(std::make_unique<CMesure>("P2", 1.3, 212.5, 99.8, 35.0), kKindMesure); // 4
    }
    // The whole store as its file would hold it.
    std::string Text() const {
        std::FILE* file = std::tmpfile();
        c.Write(file);
        std::string text = Contents(file);
        std::fclose(file);
        return text;
    }

    ui::ScriptedFrontEnd fe;
    CCarnet c;
};

TEST_F(CarnetProjection, EveryPointIsConvertedThereAndBackAndHeightsStay) {
    ASSERT_TRUE(c.Projection("Lambert 93", "CC46", &fe));
    EXPECT_TRUE(fe.messages.empty());
    EXPECT_NEAR(c.xAt(0), 1700000.0, kTenthMm);
    EXPECT_NEAR(c.yAt(0), 5255574.0521, kTenthMm);
    EXPECT_EQ(c.zAt(0), 312.456);
    EXPECT_GT(c.xAt(1), 1800000.0); // P2 is 143 km east of the central meridian
    EXPECT_EQ(c.xAt(2), kUndefined);
    EXPECT_EQ(c.zAt(2), 57.25);

    ASSERT_TRUE(c.Projection("CC46", "Lambert 93", &fe));
    EXPECT_NEAR(c.xAt(0), 700000.0, kTenthMm);
    EXPECT_NEAR(c.yAt(0), 6600000.0, kTenthMm);
    EXPECT_NEAR(c.xAt(1), 843210.1234, kTenthMm);
    EXPECT_NEAR(c.yAt(1), 6521098.7654, kTenthMm);

    // Rounded to the decimals of coordinates, like every computed point.
    const int decimals = CPointGen::DeciXY();
    CPointGen::setDeciXY(2);
    ASSERT_TRUE(c.Projection("Lambert 93", "CC46", &fe));
    CPointGen::setDeciXY(decimals);
    EXPECT_EQ(c.yAt(0), 5255574.05);
}

TEST_F(CarnetProjection, ARefusalSaysWhyAndChangesNothing) {
    c.Add(std::make_unique<CPointGen>("LOIN", 1e8, 5e6), kKindPoint); // after points that do convert
    const std::string before = Text();
    ui::ScopedApplicationFrontEnd application(fe); // told when no parent is given
    const char* needsTwo =
        "Changement de projection impossible : indiquez une projection de départ et une projection d'arrivée "
        "(« Aucune » désigne des coordonnées locales, qui ne se convertissent pas) !";
    for (const auto& [from, to, message] : {
             std::tuple{"Lambert 93", "Mercator",
                        "Changement de projection impossible :\nProjection <Mercator> inconnue !"},
             {"Aucune", "Lambert 93", needsTwo},
             {"Lambert 93", "", needsTwo}, // an empty name is "Aucune"
             // Read as UTM 31N, ORIG and P2 are places in the north of Europe, but LOIN lies 100 000 km east
             // of the central meridian: no latitude.
             {" UTM 31N ", "Lambert 93",
              "Changement de projection impossible : le point <LOIN> ne peut pas être converti de <UTM 31N> "
              "en <Lambert 93>.\nAucune coordonnée de la GéoBase n'a été modifiée."},
         }) {
        fe.messages.clear();
        EXPECT_FALSE(c.Projection(from, to, &fe)) << from << " -> " << to;
        ASSERT_EQ(fe.messages.size(), 1u);
        EXPECT_EQ(fe.messages[0].text, message);
        EXPECT_EQ(fe.messages[0].icon, ui::kIconWarning);
        EXPECT_EQ(Text(), before) << from << " -> " << to;
    }
    EXPECT_FALSE(c.Projection("Lambert 94", "Lambert 93"));
    EXPECT_EQ(fe.messages.back().text,
              "Changement de projection impossible :\nProjection <Lambert 94> inconnue !");
    EXPECT_EQ(Text(), before);
}

} // namespace

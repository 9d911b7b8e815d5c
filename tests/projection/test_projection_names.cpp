// The names a surveyor gives a projection, and what PROJ makes of the systems they designate.
#include "projection/Projection.h"
#include "projection/ProjectionNames.h"

#include <gtest/gtest.h>
#include <utility>

namespace pyr {
namespace {

TEST(ProjectionNames, EachWayOfWritingANameGivesItsSystem) {
    // The EPSG codes of the registry; 0 is "Aucune". Every offered name is checked below besides.
    // clang-format off
    const std::pair<const char*, int> cases[] = {
        {"  aucune ", 0}, {"", 0}, {"LAMBERT-93", 2154}, {"l93", 2154}, {"cc 42", 3942}, {"Lambert CC50", 3950},
        {"Lambert_IV_carto", 27574}, {"LAMBERT II ÉTENDU", 27572}, {"Lambert 2 etendu", 27572},
        {"Lambert IIe", 27572}, {"Lambert 3 sud", 27563}, {"utm 20 nord", 32620}, {"UTM 1S", 32701},
        {"epsg : 3946", 3946}};
    // clang-format on
    for (const auto& [name, epsg] : cases) {
        const ProjectionName resolved = ResolveProjectionName(name);
        EXPECT_EQ(resolved.error, "") << name;
        EXPECT_EQ(resolved.none, epsg == 0) << name;
        EXPECT_EQ(resolved.epsg, epsg) << name;
    }
    for (const NamedProjection& offered : OfferedProjections()) {
        const CProjection projection(offered.name);
        EXPECT_TRUE(projection.IsValid()) << offered.name << ": " << projection.Error();
        EXPECT_EQ(projection.IsNone(), offered.epsg == 0) << offered.name;
        EXPECT_EQ(projection.Epsg(), offered.epsg) << offered.name;
    }
}

TEST(ProjectionNames, AWrongNameSaysWhyInFrench) {
    for (const char* name :
         {"Mercator", "CC41", "CC51", "Lambert II Sud", "Lambert V", "EPSG:21x", "UTM N", "UTM 31X"})
        EXPECT_EQ(ResolveProjectionName(name).error, "Projection <" + std::string(name) + "> inconnue !");
    for (const char* name : {"UTM 61N", "UTM 0S"})
        EXPECT_EQ(ResolveProjectionName(name).error,
                  "Projection <" + std::string(name) + "> inconnue : les zones UTM vont de 1 à 60 !");
    EXPECT_EQ(ResolveProjectionName("UTM 31").error,
              "Projection <UTM 31> inconnue : précisez l'hémisphère de la zone UTM (par exemple « UTM 31N » "
              "ou « UTM 40S ») !");

    const CProjection unknown(" cc41 "); // named as the surveyor wrote it, blanks aside
    EXPECT_FALSE(unknown.IsValid());
    EXPECT_FALSE(unknown.IsNone());
    EXPECT_EQ(unknown.Name(), "cc41");
    EXPECT_EQ(unknown.Error(), "Projection <cc41> inconnue !");
}

TEST(ProjectionNames, AnEpsgCodeMustBeAProjectedSystemOfTheDatabase) {
    EXPECT_EQ(CProjection("EPSG:4326").Error(), // WGS 84 in longitude and latitude
              "Projection <EPSG:4326> : le système EPSG:4326 n'est pas une projection (ses "
              "coordonnées ne sont pas planes) !");
    EXPECT_EQ(CProjection("EPSG:999999").Error(),
              "Projection <EPSG:999999> : le code EPSG:999999 est inconnu !");
    const CProjection europe("EPSG:3035"); // a projection no surveyor names, accepted by its code
    EXPECT_TRUE(europe.IsValid()) << europe.Error();
    EXPECT_EQ(europe.Epsg(), 3035);
}

} // namespace
} // namespace pyr

// The names a surveyor gives a projection, and what PROJ makes of the systems they designate.
#include "projection/Projection.h"
#include "projection/ProjectionNames.h"

#include <gtest/gtest.h>

namespace pyr {
namespace {

TEST(ProjectionNames, EachWayOfWritingANameGivesItsSystem) {
    struct Case {
        const char* name;
        int epsg; // 0: "Aucune"
    };
    const Case cases[] = {
        {"Aucune", 0},
        {"  aucune ", 0},
        {"", 0},
        {"Lambert 93", 2154},
        {"LAMBERT-93", 2154},
        {"l93", 2154},
        {"CC42", 3942},
        {"cc 46", 3946},
        {"Lambert CC50", 3950},
        {"Lambert I", 27571},
        {"lambert 1 carto", 27571},
        {"Lambert II", 27572},
        {"Lambert II étendu", 27572},
        {"LAMBERT II ÉTENDU", 27572},
        {"Lambert 2 etendu", 27572},
        {"Lambert IIe", 27572},
        {"Lambert III", 27573},
        {"Lambert_IV", 27574},
        {"Lambert I Nord", 27561},
        {"Lambert II Centre", 27562},
        {"Lambert 3 sud", 27563},
        {"Lambert IV Corse", 27564},
        {"UTM 31N", 32631},
        {"utm 20 n", 32620},
        {"UTM 31 Nord", 32631},
        {"UTM 40S", 32740},
        {"UTM 1S", 32701},
        {"EPSG:2154", 2154},
        {"epsg : 3946", 3946},
    };
    for (const Case& c : cases) {
        const ProjectionName resolved = ResolveProjectionName(c.name);
        EXPECT_EQ(resolved.error, "") << c.name;
        EXPECT_EQ(resolved.none, c.epsg == 0) << c.name;
        EXPECT_EQ(resolved.epsg, c.epsg) << c.name;
    }
}

TEST(ProjectionNames, AWrongNameSaysWhyInFrench) {
    struct Case {
        const char* name;
        const char* error;
    };
    const Case cases[] = {
        {"Mercator", "Projection <Mercator> inconnue !"},
        {" CC41 ", "Projection <CC41> inconnue !"},
        {"CC51", "Projection <CC51> inconnue !"},
        {"CC4", "Projection <CC4> inconnue !"},
        {"Lambert II Sud", "Projection <Lambert II Sud> inconnue !"},
        {"Lambert V", "Projection <Lambert V> inconnue !"},
        {"EPSG:", "Projection <EPSG:> inconnue !"},
        {"EPSG:21x", "Projection <EPSG:21x> inconnue !"},
        {"UTM N", "Projection <UTM N> inconnue !"},
        {"UTM 31X", "Projection <UTM 31X> inconnue !"},
        {"UTM 61N", "Projection <UTM 61N> inconnue : les zones UTM vont de 1 à 60 !"},
        {"UTM 0S", "Projection <UTM 0S> inconnue : les zones UTM vont de 1 à 60 !"},
        {"UTM 31",
         "Projection <UTM 31> inconnue : précisez l'hémisphère de la zone UTM (par exemple « UTM 31N » "
         "ou « UTM 40S ») !"},
    };
    for (const Case& c : cases) {
        const ProjectionName resolved = ResolveProjectionName(c.name);
        EXPECT_EQ(resolved.error, c.error) << c.name;
        EXPECT_FALSE(resolved.none) << c.name;
    }
}

TEST(ProjectionNames, EveryOfferedNameIsASystemThatPROJKnows) {
    for (const NamedProjection& offered : OfferedProjections()) {
        const CProjection projection(offered.name);
        EXPECT_TRUE(projection.IsValid()) << offered.name << ": " << projection.Error();
        EXPECT_EQ(projection.IsNone(), offered.epsg == 0) << offered.name;
        EXPECT_EQ(projection.Epsg(), offered.epsg) << offered.name;
    }
}

TEST(ProjectionNames, AnEpsgCodeMustBeAProjectedSystemOfTheDatabase) {
    const CProjection geographic("EPSG:4326"); // WGS 84 in longitude and latitude
    EXPECT_FALSE(geographic.IsValid());
    EXPECT_EQ(geographic.Error(),
              "Projection <EPSG:4326> : le système EPSG:4326 n'est pas une projection (ses "
              "coordonnées ne sont pas planes) !");
    const CProjection missing("EPSG:999999");
    EXPECT_FALSE(missing.IsValid());
    EXPECT_EQ(missing.Error(), "Projection <EPSG:999999> : le code EPSG:999999 est inconnu !");
    EXPECT_FALSE(missing.IsNone());

    const CProjection europe("EPSG:3035"); // a projection no surveyor names, accepted by its code
    EXPECT_TRUE(europe.IsValid()) << europe.Error();
    EXPECT_EQ(europe.Name(), "EPSG:3035");
}

TEST(ProjectionNames, AnInvalidProjectionChangesNothing) {
    const CProjection unknown(" Mercator ", 6366.0);
    EXPECT_FALSE(unknown.IsValid());
    EXPECT_EQ(unknown.Name(), "Mercator");
    EXPECT_EQ(unknown.CalcLinearAlter(700000.0, 6600000.0), 0.0);
    double x = 700000.0, y = 6600000.0;
    EXPECT_FALSE(unknown.Convert(CProjection("Lambert 93"), x, y));
    EXPECT_EQ(x, 700000.0);
    EXPECT_EQ(y, 6600000.0);
}

} // namespace
} // namespace pyr

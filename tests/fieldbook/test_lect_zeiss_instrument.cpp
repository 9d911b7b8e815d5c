// M5 field books of an instrument whose information block holds the information in columns 1-7, the code
// in 11-15 and the point id in 16-27, read and radiated against the coordinates that the instrument
// computed: tests/data/fieldbook/zeiss-m3-entete.txt says so in its header (words 20, 21, 22; word 05 = 1,
// X the northing), zeiss-m3-sans-entete.txt holds the same lines without the header.
//
// Their geometry is constructed: known points R1 (E 1080, N 2060, Z 101.234) and R2 (E 1130, N 1900,
// Z 98.765); station S1 at E 1000, N 2000, Z 100, HI 1.550, set up on a known station (Hz = bearings),
// its backsight to R1 written before its station line; station S2 at E 1050, N 1950, Z 99.5, HI 1.620,
// its circle 41.2345 gon short of the bearings, oriented on R2, its backsight also written first. Each
// height is given after the start of the polar measurements. The observations were computed from the
// coordinates and written as the instrument rounds them (0.1 mgon, mm); the coordinates after each
// sighting were computed apart from this program, from the observations as written, and rounded to the
// mm. Reading them back must place every point within 1 mm.
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "fieldbook/LectZeiss.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

using ZeissRun = DriverRun<CLectZeiss, FieldBookFormat::Zeiss>;

// What both books give after their header comments.
constexpr const char* kElements =
    "1009 BORNE; 1006 R1; 1009 BORNE; 1006 R2; 1000 KN STAT; 1001 S1; 1006 S1; 1002 R1; 1000 POLAR; "
    "1009 MUR HAUT; 1003 101; 1006 101; 1009 ARBRE; 1003 102; 1006 102; 1009 MUR; 1003 103; 1006 103; "
    "1000 OR.COOR; 1001 S2; 1006 S2; 1002 R2; 1000 POLAR; 1009 BORNE FER; 1003 201; 1006 201; 1009 MUR; "
    "1003 202; 1006 202; ";

} // namespace

TEST(LectZeissInstrument, AnM3BookRadiatesOntoTheInstrumentsCoordinates) {
    const struct {
        const char* file;
        const char* header;
        const char* reports;
    } cases[] = {
        {"zeiss-m3-entete.txt",
         "1000 Format               = M5; 1000 Appareil             = M3 5\"; "
         "1000 Numéro de série      = 740112; 1000 Version du logiciel  = 2.10; "
         "1000 Axes des coordonnées = X = nord, Y = est; ",
         ""},
        {"zeiss-m3-sans-entete.txt", "1000 Format               = M5; ",
         "Attention : ligne 1 : places du matricule et du code non données par l'en-tête ; d'après les "
         "lignes "
         "de points, matricule lu en colonnes 16 à 27 et code en colonnes 11 à 15 du bloc d'information.\n"},
    };
    for (const auto& c : cases) {
        ZeissRun run;
        const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile(c.file);
        EXPECT_EQ(ReportText(run), c.reports) << c.file;
        ASSERT_EQ(ElementsSummary(read), std::string(c.header) + kElements) << c.file;
        // The radiation compares heights only where the station has one: its own check first.
        EXPECT_NEAR(read.hiAt(read.Find(kKindStation, "S1")), 1.55, 1e-4) << c.file;
        EXPECT_NEAR(read.hiAt(read.Find(kKindStation, "S2")), 1.62, 1e-4) << c.file;
        EXPECT_TRUE(AgreesWithInstrument(read, 7))
            << c.file; // R1, 101, 102, 103 from S1; R2, 201, 202 from S2
    }
}

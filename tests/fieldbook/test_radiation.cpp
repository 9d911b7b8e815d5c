// One survey as three makes of instrument record it, each with the coordinates it computed after each
// observation. Constructed: K1 (1250, 2180, 102.4) known; S1 (1000, 2000, 100), HI 1.562, its circle
// 37.4150 gr off the bearings, backsight on K1, then 101, 102, S2 and 103 (face II, target 1.800); S2
// (1080, 1940, 97.5), HI 1.485, circle 312.6600 gr off, backsight on S1 in both faces, then 201 and 202
// (face II, target 2.000). The observations were rounded as each book writes them and the recorded
// coordinates computed from them as written, the instrument oriented on its backsight's coordinates:
// radiated from the GéoBase, every point falls within the mm of the book.
#include "FieldBookTestSupport.h"
#include "RadiationCheck.h"
#include "fieldbook/LectNikon.h"
#include "fieldbook/LectSokkia.h"
#include "fieldbook/LectTopcon.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

template <class Reader, FieldBookFormat kFormat>
void ExpectAgreement(const char* book) {
    SCOPED_TRACE(book);
    DriverRun<Reader, kFormat> run;
    const CCarnet& read = run.Set(kKeyPointsCalcules, "1").ReadFile(book);
    EXPECT_EQ(ReportText(run), "");
    EXPECT_TRUE(AgreesWithInstrument(read, 9)); // K1, 101, 102, S2, 103; S1 in both faces, 201, 202
}

} // namespace

TEST(Radiation, TheSameSurveyInEveryMakeFindsTheInstrumentsOwnCoordinates) {
    // Raw V2.00 in ddd.mmss, northing first, CC records after each side shot (1", mm).
    ExpectAgreement<CLectNikon, FieldBookFormat::NikonAtlas>("nikon-raw-calcule.raw");
    // GTS-7 in metres and ddd.mmsss, XYZ east then north; 102 on an HD line, horizontal distance and
    // height from the tilting axis to the prism (0.1", 0.1 mm).
    ExpectAgreement<CLectTopcon, FieldBookFormat::TopconGT7>("topcon-calcule.gts7");
    // SDR33 in grads, east before north, and SDR2x in decimal degrees, north first, its reals touching;
    // 08TP records after each observation (0.1 mgon or what the 10 characters hold, mm).
    ExpectAgreement<CLectSokkia, FieldBookFormat::Sokkia>("sokkia-sdr33-calcule.sdr");
    ExpectAgreement<CLectSokkia, FieldBookFormat::Sokkia>("sokkia-sdr2x-calcule.sdr");
}

// The graphic view: a small GéoBase shown whole, clicked, zoomed about the cursor and drawn.
#include "GeoView.h"
#include "TestSupport.h"
#include "geobase/Carnet.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "ui/ScriptedFrontEnd.h"

#include <QApplication>
#include <QImage>
#include <QPainter>
#include <QSignalSpy>
#include <QTest>
#include <QWheelEvent>
#include <gtest/gtest.h>

namespace {

using pyr::bureau::GeoView;

// A control point A1, a station S1 100 m east and 50 m north of it, a computed point P1 between them and
// 80 m north of A1: an extent of 100 m by 80 m.
constexpr const char* kJob = "GEOBASE PYRALIS\t1\n"
                             "1006\tA1\t1000\t2000\t50\tXY\n"
                             "1006\tS1\t1100\t2050\t51\t-\n"
                             "1006\tP1\t1050\t2080\t-999999\t-\n"
                             "1001\tS1\t1.5\t-999999\n"
                             "1002\tA1\t1.3\t0\t100\t111.8\n"
                             "1003\tP1\t1.3\t0\t100\t58.3\n";

class GeoViewTest : public ::testing::Test {
protected:
    GeoViewTest() {
        WriteBytes(dir / "job.geo", kJob);
        view.resize(400, 300);
    }

    QImage Rendered() {
        QImage image(view.size(), QImage::Format_ARGB32_Premultiplied);
        QPainter painter(&image);
        view.RenderTo(painter, view.size());
        return image;
    }
    // A station's triangle is filled red.
    static bool IsStation(const QColor& colour) { return colour.red() > 200 && colour.green() < 80; }

    // The scale that fits 100 m by 80 m within the margins of 24 pixels of a 400 x 300 view.
    static constexpr double kFitScale = (300.0 - 48.0) / 80.0;

    TempDir dir;
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::ui::ScopedApplicationFrontEnd application{frontEnd};
    GeoView view;
};

TEST_F(GeoViewTest, ShowsTheWholeGeoBaseNorthUpAndSaysWhatIsClicked) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    EXPECT_EQ(view.Scene().Points().size(), 3u);
    EXPECT_NEAR(view.Scale(), kFitScale, 1e-9);
    // Centred; east to the right, north up.
    const QPointF a1 = view.ToScreen(1000, 2000), s1 = view.ToScreen(1100, 2050);
    EXPECT_NEAR((a1.x() + s1.x()) / 2, 200.0, 1e-9);
    EXPECT_NEAR(view.ToScreen(1050, 2040).y(), 150.0, 1e-9);
    EXPECT_LT(a1.x(), s1.x());
    EXPECT_GT(a1.y(), s1.y());

    view.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&view));
    QSignalSpy picked(&view, &GeoView::Picked);
    // Two pixels beside P1 is near enough; empty ground picks nothing.
    QTest::mouseClick(&view, Qt::LeftButton, {}, view.ToScreen(1050, 2080).toPoint() + QPoint(2, 1));
    QTest::mouseClick(&view, Qt::LeftButton, {}, QPoint(200, 150));
    ASSERT_EQ(picked.count(), 1);
    EXPECT_EQ(picked[0][0].toString(),
              QString::fromUtf8("Point P1 (point calculé) : X = 1050.0000 m, Y = 2080.0000 m, Z inconnu"));
    QSignalSpy moved(&view, &GeoView::CursorMoved);
    QTest::mouseMove(&view, view.ToScreen(1000, 2000).toPoint());
    ASSERT_GE(moved.count(), 1);
    EXPECT_NEAR(moved.last()[0].toDouble(), 1000.0, 1.0 / kFitScale);
    EXPECT_NEAR(moved.last()[1].toDouble(), 2000.0, 1.0 / kFitScale);
}

TEST_F(GeoViewTest, DrawsTheStationAndTheMeasureWhereTheyAre) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    const QImage image = Rendered();
    EXPECT_TRUE(IsStation(image.pixelColor(view.ToScreen(1100, 2050).toPoint())));
    // The measure to P1 is orange: at its middle, a pixel nearby holds little blue.
    const QPoint middle = view.ToScreen(1075, 2065).toPoint();
    int blue = 255;
    for (int dx = -1; dx <= 1; ++dx)
        for (int dy = -1; dy <= 1; ++dy)
            blue = std::min(blue, image.pixelColor(middle + QPoint(dx, dy)).blue());
    EXPECT_LT(blue, 150);
    // Far from everything, the background.
    EXPECT_GT(image.pixelColor(QPoint(200, 30)).blue(), 240);
}

// Thousands of points in a small view: drawn as dots and squares, each still where it stands.
TEST_F(GeoViewTest, TheOverviewOfADenseJobKeepsThePlaces) {
    pyr::CCarnet carnet;
    for (int i = 0; i < 3600; ++i)
        carnet.Add(
            std::make_unique<pyr::CPointGen>("P" + std::to_string(i), 1000.0 + i % 60, 2000.0 + i / 60, 50.0),
            pyr::kKindPoint);
    carnet.Add(std::make_unique<pyr::CStation>("P1830", 1.5), pyr::kKindStation);
    for (int i = 0; i < 3600; i += 3)
        carnet.Add(std::make_unique<pyr::CMesure>("P" + std::to_string(i), 0.0), pyr::kKindMesure);
    view.ShowCarnet(carnet);
    const QImage image = Rendered();
    EXPECT_TRUE(IsStation(image.pixelColor(view.ToScreen(1030, 2030).toPoint())));
    // A point of the corner, away from every sighting: a dark dot on the light ground.
    EXPECT_LT(image.pixelColor(view.ToScreen(1001, 2059).toPoint()).red(), 100);
    EXPECT_GT(image.pixelColor(view.ToScreen(1001, 2059).toPoint() + QPoint(-3, -3)).red(), 240);
}

TEST_F(GeoViewTest, TheWheelZoomsAboutTheCursorAndFitAllComesBack) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    const QPointF cursor(301.5, 80.25);
    double x, y;
    view.ToGround(cursor, x, y);
    for (int notches : {1, 3, -2}) {
        QWheelEvent wheel(cursor, view.mapToGlobal(cursor), QPoint(), QPoint(0, 120 * notches), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(&view, &wheel);
        const QPointF after = view.ToScreen(x, y);
        EXPECT_NEAR(after.x(), cursor.x(), 1.0);
        EXPECT_NEAR(after.y(), cursor.y(), 1.0);
    }
    EXPECT_NEAR(view.Scale(), kFitScale * 1.25 * 1.25, 1e-9);

    view.FitAll();
    EXPECT_NEAR(view.Scale(), kFitScale, 1e-9);
    EXPECT_NEAR(view.CentreX(), 1050.0, 1e-9);
    EXPECT_NEAR(view.CentreY(), 2040.0, 1e-9);
}

TEST_F(GeoViewTest, AGeoBaseThatCannotBeReadLeavesTheViewEmpty) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    EXPECT_FALSE(view.Show(dir / "absent.geo"));
    EXPECT_TRUE(view.Scene().IsEmpty());
    // The loader said why, to the application's front end.
    ASSERT_FALSE(frontEnd.messages.empty());
    EXPECT_NE(frontEnd.messages.back().text.find("absent.geo"), std::string::npos);
}

} // namespace

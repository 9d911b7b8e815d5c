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

// A scene shown again after an edit keeps the person's view; the first one, and one whose view showed
// everything, are shown whole.
TEST_F(GeoViewTest, AnEditedSceneKeepsTheViewTheFirstIsShownWhole) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    const pyr::GeoScene scene = view.Scene();
    GeoView other;
    other.resize(400, 300);
    other.ShowScene(scene);
    EXPECT_NEAR(other.Scale(), kFitScale, 1e-9);
    other.SetView(1090.0, 2040.0, 10.0);
    other.ShowScene(scene);
    EXPECT_DOUBLE_EQ(other.Scale(), 10.0);
    EXPECT_DOUBLE_EQ(other.CentreX(), 1090.0);
    // A view that no longer sees anything of the scene shows it whole again.
    other.SetView(5000.0, 5000.0, 10.0);
    other.ShowScene(scene);
    EXPECT_NEAR(other.Scale(), kFitScale, 1e-9);
    other.Clear();
    other.SetView(1090.0, 2040.0, 10.0);
    other.ShowScene(scene);
    EXPECT_NEAR(other.Scale(), kFitScale, 1e-9);
}

// The elements of the job: 0 A1, 1 S1, 2 P1, 3 the station, 4 its reference to A1, 5 its measure to P1.
TEST_F(GeoViewTest, TheSelectedElementsAndTheirSightingsAreDrawnApart) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    // The pixel of the measure to P1 at its middle that is least red: orange when not selected.
    auto leastRed = [&](const QImage& image) {
        const QPoint middle = view.ToScreen(1075, 2065).toPoint();
        QColor found(255, 255, 255);
        for (int dx = -1; dx <= 1; ++dx)
            for (int dy = -1; dy <= 1; ++dy)
                if (image.pixelColor(middle + QPoint(dx, dy)).red() < found.red())
                    found = image.pixelColor(middle + QPoint(dx, dy));
        return found;
    };
    EXPECT_GT(leastRed(Rendered()).red(), 180);

    // The station: both its sightings.
    view.SetSelectedElements({3});
    EXPECT_EQ(view.SelectedStations(), (std::vector<int>{0}));
    EXPECT_EQ(view.SelectedSightings().size(), 2u);
    const QColor selected = leastRed(Rendered());
    EXPECT_LT(selected.red(), 80);
    EXPECT_GT(selected.blue(), 150);
    // The sighting of A1 alone; then P1, and the sighting aimed at it.
    view.SetSelectedElements({4});
    ASSERT_EQ(view.SelectedSightings().size(), 1u);
    EXPECT_TRUE(view.Scene().Sightings()[static_cast<std::size_t>(view.SelectedSightings()[0])].reference);
    EXPECT_GT(leastRed(Rendered()).red(), 180);
    view.SetSelectedElements({2, 2, -1, 99});
    EXPECT_EQ(view.SelectedElements(), (std::vector<int>{2, 99}));
    ASSERT_EQ(view.SelectedPoints().size(), 1u);
    EXPECT_EQ(view.Scene().Points()[static_cast<std::size_t>(view.SelectedPoints()[0])].name, "P1");
    EXPECT_LT(leastRed(Rendered()).red(), 80);
    EXPECT_TRUE(view.SelectedStations().empty());
    // Kept across the scenes shown, and found again in the new one.
    view.ShowScene(pyr::GeoScene(view.Scene()));
    EXPECT_EQ(view.SelectedPoints().size(), 1u);
    view.SetSelectedElements({});
    EXPECT_TRUE(view.SelectedSightings().empty());
}

TEST_F(GeoViewTest, AClickGivesTheElementOfWhatIsPicked) {
    ASSERT_TRUE(view.Show(dir / "job.geo"));
    view.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&view));
    QSignalSpy picked(&view, &GeoView::ElementPicked);
    // The station wins over the point it stands on.
    QTest::mouseClick(&view, Qt::LeftButton, {}, view.ToScreen(1100, 2050).toPoint());
    QTest::mouseClick(&view, Qt::LeftButton, {}, view.ToScreen(1000, 2000).toPoint());
    QTest::mouseClick(&view, Qt::LeftButton, {}, QPoint(200, 150));
    ASSERT_EQ(picked.count(), 3);
    EXPECT_EQ(picked[0][0].toInt(), 3);
    EXPECT_EQ(picked[1][0].toInt(), 0);
    EXPECT_EQ(picked[2][0].toInt(), -1);
}

} // namespace

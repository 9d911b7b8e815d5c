#pragma once

#include "editor/GeoScene.h"

#include <QImage>
#include <QLineF>
#include <QPointF>
#include <QString>
#include <QWidget>
#include <cstdint>
#include <string>
#include <vector>

namespace pyr {
class CCarnet;
}

namespace pyr::bureau {

// The graphic view of the current GéoBase: points, stations, sightings and traverses drawn in ground
// coordinates, X (easting) to the right and Y (northing) upwards, at one scale for both axes.
//
// What is drawn comes from the scene's grid: only what lies in the window is touched. The drawing is kept
// in an image and redrawn only when the view changes; the names appear once few enough points are seen
// for them to be read. The wheel zooms about the cursor, the middle button or a left drag from an empty
// place pans, a click on a point or a station says what it is.
//
// Elements of the GéoBase may be shown selected (a dialog's choice): their points and stations ringed,
// and in the same colour the sightings that concern them: those of a selected set-up, those selected
// themselves, those aimed at a selected point.
class GeoView : public QWidget {
    Q_OBJECT
public:
    explicit GeoView(QWidget* parent = nullptr);
    ~GeoView() override;

    // Loads the GéoBase at that path through the store's loader (its reports go to the application's
    // front end) and shows all of it. False, and the view left empty, when it cannot be read.
    bool Show(const std::string& geoBasePath);
    void ShowCarnet(const CCarnet& carnet);
    // Shows a copy of a scene built elsewhere. The first scene is shown whole; a scene shown again after an
    // edit keeps the view the person chose, unless the view was showing everything, which it goes on
    // doing.
    void ShowScene(const GeoScene& scene);
    void Clear();
    const GeoScene& Scene() const { return m_scene; }

    // The scale that shows the whole scene, centred, with a margin.
    void FitAll();
    // Multiplies the scale by `factor`, the ground under `position` (pixels) staying where it is.
    void ZoomAt(const QPointF& position, double factor);
    // Pixels per metre; the ground point at the centre of the view.
    double Scale() const { return m_scale; }
    double CentreX() const { return m_centreX; }
    double CentreY() const { return m_centreY; }
    void SetView(double centreX, double centreY, double scale);

    // Between ground coordinates (metres) and the widget's pixels.
    QPointF ToScreen(double x, double y) const;
    void ToGround(const QPointF& position, double& x, double& y) const;

    // Draws the current view into a painter's device of that size, centred as the widget is: the image
    // shown, the benchmarks' drawing, the screenshots.
    void RenderTo(QPainter& painter, const QSize& size) const;

    // The elements shown selected (indices of elements of the GéoBase), kept across the scenes shown.
    void SetSelectedElements(std::vector<int> elements);
    const std::vector<int>& SelectedElements() const { return m_selected.elements; }
    // What they select in the scene: points, stations and sightings (indices into its lists), increasing.
    const std::vector<int>& SelectedPoints() const { return m_selected.points; }
    const std::vector<int>& SelectedStations() const { return m_selected.stations; }
    const std::vector<int>& SelectedSightings() const { return m_selected.sightings; }

signals:
    // A click on a point or a station: its description, as the status bar and the text window show it.
    void Picked(const QString& description);
    // The same click: the element of the point or the station picked, -1 for a click on nothing.
    void ElementPicked(int element);
    // The ground coordinates under the cursor (metres).
    void CursorMoved(double x, double y);

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    QSize sizeHint() const override;

private:
    // From ground to pixels for a device of a given size.
    struct Transform;
    Transform TransformFor(const QSize& size) const;
    void ViewChanged();
    // What the view shows, in pixels: the segments cut to it, the places of the symbols.
    void CollectSegments(const Transform& transform) const;
    void CollectMarks(const Transform& transform) const;
    void RasterOverview(QPainter& painter, const QSize& size, bool points, bool stations) const;
    void PaintSegments(QPainter& painter) const;
    void PaintPoints(QPainter& painter) const;
    void PaintStations(QPainter& painter) const;
    void DrawLabels(QPainter& painter, const Transform& transform) const;
    void DrawHighlight(QPainter& painter, const Transform& transform) const;
    void MarkSelected();
    void DrawSelectedSightings(QPainter& painter, const Transform& transform) const;
    void DrawSelectedMarks(QPainter& painter, const Transform& transform) const;
    void DrawScaleBar(QPainter& painter, const QSize& size) const;

    GeoScene m_scene;
    double m_centreX = 0.0;
    double m_centreY = 0.0;
    double m_scale = 1.0; // pixels per metre
    // The view shows all of the scene, as FitAll left it: a new size fits it again.
    bool m_fitted = true;
    SceneHit m_highlight;
    bool m_shown = false; // a scene was shown: the next one keeps the view

    // The elements selected, and what of the scene they select: the lists, and a flag per item of the
    // scene to test what is seen against.
    struct Selected {
        std::vector<int> elements;
        std::vector<int> points, stations, sightings;
        std::vector<std::uint8_t> pointFlags, stationFlags, sightingFlags;
    };
    Selected m_selected;

    // The last drawing, shown again while nothing changes.
    QImage m_cache;
    bool m_cacheValid = false;

    // The mouse between a press and its release.
    Qt::MouseButton m_pressButton = Qt::NoButton;
    QPointF m_pressPosition;
    QPointF m_lastPosition;
    bool m_panning = false;
    bool m_dragged = false;
    SceneHit m_pressHit;

    // The memory of every redraw, kept from one to the next.
    mutable SceneSelection m_selection;
    mutable std::vector<QLineF> m_references;
    mutable std::vector<QLineF> m_measures;
    mutable std::vector<QLineF> m_legLines;
    mutable std::vector<QLineF> m_crosses;
    mutable std::vector<QLineF> m_selectedLines;
    mutable std::vector<QPointF> m_computed;
    mutable std::vector<QPointF> m_known;
    mutable std::vector<QPointF> m_stationMarks;
    mutable std::vector<std::uint8_t> m_labelSpace;
    mutable QImage m_layer; // the overview's image
};

} // namespace pyr::bureau

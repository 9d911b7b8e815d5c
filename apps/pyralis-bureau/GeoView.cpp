#include "GeoView.h"

#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <QFontMetricsF>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QPolygonF>
#include <QWheelEvent>
#include <algorithm>
#include <cmath>
#include <cstddef>

namespace pyr::bureau {

namespace {

constexpr const char* kNothingToDraw = "Aucun point à dessiner";

// Readable on a light background, and told apart by shape as well as colour: the references blue and
// dashed, the measures orange and solid, the traverses thick and purple; stations are triangles, known
// points circles, computed points crosses.
const QColor kBackground(252, 251, 246);
const QColor kReference(36, 96, 178);
const QColor kMeasure(222, 128, 36);
const QColor kTraverse(120, 40, 140);
const QColor kComputedPoint(40, 40, 40);
const QColor kKnownPoint(0, 120, 60);
const QColor kStationFill(220, 52, 44);
const QColor kStationLine(110, 16, 12);
const QColor kLabel(30, 30, 30);
const QColor kHighlight(230, 0, 120);
// What a dialog selected: its points and stations ringed, its sightings drawn over the others, in a colour
// that no layer uses.
const QColor kSelected(0, 150, 200);
const QColor kLabelVeil(252, 251, 246, 200);

// Sizes in pixels.
constexpr double kCross = 3.0;    // half the arms of a computed point's cross
constexpr double kCircle = 3.5;   // radius of a known point's circle
constexpr double kTriangle = 6.0; // half the side of a station's triangle
constexpr double kTraverseWidth = 3.0;
constexpr double kSelectedWidth = 2.5; // a selected sighting
constexpr double kSelectedRing = 7.0;  // radius of the ring round a selected point or station
constexpr double kMargin = 24.0;       // around the scene when all of it is shown
constexpr double kPickPixels = 6.0;    // how near the cursor a point must be to be picked
constexpr double kDragPixels = 3.0;    // a press that moves less is a click
// Below this many pixels of the view for each symbol, symbols would cover each other: points are drawn
// as dots and stations as small squares.
constexpr double kPixelsPerPoint = 120.0;
constexpr double kPixelsPerStation = 400.0;
// Denser still, dots of one pixel and squares of three.
constexpr double kPixelsPerDot = 16.0;
constexpr double kPixelsPerSquare = 100.0;
// More lines than this are drawn in the overview, without the painter.
constexpr std::size_t kPainterLines = 6000;
// Names are written when no more points and stations than this are seen, and never over one another.
constexpr std::size_t kMaxLabels = 1500;
constexpr int kLabelBlock = 4; // pixels: the grain of the space the names take
// The scale stays within these (pixels per metre): from a thousand kilometres to a tenth of a millimetre
// to the pixel.
constexpr double kMaxScale = 1.0e4;
constexpr double kMinScale = 1.0e-6;

// Cuts the segment to the rectangle (Liang and Barsky). The raster engine works in fixed point, so
// coordinates far outside the device, as a long sighting gives when zoomed in, must not reach it.
bool ClipSegment(const QRectF& r, QPointF& a, QPointF& b) {
    if (r.contains(a) && r.contains(b)) return true;
    const double dx = b.x() - a.x(), dy = b.y() - a.y();
    double t0 = 0.0, t1 = 1.0;
    auto edge = [&](double p, double q) {
        if (p == 0.0) return q >= 0.0;
        const double t = q / p;
        if (p < 0.0) {
            if (t > t1) return false;
            t0 = std::max(t0, t);
        } else {
            if (t < t0) return false;
            t1 = std::min(t1, t);
        }
        return true;
    };
    if (!edge(-dx, a.x() - r.left()) || !edge(dx, r.right() - a.x()) || !edge(-dy, a.y() - r.top()) ||
        !edge(dy, r.bottom() - a.y()))
        return false;
    const QPointF start = a;
    a = start + QPointF(t0 * dx, t0 * dy);
    b = start + QPointF(t1 * dx, t1 * dy);
    return true;
}

QPen Cosmetic(const QColor& colour, double width, Qt::PenStyle style = Qt::SolidLine) {
    QPen pen(colour, width, style, Qt::FlatCap, Qt::MiterJoin);
    pen.setCosmetic(true);
    return pen;
}

// 1, 2 or 5 times a power of ten metres: the longest such length not over `metres`.
double RoundLength(double metres) {
    const double power = std::pow(10.0, std::floor(std::log10(metres)));
    for (double step : {5.0, 2.0, 1.0})
        if (step * power <= metres) return step * power;
    return power;
}

QString LengthText(double metres) {
    if (metres >= 1000.0) return QString::number(metres / 1000.0, 'g', 6) + " km";
    if (metres >= 1.0) return QString::number(metres, 'g', 6) + " m";
    return QString::number(metres * 100.0, 'g', 6) + " cm";
}

// Lines one pixel wide and squares written straight into an image's memory (32 bits a pixel), for the
// overview: there the painter's own cost for each of a hundred thousand segments would dominate the
// redraw, while lines without antialiasing look the same at that density.
class Raster {
public:
    explicit Raster(QImage& image)
        : m_bits(reinterpret_cast<QRgb*>(image.bits())), m_stride(image.bytesPerLine() / 4),
          m_width(image.width()), m_height(image.height()) {}

    void Plot(int x, int y, QRgb colour) {
        if (x >= 0 && y >= 0 && x < m_width && y < m_height)
            m_bits[static_cast<std::ptrdiff_t>(y) * m_stride + x] = colour;
    }
    // From a to b (Bresenham), `thickness` pixels across its longer axis; dashed when `on` is given: `on`
    // pixels drawn, `off` pixels left, along the longer axis.
    void Line(const QPointF& a, const QPointF& b, QRgb colour, int thickness = 1, int on = 0, int off = 0) {
        int x0 = static_cast<int>(std::lround(a.x())), y0 = static_cast<int>(std::lround(a.y()));
        const int x1 = static_cast<int>(std::lround(b.x())), y1 = static_cast<int>(std::lround(b.y()));
        const int dx = std::abs(x1 - x0), dy = -std::abs(y1 - y0);
        const int sx = x0 < x1 ? 1 : -1, sy = y0 < y1 ? 1 : -1;
        const bool steep = -dy > dx;
        const int first = -(thickness - 1) / 2, last = first + thickness - 1;
        int error = dx + dy;
        for (int step = 0;; ++step) {
            if (on == 0 || step % (on + off) < on)
                for (int k = first; k <= last; ++k)
                    steep ? Plot(x0 + k, y0, colour) : Plot(x0, y0 + k, colour);
            if (x0 == x1 && y0 == y1) break;
            const int twice = 2 * error;
            if (twice >= dy) {
                error += dy;
                x0 += sx;
            }
            if (twice <= dx) {
                error += dx;
                y0 += sy;
            }
        }
    }
    // A square of `side` pixels centred on a point.
    void Square(const QPointF& centre, int side, QRgb colour) {
        const int left = static_cast<int>(std::lround(centre.x() - side / 2.0));
        const int top = static_cast<int>(std::lround(centre.y() - side / 2.0));
        for (int y = top; y < top + side; ++y)
            for (int x = left; x < left + side; ++x)
                Plot(x, y, colour);
    }

private:
    QRgb* m_bits;
    std::ptrdiff_t m_stride;
    int m_width;
    int m_height;
};

} // namespace

struct GeoView::Transform {
    double centreX, centreY, scale, halfWidth, halfHeight;
    int width, height;

    QPointF operator()(double x, double y) const {
        return {halfWidth + (x - centreX) * scale, halfHeight - (y - centreY) * scale};
    }
    // The ground seen, widened by `pixels` on every side.
    GroundRect Window(double pixels) const {
        return GroundRect::Around(centreX, centreY, (halfWidth + pixels) / scale,
                                  (halfHeight + pixels) / scale);
    }
    QRectF Bounds(double pixels) const {
        return QRectF(-pixels, -pixels, width + 2 * pixels, height + 2 * pixels);
    }
    double Area() const { return std::max(1.0, static_cast<double>(width) * height); }
};

GeoView::GeoView(QWidget* parent) : QWidget(parent) {
    setMouseTracking(true);
    setCursor(Qt::CrossCursor);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setFocusPolicy(Qt::WheelFocus);
}

GeoView::~GeoView() = default;

QSize GeoView::sizeHint() const {
    return {800, 600};
}

bool GeoView::Show(const std::string& geoBasePath) {
    CCarnet carnet;
    ui::FrontEnd& frontEnd = ui::ApplicationFrontEnd();
    CPyrTxtWnd txt(frontEnd);
    if (!carnet.Load(&txt, geoBasePath, {}, 0, &frontEnd)) {
        Clear();
        return false;
    }
    ShowCarnet(carnet);
    return true;
}

void GeoView::ShowCarnet(const CCarnet& carnet) {
    m_scene.Build(carnet);
    m_highlight = {};
    m_shown = true;
    MarkSelected();
    FitAll();
}

void GeoView::ShowScene(const GeoScene& scene) {
    // After an edit the scene is nearly the same: the person's zoom and place stay, unless nothing of the
    // new scene would be seen through them.
    const GroundRect seen = TransformFor(size()).Window(0.0);
    const bool keep = m_shown && !m_fitted && !m_scene.IsEmpty() && scene.Extent().Intersects(seen);
    m_scene = scene;
    m_highlight = {};
    m_shown = true;
    MarkSelected();
    if (keep)
        ViewChanged();
    else
        FitAll();
}

void GeoView::Clear() {
    m_scene.Clear();
    m_highlight = {};
    m_shown = false;
    MarkSelected();
    FitAll();
}

void GeoView::SetSelectedElements(std::vector<int> elements) {
    if (!std::is_sorted(elements.begin(), elements.end())) std::sort(elements.begin(), elements.end());
    elements.erase(std::unique(elements.begin(), elements.end()), elements.end());
    elements.erase(elements.begin(), std::lower_bound(elements.begin(), elements.end(), 0));
    if (elements == m_selected.elements) return;
    m_selected.elements = std::move(elements);
    MarkSelected();
    ViewChanged();
}

void GeoView::MarkSelected() {
    Selected& selected = m_selected;
    selected.points.clear();
    selected.stations.clear();
    selected.sightings.clear();
    selected.pointFlags.clear();
    selected.stationFlags.clear();
    selected.sightingFlags.clear();
    if (selected.elements.empty()) return;
    auto chosen = [&](int element) {
        return std::binary_search(selected.elements.begin(), selected.elements.end(), element);
    };
    // One pass over each list of the scene, in its order: the lists come out increasing.
    auto mark = [&](const auto& items, std::vector<int>& list, std::vector<std::uint8_t>& flags, auto test) {
        flags.assign(items.size(), 0);
        for (std::size_t index = 0; index < items.size(); ++index)
            if (test(items[index])) {
                flags[index] = 1;
                list.push_back(static_cast<int>(index));
            }
    };
    mark(m_scene.Points(), selected.points, selected.pointFlags,
         [&](const ScenePoint& point) { return chosen(point.element); });
    mark(m_scene.Stations(), selected.stations, selected.stationFlags,
         [&](const SceneStation& station) { return chosen(station.element); });
    mark(m_scene.Sightings(), selected.sightings, selected.sightingFlags, [&](const SceneSighting& sighting) {
        return selected.stationFlags[static_cast<std::size_t>(sighting.station)] ||
               selected.pointFlags[static_cast<std::size_t>(sighting.target)] || chosen(sighting.element);
    });
}

void GeoView::FitAll() {
    const GroundRect& extent = m_scene.Extent();
    const double width = std::max(1.0, static_cast<double>(this->width()) - 2 * kMargin);
    const double height = std::max(1.0, static_cast<double>(this->height()) - 2 * kMargin);
    if (extent.IsEmpty()) {
        m_centreX = m_centreY = 0.0;
        m_scale = 1.0;
    } else {
        m_centreX = extent.CentreX();
        m_centreY = extent.CentreY();
        // A single point, or points on one line of northing or easting, show 100 m around them.
        const double across = std::max(extent.Width(), 0.0), up = std::max(extent.Height(), 0.0);
        if (across == 0.0 && up == 0.0)
            m_scale = std::min(width, height) / 100.0;
        else if (across == 0.0)
            m_scale = height / up;
        else if (up == 0.0)
            m_scale = width / across;
        else
            m_scale = std::min(width / across, height / up);
        m_scale = std::clamp(m_scale, kMinScale, kMaxScale);
    }
    m_fitted = true;
    ViewChanged();
}

void GeoView::ZoomAt(const QPointF& position, double factor) {
    if (!(factor > 0.0)) return;
    double x, y;
    ToGround(position, x, y);
    m_scale = std::clamp(m_scale * factor, kMinScale, kMaxScale);
    m_centreX = x - (position.x() - width() / 2.0) / m_scale;
    m_centreY = y + (position.y() - height() / 2.0) / m_scale;
    m_fitted = false;
    ViewChanged();
}

void GeoView::SetView(double centreX, double centreY, double scale) {
    m_centreX = centreX;
    m_centreY = centreY;
    m_scale = std::clamp(scale, kMinScale, kMaxScale);
    m_fitted = false;
    ViewChanged();
}

QPointF GeoView::ToScreen(double x, double y) const {
    return TransformFor(size())(x, y);
}

void GeoView::ToGround(const QPointF& position, double& x, double& y) const {
    x = m_centreX + (position.x() - width() / 2.0) / m_scale;
    y = m_centreY - (position.y() - height() / 2.0) / m_scale;
}

GeoView::Transform GeoView::TransformFor(const QSize& size) const {
    return {m_centreX,           m_centreY,    m_scale,      size.width() / 2.0,
            size.height() / 2.0, size.width(), size.height()};
}

void GeoView::ViewChanged() {
    m_cacheValid = false;
    update();
}

// ---- Drawing

void GeoView::RenderTo(QPainter& painter, const QSize& size) const {
    painter.save();
    if (m_scene.IsEmpty()) {
        painter.fillRect(QRect(QPoint(0, 0), size), kBackground);
        painter.setPen(QColor(120, 120, 120));
        painter.drawText(QRect(QPoint(0, 0), size), Qt::AlignCenter, kNothingToDraw);
        painter.restore();
        return;
    }
    const Transform transform = TransformFor(size);
    // Symbols and names of what stands just outside still show their part inside.
    m_scene.Query(transform.Window(3 * kTriangle), m_selection);
    CollectSegments(transform);
    CollectMarks(transform);

    // Where symbols would cover each other, or lines are too many for the painter to draw each one in
    // time, the overview: the lower layers written straight into an image, one pixel wide lines, dots
    // and squares. What lies above them is painted over that image.
    const double area = transform.Area();
    const bool stationsDense = static_cast<double>(m_stationMarks.size()) * kPixelsPerStation > area;
    const bool pointsDense =
        stationsDense || static_cast<double>(m_computed.size() + m_known.size()) * kPixelsPerPoint > area;
    const bool linesDense =
        pointsDense || m_references.size() + m_measures.size() + m_legLines.size() > kPainterLines;
    if (linesDense) {
        RasterOverview(painter, size, pointsDense, stationsDense);
    } else {
        painter.fillRect(QRect(QPoint(0, 0), size), kBackground);
        PaintSegments(painter);
    }
    DrawSelectedSightings(painter, transform);
    if (!pointsDense) PaintPoints(painter);
    if (!stationsDense) PaintStations(painter);
    DrawSelectedMarks(painter, transform);
    DrawLabels(painter, transform);
    DrawHighlight(painter, transform);
    DrawScaleBar(painter, size);
    painter.restore();
}

void GeoView::CollectSegments(const Transform& transform) const {
    const QRectF bounds = transform.Bounds(kTraverseWidth + 1);
    m_references.clear();
    m_measures.clear();
    m_legLines.clear();
    const auto& stations = m_scene.Stations();
    const auto& points = m_scene.Points();
    for (int id : m_selection.sightings) {
        const SceneSighting& sighting = m_scene.Sightings()[static_cast<std::size_t>(id)];
        const SceneStation& from = stations[static_cast<std::size_t>(sighting.station)];
        const ScenePoint& to = points[static_cast<std::size_t>(sighting.target)];
        QPointF a = transform(from.x, from.y), b = transform(to.x, to.y);
        // Shorter than a pixel: hidden under the station's symbol.
        if (std::abs(a.x() - b.x()) < 1.0 && std::abs(a.y() - b.y()) < 1.0) continue;
        if (!ClipSegment(bounds, a, b)) continue;
        (sighting.reference ? m_references : m_measures).emplace_back(a, b);
    }
    for (int id : m_selection.legs) {
        const SceneLeg& leg = m_scene.Legs()[static_cast<std::size_t>(id)];
        QPointF a = transform(leg.x1, leg.y1), b = transform(leg.x2, leg.y2);
        if (ClipSegment(bounds, a, b)) m_legLines.emplace_back(a, b);
    }
}

void GeoView::CollectMarks(const Transform& transform) const {
    m_computed.clear();
    m_known.clear();
    m_stationMarks.clear();
    for (int id : m_selection.points) {
        const ScenePoint& point = m_scene.Points()[static_cast<std::size_t>(id)];
        (point.known ? m_known : m_computed).push_back(transform(point.x, point.y));
    }
    for (int id : m_selection.stations) {
        const SceneStation& station = m_scene.Stations()[static_cast<std::size_t>(id)];
        // The set-ups on one point share its symbol.
        if (station.firstOnPoint == id) m_stationMarks.push_back(transform(station.x, station.y));
    }
}

void GeoView::RasterOverview(QPainter& painter, const QSize& size, bool points, bool stations) const {
    const qreal ratio = painter.device() ? painter.device()->devicePixelRatio() : 1.0;
    const QSize pixels(static_cast<int>(std::ceil(size.width() * ratio)),
                       static_cast<int>(std::ceil(size.height() * ratio)));
    if (m_layer.size() != pixels) m_layer = QImage(pixels, QImage::Format_RGB32);
    m_layer.setDevicePixelRatio(ratio);
    m_layer.fill(kBackground);
    Raster raster(m_layer);
    auto pixel = [ratio](double length) {
        return std::max(1, static_cast<int>(std::lround(length * ratio)));
    };
    for (const QLineF& line : m_measures)
        raster.Line(line.p1() * ratio, line.p2() * ratio, kMeasure.rgb());
    for (const QLineF& line : m_references)
        raster.Line(line.p1() * ratio, line.p2() * ratio, kReference.rgb(), 1, pixel(4), pixel(3));
    for (const QLineF& line : m_legLines)
        raster.Line(line.p1() * ratio, line.p2() * ratio, kTraverse.rgb(), pixel(kTraverseWidth));
    // Dots and squares a size smaller where they would cover most of the ground.
    const double area = static_cast<double>(size.width()) * size.height();
    if (points) {
        const int smaller = static_cast<double>(m_computed.size() + m_known.size()) * kPixelsPerDot > area;
        for (const QPointF& at : m_computed)
            raster.Square(at * ratio, pixel(2 - smaller), kComputedPoint.rgb());
        for (const QPointF& at : m_known)
            raster.Square(at * ratio, pixel(3 - smaller), kKnownPoint.rgb());
    }
    if (stations) {
        const int smaller = static_cast<double>(m_stationMarks.size()) * kPixelsPerSquare > area;
        for (const QPointF& at : m_stationMarks)
            raster.Square(at * ratio, pixel(4 - smaller), kStationFill.rgb());
    }
    painter.drawImage(QPointF(0, 0), m_layer);
}

void GeoView::PaintSegments(QPainter& painter) const {
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kMeasure, 1.0));
    painter.drawLines(m_measures.data(), static_cast<int>(m_measures.size()));
    painter.setPen(Cosmetic(kReference, 1.0, Qt::DashLine));
    painter.drawLines(m_references.data(), static_cast<int>(m_references.size()));
    painter.setPen(QPen(kTraverse, kTraverseWidth, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawLines(m_legLines.data(), static_cast<int>(m_legLines.size()));
}

void GeoView::PaintPoints(QPainter& painter) const {
    // Computed points as crosses, known points as circles around a dot.
    m_crosses.clear();
    for (const QPointF& at : m_computed) {
        m_crosses.emplace_back(at - QPointF(kCross, kCross), at + QPointF(kCross, kCross));
        m_crosses.emplace_back(at - QPointF(kCross, -kCross), at + QPointF(kCross, -kCross));
    }
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kComputedPoint, 1.2));
    painter.drawLines(m_crosses.data(), static_cast<int>(m_crosses.size()));
    painter.setPen(Cosmetic(kKnownPoint, 1.5));
    painter.setBrush(Qt::NoBrush);
    for (const QPointF& at : m_known)
        painter.drawEllipse(at, kCircle, kCircle);
    painter.setPen(Cosmetic(kKnownPoint, 2.0));
    painter.drawPoints(m_known.data(), static_cast<int>(m_known.size()));
}

void GeoView::PaintStations(QPainter& painter) const {
    // A triangle pointing up, its centre on the station.
    const double h = kTriangle * std::sqrt(3.0);
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kStationLine, 1.0));
    painter.setBrush(kStationFill);
    for (const QPointF& at : m_stationMarks) {
        const QPointF triangle[3] = {at + QPointF(0, -2 * h / 3), at + QPointF(kTriangle, h / 3),
                                     at + QPointF(-kTriangle, h / 3)};
        painter.drawPolygon(triangle, 3);
    }
    painter.setBrush(Qt::NoBrush);
}

void GeoView::DrawLabels(QPainter& painter, const Transform& transform) const {
    if (m_selection.points.size() + m_selection.stations.size() > kMaxLabels) return;
    QFont font = painter.font();
    font.setPointSizeF(8.0);
    QFont bold = font;
    bold.setBold(true);

    // The space taken by the names written so far, in blocks of a few pixels: a name that would cover
    // another is left out, the stations' first.
    const int columns = transform.width / kLabelBlock + 1, rows = transform.height / kLabelBlock + 1;
    m_labelSpace.assign(static_cast<std::size_t>(columns) * static_cast<std::size_t>(rows), 0);
    auto place = [&](const QRectF& box) {
        const int left = std::max(0, static_cast<int>(box.left()) / kLabelBlock);
        const int right = std::min(columns - 1, static_cast<int>(box.right()) / kLabelBlock);
        const int top = std::max(0, static_cast<int>(box.top()) / kLabelBlock);
        const int bottom = std::min(rows - 1, static_cast<int>(box.bottom()) / kLabelBlock);
        if (box.right() < 0 || box.bottom() < 0 || left > right || top > bottom) return false;
        for (int row = top; row <= bottom; ++row)
            for (int column = left; column <= right; ++column)
                if (m_labelSpace[static_cast<std::size_t>(row) * columns + column]) return false;
        for (int row = top; row <= bottom; ++row)
            for (int column = left; column <= right; ++column)
                m_labelSpace[static_cast<std::size_t>(row) * columns + column] = 1;
        return true;
    };
    auto write = [&](const QFont& face, const QColor& colour, const QPointF& at, double offset,
                     const std::string& text) {
        const QString label = QString::fromStdString(text);
        const QFontMetricsF metrics(face);
        const QPointF baseline = at + QPointF(offset, -offset);
        const QRectF box(baseline.x(), baseline.y() - metrics.ascent(), metrics.horizontalAdvance(label),
                         metrics.height());
        if (!place(box)) return;
        // On a veil of the background, so that a line under the name does not cross it.
        painter.fillRect(box.adjusted(-1, 0, 1, 0), kLabelVeil);
        painter.setFont(face);
        painter.setPen(colour);
        painter.drawText(baseline, label);
    };

    painter.setRenderHint(QPainter::TextAntialiasing, true);
    const auto& stations = m_scene.Stations();
    for (int id : m_selection.stations) {
        const SceneStation& station = stations[static_cast<std::size_t>(id)];
        // The set-ups on one point: "S1, S1(2)".
        if (station.firstOnPoint != id) continue;
        std::string text = station.designation;
        for (int s = station.nextOnPoint; s >= 0; s = stations[static_cast<std::size_t>(s)].nextOnPoint)
            text += ", " + stations[static_cast<std::size_t>(s)].designation;
        write(bold, kStationLine, transform(station.x, station.y), kTriangle + 1, text);
    }
    for (int id : m_selection.points) {
        const ScenePoint& point = m_scene.Points()[static_cast<std::size_t>(id)];
        if (point.stationHere) continue;
        write(font, point.known ? kKnownPoint : kLabel, transform(point.x, point.y), kCircle + 1, point.name);
    }
}

void GeoView::DrawHighlight(QPainter& painter, const Transform& transform) const {
    if (!m_highlight) return;
    double x, y;
    if (m_highlight.kind == SceneHit::Kind::Station) {
        const SceneStation& station = m_scene.Stations()[static_cast<std::size_t>(m_highlight.index)];
        x = station.x, y = station.y;
    } else {
        const ScenePoint& point = m_scene.Points()[static_cast<std::size_t>(m_highlight.index)];
        x = point.x, y = point.y;
    }
    const QPointF at = transform(x, y);
    if (!transform.Bounds(20).contains(at)) return;
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kHighlight, 2.0));
    painter.setBrush(Qt::NoBrush);
    painter.drawEllipse(at, 10.0, 10.0);
}

namespace {

// Calls `draw` for each item both selected and seen, going through the shorter of the two lists.
template <class Draw>
void ForEachSelectedSeen(const std::vector<int>& selected, const std::vector<std::uint8_t>& flags,
                         const std::vector<int>& seen, Draw&& draw) {
    if (selected.size() <= seen.size()) {
        for (int id : selected)
            draw(id);
    } else {
        for (int id : seen)
            if (flags[static_cast<std::size_t>(id)]) draw(id);
    }
}

} // namespace

void GeoView::DrawSelectedSightings(QPainter& painter, const Transform& transform) const {
    if (m_selected.sightings.empty()) return;
    const QRectF bounds = transform.Bounds(kSelectedWidth + 1);
    m_selectedLines.clear();
    ForEachSelectedSeen(m_selected.sightings, m_selected.sightingFlags, m_selection.sightings, [&](int id) {
        const SceneSighting& sighting = m_scene.Sightings()[static_cast<std::size_t>(id)];
        const SceneStation& from = m_scene.Stations()[static_cast<std::size_t>(sighting.station)];
        const ScenePoint& to = m_scene.Points()[static_cast<std::size_t>(sighting.target)];
        QPointF a = transform(from.x, from.y), b = transform(to.x, to.y);
        if (ClipSegment(bounds, a, b)) m_selectedLines.emplace_back(a, b);
    });
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kSelected, kSelectedWidth));
    painter.drawLines(m_selectedLines.data(), static_cast<int>(m_selectedLines.size()));
}

void GeoView::DrawSelectedMarks(QPainter& painter, const Transform& transform) const {
    if (m_selected.points.empty() && m_selected.stations.empty()) return;
    const QRectF bounds = transform.Bounds(kSelectedRing + 2);
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setPen(Cosmetic(kSelected, 2.0));
    painter.setBrush(Qt::NoBrush);
    auto ring = [&](double x, double y, double radius) {
        const QPointF at = transform(x, y);
        if (bounds.contains(at)) painter.drawEllipse(at, radius, radius);
    };
    ForEachSelectedSeen(m_selected.points, m_selected.pointFlags, m_selection.points, [&](int id) {
        const ScenePoint& point = m_scene.Points()[static_cast<std::size_t>(id)];
        ring(point.x, point.y, kSelectedRing);
    });
    // Round the station's triangle.
    ForEachSelectedSeen(m_selected.stations, m_selected.stationFlags, m_selection.stations, [&](int id) {
        const SceneStation& station = m_scene.Stations()[static_cast<std::size_t>(id)];
        ring(station.x, station.y, kTriangle + 4);
    });
}

void GeoView::DrawScaleBar(QPainter& painter, const QSize& size) const {
    // About a tenth of the width, in the lower left corner.
    const double wanted = std::clamp(size.width() / 8.0, 40.0, 160.0);
    const double metres = RoundLength(wanted / m_scale);
    const double pixels = metres * m_scale;
    const QPointF start(12.0, size.height() - 14.0);
    painter.setRenderHint(QPainter::Antialiasing, false);
    painter.setPen(Cosmetic(QColor(60, 60, 60), 1.0));
    painter.drawLine(start, start + QPointF(pixels, 0));
    painter.drawLine(start, start - QPointF(0, 4));
    painter.drawLine(start + QPointF(pixels, 0), start + QPointF(pixels, -4));
    QFont font = painter.font();
    font.setPointSizeF(8.0);
    painter.setFont(font);
    painter.drawText(start + QPointF(pixels + 6, 3), LengthText(metres));
}

// ---- The widget

void GeoView::paintEvent(QPaintEvent*) {
    const qreal ratio = devicePixelRatioF();
    const QSize pixels = size() * ratio;
    if (!m_cacheValid || m_cache.size() != pixels) {
        if (m_cache.size() != pixels) m_cache = QImage(pixels, QImage::Format_ARGB32_Premultiplied);
        m_cache.setDevicePixelRatio(ratio);
        QPainter painter(&m_cache);
        RenderTo(painter, size());
        m_cacheValid = true;
    }
    QPainter painter(this);
    painter.drawImage(QPointF(0, 0), m_cache);
}

void GeoView::resizeEvent(QResizeEvent*) {
    // A view showing everything keeps showing everything; another keeps its centre and scale.
    if (m_fitted)
        FitAll();
    else
        ViewChanged();
}

void GeoView::wheelEvent(QWheelEvent* event) {
    const int steps = event->angleDelta().y(); // eighths of a degree: 120 for one notch
    if (steps == 0) return event->ignore();
    ZoomAt(event->position(), std::pow(1.25, steps / 120.0));
    event->accept();
}

void GeoView::mousePressEvent(QMouseEvent* event) {
    m_pressButton = event->button();
    m_pressPosition = m_lastPosition = event->position();
    m_dragged = false;
    m_pressHit = {};
    if (m_pressButton == Qt::MiddleButton) {
        m_panning = true;
    } else if (m_pressButton == Qt::LeftButton) {
        double x, y;
        ToGround(event->position(), x, y);
        m_pressHit = m_scene.Pick(x, y, kPickPixels / m_scale);
        // A drag from an empty place pans; from a point or a station it does nothing yet.
        m_panning = !m_pressHit;
    }
    if (m_panning) setCursor(Qt::ClosedHandCursor);
    event->accept();
}

void GeoView::mouseMoveEvent(QMouseEvent* event) {
    double x, y;
    ToGround(event->position(), x, y);
    emit CursorMoved(x, y);
    if (m_pressButton == Qt::NoButton) return;
    const QPointF moved = event->position() - m_pressPosition;
    if (std::abs(moved.x()) + std::abs(moved.y()) > kDragPixels) m_dragged = true;
    if (m_panning && (m_dragged || m_pressButton == Qt::MiddleButton)) {
        const QPointF delta = event->position() - m_lastPosition;
        m_lastPosition = event->position();
        m_centreX -= delta.x() / m_scale;
        m_centreY += delta.y() / m_scale;
        m_fitted = false;
        ViewChanged();
    }
}

void GeoView::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() != m_pressButton) return;
    if (m_pressButton == Qt::LeftButton && !m_dragged) {
        m_highlight = m_pressHit;
        ViewChanged();
        if (m_pressHit) emit Picked(QString::fromStdString(m_pressHit.description));
        int element = -1;
        if (m_pressHit.kind == SceneHit::Kind::Station)
            element = m_scene.Stations()[static_cast<std::size_t>(m_pressHit.index)].element;
        else if (m_pressHit.kind == SceneHit::Kind::Point)
            element = m_scene.Points()[static_cast<std::size_t>(m_pressHit.index)].element;
        emit ElementPicked(element);
    }
    m_pressButton = Qt::NoButton;
    m_panning = false;
    setCursor(Qt::CrossCursor);
    event->accept();
}

} // namespace pyr::bureau

#include "CommandIcons.h"

#include <QPainter>
#include <QPainterPath>
#include <QPixmap>
#include <QPolygonF>
#include <map>

namespace pyr::bureau {

namespace {

// Drawn on a 32 × 32 grid; Qt scales the icon for the toolbar and the menus.
constexpr int kSize = 32;
const QColor kInk(40, 40, 48);
const QColor kKnown(200, 40, 40);     // known points and stations
const QColor kComputed(30, 110, 200); // the point or the value computed
const QColor kBook(52, 101, 164);
const QColor kExport(46, 139, 87);

void Station(QPainter& p, QPointF at, const QColor& colour = kKnown) {
    const QPolygonF triangle({at + QPointF(0, -4.5), at + QPointF(4, 3), at + QPointF(-4, 3)});
    p.setPen(QPen(kInk, 1));
    p.setBrush(colour);
    p.drawPolygon(triangle);
}

void Point(QPainter& p, QPointF at, const QColor& colour = kComputed) {
    p.setPen(QPen(kInk, 1));
    p.setBrush(colour);
    p.drawEllipse(at, 3.5, 3.5);
}

void Ray(QPainter& p, QPointF from, QPointF to, Qt::PenStyle style = Qt::SolidLine) {
    p.setPen(QPen(kInk, 1.4, style));
    p.setBrush(Qt::NoBrush);
    p.drawLine(from, to);
}

void Tag(QPainter& p, const QString& text, const QColor& colour) {
    QFont font = p.font();
    font.setPixelSize(text.size() > 2 ? 9 : 11);
    font.setBold(true);
    p.setFont(font);
    const QRectF box(7, 18, 24, 13);
    p.setPen(Qt::NoPen);
    p.setBrush(colour);
    p.drawRoundedRect(box, 2, 2);
    p.setPen(Qt::white);
    p.drawText(box, Qt::AlignCenter, text);
}

// A field book: a notebook with its spiral, and the format's short name.
void FieldBook(QPainter& p, const QString& tag) {
    p.setPen(QPen(kInk, 1.2));
    p.setBrush(QColor(250, 248, 235));
    p.drawRect(QRectF(5, 2, 20, 26));
    for (int y = 5; y < 27; y += 4)
        p.drawLine(QPointF(3, y), QPointF(7, y));
    p.setPen(QPen(QColor(150, 150, 160), 1));
    for (int y = 8; y < 18; y += 3)
        p.drawLine(QPointF(10, y), QPointF(22, y));
    Tag(p, tag, kBook);
}

// An export: a sheet with its corner folded and an arrow going out, and the format's short name.
void ExportSheet(QPainter& p, const QString& tag) {
    QPainterPath sheet;
    sheet.moveTo(4, 2);
    sheet.lineTo(17, 2);
    sheet.lineTo(23, 8);
    sheet.lineTo(23, 28);
    sheet.lineTo(4, 28);
    sheet.closeSubpath();
    p.setPen(QPen(kInk, 1.2));
    p.setBrush(Qt::white);
    p.drawPath(sheet);
    p.drawLine(QPointF(17, 2), QPointF(17, 8));
    p.drawLine(QPointF(17, 8), QPointF(23, 8));
    p.setPen(QPen(kExport, 2.2));
    p.drawLine(QPointF(10, 11), QPointF(28, 11));
    p.drawLine(QPointF(24, 7), QPointF(28, 11));
    p.drawLine(QPointF(24, 15), QPointF(28, 11));
    Tag(p, tag, kExport);
}

void Draw(QPainter& p, const std::string& name) {
    static const std::map<std::string, QString> books = {
        {"LGeodim", "GDM"}, {"LNikPsi", "PSI"}, {"LNikAtl", "ATL"}, {"LNikKps", "KPS"},
        {"LSokkia", "SOK"}, {"LQuenda", "QDL"}, {"LSeparat", ";"},  {"LColonne", "COL"},
        {"LTopcon", "GT7"}, {"LecWild", "GSI"}, {"LZeiss1", "ZEI"}};
    static const std::map<std::string, QString> exports = {
        {"EPoints", "PTS"},  {"EGeoBase", "GEO"}, {"ESeparat", ";"},   {"EColonne", "COL"},
        {"EQuendal", "QDL"}, {"ELeica", "GSI"},   {"ESpectra", "GDM"}, {"ESokkia", "SOK"}};
    if (const auto book = books.find(name); book != books.end()) return FieldBook(p, book->second);
    if (const auto out = exports.find(name); out != exports.end()) return ExportSheet(p, out->second);

    if (name == "PyrCalTopo15") { // the toolbar itself
        p.setPen(QPen(kInk, 1));
        for (int i = 0; i < 4; ++i) {
            p.setBrush(i % 2 ? kComputed : kKnown);
            p.drawRect(QRectF(3 + i * 7, 12, 5, 8));
        }
    } else if (name == "CalcOpt") { // sliders
        for (int i = 0; i < 3; ++i) {
            const double y = 8 + i * 8;
            p.setPen(QPen(kInk, 2));
            p.drawLine(QPointF(4, y), QPointF(28, y));
            p.setBrush(i == 1 ? kComputed : QColor(230, 230, 230));
            p.setPen(QPen(kInk, 1));
            p.drawRect(QRectF(i == 1 ? 18 : 8 + i * 2, y - 3.5, 5, 7));
        }
    } else if (name == "GeoEdit" || name == "GeoEdit2") { // the GéoBase's lines, and a pen
        p.setPen(QPen(kInk, 1));
        p.setBrush(Qt::white);
        p.drawRect(QRectF(3, 4, 22, 24));
        for (int y = 10; y < 28; y += 6)
            p.drawLine(QPointF(3, y), QPointF(25, y));
        p.drawLine(QPointF(10, 4), QPointF(10, 28));
        p.setPen(QPen(QColor(220, 150, 20), 3.5, Qt::SolidLine, Qt::RoundCap));
        p.drawLine(QPointF(16, 24), QPointF(28, 10));
    } else if (name == "CalInter") { // two stations sight one new point
        Ray(p, {6, 26}, {16, 7});
        Ray(p, {26, 26}, {16, 7});
        Station(p, {6, 26});
        Station(p, {26, 26});
        Point(p, {16, 7});
    } else if (name == "CalRelev") { // a station sights three known points
        Ray(p, {16, 25}, {4, 6});
        Ray(p, {16, 25}, {16, 4});
        Ray(p, {16, 25}, {28, 8});
        Station(p, {4, 6});
        Station(p, {16, 4});
        Station(p, {28, 8});
        Point(p, {16, 25});
    } else if (name == "CalRecou") { // sightings both ways
        Ray(p, {16, 18}, {4, 5});
        Ray(p, {16, 18}, {28, 5});
        Ray(p, {5, 28}, {16, 18});
        Station(p, {4, 5});
        Station(p, {28, 5});
        Station(p, {5, 28});
        Point(p, {16, 18});
    } else if (name == "CalExcen") { // the station beside the point
        Ray(p, {10, 20}, {22, 12}, Qt::DashLine);
        Ray(p, {22, 12}, {28, 3});
        Station(p, {22, 12}, kComputed);
        p.setPen(QPen(kKnown, 2));
        p.drawLine(QPointF(6, 20), QPointF(14, 20));
        p.drawLine(QPointF(10, 16), QPointF(10, 24));
    } else if (name == "CalTrian") { // a chain of triangles
        const QPointF a(4, 26), b(16, 6), c(28, 26), d(16, 26);
        Ray(p, a, b);
        Ray(p, b, c);
        Ray(p, a, c);
        Ray(p, b, d);
        Station(p, a);
        Station(p, c);
        Point(p, b);
    } else if (name == "CalculV0") { // the orientation: north and the bearing's arc
        p.setPen(QPen(kInk, 1.5));
        p.drawLine(QPointF(14, 24), QPointF(14, 3));
        p.drawLine(QPointF(14, 3), QPointF(11, 8));
        p.drawLine(QPointF(14, 3), QPointF(17, 8));
        Ray(p, {14, 24}, {28, 12});
        p.setPen(QPen(kComputed, 2));
        p.drawArc(QRectF(6, 16, 16, 16), 90 * 16, -50 * 16);
        Station(p, {14, 24});
    } else if (name == "CalChem") { // a traverse
        const QPointF s[] = {{3, 26}, {11, 14}, {20, 20}, {29, 6}};
        for (int i = 0; i < 3; ++i)
            Ray(p, s[i], s[i + 1]);
        for (const QPointF& at : s)
            Station(p, at, &at == &s[0] || &at == &s[3] ? kKnown : kComputed);
    } else if (name == "CalRayon") { // points radiated from a station
        const QPointF centre(16, 17);
        const QPointF ends[] = {{4, 6}, {16, 3}, {28, 6}, {29, 22}, {4, 24}};
        for (const QPointF& end : ends) {
            Ray(p, centre, end);
            Point(p, end);
        }
        Station(p, centre);
    } else if (name == "CalBloc") { // a network adjusted as a whole
        const QPointF n[] = {{4, 5}, {28, 4}, {16, 16}, {5, 28}, {27, 27}};
        for (int i = 0; i < 5; ++i)
            for (int j = i + 1; j < 5; ++j)
                Ray(p, n[i], n[j]);
        for (const QPointF& at : n)
            Point(p, at);
    } else if (name == "CalNivSm" || name == "CalNivSt") { // level and staffs
        const bool twice = name == "CalNivSt";
        for (int staff = 0; staff < (twice ? 2 : 1); ++staff) {
            const double x = twice ? 5 + staff * 22 : 25;
            p.setPen(QPen(kInk, 1));
            for (int y = 3; y < 29; y += 4) {
                p.setBrush((y / 4) % 2 ? kKnown : Qt::white);
                p.drawRect(QRectF(x - 2, y, 4, 4));
            }
        }
        p.setPen(QPen(kInk, 1.2));
        p.setBrush(kComputed);
        p.drawRect(QRectF(11, 10, 10, 5));
        p.drawLine(QPointF(16, 15), QPointF(12, 28));
        p.drawLine(QPointF(16, 15), QPointF(20, 28));
        Ray(p, {6, 12}, {26, 12}, Qt::DashLine);
    } else if (name == "CalAsmCode" || name == "CalTabCode" || name == "CalDesCode") { // codes
        p.setPen(QPen(kInk, 1));
        p.setBrush(QColor(255, 236, 150));
        QPainterPath label;
        label.moveTo(3, 12);
        label.lineTo(10, 4);
        label.lineTo(28, 4);
        label.lineTo(28, 20);
        label.lineTo(10, 20);
        label.closeSubpath();
        p.drawPath(label);
        p.drawEllipse(QPointF(9, 12), 1.8, 1.8);
        QFont font = p.font();
        font.setPixelSize(9);
        font.setBold(true);
        p.setFont(font);
        p.drawText(QRectF(11, 4, 17, 16), Qt::AlignCenter, "A1");
        p.setPen(QPen(kComputed, 2));
        if (name == "CalAsmCode") { // two files merged into one
            p.drawLine(QPointF(6, 24), QPointF(16, 29));
            p.drawLine(QPointF(26, 24), QPointF(16, 29));
        } else if (name == "CalTabCode") { // a table
            p.drawLine(QPointF(6, 25), QPointF(26, 25));
            p.drawLine(QPointF(6, 29), QPointF(26, 29));
        } else { // drawn into lines
            p.drawLine(QPointF(4, 29), QPointF(12, 23));
            p.drawLine(QPointF(12, 23), QPointF(28, 27));
        }
    } else { // a command without a drawing of its own
        p.setPen(QPen(kInk, 1));
        p.setBrush(QColor(230, 230, 230));
        p.drawEllipse(QRectF(6, 6, 20, 20));
    }
}

} // namespace

QIcon CommandIcon(const std::string& localName) {
    QPixmap pixmap(kSize, kSize);
    pixmap.fill(Qt::transparent);
    QPainter painter(&pixmap);
    painter.setRenderHint(QPainter::Antialiasing);
    Draw(painter, localName);
    painter.end();
    return QIcon(pixmap);
}

} // namespace pyr::bureau

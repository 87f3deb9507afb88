// The buffer symbols of the View/Edit Buffer dialog: one schematic symbol per
// buffer type with its pin names, inputs on the left and the output on the
// right, and the two routing choices drawn as routed wires.

#include "Pictures.h"

#include <QFont>
#include <QPainter>
#include <QPainterPath>
#include <QPolygon>

namespace {

const QColor kInk(0x1f, 0x2d, 0x3d);
const QColor kBody(0xe3, 0xec, 0xf7);
const QColor kFabric(0xc8, 0xcf, 0xd8);
const QColor kWire(0x1d, 0x5f, 0xa8);

constexpr int kPinLeft = 8;    // outer end of an input stub
constexpr int kPinRight = 140; // outer end of the output stub

// Text without smoothing: the pictures are stored with 256 colours, and
// smoothed text would push the fills out of the palette.
QFont font(int points, bool bold)
{
    QFont f("DejaVu Sans", points, bold ? QFont::Bold : QFont::Normal);
    f.setStyleStrategy(QFont::NoAntialias);
    return f;
}

void title(QPainter& p, const QSize& size, const QString& name, const QString& what)
{
    p.setPen(kInk);
    p.setFont(font(9, true));
    p.drawText(QRect(0, 6, size.width(), 18), Qt::AlignHCenter | Qt::AlignVCenter, name);
    p.setFont(font(7, false));
    p.drawText(QRect(0, 24, size.width(), 14), Qt::AlignHCenter | Qt::AlignVCenter, what);
}

void pinFont(QPainter& p)
{
    p.setFont(font(7, true));
    p.setPen(kInk);
}

// A terminal: a small open circle at the outer end of a stub.
void terminal(QPainter& p, QPoint at)
{
    p.setPen(QPen(kInk, 1));
    p.setBrush(Qt::white);
    p.drawEllipse(at, 3, 3);
}

void stub(QPainter& p, QPoint outer, QPoint inner)
{
    p.setPen(QPen(kInk, 2));
    p.drawLine(outer, inner);
    terminal(p, outer);
}

// An input on the left edge at x, named inside the body.
void inputPin(QPainter& p, int edgeX, int y, const QString& name)
{
    stub(p, QPoint(kPinLeft, y), QPoint(edgeX, y));
    pinFont(p);
    p.drawText(QRect(edgeX + 4, y - 8, 70, 16), Qt::AlignLeft | Qt::AlignVCenter, name);
}

// An input entering from below at x, named beside its stub.
void bottomPin(QPainter& p, int x, int edgeY, int outerY, const QString& name)
{
    stub(p, QPoint(x, outerY), QPoint(x, edgeY));
    pinFont(p);
    p.drawText(QRect(x + 6, outerY - 14, 40, 14), Qt::AlignLeft | Qt::AlignVCenter, name);
}

void outputPin(QPainter& p, int edgeX, int y)
{
    stub(p, QPoint(kPinRight, y), QPoint(edgeX, y));
    pinFont(p);
    p.drawText(QRect(edgeX + 6, y - 18, 20, 14), Qt::AlignLeft | Qt::AlignVCenter, "O");
}

void body(QPainter& p, const QPolygon& shape)
{
    p.setPen(QPen(kInk, 2));
    p.setBrush(kBody);
    p.drawPolygon(shape);
}

// A buffer: a triangle pointing at its output.
void drawBufg(QPainter& p, const QSize& size, bool enable)
{
    title(p, size, enable ? "BUFGCE" : "BUFG", enable ? "Enabled Buffer" : "Global Buffer");
    const int y = 170;
    body(p, QPolygon({QPoint(44, y - 34), QPoint(44, y + 34), QPoint(104, y)}));
    inputPin(p, 44, y, "I");
    outputPin(p, 104, y);
    if (enable) {
        // The enable meets the lower edge of the triangle.
        const int x = 64;
        const int edge = y + 34 - (34 * (x - 44)) / 60;
        bottomPin(p, x, edge, 250, "CE");
    }
}

// A two-input clock multiplexer: a trapezoid, select from below.
void drawMux(QPainter& p, const QSize& size, const QString& name, const QString& what)
{
    title(p, size, name, what);
    body(p, QPolygon({QPoint(40, 110), QPoint(40, 230), QPoint(104, 200), QPoint(104, 140)}));
    inputPin(p, 40, 140, "I0");
    inputPin(p, 40, 200, "I1");
    outputPin(p, 104, 170);
    // The select meets the sloping lower edge.
    const int x = 72;
    const int edge = 230 - (30 * (x - 40)) / 64;
    bottomPin(p, x, edge, 270, "S");
}

// The full multiplexer control: two inputs with their selects, enables and
// glitch-protection ignores, in one block.
void drawBufgctrl(QPainter& p, const QSize& size)
{
    title(p, size, "BUFGCTRL", "Clock Mux Control");
    const char* const pins[] = {"I0", "I1", "S0", "S1", "CE0", "CE1", "IGNORE0", "IGNORE1"};
    const int top = 52;
    const int step = 28;
    const int bottom = top + step * 8 + 8;
    body(p, QPolygon({QPoint(36, top), QPoint(36, bottom), QPoint(108, bottom), QPoint(108, top)}));
    for (int i = 0; i < 8; ++i)
        inputPin(p, 36, top + 20 + step * i, pins[i]);
    outputPin(p, 108, (top + bottom) / 2);
}

// The tiles of the fabric the local route passes between; the channels
// between them run at x = 45, 75, 105 and y = 80, 110, ... 290.
void fabric(QPainter& p)
{
    p.setPen(QPen(kFabric, 1));
    p.setBrush(Qt::NoBrush);
    for (int x = 22; x < 140; x += 30)
        for (int y = 57; y < 310; y += 30)
            p.drawRect(x, y, 16, 16);
}

void routeEnds(QPainter& p, int y, int labelY)
{
    terminal(p, QPoint(kPinLeft, y));
    terminal(p, QPoint(kPinRight, y));
    pinFont(p);
    p.drawText(QRect(kPinLeft - 2, labelY, 12, 14), Qt::AlignCenter, "I");
    p.drawText(QRect(kPinRight - 6, labelY, 12, 14), Qt::AlignCenter, "O");
}

// Local routing: the clock takes the general interconnect, turning from
// switch box to switch box through the channels of the fabric.
void drawLocalRouting(QPainter& p, const QSize& size)
{
    title(p, size, "LOCALROUTING", "Local Routing");
    fabric(p);
    const QPoint route[] = {QPoint(kPinLeft, 170), QPoint(45, 170),  QPoint(45, 110),  QPoint(75, 110),
                            QPoint(75, 230),       QPoint(105, 230), QPoint(105, 170), QPoint(kPinRight, 170)};
    const int n = static_cast<int>(sizeof route / sizeof route[0]);
    p.setPen(QPen(kWire, 2, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
    for (int i = 0; i + 1 < n; ++i)
        p.drawLine(route[i], route[i + 1]);
    // Switch points where the route turns.
    p.setPen(Qt::NoPen);
    p.setBrush(kWire);
    for (int i = 1; i + 1 < n; ++i)
        p.drawRect(route[i].x() - 2, route[i].y() - 2, 5, 5);
    routeEnds(p, 170, 150);
}

// A low-skew line: one straight dedicated spine whose taps reach their
// loads over equal short branches.
void drawLowskew(QPainter& p, const QSize& size)
{
    title(p, size, "LOWSKEWLINE", "Lowskewline");
    p.setPen(QPen(kWire, 4, Qt::SolidLine, Qt::FlatCap));
    p.drawLine(QPoint(kPinLeft + 3, 170), QPoint(kPinRight - 3, 170));
    for (int x = 40; x <= 100; x += 30) {
        p.setPen(QPen(kWire, 2, Qt::SolidLine, Qt::FlatCap));
        p.drawLine(QPoint(x, 170), QPoint(x, 130));
        p.drawLine(QPoint(x, 170), QPoint(x, 210));
        p.setPen(QPen(kInk, 1));
        p.setBrush(kBody);
        p.drawRect(x - 7, 116, 14, 14);
        p.drawRect(x - 7, 210, 14, 14);
    }
    routeEnds(p, 170, 150);
}

} // namespace

void addBufferPictures(std::vector<PictureSpec>& out)
{
    const int w = 148;
    const int h = 340;
    out.push_back({"bufg", w, h, 8, [](QPainter& p, const QSize& s) { drawBufg(p, s, false); }});
    out.push_back({"bufgce", w, h, 8, [](QPainter& p, const QSize& s) { drawBufg(p, s, true); }});
    out.push_back({"bufgctrl", w, h, 8, [](QPainter& p, const QSize& s) { drawBufgctrl(p, s); }});
    out.push_back({"bufgmux", w, h, 8, [](QPainter& p, const QSize& s) { drawMux(p, s, "BUFGMUX", "Clock Mux"); }});
    out.push_back({"bufgmux_ctrl", w, h, 8,
                   [](QPainter& p, const QSize& s) { drawMux(p, s, "BUFGMUX_CTRL", "Global Clock Mux"); }});
    out.push_back({"bufgmuxtal4", w, h, 8,
                   [](QPainter& p, const QSize& s) { drawMux(p, s, "BUFGMUX_TALDOR4", "Clock Mux for Taldor4"); }});
    out.push_back({"localrout", w, h, 8, [](QPainter& p, const QSize& s) { drawLocalRouting(p, s); }});
    out.push_back({"lowskew", w, h, 8, [](QPainter& p, const QSize& s) { drawLowskew(p, s); }});
}

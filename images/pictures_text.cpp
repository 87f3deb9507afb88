// The pin caption bitmaps: the name of a DCM or PLL output, as painted beside
// the pins of the block symbols.

#include "Pictures.h"

#include <QFont>
#include <QPainter>

namespace {

void caption(QPainter& p, const QSize& size, const QString& text)
{
    QFont font("DejaVu Sans", 9, QFont::Bold);
    p.setFont(font);
    p.setPen(Qt::black);
    p.drawText(QRect(QPoint(0, 0), size), Qt::AlignCenter, text);
}

} // namespace

void addTextPictures(std::vector<PictureSpec>& out)
{
    // CLK0's caption is kept in full colour, the others in 256 colours.
    const char* const dcmPins[] = {"CLK0", "CLK90", "CLK180", "CLK270", "CLK2X", "CLK2X180", "CLKDV", "CLKFX",
                                   "CLKFX180"};
    for (const char* pin : dcmPins) {
        QString text = pin;
        int depth = text == "CLK0" ? 24 : 8;
        out.push_back({"text" + text, 61, 25, depth, [text](QPainter& p, const QSize& s) { caption(p, s, text); }});
    }
    for (int n = 0; n <= 5; ++n) {
        QString text = QString("CLKOUTDCM%1").arg(n);
        out.push_back({"text" + text, 79, 21, 24, [text](QPainter& p, const QSize& s) { caption(p, s, text); }});
    }
}

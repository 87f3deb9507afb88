#include "Tsy_DCMgenSetupUI_Imp.h"

#include <QEvent>
#include <QFontMetrics>
#include <QPainter>
#include <QPainterPath>

namespace {

// Rows of the symbol, counted from the row of CLK0 and CLKIN. Inputs take
// their fixed places on the left; outputs stand level with their boxes.
const char* const kInputRows[] = {"CLKIN", "CLKFB", "RST",   "PSEN", "PSINCDEC", "PSCLK",
                                  "DADDR", "DI",    "DWE",   "DEN",  "DCLK"};
const char* const kOutputRows[] = {"CLK0",     "CLK90", "CLK180",   "CLK270", "CLKDV",  "CLK2X", "CLK2X180",
                                   "CLKFX",    "CLKFX180", "STATUS", "LOCKED", "PSDONE", "DRDY"};
const char* const kClockInputs[] = {"CLKIN", "CLKFB", "PSCLK", "DCLK"};

constexpr int kPinLength = 22;

QString baseName(const QString& caption)
{
    int bracket = caption.indexOf('[');
    return bracket < 0 ? caption : caption.left(bracket);
}

template <size_t N>
int rowOf(const char* const (&rows)[N], const QString& name)
{
    for (size_t i = 0; i < N; ++i)
        if (name == QLatin1String(rows[i]))
            return static_cast<int>(i);
    return -1;
}

} // namespace

Tsy_DCMgenSetupUI_Imp::Tsy_DCMgenSetupUI_Imp(QWidget* parent) : Tsy_DCMgenSetupUI(parent)
{
    FrameDcmBlockGraphics->installEventFilter(this);
}

Tsy_DCMgenSetupUI_Imp::~Tsy_DCMgenSetupUI_Imp() = default;

void Tsy_DCMgenSetupUI_Imp::setSymbol(const Symbol& symbol)
{
    symbol_ = symbol;
    FrameDcmBlockGraphics->update();
}

bool Tsy_DCMgenSetupUI_Imp::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == FrameDcmBlockGraphics && event->type() == QEvent::Paint) {
        QPainter painter(FrameDcmBlockGraphics);
        paintSymbol(painter);
        return true;
    }
    return Tsy_DCMgenSetupUI::eventFilter(watched, event);
}

int Tsy_DCMgenSetupUI_Imp::rowPitch() const
{
    int a = CheckBoxCLK0->geometry().center().y();
    int b = CheckBoxCLK90->geometry().center().y();
    // Before the first layout pass the boxes have no places yet.
    return b - a >= 12 ? b - a : 22;
}

int Tsy_DCMgenSetupUI_Imp::rowCentre(int row) const
{
    QPoint first = CheckBoxCLK0->mapTo(FrameDcmBlockGraphics->parentWidget(), CheckBoxCLK0->rect().center());
    int y0 = first.y() - FrameDcmBlockGraphics->geometry().top();
    if (y0 < 0)
        y0 = 40;
    return y0 + row * rowPitch();
}

void Tsy_DCMgenSetupUI_Imp::paintSymbol(QPainter& p) const
{
    const QRect area = FrameDcmBlockGraphics->rect();
    const QPalette& pal = palette();
    const int pitch = rowPitch();
    p.setRenderHint(QPainter::Antialiasing, true);

    QFont pinFont = font();
    pinFont.setPointSizeF(pinFont.pointSizeF() * 0.85);
    QFont titleFont = font();
    titleFont.setBold(true);

    const int top = rowCentre(0) - pitch / 2 - QFontMetrics(titleFont).height() - 6;
    const int bottom = rowCentre(12) + pitch / 2;
    QRect body(kPinLength, qMax(1, top), area.width() - 2 * kPinLength - 1, bottom - qMax(1, top));

    p.setPen(QPen(pal.color(QPalette::WindowText), 2));
    p.setBrush(pal.color(QPalette::Base));
    p.drawRect(body);

    p.setFont(titleFont);
    QRect titleBox(body.left(), body.top() + 2, body.width(), rowCentre(0) - pitch / 2 - body.top() - 2);
    p.drawText(titleBox, Qt::AlignHCenter | Qt::AlignVCenter, symbol_.primitive);

    p.setFont(pinFont);
    const QFontMetrics fm(pinFont);
    const int half = body.width() / 2;
    p.setPen(QPen(pal.color(QPalette::WindowText), 1.5));
    for (const QString& caption : symbol_.inputs) {
        int row = rowOf(kInputRows, baseName(caption));
        if (row < 0)
            continue;
        int y = rowCentre(row);
        p.drawLine(0, y, body.left(), y);
        int textLeft = body.left() + 4;
        if (rowOf(kClockInputs, caption) >= 0) {
            // The clock wedge of a schematic symbol.
            QPainterPath wedge;
            wedge.moveTo(body.left(), y - 4);
            wedge.lineTo(body.left() + 6, y);
            wedge.lineTo(body.left(), y + 4);
            p.drawPath(wedge);
            textLeft += 6;
        }
        p.drawText(QRect(textLeft, y - fm.height() / 2, half, fm.height()), Qt::AlignLeft | Qt::AlignVCenter,
                   fm.elidedText(caption, Qt::ElideRight, half - (textLeft - body.left())));
    }
    for (const QString& caption : symbol_.outputs) {
        QString name = baseName(caption);
        int row = rowOf(kOutputRows, name == QLatin1String("DO") ? QStringLiteral("STATUS") : name);
        if (row < 0)
            continue;
        int y = rowCentre(row);
        p.drawLine(body.right(), y, area.right(), y);
        p.drawText(QRect(body.right() - half, y - fm.height() / 2, half - 4, fm.height()),
                   Qt::AlignRight | Qt::AlignVCenter, fm.elidedText(caption, Qt::ElideLeft, half - 4));
    }

    if (!symbol_.instance.isEmpty()) {
        p.setFont(titleFont);
        p.setPen(pal.color(QPalette::WindowText));
        p.drawText(QRect(body.left(), body.bottom() + 4, body.width(), area.bottom() - body.bottom() - 4),
                   Qt::AlignHCenter | Qt::AlignTop, symbol_.instance);
    }
}

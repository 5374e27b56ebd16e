#include "widgets/ColorSwatch.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

constexpr int32 kCheck = 5; // checkerboard square, logical pixels

void PaintChecker(QPainter &p, const QRect &r)
{
    p.fillRect(r, QColor(200, 200, 200));
    for (int32 y = r.top(); y <= r.bottom(); y += kCheck)
        for (int32 x = r.left() + (((y - r.top()) / kCheck) % 2) * kCheck; x <= r.right(); x += 2 * kCheck)
            p.fillRect(QRect(x, y, kCheck, kCheck).intersected(r), QColor(120, 120, 120));
}

bool Outside(float64 v)
{
    return std::isnan(v) || v < 0.0 || v > 1.0;
}

} // namespace

ColorSwatch::ColorSwatch() : CustomControl(nullptr, ScriptVal(), TagList())
{
    setMinimumHeight(12);
}

ColorSwatch::~ColorSwatch() = default;

bool ColorSwatch::IsOutOfRange(const ColorRGBA &c)
{
    return Outside(c.r) || Outside(c.g) || Outside(c.b) || Outside(c.a);
}

void ColorSwatch::SetColor(const ColorRGBA &colour)
{
    const auto same = [](float64 a, float64 b) { return a == b || (std::isnan(a) && std::isnan(b)); };
    if (same(colour.r, mColor.r) && same(colour.g, mColor.g) && same(colour.b, mColor.b) && same(colour.a, mColor.a))
        return;
    mColor = colour;
    update();
}

void ColorSwatch::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    const QRect all = rect().adjusted(1, 1, -1, -1);
    const QRect left(all.left(), all.top(), all.width() / 2, all.height());
    const QRect right(left.right() + 1, all.top(), all.right() - left.right(), all.height());
    QColor shown = ColorMath::ToDisplay(mColor);
    PaintChecker(p, right);
    p.fillRect(right, shown);
    shown.setAlpha(255);
    p.fillRect(left, shown);
    p.setPen(QColor(30, 30, 30));
    p.drawRect(all.adjusted(0, 0, -1, -1));
    if (IsOutOfRange(mColor)) {
        // The corner mark: the value holds more than the patch can show.
        const QPoint corner = all.topRight();
        const QPoint tri[3] = {corner, corner + QPoint(-7, 0), corner + QPoint(0, 7)};
        p.setBrush(QColor(255, 160, 0));
        p.drawPolygon(tri, 3);
    }
    EndDraw();
}

void ColorSwatch::mouseDoubleClickEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton && !IsDisabled())
        emit DoubleClicked();
}

} // namespace Orbane

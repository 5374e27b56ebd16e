#include "widgets/PatternSwatch.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <cstdlib>

namespace Orbane {

const char *PatternSwatch::Name(int32 pattern)
{
    static const char *const names[PatternCount] = {
        "Checker", "Horizontal stripes", "Vertical stripes", "Diagonal", "Dots", "Grid"};
    return pattern >= 0 && pattern < PatternCount ? names[pattern] : "";
}

bool PatternSwatch::Inked(int32 pattern, int32 x, int32 y, int32 tile)
{
    tile = std::max(2, tile);
    const int32 half = tile / 2, u = x % tile, v = y % tile;
    switch (pattern) {
    case Checker:
        return ((x / half) + (y / half)) % 2 == 0;
    case HStripes:
        return v < half;
    case VStripes:
        return u < half;
    case Diagonal:
        return (x + y) % tile < half;
    case Dots:
        return (u - half) * (u - half) + (v - half) * (v - half) <= (tile * tile) / 9;
    case Grid:
        return u == 0 || v == 0;
    default:
        return false;
    }
}

PatternSwatch::PatternSwatch(int32 pattern) : CustomControl(nullptr, ScriptVal(), TagList()), mPattern(pattern)
{
    setToolTip(Name(pattern));
    setMinimumSize(24, 24);
}

PatternSwatch::~PatternSwatch() = default;

void PatternSwatch::SetChosen(bool chosen)
{
    if (chosen == mChosen)
        return;
    mChosen = chosen;
    update();
}

void PatternSwatch::SetLook(int32 tile, const QColor &ink)
{
    if (tile == mTile && ink == mInk)
        return;
    mTile = tile;
    mInk = ink;
    update();
}

void PatternSwatch::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &p = *BackPainter();
    const QRect inner = rect().adjusted(2, 2, -2, -2);
    p.fillRect(inner, QColor(25, 25, 25));
    // One logical pixel a cell: the pattern keeps its size at any pixel ratio.
    for (int32 y = 0; y < inner.height(); ++y)
        for (int32 x = 0; x < inner.width(); ++x)
            if (Inked(mPattern, x, y, mTile))
                p.fillRect(inner.left() + x, inner.top() + y, 1, 1, mInk);
    p.setPen(QPen(mChosen ? QColor(255, 220, 80) : QColor(70, 70, 70), mChosen ? 2.0 : 1.0));
    p.setBrush(Qt::NoBrush);
    p.drawRect(rect().adjusted(1, 1, -1, -1));
    EndDraw();
}

void PatternSwatch::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() == Qt::LeftButton && rect().contains(event->pos()) && !IsDisabled())
        emit Clicked(mPattern);
}

} // namespace Orbane

#pragma once

#include <QApplication>
#include <QMouseEvent>
#include <QTest>
#include <QWidget>

#include <cmath>

namespace Orbane {
namespace Test {

// The pixel of a value in a painted graph that shows 0..1 both ways inside
// a margin of 6 pixels, y up (the curve, levels and ranges graphs).
inline QPoint GraphPixel(const QWidget *graph, double x, double y, double left = 0.0, double right = 1.0)
{
    constexpr int kMargin = 6;
    const double w = graph->width() - 2 * kMargin, h = graph->height() - 2 * kMargin;
    return QPoint(int(std::lround(kMargin + (x - left) / (right - left) * w)),
                  int(std::lround(graph->height() - kMargin - y * h)));
}

// A press at `from`, `steps` moves with the left button held and the
// modifiers (which QTest's mouseMove cannot carry), and the release at `to`.
inline void DragWith(QWidget *w, QPoint from, QPoint to, Qt::KeyboardModifiers mods = Qt::NoModifier, int steps = 4)
{
    QTest::mousePress(w, Qt::LeftButton, mods, from);
    for (int i = 1; i <= steps; ++i) {
        const QPoint at = from + (to - from) * i / steps;
        QMouseEvent move(QEvent::MouseMove, at, w->mapToGlobal(at), Qt::NoButton, Qt::LeftButton, mods);
        QApplication::sendEvent(w, &move);
    }
    QTest::mouseRelease(w, Qt::LeftButton, mods, to);
}

} // namespace Test
} // namespace Orbane

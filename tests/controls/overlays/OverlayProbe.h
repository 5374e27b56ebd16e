#pragma once

#include "ViewerFixture.h"

#include <QImage>
#include <QPoint>
#include <QtTest>

#include <algorithm>

namespace Orbane {
namespace Test {

// The brightest grey level within `radius` pixels of `at`.
inline int Level(const QImage &image, QPoint at, int radius = 1)
{
    int level = 0;
    for (int dy = -radius; dy <= radius; ++dy)
        for (int dx = -radius; dx <= radius; ++dx) {
            const QPoint p = at + QPoint(dx, dy);
            if (image.rect().contains(p))
                level = std::max(level, qGray(image.pixel(p)));
        }
    return level;
}

inline bool Lit(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) > 60;
}

inline bool Dark(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) < 20;
}

// Arrow-key nudges and how far they move a point, in image pixels.
inline void NudgeRows()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("dx");
    QTest::addColumn<double>("dy");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << 1.0 << 0.0;
    QTest::newRow("up increases Y") << int(Qt::Key_Up) << int(Qt::NoModifier) << 0.0 << 1.0;
    QTest::newRow("left with shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << -10.0 << 0.0;
    QTest::newRow("down with control: a tenth") << int(Qt::Key_Down) << int(Qt::ControlModifier) << 0.0 << -0.1;
    QTest::newRow("up with both: one") << int(Qt::Key_Up) << int(Qt::ShiftModifier | Qt::ControlModifier) << 0.0 << 1.0;
}

// One nudge of a centred point; a Y step is one pixel of `yPixels`.
inline void CheckNudge(const TagList &attrs, double yPixels)
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, dx);
    QFETCH(double, dy);
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, attrs);
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QVERIFY(Near(f.PointOf(p), {0.5 + dx / 400, 0.5 + dy / yPixels}));
    QCOMPARE(f.UndoSteps(), 1);
}

} // namespace Test
} // namespace Orbane

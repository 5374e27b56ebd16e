#pragma once

#include <QColor>
#include <QImage>
#include <QPoint>

#include <algorithm>

namespace Orbane {
namespace Test {

// The brightest grey level within `radius` pixels of `at`: overlays draw in
// light colours over the tests' black image.
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

// The colour of the brightest pixel within `radius` pixels of `at`.
inline QColor Brightest(const QImage &image, QPoint at, int radius = 1)
{
    QColor best(Qt::black);
    for (int dy = -radius; dy <= radius; ++dy)
        for (int dx = -radius; dx <= radius; ++dx) {
            const QPoint p = at + QPoint(dx, dy);
            if (image.rect().contains(p) && qGray(image.pixel(p)) > qGray(best.rgb()))
                best = image.pixelColor(p);
        }
    return best;
}

// Something is drawn at `at` (even faded to half).
inline bool Lit(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) > 60;
}

inline bool Dark(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) < 20;
}

} // namespace Test
} // namespace Orbane

#include "QtGPainter.h"
#include "PixelProbe.h"

#include <gtest/gtest.h>

#include <functional>
#include <ostream>
#include <string>
#include <vector>

namespace Orbane {
namespace Graphics {
namespace {

const GColor Red(1.0f, 0.0f, 0.0f);
const GColor Black(0.0f, 0.0f, 0.0f);
const QColor Grey(128, 128, 128);

bool isRed(const QColor &c)
{
    return c.red() > 200 && c.green() < 60 && c.blue() < 60;
}

bool isDark(const QColor &c)
{
    return c.red() < 60 && c.green() < 60 && c.blue() < 60;
}

// Parameter rows print as their names in test output.
template <typename Row> auto operator<<(std::ostream &os, const Row &row) -> decltype(row.name, os)
{
    return os << row.name;
}

using Draw = std::function<void(QtGPainter &)>;
using Points = std::vector<QPointF>;

// One Begin/End primitive in red, with its shadow.
Draw primitive(int32 mode, Points vertices, GColor shadow = GColor())
{
    return [=](QtGPainter &g) {
        g.Color(Red, shadow);
        g.Begin(mode);
        for (const QPointF &p : vertices)
            g.Vertex(p.x(), p.y());
        g.End();
    };
}

Draw rect(float64 x1, float64 y1, float64 x2, float64 y2, GColor shadow = GColor())
{
    return [=](QtGPainter &g) {
        g.Color(Red, shadow);
        g.Rectangle(x1, y1, x2, y2);
    };
}

// A red square of side 4 centred on the model-space origin.
const Draw marker = rect(-2, -2, 2, 2);

// Corners of the square (10, 10) - (50, 50), counter-clockwise, and two
// triangles that cover it.
const float64 Square[12] = {10, 10, 0, 50, 10, 0, 50, 50, 0, 10, 50, 0};
const uint32 TwoTriangles[6] = {0, 1, 2, 0, 2, 3};

Draw squareArrays(int32 mode, int32 first, int32 count, bool indexed)
{
    return [=](QtGPainter &g) {
        g.Color(Red);
        g.SetVertexArray(Square, 4);
        if (indexed)
            g.SetIndexArray(TwoTriangles, 6);
        g.DrawArrays(mode, first, count);
    };
}

// A drawing on grey and what it must leave where: pure red (so a seam
// between two triangles shows), the dark shadow, the background.
struct Scene
{
    const char *name;
    Draw draw;
    Points red = {}, background = {}, shadow = {};
};

using QtGPainterScene = testing::TestWithParam<Scene>;

TEST_P(QtGPainterScene, DrawsWhereExpected)
{
    const Scene &s = GetParam();
    PixelProbe probe(64, 64, Grey);
    probe.Paint(s.draw);
    for (const QPointF &p : s.red)
        EXPECT_EQ(probe.At(p.x(), p.y()), QColor(Qt::red)) << "red at " << p.x() << ", " << p.y();
    for (const QPointF &p : s.background)
        EXPECT_TRUE(probe.IsBackground(p.x(), p.y())) << "background at " << p.x() << ", " << p.y();
    for (const QPointF &p : s.shadow)
        EXPECT_TRUE(isDark(probe.At(p.x(), p.y()))) << "shadow at " << p.x() << ", " << p.y();
}

const Points Outline = {{10.5, 10.5}, {50.5, 10.5}, {50.5, 50.5}, {10.5, 50.5}};

// clang-format off
const Scene Scenes[] = {
    // Lines
    {"StripIsNotClosed", primitive(GP_LineStrip, Outline),
     {{30.5, 10.5}, {50.5, 30.5}, {30.5, 50.5}}, {{10.5, 30.5}, {30.5, 30.5}, {55.5, 10.5}}},
    {"LoopClosesToTheFirstVertex", primitive(GP_LineLoop, Outline), {{30.5, 10.5}, {10.5, 30.5}}, {{30.5, 30.5}}},
    // Filled modes
    {"TriangleStrip", primitive(GP_TriangleStrip, {{10, 10}, {50, 10}, {10, 50}, {50, 50}}),
     {{15.5, 15.5}, {45.5, 45.5}, {30.5, 29.5}, {20.5, 39.5}}, {{5.5, 30.5}, {55.5, 30.5}}},
    {"QuadStrip", primitive(GP_QuadStrip, {{10, 10}, {10, 50}, {30, 10}, {30, 50}, {50, 10}, {50, 50}}),
     {{20.5, 30.5}, {40.5, 30.5}, {29.5, 30.5}, {30.5, 30.5}}, {{55.5, 30.5}, {30.5, 55.5}}},
    {"Polygon", primitive(GP_Polygon, {{30, 5}, {55, 30}, {30, 55}, {5, 30}}),
     {{30.5, 30.5}, {30.5, 10.5}, {50.5, 30.5}}, {{8.5, 8.5}, {52.5, 52.5}}},
    {"RectangleCornersInAnyOrder", rect(40, 30, 10, 20), {{10.5, 20.5}, {39.5, 29.5}}, {{40.5, 25.5}, {25.5, 19.5}}},
    // Shadow pass: a dark copy one pixel down and right, under the colour
    {"ShadowOfALine", primitive(GP_LineStrip, {{10.0, 20.5}, {50.0, 20.5}}, Black),
     {{30.5, 20.5}}, {{30.5, 21.5}, {30.5, 18.5}}, {{31.5, 19.5}, {50.5, 19.5}}},
    // Matrix stack
    {"ScaleActsBeforeAnEarlierTranslate",
     [](QtGPainter &g) { g.Translate(10, 10); g.Scale(2, 3); rect(0, 0, 5, 5)(g); },
     {{19.5, 24.5}, {10.5, 10.5}}, {{20.5, 20.5}, {15.5, 25.5}, {9.5, 15.5}}},
    {"RotateAboutZIsCounterClockwise",
     [](QtGPainter &g) { g.Translate(32, 32); g.Rotate(90, 0, 0, 1); g.Translate(15, 0); marker(g); },
     {{32.5, 47.5}}, {{47.5, 32.5}}},
    {"PopRestoresThePushedMatrixAndIgnoresAnEmptyStack",
     [](QtGPainter &g) {
         g.Translate(10, 10);
         g.PushMatrix();
         g.Translate(40, 0);
         marker(g);
         g.PopMatrix();
         g.PopMatrix();
         marker(g);
     },
     {{50.5, 10.5}, {10.5, 10.5}}, {{0.5, 0.5}}},
    // Arrays
    {"IndexedTrianglesFillTheSquare", squareArrays(GP_Triangles, 0, 6, true),
     {{40.5, 20.5}, {20.5, 40.5}, {30.5, 30.5}}},
    {"FirstAndCountPickIndices", squareArrays(GP_Triangles, 3, 3, true), {{20.5, 40.5}}, {{40.5, 20.5}}},
    {"RangesOutsideTheArraysDrawNothing",
     [](QtGPainter &g) {
         const uint32 badIndex[3] = {0, 1, 7};
         squareArrays(GP_Quads, 1, 4, false)(g);    // one vertex short
         squareArrays(GP_Triangles, 4, 3, true)(g); // one index short
         g.SetIndexArray(badIndex, 3);
         g.DrawArrays(GP_Triangles, 0, 3);          // an index past the vertices
         g.SetVertexArray(nullptr, 0);
         g.SetIndexArray(nullptr, 0);
         g.DrawArrays(GP_Triangles, 0, 3);
     },
     {}, {{40.5, 20.5}, {20.5, 40.5}, {30.5, 30.5}}},
};
// clang-format on

INSTANTIATE_TEST_SUITE_P(Scenes, QtGPainterScene, testing::ValuesIn(Scenes), testing::PrintToStringParamName());

// Stipple ---------------------------------------------------------------------

// The first 32 pixels along the row at y 10.5: 1 drawn, 0 black.
std::string drawnPixels(const PixelProbe &probe)
{
    std::string s;
    for (int x = 0; x < 32; ++x) {
        QColor c = probe.At(x + 0.5, 10.5);
        s += isRed(c) ? '1' : (c == QColor(Qt::black) ? '0' : '?');
    }
    return s;
}

struct StippleCase
{
    const char *name;
    int32 factor;
    uint16 pattern;
    Draw draw;
    const char *expected;
};

using QtGPainterStipple = testing::TestWithParam<StippleCase>;

TEST_P(QtGPainterStipple, DrawsTheBitsLowestFirst)
{
    const StippleCase &c = GetParam();
    PixelProbe probe(64, 64);
    probe.Paint([&](QtGPainter &g) {
        g.LineStipple(c.factor, c.pattern);
        g.Enable(GC_LineStipple);
        c.draw(g);
    });
    EXPECT_EQ(drawnPixels(probe), c.expected);
}

const Draw Across = primitive(GP_LineStrip, {{0.0, 10.5}, {64.0, 10.5}});

const StippleCase StippleCases[] = {
    {"HalfOn", 1, 0x00FF, Across, "11111111000000001111111100000000"},
    {"FactorTwoUneven", 2, 0x0107, Across, "11111100000000001100000000000000"},
    {"StripCarriesThePatternAcrossVertices", 1, 0x00FF,
     primitive(GP_LineStrip, {{0.0, 10.5}, {12.0, 10.5}, {64.0, 10.5}}), "11111111000000001111111100000000"},
    {"SeparateLinesRestartThePattern", 1, 0x00FF,
     primitive(GP_Lines, {{0.0, 10.5}, {12.0, 10.5}, {12.0, 10.5}, {64.0, 10.5}}), "11111111000011111111000000001111"},
    {"LoopDashesItsClosingSide", 1, 0x00FF, // the side from (0, 10.5) back to the first vertex
     primitive(GP_LineLoop, {{64.0, 10.5}, {64.0, 50.5}, {0.0, 50.5}, {0.0, 10.5}}),
     "11111111000000001111111100000000"},
};

INSTANTIATE_TEST_SUITE_P(Patterns, QtGPainterStipple, testing::ValuesIn(StippleCases),
                         testing::PrintToStringParamName());

} // namespace
} // namespace Graphics
} // namespace Orbane

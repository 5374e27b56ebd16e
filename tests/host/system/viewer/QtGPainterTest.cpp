#include "QtGPainter.h"
#include "PixelProbe.h"

#include <QPainter>

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

namespace Orbane {
namespace Graphics {
namespace {

// Parameter rows print as their names in test output.
template <typename Row> auto operator<<(std::ostream &os, const Row &row) -> decltype(row.name, os)
{
    return os << row.name;
}

const GColor Red(1.0f, 0.0f, 0.0f);
const GColor Green(0.0f, 1.0f, 0.0f);
const GColor Black(0.0f, 0.0f, 0.0f);
const GColor White(1.0f, 1.0f, 1.0f);
const QColor Grey(128, 128, 128);

bool isRed(const QColor &c)
{
    return c.red() > 200 && c.green() < 60 && c.blue() < 60;
}

bool isDark(const QColor &c)
{
    return c.red() < 60 && c.green() < 60 && c.blue() < 60;
}

// Draws one Begin/End primitive in red.
void drawPrimitive(QtGPainter &g, int32 mode, const std::vector<QPointF> &points)
{
    g.Color(Red);
    g.Begin(mode);
    for (const QPointF &p : points)
        g.Vertex(p.x(), p.y());
    g.End();
}

// Line strips, loops and pairs ----------------------------------------------

TEST(QtGPainterLines, StripDrawsItsSegmentsWithoutClosing)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) { drawPrimitive(g, GP_LineStrip, {{10.5, 10.5}, {50.5, 10.5}, {50.5, 40.5}}); });
    EXPECT_TRUE(isRed(probe.At(30.5, 10.5))) << "first segment";
    EXPECT_TRUE(isRed(probe.At(50.5, 25.5))) << "second segment";
    EXPECT_TRUE(probe.IsBackground(30.5, 25.5)) << "a strip is not closed";
    EXPECT_TRUE(probe.IsBackground(55.5, 10.5)) << "nothing past the last vertex";
}

TEST(QtGPainterLines, LoopClosesBackToTheFirstVertex)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) { drawPrimitive(g, GP_LineLoop, {{10.5, 10.5}, {50.5, 10.5}, {50.5, 50.5}}); });
    EXPECT_TRUE(isRed(probe.At(30.5, 10.5)));
    EXPECT_TRUE(isRed(probe.At(50.5, 30.5)));
    EXPECT_GT(probe.At(30.5, 30.5).red(), 100) << "the closing diagonal";
    EXPECT_TRUE(probe.IsBackground(40.5, 20.5)) << "a loop is not filled";
}

TEST(QtGPainterLines, LinesPairTheirVerticesAndDropAnOddOne)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        drawPrimitive(g, GP_Lines, {{10.5, 10.5}, {50.5, 10.5}, {10.5, 40.5}, {50.5, 40.5}, {30.5, 60.5}});
    });
    EXPECT_TRUE(isRed(probe.At(30.5, 10.5)));
    EXPECT_TRUE(isRed(probe.At(30.5, 40.5)));
    EXPECT_TRUE(probe.IsBackground(50.5, 25.5)) << "no line joins the pairs";
    EXPECT_TRUE(probe.IsBackground(40.5, 50.5)) << "the odd vertex draws nothing";
}

TEST(QtGPainterLines, YRunsUpFromTheBottomEdge)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) { drawPrimitive(g, GP_LineStrip, {{0.0, 2.5}, {64.0, 2.5}}); });
    // Viewer y 2.5 is the third row from the bottom of the image.
    EXPECT_TRUE(isRed(probe.AtDevice(32, 61)));
    EXPECT_FALSE(isRed(probe.AtDevice(32, 2)));
}

TEST(QtGPainterLines, WidthIsInViewerPixelsWhateverTheScale)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.LineWidth(5.0f);
        drawPrimitive(g, GP_LineStrip, {{0.0, 20.5}, {64.0, 20.5}});
        g.LineWidth(1.0f);
        g.Scale(4.0, 4.0);
        drawPrimitive(g, GP_LineStrip, {{0.0, 10.125}, {16.0, 10.125}}); // y 40.5 after the scale
    });
    EXPECT_TRUE(isRed(probe.At(30.5, 22.5)));
    EXPECT_TRUE(isRed(probe.At(30.5, 18.5)));
    EXPECT_TRUE(probe.IsBackground(30.5, 23.5));
    EXPECT_TRUE(isRed(probe.At(30.5, 40.5)));
    EXPECT_TRUE(probe.IsBackground(30.5, 41.5)) << "a scaled line stays one pixel wide";
}

// Filled modes ---------------------------------------------------------------

struct FillCase
{
    const char *name;
    int32 mode;
    std::vector<QPointF> vertices;
    std::vector<QPointF> inside;
    std::vector<QPointF> outside;
};

class QtGPainterFill : public testing::TestWithParam<FillCase>
{
};

TEST_P(QtGPainterFill, CoversItsInteriorInFullColour)
{
    const FillCase &c = GetParam();
    PixelProbe probe(64, 64);
    probe.Paint([&](QtGPainter &g) { drawPrimitive(g, c.mode, c.vertices); });
    for (const QPointF &p : c.inside)
        EXPECT_EQ(probe.At(p.x(), p.y()), QColor(Qt::red)) << "inside at " << p.x() << ", " << p.y();
    for (const QPointF &p : c.outside)
        EXPECT_TRUE(probe.IsBackground(p.x(), p.y())) << "outside at " << p.x() << ", " << p.y();
}

// Points on a diagonal that two triangles share must be as solid as the rest:
// a seam there would show the image through the handle.
const FillCase FillCases[] = {
    {"Triangles",
     GP_Triangles,
     {{10, 10}, {30, 10}, {10, 30}, {40, 40}, {60, 40}, {40, 60}, {0, 60}},
     {{14.5, 14.5}, {44.5, 44.5}},
     {{28.5, 28.5}, {5.5, 58.5}}},
    {"TriangleStripOfASquare",
     GP_TriangleStrip,
     {{10, 10}, {50, 10}, {10, 50}, {50, 50}},
     {{15.5, 15.5}, {45.5, 45.5}, {30.5, 29.5}, {20.5, 39.5}},
     {{5.5, 30.5}, {55.5, 30.5}}},
    {"TriangleFanOfASquare",
     GP_TriangleFan,
     {{30, 30}, {10, 10}, {50, 10}, {50, 50}, {10, 50}},
     {{30.5, 15.5}, {45.5, 30.5}, {20.5, 19.5}, {40.5, 40.5}},
     {{30.5, 55.5}, {15.5, 30.5}}},
    {"QuadsSeparate",
     GP_Quads,
     {{5, 5}, {25, 5}, {25, 25}, {5, 25}, {35, 35}, {55, 35}, {55, 55}, {35, 55}, {0, 60}},
     {{15.5, 15.5}, {45.5, 45.5}},
     {{30.5, 30.5}, {15.5, 45.5}}},
    {"QuadStripOfTwoQuads",
     GP_QuadStrip,
     {{10, 10}, {10, 50}, {30, 10}, {30, 50}, {50, 10}, {50, 50}},
     {{20.5, 30.5}, {40.5, 30.5}, {29.5, 30.5}, {30.5, 30.5}},
     {{55.5, 30.5}, {30.5, 55.5}}},
    {"ConvexPolygon",
     GP_Polygon,
     {{30, 5}, {55, 30}, {30, 55}, {5, 30}},
     {{30.5, 30.5}, {30.5, 10.5}, {50.5, 30.5}},
     {{8.5, 8.5}, {52.5, 52.5}}},
};

INSTANTIATE_TEST_SUITE_P(Modes, QtGPainterFill, testing::ValuesIn(FillCases),
                         [](const testing::TestParamInfo<FillCase> &info) { return std::string(info.param.name); });

TEST(QtGPainterFill, RectangleFillsBetweenItsCorners)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red);
        g.Rectangle(40, 30, 10, 20); // corners in any order
    });
    EXPECT_TRUE(isRed(probe.At(10.5, 20.5)));
    EXPECT_TRUE(isRed(probe.At(39.5, 29.5)));
    EXPECT_TRUE(probe.IsBackground(40.5, 25.5));
    EXPECT_TRUE(probe.IsBackground(25.5, 19.5));
}

TEST(QtGPainterFill, PointsAreSquaresOfThePointSize)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.PointSize(5.0f);
        drawPrimitive(g, GP_Points, {{20.5, 20.5}, {40.5, 40.5}});
    });
    for (QPointF p : {QPointF(20.5, 20.5), QPointF(40.5, 40.5)}) {
        EXPECT_TRUE(isRed(probe.At(p.x() - 2, p.y() + 2)));
        EXPECT_TRUE(isRed(probe.At(p.x() + 2, p.y() - 2)));
        EXPECT_TRUE(probe.IsBackground(p.x() + 3, p.y()));
        EXPECT_TRUE(probe.IsBackground(p.x(), p.y() - 3));
    }
}

// Stipple -------------------------------------------------------------------

struct StippleCase
{
    const char *name;
    int32 factor;
    uint16 pattern;
    const char *expected; // the first 32 pixels along the line, 1 drawn
};

class QtGPainterStipple : public testing::TestWithParam<StippleCase>
{
};

std::string drawnPixels(const PixelProbe &probe, qreal y, int count)
{
    std::string s;
    for (int x = 0; x < count; ++x) {
        QColor c = probe.At(x + 0.5, y);
        s += isRed(c) ? '1' : (c == QColor(Qt::black) ? '0' : '?');
    }
    return s;
}

TEST_P(QtGPainterStipple, DrawsTheBitsLowestFirst)
{
    const StippleCase &c = GetParam();
    PixelProbe probe(64, 64);
    probe.Paint([&](QtGPainter &g) {
        g.LineStipple(c.factor, c.pattern);
        g.Enable(GC_LineStipple);
        drawPrimitive(g, GP_LineStrip, {{0.0, 10.5}, {64.0, 10.5}});
    });
    EXPECT_EQ(drawnPixels(probe, 10.5, 32), c.expected);
}

const StippleCase StippleCases[] = {
    {"HalfOn", 1, 0x00FF, "11111111000000001111111100000000"},
    {"StartsWithAGap", 1, 0xFF00, "00000000111111110000000011111111"},
    {"GapAtBothEnds", 1, 0x0FF0, "00001111111100000000111111110000"},
    {"Dotted", 1, 0x3333, "11001100110011001100110011001100"},
    {"FactorThree", 3, 0x0003, "11111100000000000000000000000000"},
    {"FactorTwoUneven", 2, 0x0107, "11111100000000001100000000000000"},
    {"Solid", 1, 0xFFFF, "11111111111111111111111111111111"},
    {"Empty", 1, 0x0000, "00000000000000000000000000000000"},
};

INSTANTIATE_TEST_SUITE_P(Patterns, QtGPainterStipple, testing::ValuesIn(StippleCases),
                         [](const testing::TestParamInfo<StippleCase> &info) { return std::string(info.param.name); });

TEST(QtGPainterStippleRules, DisabledStippleDrawsSolid)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.LineStipple(1, 0x00FF);
        drawPrimitive(g, GP_LineStrip, {{0.0, 10.5}, {64.0, 10.5}});
    });
    EXPECT_EQ(drawnPixels(probe, 10.5, 16), "1111111111111111");
}

TEST(QtGPainterStippleRules, StripCarriesThePatternAcrossItsVertices)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.LineStipple(1, 0x00FF);
        g.Enable(GC_LineStipple);
        drawPrimitive(g, GP_LineStrip, {{0.0, 10.5}, {12.0, 10.5}, {64.0, 10.5}});
    });
    EXPECT_EQ(drawnPixels(probe, 10.5, 32), "11111111000000001111111100000000");
}

TEST(QtGPainterStippleRules, SeparateLinesRestartThePattern)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.LineStipple(1, 0x00FF);
        g.Enable(GC_LineStipple);
        drawPrimitive(g, GP_Lines, {{0.0, 10.5}, {12.0, 10.5}, {12.0, 10.5}, {64.0, 10.5}});
    });
    EXPECT_EQ(drawnPixels(probe, 10.5, 32), "11111111000011111111000000001111");
}

TEST(QtGPainterStippleRules, LoopDashesTheClosingSide)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.LineStipple(1, 0x0F0F);
        g.Enable(GC_LineStipple);
        // Clockwise from the top left, so the closing side is the left edge.
        drawPrimitive(g, GP_LineLoop, {{10.5, 50.5}, {50.5, 50.5}, {50.5, 10.5}, {10.5, 10.5}});
    });
    int drawn = 0;
    int gaps = 0;
    for (int y = 12; y < 49; ++y)
        isRed(probe.At(10.5, y + 0.5)) ? ++drawn : ++gaps;
    EXPECT_GT(drawn, 10);
    EXPECT_GT(gaps, 10);
}

// Shadow pass ------------------------------------------------------------------

TEST(QtGPainterShadow, DarkCopyOnePixelDownAndRight)
{
    PixelProbe probe(64, 64, 1.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red, Black);
        g.Begin(GP_LineStrip);
        g.Vertex(10.0, 20.5);
        g.Vertex(50.0, 20.5);
        g.End();
    });
    EXPECT_TRUE(isRed(probe.At(30.5, 20.5)));
    EXPECT_TRUE(isDark(probe.At(31.5, 19.5))) << "shadow one pixel lower";
    EXPECT_TRUE(isDark(probe.At(50.5, 19.5))) << "shadow one pixel further right";
    EXPECT_TRUE(probe.IsBackground(30.5, 21.5));
    EXPECT_TRUE(probe.IsBackground(30.5, 18.5));
}

TEST(QtGPainterShadow, ColourPassIsDrawnOverTheShadow)
{
    PixelProbe probe(64, 64, 1.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red, Black);
        g.Rectangle(10, 10, 30, 30);
    });
    EXPECT_TRUE(isRed(probe.At(20.5, 20.5)));
    EXPECT_TRUE(isRed(probe.At(29.5, 10.5)));
    EXPECT_TRUE(isDark(probe.At(30.5, 9.5))) << "the corner only the shadow reaches";
    EXPECT_TRUE(probe.IsBackground(9.5, 30.5));
}

TEST(QtGPainterShadow, TransparentShadowDrawsNoShadowPass)
{
    PixelProbe probe(64, 64, 1.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red, Black.WithAlpha(0.0f));
        g.Rectangle(10, 10, 30, 30);
    });
    EXPECT_TRUE(probe.IsBackground(30.5, 9.5));
}

TEST(QtGPainterShadow, TextGetsAShadowToo)
{
    PixelProbe probe(80, 64, 1.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(White, Black);
        g.Text(10, 30, "HHH");
    });
    int white = 0;
    int dark = 0;
    for (int y = 25; y < 50; ++y) {
        for (int x = 8; x < 60; ++x) {
            QColor c = probe.At(x + 0.5, y + 0.5);
            white += c.red() > 200 && c.green() > 200;
            dark += isDark(c);
        }
    }
    EXPECT_GT(white, 10);
    EXPECT_GT(dark, 10);
    EXPECT_TRUE(probe.IsBackground(5.5, 35.5)) << "text starts at its point";
}

// Matrix stack -------------------------------------------------------------------

class QtGPainterMatrix : public testing::Test
{
protected:
    // A red square of side 4 centred on the model-space origin.
    static void Marker(QtGPainter &g)
    {
        g.Color(Red);
        g.Rectangle(-2, -2, 2, 2);
    }
    PixelProbe probe{64, 64};
};

TEST_F(QtGPainterMatrix, TranslateMovesWhereAPointLands)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(20, 30);
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(20.5, 30.5)));
    EXPECT_TRUE(probe.IsBackground(0.5, 0.5));
}

TEST_F(QtGPainterMatrix, ScaleActsBeforeAnEarlierTranslate)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(10, 10);
        g.Scale(2, 3);
        g.Color(Red);
        g.Rectangle(0, 0, 5, 5);
    });
    EXPECT_TRUE(isRed(probe.At(19.5, 24.5)));
    EXPECT_TRUE(probe.IsBackground(20.5, 20.5));
    EXPECT_TRUE(probe.IsBackground(15.5, 25.5));
    EXPECT_TRUE(probe.IsBackground(9.5, 15.5));
}

TEST_F(QtGPainterMatrix, RotateAboutZIsCounterClockwise)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(32, 32);
        g.Rotate(90, 0, 0, 1);
        g.Translate(15, 0);
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(32.5, 47.5))) << "+X turned to +Y";
    EXPECT_TRUE(probe.IsBackground(47.5, 32.5));
}

TEST_F(QtGPainterMatrix, RotateAboutXIsProjectedOrthographically)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(32, 10);
        g.Rotate(60, 1, 0, 0);
        g.Color(Red);
        g.Rectangle(-2, 0, 2, 40);
    });
    // 40 units tilted by 60 degrees cover 20 on screen.
    EXPECT_TRUE(isRed(probe.At(32.5, 28.5)));
    EXPECT_TRUE(probe.IsBackground(32.5, 31.5));
}

TEST_F(QtGPainterMatrix, PopRestoresThePushedMatrix)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(10, 10);
        g.PushMatrix();
        g.Translate(40, 0);
        Marker(g);
        g.PopMatrix();
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(50.5, 10.5)));
    EXPECT_TRUE(isRed(probe.At(10.5, 10.5)));
}

TEST_F(QtGPainterMatrix, PopOnAnEmptyStackIsIgnored)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(20, 20);
        g.PopMatrix();
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(20.5, 20.5)));
}

TEST_F(QtGPainterMatrix, LoadIdentityDropsEveryTransform)
{
    probe.Paint([](QtGPainter &g) {
        g.Translate(20, 20);
        g.Scale(3, 3);
        g.LoadIdentity();
        g.Translate(40, 40);
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(40.5, 40.5)));
    EXPECT_TRUE(probe.IsBackground(20.5, 20.5));
}

TEST_F(QtGPainterMatrix, MultMatrixTakesColumnMajorValues)
{
    probe.Paint([](QtGPainter &g) {
        // Scale 2 on X, then move by (30, 20): the translation is in the last column.
        const float64 m[16] = {2, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 30, 20, 0, 1};
        g.MultMatrix(m);
        g.Color(Red);
        g.Rectangle(0, 0, 5, 2);
    });
    EXPECT_TRUE(isRed(probe.At(39.5, 21.5)));
    EXPECT_TRUE(probe.IsBackground(40.5, 21.5));
    EXPECT_TRUE(probe.IsBackground(29.5, 21.5));
}

TEST_F(QtGPainterMatrix, ProjectionIsASeparateStackAppliedLast)
{
    probe.Paint([](QtGPainter &g) {
        g.MatrixMode(GM_Projection);
        g.Translate(0, 20);
        g.PopMatrix(); // the projection stack is empty: nothing happens to either stack
        g.MatrixMode(GM_ModelView);
        g.PushMatrix();
        g.Translate(10, 0);
        Marker(g);
        g.PopMatrix();
        g.Translate(40, 0);
        Marker(g);
    });
    EXPECT_TRUE(isRed(probe.At(10.5, 20.5)));
    EXPECT_TRUE(isRed(probe.At(40.5, 20.5)));
    EXPECT_TRUE(probe.IsBackground(10.5, 0.5));
}

// Arrays --------------------------------------------------------------------

class QtGPainterArrays : public testing::Test
{
protected:
    // Corners of the square (10, 10) - (50, 50), counter-clockwise.
    const float64 square[12] = {10, 10, 0, 50, 10, 0, 50, 50, 0, 10, 50, 0};
    const uint32 twoTriangles[6] = {0, 1, 2, 0, 2, 3};
    PixelProbe probe{64, 64};
};

TEST_F(QtGPainterArrays, IndexedTrianglesFillTheSquare)
{
    probe.Paint([this](QtGPainter &g) {
        g.Color(Red);
        g.SetVertexArray(square, 4);
        g.SetIndexArray(twoTriangles, 6);
        g.DrawArrays(GP_Triangles, 0, 6);
    });
    EXPECT_EQ(probe.At(40.5, 20.5), QColor(Qt::red));
    EXPECT_EQ(probe.At(20.5, 40.5), QColor(Qt::red));
    EXPECT_EQ(probe.At(30.5, 30.5), QColor(Qt::red)) << "on the shared diagonal";
}

TEST_F(QtGPainterArrays, FirstAndCountPickIndices)
{
    probe.Paint([this](QtGPainter &g) {
        g.Color(Red);
        g.SetVertexArray(square, 4);
        g.SetIndexArray(twoTriangles, 6);
        g.DrawArrays(GP_Triangles, 3, 3);
    });
    EXPECT_TRUE(isRed(probe.At(20.5, 40.5)));
    EXPECT_TRUE(probe.IsBackground(40.5, 20.5));
}

TEST_F(QtGPainterArrays, WithoutIndicesVerticesAreTakenInOrder)
{
    probe.Paint([this](QtGPainter &g) {
        g.Color(Red);
        g.SetVertexArray(square, 4);
        g.DrawArrays(GP_LineLoop, 0, 4);
    });
    EXPECT_GT(probe.At(10.5, 30.5).red(), 100) << "closing side";
    EXPECT_GT(probe.At(30.5, 50.5).red(), 100);
    EXPECT_TRUE(probe.IsBackground(30.5, 30.5));
}

TEST_F(QtGPainterArrays, RangesOutsideTheArraysDrawNothing)
{
    const uint32 badIndex[3] = {0, 1, 7};
    probe.Paint([&](QtGPainter &g) {
        g.Color(Red);
        g.SetVertexArray(square, 4);
        g.DrawArrays(GP_Quads, 1, 4); // one vertex short
        g.SetIndexArray(twoTriangles, 6);
        g.DrawArrays(GP_Triangles, 4, 3); // one index short
        g.SetIndexArray(badIndex, 3);
        g.DrawArrays(GP_Triangles, 0, 3); // an index past the vertices
        g.SetVertexArray(nullptr, 0);
        g.SetIndexArray(nullptr, 0);
        g.DrawArrays(GP_Triangles, 0, 3);
    });
    for (QPointF p : {QPointF(40.5, 20.5), QPointF(20.5, 40.5), QPointF(30.5, 30.5)})
        EXPECT_TRUE(probe.IsBackground(p.x(), p.y()));
}

TEST_F(QtGPainterArrays, UniformPicksAColourPair)
{
    const GColor uniforms[4] = {Red, GColor(), Green, Black};
    PixelProbe grey(64, 64, 1.0, Grey);
    grey.Paint([&](QtGPainter &g) {
        g.SetVertexArray(square, 4);
        g.SetUniformArray(uniforms, 4);
        g.Uniform(1);
        g.DrawArrays(GP_Quads, 0, 4);
        g.Uniform(2); // no such pair: the colour stays
        g.Rectangle(52, 52, 60, 60);
    });
    EXPECT_EQ(grey.At(30.5, 30.5), QColor(Qt::green));
    EXPECT_TRUE(isDark(grey.At(50.5, 9.5))) << "the pair's shadow";
    EXPECT_EQ(grey.At(55.5, 55.5), QColor(Qt::green));
}

// State -------------------------------------------------------------------------

TEST(QtGPainterState, BlendingMixesAndDisabledBlendingIsOpaque)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red.WithAlpha(0.5f));
        g.Rectangle(0, 0, 20, 20);
        g.Disable(GC_Blend);
        g.Rectangle(40, 40, 60, 60);
    });
    EXPECT_NEAR(probe.At(10.5, 10.5).red(), 128, 3);
    EXPECT_EQ(probe.At(50.5, 50.5), QColor(Qt::red));
}

TEST(QtGPainterState, ScreenBlendLightens)
{
    PixelProbe probe(64, 64, 1.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(GColor(0.5f, 0.5f, 0.5f));
        g.BlendFunc(GBF_One, GBF_OneMinusSrcColor);
        g.Rectangle(0, 0, 20, 20);
        g.BlendFunc(GBF_SrcAlpha, GBF_OneMinusSrcAlpha);
        g.Rectangle(40, 40, 60, 60);
    });
    EXPECT_NEAR(probe.At(10.5, 10.5).red(), 192, 3);
    EXPECT_NEAR(probe.At(50.5, 50.5).red(), 128, 2);
}

TEST(QtGPainterState, PopAttribRestoresColourWidthAndStipple)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red);
        g.PushAttrib();
        g.Color(Green);
        g.LineWidth(7.0f);
        g.LineStipple(1, 0x00FF);
        g.Enable(GC_LineStipple);
        g.Disable(GC_Blend);
        EXPECT_TRUE(g.IsEnabled(GC_LineStipple));
        g.PopAttrib();
        g.PopAttrib(); // one too many: ignored
        EXPECT_FALSE(g.IsEnabled(GC_LineStipple));
        EXPECT_TRUE(g.IsEnabled(GC_Blend));
        g.Begin(GP_LineStrip);
        g.Vertex(0, 10.5);
        g.Vertex(64, 10.5);
        g.End();
    });
    EXPECT_EQ(drawnPixels(probe, 10.5, 16), "1111111111111111");
    EXPECT_TRUE(probe.IsBackground(20.5, 11.5)) << "width back to one";
}

TEST(QtGPainterState, SmoothingOffGivesHardEdges)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.Disable(GC_LineSmooth);
        g.Color(Red);
        g.Rectangle(10.25, 10.25, 30.25, 30.25);
    });
    for (int x = 5; x < 35; ++x) {
        QColor c = probe.At(x + 0.5, 20.5);
        EXPECT_TRUE(c.red() == 0 || c.red() == 255) << "column " << x << " red " << c.red();
    }
}

TEST(QtGPainterState, MisusedBeginAndEndDrawNothingStray)
{
    PixelProbe probe(64, 64);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red);
        g.Vertex(5, 5); // outside Begin
        g.End();        // without Begin
        g.Begin(42);    // no such mode
        g.Vertex(10, 10);
        g.Vertex(50, 50);
        g.Vertex(10, 50);
        g.End();
        g.Text(10, 10, "");
    });
    QImage blank(probe.Image().size(), probe.Image().format());
    blank.fill(Qt::black);
    blank.setDevicePixelRatio(1.0);
    EXPECT_EQ(probe.Image(), blank);
}

TEST(QtGPainterState, QPainterStateIsGivenBack)
{
    QImage image(16, 16, QImage::Format_ARGB32_Premultiplied);
    QPainter painter(&image);
    painter.setPen(QPen(Qt::blue, 3));
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    {
        QtGPainter g(&painter, 16);
        g.BlendFunc(GBF_One, GBF_OneMinusSrcColor);
        g.Color(Red);
        g.Rectangle(0, 0, 4, 4);
    }
    EXPECT_EQ(painter.pen().color(), QColor(Qt::blue));
    EXPECT_EQ(painter.pen().widthF(), 3.0);
    EXPECT_EQ(painter.compositionMode(), QPainter::CompositionMode_Source);
}

// Device pixel ratio 2 ---------------------------------------------------------------

TEST(QtGPainterHiDpi, OnePixelLineIsTwoFullDeviceRows)
{
    PixelProbe probe(64, 64, 2.0);
    probe.Paint([](QtGPainter &g) { drawPrimitive(g, GP_LineStrip, {{0.0, 20.0}, {64.0, 20.0}}); });
    // Logical y 20 is the boundary between device rows 87 and 88.
    EXPECT_EQ(probe.AtDevice(60, 87), QColor(Qt::red));
    EXPECT_EQ(probe.AtDevice(60, 88), QColor(Qt::red));
    EXPECT_EQ(probe.AtDevice(60, 86), QColor(Qt::black));
    EXPECT_EQ(probe.AtDevice(60, 89), QColor(Qt::black));
}

TEST(QtGPainterHiDpi, ShadowAndStippleKeepLogicalSizes)
{
    PixelProbe probe(64, 64, 2.0, Grey);
    probe.Paint([](QtGPainter &g) {
        g.Color(Red, Black);
        g.LineStipple(1, 0x00FF);
        g.Enable(GC_LineStipple);
        g.Begin(GP_LineStrip);
        g.Vertex(0.0, 20.0);
        g.Vertex(64.0, 20.0);
        g.End();
    });
    EXPECT_EQ(probe.AtDevice(4, 88), QColor(Qt::red));
    EXPECT_EQ(probe.AtDevice(15, 88), QColor(Qt::red)) << "eight logical pixels are sixteen device pixels";
    EXPECT_EQ(probe.AtDevice(17, 87), Grey);
    EXPECT_TRUE(isDark(probe.AtDevice(17, 90))) << "the shadow is one logical pixel down: two device rows";
    EXPECT_EQ(probe.AtDevice(17, 92), Grey);
}

} // namespace
} // namespace Graphics
} // namespace Orbane

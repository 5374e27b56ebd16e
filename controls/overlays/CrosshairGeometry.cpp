#include "overlays/CrosshairGeometry.h"

#include "orbane/GPainter.h"
#include "orbane/OrbPointT.h"

#include <cmath>
#include <iterator>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;

namespace {

// Colour pairs of the uniform array.
enum Pair : int32
{
    PAIR_Centre,
    PAIR_XArm,
    PAIR_YArm,
    PAIR_Feedback,
};

// The guides of a one-axis drag reach past any viewer.
constexpr float64 kGuide = 4000.0;

// Style 0: a centre square with short ticks, an X arm to the right and a Y
// arm upwards ending in filled arrow heads 23 pixels out, and the guides.
// clang-format off
const float64 kAxisVertices[][2] = {
    {-4, -4}, {4, -4}, {4, 4}, {-4, 4},                     // 0-3 centre square
    {-10, 0}, {-4, 0}, {0, -10}, {0, -4},                   // 4-7 ticks
    {4, 0}, {17, 0}, {0, 4}, {0, 17},                       // 8-11 arms
    {17, -3}, {23, 0}, {17, 3}, {-3, 17}, {0, 23}, {3, 17}, // 12-17 heads
    {-kGuide, 0}, {kGuide, 0}, {0, -kGuide}, {0, kGuide},   // 18-21 guides
};
const uint32 kAxisIndices[] = {
    0, 1, 1, 2, 2, 3, 3, 0, 4, 5, 6, 7, // 0: centre, 12 (the square is the first 8)
    8, 9,                               // 12: X arm
    10, 11,                             // 14: Y arm
    12, 13, 14,                         // 16: X head
    15, 16, 17,                         // 19: Y head
    18, 19,                             // 22: X guide
    20, 21,                             // 24: Y guide
};
// clang-format on

constexpr int32 kRingPoints = 12;
constexpr float64 kPi = 3.14159265358979323846;

void AddVertex(std::vector<float64> &v, float64 x, float64 y)
{
    v.insert(v.end(), {x, y, 0.0});
}

void AddCircle(std::vector<float64> &v, int32 count, float64 radius)
{
    for (int32 i = 0; i < count; ++i)
        AddVertex(v, radius * std::cos(2 * kPi * i / count), radius * std::sin(2 * kPi * i / count));
}

} // namespace

void CrosshairGeometry::Build(int32 style)
{
    if (style == mStyle)
        return;
    mStyle = style;
    mVertices.clear();
    mIndices.clear();
    switch (style) {
    case 0:
        for (const auto &v : kAxisVertices)
            AddVertex(mVertices, v[0], v[1]);
        mIndices.assign(std::begin(kAxisIndices), std::end(kAxisIndices));
        break;
    case 1: // two crossing lines
        for (const OrbPoint v : {OrbPoint(-10, 0), OrbPoint(10, 0), OrbPoint(0, -10), OrbPoint(0, 10)})
            AddVertex(mVertices, v.x, v.y);
        mIndices = {0, 1, 2, 3};
        break;
    case 2: // a closed square
        for (const OrbPoint v : {OrbPoint(-8, -8), OrbPoint(8, -8), OrbPoint(8, 8), OrbPoint(-8, 8)})
            AddVertex(mVertices, v.x, v.y);
        mIndices = {0, 1, 2, 3, 0};
        break;
    case 3: // a closed ring
        AddCircle(mVertices, kRingPoints, 8.0);
        for (uint32 i = 0; i <= kRingPoints; ++i)
            mIndices.push_back(i % kRingPoints);
        break;
    case 4: // every other piece of a 24-sided ring
        AddCircle(mVertices, 2 * kRingPoints, 10.0);
        for (uint32 i = 0; i < 2 * kRingPoints; ++i)
            mIndices.push_back(i);
        break;
    default:
        break;
    }
}

void CrosshairGeometry::SetColors(const PartFills &fills, const GColor &fill, const GColor &shadow)
{
    if (!mColors.empty() && fills == mFills && fill == mFill && shadow == mShadow)
        return;
    mFills = fills;
    mFill = fill;
    mShadow = shadow;
    mColors = {fills.centre, shadow, fills.xArm, shadow, fills.yArm, shadow, fill.Faded(0.5f), shadow.Faded(0.5f)};
    ++mUploads;
}

void CrosshairGeometry::Bind(GPainter &p) const
{
    p.SetVertexArray(mVertices.data(), int32(mVertices.size() / 3));
    p.SetIndexArray(mIndices.data(), int32(mIndices.size()));
    p.SetUniformArray(mColors.data(), int32(mColors.size()));
}

void CrosshairGeometry::Unbind(GPainter &p)
{
    p.SetVertexArray(nullptr, 0);
    p.SetIndexArray(nullptr, 0);
    p.SetUniformArray(nullptr, 0);
}

void CrosshairGeometry::Draw(GPainter &p) const
{
    p.Uniform(PAIR_Centre);
    switch (mStyle) {
    case 0:
        p.DrawArrays(Graphics::GP_Lines, 0, 12);
        p.Uniform(PAIR_XArm);
        p.DrawArrays(Graphics::GP_Lines, 12, 2);
        p.DrawArrays(Graphics::GP_Triangles, 16, 3);
        p.Uniform(PAIR_YArm);
        p.DrawArrays(Graphics::GP_Lines, 14, 2);
        p.DrawArrays(Graphics::GP_Triangles, 19, 3);
        break;
    case 1:
        p.DrawArrays(Graphics::GP_Lines, 0, 4);
        break;
    case 2:
        p.DrawArrays(Graphics::GP_LineStrip, 0, 5);
        break;
    case 3:
        p.DrawArrays(Graphics::GP_LineStrip, 0, kRingPoints + 1);
        break;
    case 4:
        p.DrawArrays(Graphics::GP_Lines, 0, 2 * kRingPoints);
        break;
    default:
        break;
    }
}

void CrosshairGeometry::DrawFeedback(GPainter &p, bool alongX, bool alongY) const
{
    if (mStyle != 0)
        return;
    p.Uniform(PAIR_Feedback);
    p.DrawArrays(Graphics::GP_Lines, 0, 8);
    if (alongX && !alongY)
        p.DrawArrays(Graphics::GP_Lines, 22, 2);
    if (alongY && !alongX)
        p.DrawArrays(Graphics::GP_Lines, 24, 2);
}

} // namespace Orbane

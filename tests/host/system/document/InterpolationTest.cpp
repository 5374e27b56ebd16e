#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Point.h"
#include "orbane/PolyLine.h"
#include "orbane/ScriptError.h"

#include <gtest/gtest.h>

#include <cmath>

namespace Orbane {
namespace {

struct Blend
{
    const char *name;
    Interpolation mode;
    float64 time;
    float64 x, y, z; // the Point's value there (a Number reads x)
};

// Keys at 0, 10 and 20: x goes 0, 1, 5; y 0, 2, 2; z 0, 0, 4. Smooth values
// worked by hand from the Hermite form with the slopes of the neighbours.
const Blend kBlends[] = {
    {"linear_first_span", Interpolation::Linear, 5, 0.5, 1, 0},
    {"linear_second_span", Interpolation::Linear, 15, 3, 2, 2},
    {"smooth_first_span", Interpolation::Smooth, 5, 0.1875, 0.875, -0.25},
    {"smooth_second_span", Interpolation::Smooth, 15, 3.3125, 2.125, 2.25},
    {"smooth_quarter", Interpolation::Smooth, 2.5, 0.0390625, 0.265625, -0.09375},
    {"smooth_at_a_key", Interpolation::Smooth, 10, 1, 2, 0},
    {"smooth_holds_before", Interpolation::Smooth, -3, 0, 0, 0},
    {"smooth_holds_after", Interpolation::Smooth, 99, 5, 2, 4},
};

class Interpolated : public testing::TestWithParam<Blend>
{
protected:
    void SetUp() override
    {
        tool = AutoRef<Operator>(new Operator("Move1", "Move"));
        number = tool->AddInput("Size", "Size", CLSID_DataType_Number, {}, AutoNumber(0.0));
        point = tool->AddInput("Center", "Center", CLSID_DataType_Point, {}, AutoPoint(0.0, 0.0));
        doc.AddTool(tool);
        const float64 keys[3][4] = {{0, 0, 0, 0}, {10, 1, 2, 0}, {20, 5, 2, 4}};
        for (Input *in : {number, point}) {
            in->SetAnimated(true);
            in->SetInterpolation(GetParam().mode);
        }
        for (const auto &k : keys) {
            ASSERT_TRUE(number->SetValue(AutoNumber(k[1]), k[0], SETVALUE_NoUndo));
            ASSERT_TRUE(point->SetValue(AutoPoint(k[1], k[2], k[3]), k[0], SETVALUE_NoUndo));
        }
    }

    OrbaneDoc doc;
    AutoRef<Operator> tool;
    Input *number = nullptr;
    Input *point = nullptr;
};

TEST_P(Interpolated, NumbersAndPointsFollowTheCurve)
{
    const Blend &b = GetParam();
    EXPECT_DOUBLE_EQ(AutoNumber(number, b.time)->Value, b.x);
    const AutoPoint p(point, b.time);
    EXPECT_DOUBLE_EQ(p->X, b.x);
    EXPECT_DOUBLE_EQ(p->Y, b.y);
    EXPECT_DOUBLE_EQ(p->Z, b.z);
}

INSTANTIATE_TEST_SUITE_P(Keys, Interpolated, testing::ValuesIn(kBlends),
                         [](const auto &info) { return std::string(info.param.name); });

// A shape blends point by point; smooth eases the factor between two keys.
TEST(InterpolatedShape, SmoothEasesTheBlendFactor)
{
    OrbaneDoc doc;
    AutoRef<Operator> tool(new Operator("Roto1", "Roto"));
    AutoRef<PolyLine> from(new PolyLine), to(new PolyLine);
    from->AddPoint(PolyPoint(0.0, 0.0));
    to->AddPoint(PolyPoint(1.0, 2.0));
    Input *shape = tool->AddInput("Shape", "Shape", CLSID_DataType_Polyline, {}, from.get());
    doc.AddTool(tool);
    shape->SetAnimated(true);
    ASSERT_TRUE(shape->SetValue(to.get(), 8.0, SETVALUE_NoUndo));
    for (const auto &[mode, factor] : {std::pair{Interpolation::Linear, 0.25}, {Interpolation::Smooth, 0.15625}}) {
        shape->SetInterpolation(mode);
        const AutoParam<PolyLine> mid(shape, 2.0);
        EXPECT_DOUBLE_EQ(mid->Points()[0].X, factor);
        EXPECT_DOUBLE_EQ(mid->Points()[0].Y, 2 * factor);
    }
}

// A key at NaN would break the order of the keys: refused with a message,
// and no key is made.
TEST(InterpolatedKeys, NonFiniteTimesMakeNoKey)
{
    OrbaneDoc doc;
    AutoRef<Operator> tool(new Operator("Blur1", "Blur"));
    Input *size = tool->AddInput("Size", "Size", CLSID_DataType_Number, {}, AutoNumber(1.0));
    doc.AddTool(tool);
    size->SetAnimated(true);
    for (const float64 time : {NAN, INFINITY, -INFINITY}) {
        TakeScriptError();
        EXPECT_FALSE(size->SetValue(AutoNumber(3.0), time));
        EXPECT_NE(TakeScriptError().find("a key needs a finite time"), std::string::npos);
    }
    EXPECT_EQ(size->KeyTimes(), std::vector<float64>{0.0});
    EXPECT_TRUE(doc.UndoNames().isEmpty());
}

} // namespace
} // namespace Orbane

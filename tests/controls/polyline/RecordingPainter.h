#pragma once

#include "orbane/GPainter.h"

#include <string>
#include <vector>

namespace Orbane {
namespace Test {

// A painter that keeps what it was asked to draw: each primitive, filled
// rectangle, array draw and text with the colour and stipple it was drawn
// in. Matrices are not applied: an overlay's draw is checked by what it
// draws and how, its places by the real viewer's pixels elsewhere.
class RecordingPainter final : public Graphics::GPainter
{
public:
    enum Kind
    {
        Primitive,
        Filled,
        Arrays,
        Label,
    };
    struct Call
    {
        Kind kind;
        int32 mode = -1; // primitive mode
        int32 count = 0; // vertices
        Graphics::GColor fill;
        uint16 stipple = 0; // 0: solid
        std::string text;
    };

    std::vector<Call> calls;

    // How many calls of `kind` were drawn in `fill` (any colour where its
    // alpha is negative), with `mode` (any where -1).
    int Count(Kind kind, Graphics::GColor fill = {0, 0, 0, -1}, int32 mode = -1) const
    {
        int n = 0;
        for (const Call &c : calls)
            n += c.kind == kind && (fill.a < 0 || Same(c.fill, fill)) && (mode < 0 || c.mode == mode);
        return n;
    }
    const Call *First(Kind kind) const
    {
        for (const Call &c : calls)
            if (c.kind == kind)
                return &c;
        return nullptr;
    }
    static bool Same(const Graphics::GColor &a, const Graphics::GColor &b)
    {
        auto near = [](float32 x, float32 y) { return x - y < 1e-3f && y - x < 1e-3f; };
        return near(a.r, b.r) && near(a.g, b.g) && near(a.b, b.b) && near(a.a, b.a);
    }

    void MatrixMode(int32) override {}
    void PushMatrix() override {}
    void PopMatrix() override {}
    void LoadIdentity() override {}
    void Translate(float64, float64, float64) override {}
    void Scale(float64, float64, float64) override {}
    void Rotate(float64, float64, float64, float64) override {}
    void MultMatrix(const float64 *) override {}

    void Begin(int32 mode) override
    {
        mMode = mode;
        mCount = 0;
    }
    void Vertex(float64, float64, float64) override { ++mCount; }
    void End() override { Add(Primitive, mMode, mCount); }
    void Rectangle(float64, float64, float64, float64) override { Add(Filled, -1, 4); }
    void Text(float64, float64, const char *text) override
    {
        Add(Label, -1, 0);
        calls.back().text = text;
    }

    void SetVertexArray(const float64 *, int32) override {}
    void SetIndexArray(const uint32 *, int32) override {}
    void SetUniformArray(const Graphics::GColor *, int32) override {}
    void Uniform(int32) override {}
    void DrawArrays(int32 mode, int32, int32 count) override { Add(Arrays, mode, count); }

    void Color(const Graphics::GColor &fill, const Graphics::GColor &) override { mState.fill = fill; }
    void LineWidth(float32) override {}
    void PointSize(float32) override {}
    void LineStipple(int32, uint16 pattern) override { mState.pattern = pattern; }
    void Enable(int32 cap) override { SetCap(cap, true); }
    void Disable(int32 cap) override { SetCap(cap, false); }
    bool IsEnabled(int32 cap) const override { return cap == Graphics::GC_LineStipple && mState.stippled; }
    void PushAttrib() override { mSaved.push_back(mState); }
    void PopAttrib() override
    {
        if (!mSaved.empty()) {
            mState = mSaved.back();
            mSaved.pop_back();
        }
    }
    void BlendFunc(int32, int32) override {}
    void DepthMask(bool) override {}
    void ShadeModel(int32) override {}

private:
    struct State
    {
        Graphics::GColor fill;
        uint16 pattern = 0xFFFF;
        bool stippled = false;
    };
    void SetCap(int32 cap, bool on)
    {
        if (cap == Graphics::GC_LineStipple)
            mState.stippled = on;
    }
    void Add(Kind kind, int32 mode, int32 count)
    {
        calls.push_back({kind, mode, count, mState.fill, uint16(mState.stippled ? mState.pattern : 0), {}});
    }

    State mState;
    std::vector<State> mSaved;
    int32 mMode = -1, mCount = 0;
};

} // namespace Test
} // namespace Orbane

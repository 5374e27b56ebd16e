#pragma once

#include "MatrixStack.h"
#include "PainterState.h"

#include "orbane/GPainter.h"

#include <QVector>

#include <vector>

class QColor;
class QPainter;

namespace Orbane {
namespace Graphics {

class PrimitiveAssembly;

// GPainter on a QPainter. The QPainter paints the viewer widget (or an
// image of it) in logical pixels, Y down; this painter keeps its own 4x4
// matrices, maps each vertex through them, flips Y with the viewport height
// and hands the result to QPainter. The QPainter's own transform is left as
// the caller set it and is normally the identity, so widths and stipples are
// in logical pixels and come out two device pixels wide, crisp, at a device
// pixel ratio of 2.
//
// Blending: (SrcAlpha, OneMinusSrcAlpha) and any other pair ending in
// OneMinusSrcAlpha draw as ordinary transparency, (One, OneMinusSrcColor) as
// a screen, pairs starting with DstColor or (Zero, SrcColor) as a multiply,
// pairs ending in One as an addition; anything else as ordinary
// transparency. With GC_Blend disabled colours are drawn opaque.
// DepthMask, GC_DepthTest and ShadeModel are kept as state (PushAttrib saves
// them) but change nothing in 2D: there is no depth buffer and each
// primitive has one colour.
class QtGPainter final : public GPainter
{
public:
    // The painter stays owned by the caller and must outlive this object;
    // its state is saved here and restored on destruction.
    QtGPainter(QPainter *painter, float64 viewportHeight);
    ~QtGPainter() override;

    using GPainter::Color;
    using GPainter::Scale;
    using GPainter::Translate;
    using GPainter::Vertex;

    void MatrixMode(int32 mode) override;
    void PushMatrix() override;
    void PopMatrix() override;
    void LoadIdentity() override;
    void Translate(float64 x, float64 y, float64 z) override;
    void Scale(float64 x, float64 y, float64 z) override;
    void Rotate(float64 angle, float64 x, float64 y, float64 z) override;
    void MultMatrix(const float64 *m) override;

    void Begin(int32 mode) override;
    void Vertex(float64 x, float64 y, float64 z) override;
    void End() override;
    void Rectangle(float64 x1, float64 y1, float64 x2, float64 y2) override;
    void Text(float64 x, float64 y, const char *text) override;
    void Texture(const QImage &image, const float64 *corners, const GColor &color) override;

    void SetVertexArray(const float64 *xyz, int32 count) override;
    void SetIndexArray(const uint32 *indices, int32 count) override;
    void SetUniformArray(const GColor *colors, int32 count) override;
    void Uniform(int32 pair) override;
    void DrawArrays(int32 mode, int32 first, int32 count) override;

    void Color(const GColor &fill, const GColor &shadow) override;
    void LineWidth(float32 width) override;
    void PointSize(float32 size) override;
    void LineStipple(int32 factor, uint16 pattern) override;
    void Enable(int32 capability) override;
    void Disable(int32 capability) override;
    bool IsEnabled(int32 capability) const override;
    void PushAttrib() override;
    void PopAttrib() override;
    void BlendFunc(int32 source, int32 destination) override;
    void DepthMask(bool write) override;
    void ShadeModel(int32 model) override;

private:
    QPointF ToWidget(float64 x, float64 y, float64 z) const;
    void Draw(int32 mode, const QVector<QPointF> &widgetPoints);
    void DrawPass(const PrimitiveAssembly &shapes, const GColor &color, QPointF offset);
    void DrawStrokes(const PrimitiveAssembly &shapes, const QColor &color, QPointF offset);
    void DrawPoints(const QVector<QPointF> &points, const QColor &color, QPointF offset);
    QColor PaintColor(const GColor &c) const;
    void ApplyBlendAndSmoothing();
    bool GatherArrayVertices(int32 first, int32 count, QVector<QPointF> &out) const;

    QPainter *mPainter;
    float64 mViewportHeight;
    MatrixStack mMatrices;
    PainterState mState;
    // A std::vector: QVector<PainterState>::append trips a false
    // -Wstringop-overflow in GCC 12's release builds.
    std::vector<PainterState> mSavedStates;

    int32 mBeginMode = -1; // -1: not between Begin and End
    QVector<QPointF> mVertices;

    const float64 *mVertexArray = nullptr;
    int32 mVertexCount = 0;
    const uint32 *mIndexArray = nullptr;
    int32 mIndexCount = 0;
    const GColor *mUniforms = nullptr;
    int32 mUniformCount = 0;
};

} // namespace Graphics
} // namespace Orbane

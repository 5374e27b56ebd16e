#include "QtGPainter.h"

#include "PrimitiveAssembly.h"
#include "StippleDashes.h"

#include <QImage>
#include <QPainter>
#include <QPen>
#include <QTransform>

#include <algorithm>

namespace Orbane {
namespace Graphics {

namespace {

// The shadow pass: one viewer pixel right and one down on screen.
const QPointF ShadowOffset(1.0, 1.0);

QPainter::CompositionMode compositionFor(int32 source, int32 destination)
{
    if (destination == GBF_OneMinusSrcAlpha)
        return QPainter::CompositionMode_SourceOver;
    if (source == GBF_One && destination == GBF_OneMinusSrcColor)
        return QPainter::CompositionMode_Screen;
    if (source == GBF_DstColor || (source == GBF_Zero && destination == GBF_SrcColor))
        return QPainter::CompositionMode_Multiply;
    if (destination == GBF_One)
        return QPainter::CompositionMode_Plus;
    return QPainter::CompositionMode_SourceOver;
}

float32 positiveOr1(float32 v)
{
    return v > 0.0f ? v : 1.0f;
}

} // namespace

QtGPainter::QtGPainter(QPainter *painter, float64 viewportHeight) : mPainter(painter), mViewportHeight(viewportHeight)
{
    mPainter->save();
}

QtGPainter::~QtGPainter()
{
    mPainter->restore();
}

// Matrices.

void QtGPainter::MatrixMode(int32 mode)
{
    mMatrices.SetMode(mode);
}

void QtGPainter::PushMatrix()
{
    mMatrices.Push();
}

void QtGPainter::PopMatrix()
{
    mMatrices.Pop();
}

void QtGPainter::LoadIdentity()
{
    mMatrices.Load(QMatrix4x4());
}

void QtGPainter::Translate(float64 x, float64 y, float64 z)
{
    QMatrix4x4 m;
    m.translate(float(x), float(y), float(z));
    mMatrices.Multiply(m);
}

void QtGPainter::Scale(float64 x, float64 y, float64 z)
{
    QMatrix4x4 m;
    m.scale(float(x), float(y), float(z));
    mMatrices.Multiply(m);
}

void QtGPainter::Rotate(float64 angle, float64 x, float64 y, float64 z)
{
    QMatrix4x4 m;
    m.rotate(float(angle), float(x), float(y), float(z));
    mMatrices.Multiply(m);
}

void QtGPainter::MultMatrix(const float64 *m)
{
    if (m)
        mMatrices.Multiply(MatrixStack::FromColumnMajor(m));
}

// Immediate primitives.

void QtGPainter::Begin(int32 mode)
{
    if (mBeginMode >= 0)
        return; // nested Begin: the first one stands
    mBeginMode = mode;
    mVertices.clear();
}

void QtGPainter::Vertex(float64 x, float64 y, float64 z)
{
    if (mBeginMode >= 0)
        mVertices.append(ToWidget(x, y, z));
}

void QtGPainter::End()
{
    if (mBeginMode < 0)
        return;
    int32 mode = mBeginMode;
    mBeginMode = -1;
    Draw(mode, mVertices);
    mVertices.clear();
}

void QtGPainter::Rectangle(float64 x1, float64 y1, float64 x2, float64 y2)
{
    Draw(GP_Quads, {ToWidget(x1, y1, 0.0), ToWidget(x2, y1, 0.0), ToWidget(x2, y2, 0.0), ToWidget(x1, y2, 0.0)});
}

void QtGPainter::Texture(const QImage &image, const float64 *corners, const GColor &color)
{
    if (image.isNull() || !corners)
        return;
    QPolygonF quad;
    for (int i = 0; i < 4; ++i)
        quad << ToWidget(corners[2 * i], corners[2 * i + 1], 0.0);
    // The image's rows run top down: its bottom-left is (0, height).
    const QPolygonF source(
        {QPointF(0, image.height()), QPointF(image.width(), image.height()), QPointF(image.width(), 0), QPointF(0, 0)});
    QTransform map;
    if (!QTransform::quadToQuad(source, quad, map))
        return;
    QImage tinted = image.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    const float32 grey = std::clamp(color.r, 0.0f, 1.0f);
    if (grey < 1.0f) {
        QPainter darken(&tinted);
        darken.setCompositionMode(QPainter::CompositionMode_Multiply);
        darken.fillRect(tinted.rect(), QColor::fromRgbF(grey, grey, grey));
    }
    ApplyBlendAndSmoothing();
    mPainter->save();
    // Alpha weighs the image only where the blend takes the source's alpha.
    const bool byAlpha = mState.IsEnabled(GC_Blend) && mState.BlendSource == GBF_SrcAlpha;
    mPainter->setOpacity(byAlpha ? std::clamp(color.a, 0.0f, 1.0f) : 1.0);
    mPainter->setTransform(map, true);
    mPainter->setRenderHint(QPainter::SmoothPixmapTransform);
    mPainter->drawImage(QPointF(0, 0), tinted);
    mPainter->restore();
}

void QtGPainter::Text(float64 x, float64 y, const char *text)
{
    if (!text || !*text)
        return;
    QString s = QString::fromUtf8(text);
    QPointF at = ToWidget(x, y, 0.0);
    ApplyBlendAndSmoothing();
    mPainter->setBrush(Qt::NoBrush);
    if (mState.Shadow.IsVisible()) {
        mPainter->setPen(PaintColor(mState.Shadow));
        mPainter->drawText(at + ShadowOffset, s);
    }
    mPainter->setPen(PaintColor(mState.Fill));
    mPainter->drawText(at, s);
}

// Arrays.

void QtGPainter::SetVertexArray(const float64 *xyz, int32 count)
{
    mVertexArray = count > 0 ? xyz : nullptr;
    mVertexCount = mVertexArray ? count : 0;
}

void QtGPainter::SetIndexArray(const uint32 *indices, int32 count)
{
    mIndexArray = count > 0 ? indices : nullptr;
    mIndexCount = mIndexArray ? count : 0;
}

void QtGPainter::SetUniformArray(const GColor *colors, int32 count)
{
    mUniforms = count > 0 ? colors : nullptr;
    mUniformCount = mUniforms ? count : 0;
}

void QtGPainter::Uniform(int32 pair)
{
    if (pair < 0 || 2 * pair + 1 >= mUniformCount)
        return;
    Color(mUniforms[2 * pair], mUniforms[2 * pair + 1]);
}

void QtGPainter::DrawArrays(int32 mode, int32 first, int32 count)
{
    QVector<QPointF> points;
    if (GatherArrayVertices(first, count, points))
        Draw(mode, points);
}

bool QtGPainter::GatherArrayVertices(int32 first, int32 count, QVector<QPointF> &out) const
{
    const int32 available = mIndexArray ? mIndexCount : mVertexCount;
    if (!mVertexArray || first < 0 || count <= 0 || count > available - first)
        return false;
    out.reserve(count);
    for (int32 i = first; i < first + count; ++i) {
        const int64 v = mIndexArray ? int64(mIndexArray[i]) : i;
        if (v >= mVertexCount)
            return false; // an index past the vertices: draw nothing rather than read past the array
        const float64 *p = mVertexArray + 3 * v;
        out.append(ToWidget(p[0], p[1], p[2]));
    }
    return true;
}

// State.

void QtGPainter::Color(const GColor &fill, const GColor &shadow)
{
    mState.Fill = fill;
    mState.Shadow = shadow;
}

void QtGPainter::LineWidth(float32 width)
{
    mState.LineWidth = positiveOr1(width);
}

void QtGPainter::PointSize(float32 size)
{
    mState.PointSize = positiveOr1(size);
}

void QtGPainter::LineStipple(int32 factor, uint16 pattern)
{
    mState.StippleFactor = factor;
    mState.StipplePattern = pattern;
}

void QtGPainter::Enable(int32 capability)
{
    mState.SetEnabled(capability, true);
}

void QtGPainter::Disable(int32 capability)
{
    mState.SetEnabled(capability, false);
}

bool QtGPainter::IsEnabled(int32 capability) const
{
    return mState.IsEnabled(capability);
}

void QtGPainter::PushAttrib()
{
    mSavedStates.push_back(mState);
}

void QtGPainter::PopAttrib()
{
    if (mSavedStates.empty())
        return;
    mState = mSavedStates.back();
    mSavedStates.pop_back();
}

void QtGPainter::BlendFunc(int32 source, int32 destination)
{
    mState.BlendSource = source;
    mState.BlendDestination = destination;
}

void QtGPainter::DepthMask(bool write)
{
    mState.DepthMask = write;
}

void QtGPainter::ShadeModel(int32 model)
{
    mState.ShadeModel = model;
}

// Drawing.

QPointF QtGPainter::ToWidget(float64 x, float64 y, float64 z) const
{
    QPointF v = mMatrices.Project(x, y, z);
    return QPointF(v.x(), mViewportHeight - v.y());
}

void QtGPainter::Draw(int32 mode, const QVector<QPointF> &widgetPoints)
{
    PrimitiveAssembly shapes(mode, widgetPoints);
    if (shapes.IsEmpty())
        return;
    ApplyBlendAndSmoothing();
    if (mState.Shadow.IsVisible())
        DrawPass(shapes, mState.Shadow, ShadowOffset);
    DrawPass(shapes, mState.Fill, QPointF());
}

void QtGPainter::DrawPass(const PrimitiveAssembly &shapes, const GColor &color, QPointF offset)
{
    const QColor c = PaintColor(color);
    if (c.alpha() == 0)
        return;
    if (!shapes.Fill().isEmpty())
        mPainter->fillPath(shapes.Fill().translated(offset), c);
    DrawStrokes(shapes, c, offset);
    DrawPoints(shapes.Points(), c, offset);
}

void QtGPainter::DrawStrokes(const PrimitiveAssembly &shapes, const QColor &color, QPointF offset)
{
    if (shapes.OpenStrokes().isEmpty() && shapes.ClosedStrokes().isEmpty())
        return;
    const qreal width = mState.LineWidth;
    // Flat ends, as a line has in OpenGL, so dashes keep their length.
    QPen pen(color, width, Qt::SolidLine, Qt::FlatCap, Qt::MiterJoin);
    if (mState.IsEnabled(GC_LineStipple)) {
        StippleDashes stipple(mState.StippleFactor, mState.StipplePattern);
        if (stipple.IsInvisible())
            return;
        if (!stipple.IsSolid()) {
            pen.setDashPattern(stipple.Dashes(width));
            pen.setDashOffset(stipple.Offset(width));
        }
    }
    mPainter->setPen(pen);
    mPainter->setBrush(Qt::NoBrush);
    // One call per stroke: each restarts the stipple, as each Begin and each
    // separate line does.
    for (const QPolygonF &stroke : shapes.OpenStrokes())
        mPainter->drawPolyline(stroke.translated(offset));
    for (const QPolygonF &stroke : shapes.ClosedStrokes())
        mPainter->drawPolygon(stroke.translated(offset));
}

void QtGPainter::DrawPoints(const QVector<QPointF> &points, const QColor &color, QPointF offset)
{
    const qreal size = mState.PointSize;
    const QPointF half(size / 2.0, size / 2.0);
    for (const QPointF &p : points)
        mPainter->fillRect(QRectF(p + offset - half, QSizeF(size, size)), color);
}

QColor QtGPainter::PaintColor(const GColor &c) const
{
    const float32 alpha = mState.IsEnabled(GC_Blend) ? c.a : 1.0f;
    return QColor::fromRgbF(qBound(0.0f, c.r, 1.0f), qBound(0.0f, c.g, 1.0f), qBound(0.0f, c.b, 1.0f),
                            qBound(0.0f, alpha, 1.0f));
}

void QtGPainter::ApplyBlendAndSmoothing()
{
    const bool blend = mState.IsEnabled(GC_Blend);
    mPainter->setCompositionMode(blend ? compositionFor(mState.BlendSource, mState.BlendDestination)
                                       : QPainter::CompositionMode_SourceOver);
    mPainter->setRenderHint(QPainter::Antialiasing, mState.IsEnabled(GC_LineSmooth));
    mPainter->setRenderHint(QPainter::TextAntialiasing, mState.IsEnabled(GC_LineSmooth));
}

} // namespace Graphics
} // namespace Orbane

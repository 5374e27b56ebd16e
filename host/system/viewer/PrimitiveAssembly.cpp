#include "PrimitiveAssembly.h"

#include "orbane/GPainter.h"

#include <algorithm>

namespace Orbane {
namespace Graphics {

namespace {

qreal signedArea(const QPolygonF &p)
{
    qreal twice = 0.0;
    for (int32 i = 0, n = p.size(); i < n; ++i) {
        const QPointF &a = p[i];
        const QPointF &b = p[(i + 1) % n];
        twice += a.x() * b.y() - b.x() * a.y();
    }
    return twice / 2.0;
}

QPolygonF polygonOf(std::initializer_list<QPointF> points)
{
    return QPolygonF(QVector<QPointF>(points));
}

} // namespace

PrimitiveAssembly::PrimitiveAssembly(int32 mode, const QVector<QPointF> &v)
{
    mFill.setFillRule(Qt::WindingFill);
    switch (mode) {
    case GP_Points:
        mPoints = v;
        break;
    case GP_Lines:
        AssembleLines(v);
        break;
    case GP_LineLoop:
        if (v.size() >= 2)
            mClosedStrokes.append(QPolygonF(v));
        break;
    case GP_LineStrip:
        if (v.size() >= 2)
            mOpenStrokes.append(QPolygonF(v));
        break;
    case GP_Triangles:
    case GP_TriangleStrip:
    case GP_TriangleFan:
        AssembleTriangles(mode, v);
        break;
    case GP_Quads:
    case GP_QuadStrip:
        AssembleQuads(mode, v);
        break;
    case GP_Polygon:
        if (v.size() >= 3)
            AddFilled(QPolygonF(v));
        break;
    default:
        break;
    }
}

bool PrimitiveAssembly::IsEmpty() const
{
    return mPoints.isEmpty() && mOpenStrokes.isEmpty() && mClosedStrokes.isEmpty() && mFill.isEmpty();
}

void PrimitiveAssembly::AssembleLines(const QVector<QPointF> &v)
{
    for (int32 i = 0; i + 1 < v.size(); i += 2)
        mOpenStrokes.append(polygonOf({v[i], v[i + 1]}));
}

void PrimitiveAssembly::AssembleTriangles(int32 mode, const QVector<QPointF> &v)
{
    const int32 n = v.size();
    if (mode == GP_Triangles) {
        for (int32 i = 0; i + 2 < n; i += 3)
            AddFilled(polygonOf({v[i], v[i + 1], v[i + 2]}));
    } else if (mode == GP_TriangleStrip) {
        for (int32 i = 0; i + 2 < n; ++i)
            AddFilled(polygonOf({v[i], v[i + 1], v[i + 2]}));
    } else {
        for (int32 i = 1; i + 1 < n; ++i)
            AddFilled(polygonOf({v[0], v[i], v[i + 1]}));
    }
}

void PrimitiveAssembly::AssembleQuads(int32 mode, const QVector<QPointF> &v)
{
    const int32 n = v.size();
    if (mode == GP_Quads) {
        for (int32 i = 0; i + 3 < n; i += 4)
            AddFilled(polygonOf({v[i], v[i + 1], v[i + 2], v[i + 3]}));
    } else {
        // A quad strip pairs its vertices: quad i is 2i, 2i+1, 2i+3, 2i+2.
        for (int32 i = 0; i + 3 < n; i += 2)
            AddFilled(polygonOf({v[i], v[i + 1], v[i + 3], v[i + 2]}));
    }
}

void PrimitiveAssembly::AddFilled(QPolygonF polygon)
{
    qreal area = signedArea(polygon);
    if (area == 0.0)
        return;
    if (area < 0.0)
        std::reverse(polygon.begin(), polygon.end());
    mFill.addPolygon(polygon);
    mFill.closeSubpath();
}

} // namespace Graphics
} // namespace Orbane

#pragma once

#include "orbane/Types.h"

#include <QPainterPath>
#include <QPolygonF>
#include <QVector>

namespace Orbane {
namespace Graphics {

// Turns the vertices of one Begin/End (or DrawArrays) in one of the
// OpenGL-numbered modes into what QPainter draws: points, open and closed
// strokes, and one fill path.
//
// Filled pieces are wound the same way and share one path, so triangles of
// a strip or fan that meet along an edge are filled in one go: no
// antialiased seam between them, and no pixel blended twice.
class PrimitiveAssembly
{
public:
    PrimitiveAssembly(int32 mode, const QVector<QPointF> &vertices);

    const QVector<QPointF> &Points() const { return mPoints; }
    const QVector<QPolygonF> &OpenStrokes() const { return mOpenStrokes; }
    const QVector<QPolygonF> &ClosedStrokes() const { return mClosedStrokes; }
    const QPainterPath &Fill() const { return mFill; }
    bool IsEmpty() const;

private:
    void AssembleLines(const QVector<QPointF> &v);
    void AssembleTriangles(int32 mode, const QVector<QPointF> &v);
    void AssembleQuads(int32 mode, const QVector<QPointF> &v);
    void AddFilled(QPolygonF polygon);

    QVector<QPointF> mPoints;
    QVector<QPolygonF> mOpenStrokes;
    QVector<QPolygonF> mClosedStrokes;
    QPainterPath mFill;
};

} // namespace Graphics
} // namespace Orbane

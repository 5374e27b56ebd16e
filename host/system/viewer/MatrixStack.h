#pragma once

#include "orbane/GPainter.h"

#include <QMatrix4x4>
#include <QPointF>
#include <QVector>

namespace Orbane {
namespace Graphics {

// The three matrix stacks of GPainter (model-view, projection, texture) and
// the orthographic projection of a vertex through them.
class MatrixStack
{
public:
    MatrixStack();

    // Unknown modes are ignored, keeping the current one.
    void SetMode(int32 mode);
    int32 Mode() const { return mMode; }

    void Push();
    // False (and nothing popped) when only the bottom matrix is left.
    bool Pop();
    const QMatrix4x4 &Top() const { return mStacks[mMode].last(); }
    int32 Depth() const { return mStacks[mMode].size(); }
    // The current matrix becomes m, or itself times m (m acts first).
    void Load(const QMatrix4x4 &m);
    void Multiply(const QMatrix4x4 &m);

    // Column-major sixteen values, as OpenGL lays them out.
    static QMatrix4x4 FromColumnMajor(const float64 *m);

    // Projection times model-view applied to (x, y, z), z dropped.
    QPointF Project(float64 x, float64 y, float64 z) const;

private:
    static constexpr int32 ModeCount = 3;
    const QMatrix4x4 &Combined() const;

    QVector<QMatrix4x4> mStacks[ModeCount];
    int32 mMode = 0;
    // Projection times model-view, rebuilt on the first vertex after a change.
    mutable QMatrix4x4 mCombined;
    mutable bool mCombinedValid = false;
};

} // namespace Graphics
} // namespace Orbane

#include "MatrixStack.h"

#include <QVector3D>

namespace Orbane {
namespace Graphics {

MatrixStack::MatrixStack()
{
    for (QVector<QMatrix4x4> &stack : mStacks)
        stack.append(QMatrix4x4());
}

void MatrixStack::SetMode(int32 mode)
{
    if (mode >= 0 && mode < ModeCount)
        mMode = mode;
}

void MatrixStack::Push()
{
    QVector<QMatrix4x4> &stack = mStacks[mMode];
    QMatrix4x4 top = stack.last();
    stack.append(top);
}

bool MatrixStack::Pop()
{
    QVector<QMatrix4x4> &stack = mStacks[mMode];
    if (stack.size() <= 1)
        return false;
    stack.removeLast();
    mCombinedValid = false;
    return true;
}

void MatrixStack::Load(const QMatrix4x4 &m)
{
    mStacks[mMode].last() = m;
    mCombinedValid = false;
}

void MatrixStack::Multiply(const QMatrix4x4 &m)
{
    mStacks[mMode].last() *= m;
    mCombinedValid = false;
}

const QMatrix4x4 &MatrixStack::Combined() const
{
    if (!mCombinedValid) {
        mCombined = mStacks[GM_Projection].last() * mStacks[GM_ModelView].last();
        mCombinedValid = true;
    }
    return mCombined;
}

QMatrix4x4 MatrixStack::FromColumnMajor(const float64 *m)
{
    // QMatrix4x4's element constructor takes rows.
    return QMatrix4x4(float(m[0]), float(m[4]), float(m[8]), float(m[12]),  //
                      float(m[1]), float(m[5]), float(m[9]), float(m[13]),  //
                      float(m[2]), float(m[6]), float(m[10]), float(m[14]), //
                      float(m[3]), float(m[7]), float(m[11]), float(m[15]));
}

QPointF MatrixStack::Project(float64 x, float64 y, float64 z) const
{
    QVector3D v = Combined().map(QVector3D(float(x), float(y), float(z)));
    return QPointF(v.x(), v.y());
}

} // namespace Graphics
} // namespace Orbane

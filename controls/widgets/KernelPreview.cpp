#include "widgets/KernelPreview.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QPaintEvent>
#include <QPainter>

#include <algorithm>
#include <cmath>

namespace Orbane {

KernelPreview::KernelPreview(QWidget *parent) : CustomControl(nullptr, ScriptVal(), TagList())
{
    setParent(parent);
    setMinimumSize(24, 24);
}

void KernelPreview::SetKernel(const Kernel &kernel)
{
    if (kernel == mKernel)
        return;
    mKernel = kernel;
    update();
}

QColor KernelPreview::CellColour(float64 weight, float64 peak)
{
    const float64 t = peak > 0.0 ? std::min(1.0, std::abs(weight) / peak) : 0.0;
    const int32 level = int32(std::lround(40 + t * 215));
    return weight < 0.0 ? QColor(level, 40, 40) : QColor(level, level, level);
}

void KernelPreview::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &painter = *BackPainter();
    const int32 n = mKernel.Size();
    const float64 side = std::min(width(), height()) / float64(n);
    float64 peak = 0.0;
    for (float64 v : mKernel.Cells())
        peak = std::max(peak, std::abs(v));
    for (int32 r = 0; r < n; ++r)
        for (int32 c = 0; c < n; ++c)
            painter.fillRect(QRectF(c * side, r * side, side - 1, side - 1), CellColour(mKernel.At(r, c), peak));
    EndDraw();
}

} // namespace Orbane

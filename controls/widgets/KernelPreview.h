#pragma once

#include "widgets/CustomControl.h"
#include "widgets/Kernel.h"

namespace Orbane {

// A picture of a kernel: one square a cell, grey for positive weights
// (white the largest), red for negative ones, so the shape of a blur or an
// edge kernel shows at a glance.
class KernelPreview : public CustomControl
{
    Q_OBJECT
public:
    explicit KernelPreview(QWidget *parent = nullptr);

    void SetKernel(const Kernel &kernel);
    const Kernel &GetKernel() const noexcept { return mKernel; }
    // The colour of a weight where `peak` is the largest magnitude.
    static QColor CellColour(float64 weight, float64 peak);

    QSize sizeHint() const override { return QSize(72, 72); }

protected:
    void paintEvent(QPaintEvent *event) override;

private:
    Kernel mKernel;
};

} // namespace Orbane

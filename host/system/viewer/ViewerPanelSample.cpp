#include "orbane/ViewerPanel.h"

namespace Orbane {

// The mean is taken over the stored, premultiplied values (the right mean
// of pixels with alpha) and given as straight colour, as a colour control
// holds it; where the box has no alpha at all the colour stays as summed.
bool ViewerPanel::SampleLinear(const QRect &pixels, std::array<float64, 4> &rgba) const
{
    const QRect area = pixels.normalized().intersected(QRect(0, 0, mLinear.Width(), mLinear.Height()));
    if (mLinear.IsNull() || area.isEmpty())
        return false;
    const FloatImage::Rgba mean = mLinear.Average(area);
    const float64 alpha = mean[3];
    for (std::size_t c = 0; c < 3; ++c)
        rgba[c] = alpha > 0.0 ? mean[c] / alpha : mean[c];
    rgba[3] = alpha;
    return true;
}

} // namespace Orbane

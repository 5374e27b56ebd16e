#include "orbane/ViewMapping.h"

#include <algorithm>

namespace Orbane {

namespace {

float64 positiveOr1(float64 v)
{
    return v > 0.0 ? v : 1.0;
}

} // namespace

ViewMapping::ViewMapping(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 zoom, OrbPoint origin,
                         float64 viewportHeight) noexcept
    : mImageWidth(std::max(imageWidth, 1)), mImageHeight(std::max(imageHeight, 1)),
      mPixelAspect(positiveOr1(pixelAspect)), mZoom(positiveOr1(zoom)), mOrigin(origin),
      mViewportHeight(std::max(viewportHeight, 0.0))
{
}

ViewMapping ViewMapping::Centered(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 zoom,
                                  float64 viewportWidth, float64 viewportHeight, OrbPoint pan) noexcept
{
    // Build once to get the tidied spans, then place the centre.
    ViewMapping m(imageWidth, imageHeight, pixelAspect, zoom, {}, viewportHeight);
    OrbPoint viewportCentre(viewportWidth / 2.0, viewportHeight / 2.0);
    m.mOrigin = viewportCentre + pan - OrbPoint(m.SpanX(), m.SpanY()) / 2.0;
    return m;
}

ViewMapping ViewMapping::Fitted(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 viewportWidth,
                                float64 viewportHeight) noexcept
{
    ViewMapping unit(imageWidth, imageHeight, pixelAspect, 1.0, {}, viewportHeight);
    float64 zoom = std::min(viewportWidth / unit.SpanX(), viewportHeight / unit.SpanY());
    return Centered(imageWidth, imageHeight, pixelAspect, zoom, viewportWidth, viewportHeight);
}

ViewMapping ViewMapping::ZoomedAbout(float64 zoom, OrbPoint anchor) const noexcept
{
    OrbPoint fixed = ToImage(anchor);
    ViewMapping m(mImageWidth, mImageHeight, mPixelAspect, zoom, {}, mViewportHeight);
    m.mOrigin = anchor - fixed.Mul({m.SpanX(), m.SpanY()});
    return m;
}

ViewMapping ViewMapping::WithViewportHeight(float64 viewportHeight) const noexcept
{
    return ViewMapping(mImageWidth, mImageHeight, mPixelAspect, mZoom, mOrigin, viewportHeight);
}

bool ViewMapping::operator==(const ViewMapping &o) const noexcept
{
    return mImageWidth == o.mImageWidth && mImageHeight == o.mImageHeight && mPixelAspect == o.mPixelAspect &&
           mZoom == o.mZoom && mOrigin == o.mOrigin && mViewportHeight == o.mViewportHeight;
}

} // namespace Orbane

#pragma once

#include "orbane/OrbPointT.h"

namespace Orbane {

// Where the viewer shows the image: the one mapping between the three
// coordinate systems that overlays and the viewer meet.
//
// Image coordinates (what Inputs hold, what PreviewInfo::MouseX/MouseY give):
//   normalised, X runs 0..1 across the image width and Y 0..1 across the
//   image height, Y up, (0, 0) the bottom-left corner and (0.5, 0.5) the
//   centre whatever the image's shape.
// Viewer coordinates (what TransformOut produces, what the painter draws in):
//   logical pixels of the viewer widget, X right, Y up, (0, 0) the widget's
//   bottom-left corner. One unit is one device-independent pixel, so a
//   handle's size in these units is its size on screen at any device pixel
//   ratio.
// Widget coordinates (what Qt mouse events carry):
//   the same pixels with Y down from the widget's top edge.
//
// Y up in viewer units keeps image and viewer offsets the same sign, so an
// overlay turns a pixel offset into image units by dividing by the spans.
//
// Non-square image pixels: one image pixel is shown PixelAspect times as wide
// as it is high (2 for a 2:1 anamorphic squeeze). SpanX and SpanY, the viewer
// units that one unit of X and one unit of Y cover, take it into account.
//
// Aspect-corrected lengths (the Aspect* functions): a length measured in
// image widths as displayed, the same on screen along both axes. A circle of
// radius r in these units is round on screen; AspectYOut(r) gives how many Y
// units it reaches up. X is the reference axis, so AspectXOut is the identity.
class ViewMapping
{
public:
    ViewMapping() noexcept = default;
    // Out-of-range input is tidied: sizes below 1 become 1, a zoom or pixel
    // aspect that is not positive becomes 1.
    ViewMapping(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 zoom, OrbPoint origin,
                float64 viewportHeight) noexcept;

    // The image centred in a viewport of the given logical size, moved by
    // `pan` viewer units (Y up).
    static ViewMapping Centered(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 zoom,
                                float64 viewportWidth, float64 viewportHeight, OrbPoint pan = {}) noexcept;
    // The largest zoom at which the whole image fits the viewport, centred.
    static ViewMapping Fitted(int32 imageWidth, int32 imageHeight, float64 pixelAspect, float64 viewportWidth,
                              float64 viewportHeight) noexcept;
    // The same view at a new zoom, keeping the image point under `anchor`
    // (viewer units) where it is: what a mouse-wheel zoom does.
    ViewMapping ZoomedAbout(float64 zoom, OrbPoint anchor) const noexcept;
    // The same view with a new viewport height (the widget was resized).
    ViewMapping WithViewportHeight(float64 viewportHeight) const noexcept;

    int32 ImageWidth() const noexcept { return mImageWidth; }
    int32 ImageHeight() const noexcept { return mImageHeight; }
    float64 PixelAspect() const noexcept { return mPixelAspect; }
    // Viewer units per image pixel, vertically.
    float64 Zoom() const noexcept { return mZoom; }
    // The image's bottom-left corner in viewer units.
    OrbPoint Origin() const noexcept { return mOrigin; }
    float64 ViewportHeight() const noexcept { return mViewportHeight; }

    float64 SpanX() const noexcept { return mImageWidth * mZoom * mPixelAspect; }
    float64 SpanY() const noexcept { return mImageHeight * mZoom; }

    float64 XToViewer(float64 x) const noexcept { return mOrigin.x + x * SpanX(); }
    float64 YToViewer(float64 y) const noexcept { return mOrigin.y + y * SpanY(); }
    float64 XToImage(float64 vx) const noexcept { return (vx - mOrigin.x) / SpanX(); }
    float64 YToImage(float64 vy) const noexcept { return (vy - mOrigin.y) / SpanY(); }
    OrbPoint ToViewer(OrbPoint image) const noexcept { return {XToViewer(image.x), YToViewer(image.y)}; }
    OrbPoint ToImage(OrbPoint viewer) const noexcept { return {XToImage(viewer.x), YToImage(viewer.y)}; }

    // Aspect-corrected length to image units of one axis, and back.
    float64 AspectXOut(float64 length) const noexcept { return length; }
    float64 AspectYOut(float64 length) const noexcept { return length * SpanX() / SpanY(); }
    float64 AspectXIn(float64 dx) const noexcept { return dx; }
    float64 AspectYIn(float64 dy) const noexcept { return dy * SpanY() / SpanX(); }

    // Widget pixels (Y down) and viewer units (Y up) differ only by the flip.
    OrbPoint WidgetToViewer(OrbPoint w) const noexcept { return {w.x, mViewportHeight - w.y}; }
    OrbPoint ViewerToWidget(OrbPoint v) const noexcept { return {v.x, mViewportHeight - v.y}; }

    bool operator==(const ViewMapping &o) const noexcept;
    bool operator!=(const ViewMapping &o) const noexcept { return !(*this == o); }

private:
    int32 mImageWidth = 1;
    int32 mImageHeight = 1;
    float64 mPixelAspect = 1.0;
    float64 mZoom = 1.0;
    OrbPoint mOrigin;
    float64 mViewportHeight = 0.0;
};

} // namespace Orbane

#pragma once

#include "orbane/GColor.h"
#include "orbane/OrbColor.h"
#include "orbane/OrbPointT.h"
#include "orbane/OrbRectT.h"
#include "orbane/ViewCamera.h"
#include "orbane/ViewMapping.h"

#include <functional>

class QCursor;
class QWidget;

namespace Orbane {

class PreviewControl;

namespace Graphics {
class GPainter;
} // namespace Graphics

// What the viewer tells an overlay on every draw and mouse call. The viewer
// fills it; overlays read it and convert coordinates through it.
//
// Coordinates are those of ViewMapping: image coordinates normalised 0..1
// across the image's width (X) and height (Y), Y up; viewer units are the
// viewer widget's logical pixels, Y up from its bottom edge. TransformOut
// goes from image to viewer, TransformIn back.
class PreviewInfo
{
public:
    using CursorHandler = std::function<void(const QCursor *)>;

    PreviewInfo();

    // The fields overlays read, named as the contract names them.
    float64 MouseX = 0.0; // image coordinates
    float64 MouseY = 0.0;
    int32 ViewWidth = 1;  // viewer units per unit of X (rounded)
    int32 ViewHeight = 1; // viewer units per unit of Y (rounded)
    int32 ImageWidth = 1; // image pixels
    int32 ImageHeight = 1;
    int32 PickTolerance = 6; // viewer units
    float32 HandleScale = 1.0f;
    int32 DrawPass = 1; // 1, 2 ordinary passes; 3: plain 2D handles draw nothing
    PreviewControl *HotControl = nullptr;
    uint8 Highlight = 0;
    uint8 ShowDrag = 0;
    OrbColor OverlayColor{230, 230, 230, 255};
    OrbColor ShadowColor{0, 0, 0, 160};

    // The view. Setting it also sets ViewWidth, ViewHeight, ImageWidth and
    // ImageHeight, which are derived from it.
    void SetMapping(const ViewMapping &mapping);
    const ViewMapping &Mapping() const { return mMapping; }
    // Sets MouseX, MouseY from a position in viewer units, and reads it back.
    void SetMouseFromViewer(OrbPoint viewer);
    OrbPoint MouseInViewer() const { return TransformOut(MouseX, MouseY); }

    // The camera 3D overlays are seen through (ViewCamera::Default() unless
    // the viewer was given another); world -> image through it, then image
    // -> viewer through the mapping.
    const ViewCamera &Camera() const { return mCamera; }
    void SetCamera(const ViewCamera &camera) { mCamera = camera; }

    // Image -> viewer.
    OrbPoint TransformOut(float64 x, float64 y) const { return mMapping.ToViewer({x, y}); }
    OrbPoint TransformOut(const OrbPoint &p) const { return mMapping.ToViewer(p); }
    // z (a depth in image widths, for 3D gizmos) scales with X and is not moved.
    void TransformOut(float64 &x, float64 &y, float64 &z) const;
    OrbRect TransformOut(const OrbRect &r) const;
    float64 TransformXOut(float64 x) const { return mMapping.XToViewer(x); }
    float64 TransformYOut(float64 y) const { return mMapping.YToViewer(y); }

    // Viewer -> image.
    OrbPoint TransformIn(float64 x, float64 y) const { return mMapping.ToImage({x, y}); }
    OrbPoint TransformIn(const OrbPoint &p) const { return mMapping.ToImage(p); }
    void TransformIn(float64 &x, float64 &y, float64 &z) const;
    OrbRect TransformIn(const OrbRect &r) const;
    float64 TransformXIn(float64 x) const { return mMapping.XToImage(x); }
    float64 TransformYIn(float64 y) const { return mMapping.YToImage(y); }

    // Aspect-corrected lengths (see ViewMapping) to image units of one axis
    // (Out) and back (In).
    float64 AspectScaleXOut(float64 length) const { return mMapping.AspectXOut(length); }
    float64 AspectScaleYOut(float64 length) const { return mMapping.AspectYOut(length); }
    float64 AspectScaleXIn(float64 dx) const { return mMapping.AspectXIn(dx); }
    float64 AspectScaleYIn(float64 dy) const { return mMapping.AspectYIn(dy); }

    // Painter colours: `c`, or the overlay colour when `c` is "no colour";
    // and the shadow that goes with it (the shadow colour, faded as much as
    // `c` is transparent).
    Graphics::GColor GetColor(OrbColor c) const;
    Graphics::GColor GetShadow(OrbColor c) const;

    // The viewer's cursor; null restores the viewer's own. Does nothing when
    // the viewer set no handler.
    void SetCursor(const QCursor *cursor) const;
    void SetCursorHandler(CursorHandler handler) { mCursorHandler = std::move(handler); }

    // The viewer's widget, under which overlays open their dialogs: they are
    // then windows of the application (scripts find their parts by object
    // name) and go with it. Null where no viewer shows the overlay.
    QWidget *DialogParent() const { return mDialogParent; }
    void SetDialogParent(QWidget *parent) { mDialogParent = parent; }

    // The painter of the pass being drawn; null outside draw passes.
    Graphics::GPainter *GetPainter() const { return mPainter; }
    void SetPainter(Graphics::GPainter *painter) { mPainter = painter; }

private:
    ViewMapping mMapping;
    ViewCamera mCamera = ViewCamera::Default();
    Graphics::GPainter *mPainter = nullptr;
    CursorHandler mCursorHandler;
    QWidget *mDialogParent = nullptr;
};

} // namespace Orbane

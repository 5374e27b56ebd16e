#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

namespace Orbane {

// What places a transformed layer: the layer's point `pivot` (0..1 across
// it) lands on `center` (image coordinates); about it the layer is scaled by
// `size`, sheared (X moves by `shear` times Y) and turned by `angle` degrees
// counter-clockwise. `frame` is the layer's size in image widths as
// displayed, so the frame stays rigid on screen as it turns.
struct TransformShape
{
    OrbPoint center{0.5, 0.5};
    OrbPoint pivot{0.5, 0.5};
    OrbPoint size{1.0, 1.0};
    float64 angle = 0.0;
    float64 shear = 0.0;
    OrbPoint frame{1.0, 1.0};
};

// A drag's new scale, and the centre that keeps the opposite side in place
// (the old centre where the scale is about the pivot).
struct TransformScale
{
    OrbPoint size;
    OrbPoint center;
};

// The transform's mapping between layer points (0..1), image coordinates
// and its "arm" space: aspect-corrected units from the centre with the turn
// taken back, where the sheared, scaled layer lies upright. `yPerX` is how
// many image Y units one aspect-corrected unit spans (the view's
// AspectScaleYOut(1)). Pure, so that every handle's effect is checked alone.
class TransformFrame
{
public:
    TransformFrame(const TransformShape &shape, float64 yPerX) noexcept;

    OrbPoint ToImage(OrbPoint layer) const noexcept;
    OrbPoint ToLayer(OrbPoint image) const noexcept;
    // Image coordinates into arm space and back.
    OrbPoint ToArm(OrbPoint image) const noexcept;
    OrbPoint FromArm(OrbPoint arm) const noexcept;
    // A layer point relative to the pivot, before scaling (aspect units).
    OrbPoint Reach(OrbPoint layer) const noexcept;
    // False where anything it was made from is not a finite number, or the
    // layer is flat (a zero size or frame).
    bool IsValid() const noexcept { return mValid; }
    const TransformShape &Shape() const noexcept { return mShape; }

    // The scale that puts the side (`side` -1, 0 or +1 on each axis) under
    // `image`. `uniform`: both axes by the factor of the dragged one (X for
    // a corner); `aboutOpposite`: the opposite side stays where it is, and
    // the centre moves. An axis that cannot change (not dragged, or the
    // pivot on the dragged side) keeps its size.
    TransformScale Scaled(OrbPoint image, OrbPointI side, bool uniform, bool aboutOpposite) const noexcept;
    // The shear that puts the knob above the top edge's middle under
    // `image`; the old shear where the mouse is level with the centre.
    float64 Sheared(OrbPoint image) const noexcept;
    // The knob of the shear bar: `out` aspect units beyond the top edge's
    // middle, along the layer's sheared vertical.
    OrbPoint ShearKnob(float64 out) const noexcept;
    // The pivot that keeps the layer in place when the centre moves to
    // `image`: the layer point now there.
    OrbPoint PivotAt(OrbPoint image) const noexcept { return ToLayer(image); }

private:
    OrbPoint Turn(OrbPoint v, float64 sign) const noexcept;
    float64 ScaleOf(float64 arm, float64 reachSide, float64 reachOpposite, float64 size, bool aboutOpposite) const;

    TransformShape mShape;
    float64 mYPerX = 1.0;
    float64 mCos = 1.0, mSin = 0.0;
    bool mValid = true;
};

} // namespace Orbane

#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

namespace Orbane {

// Part codes of the rectangle: one bit per side, a corner has two.
enum RectanglePart : int32
{
    RPART_None = 0,
    RPART_PlusX = 1,
    RPART_PlusY = 2,
    RPART_MinusX = 4,
    RPART_MinusY = 8,
    RPART_XSides = RPART_PlusX | RPART_MinusX,
    RPART_YSides = RPART_PlusY | RPART_MinusY,
};

// What places and sizes the rectangle. Width and height are lengths in image
// widths as displayed (the same on screen along both axes, so the shape
// stays rigid when it turns, also on non-square pixels); the centre is in
// image coordinates; the axis is the point of the rectangle (0..1 across
// each side) that sits on the centre and about which it turns.
struct RectangleShape
{
    OrbPoint center{0.5, 0.5};
    float64 angle = 0.0; // degrees, counter-clockwise
    float64 size = 1.0;
    OrbPoint axis{0.5, 0.5};
    float64 width = 0.0;
    float64 height = 0.0;
    OrbPoint displayScale{1.0, 1.0};
    bool flipX = false;
    bool flipY = false;
};

// The rectangle's own frame: origin on the centre (the pivot), X along its
// width, in square image pixels (one unit is one image pixel high). The flips
// mirror the frame about the pivot, so the +X side of a flipped rectangle
// lies on the left.
class RectangleFrame
{
public:
    RectangleFrame(const RectangleShape &shape, int32 imageWidth, int32 imageHeight, float64 pixelAspect) noexcept;

    OrbPoint ToFrame(OrbPoint image) const noexcept;
    OrbPoint ToImage(OrbPoint frame) const noexcept;
    // Half the drawn sides: width (height) x size x display scale / 2.
    OrbPoint Half() const noexcept { return mHalf; }
    // The rectangle's middle; it lies off the pivot unless the axis is 0.5.
    OrbPoint Middle() const noexcept { return mMiddle; }
    // The point (u, v) of the rectangle, -1..1 from the middle across each
    // half side, in image coordinates.
    OrbPoint At(float64 u, float64 v) const noexcept;
    // Frame units per image width.
    float64 Unit() const noexcept { return mUnit; }
    OrbPoint Axis() const noexcept { return mAxis; }
    // False where anything it was made from is not a finite number.
    bool IsValid() const noexcept { return mValid; }

private:
    OrbPoint mCenter;
    OrbPoint mPixels; // frame units per image unit, X and Y
    float64 mCos = 1.0, mSin = 0.0;
    OrbPoint mFlip{1.0, 1.0};
    OrbPoint mHalf;
    OrbPoint mMiddle;
    OrbPoint mAxis;
    float64 mUnit = 1.0;
    bool mValid = true;
};

// The pick tolerance in frame units: `pickTolerance` viewer pixels divided
// by how many viewer pixels one frame unit spans on each axis.
OrbPoint RectangleTolerance(float64 pickTolerance, OrbPoint viewScale) noexcept;

// The radius of the corners' hit zones: `cornerRound` of the smaller half side.
float64 RectangleCornerRadius(OrbPoint half, float64 cornerRound) noexcept;

// From `local` (frame units from the rectangle's middle) to the sides `part` names (the sides' ends pulled
// in along the diagonal by (1 - sqrt(2)/2) x radius at a corner); 0 on an
// axis the part does not name.
OrbPoint RectangleGrabOffset(OrbPoint local, int32 part, OrbPoint half, float64 cornerRound) noexcept;

// The drawn length of one side pair after a drag that put the grabbed side
// at `pivotLocal` (frame units from the pivot, along that axis) and
// `middleLocal` (the same from the middle): measured from the pivot to the
// side that `sideBits` name (+1, -1; 0: that axis is not dragged), or, when
// the axis lies outside 0..1, the side the mouse is on. In image widths;
// false where the axis is not dragged or the pivot sits on that side.
bool RectangleResizedSide(float64 pivotLocal, float64 middleLocal, float64 axis, int32 sideBits, float64 unit,
                          float64 &length) noexcept;

// The side bits of one axis of a part code: +1, -1 or 0.
int32 RectangleSideX(int32 part) noexcept;
int32 RectangleSideY(int32 part) noexcept;

// Locked aspect: the width is the larger of height x aspect and width; the
// height follows from it.
OrbPoint RectangleLockedSize(float64 width, float64 height, float64 aspect) noexcept;

} // namespace Orbane

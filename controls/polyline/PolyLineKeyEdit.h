#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

class PolyLine;
class PolyLineControl;

// The polyline overlay's edits of its shape's keyframes: smoothing and
// easing the motion of the selected points (of every point where none is
// selected), deleting keyframes, going to one, and turning the shape into
// an XY path. Each edit is one undo step under its own name, through the
// Input's keyframe API; one that cannot act tells the user why and answers
// false, changing nothing.
class PolyLineKeyEdit
{
public:
    explicit PolyLineKeyEdit(PolyLineControl &control) : mControl(control) {}

    // "Smooth Animation" (PolyLineAnimation::SmoothKeys on every key).
    bool SmoothAnimation(float64 amount, int32 passes);
    // "Ease In / Out": the inner keys take the shape the motion has at
    // their eased time, so the points leave the first key and reach the
    // last slowly; the first and last keys stay.
    bool EaseInOut(float64 in, float64 out);
    // "Delete Keyframes": removes the keys at `times`; removing every key
    // ends the animation and keeps the shape shown now.
    bool DeleteKeys(const std::vector<float64> &times);
    // Sets the document's time (no undo step: time is not an edit).
    bool JumpTo(float64 time);
    // "Convert to XYPath": the key points, in order, become the keys of the
    // tool's number Inputs <Input>X and <Input>Y (made where missing), one
    // frame apart from the current time; a closed shape ends where it began.
    bool ToXYPath();

private:
    bool Refuse(const char *why);
    // The keys and their shapes, all with the same point count; refuses
    // with fewer than three keys.
    bool Gather(const char *what, std::vector<float64> &times, std::vector<AutoRef<PolyLine>> &shapes);
    // One selection byte per point: the selected points, or all of them.
    std::vector<uint8> Points(int32 count) const;
    bool WriteKeys(const char *undo, const std::vector<float64> &times, const std::vector<AutoRef<PolyLine>> &shapes);

    PolyLineControl &mControl;
};

} // namespace Orbane

#pragma once

#include "orbane/Types.h"

namespace Orbane {

class PolyLine;

// Grows (or with a negative amount shrinks) a shape by a distance, for the
// outer (feather) shape of a mask. The offsetting is Clipper's: the shape
// is flattened, offset with round joins (an open shape gets round ends),
// and the largest resulting outline is fitted back to Bezier key points.
class ShapeExpand
{
public:
    // A new closed shape (one reference), or null where nothing is left
    // (a shape shrunk away, an empty shape). `tolerance` is how far the
    // fitted outline may stray from the offset one.
    static PolyLine *Expand(const PolyLine &shape, float64 amount, float64 tolerance);
};

} // namespace Orbane

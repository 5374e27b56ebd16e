#pragma once

#include "orbane/AutoRef.h"
#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

class PolyLine;

// Pen values a freehand stroke keeps per key point (the record flags).
enum PolyLineRecord : uint32
{
    PLR_Time = 1,
    PLR_Pressure = 2,
};

// The gesture that creates points, from press to release, and the new
// shapes it makes. Every shape made is a new value (the old one is never
// changed), ready to be written to the Input.
class PolyLineCreation
{
public:
    enum Gesture : int32
    {
        PCG_None,
        PCG_Click,  // a point was added; a drag pulls out its handles
        PCG_Close,  // the press closed the shape
        PCG_Stroke, // a freehand stroke is being drawn
        PCG_Move,   // a key point or a handle end is dragged
        PCG_Edit,   // the shape's editing gestures have the mouse
    };

    // One sample of a freehand stroke: where (image coordinates), when
    // (seconds from the stroke's start) and how hard the pen pressed.
    struct Sample
    {
        OrbPoint at;
        float64 time = 0.0;
        float64 pressure = 1.0;
    };

    // --- Click Append ---
    // `shape` (a new Bezier shape where null) with a corner point at `at`
    // appended.
    static AutoRef<PolyLine> Appended(const PolyLine *shape, OrbPoint at);
    // `shape` with the handles of point `index` pulled out smooth: the out
    // handle at `to`, the in handle mirrored through the point.
    static AutoRef<PolyLine> Pulled(const PolyLine &shape, int32 index, OrbPoint to);
    static AutoRef<PolyLine> Closed(const PolyLine &shape);
    // `shape` with point `index` (part 1: with its handles) or one of its
    // handle ends (part 2: in, 4: out) moved to `to`.
    static AutoRef<PolyLine> Moved(const PolyLine &shape, int32 index, uint32 part, OrbPoint to);

    // --- Draw Append ---
    void BeginStroke(const Sample &first);
    // Takes a sample `minStep` image units or more from the last; true where taken.
    bool AddSample(const Sample &s, OrbPoint minStep);
    const std::vector<Sample> &Stroke() const { return mStroke; }
    void DropLastSample() { mStroke.pop_back(); }
    std::vector<OrbPoint> StrokePoints() const;
    // `shape` with the stroke appended: fitted by the host with Bezier key
    // points within `tolerance` viewer pixels of every sample (`pixel`: one
    // viewer pixel in image units, per axis), closed where `closed` and the
    // stroke is the whole shape; or every sample a corner at tolerance 0.
    // `record` (PolyLineRecord bits) says which pen values the points keep.
    AutoRef<PolyLine> WithStroke(const PolyLine *shape, OrbPoint pixel, float64 tolerance, uint32 record,
                                 bool closed) const;

    Gesture gesture = PCG_None;
    int32 index = -1; // the point the gesture works on
    uint32 part = 0;  // PCG_Move: what of it

private:
    std::vector<Sample> mStroke;
};

} // namespace Orbane

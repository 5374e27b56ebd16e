#pragma once

#include "orbane/OrbPointT.h"

#include <functional>
#include <vector>

namespace Orbane {

// A bounding-box hierarchy over the segments of a shape, so that the
// segment nearest to a point is found by visiting a handful of boxes
// instead of every segment: each segment lies inside its box (its hull's),
// and a box farther away than the best distance so far is skipped whole.
class SegmentIndex
{
public:
    struct Box
    {
        float64 x0, y0, x1, y1;
        float64 Dist2(const OrbPoint &p) const noexcept;
    };
    // The exact squared distance from the query point to one segment.
    using SegmentDist2 = std::function<float64(int32 seg)>;

    explicit SegmentIndex(std::vector<Box> segments);

    // The segment nearest to `p` by `exact` (its squared distance in
    // `dist2`), or -1 for an index of no segments.
    int32 Nearest(const OrbPoint &p, const SegmentDist2 &exact, float64 &dist2) const;
    int32 Count() const noexcept { return int32(mBoxes.size()); }

private:
    struct Node
    {
        Box box;
        int32 first, count; // a leaf's range in mOrder
        int32 left, right;  // children of an inner node, -1 in a leaf
    };
    int32 Build(int32 first, int32 count);

    std::vector<Box> mBoxes;
    std::vector<int32> mOrder;
    std::vector<Node> mNodes;
};

} // namespace Orbane

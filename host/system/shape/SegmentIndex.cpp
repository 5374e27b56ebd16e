#include "SegmentIndex.h"

#include <algorithm>
#include <limits>

namespace Orbane {

namespace {

// Segments per leaf: few enough that a leaf costs little to test exactly,
// enough that the tree stays shallow.
constexpr int32 kLeafSize = 4;

SegmentIndex::Box Merge(const SegmentIndex::Box &a, const SegmentIndex::Box &b)
{
    return {std::min(a.x0, b.x0), std::min(a.y0, b.y0), std::max(a.x1, b.x1), std::max(a.y1, b.y1)};
}

} // namespace

float64 SegmentIndex::Box::Dist2(const OrbPoint &p) const noexcept
{
    const float64 dx = std::max({x0 - p.x, 0.0, p.x - x1});
    const float64 dy = std::max({y0 - p.y, 0.0, p.y - y1});
    return dx * dx + dy * dy;
}

SegmentIndex::SegmentIndex(std::vector<Box> segments) : mBoxes(std::move(segments))
{
    mOrder.resize(mBoxes.size());
    for (std::size_t i = 0; i < mOrder.size(); ++i)
        mOrder[i] = int32(i);
    mNodes.reserve(mBoxes.size() / 2 + 1);
    if (!mBoxes.empty())
        Build(0, int32(mBoxes.size()));
}

// Splits at the median of the box centres along the wider axis.
int32 SegmentIndex::Build(int32 first, int32 count)
{
    Box box = mBoxes[std::size_t(mOrder[std::size_t(first)])];
    for (int32 i = first + 1; i < first + count; ++i)
        box = Merge(box, mBoxes[std::size_t(mOrder[std::size_t(i)])]);
    const int32 self = int32(mNodes.size());
    mNodes.push_back({box, first, count, -1, -1});
    if (count <= kLeafSize)
        return self;
    const bool alongX = box.x1 - box.x0 >= box.y1 - box.y0;
    auto centre = [&](int32 s) {
        const Box &b = mBoxes[std::size_t(s)];
        return alongX ? b.x0 + b.x1 : b.y0 + b.y1;
    };
    const auto begin = mOrder.begin() + first, mid = begin + count / 2;
    std::nth_element(begin, mid, begin + count, [&](int32 a, int32 b) { return centre(a) < centre(b); });
    const int32 left = Build(first, count / 2);
    const int32 right = Build(first + count / 2, count - count / 2);
    mNodes[std::size_t(self)].left = left;
    mNodes[std::size_t(self)].right = right;
    return self;
}

int32 SegmentIndex::Nearest(const OrbPoint &p, const SegmentDist2 &exact, float64 &dist2) const
{
    dist2 = std::numeric_limits<float64>::infinity();
    int32 best = -1;
    if (mNodes.empty())
        return best;
    std::vector<int32> stack{0};
    while (!stack.empty()) {
        const Node &n = mNodes[std::size_t(stack.back())];
        stack.pop_back();
        if (n.box.Dist2(p) >= dist2)
            continue;
        if (n.left < 0) {
            for (int32 i = n.first; i < n.first + n.count; ++i) {
                const int32 seg = mOrder[std::size_t(i)];
                if (mBoxes[std::size_t(seg)].Dist2(p) >= dist2)
                    continue;
                const float64 d = exact(seg);
                if (d < dist2)
                    dist2 = d, best = seg;
            }
            continue;
        }
        // The nearer child goes on top, so it is searched first and its
        // result prunes the other.
        const Node &l = mNodes[std::size_t(n.left)], &r = mNodes[std::size_t(n.right)];
        const bool leftFirst = l.box.Dist2(p) <= r.box.Dist2(p);
        stack.push_back(leftFirst ? n.right : n.left);
        stack.push_back(leftFirst ? n.left : n.right);
    }
    return best;
}

} // namespace Orbane

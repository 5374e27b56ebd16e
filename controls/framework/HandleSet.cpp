#include "framework/HandleSet.h"

#include <algorithm>

namespace Orbane {

Handle &HandleSet::Add(const Handle &handle)
{
    mHandles.push_back(handle);
    return mHandles.back();
}

Handle &HandleSet::Start(HandleShape shape, OrbPoint at, uint32 part, int32 priority)
{
    Handle h;
    h.shape = shape;
    h.at = at;
    h.part = part;
    h.priority = priority;
    return Add(h);
}

Handle &HandleSet::AddBox(OrbPoint at, OrbPoint lo, OrbPoint hi, uint32 part, int32 priority, uint8 grow)
{
    Handle &h = Start(HSH_Box, at, part, priority);
    h.lo = lo;
    h.hi = hi;
    h.grow = grow;
    return h;
}

Handle &HandleSet::AddPixelSquare(OrbPoint at, uint32 part, int32 priority)
{
    return Start(HSH_PixelSquare, at, part, priority);
}

Handle &HandleSet::AddRing(OrbPoint at, float64 radius, uint32 part, int32 priority)
{
    Handle &h = Start(HSH_Ring, at, part, priority);
    h.radius = radius;
    return h;
}

Handle &HandleSet::AddDisc(OrbPoint at, float64 radius, uint32 part, int32 priority)
{
    Handle &h = AddRing(at, radius, part, priority);
    h.shape = HSH_Disc;
    return h;
}

Handle &HandleSet::AddBand(OrbPoint from, OrbPoint to, float64 extend, uint32 part, int32 priority)
{
    Handle &h = AddRing(from, extend, part, priority);
    h.shape = HSH_Band;
    h.end = to;
    return h;
}

Handle &HandleSet::AddBoxPart(OrbPoint at, OrbPoint unitX, OrbPoint half, float64 reach, OrbPointI side, uint32 part,
                              int32 priority)
{
    Handle &h = Start(side.x || side.y ? HSH_Outline : HSH_Inside, at, part, priority);
    h.frameX = unitX;
    h.frameY = OrbPoint(-unitX.y, unitX.x);
    h.half = half;
    h.reach = OrbPoint(reach, reach);
    h.sideX = int8(side.x);
    h.sideY = int8(side.y);
    return h;
}

const Handle *HandleSet::Find(uint32 part, int32 item) const
{
    for (const Handle &h : mHandles)
        if (h.part == part && h.item == item)
            return &h;
    return nullptr;
}

HandleHit HandleSet::HitTest(OrbPoint mouse, float64 scale, float64 tolerance, HandleGeometry::Reach reach) const
{
    const Handle *best = nullptr;
    for (const Handle &h : mHandles)
        if ((!best || h.priority > best->priority) && HandleGeometry::Hits(h, mouse, scale, tolerance, reach))
            best = &h;
    return best ? HandleHit{best->part, best->item} : HandleHit{};
}

bool HandleSet::Bounds(float64 scale, float64 tolerance, OrbRect &bounds) const
{
    bounds = OrbRect(1.0, 1.0, 0.0, 0.0);
    for (std::size_t i = 0; i < mHandles.size(); ++i) {
        const OrbRect e = HandleGeometry::Extent(mHandles[i], scale, tolerance);
        bounds = i == 0 ? e
                        : OrbRect(std::min(bounds.x1, e.x1), std::min(bounds.y1, e.y1), std::max(bounds.x2, e.x2),
                                  std::max(bounds.y2, e.y2));
    }
    return !mHandles.empty();
}

bool HandleSet::SetPoised(HandleHit hit)
{
    if (hit == mPoised)
        return false;
    mPoised = hit;
    return true;
}

bool HandleSet::SetPicked(HandleHit hit)
{
    if (hit == mPicked)
        return false;
    mPicked = hit;
    return true;
}

HandleSet::State HandleSet::StateOf(uint32 part, int32 item) const
{
    const HandleHit h{part, item};
    if (mPicked && mPicked == h)
        return HS_Picked;
    if (mPoised && mPoised == h)
        return HS_Poised;
    return HS_Idle;
}

Graphics::GColor HandleSet::FillOf(const Graphics::GColor &fill, uint32 part, int32 item) const
{
    return StateOf(part, item) == HS_Idle ? fill : Highlight.WithAlpha(fill.a);
}

} // namespace Orbane

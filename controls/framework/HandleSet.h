#pragma once

#include "framework/HandleGeometry.h"

#include "orbane/GColor.h"

#include <vector>

namespace Orbane {

// The handles of one overlay and their state. The overlay rebuilds the
// handles where its values put them (Clear, Add...) before each test; the
// state survives a rebuild:
//   idle -> poised (the mouse is over it: a press would pick it; what the
//   viewer's hover test reports) -> picked (pressed, held until release).
// The setters answer whether the state changed, so that an overlay repaints
// only then.
class HandleSet
{
public:
    enum State : int32
    {
        HS_Idle,
        HS_Poised,
        HS_Picked,
    };

    // The colour of a poised or picked handle; it keeps the alpha of the
    // colour it replaces, so it fades with the overlay.
    static constexpr Graphics::GColor Highlight{1.0f, 0.8f, 0.25f};

    // --- building ---
    // Drops the handles, keeps the state.
    void Clear() { mHandles.clear(); }
    Handle &Add(const Handle &handle);
    // A box about `at` from `lo` to `hi` handle pixels (the tolerance added
    // on the sides of `grow` for a press, on all for hover).
    Handle &AddBox(OrbPoint at, OrbPoint lo, OrbPoint hi, uint32 part, int32 priority, uint8 grow = HG_All);
    // The point's square: whole units within the tolerance.
    Handle &AddPixelSquare(OrbPoint at, uint32 part, int32 priority = HP_Point);
    Handle &AddRing(OrbPoint at, float64 radius, uint32 part, int32 priority = HP_Edge);
    Handle &AddDisc(OrbPoint at, float64 radius, uint32 part, int32 priority = HP_Point);
    Handle &AddBand(OrbPoint from, OrbPoint to, float64 extend, uint32 part, int32 priority = HP_Edge);
    // A part of a box about `at` (viewer units) whose X side runs along the
    // unit vector `unitX` and whose Y side along its left normal, with half
    // sides `half` (viewer units): its outline's side or corner `side`
    // (HSH_Outline, within `reach` of it), or with side 0, 0 its inside out
    // to `reach` beyond it (HSH_Inside).
    Handle &AddBoxPart(OrbPoint at, OrbPoint unitX, OrbPoint half, float64 reach, OrbPointI side, uint32 part,
                       int32 priority);
    // The handle of `part` (and `item`), or null: where the overlay put it.
    const Handle *Find(uint32 part, int32 item = -1) const;
    const std::vector<Handle> &Handles() const { return mHandles; }
    bool Empty() const { return mHandles.empty(); }

    // --- testing: pure functions of the mouse (viewer units), the handle
    // scale and the viewer's tolerance ---
    // The hit handle of the highest priority; the first added among equals.
    HandleHit HitTest(OrbPoint mouse, float64 scale, float64 tolerance, HandleGeometry::Reach reach) const;
    // The union of every handle's extent at hover reach; false (and an
    // empty rectangle) when there is no handle.
    bool Bounds(float64 scale, float64 tolerance, OrbRect &bounds) const;

    // --- state ---
    HandleHit PoisedHit() const { return mPoised; }
    HandleHit PickedHit() const { return mPicked; }
    bool SetPoised(HandleHit hit);
    bool SetPicked(HandleHit hit);
    // Picked wins over poised.
    State StateOf(uint32 part, int32 item = -1) const;
    // `fill` for an idle handle, the highlight (with fill's alpha) for a
    // poised or picked one.
    Graphics::GColor FillOf(const Graphics::GColor &fill, uint32 part, int32 item = -1) const;

private:
    // A handle of `shape` at `at`, added; the shape's own fields follow.
    Handle &Start(HandleShape shape, OrbPoint at, uint32 part, int32 priority);

    std::vector<Handle> mHandles;
    HandleHit mPoised;
    HandleHit mPicked;
};

} // namespace Orbane

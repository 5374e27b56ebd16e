#pragma once

#include "orbane/OrbRectT.h"
#include "orbane/ViewMapping.h"

#include <unordered_map>
#include <vector>

namespace Orbane {

class PreviewControl;
class PreviewInfo;

// Narrows the viewer's hover walk to the overlays that can answer it.
//
// Each overlay tells where its handles are (HoverBounds); a uniform grid of
// cells over the visible part of the viewer lists the overlays whose bounds
// touch each cell. A hover then asks CCMD_HitTest, topmost first with the
// claimed bit passed along as the plain walk over every overlay does, of:
//   - the overlays with no bounds (they fade, or keep the base's answer),
//   - the overlays whose bounds hold the mouse,
//   - the overlays that claimed the mouse or asked for a redraw last time,
//     so that they can let go of their hover.
// Any other overlay would answer "not hit, nothing changed", so the answers
// are those of the plain walk.
//
// Bounds go stale when an overlay asks for a redraw (its handles may have
// moved: Touch) and all of them when the view, the tolerance, the handle
// scale or the list of overlays changes. A few touched overlays are tested
// by their fresh bounds beside the grid; many rebuild it.
class HoverIndex
{
public:
    struct Result
    {
        PreviewControl *hover = nullptr; // the overlay that claimed the mouse
        bool redraw = false;             // some overlay asked for a redraw
        int32 asked = 0;                 // how many overlays were asked
    };

    // Cells are this many viewer units square, unless the area needs more
    // than MaxCells of them across. Measured from 16 to 128: the hover's
    // cost is the overlays it asks, which the bounds test fixes whatever
    // the cell; 32 (a few handles across) keeps cell lists short and the
    // grid small.
    static constexpr float64 CellSize = 32.0;
    static constexpr int32 MaxCells = 128;

    // The overlays changed: rebuild before the next hover.
    void Reset() { mValid = false; }
    // `overlay`'s handles may have moved.
    void Touch(const PreviewControl *overlay);

    // The hover walk over `overlays` (creation order: the last is topmost)
    // at info's mouse; `area` is the visible part of the viewer, viewer units.
    Result Hover(const std::vector<PreviewControl *> &overlays, PreviewInfo &info, const OrbRect &area);
    // The same walk asking every switched-on overlay.
    static Result PlainHover(const std::vector<PreviewControl *> &overlays, PreviewInfo &info);

private:
    struct Entry
    {
        PreviewControl *overlay = nullptr;
        OrbRect bounds;
        bool bounded = false;
        bool stale = false; // touched since the grid was built: tested by its bounds alone
        bool dirty = false; // touched since its bounds were taken
    };

    bool NeedsRebuild(const std::vector<PreviewControl *> &overlays, const PreviewInfo &info,
                      const OrbRect &area) const;
    void Rebuild(const std::vector<PreviewControl *> &overlays, const PreviewInfo &info, const OrbRect &area);
    void Refresh(Entry &entry, const PreviewInfo &info);
    void FillGrid();
    bool CellOf(OrbPoint p, int32 &col, int32 &row) const;
    void Collect(OrbPoint mouse, std::vector<int32> &out) const;

    std::vector<Entry> mEntries; // in the overlays' order
    std::unordered_map<const PreviewControl *, int32> mSlots;
    std::vector<int32> mUnbounded;
    std::vector<int32> mStale;
    std::vector<PreviewControl *> mSticky;     // claimed or asked for a redraw last time
    std::vector<PreviewControl *> mPrevSticky; // scratch

    // The grid: cell (col, row) lists mCellItems[mCellStart[c] .. mCellStart[c + 1]).
    OrbRect mArea;
    float64 mCell = CellSize;
    int32 mCols = 0, mRows = 0;
    std::vector<int32> mCellStart;
    std::vector<int32> mCellItems;
    std::vector<int32> mWide; // bounds over too many cells: tested one by one

    // What the bounds were taken with.
    bool mValid = false;
    ViewMapping mMapping;
    int32 mTolerance = 0;
    float32 mScale = 0.0f;
    OrbRect mBuiltArea;
    std::vector<int32> mCandidates; // scratch
};

} // namespace Orbane

#include "HoverIndex.h"

#include "orbane/ControlCommands.h"
#include "orbane/PreviewControl.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>
#include <functional>

namespace Orbane {

namespace {

// Bounds over more cells than this are tested one by one instead.
constexpr int32 kWideCells = 256;
// Touched overlays beyond this share (and a floor) rebuild the grid.
constexpr std::size_t kStaleFloor = 16, kStaleShare = 8;

bool IsEmpty(const OrbRect &r)
{
    return r.x2 < r.x1 || r.y2 < r.y1;
}

OrbRect Intersect(const OrbRect &a, const OrbRect &b)
{
    return {std::max(a.x1, b.x1), std::max(a.y1, b.y1), std::min(a.x2, b.x2), std::min(a.y2, b.y2)};
}

// One overlay's answer to the hover test, with the claimed bit passed
// along. True where it claimed the mouse or asked for a redraw: it must be
// asked again next time, to let go.
bool Ask(PreviewControl *overlay, PreviewInfo &info, HoverIndex::Result &result)
{
    const uint64 claimed = result.hover ? 1 : 0;
    const uint64 answer = overlay->ControlCommand(&info, CCMD_HitTest, claimed, nullptr);
    ++result.asked;
    result.redraw |= (answer & 2) != 0;
    const bool claims = !claimed && (answer & 1);
    if (claims)
        result.hover = overlay;
    return claims || (answer & 2);
}

// A switched-off overlay keeps the hover it had: it stays to be asked once
// it is back.
bool IsIn(const std::vector<PreviewControl *> &list, const PreviewControl *overlay)
{
    return std::find(list.begin(), list.end(), overlay) != list.end();
}

} // namespace

void HoverIndex::Touch(const PreviewControl *overlay)
{
    const auto it = mSlots.find(overlay);
    if (!mValid || it == mSlots.end())
        return;
    Entry &entry = mEntries[std::size_t(it->second)];
    if (!entry.stale)
        mStale.push_back(it->second);
    entry.stale = true;
    entry.dirty = true;
}

HoverIndex::Result HoverIndex::Hover(const std::vector<PreviewControl *> &overlays, PreviewInfo &info,
                                     const OrbRect &area)
{
    if (NeedsRebuild(overlays, info, area))
        Rebuild(overlays, info, area);
    for (const int32 i : mStale)
        if (mEntries[std::size_t(i)].dirty)
            Refresh(mEntries[std::size_t(i)], info);
    Collect(info.MouseInViewer(), mCandidates);
    Result result;
    mPrevSticky.swap(mSticky);
    mSticky.clear();
    for (const int32 i : mCandidates) {
        PreviewControl *overlay = mEntries[std::size_t(i)].overlay;
        if (overlay->IsActive() ? Ask(overlay, info, result) : IsIn(mPrevSticky, overlay))
            mSticky.push_back(overlay);
    }
    return result;
}

HoverIndex::Result HoverIndex::PlainHover(const std::vector<PreviewControl *> &overlays, PreviewInfo &info)
{
    Result result;
    for (auto it = overlays.rbegin(); it != overlays.rend(); ++it)
        if ((*it)->IsActive())
            Ask(*it, info, result);
    return result;
}

bool HoverIndex::NeedsRebuild(const std::vector<PreviewControl *> &overlays, const PreviewInfo &info,
                              const OrbRect &area) const
{
    return !mValid || overlays.size() != mEntries.size() || !(info.Mapping() == mMapping) ||
           info.PickTolerance != mTolerance || info.HandleScale != mScale || area != mBuiltArea ||
           mStale.size() > std::max(kStaleFloor, mEntries.size() / kStaleShare);
}

void HoverIndex::Rebuild(const std::vector<PreviewControl *> &overlays, const PreviewInfo &info, const OrbRect &area)
{
    mValid = true;
    mMapping = info.Mapping();
    mTolerance = info.PickTolerance;
    mScale = info.HandleScale;
    mBuiltArea = area;
    mEntries.assign(overlays.size(), Entry());
    mSlots.clear();
    mStale.clear();
    for (std::size_t i = 0; i < overlays.size(); ++i) {
        mEntries[i].overlay = overlays[i];
        mSlots[overlays[i]] = int32(i);
        Refresh(mEntries[i], info);
    }
    FillGrid();
}

void HoverIndex::Refresh(Entry &entry, const PreviewInfo &info)
{
    entry.bounds = OrbRect(1.0, 1.0, 0.0, 0.0);
    entry.bounded = entry.overlay->HoverBounds(info, entry.bounds);
    entry.dirty = false;
}

// Counts, then places: every cell's list is one run of mCellItems.
void HoverIndex::FillGrid()
{
    mArea = mBuiltArea;
    mCell = std::max(CellSize, std::max(mArea.Width(), mArea.Height()) / MaxCells);
    mCols = std::max(1, int32(std::ceil(mArea.Width() / mCell)));
    mRows = std::max(1, int32(std::ceil(mArea.Height() / mCell)));
    mUnbounded.clear();
    mWide.clear();
    std::vector<int32> count(std::size_t(mCols) * std::size_t(mRows) + 1, 0);
    const auto eachCell = [this](const OrbRect &r, const std::function<void(int32)> &visit) {
        int32 c1, r1, c2, r2;
        CellOf(r.Corner1(), c1, r1);
        CellOf(r.Corner2(), c2, r2);
        for (int32 row = r1; row <= r2; ++row)
            for (int32 col = c1; col <= c2; ++col)
                visit(row * mCols + col);
    };
    // Where each entry goes: -1 nowhere, 0 the cells of its clipped bounds.
    std::vector<OrbRect> clipped(mEntries.size());
    std::vector<bool> inCells(mEntries.size(), false);
    for (std::size_t i = 0; i < mEntries.size(); ++i) {
        const Entry &e = mEntries[i];
        clipped[i] = Intersect(e.bounds, mArea);
        if (!e.bounded)
            mUnbounded.push_back(int32(i));
        else if (IsEmpty(clipped[i]))
            continue;
        else if ((clipped[i].Width() / mCell + 2) * (clipped[i].Height() / mCell + 2) > kWideCells)
            mWide.push_back(int32(i));
        else
            inCells[i] = true;
    }
    for (std::size_t i = 0; i < mEntries.size(); ++i)
        if (inCells[i])
            eachCell(clipped[i], [&count](int32 cell) { ++count[std::size_t(cell) + 1]; });
    for (std::size_t c = 1; c < count.size(); ++c)
        count[c] += count[c - 1];
    mCellStart = count;
    mCellItems.assign(std::size_t(count.back()), 0);
    for (std::size_t i = 0; i < mEntries.size(); ++i)
        if (inCells[i])
            eachCell(clipped[i], [&](int32 cell) { mCellItems[std::size_t(count[std::size_t(cell)]++)] = int32(i); });
}

// The cell of `p`, clamped to the grid; false where `p` lies outside it.
bool HoverIndex::CellOf(OrbPoint p, int32 &col, int32 &row) const
{
    const bool inside = mArea.Contains(p);
    col = std::clamp(int32(std::floor((p.x - mArea.x1) / mCell)), 0, mCols - 1);
    row = std::clamp(int32(std::floor((p.y - mArea.y1) / mCell)), 0, mRows - 1);
    return inside;
}

// The entries to ask, topmost first, each once.
void HoverIndex::Collect(OrbPoint mouse, std::vector<int32> &out) const
{
    out = mUnbounded;
    const auto under = [&](int32 i) {
        const Entry &e = mEntries[std::size_t(i)];
        if (!e.stale && e.bounds.Contains(mouse))
            out.push_back(i);
    };
    int32 col, row;
    if (CellOf(mouse, col, row)) {
        const int32 cell = row * mCols + col;
        for (int32 k = mCellStart[std::size_t(cell)]; k < mCellStart[std::size_t(cell) + 1]; ++k)
            under(mCellItems[std::size_t(k)]);
        for (const int32 i : mWide)
            under(i);
    } else {
        // Outside the visible area (a release after a drag out): rare, so
        // every bounded entry is tested by its rectangle.
        for (std::size_t i = 0; i < mEntries.size(); ++i)
            if (mEntries[i].bounded)
                under(int32(i));
    }
    for (const int32 i : mStale) {
        const Entry &e = mEntries[std::size_t(i)];
        if (!e.bounded || e.bounds.Contains(mouse))
            out.push_back(i);
    }
    for (const PreviewControl *overlay : mSticky)
        if (const auto it = mSlots.find(overlay); it != mSlots.end())
            out.push_back(it->second);
    std::sort(out.begin(), out.end(), std::greater<int32>());
    out.erase(std::unique(out.begin(), out.end()), out.end());
}

} // namespace Orbane

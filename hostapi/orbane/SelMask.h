#pragma once

#include "orbane/Types.h"

#include <vector>

namespace Orbane {

// The selection of a set of numbered items (the key points of a shape).
// Each item has a state byte: 0 is not selected, anything else selected.
// Set(i, true) gives the ordinary state Selected; editors may store other
// states with SetState (a point picked without its handles, say) and draw
// them apart, while counting and queries treat every non-zero state alike.
//
// Mutators return true when the mask changed, so callers redraw only then;
// indices out of range change nothing. The count of selected items is kept
// up to date, so GetSetCount, IsAllSet and IsMultiSet cost nothing.
class SelMask
{
public:
    static constexpr uint8 Clear = 0;
    static constexpr uint8 Selected = 2;

    // How DoSet changes one item.
    enum SelOp : int32
    {
        SEL_Clear = 0,  // deselect it
        SEL_Set = 1,    // add it to the selection
        SEL_Toggle = 2, // flip it
        SEL_Only = 3,   // make it the only selected item
    };

    SelMask() = default;
    explicit SelMask(int32 count) { Create(count); }

    // `count` items, none selected; false (and no change) for a negative count.
    bool Create(int32 count);
    int32 GetCount() const { return int32(mStates.size()); }
    // Deselects everything, keeping the count.
    bool Reset();

    bool Set(int32 index, bool selected);
    bool DoSet(int32 index, SelOp op);
    bool SetState(int32 index, uint8 state);
    // The state byte; 0 for an index out of range.
    uint8 operator[](int32 index) const;
    bool IsSet(int32 index) const { return (*this)[index] != Clear; }

    int32 GetSetCount() const { return mSetCount; }
    // The index of the n-th selected item (from 0, in index order), -1 when
    // there are not that many. GetSetItem(-1) is GetSingleSetItem().
    int32 GetSetItem(int32 n) const;
    // The index of the selected item when exactly one is selected, else -1.
    int32 GetSingleSetItem() const;
    bool IsAllSet() const { return !mStates.empty() && mSetCount == GetCount(); }
    bool IsMultiSet() const { return mSetCount > 1; }

    // Moves every state `offset` items up (negative: down). With `wrap` the
    // states rotate round (a closed shape); without, those pushed past either
    // end are dropped and the items left behind are deselected.
    bool ShiftSet(int32 offset, bool wrap);

    // The state bytes in item order, as the shape operations take them
    // (PolyLine::MovePoints and the like); null for an empty mask.
    const uint8 *Bytes() const noexcept { return mStates.empty() ? nullptr : mStates.data(); }
    // Keeps the selection attached to its items when the shape gains an
    // item before `index` (GetCount() appends) or loses the selected ones.
    bool InsertItem(int32 index, uint8 state = Clear);
    bool RemoveSetItems();

    // One saved copy, for a gesture that may be cancelled.
    void BackupMask();
    // False when nothing was backed up; the backup is kept.
    bool RestoreMask();

    // `index` taken round into 0..count-1 (-1 is the last item); -1 for an
    // empty mask.
    int32 GetAbsolute(int32 index) const;
    // Segments join item i to i+1, and the last to the first when `closed`
    // (with three items or more). The start of the n-th segment whose two
    // ends are both selected, or -1.
    int32 GetSegment(int32 n, bool closed) const;
    // The segment's start when exactly two items are selected and they are
    // the ends of one segment, else -1.
    int32 GetSingleSetSegment(bool closed) const;

    bool operator==(const SelMask &o) const { return mStates == o.mStates; }
    bool operator!=(const SelMask &o) const { return !(*this == o); }

private:
    bool InRange(int32 index) const { return index >= 0 && index < GetCount(); }
    int32 SegmentCount(bool closed) const;
    int32 CountSet() const;

    std::vector<uint8> mStates;
    int32 mSetCount = 0;
    std::vector<uint8> mBackup;
    bool mHasBackup = false;
};

} // namespace Orbane

#include "orbane/SelMask.h"

#include <algorithm>

namespace Orbane {

bool SelMask::Create(int32 count)
{
    if (count < 0)
        return false;
    mStates.assign(std::size_t(count), Clear);
    mSetCount = 0;
    return true;
}

bool SelMask::Reset()
{
    if (mSetCount == 0)
        return false;
    std::fill(mStates.begin(), mStates.end(), Clear);
    mSetCount = 0;
    return true;
}

bool SelMask::Set(int32 index, bool selected)
{
    if (!InRange(index) || IsSet(index) == selected)
        return false;
    return SetState(index, selected ? Selected : Clear);
}

bool SelMask::DoSet(int32 index, SelOp op)
{
    if (!InRange(index))
        return false;
    switch (op) {
    case SEL_Clear:
        return Set(index, false);
    case SEL_Set:
        return Set(index, true);
    case SEL_Toggle:
        return Set(index, !IsSet(index));
    case SEL_Only: {
        if (mSetCount == 1 && IsSet(index))
            return false;
        const uint8 state = IsSet(index) ? (*this)[index] : Selected;
        Reset();
        SetState(index, state);
        return true;
    }
    }
    return false;
}

bool SelMask::SetState(int32 index, uint8 state)
{
    if (!InRange(index))
        return false;
    uint8 &s = mStates[std::size_t(index)];
    if (s == state)
        return false;
    mSetCount += int32(state != Clear) - int32(s != Clear);
    s = state;
    return true;
}

uint8 SelMask::operator[](int32 index) const
{
    return InRange(index) ? mStates[std::size_t(index)] : Clear;
}

int32 SelMask::GetSetItem(int32 n) const
{
    if (n == -1)
        return GetSingleSetItem();
    if (n < 0 || n >= mSetCount)
        return -1;
    for (int32 i = 0, seen = 0; i < GetCount(); ++i) {
        if (IsSet(i) && seen++ == n)
            return i;
    }
    return -1;
}

int32 SelMask::GetSingleSetItem() const
{
    return mSetCount == 1 ? GetSetItem(0) : -1;
}

bool SelMask::ShiftSet(int32 offset, bool wrap)
{
    const int32 count = GetCount();
    if (mSetCount == 0)
        return false;
    std::vector<uint8> shifted(mStates.size(), Clear);
    for (int32 i = 0; i < count; ++i) {
        int64 to = int64(i) + offset;
        if (wrap)
            to = ((to % count) + count) % count;
        if (to >= 0 && to < count)
            shifted[std::size_t(to)] = mStates[std::size_t(i)];
    }
    if (shifted == mStates)
        return false;
    mStates.swap(shifted);
    mSetCount = CountSet();
    return true;
}

bool SelMask::InsertItem(int32 index, uint8 state)
{
    if (index < 0 || index > GetCount())
        return false;
    mStates.insert(mStates.begin() + index, state);
    mSetCount += state != Clear ? 1 : 0;
    return true;
}

bool SelMask::RemoveSetItems()
{
    if (mSetCount == 0)
        return false;
    // What is left is exactly the items that were not selected.
    mStates.assign(std::size_t(GetCount() - mSetCount), Clear);
    mSetCount = 0;
    return true;
}

void SelMask::BackupMask()
{
    mBackup = mStates;
    mHasBackup = true;
}

bool SelMask::RestoreMask()
{
    if (!mHasBackup)
        return false;
    mStates = mBackup;
    mSetCount = CountSet();
    return true;
}

int32 SelMask::GetAbsolute(int32 index) const
{
    const int32 count = GetCount();
    if (count == 0)
        return -1;
    return ((index % count) + count) % count;
}

int32 SelMask::SegmentCount(bool closed) const
{
    const int32 count = GetCount();
    if (count < 2)
        return 0;
    return closed && count >= 3 ? count : count - 1;
}

int32 SelMask::GetSegment(int32 n, bool closed) const
{
    if (n < 0)
        return -1;
    const int32 segments = SegmentCount(closed);
    for (int32 i = 0, seen = 0; i < segments; ++i) {
        if (IsSet(i) && IsSet((i + 1) % GetCount()) && seen++ == n)
            return i;
    }
    return -1;
}

int32 SelMask::GetSingleSetSegment(bool closed) const
{
    if (mSetCount != 2)
        return -1;
    return GetSegment(0, closed);
}

int32 SelMask::CountSet() const
{
    return int32(std::count_if(mStates.begin(), mStates.end(), [](uint8 s) { return s != Clear; }));
}

} // namespace Orbane

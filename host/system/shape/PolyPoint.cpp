#include "orbane/PolyPoint.h"

#include "orbane/PolyLine.h"

namespace Orbane {

void PolyPoint::Assign(const PolyPoint &o) noexcept
{
    X = o.X, Y = o.Y, InX = o.InX, InY = o.InY, OutX = o.OutX, OutY = o.OutY;
    Weight = o.Weight, Time = o.Time, Pressure = o.Pressure;
    Height = o.Height, AngleXY = o.AngleXY, AngleZ = o.AngleZ, Rotation = o.Rotation;
    Flags = o.Flags, TagID = o.TagID;
    DispX = o.DispX, DispY = o.DispY, FollowIndex = o.FollowIndex;
}

void PolyPoint::Offset(float64 dx, float64 dy) noexcept
{
    X += dx, Y += dy, InX += dx, InY += dy, OutX += dx, OutY += dy;
}

PolyPoint *PolyPoint::Next1(int32 step, uint32 flags) const
{
    if (!mOwner)
        return nullptr;
    const int32 count = mOwner->GetCount();
    int32 next = mOwner->GetIndex(this) + step;
    if ((flags & PWF_Wrap) && mOwner->IsClosed() && count > 0)
        next = ((next % count) + count) % count;
    return mOwner->GetPoint(next);
}

bool PolyPoint::operator==(const PolyPoint &o) const noexcept
{
    return X == o.X && Y == o.Y && InX == o.InX && InY == o.InY && OutX == o.OutX && OutY == o.OutY &&
           Weight == o.Weight && Time == o.Time && Pressure == o.Pressure && Height == o.Height &&
           AngleXY == o.AngleXY && AngleZ == o.AngleZ && Rotation == o.Rotation && Flags == o.Flags &&
           TagID == o.TagID && DispX == o.DispX && DispY == o.DispY && FollowIndex == o.FollowIndex;
}

} // namespace Orbane

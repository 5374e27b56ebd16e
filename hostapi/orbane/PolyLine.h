#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Parameter.h"
#include "orbane/PolyPoint.h"

#include <memory>
#include <vector>

namespace Orbane {

class SegmentIndex;

// A shape value (CLSID_DataType_Polyline): key points joined by cubic Bezier
// segments, open or closed. Segment i runs from point i through its out
// handle and the in handle of point i+1 to point i+1; a closed shape adds
// the segment from the last point back to the first.
//
// A place on the shape is a parameter `par`: the segment index plus the
// fraction (0..1) along it, so 0..GetSegmentsCount().
//
// Like every Parameter, a shape that an Input holds is never changed: edit
// a Clone (or Copy) and store that. Operations that take a selection read
// one byte per key point, non-zero for selected; a null selection means
// every point.
class PolyLine : public Parameter
{
public:
    PolyLine() = default;
    PolyLine(const PolyLine &o);
    PolyLine &operator=(const PolyLine &o);

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    bool Equals(const Parameter &o) const override;
    // Key points blended one by one (InterpolateWith).
    Parameter *Interpolate(const Parameter &to, float64 t) const override;

    // Walking.
    int32 GetCount() const noexcept { return int32(mPoints.size()); }
    PolyPoint *First(uint32 flags = 0) const;
    PolyPoint *Last(uint32 flags = 0) const;
    // Null for an index out of range.
    PolyPoint *GetPoint(int32 index) const;
    // The index of a point of this shape, -1 for any other.
    int32 GetIndex(const PolyPoint *p) const noexcept;
    const std::vector<PolyPoint> &Points() const noexcept { return mPoints; }
    bool IsClosed() const noexcept { return mClosed; }
    // Count-1 when open, count when closed (a closed single point has none).
    int32 GetSegmentsCount() const noexcept;

    // Evaluation. `par` is clamped to the shape; false for an empty shape.
    virtual bool CalcXYZ(float64 par, float64 &x, float64 &y, float64 &z) const;
    OrbPoint ValueAt(float64 par) const;
    // The derivative d(position)/d(par) at `par`.
    virtual OrbPoint TangentAt(float64 par) const;
    // The four points whose convex hull holds segment `seg` (for a Bezier:
    // its control points).
    virtual void SegmentHull(int32 seg, OrbPoint hull[4]) const;
    // The shape flattened: `perSegment` points along each segment, plus the
    // end point of an open shape. A single point gives itself.
    std::vector<OrbPoint> GetSamplePoints(int32 perSegment = 16) const;

    // Editing. Each returns false (and changes nothing) where it has nothing
    // to do or the input is bad: a non-finite coordinate is refused.
    bool AddPoint(const PolyPoint &p);
    // Puts `p` before `index` (GetCount() appends).
    bool InsertPoint(int32 index, const PolyPoint &p);
    // Inserts a key point at `par` splitting its segment so the curve keeps
    // its shape; returns the new point's index, or -1.
    int32 InsertPointAt(float64 par);
    // Moves selected points and their handles by (dx, dy).
    bool MovePoints(const uint8 *selected, float64 dx, float64 dy);
    bool DeletePoints(const uint8 *selected);
    bool DeleteAllPoints();
    bool Close();
    bool Open();
    // Replaces this shape's points and closure with `from`'s.
    void Copy(const PolyLine &from);
    // The shape a fraction `t` of the way to `to`, point by point; a copy of
    // this one (of `to` once t reaches 1) when the point counts differ.
    // The result holds one reference for the caller.
    PolyLine *InterpolateWith(const PolyLine &to, float64 t) const;

    bool operator==(const PolyLine &o) const;
    bool operator!=(const PolyLine &o) const { return !(*this == o); }

    // Set on a value blended between keyframes rather than stored in one.
    bool IsFromSplineList() const noexcept { return mFromSplineList; }

protected:
    ~PolyLine() override;
    // Splits `par` into a segment and the fraction along it.
    void SegmentOf(float64 par, int32 &seg, float64 &t) const;
    // Called after any change to the points: drops cached lookups and lets
    // every point know its shape again.
    void Changed();
    std::vector<PolyPoint> mPoints;

private:
    bool mClosed = false;
    bool mFromSplineList = false;
};

} // namespace Orbane

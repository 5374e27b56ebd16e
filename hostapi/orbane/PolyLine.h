#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Parameter.h"
#include "orbane/PolyPoint.h"

#include <memory>
#include <vector>

namespace Orbane {

class Operator;
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
    // Counted against the undo history's memory bound: every key point.
    std::size_t Footprint() const noexcept override;
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
    // Points about every `spacing` along the curve, with the pen values of
    // the key points blended between them: what a paint stroke stamps.
    std::vector<PolyPoint> GetDigitalPoints(float64 spacing) const;

    // Measuring. The nearest place is found through a bounding-box index of
    // the segments, built on first use and shared by copies of the shape.
    // The parameter of the place on the shape nearest to (x, y), its
    // distance in `distance`; -1 for an empty shape.
    float64 CalcClosestPar(float64 x, float64 y, float64 *distance = nullptr) const;
    // The nearest place itself in (px, py); returns its distance, -1 for an
    // empty shape.
    float64 CalcClosestPoint(float64 x, float64 y, float64 &px, float64 &py, float64 *par = nullptr) const;
    float64 CalcLength() const;
    // The arc length between two parameters (negative when par1 < par0).
    float64 Distance(float64 par0, float64 par1) const;
    // The place `distance` along the shape from its start, clamped to the
    // shape; its parameter in `par`.
    OrbPoint GetPointOnPath(float64 distance, float64 *par = nullptr) const;

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
    // Corners: the handles of the selected points go onto the points.
    bool Linear(const uint8 *selected);
    // Smooth points: handles along the line from the previous to the next
    // point, a third of the way to each neighbour.
    bool Smooth(const uint8 *selected);
    // Scales the handles of the selected points by `factor` (0 makes
    // corners, 1 changes nothing).
    bool Tensioning(const uint8 *selected, float64 factor);
    // Blends the handles of the selected points a fraction `amount` (0..1)
    // of the way towards their smooth handles.
    bool Shaping(const uint8 *selected, float64 amount);
    // Pen values and weight of the selected points back to their defaults.
    bool ResetAttrib(const uint8 *selected);
    // The segments that start at selected points become gaps; the others
    // are drawn again.
    bool SetDiscontinualSegementMask(const uint8 *selected);
    bool IsDiscontinual(int32 seg) const;

    // Replaces point `index` (keeping its place); false out of range or for
    // non-finite coordinates.
    bool SetPoint(int32 index, const PolyPoint &p);

    // Making shapes: each replaces the points and returns false (changing
    // nothing) for non-finite or empty input.
    // Reduces sampled points (a freehand stroke, with their pen values) to
    // few Bezier key points whose curve stays within `tolerancePx` pixels of
    // every sample; `pixelW` and `pixelH` are the size of one viewer pixel
    // in image units. Each key point keeps the pen values of its sample.
    bool SetReducedPoints(const std::vector<PolyPoint> &samples, float64 tolerancePx, float64 pixelW = 1.0,
                          float64 pixelH = 1.0, bool closed = false);
    // Reduces this shape's own points the same way.
    bool ReducePoints(float64 tolerancePx, float64 pixelW = 1.0, float64 pixelH = 1.0);
    bool MakeEllipse(float64 cx, float64 cy, float64 rx, float64 ry, int32 points = 4);
    bool MakeRectangle(float64 cx, float64 cy, float64 w, float64 h);
    bool MakeArrow(float64 x0, float64 y0, float64 x1, float64 y1, float64 shaftWidth, float64 headWidth,
                   float64 headLength);
    bool MakeSpiral(float64 cx, float64 cy, float64 r0, float64 r1, float64 turns, int32 pointsPerTurn = 8);
    // This shape as a value of `dataType` (CLSID_DataType_Polyline or
    // CLSID_DataType_BSplinePolyline), one reference for the caller; a copy
    // when it already is one; null for another type.
    PolyLine *Convert(const OrbID &dataType) const;
    // The outline `amount` farther out (negative: in), fitted within
    // `tolerance`; one reference, or null where nothing is left.
    PolyLine *Expand(float64 amount, float64 tolerance = 1e-4) const;

    // Replaces this shape's points and closure with `from`'s.
    void Copy(const PolyLine &from);
    // The shape a fraction `t` of the way to `to`, point by point; a copy of
    // this one (of `to` once t reaches 1) when the point counts differ.
    // The result holds one reference for the caller.
    PolyLine *InterpolateWith(const PolyLine &to, float64 t) const;

    bool operator==(const PolyLine &o) const;
    bool operator!=(const PolyLine &o) const { return !(*this == o); }

    // Publishing: a published point is offered to the tool as the point
    // Input "Point<n>" (n its TagID), so other tools can follow it.
    // Publishes the selected points with numbers from max(firstID, highest
    // in use + 1); returns how many were published.
    int32 PublishPoints(const uint8 *selected, int32 firstID = 1);
    bool UnpublishPoints(const uint8 *selected);
    // The index of the point published as `id`, or -1.
    int32 GetPublishedPoint(int32 id) const;
    // The number of the first selected published point, 0 for none.
    int32 GetSelectedPublishedPoint(const uint8 *selected) const;
    static OrbID PublishedPointInputID(int32 id);
    // Writes each published point's position into the tool's point Input
    // of its number at `time` (undo as any write); returns how many.
    int32 UpdatePublishedPointInputs(Operator &tool, float64 time) const;
    // Moves each published point (with its handles) to the value of its
    // point Input at `time`; true where something moved.
    bool UpdatePublish(const Operator &tool, float64 time);

    // Following: a following point keeps its offset to a point of another
    // shape (an outer shape to its inner one), so moving the inner shape
    // carries the outer along.
    // The index of the key point of `master` nearest to point `index`.
    int32 FindExternFollowingPoint(const PolyLine &master, int32 index) const;
    // The selected points follow their nearest points of `master`.
    bool SetFollowing(const PolyLine &master, const uint8 *selected);
    // Every point follows the point of `master` with its own index (a shape
    // made from `master`); false when the counts differ.
    bool SetFollowingPointsOrg(const PolyLine &master);
    // Takes the current offsets of the following points as their new ones.
    bool RecalcDisplacements(const PolyLine &master);
    // Puts the following points back at their offsets from `master`.
    bool UpdateShape(const PolyLine &master);

    // Set on a value blended between keyframes rather than stored in one.
    bool IsFromSplineList() const noexcept { return mFromSplineList; }

protected:
    ~PolyLine() override;
    // Splits `par` into a segment and the fraction along it.
    void SegmentOf(float64 par, int32 &seg, float64 &t) const;
    // Called after any change to the points: drops cached lookups and lets
    // every point know its shape again.
    void Changed();
    // Lets every point know its shape again (after the vector moved them).
    void Adopt();
    std::vector<PolyPoint> mPoints;

private:
    // Segment index for closest-point queries; shared by copies, dropped by
    // any change.
    const SegmentIndex &Index() const;
    float64 SegmentDist2(int32 seg, const OrbPoint &p, float64 &t, float64 bound) const;
    void SmoothHandles(int32 i, OrbPoint &in, OrbPoint &out) const;
    // Calls `edit(point, index)` on each selected point; true (and the
    // caches dropped) where any call changed its point.
    template <class F> bool EditSelected(const uint8 *selected, F edit);
    // Replaces the points with a made shape; false (no change) for none.
    bool SetMade(std::vector<PolyPoint> made, bool closed);

    mutable std::shared_ptr<const SegmentIndex> mIndex;
    bool mClosed = false;
    bool mFromSplineList = false;
};

} // namespace Orbane

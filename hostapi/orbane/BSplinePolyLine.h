#pragma once

#include "orbane/PolyLine.h"

namespace Orbane {

// A shape value (CLSID_DataType_BSplinePolyline) whose points are the
// control points of a rational uniform cubic B-spline, each with its
// Weight; handles are not used. Segment i is shaped by control points
// i-1 .. i+2. A closed shape wraps round; an open one mirrors a phantom
// point past each end (2*P0 - P1), so the curve starts and ends on its end
// points and has as many segments as the Bezier shape of the same points.
class BSplinePolyLine : public PolyLine
{
public:
    BSplinePolyLine() = default;
    BSplinePolyLine(const BSplinePolyLine &o) = default;

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;

    bool CalcXYZ(float64 par, float64 &x, float64 &y, float64 &z) const override;
    OrbPoint TangentAt(float64 par) const override;
    void SegmentHull(int32 seg, OrbPoint hull[4]) const override;

    // The homogeneous control point k of the curve (x*w, y*w, w), with the
    // wrap of a closed shape and the phantom ends of an open one.
    void ControlPoint(int32 k, float64 &xw, float64 &yw, float64 &w) const;

protected:
    ~BSplinePolyLine() override;
};

} // namespace Orbane

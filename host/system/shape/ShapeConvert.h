#pragma once

namespace Orbane {

class BSplinePolyLine;
class PolyLine;

// Between the two kinds of shape, keeping the key points' pen values.
class ShapeConvert
{
public:
    // The B-spline whose curve passes through every key point of `bezier`
    // (control points solved from P[i-1] + 4 P[i] + P[i+1] = 6 K[i], with
    // the ends held on their key points when open), weights 1. The curve is
    // the Bezier one exactly when that one is twice continuously
    // differentiable, as a converted B-spline is.
    static BSplinePolyLine *ToBSpline(const PolyLine &bezier);
    // The Bezier shape with a key point at each knot of `bspline` and the
    // handles of its tangents there: exact for equal weights, and matching
    // position and direction at every knot otherwise.
    static PolyLine *ToBezier(const BSplinePolyLine &bspline);
};

} // namespace Orbane

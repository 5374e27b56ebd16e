#include "widgets/Curve.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

Curve::Curve(std::vector<CurvePoint> points, bool linear) : mPoints(std::move(points)), mLinear(linear)
{
    Tidy();
}

Curve Curve::Identity(bool linear)
{
    return Curve({{0.0, 0.0}, {1.0, 1.0}}, linear);
}

void Curve::SetLinear(bool linear)
{
    mLinear = linear;
}

void Curve::Tidy()
{
    mPoints.erase(std::remove_if(mPoints.begin(), mPoints.end(),
                                 [](const CurvePoint &p) { return !std::isfinite(p.x) || !std::isfinite(p.y); }),
                  mPoints.end());
    std::stable_sort(mPoints.begin(), mPoints.end(),
                     [](const CurvePoint &a, const CurvePoint &b) { return a.x < b.x; });
    std::vector<CurvePoint> merged;
    for (std::size_t i = 0; i < mPoints.size();) {
        std::size_t j = i;
        float64 sum = 0.0;
        while (j < mPoints.size() && mPoints[j].x - mPoints[i].x < kMinGap)
            sum += mPoints[j++].y;
        merged.push_back({mPoints[i].x, sum / float64(j - i)});
        i = j;
    }
    mPoints = std::move(merged);
    UpdateSlopes();
}

// Fritsch and Carlson's tangents: the secants' harmonic mean where they
// agree in sign, flat at a turn, so no segment overshoots its ends.
void Curve::UpdateSlopes()
{
    const std::size_t n = mPoints.size();
    mSlopes.assign(n, 0.0);
    if (n < 2)
        return;
    std::vector<float64> secant(n - 1);
    for (std::size_t i = 0; i + 1 < n; ++i)
        secant[i] = (mPoints[i + 1].y - mPoints[i].y) / (mPoints[i + 1].x - mPoints[i].x);
    mSlopes[0] = secant[0];
    mSlopes[n - 1] = secant[n - 2];
    for (std::size_t i = 1; i + 1 < n; ++i) {
        const float64 a = secant[i - 1], b = secant[i];
        mSlopes[i] = a * b <= 0.0 ? 0.0 : 2.0 * a * b / (a + b);
    }
}

float64 Curve::Segment(std::size_t i, float64 x) const
{
    const CurvePoint &p0 = mPoints[i], &p1 = mPoints[i + 1];
    const float64 h = p1.x - p0.x;
    const float64 t = (x - p0.x) / h;
    if (mLinear)
        return p0.y + t * (p1.y - p0.y);
    const float64 t2 = t * t, t3 = t2 * t;
    return (2 * t3 - 3 * t2 + 1) * p0.y + (t3 - 2 * t2 + t) * h * mSlopes[i] + (-2 * t3 + 3 * t2) * p1.y +
           (t3 - t2) * h * mSlopes[i + 1];
}

float64 Curve::Evaluate(float64 x) const
{
    if (mPoints.empty())
        return x;
    if (std::isnan(x))
        return mPoints.front().y;
    if (x <= mPoints.front().x)
        return mPoints.front().y;
    if (x >= mPoints.back().x)
        return mPoints.back().y;
    const auto after =
        std::upper_bound(mPoints.begin(), mPoints.end(), x, [](float64 v, const CurvePoint &p) { return v < p.x; });
    return Segment(std::size_t(after - mPoints.begin()) - 1, x);
}

int32 Curve::Insert(CurvePoint p)
{
    const auto at =
        std::lower_bound(mPoints.begin(), mPoints.end(), p.x, [](const CurvePoint &q, float64 v) { return q.x < v; });
    const int32 index = int32(at - mPoints.begin());
    // A point on top of another replaces it rather than making a step.
    if (at != mPoints.end() && at->x - p.x < kMinGap) {
        at->y = p.y;
    } else if (index > 0 && p.x - mPoints[index - 1].x < kMinGap) {
        mPoints[index - 1].y = p.y;
        UpdateSlopes();
        return index - 1;
    } else {
        mPoints.insert(at, p);
    }
    UpdateSlopes();
    return index;
}

bool Curve::Move(int32 index, CurvePoint p)
{
    if (index < 0 || index >= int32(mPoints.size()) || !std::isfinite(p.x) || !std::isfinite(p.y))
        return false;
    if (index > 0)
        p.x = std::max(p.x, mPoints[index - 1].x + kMinGap);
    if (index + 1 < int32(mPoints.size()))
        p.x = std::min(p.x, mPoints[index + 1].x - kMinGap);
    if (mPoints[index] == p)
        return false;
    mPoints[index] = p;
    UpdateSlopes();
    return true;
}

bool Curve::Remove(int32 index)
{
    if (index < 0 || index >= int32(mPoints.size()))
        return false;
    mPoints.erase(mPoints.begin() + index);
    UpdateSlopes();
    return true;
}

int32 Curve::Nearest(CurvePoint p, float64 scaleX, float64 scaleY, float64 tolerance) const
{
    int32 best = -1;
    float64 bestDistance = tolerance * tolerance;
    for (int32 i = 0; i < int32(mPoints.size()); ++i) {
        const float64 dx = (mPoints[i].x - p.x) * scaleX, dy = (mPoints[i].y - p.y) * scaleY;
        const float64 d = dx * dx + dy * dy;
        if (d <= bestDistance) {
            bestDistance = d;
            best = i;
        }
    }
    return best;
}

} // namespace Orbane

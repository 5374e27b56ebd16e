#include "CurveFit.h"

#include "Bezier.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// A fit this many times the tolerance is close enough that better
// parameters may bring it under; farther off, the samples are split.
constexpr float64 kIterationFactor = 4.0;
constexpr int kMaxNewtonRounds = 4;

OrbPoint Unit(const OrbPoint &v)
{
    const float64 len = v.Length();
    return len > 0.0 ? v / len : OrbPoint();
}

class Fitter
{
public:
    Fitter(const std::vector<OrbPoint> &pts, const std::vector<int32> &index, float64 tolerance)
        : mPts(pts), mIndex(index), mTol2(tolerance * tolerance)
    {
    }

    std::vector<CurveFit::Key> Run()
    {
        const int32 last = int32(mPts.size()) - 1;
        mKeys.push_back({mPts[0], mPts[0], mPts[0], mIndex[0]});
        FitCubic(0, last, Unit(mPts[1] - mPts[0]), Unit(mPts[std::size_t(last - 1)] - mPts[std::size_t(last)]));
        return mKeys;
    }

private:
    const OrbPoint &P(int32 i) const { return mPts[std::size_t(i)]; }

    void Emit(const OrbPoint c[4], int32 last)
    {
        mKeys.back().out = c[1];
        mKeys.push_back({c[3], c[2], c[3], mIndex[std::size_t(last)]});
    }

    void FitCubic(int32 first, int32 last, OrbPoint tan1, OrbPoint tan2)
    {
        OrbPoint c[4];
        if (last - first == 1) {
            const float64 d = (P(last) - P(first)).Length() / 3.0;
            c[0] = P(first), c[1] = c[0] + tan1 * d, c[3] = P(last), c[2] = c[3] + tan2 * d;
            Emit(c, last);
            return;
        }
        std::vector<float64> u = ChordParams(first, last);
        Generate(first, last, u, tan1, tan2, c);
        int32 split = 0;
        float64 err = MaxError(first, last, c, u, split);
        if (err <= mTol2) {
            Emit(c, last);
            return;
        }
        for (int round = 0; err <= mTol2 * kIterationFactor * kIterationFactor && round < kMaxNewtonRounds; ++round) {
            Reparameterize(first, last, c, u);
            Generate(first, last, u, tan1, tan2, c);
            err = MaxError(first, last, c, u, split);
            if (err <= mTol2) {
                Emit(c, last);
                return;
            }
        }
        const OrbPoint centre = Unit(P(split - 1) - P(split + 1));
        FitCubic(first, split, tan1, centre);
        FitCubic(split, last, -centre, tan2);
    }

    std::vector<float64> ChordParams(int32 first, int32 last) const
    {
        std::vector<float64> u(std::size_t(last - first + 1), 0.0);
        for (int32 i = first + 1; i <= last; ++i)
            u[std::size_t(i - first)] = u[std::size_t(i - first - 1)] + (P(i) - P(i - 1)).Length();
        for (float64 &v : u)
            v /= u.back();
        return u;
    }

    // The least-squares handle lengths along the fixed end tangents.
    void Generate(int32 first, int32 last, const std::vector<float64> &u, OrbPoint tan1, OrbPoint tan2,
                  OrbPoint c[4]) const
    {
        float64 m[2][2] = {{0, 0}, {0, 0}}, x[2] = {0, 0};
        const OrbPoint p0 = P(first), p3 = P(last);
        for (int32 i = first; i <= last; ++i) {
            const float64 t = u[std::size_t(i - first)], s = 1.0 - t;
            const float64 b0 = s * s * s, b1 = 3 * t * s * s, b2 = 3 * t * t * s, b3 = t * t * t;
            const OrbPoint a1 = tan1 * b1, a2 = tan2 * b2;
            m[0][0] += a1.Dot(a1), m[0][1] += a1.Dot(a2), m[1][1] += a2.Dot(a2);
            const OrbPoint rest = P(i) - (p0 * (b0 + b1) + p3 * (b2 + b3));
            x[0] += a1.Dot(rest), x[1] += a2.Dot(rest);
        }
        m[1][0] = m[0][1];
        const float64 det = m[0][0] * m[1][1] - m[0][1] * m[1][0];
        float64 alpha1 = det != 0.0 ? (x[0] * m[1][1] - x[1] * m[0][1]) / det : 0.0;
        float64 alpha2 = det != 0.0 ? (m[0][0] * x[1] - m[1][0] * x[0]) / det : 0.0;
        // Degenerate or reversed handles fall back to a third of the chord.
        const float64 chord = (p3 - p0).Length(), eps = 1e-6 * chord;
        if (alpha1 < eps || alpha2 < eps)
            alpha1 = alpha2 = chord / 3.0;
        c[0] = p0, c[1] = p0 + tan1 * alpha1, c[2] = p3 + tan2 * alpha2, c[3] = p3;
    }

    float64 MaxError(int32 first, int32 last, const OrbPoint c[4], const std::vector<float64> &u, int32 &split) const
    {
        float64 worst = 0.0;
        split = (first + last) / 2;
        for (int32 i = first + 1; i < last; ++i) {
            const float64 d = (Bezier::Eval(c, u[std::size_t(i - first)]) - P(i)).LengthSquared();
            if (d >= worst)
                worst = d, split = i;
        }
        return worst;
    }

    // One Newton step per sample on the distance to the curve.
    void Reparameterize(int32 first, int32 last, const OrbPoint c[4], std::vector<float64> &u) const
    {
        const OrbPoint d1[3] = {(c[1] - c[0]) * 3.0, (c[2] - c[1]) * 3.0, (c[3] - c[2]) * 3.0};
        const OrbPoint d2[2] = {(d1[1] - d1[0]) * 2.0, (d1[2] - d1[1]) * 2.0};
        for (int32 i = first; i <= last; ++i) {
            float64 &t = u[std::size_t(i - first)];
            const float64 s = 1.0 - t;
            const OrbPoint q = Bezier::Eval(c, t) - P(i);
            const OrbPoint q1 = d1[0] * (s * s) + d1[1] * (2 * s * t) + d1[2] * (t * t);
            const OrbPoint q2 = d2[0] * s + d2[1] * t;
            const float64 den = q1.Dot(q1) + q.Dot(q2);
            if (den != 0.0)
                t = std::clamp(t - q.Dot(q1) / den, 0.0, 1.0);
        }
    }

    const std::vector<OrbPoint> &mPts;
    const std::vector<int32> &mIndex;
    float64 mTol2;
    std::vector<CurveFit::Key> mKeys;
};

} // namespace

std::vector<CurveFit::Key> CurveFit::Fit(const std::vector<OrbPoint> &samples, float64 tolerance)
{
    std::vector<OrbPoint> pts;
    std::vector<int32> index;
    for (std::size_t i = 0; i < samples.size(); ++i)
        if (pts.empty() || samples[i] != pts.back()) {
            pts.push_back(samples[i]);
            index.push_back(int32(i));
        }
    if (pts.size() < 2) {
        std::vector<Key> keys;
        for (std::size_t i = 0; i < pts.size(); ++i)
            keys.push_back({pts[i], pts[i], pts[i], index[i]});
        return keys;
    }
    return Fitter(pts, index, std::max(tolerance, 1e-9)).Run();
}

std::vector<PolyPoint> CurveFit::KeyPoints(const std::vector<Key> &keys, bool closed)
{
    std::vector<PolyPoint> pts;
    for (const Key &k : keys) {
        PolyPoint p(k.pos.x, k.pos.y);
        p.InX = k.in.x, p.InY = k.in.y, p.OutX = k.out.x, p.OutY = k.out.y;
        pts.push_back(p);
    }
    if (closed && pts.size() > 2 && pts.back().Pos() == pts.front().Pos()) {
        pts.front().InX = pts.back().InX, pts.front().InY = pts.back().InY;
        pts.pop_back();
    }
    return pts;
}

} // namespace Orbane

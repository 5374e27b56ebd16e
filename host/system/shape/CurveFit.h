#pragma once

#include "orbane/PolyPoint.h"

#include <vector>

namespace Orbane {

// Least-squares fitting of cubic Beziers to digitized curves (the method
// Philip Schneider published in Graphics Gems, 1990): fit one cubic to the
// samples by chord-length parameters, improve the parameters by Newton
// steps while the fit is near, and split at the worst sample otherwise,
// keeping the tangent continuous there.
class CurveFit
{
public:
    struct Key
    {
        OrbPoint pos, in, out; // handles absolute
        int32 sample;          // the index of the sample the key sits on
    };
    // Keys of a curve that stays within `tolerance` of every sample.
    // Repeated samples are skipped; fewer than two distinct samples give
    // them as they are.
    static std::vector<Key> Fit(const std::vector<OrbPoint> &samples, float64 tolerance);
    // The keys as shape points. A closed fit (samples that end where they
    // start) drops its last key and gives its in handle to the first.
    static std::vector<PolyPoint> KeyPoints(const std::vector<Key> &keys, bool closed);
};

} // namespace Orbane

#include "StippleDashes.h"

#include <algorithm>

namespace Orbane {
namespace Graphics {

namespace {

constexpr int32 PatternBits = 16;

bool bitAt(uint16 pattern, int32 bit)
{
    return (pattern >> (bit % PatternBits)) & 1u;
}

// A set bit whose predecessor (cyclically) is clear.
int32 firstDashStart(uint16 pattern)
{
    for (int32 bit = 0; bit < PatternBits; ++bit) {
        if (bitAt(pattern, bit) && !bitAt(pattern, bit + PatternBits - 1))
            return bit;
    }
    return 0;
}

} // namespace

StippleDashes::StippleDashes(int32 factor, uint16 pattern)
    : mFactor(std::clamp<int32>(factor, 1, 256)), mPattern(pattern)
{
    if (IsSolid() || IsInvisible())
        return;
    mStartBit = firstDashStart(pattern);
    bool on = true;
    int32 run = 0;
    for (int32 i = 0; i < PatternBits; ++i) {
        if (bitAt(pattern, mStartBit + i) != on) {
            mRunBits.append(run);
            on = !on;
            run = 0;
        }
        ++run;
    }
    mRunBits.append(run); // the last run is a gap: the pattern began at a dash after one
}

QVector<qreal> StippleDashes::Dashes(qreal penWidth) const
{
    QVector<qreal> dashes;
    dashes.reserve(mRunBits.size());
    for (int32 bits : mRunBits)
        dashes.append(bits * mFactor / penWidth);
    return dashes;
}

qreal StippleDashes::Offset(qreal penWidth) const
{
    // Bit 0 lies this far into the rotated pattern.
    int32 bits = (PatternBits - mStartBit) % PatternBits;
    return bits * mFactor / penWidth;
}

} // namespace Graphics
} // namespace Orbane

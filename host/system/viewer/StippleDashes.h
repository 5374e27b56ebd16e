#pragma once

#include "orbane/Types.h"

#include <QVector>

namespace Orbane {
namespace Graphics {

// A 16-bit line stipple as a Qt dash pattern. The stipple's bits, lowest
// first, are `factor` pixels each; Qt wants alternating dash and gap lengths
// in pen widths starting with a dash, so the pattern is rotated to begin at
// a dash and the rotation becomes the dash offset.
class StippleDashes
{
public:
    // factor is clamped to 1..256.
    StippleDashes(int32 factor, uint16 pattern);

    bool IsSolid() const { return mPattern == 0xFFFF; }
    bool IsInvisible() const { return mPattern == 0; }

    // In units of a pen `penWidth` pixels wide.
    QVector<qreal> Dashes(qreal penWidth) const;
    qreal Offset(qreal penWidth) const;

private:
    int32 mFactor;
    uint16 mPattern;
    int32 mStartBit = 0;     // first bit of a dash that follows a gap
    QVector<int32> mRunBits; // dash, gap, dash, gap... in bits from mStartBit
};

} // namespace Graphics
} // namespace Orbane

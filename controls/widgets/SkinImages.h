#pragma once

#include "orbane/Types.h"

#include <QtGlobal>

namespace Orbane {

class DIB;

// The painted widgets' skin images as DIBs, one per look-pack name for the
// whole process, made on first use from the look pack (ResDIB) at a ratio
// that is crisp on high-density screens and sharp enough everywhere else.
class SkinImages
{
public:
    static constexpr const char *SliderKnob = "Controls.Slider.Knob.1";
    static constexpr const char *SliderKnobPressed = "Controls.Slider.Knob.2";
    static constexpr const char *SliderReset = "Controls.Slider.Reset";
    static constexpr const char *SliderTrack = "Controls.Slider.Track";
    static constexpr qreal Ratio = 2.0;

    // The image named `name`; null where the look pack has none. The cache
    // keeps one use of it until the process ends: call Use to store it.
    static DIB *Get(const char *name);
};

} // namespace Orbane

#pragma once

#include "orbane/GColor.h"
#include "orbane/GPainter.h"

namespace Orbane {
namespace Graphics {

// Everything PushAttrib saves. The defaults are those of the viewer's overlay
// passes: white, no shadow, one-pixel lines, antialiased, ordinary blending.
class PainterState
{
public:
    GColor Fill{1.0f, 1.0f, 1.0f, 1.0f};
    GColor Shadow;
    float32 LineWidth = 1.0f;
    float32 PointSize = 1.0f;
    int32 StippleFactor = 1;
    uint16 StipplePattern = 0xFFFF;
    uint32 Enabled = (1u << GC_Blend) | (1u << GC_LineSmooth);
    int32 BlendSource = GBF_SrcAlpha;
    int32 BlendDestination = GBF_OneMinusSrcAlpha;
    bool DepthMask = true;
    int32 ShadeModel = GSM_Smooth;

    bool IsEnabled(int32 capability) const
    {
        return capability >= 0 && capability < 32 && (Enabled & (1u << capability)) != 0;
    }
    void SetEnabled(int32 capability, bool on)
    {
        if (capability < 0 || capability >= 32)
            return;
        Enabled = on ? (Enabled | (1u << capability)) : (Enabled & ~(1u << capability));
    }
};

} // namespace Graphics
} // namespace Orbane

#pragma once

#include "framework/TransformTags.h"

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ImgOverlayControl. The image overlay is a transform with
// an image in its frame: its first ten tags are the transform's, under the
// same numbers and meanings.
constexpr Tag IO_AngleInput = TC_AngleInput;
constexpr Tag IO_XSizeInput = TC_XSizeInput;
constexpr Tag IO_YSizeInput = TC_YSizeInput;
constexpr Tag IO_PivotInput = TC_PivotInput;
constexpr Tag IO_ShearInput = TC_ShearInput;
constexpr Tag IO_KeepAspect = TC_KeepAspect;
constexpr Tag IO_ShowFrame = TC_ShowFrame;
constexpr Tag IOD_FrameWidth = TCD_FrameWidth;
constexpr Tag IOD_FrameHeight = TCD_FrameHeight;
constexpr Tag IOD_RingRadius = TCD_RingRadius;
// Its own.
constexpr Tag IO_BlendMode = 0x10058007;         // 0 over by alpha, 1 multiply, 2 screen
constexpr Tag IO_FitImage = 0x10058008;          // the frame's height follows the image's shape
constexpr Tag IO_FlipX = 0x10058009;             // the image mirrored left to right in the frame
constexpr Tag IO_FlipY = 0x1005800a;             // and top to bottom
constexpr Tag IO_ShowHandles = 0x1005800b;       // off: the image alone, nothing to grab (default on)
constexpr Tag IO_BorderStyle = 0x1005800c;       // the frame's pen: 0 solid, 1..4 dashed as the rectangle's
constexpr Tag IO_BorderColor = 0x1005800d;       // the frame's colour
constexpr Tag IO_HideWhileDragging = 0x1005800e; // the image is not drawn while the frame is dragged
constexpr Tag IOD_Opacity = 0x20058003;          // where no opacity Input is linked (default 1)
constexpr Tag IOD_Gain = 0x20058004;             // the image's brightness (default 1)
constexpr Tag IOD_CropLeft = 0x20058005;         // share of the image cut away on each side (0..1)
constexpr Tag IOD_CropBottom = 0x20058006;
constexpr Tag IOD_CropRight = 0x20058007;
constexpr Tag IOD_CropTop = 0x20058008;
constexpr Tag IOD_BorderWidth = 0x20058009; // the frame's line width, viewer pixels (default 1)
constexpr Tag IOS_Label = 0x30058000;       // a text at the frame's top-left corner
constexpr Tag IOID_Image = 0x80058000;      // the image Input
constexpr Tag IOP_Image = 0x60058000;
constexpr Tag IOID_Opacity = 0x80058001; // a Number Input 0..1
constexpr Tag IOP_Opacity = 0x60058001;
constexpr Tag IOID_Visible = 0x80058002; // a Number Input; 0 hides the image
constexpr Tag IOP_Visible = 0x60058002;

extern const TagMapEntry ImgOverlayControlTags[];

} // namespace Orbane

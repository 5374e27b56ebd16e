#include "framework/ImgOverlayTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ImgOverlayControlTags[] = {
    ORBANE_TAG(IO_AngleInput, TMK_Plain),
    ORBANE_TAG(IO_XSizeInput, TMK_Plain),
    ORBANE_TAG(IO_YSizeInput, TMK_Plain),
    ORBANE_TAG(IO_PivotInput, TMK_Plain),
    ORBANE_TAG(IO_ShearInput, TMK_Plain),
    ORBANE_TAG(IO_KeepAspect, TMK_Boolean),
    ORBANE_TAG(IO_ShowFrame, TMK_Boolean),
    ORBANE_TAG(IOD_FrameWidth, TMK_Plain),
    ORBANE_TAG(IOD_FrameHeight, TMK_Plain),
    ORBANE_TAG(IOD_RingRadius, TMK_Plain),
    ORBANE_TAG(IO_BlendMode, TMK_Plain),
    ORBANE_TAG(IO_FitImage, TMK_Boolean),
    ORBANE_TAG(IO_FlipX, TMK_Boolean),
    ORBANE_TAG(IO_FlipY, TMK_Boolean),
    ORBANE_TAG(IO_ShowHandles, TMK_Boolean),
    ORBANE_TAG(IO_BorderStyle, TMK_Plain),
    ORBANE_TAG(IO_BorderColor, TMK_Color),
    ORBANE_TAG(IO_HideWhileDragging, TMK_Boolean),
    ORBANE_TAG(IOD_Opacity, TMK_Plain),
    ORBANE_TAG(IOD_Gain, TMK_Plain),
    ORBANE_TAG(IOD_CropLeft, TMK_Plain),
    ORBANE_TAG(IOD_CropBottom, TMK_Plain),
    ORBANE_TAG(IOD_CropRight, TMK_Plain),
    ORBANE_TAG(IOD_CropTop, TMK_Plain),
    ORBANE_TAG(IOD_BorderWidth, TMK_Plain),
    ORBANE_TAG(IOS_Label, TMK_Plain),
    ORBANE_TAG(IOID_Image, TMK_Plain),
    ORBANE_OBJECT_TAG(IOP_Image, "Input"),
    ORBANE_TAG(IOID_Opacity, TMK_Plain),
    ORBANE_OBJECT_TAG(IOP_Opacity, "Input"),
    ORBANE_TAG(IOID_Visible, TMK_Plain),
    ORBANE_OBJECT_TAG(IOP_Visible, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane

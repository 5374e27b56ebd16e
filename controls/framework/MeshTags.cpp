#include "framework/MeshTags.h"

#include "framework/TagTable.h"

namespace Orbane {

namespace {

const EnumEntry VertexShapeEnum[] = {
    {ENUM_NameRow, "VertexShape"}, {0, "Square"}, {1, "Disc"}, {2, "Diamond"}, {0, nullptr},
};

const EnumEntry LineStyleEnum[] = {
    {ENUM_NameRow, "LineStyle"}, {0, "Solid"}, {1, "Dash"}, {2, "Dot"}, {0, nullptr},
};

} // namespace

const TagMapEntry MeshControlTags[] = {
    ORBANE_TAG(MSC_Columns, TMK_Plain),
    ORBANE_TAG(MSC_Rows, TMK_Plain),
    ORBANE_TAG(MSC_ShowVertices, TMK_Boolean),
    ORBANE_TAG(MSC_ShowRows, TMK_Boolean),
    ORBANE_TAG(MSC_ShowColumns, TMK_Boolean),
    ORBANE_TAG(MSC_ShowBorder, TMK_Boolean),
    ORBANE_TAG(MSC_ShowDiagonals, TMK_Boolean),
    ORBANE_TAG(MSC_LineEvery, TMK_Plain),
    ORBANE_ENUM_TAG(MSC_VertexShape, VertexShapeEnum),
    ORBANE_ENUM_TAG(MSC_LineStyle, LineStyleEnum),
    ORBANE_TAG(MSC_LockBorder, TMK_Boolean),
    ORBANE_TAG(MSC_LockCorners, TMK_Boolean),
    ORBANE_TAG(MSC_SlideBorder, TMK_Boolean),
    ORBANE_TAG(MSC_SnapToPixels, TMK_Boolean),
    ORBANE_TAG(MSC_SnapToGrid, TMK_Boolean),
    ORBANE_TAG(MSC_ClampToImage, TMK_Boolean),
    ORBANE_TAG(MSC_BoxSelect, TMK_Boolean),
    ORBANE_TAG(MSC_ReadOnly, TMK_Boolean),
    ORBANE_TAG(MSC_ShowLabels, TMK_Boolean),
    ORBANE_TAG(MSC_HideWhileDragging, TMK_Boolean),
    ORBANE_TAG(MSC_ShowRest, TMK_Boolean),
    ORBANE_TAG(MSC_HandleColor, TMK_Color),
    ORBANE_TAG(MSC_LineColor, TMK_Color),
    ORBANE_TAG(MSC_SelectedColor, TMK_Color),
    ORBANE_TAG(MSC_BorderColor, TMK_Color),
    ORBANE_TAG(MSC_RestColor, TMK_Color),
    ORBANE_TAG(MSC_BoxColor, TMK_Color),
    ORBANE_TAG(MSC_MirrorX, TMK_Boolean),
    ORBANE_TAG(MSCD_VertexSize, TMK_Plain),
    ORBANE_TAG(MSCD_LineWidth, TMK_Plain),
    ORBANE_TAG(MSCD_BorderWidth, TMK_Plain),
    ORBANE_TAG(MSCD_SnapSpacing, TMK_Plain),
    ORBANE_TAG(MSCD_Opacity, TMK_Plain),
    ORBANE_TAG(MSCD_Falloff, TMK_Plain),
    ORBANE_TAG(MSCD_FineFactor, TMK_Plain),
    ORBANE_TAG(MSCD_NudgeStep, TMK_Plain),
    ORBANE_TAG(MSCS_Label, TMK_Plain),
    ORBANE_TAG(MSCID_Rest, TMK_Plain),
    ORBANE_OBJECT_TAG(MSCP_Rest, "Input"),
    ORBANE_TAG(MSCID_Offset, TMK_Plain),
    ORBANE_OBJECT_TAG(MSCP_Offset, "Input"),
    ORBANE_TAG(MSCID_Visible, TMK_Plain),
    ORBANE_OBJECT_TAG(MSCP_Visible, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane

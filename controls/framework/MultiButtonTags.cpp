#include "framework/MultiButtonTags.h"

#include "framework/TagEnums.h"
#include "framework/TagTable.h"

namespace Orbane {

const EnumEntry WidthModeEnum[] = {
    {ENUM_NameRow, "WidthMode"}, {0, "Fill"}, {1, "Equal"}, {2, "Text"}, {0, nullptr},
};

const EnumEntry IconPositionEnum[] = {
    {ENUM_NameRow, "IconPosition"},
    {0, "Left"},
    {1, "Top"},
    {0, nullptr},
};

const TagMapEntry MultiButtonControlTags[] = {
    ORBANE_TAG(MBTNC_Columns, TMK_Plain),
    ORBANE_ENUM_TAG(MBTNC_WidthMode, WidthModeEnum),
    ORBANE_TAG(MBTNC_MinButtonWidth, TMK_Plain),
    ORBANE_TAG(MBTNC_MaxButtonWidth, TMK_Plain),
    ORBANE_TAG(MBTNC_ButtonHeight, TMK_Plain),
    ORBANE_TAG(MBTNC_HSpacing, TMK_Plain),
    ORBANE_TAG(MBTNC_VSpacing, TMK_Plain),
    ORBANE_ENUM_TAG(MBTNC_Align, AlignEnum),
    ORBANE_ENUM_TAG(MBTNC_LabelPosition, LabelPositionEnum),
    ORBANE_TAG(MBTNC_ShowLabel, TMK_Boolean),
    ORBANE_TAG(MBTNC_AlphaSort, TMK_Boolean),
    ORBANE_TAG(MBTNC_IconsOnly, TMK_Boolean),
    ORBANE_TAG(MBTNC_IconSize, TMK_Plain),
    ORBANE_ENUM_TAG(MBTNC_IconPosition, IconPositionEnum),
    ORBANE_TAG(MBTNC_Flat, TMK_Boolean),
    ORBANE_TAG(MBTNC_AllowNone, TMK_Boolean),
    ORBANE_TAG(MBTNC_BoldChosen, TMK_Boolean),
    ORBANE_TAG(MBTNC_CheckedColor, TMK_Color),
    ORBANE_TAG(MBTNC_CheckedTextColor, TMK_Color),
    ORBANE_TAG(MBTNC_TextColor, TMK_Color),
    ORBANE_TAG(MBTNC_ButtonColor, TMK_Color),
    ORBANE_TAG(MBTNC_KeyNavigation, TMK_Boolean),
    ORBANE_TAG(MBTNCS_Tooltip, TMK_Plain),
    ORBANE_TAG(MBTNCS_UndoName, TMK_Plain),
    ORBANE_TAG(MBTNCS_AddButton, TMK_Plain),
    ORBANE_TAG(MBTNCS_AddSeparator, TMK_Plain),
    ORBANE_TAG(MBTNCID_AddID, TMK_Plain),
    ORBANE_TAG(MBTNCD_ButtonValue, TMK_Plain),
    ORBANE_TAG(MBTNC_ButtonInteger, TMK_Plain),
    ORBANE_TAG(MBTNCS_ButtonTip, TMK_Plain),
    ORBANE_TAG(MBTNCS_ButtonIcon, TMK_Plain),
    ORBANE_TAG(MBTNC_ButtonDisabled, TMK_Boolean),
    ORBANE_TAG(MBTNC_ButtonNewRow, TMK_Boolean),
    ORBANE_TAG_END,
};

} // namespace Orbane

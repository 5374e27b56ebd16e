#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of MultiButtonControl (both the number and the identifier
// variant). The row's own look first, then its texts, then the items: each
// MBTNCS_AddButton starts a button, and the item tags after it, up to the
// next button or separator, describe that button.
constexpr Tag MBTNC_Columns = 0x10050000;          // buttons per row; 0: as many as the width holds
constexpr Tag MBTNC_WidthMode = 0x10050001;        // "WidthMode": Fill, Equal, Text
constexpr Tag MBTNC_MinButtonWidth = 0x10050002;   // pixels
constexpr Tag MBTNC_MaxButtonWidth = 0x10050003;   // pixels; 0: no limit
constexpr Tag MBTNC_ButtonHeight = 0x10050004;     // pixels; 0: the style's
constexpr Tag MBTNC_HSpacing = 0x10050005;         // pixels between buttons of a row
constexpr Tag MBTNC_VSpacing = 0x10050006;         // pixels between rows
constexpr Tag MBTNC_Align = 0x10050007;            // "Align": where buttons that do not fill sit
constexpr Tag MBTNC_LabelPosition = 0x10050008;    // "LabelPosition": label beside or over the buttons
constexpr Tag MBTNC_ShowLabel = 0x10050009;        // show the label (default true)
constexpr Tag MBTNC_AlphaSort = 0x1005000A;        // sort the buttons by text
constexpr Tag MBTNC_IconsOnly = 0x1005000B;        // a button with an icon shows no text (it becomes the tip)
constexpr Tag MBTNC_IconSize = 0x1005000C;         // icon size in pixels
constexpr Tag MBTNC_IconPosition = 0x1005000D;     // "IconPosition": Left, Top of the text
constexpr Tag MBTNC_Flat = 0x1005000E;             // buttons not chosen have no frame
constexpr Tag MBTNC_AllowNone = 0x1005000F;        // a click on the chosen button clears the choice
constexpr Tag MBTNC_BoldChosen = 0x10050010;       // the chosen button's text is bold
constexpr Tag MBTNC_CheckedColor = 0x10050011;     // fill of the chosen button
constexpr Tag MBTNC_CheckedTextColor = 0x10050012; // text of the chosen button
constexpr Tag MBTNC_TextColor = 0x10050013;        // text of the other buttons
constexpr Tag MBTNC_ButtonColor = 0x10050014;      // fill of the other buttons
constexpr Tag MBTNC_KeyNavigation = 0x10050015;    // Left and Right choose the neighbour (default true)
constexpr Tag MBTNCS_Tooltip = 0x30050000;         // tip over the label
constexpr Tag MBTNCS_UndoName = 0x30050001;        // name of the undo step of a choice
constexpr Tag MBTNCS_AddButton = 0x38040000;       // starts a button (repeatable)
constexpr Tag MBTNCS_AddSeparator = 0x38040001;    // a gap before the next button (repeatable)
constexpr Tag MBTNCID_AddID = 0x88030000;          // the button's identifier (repeatable)
constexpr Tag MBTNCD_ButtonValue = 0x28030000;     // the button's value (repeatable)
constexpr Tag MBTNC_ButtonInteger = 0x18040000;    // sent with the button's writes (repeatable)
constexpr Tag MBTNCS_ButtonTip = 0x38050000;       // the button's tip (repeatable)
constexpr Tag MBTNCS_ButtonIcon = 0x38050001;      // skin image item of the button's icon (repeatable)
constexpr Tag MBTNC_ButtonDisabled = 0x18050000;   // the button cannot be chosen (repeatable)
constexpr Tag MBTNC_ButtonNewRow = 0x18050001;     // the button starts a new row (repeatable)

extern const TagMapEntry MultiButtonControlTags[];
extern const EnumEntry WidthModeEnum[];
extern const EnumEntry IconPositionEnum[];

} // namespace Orbane

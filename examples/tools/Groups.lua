-- Groups: a folding group of button rows, lists and check boxes, a nested
-- group inside it, a separator and a spacer, a point's X and Y, and a screw.
--
-- Click a group's header to fold it (Ctrl-click folds every group); the
-- open state is the header Input's value, so each tool keeps its own.
-- Gang's buttons flow into rows as the inspector narrows; Quality holds
-- an identifier. Channels keeps its boxes as the bits of one number.
-- Drag Center's X or Y box sideways (Ctrl fine, Shift coarse) or type into
-- it; the viewer's point follows. Turn Spin's wheel, or use the mouse wheel.
local AddString, AddSeparator, Value, Tip = 0x38040000, 0x38040001, 0x28030000, 0x38050000
local ID, Icon, Disabled, NewRow = 0x88030000, 0x38050001, 0x18050000, 0x18050001
local MultiSelect = 0x10050002

return {
  type = "Groups",
  inputs = {
    { id = "Look", name = "Look", type = "Number", default = 1,
      control = "NestControl", tags = { LBLC_NumInputs = 6, LBLC_Bold = true } },
    { id = "Gang", name = "Gang", type = "Number", default = 0,
      control = "MultiButtonControl",
      tags = { MBTNC_WidthMode = "Equal", MBTNC_BoldChosen = true, MBTNCS_UndoName = "Choose gang" },
      attrs = {
        { AddString, "One" }, { Tip, "A single gang" },
        { AddString, "Two" },
        { AddString, "Three" },
        { AddSeparator, "" },
        { AddString, "Four" }, { Icon, "Controls.Slider.Knob.1" },
        { AddString, "Eight" }, { Value, 8 },
        { AddString, "Sixteen" }, { Value, 16 }, { Disabled, 1 },
      } },
    { id = "Quality", name = "Quality", type = "ID", default = "good",
      control = "MultiButtonIDControl",
      tags = { MBTNC_Columns = 2, MBTNC_LabelPosition = "Vertical",
               MBTNC_CheckedColor = { R = 0.25, G = 0.45, B = 0.8 } },
      attrs = {
        { AddString, "Draft" }, { ID, "draft" },
        { AddString, "Good" }, { ID, "good" },
        { AddString, "Best" }, { ID, "best" }, { NewRow, 1 },
      } },
    { id = "Details", name = "Details", type = "Number", default = 1,
      control = "LabelControl",
      tags = { LBLC_DropDownButton = true, LBLC_NumInputs = 2, LBLC_NestLevel = 1 } },
    { id = "Colour", name = "Colour", type = "Number", default = 2,
      control = "ListControl", tags = { LC_Rows = 4 },
      attrs = {
        { AddString, "Red" }, { AddString, "Green" }, { AddString, "Blue" },
        { AddString, "Cyan" }, { AddString, "Magenta" }, { AddString, "Yellow" }, { AddString, "Black" },
      } },
    { id = "Channels", name = "Channels", type = "Number", default = 7,
      control = "CheckListControl", tags = { CLC_Columns = 2 },
      attrs = {
        { AddString, "Red" }, { AddString, "Green" }, { AddString, "Blue" },
        { AddString, "Alpha" }, { Value, 7 }, { Tip, "Bit 7: 128" },
      } },
    { id = "Line", type = "Number", control = "SeparatorControl",
      tags = { LBLC_Height = 12, LBLC_LineColor = { R = 0.5, G = 0.5, B = 0.55 } } },
    { id = "Layers", name = "Layers", type = "Number", default = 1 + 4,
      control = "ListControl", tags = { LC_Rows = 3 },
      attrs = {
        { MultiSelect, 1 },
        { AddString, "Background" }, { AddString, "Matte" }, { AddString, "Foreground" }, { AddString, "Grain" },
      } },
    { id = "Gap", type = "Number", control = "SpacerControl", tags = { LBLC_Height = 10 } },
    { id = "Center", name = "Center", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl", overlay = "PointControl", tags = { OFCD_DragStep = 0.002 } },
    { id = "Spin", name = "Spin", type = "Number", default = 0,
      control = "ScrewControl", tags = { SCRD_Step = 0.5 } },
  },
}

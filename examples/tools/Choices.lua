-- Choices: combo boxes and a script value list.
--
-- Blend holds a number: each item's value is its place among the items
-- (separators do not count) unless it gives its own (0x28030000). Channel
-- holds an identifier and Filter a text, each item's identifier given
-- (0x88030000) or its text. While a list is open, the item under the mouse
-- or the keys is applied at once; Escape puts the value back.
-- Metadata is a script table, shown as a tree of keys and values; select
-- rows and press Ctrl+C to copy them as tab-separated text.
local AddString, AddSeparator = 0x38040000, 0x38040001
local Value, SecondText, ID = 0x28030000, 0x38050000, 0x88030000

return {
  type = "Choices",
  inputs = {
    -- Normal 0, Add 1, Subtract 10 (its own), Multiply 3, Screen 4.
    { id = "Blend", name = "Blend", type = "Number", default = 0,
      control = "ComboControl",
      attrs = {
        { AddString, "Normal" },
        { AddSeparator, "" },
        { AddString, "Add" },
        { AddString, "Subtract" }, { Value, 10 },
        { AddString, "Multiply" },
        { AddSeparator, "" },
        { AddString, "Screen" }, { SecondText, "Multiplies the inverses" },
      } },
    -- Sorted by name, the label over the list.
    { id = "Channel", name = "Channel", type = "ID", default = "green",
      control = "ComboIDControl",
      tags = { CC_LabelPosition = "Vertical", CC_AlphaSort = true },
      attrs = {
        { AddString, "Red" }, { ID, "red" },
        { AddString, "Green" }, { ID, "green" },
        { AddString, "Blue" }, { ID, "blue" },
        { AddString, "Alpha" }, { ID, "alpha" },
      } },
    -- A text Input; names sort with their numbers: Lanczos 3 before Lanczos 10.
    { id = "Filter", name = "Filter", type = "Text", default = "Box",
      control = "ComboIDControl",
      tags = { CC_AlphaSort = true, CCS_AddString = { "Lanczos 10", "Box", "Lanczos 3", "Gaussian" } } },
    { id = "Metadata", name = "Metadata", type = "ScriptVal",
      control = "ScriptValListControl",
      tags = { LC_Rows = 8 },
      default = {
        Filename = "plate_v003.exr",
        FrameRate = 24,
        Camera = { Make = "Arri", Model = "Alexa 35", ISO = 800 },
        Channels = { "R", "G", "B", "A" },
        Lens = { FocalLength = 35, Distortion = { k1 = 0.01 } },
      } },
  },
}

-- Viewer overlays: angles turned about the tool's centre. Drag the ring of
-- the Angle dial round (past 360 it keeps counting turns) or press Left and
-- Right over it (Shift: ten degrees, Control: a tenth). The Spread dial shows
-- no ring: grab the end of its arm, which reaches as far as Size says.
local MinScale, MaxScale, Places = 0x20030002, 0x20030003, 0x10040004
local DialStyle = 0x10058000

return {
  type = "Dials",
  inputs = {
    { id = "Center", name = "Center", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl", overlay = "CrosshairControl", tags = { CHC_Style = 1 } },
    { id = "Size", name = "Size", type = "Number", default = 0.25,
      control = "SliderControl", attrs = { [MinScale] = 0, [MaxScale] = 0.5, [Places] = 3 } },
    { id = "Angle", name = "Angle", type = "Number", default = 30,
      control = "SliderControl", overlay = "AngleControl", tags = { ACID_Center = "Center" },
      attrs = { [MinScale] = -360, [MaxScale] = 360, [Places] = 2 } },
    { id = "Spread", name = "Spread", type = "Number", default = 120,
      control = "SliderControl", overlay = "AngleControl",
      tags = { ACID_Center = "Center", ACID_Radius = "Size", ACD_RadiusScale = 1, ACD_MinRadius = 0.05 },
      attrs = { [MinScale] = -360, [MaxScale] = 360, [Places] = 2, [DialStyle] = 0 } },
  },
}

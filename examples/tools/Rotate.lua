-- A rotation tool: an angle dial at the tool's centre. Drag round the dial
-- to turn; the angle keeps counting past a full turn instead of jumping
-- back to 0. The dial's radius follows the Radius Input. Its style, a
-- tag without a script name (0x10058000), is given by number: 1 draws the
-- dial and grabs its ring.
local DialStyle = 0x10058000
local MinScale, MaxScale = 0x20030002, 0x20030003
return {
  type = "Rotate",
  inputs = {
    { id = "Angle", name = "Angle", type = "Number", default = 30,
      control = "SliderControl", overlay = "AngleControl",
      attrs = { [MinScale] = -360, [MaxScale] = 360 },
      tags = { ACP_Center = "Center", ACP_Radius = "Radius", [DialStyle] = 1 } },
    { id = "Center", name = "Center", type = "Point", default = { 0.62, 0.55 },
      control = "OffsetControl", overlay = "CrosshairControl" },
    { id = "Radius", name = "Radius", type = "Number", default = 0.3,
      control = "SliderControl" },
  },
}

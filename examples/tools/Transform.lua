-- A Transform-like tool: a rectangle over the demo image that shows the
-- tool's frame. Drag an edge to change Width or Height, a corner for both;
-- the edge under the mouse lights up. The rectangle turns by Angle about
-- the pivot Axis (a point of the rectangle, 0..1 across each side) placed
-- on Center, and scales by Size; Flip X mirrors it about the pivot.
-- Width and Height are in image widths, so the frame stays rigid as it turns.
-- The Inset image is shown inside, laid over at 60 % (RC_BlendMode 0: over
-- by alpha, 1: multiply, 2: screen).
local MinScale, MaxScale = 0x20030002, 0x20030003
return {
  type = "Transform",
  inputs = {
    { id = "Width", name = "Width", type = "Number", default = 0.5,
      control = "SliderControl", overlay = "RectangleControl",
      overlayInputs = { "Height" },
      tags = { RCP_Center = "Center", RCP_Angle = "Angle", RCP_Size = "Size",
               RCP_Axis = "Axis", RCP_FlipX = "FlipX", RCP_Image = "Inset",
               RC_PenStyle = 0, RC_BlendMode = 0, RCD_BlendAmount = 0.6 } },
    { id = "Height", name = "Height", type = "Number", default = 0.25,
      control = "SliderControl" },
    { id = "Center", name = "Center", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl", overlay = "CrosshairControl" },
    { id = "Angle", name = "Angle", type = "Number", default = 15,
      control = "SliderControl", attrs = { [MinScale] = -180, [MaxScale] = 180 } },
    { id = "Size", name = "Size", type = "Number", default = 1,
      control = "SliderControl", attrs = { [MaxScale] = 4 } },
    { id = "Axis", name = "Pivot", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl" },
    { id = "FlipX", name = "Flip X", type = "Number", default = 0,
      control = "CheckboxControl" },
    { id = "Inset", name = "Inset", type = "Image", default = "../images/dusk.png" },
  },
}

-- Two-dimensional layer handles over the demo image. The Center's
-- transform handle moves the layer (Ctrl-drag the centre: move the pivot,
-- the layer stays), the ring turns it, the side and corner knobs scale it
-- (Shift: both axes, Ctrl: about the opposite side) and the bar above the
-- top edge shears it. Its further Inputs are taken in order: Angle (1),
-- X Size (2), Y Size (3), Pivot (4), Shear (5); TCD_FrameWidth makes the
-- layer half the image wide. The Drift arrow starts at the Center and its
-- tip edits the offset; the Badge positioner places a box, snapped to
-- whole pixels.
local MinScale, MaxScale = 0x20030002, 0x20030003
return {
  type = "Layers",
  inputs = {
    { id = "Center", name = "Center", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl", overlay = "TransformControl",
      overlayInputs = { "Angle", "XSize", "YSize", "Pivot", "Shear" },
      tags = { TCD_FrameWidth = 0.5, TCD_FrameHeight = 0.28 } },
    { id = "Angle", name = "Angle", type = "Number", default = 10,
      control = "SliderControl", attrs = { [MinScale] = -180, [MaxScale] = 180 } },
    { id = "XSize", name = "X Size", type = "Number", default = 1,
      control = "SliderControl", attrs = { [MaxScale] = 4 } },
    { id = "YSize", name = "Y Size", type = "Number", default = 1,
      control = "SliderControl", attrs = { [MaxScale] = 4 } },
    { id = "Pivot", name = "Pivot", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl" },
    { id = "Shear", name = "Shear", type = "Number", default = 0,
      control = "SliderControl", attrs = { [MinScale] = -1, [MaxScale] = 1 } },
    { id = "Drift", name = "Drift", type = "Point", default = { 0.15, 0.1 },
      control = "OffsetControl", overlay = "XYOffsetControl",
      tags = { XOP_Center = "Center" } },
    { id = "Badge", name = "Badge", type = "Point", default = { 0.2, 0.78 },
      control = "OffsetControl", overlay = "PositionerControl",
      tags = { PSD_Width = 0.2, PSD_Height = 0.08, PSD_Angle = -8, PS_SnapToPixels = true } },
  },
}

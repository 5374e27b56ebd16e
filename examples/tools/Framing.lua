-- Framing the demo image: a crop box (drag its edges, corners or inside;
-- Shift or Keep Aspect holds its shape) darkens what it leaves out, and a
-- picture-in-picture inset laid over it in a transform's frame, with its
-- own handles, opacity and label; the opacity has a slider in the viewer
-- too (bottom left: drag the knob, Ctrl finer, or click the track). The
-- Glow ellipse sits on the sun: its axis knobs resize it (Shift both, Ctrl
-- about the opposite knob), the diamond beyond +X turns it and the knob off
-- its top edge widens the soft edge between its dotted ellipses. The crop takes its Inputs in order:
-- Corner (0, the lower-left corner), Size (1) and Keep Aspect (2).
local MaxScale = 0x20030003
return {
  type = "Framing",
  inputs = {
    { id = "Corner", name = "Corner", type = "Point", default = { 0.08, 0.1 },
      control = "OffsetControl", overlay = "CropControl",
      overlayInputs = { "Size", "KeepAspect" } },
    { id = "Size", name = "Size", type = "Point", default = { 0.84, 0.8 },
      control = "OffsetControl" },
    { id = "KeepAspect", name = "Keep Aspect", type = "Number", default = 0,
      control = "CheckboxControl" },
    { id = "InsetCenter", name = "Inset Center", type = "Point", default = { 0.74, 0.7 },
      control = "OffsetControl", overlay = "ImgOverlayControl",
      overlayInputs = { "InsetSize" },
      tags = { IO_AngleInput = -1, IO_XSizeInput = 1, IO_YSizeInput = -1, IO_PivotInput = -1,
               IO_ShearInput = -1, IOD_FrameWidth = 0.3, IO_FitImage = true,
               IOP_Image = "Inset", IOP_Opacity = "InsetOpacity", IOS_Label = "Inset",
               IO_BorderStyle = 2 } },
    { id = "InsetSize", name = "Inset Size", type = "Number", default = 1,
      control = "SliderControl", attrs = { [MaxScale] = 2 } },
    { id = "InsetOpacity", name = "Inset Opacity", type = "Number", default = 0.8,
      control = "SliderControl", overlay = "SliderOverlay" },
    { id = "Inset", name = "Inset", type = "Image", default = "../images/dusk.png" },
    { id = "Glow", name = "Glow", type = "Point", default = { 0.655, 0.43 },
      control = "OffsetControl", overlay = "EllipseControl",
      overlayInputs = { "GlowWidth", "GlowHeight", "GlowAngle", "GlowSoftness" },
      tags = { EC_ShowAxes = true, ECS_Label = "Glow" } },
    { id = "GlowWidth", name = "Glow Width", type = "Number", default = 0.12,
      control = "SliderControl" },
    { id = "GlowHeight", name = "Glow Height", type = "Number", default = 0.08,
      control = "SliderControl" },
    { id = "GlowAngle", name = "Glow Angle", type = "Number", default = 20,
      control = "SliderControl", attrs = { [0x20030002] = -180, [MaxScale] = 180 } },
    { id = "GlowSoftness", name = "Glow Softness", type = "Number", default = 0.04,
      control = "SliderControl", attrs = { [MaxScale] = 0.2 } },
  },
}

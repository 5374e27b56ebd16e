-- Colour controls. A colour is up to four Number Inputs: the control stands
-- on red and names green, blue and alpha by their ids. Drag a channel's track,
-- type a hex code (#RRGGBB, #RRGGBBAA, as the screen shows it) or three
-- numbers of the second view (click "HSV" to go to HLS, then YUV), double
-- click the swatch for the system colour dialog, or press "Pick" and click a
-- pixel of the viewer (drag a box for its average). Values keep what the
-- screen cannot show (above 1, below 0).
return {
  type = "Colour",
  inputs = {
    { id = "TintRed", name = "Tint", type = "Number", default = 1.0,
      control = "ColorControl",
      tags = { CLRCP_GreenInput = "TintGreen", CLRCP_BlueInput = "TintBlue",
               CLRCP_AlphaInput = "TintAlpha", CLRC_ColorSpace = "HSV" } },
    { id = "TintGreen", name = "Tint Green", type = "Number", default = 0.55 },
    { id = "TintBlue", name = "Tint Blue", type = "Number", default = 0.2 },
    { id = "TintAlpha", name = "Tint Alpha", type = "Number", default = 1.0 },
    -- RGB only, sliders up to 4 for light above white, no picker.
    { id = "GlowRed", name = "Glow", type = "Number", default = 2.0,
      control = "ColorControl",
      tags = { CLRCP_GreenInput = "GlowGreen", CLRCP_BlueInput = "GlowBlue",
               CLRC_ColorSpace = "HLS", CLRC_ShowPicker = false, CLRCD_MaxScale = 4 } },
    { id = "GlowGreen", name = "Glow Green", type = "Number", default = 1.5 },
    { id = "GlowBlue", name = "Glow Blue", type = "Number", default = 0.5 },
    -- Grading wheels: the puck is a Point (its angle the hue, its length the
    -- saturation), the master a Number whose range follows the role. Drag
    -- the puck (Ctrl finer, Shift along hue or saturation), double click to
    -- centre it; Alt-click the master's track for its neutral value.
    { id = "Lift", name = "Lift", type = "Point", default = { 0, 0 },
      control = "ColorWheelControl",
      tags = { CWCP_MasterInput = "LiftMaster", CWC_Role = "Lift" } },
    { id = "LiftMaster", name = "Lift Master", type = "Number", default = 0 },
    { id = "Gain", name = "Gain", type = "Point", default = { 0.1, 0.05 },
      control = "ColorWheelControl",
      tags = { CWCP_MasterInput = "GainMaster", CWC_Role = "Gain", CWCD_Rim = 0.5 } },
    { id = "GainMaster", name = "Gain Master", type = "Number", default = 1 },
    -- A gradient is a script table: click the bar to add a stop, drag a marker
    -- to move it or off the bar to delete it, double click it for its colour.
    { id = "Ramp", name = "Ramp", type = "ScriptVal", control = "GradientControl",
      default = { interpolation = "smooth",
                  stops = { { 0, 0.02, 0.02, 0.1, 1 }, { 0.45, 0.8, 0.25, 0.05, 1 }, { 1, 1, 0.95, 0.8, 1 } } },
      tags = { GRDC_ShowAlpha = false, GRDC_MaxStops = 8 } },
    -- Suppression of six hues: press or drag along a spoke of the hexagon
    -- (Ctrl finer), or type into the boxes.
    { id = "SupRed", name = "Suppress", type = "Number", default = 0.2,
      control = "ColorSuppressionControl",
      tags = { CSCP_YellowInput = "SupYellow", CSCP_GreenInput = "SupGreen", CSCP_CyanInput = "SupCyan",
               CSCP_BlueInput = "SupBlue", CSCP_MagentaInput = "SupMagenta", CSCD_Maximum = 1 } },
    { id = "SupYellow", name = "Suppress Yellow", type = "Number", default = 0 },
    { id = "SupGreen", name = "Suppress Green", type = "Number", default = 0.6 },
    { id = "SupCyan", name = "Suppress Cyan", type = "Number", default = 0 },
    { id = "SupBlue", name = "Suppress Blue", type = "Number", default = 0.3 },
    { id = "SupMagenta", name = "Suppress Magenta", type = "Number", default = 0 },
    -- A working space's gamut on the CIE 1931 xy diagram: choose a space, or
    -- drag a primary or the white point for a custom one.
    { id = "Gamut", name = "Gamut", type = "ScriptVal", control = "ColorGamutControl",
      default = { space = "Rec. 2020" } },
    -- A tiled pattern, chosen by clicking its preview (the value is its index).
    { id = "Fill", name = "Fill", type = "Number", default = 0, control = "PatternControl",
      tags = { PTNC_TileSize = 8, PTNC_InkColor = 0xFF66CCFF } },
    -- An image Input shown as a thumbnail with its size and channels.
    { id = "Plate", name = "Plate", type = "Image", default = "../images/dusk.png", control = "ImageControl" },
  },
}

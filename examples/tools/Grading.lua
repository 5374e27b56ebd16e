-- Grading: the tone controls.
--
-- Curves is a script table of curves by name (luma, red, green, blue,
-- alpha), each an array of {x, y} points, `linear = true` for straight
-- segments; a curve left out is the identity. Click in the graph to add a
-- point, drag to move it (Ctrl finer, Shift on the grid), double-click or
-- Delete to remove it; the wheel zooms, a middle drag pans, Home resets the
-- view. The buttons choose the curve.
--
-- Levels: the input black, gamma and white over the viewed image's
-- histogram (choose its channel and scale); drag a handle (Ctrl finer),
-- double-click it for its default, or type. Output levels map into black
-- and white over a ramp. The histogram's Input holds the channel shown.
--
-- Gamma: type it or drag the handle over 0.5 up and down. Log: the
-- conversion of 10-bit log code values to linear, a table of black and white
-- code values, film gamma and soft clip, drawn as a curve.
--
-- Ranges: the shadows fall from lowStart to lowEnd, the highlights rise from
-- highStart to highEnd; drag the four ends sideways. The midtones (dashed)
-- are what is left.
--
-- Kernel: a convolution kernel as its rows; type the cells, choose its size,
-- put in a preset or normalise it (refused where the cells sum to 0).
return {
  type = "Grading",
  inputs = {
    { id = "Curves", name = "Curves", type = "ScriptVal",
      control = "SplineControl",
      tags = { SPC_ShowAlpha = true, SPC_ShowHistogram = true, SPC_Height = 150,
               SPC_SplineColor = { R = 0.9, G = 0.9, B = 0.9, A = 1 } },
      default = {
        luma = { { 0, 0 }, { 0.25, 0.2 }, { 0.75, 0.82 }, { 1, 1 } },
        red = { { 0, 0.02 }, { 1, 1 } },
      } },
    { id = "InBlack", name = "Input Levels", type = "Number", default = 0.02,
      control = "LevelsControl",
      tags = { LVLCP_GammaInput = "InGamma", LVLCP_WhiteInput = "InWhite", LVLC_LogScale = true } },
    { id = "InGamma", name = "Gamma", type = "Number", default = 1.2 },
    { id = "InWhite", name = "White", type = "Number", default = 0.95 },
    { id = "OutBlack", name = "Output Levels", type = "Number", default = 0.05,
      control = "LevelsOutputControl",
      tags = { LVLOCP_WhiteInput = "OutWhite", LVLOC_GradientColor = { R = 1, G = 0.85, B = 0.6, A = 1 } } },
    { id = "OutWhite", name = "Output White", type = "Number", default = 1 },
    { id = "Channel", name = "Histogram", type = "Number", default = 0,
      control = "HistogramControl" },
    { id = "Gamma", name = "Gamma", type = "Number", default = 2.2,
      control = "GammaControl" },
    { id = "Log", name = "Log to Linear", type = "ScriptVal",
      control = "LogControl",
      default = { black = 95, white = 685, filmGamma = 0.6, softClip = 0.2 } },
    { id = "Ranges", name = "Ranges", type = "ScriptVal",
      control = "ColorRangesControl",
      tags = { CRC_SmoothFalloff = true, CRC_ShowMidtones = true, CRCD_SnapStep = 0.01 },
      default = { lowStart = 0.05, lowEnd = 0.4, highStart = 0.55, highEnd = 0.95 } },
    { id = "Kernel", name = "Kernel", type = "ScriptVal",
      control = "CustomFilterControl",
      default = { { 0, -1, 0 }, { -1, 5, -1 }, { 0, -1, 0 } } },
  },
}

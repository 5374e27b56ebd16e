-- Grading: the tone controls.
--
-- Curves is a script table of curves by name (luma, red, green, blue,
-- alpha), each an array of {x, y} points, `linear = true` for straight
-- segments; a curve left out is the identity. Click in the graph to add a
-- point, drag to move it (Ctrl finer, Shift on the grid), double-click or
-- Delete to remove it; the wheel zooms, a middle drag pans, Home resets the
-- view. The buttons choose the curve.
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
  },
}

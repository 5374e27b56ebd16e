-- A tool with shape Inputs for the shape scripts: a Bezier mask, a
-- B-spline path and a guide the tool file marks read-only.
return {
  type = "Shapes",
  inputs = {
    { id = "Mask", type = "PolyLine",
      default = { kind = "bezier", closed = true, points = {
        { x = 0.25, y = 0.25 }, { x = 0.75, y = 0.25 },
        { x = 0.75, y = 0.75, inX = 0.8, inY = 0.7, outX = 0.7, outY = 0.8 }, { x = 0.25, y = 0.75 } } } },
    { id = "Path", type = "BSplinePolyLine" },
    { id = "Guide", type = "PolyLine", readOnly = true },
  },
}

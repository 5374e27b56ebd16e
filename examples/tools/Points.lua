-- Viewer overlays: the tool's centre as an axis crosshair (drag its arms to
-- move along one axis), and a path of points along the ridge of the demo
-- image, each joined by a line to the point before it (PCID_PrevPoint).
-- The inspector shows each point's X and Y in edit boxes that take typed
-- values and drag sideways, and follows every drag in the viewer.
return {
  type = "Points",
  inputs = {
    { id = "Center", name = "Center", type = "Point", default = { 0.5, 0.5 },
      control = "OffsetControl", overlay = "CrosshairControl", tags = { CHC_Style = 0 } },
    { id = "Ridge1", name = "Ridge 1", type = "Point", default = { 0.172, 0.431 },
      control = "OffsetControl", overlay = "PointControl" },
    { id = "Ridge2", name = "Ridge 2", type = "Point", default = { 0.359, 0.272 },
      control = "OffsetControl", overlay = "PointControl", tags = { PCID_PrevPoint = "Ridge1" } },
    { id = "Ridge3", name = "Ridge 3", type = "Point", default = { 0.547, 0.406 },
      control = "OffsetControl", overlay = "PointControl", tags = { PCID_PrevPoint = "Ridge2" } },
    { id = "Ridge4", name = "Ridge 4", type = "Point", default = { 0.734, 0.283 },
      control = "OffsetControl", overlay = "PointControl", tags = { PCID_PrevPoint = "Ridge3" } },
    { id = "Ridge5", name = "Ridge 5", type = "Point", default = { 0.875, 0.372 },
      control = "OffsetControl", overlay = "PointControl", tags = { PCID_PrevPoint = "Ridge4" } },
  },
}

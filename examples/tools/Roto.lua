-- A roto tool: a closed mask round the sun of the demo image, in "Modify
-- Only" (drag a point or, once a point is selected, its handle ends), and
-- a second, empty shape in "Click Append": each click in the viewer adds a
-- point, a drag while clicking pulls out smooth handles, and a click on the
-- first point closes the shape. Positions are image coordinates, 0..1
-- across each axis with Y up; handles are absolute.
local k = 0.5523 -- a cubic's handle length that follows a quarter circle

-- A smooth ellipse of four key points about (cx, cy) with radii rx, ry.
local function ellipse(cx, cy, rx, ry)
  return { kind = "bezier", closed = true, points = {
    { x = cx + rx, y = cy, inX = cx + rx, inY = cy - k * ry, outX = cx + rx, outY = cy + k * ry },
    { x = cx, y = cy + ry, inX = cx + k * rx, inY = cy + ry, outX = cx - k * rx, outY = cy + ry },
    { x = cx - rx, y = cy, inX = cx - rx, inY = cy + k * ry, outX = cx - rx, outY = cy - k * ry },
    { x = cx, y = cy - ry, inX = cx - k * rx, inY = cy - ry, outX = cx + k * rx, outY = cy - ry },
  } }
end

return {
  type = "Roto",
  inputs = {
    -- The sun's glow: 130 of the image's 640 pixels across, at (420, 203).
    { id = "Mask", name = "Mask", type = "PolyLine", default = ellipse(0.656, 0.436, 0.105, 0.185),
      overlay = "PolylineControl", tags = { PLC_DrawMode = 4, PLC_Animated = true } },
    { id = "Mask2", name = "Second Mask", type = "PolyLine",
      overlay = "PolylineControl", tags = { PLC_DrawMode = 1 } },
  },
}

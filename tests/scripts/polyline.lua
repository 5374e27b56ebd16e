-- The roto tool of the demo comp worked by hand: a shape clicked point by
-- point (one with its handles pulled out) and closed on its first point,
-- then a freehand stroke, each step undone again; what the user sees read
-- through orbane.OverlayState and orbane.ViewerInfo.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Roto1")
orbane.Process()

local function state(id)
  return orbane.OverlayState("Roto1", id)
end
local function shape(id)
  return orbane.GetValue("Roto1", id)
end
local function click(ix, iy, pull)
  orbane.ViewerPress({ ix = ix, iy = iy })
  if pull then
    orbane.ViewerMove({ ix = ix, iy = iy, dx = pull / 2 })
    orbane.ViewerMove({ ix = ix, iy = iy, dx = pull })
  end
  orbane.ViewerRelease({ ix = ix, iy = iy, dx = pull or 0 })
end

local mask = shape("Mask")
check.eq(mask.closed, true, "the sun's mask is closed")
check.eq(#mask.points, 4, "four points round the sun")
check.eq(state("Mask").mode, 4, "the mask starts in Modify Only")
check.eq(state("Mask2").mode, 1, "the second shape starts in Click Append")
check.eq(#shape("Mask2").points, 0, "and empty")

-- Click Append takes a press anywhere, also on the other mask.
click(0.2, 0.3)
click(0.4, 0.3, 30)
click(0.3, 0.6)
local s = shape("Mask2")
check.eq(#s.points, 3, "three clicks, three points")
check.near(s.points[1].x, 0.2, "the first point where clicked", 1 / orbane.ViewerInfo().width)
check.eq(s.points[1].outX, s.points[1].x, "a plain click adds a corner")
check.eq(s.points[2].outX > s.points[2].x, true, "a drag pulls the out handle along")
check.near(s.points[2].inX - s.points[2].x, s.points[2].x - s.points[2].outX, "the in handle mirrors it", 1e-12)
check.eq(state("Mask2").selected[1], 2, "the last point added is selected")
check.eq(#shape("Mask").points, 4, "the sun's mask is untouched")

click(0.2, 0.3)
check.eq(shape("Mask2").closed, true, "a click on the first point closes the shape")
check.eq(#shape("Mask2").points, 3, "closing adds no point")
check.eq(state("Mask2").mode, 3, "and leaves the append mode")
local names = orbane.UndoNames()
check.eq(table.concat(names, ","), "Add Point,Add Point,Add Point,Close polygon", "one step a click")

orbane.Undo()
check.eq(shape("Mask2").closed, false, "undo opens it again")
for _ = 1, 3 do orbane.Undo() end
check.eq(#shape("Mask2").points, 0, "undo takes every point back")

-- Draw Append: the cross cursor over the whole viewer, and a stroke round
-- a circle fitted with a few points in one step.
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 2 })
check.eq(orbane.Overlay("Roto1", "Mask2"):GetAttrs().PLC_DrawMode, 2, "the mode reads back")
orbane.ViewerHover({ ix = 0.1, iy = 0.9 })
check.eq(orbane.ViewerInfo().cursor, 2, "the cross cursor")
check.eq(state("Mask2").cursor, 2, "the overlay's cursor")
local info = orbane.ViewerInfo()
orbane.ViewerPress({ ix = 0.3, iy = 0.5, dx = 60 })
for i = 1, 64 do
  local a = 2 * math.pi * i / 64
  orbane.ViewerMove({ ix = 0.3, iy = 0.5, dx = 60 * math.cos(a), dy = -60 * math.sin(a) })
end
orbane.ViewerRelease({ ix = 0.3, iy = 0.5, dx = 60 })
s = shape("Mask2")
check.eq(s.closed, true, "a stroke back to its start closes the shape")
check.eq(#s.points >= 2 and #s.points <= 12, true, "a few key points for 64 samples: " .. #s.points)
for _, p in ipairs(s.points) do
  local r = math.sqrt(((p.x - 0.3) * info.imageWidth) ^ 2 + ((p.y - 0.5) * info.imageHeight) ^ 2) * info.zoom
  check.near(r, 60, "each key point on the circle drawn", 2.5)
end
names = orbane.UndoNames()
check.eq(names[#names], "Freehand Add Points", "one step for the stroke")
orbane.Undo()
check.eq(#shape("Mask2").points, 0, "undo takes the stroke back")

-- A locked tool takes no click, and neither does a shape declared readOnly.
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 1 })
orbane.SetToolLocked("Roto1", true)
click(0.5, 0.5)
check.eq(#shape("Mask2").points, 0, "a locked tool takes no click")
orbane.SetToolLocked("Roto1", false)
click(0.5, 0.5)
check.eq(#shape("Mask2").points, 1, "unlocked, it does")

local path = os.tmpname()
local f = assert(io.open(path, "w"))
f:write([[return { inputs = { { id = "Fixed", type = "PolyLine", readOnly = true,
  overlay = "PolylineControl", tags = { PLC_DrawMode = 1 } } } }]])
f:close()
orbane.LoadTool(path, "Fixed1")
orbane.ShowTool("Fixed1")
check.eq(orbane.OverlayState("Fixed1", "Fixed").shapeReadOnly, true, "read-only from the tool file")
orbane.ViewerPress({ ix = 0.5, iy = 0.5 })
orbane.ViewerRelease({ ix = 0.5, iy = 0.5 })
check.eq(#orbane.GetValue("Fixed1", "Fixed").points, 0, "a read-only shape takes no click")
os.remove(path)

-- The mask animated over two keyframes: a click at a time between them
-- adds its point to the shape shown there, as a new key.
orbane.ShowTool("Roto1")
local later = shape("Mask")
for _, p in ipairs(later.points) do
  p.x, p.inX, p.outX = p.x + 0.04, p.inX + 0.04, p.outX + 0.04
end
orbane.SetKey("Roto1", "Mask", shape("Mask"), 0)
orbane.SetKey("Roto1", "Mask", later, 24)
orbane.SetTime(12)
orbane.Process()
check.near(shape("Mask").points[1].x, mask.points[1].x + 0.02, "half way at frame 12", 1e-9)
-- The second shape, above, would take the press while it appends.
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 0 })
orbane.Overlay("Roto1", "Mask"):SetAttrs({ PLC_DrawMode = 1 })
click(0.1, 0.1)
check.eq(#shape("Mask").points, 5, "the point added at frame 12")
check.eq(table.concat(orbane.Keys("Roto1", "Mask"), ","), "0,12,24", "as a key of its own")
orbane.ViewerGrab(os.tmpname() .. ".png")

-- The sun's mask of the demo comp refined by hand: points picked by click,
-- Shift-click and a selection box, dragged together, a segment reshaped,
-- each step undone again; what the user sees read through
-- orbane.OverlayState.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Roto1")
-- The second shape appends on any press: out of the way.
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 0 })
orbane.Process()

local SHIFT = 0x01000020
local function state() return orbane.OverlayState("Roto1", "Mask") end
local function shape() return orbane.GetValue("Roto1", "Mask") end
local function selected() return table.concat(state().selected, ",") end
local info = orbane.ViewerInfo()
local pixel = 1 / (info.imageWidth * info.zoom)
local start = shape()
local function at(i, dx) return { ix = start.points[i].x, iy = start.points[i].y, dx = dx or 0 } end
local function click(pos)
  orbane.ViewerPress(pos)
  orbane.ViewerRelease(pos)
end

click(at(1))
check.eq(selected(), "0", "a click selects one point")
orbane.ViewerKey(SHIFT, "shift", "press")
click(at(2))
orbane.ViewerKey(SHIFT, "", "release")
check.eq(selected(), "0,1", "Shift-click adds one")

orbane.ViewerPress(at(1))
orbane.ViewerMove(at(1, 10))
orbane.ViewerMove(at(1, 20))
orbane.ViewerRelease(at(1, 20))
local moved = shape()
check.near(moved.points[1].x - start.points[1].x, 20 * pixel, "the pressed point follows", 1e-9)
check.near(moved.points[2].x - start.points[2].x, 20 * pixel, "and the other selected one", 1e-9)
check.eq(moved.points[3].x, start.points[3].x, "the others stay")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Move points", "one step for several points")
orbane.Undo()
check.eq(shape().points[1].x, start.points[1].x, "undo puts them back exactly")

-- A box round the whole mask from empty space picks every point.
orbane.ViewerPress({ ix = 0.45, iy = 0.15 })
orbane.ViewerMove({ ix = 0.7, iy = 0.5 })
orbane.ViewerRelease({ ix = 0.9, iy = 0.7 })
check.eq(selected(), "0,1,2,3", "the box picks all four")
check.eq(#orbane.UndoNames(), 0, "selecting is no step")
click({ ix = 0.3, iy = 0.9 })
check.eq(selected(), "", "a click on nothing empties the selection")

-- The curve between the first two points pulled out: the curve follows.
local a, b = start.points[1], start.points[2]
local mid = { ix = 0.656 + 0.105 * math.cos(math.pi / 4), iy = 0.436 + 0.185 * math.sin(math.pi / 4) }
orbane.ViewerPress(mid)
orbane.ViewerMove({ ix = mid.ix, iy = mid.iy, dx = 6, dy = -6 })
orbane.ViewerRelease({ ix = mid.ix, iy = mid.iy, dx = 12, dy = -12 })
local shaped = shape()
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Shape points", "the segment drag's step")
check.eq(shaped.points[1].outX > a.outX, true, "the first point's out handle moved out")
check.eq(shaped.points[2].inY > b.inY, true, "the second point's in handle moved up")
check.eq(shaped.points[1].x, a.x, "the points themselves stay")
check.eq(state().message, "", "no refusal to report")
orbane.Undo()
check.eq(shape().points[1].outX, a.outX, "undo takes the shaping back")

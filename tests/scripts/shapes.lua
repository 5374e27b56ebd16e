-- Shape values from a script: the table form both ways, keyframes blended
-- point by point, and shapes through SVG and shape files.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadTool(here .. "lib/ShapeTool.lua", "Roto1")

local mask = orbane.GetValue("Roto1", "Mask")
check.eq(mask.kind, "bezier", "kind")
check.eq(mask.closed, true, "closed")
check.eq(#mask.points, 4, "point count")
check.eq(mask.points[3].outY, 0.8, "a handle as declared")
check.eq(mask.points[1].inX, 0.25, "a missing handle lies on its point")
check.eq(#orbane.GetValue("Roto1", "Path").points, 0, "no default: an empty shape")
check.eq(orbane.GetValue("Roto1", "Path").kind, "bspline", "the B-spline Input's kind")

-- What a script writes it reads back, extras included.
mask.points[2].pressure = 0.5
mask.points[2].weight = 2
mask.closed = false
orbane.SetValue("Roto1", "Mask", mask)
local back = orbane.GetValue("Roto1", "Mask")
check.eq(back.closed, false, "closure written")
check.eq(back.points[2].pressure, 0.5, "pressure written")
check.eq(back.points[2].weight, 2, "weight written")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Change Mask", "one undo step")

check.fails(function()
  orbane.SetValue("Roto1", "Mask", { points = { { x = 0 / 0, y = 0.5 } } })
end, "NaN and infinities are not values", "NaN refused")
check.fails(function()
  orbane.SetValue("Roto1", "Mask", { kind = "bspline", points = {} })
end, "does not suit", "the kind must fit the Input")
check.eq(#orbane.GetValue("Roto1", "Mask").points, 4, "a refused write changes nothing")

-- Two keys; between them every point and handle is blended.
local a = orbane.GetValue("Roto1", "Mask")
local b = orbane.GetValue("Roto1", "Mask")
for _, p in ipairs(b.points) do
  p.x, p.inX, p.outX = p.x + 0.1, p.inX + 0.1, p.outX + 0.1
end
orbane.SetKey("Roto1", "Mask", a, 0)
orbane.SetKey("Roto1", "Mask", b, 10)
local keys = orbane.Keys("Roto1", "Mask")
check.eq(#keys, 2, "two keys")
check.eq(keys[2], 10, "the second key's time")
local mid = orbane.GetValue("Roto1", "Mask", 5)
check.near(mid.points[3].x, 0.8, "a point half way")
check.near(mid.points[3].outX, 0.75, "a handle half way")
check.eq(orbane.RemoveKey("Roto1", "Mask", 10), true, "the key removed")
check.eq(#orbane.Keys("Roto1", "Mask"), 1, "one key left")
check.eq(orbane.RemoveKey("Roto1", "Mask", 3), false, "no key at 3")
orbane.Undo()
check.eq(#orbane.Keys("Roto1", "Mask"), 2, "undo brings the key back")
check.eq(#orbane.Keys("Roto1", "Path"), 0, "an Input never keyed has no keys")

-- Out to SVG and into the B-spline Input: converted, the same curve at
-- its key points.
local svg = os.tmpname() .. ".svg"
orbane.ExportShape("Roto1", "Mask", svg, 0)
orbane.ImportShape("Roto1", "Path", svg)
local path = orbane.GetValue("Roto1", "Path")
check.eq(path.kind, "bspline", "imported as the Input's kind")
check.eq(#path.points, 4, "every key point")

local shape = os.tmpname() .. ".shape"
orbane.ExportShape("Roto1", "Mask", shape, 10)
orbane.ImportShape("Roto1", "Guide", shape)
check.near(orbane.GetValue("Roto1", "Guide").points[3].outX, 0.8, "shape file round trip")

local bad = io.open(svg, "w")
bad:write('<svg viewBox="0 0 10 10">\n<path d="M 1 1 L 2"/>\n</svg>\n')
bad:close()
check.fails(function() orbane.ImportShape("Roto1", "Guide", svg) end, "line 2, column 2: path data, character 10",
  "a broken SVG names file and place")
check.near(orbane.GetValue("Roto1", "Guide").points[3].outX, 0.8, "a failed import changes nothing")
check.fails(function() orbane.SetToolLocked("Nope", true) end, "no tool", "locking an unknown tool")
os.remove(svg)
os.remove(shape)

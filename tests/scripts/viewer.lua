-- The viewer worked by hand from a script: the demo comp's Points tool over
-- its image, the centre crosshair dragged by its X arm, a point of the ridge
-- chain dragged and nudged with the arrow keys, then the history undone.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Points1")

local info = orbane.ViewerInfo()
check.eq(info.imageWidth .. "x" .. info.imageHeight, "640x360", "the demo image's size")
-- Viewer pixels per unit of image X and Y.
local spanX, spanY = 640 * info.zoom, 360 * info.zoom

local function value(id) local v = orbane.GetValue("Points1", id) return v[1], v[2] end
local function at(id) return table.concat({ value(id) }, ",") end

-- The X arm, 15 pixels right of the centre: the hand wanders up and down,
-- the crosshair moves along X only.
local arm = { ix = 0.5, iy = 0.5, dx = 15 }
orbane.ViewerPress(arm)
check.eq(orbane.ViewerInfo().hot, "CrosshairControl", "the crosshair is hot")
check.eq(orbane.OverlayState("Points1", "Center").dragPart, 1, "its X arm is dragged")
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = 15 + 64, dy = 37 })
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = 15 + 128, dy = -23 })
orbane.ViewerRelease({ ix = 0.5, iy = 0.5, dx = 15 + 128, dy = -23 })
check.eq(orbane.OverlayState("Points1", "Center").dragPart, 0, "the arm is let go")
local cx, cy = value("Center")
check.eq(cy, 0.5, "Y after an X-arm drag")
check.near(cx, 0.5 + 128 / spanX, "X after an X-arm drag", 1e-9)

-- A point of the chain: 50 pixels right, 30 up. The next point, linked to
-- it, moves nothing of its own.
local x3, y3 = value("Ridge3")
local ridge4 = at("Ridge4")
orbane.ViewerPress({ ix = x3, iy = y3, dx = 1 })
orbane.ViewerMove({ ix = x3, iy = y3, dx = 26, dy = -15 })
orbane.ViewerMove({ ix = x3, iy = y3, dx = 51, dy = -30 })
orbane.ViewerRelease({ ix = x3, iy = y3, dx = 51, dy = -30 })
-- The point turns its grab offset back with whole viewer pixels per image
-- unit, which the fitted view's spans are not: a millionth is what it costs.
local nx, ny = value("Ridge3")
check.near(nx, x3 + 50 / spanX, "Ridge 3 X after the drag", 1e-6)
check.near(ny, y3 + 30 / spanY, "Ridge 3 Y after the drag", 1e-6)
check.eq(at("Ridge4"), ridge4, "Ridge 4")

-- Nudges go to the point pressed last: Shift+Right is ten pixels of the
-- width; two Ups held down are one step, one pixel each of the width too.
orbane.ViewerHover({ ix = nx, iy = ny })
check.eq(orbane.OverlayState("Points1", "Ridge3").hover, true, "the point is under the mouse")
orbane.ViewerKey("Right", "shift")
orbane.ViewerKey("Up", "", "press")
orbane.ViewerKey("Up", "", "press")
orbane.ViewerKey("Up", "", "release")
local kx, ky = value("Ridge3")
check.near(kx, nx + 10 / 640, "Ridge 3 X after Shift+Right", 1e-12)
check.near(ky, ny + 2 / 640, "Ridge 3 Y after two Ups", 1e-12)

local names = orbane.UndoNames()
check.eq(table.concat(names, "; "), "Change Center; Change Ridge 3; Change Ridge 3; Change Ridge 3",
         "undo steps: one per drag, one per run of keys")

local shot = os.tmpname()
orbane.ViewerGrab(shot .. ".png")
local file = io.open(shot .. ".png", "rb")
check.eq(file:read(4), "\137PNG", "the screenshot is a PNG")
file:close()
os.remove(shot)
os.remove(shot .. ".png")
check.fails(function() orbane.ViewerImage("/no/such/image.png") end, "cannot read", "an unreadable image")

for _ = 1, 4 do
  check.eq(orbane.Undo(), true, "undo")
end
check.eq(at("Ridge3"), x3 .. "," .. y3, "Ridge 3 back")
check.eq(at("Center"), "0.5,0.5", "Center back")

-- The demo comp's Dials tool in the viewer: the Angle dial turned through
-- half a turn clockwise past 0 keeps counting (no jump to 180), the Spread
-- arm, whose length is the Size Input, grabbed at its end and nudged.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Dials1")
local function value(id) return orbane.GetValue("Dials1", id) end
local function at(dx, dy) return { ix = 0.5, iy = 0.5, dx = dx, dy = dy } end

local function dial() return orbane.OverlayState("Dials1", "Angle") end

-- The dial fades with the mouse's distance from its ring: half from 60
-- viewer pixels off; on the ring it is whole and lit.
orbane.ViewerHover(at(0, 0))
check.eq(dial().hover, false, "the centre is off the ring")
orbane.ViewerHover(at(200, 200))
check.eq(dial().fade, 0.5, "far from the ring: half")
check.eq(dial().drawnFade, 0.5, "drawn at half")
orbane.ViewerHover(at(43, -25))
check.eq(dial().hover, true, "on the ring")
check.eq(dial().highlight, true, "the ring lights up")
check.eq(dial().fade, 1, "on the ring: whole")

-- The Angle ring where its arm meets it, 30 degrees up (widget Y is down),
-- pressed with the flag that keeps where the drag began: the dial's centre.
orbane.ViewerPress({ ix = 0.5, iy = 0.5, dx = 43, dy = -25, flags = 4 })
check.eq(orbane.ViewerInfo().hot, "AngleControl", "the angle dial is hot")
check.eq(dial().dragType, 2, "its own drag")
check.eq(dial().followCursor, false, "not following the cursor")
check.eq(dial().startGrabX ~= 0 or dial().startGrabY ~= 0, true, "the start of the drag is kept")
for _, p in ipairs({ { 0, -100 }, { 100, 0 }, { 0, 100 }, { -100, 0 } }) do
  orbane.ViewerMove(at(p[1], p[2]))
end
orbane.ViewerRelease(at(-100, 0))
check.eq(dial().dragType, 0, "the drag is over")
check.eq(dial().startGrabX, 0, "the start is forgotten")
check.near(value("Angle"), -180, "the angle after turning clockwise from 90 to -180", 0.5)

-- The Spread arm ends Size (0.25 image widths) out at 120 degrees.
local reach = 0.25 * orbane.ViewerInfo().imageWidth * orbane.ViewerInfo().zoom
orbane.ViewerPress(at(-0.5 * reach, -0.866 * reach))
orbane.ViewerMove(at(200, 0))
orbane.ViewerRelease(at(200, 0))
local spread = value("Spread")
check.near(spread, 0, "the spread turned to the right", 0.5)
orbane.ViewerKey("Right", "ctrl")
check.near(value("Spread"), spread - 0.1, "Control-Right turns a tenth of a degree clockwise", 1e-9)
check.eq(table.concat(orbane.UndoNames(), ", "), "Change Angle, Change Spread, Change Spread", "undo steps")

-- The demo comp's Dials tool in the viewer: the Angle dial turned through
-- half a turn clockwise past 0 keeps counting (no jump to 180), the Spread
-- arm, whose length is the Size Input, grabbed at its end and nudged.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Dials1")
local function value(id) return orbane.GetValue("Dials1", id) end
local function at(dx, dy) return { ix = 0.5, iy = 0.5, dx = dx, dy = dy } end

-- The Angle ring where its arm meets it, 30 degrees up (widget Y is down).
orbane.ViewerPress(at(43, -25))
check.eq(orbane.ViewerInfo().hot, "AngleControl", "the angle dial is hot")
for _, p in ipairs({ { 0, -100 }, { 100, 0 }, { 0, 100 }, { -100, 0 } }) do
  orbane.ViewerMove(at(p[1], p[2]))
end
orbane.ViewerRelease(at(-100, 0))
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

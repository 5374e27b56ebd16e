-- The demo comp's 3D overlays worked by hand from a script: the box's face
-- and centre, the camera's position, the light's aim, each grabbed where
-- orbane.OverlayState says its knob is and read back through the values and
-- the undo history; then the viewer's camera turned from the script.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Scene1")
-- A plain box at the origin, straight on.
orbane.SetValue("Scene1", "Center", { 0, 0, 0 })
for _, id in ipairs({ "TiltX", "TurnY", "RollZ" }) do orbane.SetValue("Scene1", id, 0) end
for _, id in ipairs({ "Width", "Height", "Depth" }) do orbane.SetValue("Scene1", id, 0.5) end
orbane.Process()
local info = orbane.ViewerInfo()
local px = info.imageWidth * info.zoom -- viewer pixels per world unit on the image plane
local function box() return orbane.OverlayState("Scene1", "Center") end
local function steps() return #orbane.UndoNames() end

-- The +X face's knob (part 2) lies on the image plane at X = 0.25.
local knob = box().handles[2]
check.near(knob.ix, 0.75, "the +X knob's place", 1e-12)
orbane.ViewerHover({ ix = knob.ix, iy = knob.iy })
check.eq(box().hoverPart, 2, "the +X face under the mouse")
check.eq(box().highlight, true, "it lights up")
local before = steps()
orbane.ViewerPress({ ix = knob.ix, iy = knob.iy })
orbane.ViewerMove({ ix = knob.ix, iy = knob.iy, dx = 10 })
orbane.ViewerMove({ ix = knob.ix, iy = knob.iy, dx = 20 })
orbane.ViewerRelease({ ix = knob.ix, iy = knob.iy, dx = 20 })
check.near(orbane.GetValue("Scene1", "Width"), 0.5 + 20 / px, "the face moved its side", 1e-9)
check.near(orbane.GetValue("Scene1", "Center")[1], 10 / px, "the centre half as far", 1e-9)
check.eq(steps(), before + 1, "one step")
local names = orbane.UndoNames()
check.eq(names[#names], "Resize Box", "named")
orbane.Undo()
check.eq(orbane.GetValue("Scene1", "Width"), 0.5, "undone")

-- Arrows nudge the centre by an image pixel.
orbane.ViewerHover({ ix = 0.5, iy = 0.5 })
orbane.ViewerKey("Right")
check.near(orbane.GetValue("Scene1", "Center")[1], 1 / info.imageWidth, "nudged", 1e-12)

-- The camera overlay's position knob (part 1).
local cam = orbane.OverlayState("Scene1", "CamPosition")
local x0 = orbane.GetValue("Scene1", "CamPosition")[1]
orbane.ViewerPress({ ix = cam.handles[1].ix, iy = cam.handles[1].iy })
orbane.ViewerMove({ ix = cam.handles[1].ix, iy = cam.handles[1].iy, dx = 15 })
orbane.ViewerRelease({ ix = cam.handles[1].ix, iy = cam.handles[1].iy, dx = 15 })
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Move Camera", "the camera moved")
check.eq(orbane.GetValue("Scene1", "CamPosition")[1] > x0, true, "to the right")

-- The light's aim knob (part 5) moves the point it shines at.
local light = orbane.OverlayState("Scene1", "LightPosition")
check.eq(light.lightType, 2, "a spot")
local aim = light.handles[5]
orbane.ViewerPress({ ix = aim.ix, iy = aim.iy })
orbane.ViewerMove({ ix = aim.ix, iy = aim.iy, dy = -15 })
orbane.ViewerRelease({ ix = aim.ix, iy = aim.iy, dy = -15 })
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Aim Light", "aimed")
check.eq(orbane.GetValue("Scene1", "LightAim")[2] > -0.1, true, "upwards")

-- The viewer's camera: turned, the box's knobs move; the default view
-- brings them back.
local view = orbane.ViewerCamera()
check.near(view.focal, 50, "the default lens", 1e-12)
check.near(view.position[3], 50 / 36, "straight at the image", 1e-12)
orbane.ViewerCamera({ rotation = { 0, 20, 0 }, position = { 0.5, 0, 1.3 } })
orbane.Process()
check.eq(orbane.ViewerCamera().rotation[2], 20, "turned")
check.eq(math.abs(box().handles[2].ix - 0.75) > 0.01, true, "the knob moved with the view")
orbane.ViewerCamera("default")
orbane.Process()
check.near(box().handles[2].ix, 0.75 + 1 / info.imageWidth, "back", 1e-9)
check.fails(function() orbane.ViewerCamera({ focal = 0 }) end, "not a camera", "a camera with no lens")
print("view3d: ok")

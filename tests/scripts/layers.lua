-- The demo comp's layer overlays worked by hand from a script: the
-- transform's knobs and ring, the offset arrow, the crop box and the viewer
-- slider, each read back through orbane.OverlayState and the undo history.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

-- Layers1: the transform over a layer half the image wide, turned 10.
orbane.ShowTool("Layers1")
orbane.SetValue("Layers1", "Angle", 0)
orbane.Process()
local info = orbane.ViewerInfo()
local px = info.imageWidth * info.zoom -- viewer pixels per image width
local function state()
  return orbane.OverlayState("Layers1", "Center")
end
local side = { ix = 0.5, iy = 0.5, dx = 0.25 * px } -- the +X knob
orbane.ViewerHover(side)
check.eq(state().hoverPart, 16, "the +X knob under the mouse")
check.eq(state().highlight, true, "it lights up")
orbane.ViewerPress(side)
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = 0.25 * px + 20 })
orbane.ViewerRelease({ ix = 0.5, iy = 0.5, dx = 0.25 * px + 20 })
check.near(orbane.GetValue("Layers1", "XSize"), 1 + 20 / (0.25 * px), "X size", 1e-9)
check.eq(orbane.GetValue("Layers1", "YSize"), 1, "Y size untouched")
local names = orbane.UndoNames()
check.eq(names[#names], "Scale Transform", "one named step")

-- The ring, 70 handle pixels out: a quarter turn counter-clockwise.
orbane.ViewerPress({ ix = 0.5, iy = 0.5, dx = 70 })
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = 50, dy = -50 })
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dy = -70 })
orbane.ViewerRelease({ ix = 0.5, iy = 0.5, dy = -70 })
check.near(orbane.GetValue("Layers1", "Angle"), 90, "turned a quarter", 1e-9)
check.eq(state().angle, 90, "the state shows it")

-- The offset arrow's tip, nudged ten pixels right.
local drift = orbane.GetValue("Layers1", "Drift")
local c = orbane.GetValue("Layers1", "Center")
orbane.ViewerPress({ ix = c[1] + drift[1], iy = c[2] + drift[2] })
orbane.ViewerRelease({ ix = c[1] + drift[1], iy = c[2] + drift[2] })
orbane.ViewerKey("Right", "shift")
check.near(orbane.GetValue("Layers1", "Drift")[1], drift[1] + 10 / info.imageWidth, "nudged", 1e-12)

-- Framing1: the crop's top edge dragged down, then the viewer slider.
orbane.ShowTool("Framing1")
orbane.Process()
local corner, size = orbane.GetValue("Framing1", "Corner"), orbane.GetValue("Framing1", "Size")
local top = corner[2] + size[2]
orbane.ViewerPress({ ix = 0.3, iy = top })
orbane.ViewerMove({ ix = 0.3, iy = top, dy = 30 })
orbane.ViewerRelease({ ix = 0.3, iy = top, dy = 30 })
local crop = orbane.OverlayState("Framing1", "Corner")
check.near(crop.top, top - 30 / (info.imageHeight * info.zoom), "the top edge came down", 1e-9)
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Adjust Crop", "the crop's step")

local slider = orbane.OverlayState("Framing1", "InsetOpacity")
check.eq(slider.maximum, 1, "the slider's range")
-- Inset Opacity is the tool's sixth Input: its track is the sixth row up,
-- its knob at 0.8 of 200 pixels along.
local h = info.height
orbane.ViewerPress({ x = 20 + 200 * 0.8, y = h - 20 - 28 * 5 })
orbane.ViewerMove({ x = 20 + 200 * 0.8 - 40, y = h - 20 - 28 * 5 })
orbane.ViewerRelease({ x = 20 + 200 * 0.8 - 40, y = h - 20 - 28 * 5 })
check.near(orbane.GetValue("Framing1", "InsetOpacity"), 0.6, "slid down by a fifth", 1e-9)
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Slide Inset Opacity", "the slider's step")
print("layers: ok")

-- The rectangle of the demo comp's Transform tool worked by hand: hover an
-- edge, drag it, and read what the user sees through orbane.OverlayState.
-- The tool file links the rectangle's height (overlayInputs) and the Inputs
-- that place it (RCP_Center = "Center", ...) by name.
local check = require("check")
local ffi = require("ffi")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Transform1")

local info = orbane.ViewerInfo()
local px = info.imageWidth * info.zoom -- viewer pixels per image width
local function num(id)
  return orbane.GetValue("Transform1", id)
end
local function state()
  return orbane.OverlayState("Transform1", "Width")
end

-- Upright, so the +X edge is to the right of the centre; the mouse meets
-- what was drawn, so the viewer draws first.
orbane.SetValue("Transform1", "Angle", 0)
orbane.Process()
local w, h = num("Width"), num("Height")
local inside = w * px / 2 - 2 -- two pixels inside the +X edge

orbane.ViewerHover({ ix = 0.5, iy = 0.5 })
check.eq(state().hoverPart, 0, "nothing under the mouse in the middle")
check.eq(state().highlight, false, "no highlight in the middle")
orbane.ViewerHover({ ix = 0.5, iy = 0.5, dx = inside })
check.eq(state().hoverPart, 1, "the +X edge under the mouse")
check.eq(state().highlight, true, "the edge lights up")
check.fails(function() state().hoverPart = 3 end, "read%-only", "the state cannot be written")

-- A press with the event flag 4, then a drag 60 pixels to the right: with
-- the pivot in the middle both sides move, the width grows by twice that.
orbane.ViewerPress({ ix = 0.5, iy = 0.5, dx = inside, flags = 4 })
check.eq(orbane.ViewerInfo().hot, "RectangleControl", "the rectangle is hot")
check.eq(state().dragType, 2, "dragging its own handle")
-- Frame units are image pixels: two viewer pixels are 2 / zoom of them (the
-- press lands on a whole widget pixel, half a pixel either way).
check.near(state().grabOffsetX, 2 / info.zoom, "grab offset to the edge", 0.5 / info.zoom + 1e-9)
check.eq(state().grabOffsetY, 0, "an X edge is grabbed across only")
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = inside + 30, dy = 17 })
orbane.ViewerMove({ ix = 0.5, iy = 0.5, dx = inside + 60, dy = -9 })
orbane.ViewerRelease({ ix = 0.5, iy = 0.5, dx = inside + 60, dy = -9 })
check.near(num("Width"), w + 2 * 60 / px, "width after the drag", 1e-9)
check.eq(num("Height"), h, "height untouched by an X edge")
local s = state()
check.eq(s.dragType, 0, "the drag is over")
check.eq(s.dragPart, 1, "the part dragged")
check.eq(s.lastPart, 1, "the last part grabbed")
local names = orbane.UndoNames()
check.eq(names[#names], "Adjust Rectangle", "one undo step, named")

-- The rectangle follows the centre it is linked to by name.
orbane.SetValue("Transform1", "Center", { 0.4, 0.5 })
orbane.Process()
orbane.ViewerHover({ ix = 0.4, iy = 0.5, dx = num("Width") * px / 2 - 2 })
check.eq(state().hoverPart, 1, "the +X edge of the moved rectangle")

-- The overlay object itself: casts and attributes.
local rect = orbane.Overlay("Transform1", "Width", "RectangleControl")
check.eq(ffi.C.ffi_RectangleControl_cast(rect) ~= nil, true, "a RectangleControl")
check.eq(rect:GetAttrs().RCID_Center, "Center", "linked centre by id")
check.fails(function() orbane.OverlayState("Transform1", "Height") end, "no overlay", "Height has none")

orbane.Undo()
orbane.Undo()
check.eq(num("Width"), w, "undo puts the width back")

-- Tool files: a tag by number, Inputs named in tags, an image file beside
-- the tool file, a misspelt link.
local path = os.tmpname()
local function write(text)
  local f = assert(io.open(path, "w"))
  f:write(text)
  f:close()
end
write([[return { type = "Box", inputs = {
  { id = "W", type = "Number", default = 0.2, overlay = "RectangleControl", overlayInputs = { "H" },
    tags = { [0x10058000] = 2, RCP_Center = "C", RCP_Image = "Pic" } },
  { id = "H", type = "Number", default = 0.1 },
  { id = "C", type = "Point", default = { 0.3, 0.6 } },
  { id = "Pic", type = "Image", default = "pic.png" } } }]])
orbane.LoadTool(path, "Box1")
orbane.ShowTool("Box1")
local attrs = orbane.Overlay("Box1", "W"):GetAttrs()
check.eq(attrs.RC_PenStyle, 2, "a tag given by number")
check.eq(attrs.RCD_SetX, 0.3, "the centre from the Input named in RCP_Center")
check.eq(attrs.RCID_Image, "Pic", "the image Input named in RCP_Image")
check.eq(orbane.GetValue("Box1", "Pic"), path:match("^(.*/)") .. "pic.png", "image path beside the tool file")
write([[return { inputs = { { id = "W", type = "Number", overlay = "RectangleControl",
  tags = { RCP_Center = "Nowhere" } } } }]])
check.fails(function() orbane.LoadTool(path, "Box2") end, "RCP_Center", "a link to no Input")

-- A comp whose image has pixels twice as wide: the rectangle keeps its shape
-- on screen, its +X edge w image widths across at twice the zoom.
local abs = here:sub(1, 1) == "/" and here or (os.getenv("PWD") .. "/" .. here)
local comp = os.tmpname()
local f = assert(io.open(comp, "w"))
f:write(string.format([[return { pixelAspect = 2, image = %q, tools = { { file = %q, name = "Wide1" } } }]],
  abs .. "../../examples/images/dusk.png", abs .. "../../examples/tools/Transform.lua"))
f:close()
orbane.LoadComp(comp)
orbane.ShowTool("Wide1")
orbane.SetValue("Wide1", "Angle", 0)
orbane.Process()
local wide = orbane.ViewerInfo()
check.eq(wide.pixelAspect, 2, "the comp's pixel aspect")
local ww = orbane.GetValue("Wide1", "Width") * wide.imageWidth * wide.zoom * 2 / 2
orbane.ViewerHover({ ix = 0.5, iy = 0.5, dx = ww - 2 })
check.eq(orbane.OverlayState("Wide1", "Width").hoverPart, 1, "the +X edge with wide pixels")
orbane.ViewerHover({ ix = 0.5, iy = 0.5, dx = ww / 2 - 2 })
check.eq(orbane.OverlayState("Wide1", "Width").hoverPart, 0, "half-way in is inside")
os.remove(path)
os.remove(comp)

-- The polyline overlay's dialogs from a script, filled as a person fills
-- them: the point editor, the keyframe list, the onion-skin settings and
-- the dialogs of numbers, each found by the object names of its parts.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Roto1")
-- The second, empty shape would take every press in "Click Append".
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 0 })
orbane.Process()

local function state()
  return orbane.OverlayState("Roto1", "Mask")
end
local function lastUndo()
  local names = orbane.UndoNames()
  return names[#names]
end
local function fill(field, text)
  orbane.Key(field, "A", "ctrl")
  orbane.Type(field, text)
end
local shape = orbane.GetValue("Roto1", "Mask")
local first = shape.points[1]
local on = { ix = first.x, iy = first.y }

-- The point editor: a click selects the first point, E opens the editor.
orbane.ViewerPress(on)
orbane.ViewerRelease(on)
orbane.ViewerKey("E")
check.eq(state().pointEditor, true, "E opens the point editor")
check.eq(orbane.State("pointInfo").text, "Point 1", "on the selected point")
check.near(tonumber(orbane.State("pointX").text), first.x, "its X shown", 1e-9)
fill("pointX", "0.3")
fill("pointOutY", "0.05")
orbane.Click("pointApply")
local edited = orbane.GetValue("Roto1", "Mask").points[1]
check.near(edited.x, 0.3, "X written", 1e-12)
check.near(edited.outY - edited.y, 0.05, "the out handle written from the point", 1e-12)
check.eq(lastUndo(), "Edit Point", "one step")
orbane.Undo()
check.near(orbane.GetValue("Roto1", "Mask").points[1].x, first.x, "undo puts the point back", 1e-12)
check.near(tonumber(orbane.State("pointX").text), first.x, "the editor follows", 1e-9)
orbane.Click("pointClose")
check.eq(state().pointEditor, false, "closed")

-- Three keyframes, then the list: go to one, delete one.
local moved = orbane.GetValue("Roto1", "Mask")
for _, p in ipairs(moved.points) do
  for _, k in ipairs({ "x", "inX", "outX" }) do p[k] = p[k] - 0.05 end
end
orbane.SetKey("Roto1", "Mask", shape, 0)
orbane.SetKey("Roto1", "Mask", moved, 10)
orbane.SetKey("Roto1", "Mask", shape, 20)
check.eq(orbane.ViewerMenuChoose(on, { "Polygon Keyframe List..." }), true, "the list opens")
check.eq(state().keyList, true, "shown")
orbane.Click("keyList", { row = 2 })
orbane.Click("keyJump")
check.eq(orbane.GetTime(), 10, "Go To sets the time")
orbane.Click("keyList", { row = 3 })
orbane.Click("keyDelete")
check.eq(table.concat(orbane.Keys("Roto1", "Mask"), ","), "0,10", "the key at 20 deleted")
check.eq(lastUndo(), "Delete Keyframes", "one step")
orbane.Undo()
check.eq(#orbane.Keys("Roto1", "Mask"), 3, "undo brings it back")
check.eq(orbane.State("keyInfo").text, "3 keyframe(s)", "the list follows")
orbane.Click("keyClose")

-- Smoothing and easing the motion take their numbers as a value.
-- (Back at 0, where the mouse is over this shape: its menu comes first.)
orbane.SetTime(0)
check.eq(orbane.ViewerMenuChoose(on, { "Smooth Animation", "Dialog…" }, "1 1"), true, "smoothed")
check.eq(lastUndo(), "Smooth Animation", "one step")
check.near(orbane.GetValue("Roto1", "Mask", 10).points[1].x, shape.points[1].x, "the selected point evened out", 1e-9)
check.near(orbane.GetValue("Roto1", "Mask", 10).points[2].x, moved.points[2].x, "the others kept", 1e-9)
check.eq(orbane.ViewerMenuChoose(on, { "Smooth Animation", "Dialog…" }, "2"), false, "an amount above 1")
check.eq(state().message, "Smooth Animation: Amount: give a number from 0 to 1", "says why")

-- The onion skins: shown at once, no undo step.
local steps = #orbane.UndoNames()
check.eq(orbane.ViewerMenuChoose(on, { "Onion Skin", "Onion skin settings…" }), true, "settings open")
fill("onionAfter", "1")
orbane.Key("onionAfter", "Return")
check.eq(state().onionAfter, 1, "taken")
fill("onionColor", "#00ff00")
orbane.Key("onionColor", "Return")
check.eq(state().onionColor:sub(1, 7), "#00ff00", "the colour taken")
check.eq(#orbane.UndoNames(), steps, "a view setting, no step")
orbane.Click("onionClose")

-- A rectangle from its editor, filled and confirmed.
check.eq(orbane.ViewerMenuChoose(on, { "Create", "Rectangle…" }), true, "the editor opens")
fill("rectangleWidth", "0.2")
fill("rectangleHeight", "-1")
orbane.Click("numbersOk")
check.eq(orbane.State("numbersMessage").text, "Height: give a number from 1e-06 to 20", "refused, says why")
fill("rectangleHeight", "0.1")
orbane.Click("numbersOk")
check.eq(lastUndo(), "Create Rectangle", "one step")
check.eq(#orbane.GetValue("Roto1", "Mask").points, 4, "four corners")

-- The formats no reader exists for name those that are read.
local corner = orbane.GetValue("Roto1", "Mask").points[1]
on = { ix = corner.x, iy = corner.y }
check.eq(orbane.ViewerMenuChoose(on, { "Import", "Import SSF Shapes…" }), false, "not read")
check.eq(state().message:find("reads shape and SVG files", 1, true) ~= nil, true, "names the formats read")

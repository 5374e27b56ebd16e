-- The polyline overlay's command surface from a script, as a pipeline
-- scripter drives it: the context menu read and chosen by its texts, the
-- toolbar listed and pressed, keys with their undo steps, and the tips.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Roto1")
orbane.Process()

local function state()
  return orbane.OverlayState("Roto1", "Mask")
end
local first = orbane.GetValue("Roto1", "Mask").points[1]
local on = { ix = first.x, iy = first.y }

-- The menu of the shape under the mouse comes first.
local menu = orbane.ViewerMenu(on)
check.eq(menu[1].text, "Mask: Modify Only", "the mode submenu names the shape and its mode")
check.eq(#menu[1].items, 5, "five modes")
check.eq(menu[1].items[4].flags, 0x408, "Modify Only is the chosen radio entry")
check.eq(menu[1].items[1].id, 0x2000E, "Click Append's command")
local function find(items, text)
  for _, e in ipairs(items) do
    if e.text == text then return e end
  end
end
check.eq(find(menu, "Closed").flags, 0x408, "the sun's mask is closed: checked")
check.eq(find(menu, "Edit Point\tE").id, 0x2001C, "the point editor entry with its key")
check.eq(find(menu, "Reduce Points…").flags, 0x400, "four points: reduce is offered")
local style = find(menu, "Draw Style")
check.eq(style.items[3].arg, 5, "Null sends 5")
check.eq(style.items[4].separator, true, "a separator before the colours")

-- Choosing entries.
check.eq(orbane.ViewerMenuChoose(on, { "Draw Style", "Dash" }), true, "Dash chosen")
check.eq(math.floor(state().displayFlags / 0x10) % 8, 1, "the dash style bit alone")
check.eq(orbane.ViewerMenuChoose(on, { "Roto Assist", "Distance 5…" }, "8"), true, "a distance given")
check.eq(state().rotoDistance, 8, "the distance taken")
check.eq(orbane.ViewerMenuChoose(on, { "Draw Style", "Custom Spline Color…" }), false, "no colour given")
check.eq(state().message, "Custom Spline Color: give the colour as \"#rrggbb\" (or \"none\")", "and says so")
check.eq(orbane.ViewerMenuChoose(on, { "Edit Point" }), true, "the entry matched before its key")
check.eq(state().pointEditor, true, "the point editor opens")
orbane.Click("pointClose")
check.fails(function() orbane.ViewerMenuChoose(on, { "Draw Style", "Wavy" }) end, "no entry", "an unknown entry")
check.fails(function() orbane.ViewerMenuChoose(on, "Dash") end, "path", "a path must be a table")

-- Keys over the shape: Shift+A selects every point, O is taken with Ctrl
-- too, G never; Delete removes the selection as one step.
orbane.ViewerHover(on)
orbane.ViewerKey("A", "shift")
check.eq(#state().selected, 4, "Shift+A selects all four points")
orbane.ViewerKey("X")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Flip Points", "X flips the selection")
orbane.Undo()
local steps = #orbane.UndoNames()
orbane.ViewerKey("G")
check.eq(#orbane.UndoNames(), steps, "G is never taken")
orbane.ViewerKey("Delete")
check.eq(#orbane.GetValue("Roto1", "Mask").points, 0, "Delete removes the selected points")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Delete Points", "as one step")
orbane.Undo()
check.eq(#orbane.GetValue("Roto1", "Mask").points, 4, "and undo brings them back")

-- Export and import through a file the script names.
local file = os.tmpname() .. ".svg"
check.eq(orbane.ViewerMenuChoose(on, { "Export…" }, file), true, "exported")
check.eq(orbane.ViewerMenuChoose(on, { "Import", "Import Shape…" }, file), true, "read back")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Import Shape", "one step")
check.eq(#orbane.GetValue("Roto1", "Mask").points, 4, "the same four points")
check.eq(orbane.ViewerMenuChoose(on, { "Import", "Import Shape…" }, file .. ".missing"), false, "a file not there")
check.eq(orbane.ViewerMenuChoose(on, { "Import", "Import Nuke Shapes…" }), false, "a format not read yet")
check.eq(orbane.OverlayState("Roto1", "Mask").message:find("not read yet", 1, true) ~= nil, true, "says so")
os.remove(file)

-- The toolbar: buttons by tip and label, pop-downs with their items.
local bar = orbane.ViewerToolbar()
check.eq(bar[1].label, "Click", "the first button")
check.eq(bar[1].tip, "Click Append", "with its tip")
local multi
for _, b in ipairs(bar) do
  if b.label == "Multiframe" then multi = b end
end
check.eq(multi.tip, "Multiframe Menu", "the multiframe pop-down")
check.eq(multi.items[2].label, "Prev", "holds Prev")
-- The second mask, in Click Append, would take the press: it is done.
orbane.Overlay("Roto1", "Mask2"):SetAttrs({ PLC_DrawMode = 0 })
orbane.ViewerPress(on)
orbane.ViewerRelease(on)
orbane.ViewerToolbarPress({ "Multiframe", "Prev" })
check.eq(state().multiFrame, 1, "Prev pressed on the shape pressed last")
check.eq(orbane.OverlayState("Roto1", "Mask2").multiFrame, 0, "not on the other one")
orbane.ViewerToolbarPress({ "Draw" })
check.eq(state().mode, 2, "Draw sets Draw Append")
check.fails(function() orbane.ViewerToolbarPress({ "Multiframe", "Sideways" }) end, "no button", "an unknown button")

-- Tips.
check.eq(orbane.ViewerTip(on), "Roto1:Mask - Point 1", "the tip names tool, shape and point")
check.eq(orbane.ViewerTip({ ix = 0.02, iy = 0.98 }), nil, "no tip over nothing")

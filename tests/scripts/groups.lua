-- The label groups, button rows, lists, check list, offset and screw of
-- examples/tools/Groups.lua, worked as a person would; folding shown through
-- the rows' visibility.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*)/[^/]*$")
orbane.LoadTool(here .. "/../../examples/tools/Groups.lua", "Groups1")
orbane.ShowTool("Groups1")

local function value(input) return orbane.GetValue("Groups1", input) end
local function steps() return #orbane.UndoNames() end
local function at(input, child) return { tool = "Groups1", input = input, child = child } end
local function shown(input) return orbane.State(at(input)).visible end

-- Button rows: the value of the button, the row's own undo name; a disabled
-- button takes no click.
orbane.Click(at("Gang", "button5"))
check.eq(value("Gang"), 8, "Eight has its own value")
check.eq(orbane.UndoNames()[1], "Choose gang", "the row names its step")
check.eq(orbane.State(at("Gang", "button5")).check, 1, "Eight shown chosen")
orbane.Click(at("Gang", "button6"))
check.eq(value("Gang"), 8, "Sixteen is disabled")
orbane.Click(at("Quality", "button3"))
check.eq(value("Quality"), "best", "identifier of the button")

-- The list: a click, then keys; several rows as bits in Layers.
orbane.Click(at("Colour", "list"), { row = 4 })
check.eq(value("Colour"), 3, "Cyan clicked")
orbane.Key(at("Colour", "list"), "Down")
check.eq(value("Colour"), 4, "Down steps to Magenta, scrolling")
orbane.Click(at("Layers", "list"), { row = 2, mods = "ctrl" })
check.eq(value("Layers"), 1 + 2 + 4, "Matte added to the layers")

-- The check list: a box, then None, keeping no bit.
orbane.Click(at("Channels", "item4"), { x = 5, y = 8 })
check.eq(value("Channels"), 7 + 128, "Alpha is bit 7")
orbane.Click(at("Channels", "none"))
check.eq(value("Channels"), 0, "None clears every box")

-- Folding: the nested group inside, then the outer one; no undo steps.
local before = steps()
orbane.Click(at("Details", "header"))
check.eq(value("Details"), 0, "Details closed")
check.eq(shown("Colour"), false, "Colour folded away")
check.eq(shown("Line"), true, "Line outside the nested group")
orbane.Click(at("Look", "header"))
check.eq(shown("Gang"), false, "Gang folded with Look")
check.eq(shown("Center"), true, "Center outside every group")
orbane.Click(at("Look", "header"), { mods = "ctrl" })
check.eq(value("Look") + value("Details"), 2, "Ctrl-click opens every group")
check.eq(shown("Colour"), true, "Colour back")
check.eq(steps(), before, "folding leaves no undo step")

-- The offset: typed into Y, dragged on X; the viewer's point follows.
orbane.Click(at("Center", "y"))
orbane.Type(at("Center", "y"), "0.25")
orbane.Key(at("Center", "y"), "Return")
check.near(value("Center")[2], 0.25, "Y typed")
orbane.Drag(at("Center", "x"), { x = 10, y = 8 }, { x = 60, y = 8 })
check.near(value("Center")[1], 0.5 + 50 * 0.002, "X dragged 50 pixels")

-- The screw: a drag, with no bounds.
orbane.Drag(at("Spin", "wheel"), { x = 100, y = 9 }, { x = 20, y = 9 })
check.eq(value("Spin"), -40, "80 pixels left at 0.5")
orbane.Undo()
check.eq(value("Spin"), 0, "the drag is one step")

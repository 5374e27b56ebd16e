-- Combo boxes and the script value list of examples/tools/Choices.lua, worked
-- with the mouse and the keys as a person would.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*)/[^/]*$")
orbane.LoadTool(here .. "/../../examples/tools/Choices.lua", "Choices1")
orbane.ShowTool("Choices1")

local function value(input) return orbane.GetValue("Choices1", input) end
local function steps() return #orbane.UndoNames() end
-- Opens the list with F4 and clicks a row.
local function choose(box, row) orbane.Key(box, "F4") orbane.Click("popup", { row = row }) end

-- Blend: Normal 0, separator, Add 1, Subtract 10, Multiply 3, separator, Screen 4.
local blend = { tool = "Choices1", input = "Blend", child = "combo" }
check.eq(orbane.State(blend).text, "Normal", "Blend starts on Normal")

-- Open the list, click a row: the item's own value, one step per choice.
choose(blend, 4)
check.eq(value("Blend"), 10, "Subtract gives its own value")
check.eq(orbane.State(blend).text, "Subtract", "Subtract shown")
choose(blend, 7)
check.eq(value("Blend"), 4, "Screen keeps its place among the items")
check.eq(steps(), 2, "one step per choice")

-- Keys on the closed box choose at once; in the open list they preview
-- until Return.
orbane.Key(blend, "Up")
check.eq(value("Blend"), 3, "Up goes past the separator to Multiply")
orbane.Key(blend, "F4")
orbane.Key("popup", "Up")
orbane.Key("popup", "Up")
check.eq(value("Blend"), 1, "previewing Add")
orbane.Key("popup", "Return")
orbane.Process()
local names = orbane.UndoNames()
check.eq(#names, 4, "the previews and the choice are one step")
check.eq(names[4], "Change Blend", "named after the Input")
orbane.Undo()
check.eq(orbane.State(blend).text, "Multiply", "undo goes back to Multiply and shows it")

-- Opened with the mouse, closed with Escape: nothing chosen, nothing written.
-- (Last for this box: Qt ignores a release in its list for a moment after
-- the mouse opened it, so that the opening click cannot choose.)
orbane.Click(blend)
orbane.Key("popup", "Up")
check.eq(value("Blend"), 10, "the highlighted item is previewed")
orbane.Key("popup", "Escape")
orbane.Process()
check.eq(value("Blend"), 3, "Escape puts the value back")
check.eq(steps(), 3, "a cancelled list leaves no undo step")
check.fails(function() orbane.State("popup") end, "no popup", "the list is closed")

-- Channel: an identifier, items sorted by name: Alpha, Blue, Green, Red.
local channel = { tool = "Choices1", input = "Channel", child = "combo" }
check.eq(orbane.State(channel).text, "Green", "Channel starts on green")
choose(channel, 1)
check.eq(value("Channel"), "alpha", "Alpha's identifier")
orbane.Key(channel, "End")
check.eq(value("Channel"), "red", "End chooses Red")
orbane.Undo()
check.eq(value("Channel"), "alpha", "undo")

-- Filter: a text Input, names with numbers in their order.
local filter = { tool = "Choices1", input = "Filter", child = "combo" }
orbane.Key(filter, "Down")
check.eq(value("Filter"), "Gaussian", "after Box")
orbane.Key(filter, "Down")
check.eq(value("Filter"), "Lanczos 3", "3 before 10")
choose(filter, 4)
check.eq(value("Filter"), "Lanczos 10", "last")

-- Metadata: keys sorted: Camera (and its keys), Channels, Filename, FrameRate, Lens.
local list = { tool = "Choices1", input = "Metadata", child = "list" }
orbane.Click(list, { row = 3 })
orbane.Click(list, { row = 4, mods = "shift" })
orbane.Key(list, "C", "ctrl")
check.eq(orbane.Clipboard(), "Filename\tplate_v003.exr\nFrameRate\t24\n", "two rows copied")
orbane.Click(list, { row = 2 })
orbane.Key(list, "C", "ctrl")
check.eq(orbane.Clipboard(), "Channels\t{ R, G, B, A }\n", "a list reads inline")
check.eq(value("Metadata").Camera.ISO, 800, "the table is left as it was")

-- Check boxes and buttons worked as a person works them, through the
-- headless application: clicks, the mixed state, a second control of the
-- same Input following without writing, and undo in one step per click.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local tool = "Switches1"
local first = { tool = tool, input = "Channels", index = 1, child = "checkbox" }
local second = { tool = tool, input = "Channels", index = 2, child = "checkbox" }

-- The demo starts the tri-state Input at -1: both boxes show the mixed state.
check.eq(orbane.GetValue(tool, "Channels"), -1, "initial value")
check.eq(orbane.State(first).check, 2, "first box mixed")
check.eq(orbane.State(second).check, 2, "second box mixed")

-- Mixed -> off -> on -> mixed again: the third state is written as -1.
local before = #orbane.UndoNames()
orbane.Click(first)
check.eq(orbane.GetValue(tool, "Channels"), 0, "after one click")
orbane.Click(first)
check.eq(orbane.GetValue(tool, "Channels"), 1, "after two clicks")
check.eq(orbane.State(second).check, 1, "the second box follows")
orbane.Click(first)
check.eq(orbane.GetValue(tool, "Channels"), -1, "the third state writes -1")
check.eq(orbane.State(second).check, 2, "the second box shows mixed")

-- Three clicks, three undo steps; the second box wrote nothing.
local names = orbane.UndoNames()
check.eq(#names, before + 3, "one undo step per click")
check.eq(names[#names], "Change Apply to all channels", "the step's name")

orbane.Undo()
check.eq(orbane.GetValue(tool, "Channels"), 1, "undo restores the value before the click")
check.eq(orbane.State(first).check, 1, "undo re-notifies the first box")
check.eq(orbane.State(second).check, 1, "undo re-notifies the second box")
orbane.Redo()
check.eq(orbane.GetValue(tool, "Channels"), -1, "redo")
orbane.Undo()
orbane.Click(second)
check.eq(orbane.GetValue(tool, "Channels"), -1, "after an undo the second box clicks on from what it shows")

-- A two-state box toggles, with Ctrl held too (modifiers do not change a toggle).
orbane.Click({ tool = tool, input = "Invert", child = "checkbox" }, { mods = "ctrl" })
check.eq(orbane.GetValue(tool, "Invert"), 1, "two-state toggle")

-- The wrapping box is taller than a one-line box.
local wrapped = orbane.State({ tool = tool, input = "Clip" })
local plain = orbane.State({ tool = tool, input = "Invert" })
check.eq(wrapped.height > plain.height, true, "a long label wraps onto more lines")

-- The button runs its script with the tool in view; the script's write is
-- one undo step like any other.
orbane.SetValue(tool, "Invert", 1)
orbane.Click({ tool = tool, input = "Reset", child = "button" })
check.eq(orbane.GetValue(tool, "Invert"), 0, "the button's script wrote the Input")
orbane.Undo()
check.eq(orbane.GetValue(tool, "Invert"), 1, "the script's write is undone")

-- The demo comp's Grading tool driven through its controls' children, as a
-- pipeline scripter drives it: curves, levels, gamma, log, ranges, kernel.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Grading1")
local function value(id) return orbane.GetValue("Grading1", id) end
local function child(input, name) return { tool = "Grading1", input = input, child = name } end
local function steps() return #orbane.UndoNames() end
-- Types into a box and presses Return, as a person commits a value.
local function enter(target, text)
  orbane.Key(target, "A", "ctrl")
  orbane.Type(target, text)
  orbane.Key(target, "Return")
end

-- A graph shows 0..1 inside a margin of 6 pixels, y up.
local function at(target, x, y)
  local s = orbane.State(target)
  return { x = math.floor(6 + x * (s.width - 12) + 0.5), y = math.floor(s.height - 6 - y * (s.height - 12) + 0.5) }
end

-- Curves: the luminance point at (0.25, 0.2) dragged up, one step.
local graph = child("Curves", "graph")
local before = steps()
orbane.Drag(graph, at(graph, 0.25, 0.2), at(graph, 0.25, 0.4))
check.near(value("Curves").luma[2][2], 0.4, "the point moved up", 0.02)
check.eq(steps(), before + 1, "one step")
check.eq(orbane.UndoNames()[steps()], "Change Curves", "named for the Input")
-- The red curve, chosen by its button, takes a new point; reset takes it away.
orbane.Click(child("Curves", "red"))
orbane.Click(graph, at(graph, 0.5, 0.8))
check.eq(#value("Curves").red, 3, "a point added to red")
orbane.Click(child("Curves", "reset"))
check.eq(#value("Curves").red, 2, "red reset")
check.eq(#value("Curves").luma, 4, "luma untouched")

-- Levels: the black handle dragged under the histogram writes InBlack.
local bar = child("InBlack", "histogram")
local s = orbane.State(bar)
local y = s.height - 4
orbane.Drag(bar, { x = at(bar, 0.02, 0).x, y = y }, { x = at(bar, 0.3, 0).x, y = y })
check.near(value("InBlack"), 0.3, "black moved", 0.01)
check.eq(value("InWhite"), 0.95, "white stays")
enter(child("InBlack", "gamma"), "2")
check.near(value("InGamma"), 2, "gamma typed")

-- Gamma typed; log settings typed one at a time.
enter(child("Gamma", "edit"), "1.8")
check.near(value("Gamma"), 1.8, "gamma typed")
enter(child("Log", "white"), "700")
check.eq(value("Log").white, 700, "white code value")

-- Kernel: an edge kernel cannot be normalised, and says so.
orbane.Click(child("Kernel", "edge"))
check.eq(value("Kernel")[2][2], 8, "edge preset")
local n = steps()
orbane.Click(child("Kernel", "normalise"))
check.eq(steps(), n, "nothing written")
assert(orbane.State(child("Kernel", "message")).text:find("sum to 0"), "the message says why")

-- Values written by a script show in the controls, tidied where need be.
orbane.SetValue("Grading1", "Ranges", { lowStart = 0.5, lowEnd = 0.2, highStart = 0.6, highEnd = 0.9 })
local ranges = child("Ranges", "graph")
orbane.Drag(ranges, at(ranges, 0.5, 0), at(ranges, 0.55, 0))
check.near(value("Ranges").lowStart, 0.2, "reversed ends taken the right way round", 0.01)
check.near(value("Ranges").lowEnd, 0.55, "the end dragged", 0.02)

orbane.Undo()
check.near(value("Ranges").lowEnd, 0.2, "undone", 0.001)

-- Bad inputs at every entry point: each call must fail with an error that
-- names the call and the argument, and leave the document as it was.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local tool = "Switches1"
local box = { tool = tool, input = "Invert", child = "checkbox" }
local selfish = {}
selfish.me = selfish

-- What a user sees of the document.
local function snapshot()
  return table.concat({ #orbane.UndoNames(), #orbane.RedoNames(), orbane.GetTime(),
                        orbane.GetValue(tool, "Invert"), orbane.GetValue(tool, "Channels"),
                        table.concat(orbane.Tools(), ",") }, "|")
end

local bad = {
  -- values and times
  { "value NaN", function() orbane.SetValue(tool, "Invert", 0 / 0) end,
    "SetValue: argument 3 (value): NaN and infinities are not values" },
  { "value infinite", function() orbane.SetValue(tool, "Invert", -math.huge) end, "not values" },
  { "value inside a table", function() orbane.SetValue(tool, "Invert", { 0 / 0 }) end, "not values" },
  { "value contains itself", function() orbane.SetValue(tool, "Invert", selfish) end,
    "SetValue: argument 3 (value): a table contains itself" },
  { "value of another type", function() orbane.SetValue(tool, "Invert", "on") end,
    "SetValue: argument 3 (value): Input \"Invert\": expected a value of type Number, got string" },
  { "no such tool", function() orbane.SetValue("Nope1", "Invert", 1) end,
    "SetValue: argument 1 (tool): no tool \"Nope1\"" },
  { "tool of another kind", function() orbane.GetValue({}, "Invert") end,
    "GetValue: argument 1 (tool): expected a string, got table" },
  { "no such Input", function() orbane.GetValue(tool, "Nope") end,
    "GetValue: argument 2 (input): tool \"Switches1\" has no Input \"Nope\"" },
  { "time NaN", function() orbane.SetValue(tool, "Invert", 1, 0 / 0) end,
    "SetValue: argument 4 (time): expected a finite number, got nan" },
  { "read time infinite", function() orbane.GetValue(tool, "Invert", math.huge) end,
    "GetValue: argument 3 (time): expected a finite number, got inf" },
  { "document time NaN", function() orbane.SetTime(0 / 0) end, "SetTime: argument 1 (time)" },
  { "document time text", function() orbane.SetTime("noon") end,
    "SetTime: argument 1 (time): expected a finite number, got string" },
  -- keys
  { "empty key", function() orbane.Key(box, "") end, "Key: argument 2 (key): unknown key \"\"" },
  { "unknown key", function() orbane.Key(box, "Nope") end, "unknown key \"Nope\"" },
  { "key code too big", function() orbane.Key(box, 2 ^ 40) end, "Key: argument 2 (key): expected a whole number" },
  { "key code fraction", function() orbane.Key(box, 65.5) end, "expected a whole number" },
  { "unknown modifier", function() orbane.Key(box, "Left", "hyper") end,
    "Key: argument 3 (mods): unknown modifier in \"hyper\"" },
  { "unknown phase", function() orbane.Key(box, "Left", "", "twice") end,
    "Key: argument 4 (phase): expected click, press or release" },
  { "viewer key empty", function() orbane.ViewerKey("") end, "ViewerKey: argument 1 (key): unknown key" },
  -- positions and counts
  { "x of 2^31", function() orbane.Click(box, { x = 2 ^ 31, y = 1 }) end,
    "Click: argument 2 (x): expected a whole number from -1048576 to 1048576, got 2147483648" },
  { "y NaN", function() orbane.Press(box, { x = 1, y = 0 / 0 }) end, "Press: argument 2 (y)" },
  { "unknown button", function() orbane.Click(box, { button = "fourth" }) end,
    "Click: argument 2 (button): expected left, right, middle or none" },
  { "gesture not a table", function() orbane.Click(box, 5) end, "Click: argument 2 (gesture): expected a table" },
  { "drag steps huge", function() orbane.Drag(box, {}, {}, { steps = 1e9 }) end,
    "Drag: argument 4 (steps): expected a whole number from 1 to 10000" },
  { "drag steps none", function() orbane.Drag(box, {}, {}, { steps = 0 }) end, "argument 4 (steps)" },
  { "row of 2^31", function() orbane.Click(box, { row = 2 ^ 31 }) end, "Click: argument 2 (row)" },
  { "control index huge", function() orbane.Click({ tool = tool, input = "Invert", index = 2 ^ 53 }) end,
    "target: argument 1 (index)" },
  { "viewer x huge", function() orbane.ViewerPress({ x = 1e300, y = 0 }) end, "ViewerPress: argument 1 (x)" },
  { "viewer image coordinate NaN", function() orbane.ViewerHover({ ix = 0 / 0, iy = 0 }) end,
    "ViewerHover: argument 1 (ix)" },
  { "viewer flags negative", function() orbane.ViewerPress({ flags = -1 }) end, "ViewerPress: argument 1 (flags)" },
  -- texts and targets
  { "typed text too long", function() orbane.Type(box, string.rep("a", 10001)) end,
    "Type: argument 2 (text): longer than 10000 characters" },
  { "typed text missing", function() orbane.Type(box) end, "Type: argument 2 (text): expected a string, got no value" },
  { "target that does not exist", function() orbane.Click({ tool = "Nope1", input = "Invert" }) end,
    "no tool \"Nope1\"" },
  { "child that does not exist", function() orbane.Click({ tool = tool, input = "Invert", child = "nope" }) end,
    "has no child \"nope\"" },
  { "overlay input not a string", function() orbane.Overlay(tool, 1) end,
    "Overlay: argument 2 (input): expected a string, got 1" },
  { "comp path missing", function() orbane.LoadComp() end, "LoadComp: argument 1 (path): expected a string, got no value" },
  { "comp that does not exist", function() orbane.LoadComp(here .. "nope.lua") end, "nope.lua" },
  { "tool name not a string", function() orbane.LoadTool(here .. "x.lua", 5) end, "LoadTool: argument 2 (name)" },
  { "grab path missing", function() orbane.Grab(box) end, "Grab: argument 2 (path)" },
}

local before = snapshot()
for _, row in ipairs(bad) do
  local name, fn, expected = row[1], row[2], row[3]
  local ok, err = pcall(fn)
  if ok then error(name .. ": expected an error") end
  if not tostring(err):find(expected, 1, true) then
    error(string.format("%s: error %q does not contain %q", name, tostring(err), expected))
  end
  check.eq(snapshot(), before, name .. ": the document is unchanged")
end

-- Any text can be typed, in any script.
orbane.Type({ tool = "Sliders1", input = "Size", child = "edit" }, "ä€😀\0\t")
orbane.Key({ tool = "Sliders1", input = "Size", child = "edit" }, "Escape")

-- A comp that loops or grows without end stops with its file named, and the
-- document stays as it was.
local path = os.tmpname()
for _, comp in ipairs({ "while true do end", "local t = {} while true do t[#t + 1] = ('x'):rep(999) .. #t end" }) do
  local f = assert(io.open(path, "w"))
  f:write(comp)
  f:close()
  local ok, err = pcall(orbane.LoadComp, path)
  check.eq(ok, false, comp)
  check.eq(tostring(err):find(path .. ": stopped", 1, true) ~= nil, true, "the message names the comp: " .. tostring(err))
  check.eq(snapshot(), before, comp .. ": the document is unchanged")
end
os.remove(path)

-- Number sliders worked as a person works them, through the headless
-- application: drags with and without Ctrl, integer snapping, keys, typing,
-- Alt-click back to the default, and one undo step per gesture.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local tool = "Sliders1"
local function target(input, child) return { tool = tool, input = input, child = child } end

-- The knob (11 pixels wide) stays on the track: its centre runs from pixel
-- 5 to width - 6.
local KNOB_Y = 7
-- (orbane.Drag is given its options table every time, even an empty one.)
local function track(input)
  local width = orbane.State(target(input, "slider")).width
  return 5, width - 6
end
local function knobX(lo, hi, fraction) return math.floor(lo + (hi - lo) * fraction + 0.5) end
local function places(v, n) return tonumber(string.format("%." .. n .. "f", v)) == v end

-- Blend: 0..1, three places, starts at 1 (the knob at the right end). A drag
-- moves the value by the pixels over the track's span, rounded to the places.
local lo, hi = track("Blend")
local span = hi - lo
local slider = target("Blend", "slider")
check.eq(orbane.GetValue(tool, "Blend"), 1, "Blend starts at 1")

local before = #orbane.UndoNames()
orbane.Drag(slider, { x = hi, y = KNOB_Y }, { x = hi - 100, y = KNOB_Y })
local plain = orbane.GetValue(tool, "Blend")
check.near(plain, 1 - 100 / span, "a plain drag of 100 pixels", 0.0015)
check.eq(places(plain, 3), true, "three places")
check.eq(#orbane.UndoNames(), before + 1, "one drag, one undo step")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Change Blend", "the step's name")
check.eq(orbane.State(target("Blend", "edit")).text, string.format("%.3f", plain), "the edit box shows it")

orbane.Undo()
check.eq(orbane.GetValue(tool, "Blend"), 1, "undo puts the knob back at 1")

-- With Ctrl the same hand movement moves the value ten times less.
orbane.Drag(slider, { x = hi, y = KNOB_Y }, { x = hi - 100, y = KNOB_Y }, { mods = "ctrl" })
check.near(orbane.GetValue(tool, "Blend"), 1 - 10 / span, "a Ctrl drag of 100 pixels", 0.0015)

-- Past the end: clamped.
local at = knobX(lo, hi, orbane.GetValue(tool, "Blend"))
orbane.Drag(slider, { x = at, y = KNOB_Y }, { x = lo - 80, y = KNOB_Y })
check.eq(orbane.GetValue(tool, "Blend"), 0, "dragged past the low end")

-- Alt-click goes back to the default (1).
orbane.Click(slider, { x = hi / 2, y = KNOB_Y, mods = "alt" })
check.eq(orbane.GetValue(tool, "Blend"), 1, "Alt-click resets to the default")

-- Samples: whole numbers 1..16 snapped to steps of 1; keys step by 1, and
-- with Shift by a third of the range (4 ticks).
local sLo, sHi = track("Samples")
local samples = target("Samples", "slider")
local x4 = knobX(sLo, sHi, 3 / 15)
orbane.Drag(samples, { x = x4, y = KNOB_Y }, { x = x4 + math.floor((sHi - sLo) * 2.3 / 15), y = KNOB_Y })
check.eq(orbane.GetValue(tool, "Samples"), 6, "a drag of 2.3 values snaps to 6")
orbane.Key(samples, "Right")
check.eq(orbane.GetValue(tool, "Samples"), 7, "Right steps by 1")
orbane.Key(samples, "Left", "shift")
check.eq(orbane.GetValue(tool, "Samples"), 2, "Shift+Left steps by 5")
orbane.Key(samples, "End")
check.eq(orbane.GetValue(tool, "Samples"), 16, "End goes to the top")

-- Typing: a value rounded to the places, then an expression of the value.
local edit = target("Blend", "edit")
orbane.Click(edit)
orbane.Type(edit, "0.12345")
orbane.Key(edit, "Return")
check.eq(orbane.GetValue(tool, "Blend"), 0.123, "typed 0.12345, three places")
orbane.Click(edit)
orbane.Type(edit, "=value*4")
orbane.Key(edit, "Return")
check.near(orbane.GetValue(tool, "Blend"), 0.492, "typed =value*4")

-- Time display: frames, written as dragged.
local dLo, dHi = track("Delay")
local delay = target("Delay", "slider")
local x36 = knobX(dLo, dHi, 36 / 480)
orbane.Drag(delay, { x = x36, y = KNOB_Y }, { x = x36 + 10, y = KNOB_Y })
local frames = orbane.GetValue(tool, "Delay")
check.eq(frames > 36, true, "the delay grew")
check.eq(orbane.State(target("Delay", "edit")).text:match("^%d%d:%d%d:%d%d:%d%d$") ~= nil, true,
         "the delay shows as a time code")

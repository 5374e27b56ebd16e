-- The colour controls, driven as a person drives them and read back.
local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local function near(a, b) return math.abs(a - b) < 1e-4 end
local T = "Colour1"

-- Hex: one undo step for all four channels.
local hex = { tool = T, input = "TintRed", child = "hex" }
orbane.Key(hex, "A", "ctrl")
orbane.Type(hex, "#0000FF80")
orbane.Key(hex, "Return")
assert(orbane.GetValue(T, "TintRed") == 0 and orbane.GetValue(T, "TintBlue") == 1)
assert(near(orbane.GetValue(T, "TintAlpha"), 128 / 255))
assert(#orbane.UndoNames() == 1 and orbane.UndoNames()[1] == "Change Tint")
assert(orbane.State(hex).text == "#0000FF80")

-- The second view: HLS after one click on "model".
orbane.Click({ tool = T, input = "TintRed", child = "model" })
assert(orbane.State({ tool = T, input = "TintRed", child = "model" }).text == "HLS")
assert(orbane.State({ tool = T, input = "TintRed", child = "space" }).text == "240.0 0.500 1.000")

-- A drag on the red track, Ctrl finer: one step.
orbane.Drag({ tool = T, input = "TintRed", child = "red" }, { x = 10, y = 9 }, { x = 120, y = 9 })
assert(orbane.GetValue(T, "TintRed") > 0.2)
assert(#orbane.UndoNames() == 2)
orbane.Undo()
assert(orbane.GetValue(T, "TintRed") == 0)

-- HDR values stay exact; the hex shows them clipped. No alpha on an RGB control.
orbane.SetValue(T, "GlowRed", 3.25)
assert(orbane.GetValue(T, "GlowRed") == 3.25)
assert(orbane.State({ tool = T, input = "GlowRed", child = "hex" }).text == "#FFFFBC")
assert(not orbane.State({ tool = T, input = "GlowRed", child = "alpha" }).visible)
assert(not orbane.State({ tool = T, input = "GlowRed", child = "pick" }).visible)

-- The picker samples the viewer's image in linear values, once its pixels are read.
orbane.WaitImage()
orbane.Click({ tool = T, input = "TintRed", child = "pick" })
orbane.Click("viewer")
local r, g, b = orbane.GetValue(T, "TintRed"), orbane.GetValue(T, "TintGreen"), orbane.GetValue(T, "TintBlue")
assert(r >= 0 and r <= 1 and g >= 0 and b >= 0, "picked a colour of the image")
assert(orbane.UndoNames()[#orbane.UndoNames()] == "Change Tint")
assert(not orbane.State({ tool = T, input = "TintRed", child = "pick" }).check or
       orbane.State({ tool = T, input = "TintRed", child = "pick" }).check == 0)
orbane.Grab("inspector", os.getenv("TMPDIR") and (os.getenv("TMPDIR") .. "/colour.png") or "/tmp/colour.png")
-- The lift wheel: a Shift drag round the centre keeps the saturation.
local wheel = { tool = T, input = "Lift", child = "wheel" }
orbane.SetValue(T, "Lift", { 0.5, 0 })
local steps = #orbane.UndoNames()
orbane.Drag(wheel, { x = 160, y = 60 }, { x = 160, y = 20 }, { mods = "shift" })
local p = orbane.GetValue(T, "Lift")
assert(near(math.sqrt(p[1] * p[1] + p[2] * p[2]), 0.5) and p[2] > 0.1, "hue turned, saturation kept")
assert(#orbane.UndoNames() == steps + 1)
orbane.DoubleClick(wheel)
p = orbane.GetValue(T, "Lift")
assert(p[1] == 0 and p[2] == 0 and orbane.UndoNames()[#orbane.UndoNames()] == "Reset Lift")
assert(orbane.State({ tool = T, input = "Lift", child = "readout" }).text == "H 0.0  S 0.000  M 0.000")
-- The gradient: a click adds a stop, a drag off the bar deletes it.
local bar = { tool = T, input = "Ramp", child = "bar" }
local w = orbane.State(bar).width
steps = #orbane.UndoNames()
orbane.Click(bar, { x = math.floor(w * 0.75), y = 24 })
assert(#orbane.GetValue(T, "Ramp").stops == 4 and #orbane.UndoNames() == steps + 1)
orbane.Drag(bar, { x = math.floor(w * 0.75), y = 24 }, { x = math.floor(w * 0.75), y = 80 })
assert(#orbane.GetValue(T, "Ramp").stops == 3 and #orbane.UndoNames() == steps + 2)
orbane.SetValue(T, "Ramp", { stops = "broken" })
assert(orbane.State(bar).visible)
-- Suppression: a press on the right half of the red spoke.
local hex6 = { tool = T, input = "SupRed", child = "hexagon" }
local st = orbane.State(hex6)
orbane.Click(hex6, { x = math.floor(st.width / 2 + (st.width / 2 - 8) * 0.5), y = math.floor(st.height / 2) })
assert(math.abs(orbane.GetValue(T, "SupRed") - 0.5) < 0.03, orbane.GetValue(T, "SupRed"))
assert(orbane.GetValue(T, "SupGreen") == 0.6)
-- The gamut: Rec. 2020 by name; the list chooses another space.
local gamut = orbane.GetValue(T, "Gamut")
assert(gamut.space == "Rec. 2020")
local space = { tool = T, input = "Gamut", child = "space" }
orbane.Key(space, "Home")
assert(orbane.GetValue(T, "Gamut").space == "Rec. 709" and orbane.GetValue(T, "Gamut").red[1] == 0.64)
assert(orbane.State({ tool = T, input = "Gamut", child = "readout" }).text:find("R 0.6400 0.3300", 1, true))
-- The pattern and the image.
orbane.Click({ tool = T, input = "Fill", child = "pattern5" })
assert(orbane.GetValue(T, "Fill") == 4)
assert(orbane.State({ tool = T, input = "Plate", child = "info" }).text:find("^%d+ x %d+, RGB"))
print("colour: ok")

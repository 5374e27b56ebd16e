-- The window worked from a script as a person works it: the keyframe entries
-- of a control's context menu, the time ruler's scrubbing and marks, the
-- File menu with its question, the undo history, and what screen readers read.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Sliders1")
local out = os.getenv("ORBANE_TEST_OUT") or "/tmp"

-- Keyframes from the inspector's context menu, each one undo step.
local entries = {}
for _, e in ipairs(orbane.InspectorMenu("Sliders1", "Blend")) do entries[e.text] = e.enabled end
check.eq(entries["Set Key"], true, "Set Key offered")
check.eq(entries["Remove Key"], false, "no key to remove yet")
check.eq(entries["Animate"], true, "Animate offered on a plain Input")
check.eq(orbane.InspectorMenu("Sliders1", "Blend", "Set Key"), true, "Set Key chosen")
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Set Key", "named after the entry")
orbane.SetTime(40)
orbane.SetValue("Sliders1", "Blend", 0)
check.eq(#orbane.Keys("Sliders1", "Blend"), 2, "a write at another time adds a key")

-- The ruler: marks where the keys are; a drag over it scrubs the time and the
-- slider's field follows.
local ruler = orbane.Ruler()
check.eq(ruler.keys[1], 0, "first mark")
check.eq(ruler.keys[2], 40, "second mark")
local y = math.floor(orbane.State("ruler").height / 2)
local mid = math.floor((ruler.keyX[1] + ruler.keyX[2]) / 2 + 0.5)
orbane.Drag("ruler", { x = ruler.keyX[2], y = y }, { x = mid, y = y })
check.eq(orbane.GetTime(), 20, "scrubbed to the middle frame")
check.eq(orbane.State({ tool = "Sliders1", input = "Blend", child = "edit" }).text, "0.500", "the slider shows frame 20")
check.eq(orbane.Accessible({ tool = "Sliders1", input = "Blend" }).name, "Blend", "accessible name")
check.eq(orbane.Accessible({ tool = "Sliders1", input = "Blend" }).description, "0.5", "accessible value")
orbane.Click("stepForward")
check.eq(orbane.GetTime(), 21, "step forward")
orbane.Click("last")
check.eq(orbane.GetTime(), 100, "last frame")
orbane.Click("play")
check.eq(orbane.Ruler().playing, true, "Play starts playback")
check.eq(orbane.State("play").text, "Stop", "the button offers Stop")
orbane.Click("play")
check.eq(orbane.Ruler().playing, false, "Stop ends it")

-- Remove Animation keeps the value now, and undo brings both keys back.
orbane.SetTime(20)
check.eq(orbane.InspectorMenu("Sliders1", "Blend", "Remove Animation"), true, "Remove Animation chosen")
check.eq(#orbane.Keys("Sliders1", "Blend"), 0, "no keys left")
check.eq(orbane.GetValue("Sliders1", "Blend", 99), 0.5, "the value at frame 20 stays")
orbane.Undo()
check.eq(#orbane.Keys("Sliders1", "Blend"), 2, "undo brings the keys back")

-- The history lists every step; the Edit menu names the next undo.
local rows = orbane.History()
check.eq(rows[1], "<empty>", "history starts empty")
check.eq(rows[#rows], "Remove Animation", "the undone step is still listed, to redo")
local edit = {}
for _, e in ipairs(orbane.Menu({ "Edit" })) do edit[#edit + 1] = e.text end
check.eq(edit[1], "Undo Change Blend", "Edit menu names the step")

-- File: Save As through the dialog's answer, the modified mark, the recent list.
local path = out .. "/window_script_comp.lua"
orbane.AnswerPrompts("cancel", path)
check.eq(orbane.WindowState().modified, true, "edits mark the window modified")
check.eq(orbane.Menu({ "File", "Save As" }), true, "Save As chosen")
local state = orbane.WindowState()
check.eq(state.modified, false, "saved")
check.eq(state.title, "window_script_comp.lua[*] - Orbane", "title names the comp")
check.eq(orbane.Menu({ "File", "Open Recent" })[1].text, path, "the comp heads Open Recent")

-- New with unsaved work asks; Cancel keeps the tools.
orbane.SetValue("Sliders1", "Size", 12)
orbane.Menu({ "File", "New" })
check.eq(#orbane.WindowState().questions, 1, "asked before losing work")
check.eq(#orbane.Tools() > 0, true, "Cancel kept the work")
orbane.AnswerPrompts("discard")
orbane.Menu({ "File", "New" })
check.eq(#orbane.Tools(), 0, "Discard cleared the document")
check.eq(orbane.WindowState().title, "Untitled[*] - Orbane", "a new comp is untitled")

-- Open Recent brings the saved work back, keys included.
orbane.Menu({ "File", "Open Recent", path })
check.eq(#orbane.Keys("Sliders1", "Blend"), 2, "keys came back")
os.remove(path)

-- Overlays are painted; the viewer's accessible interface names each after
-- its Input, with the value now.
orbane.ShowTool("Points1")
local painted = {}
for _, part in ipairs(orbane.Accessible("viewer").painted) do painted[part.name] = part.description end
check.eq(painted["Center"], "0.5, 0.5", "the Center overlay is named, with its value")

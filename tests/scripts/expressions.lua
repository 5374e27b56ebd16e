-- Live expressions as a user and a pipeline script make them: typed into a
-- slider's edit box or set by a call, followed when the time or the Inputs
-- they name change; cycles and missing Inputs refused with the reason shown;
-- undo puts back the expression and the value before it.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local tool = "Sliders1"
local function target(input, child) return { tool = tool, input = input, child = child } end
orbane.ShowTool(tool)

-- Typed with "=" into the edit box: kept, shown in the expression field,
-- and the slider follows Size from then on.
local edit = target("Blend", "edit")
orbane.Click(edit)
orbane.Type(edit, "=Size / 20")
orbane.Key(edit, "Return")
check.eq(orbane.GetExpression(tool, "Blend"), "Size / 20", "the typed expression is kept")
check.near(orbane.GetValue(tool, "Blend"), 0.5, "Blend from Size 10")
local field = orbane.State(target("Blend", "expression.0"))
check.eq(field.visible, true, "the expression field shows")
check.eq(field.text, "Size / 20", "the field's text")
orbane.SetValue(tool, "Size", 16)
check.near(orbane.GetValue(tool, "Blend"), 0.8, "Blend follows Size")
check.eq(orbane.State(edit).text, "0.800", "the edit box shows the value")

-- A cycle typed into Size's box is refused: the field turns red with the reason.
local sizeEdit = target("Size", "edit")
orbane.Click(sizeEdit)
orbane.Type(sizeEdit, "=Blend * 20")
orbane.Key(sizeEdit, "Return")
check.eq(orbane.GetExpression(tool, "Size"), nil, "a cycle is not kept")
check.eq(orbane.GetValue(tool, "Size"), 16, "Size unchanged")
local refused = orbane.State(target("Size", "expression.0"))
check.eq(refused.visible, true, "the refused text stays in view")
check.eq(refused.tip:find("cycle: Sliders1.Size -> Sliders1.Blend -> Sliders1.Size", 1, true) ~= nil, true,
         "the tip names the cycle: " .. refused.tip)

-- From scripts: the time, another tool's Input, chains.
orbane.SetExpression(tool, "Contrast", "1 + time / 10")
orbane.SetExpression("Dials1", "Angle", "Sliders1.Contrast * 90")
for _, t in ipairs({ 0, 5, 12 }) do
  orbane.SetTime(t)
  check.near(orbane.GetValue(tool, "Contrast"), 1 + t / 10, "Contrast at " .. t)
  check.near(orbane.GetValue("Dials1", "Angle"), (1 + t / 10) * 90, "Angle at " .. t)
end

-- Refusals are Lua errors that change nothing.
check.fails(function() orbane.SetExpression(tool, "Size", "Blur9.Size") end, 'no Input "Blur9.Size"',
            "a missing Input")
check.fails(function() orbane.SetExpression(tool, "Size", "2 +") end, "Unexpected end", "a text that does not parse")
check.eq(orbane.GetExpression(tool, "Size"), nil, "Size stays plain")
check.eq(orbane.ExpressionError(tool, "Contrast"), nil, "Contrast evaluates")

-- Undo: the expression and the value before it come back exactly.
orbane.SetTime(0)
orbane.SetValue(tool, "Hue", 42.5)
orbane.SetExpression(tool, "Hue", "Size * 2")
check.eq(orbane.GetValue(tool, "Hue"), 32, "Hue from Size")
orbane.SetExpression(tool, "Hue", nil)
check.eq(orbane.GetExpression(tool, "Hue"), nil, "removed")
orbane.Undo()
check.eq(orbane.GetExpression(tool, "Hue"), "Size * 2", "undo brings the expression back")
orbane.Undo()
check.eq(orbane.GetExpression(tool, "Hue"), nil, "undo of the expression")
check.eq(orbane.GetValue(tool, "Hue"), 42.5, "the value before it")
orbane.Redo()
orbane.SetValue(tool, "Size", 20)
check.eq(orbane.GetValue(tool, "Hue"), 40, "redone and live")
-- A plain value typed into the box makes the Input plain again, one step.
local steps = #orbane.UndoNames()
orbane.Click(target("Hue", "edit"))
orbane.Type(target("Hue", "edit"), "7")
orbane.Key(target("Hue", "edit"), "Return")
check.eq(orbane.GetExpression(tool, "Hue"), nil, "a typed number ends the expression")
check.eq(orbane.GetValue(tool, "Hue"), 7, "the typed number")
check.eq(#orbane.UndoNames(), steps + 1, "one step")
check.eq(orbane.State(target("Hue", "expression.0")).visible, false, "the field hides")

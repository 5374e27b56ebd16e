-- Saved work as a newcomer makes it: open the demo, animate a slider, a
-- point and a shape, save, open the file again, and find everything as it was.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
check.eq(orbane.IsModified(), false, "the opened demo is unchanged")

-- A key on an Input that is not animated animates it with that one key;
-- undo takes back both.
local plain = orbane.GetValue("Sliders1", "Blend")
orbane.SetKey("Sliders1", "Blend", 0.3, 5)
check.eq(orbane.UndoNames()[#orbane.UndoNames()], "Set Key", "one step")
orbane.Undo()
check.eq(#orbane.Keys("Sliders1", "Blend"), 0, "undo takes the animation back")
check.eq(orbane.GetValue("Sliders1", "Blend"), plain, "and leaves the plain value")
orbane.SetKey("Sliders1", "Blend", 0.2, 0)
orbane.SetKey("Sliders1", "Blend", 0.8, 10)
orbane.SetKey("Sliders1", "Blend", 0.4, 20)
orbane.SetInterpolation("Sliders1", "Blend", "smooth")
orbane.SetKey("Points1", "Center", { 0.1, 0.2 }, 0)
orbane.SetKey("Points1", "Center", { 0.9, 0.6 }, 8)
local mask = orbane.GetValue("Roto1", "Mask")
orbane.SetKey("Roto1", "Mask", mask, 0)
for _, p in ipairs(mask.points) do p.x = p.x + 0.1 end
orbane.SetKey("Roto1", "Mask", mask, 12)
orbane.RemoveKey("Roto1", "Mask", 12)
orbane.SetKey("Roto1", "Mask", mask, 6)
orbane.SetValue("Choices1", "Blend", 1)
orbane.SetTime(4)
check.eq(orbane.IsModified(), true, "keys change the work")
check.eq(table.concat(orbane.Keys("Sliders1", "Blend"), ","), "0,10,20", "slider keys")
check.near(orbane.GetValue("Points1", "Center", 4)[1], 0.5, "the point halfway, linear")
check.eq(orbane.GetInterpolation("Points1", "Center"), "linear", "linear until set")

-- Every value the user can read, at a few times.
local function seen()
  local out = {}
  for _, tool in ipairs(orbane.Tools()) do
    for _, id in ipairs({ "Blend", "Center", "Mask" }) do
      for _, t in ipairs({ -1, 3, 4.5, 9, 15, 30 }) do
        local ok, v = pcall(orbane.GetValue, tool, id, t)
        if ok then
          local text = type(v) == "table" and (v.points and (#v.points .. ":" .. v.points[1].x) or
                       table.concat(v, ",")) or tostring(v)
          out[#out + 1] = tool .. "." .. id .. "@" .. t .. "=" .. text
        end
      end
    end
  end
  return table.concat(out, " ") .. " t=" .. orbane.GetTime()
end
local before = seen()

local path = os.tmpname() .. ".comp.lua"
orbane.SaveComp(path)
check.eq(orbane.CompPath(), path, "the document is the saved file")
check.eq(orbane.IsModified(), false, "saved work is unchanged")

-- Changed, then opened again: the file wins.
orbane.SetValue("Choices1", "Blend", 0)
orbane.SetInterpolation("Sliders1", "Blend", "linear")
check.eq(orbane.IsModified(), true, "an edit after saving")
orbane.OpenComp(path)
check.eq(seen(), before, "every value as it was saved")
check.eq(orbane.GetInterpolation("Sliders1", "Blend"), "smooth", "interpolation saved")
check.eq(table.concat(orbane.Keys("Roto1", "Mask"), ","), "0,6", "shape keys")
check.eq(#orbane.UndoNames(), 0, "an opened comp starts a fresh history")

-- Added to work that has the same tools, the comp is refused as today and
-- nothing changes.
check.fails(function() orbane.LoadComp(path) end, "name taken", "the same tools twice")
check.eq(seen(), before, "a refused comp changes nothing")

-- Keys need finite times and values.
local bad = {
  { function() orbane.SetKey("Sliders1", "Blend", 0.5, 0 / 0) end, "expected a finite number" },
  { function() orbane.SetKey("Sliders1", "Blend", 0.5, math.huge) end, "expected a finite number" },
  { function() orbane.SetKey("Sliders1", "Blend", 0 / 0, 3) end, "finite numbers" },
  { function() orbane.SetKey("Points1", "Center", { 1 / 0, 0 }, 3) end, "finite numbers" },
  { function() orbane.SetInterpolation("Sliders1", "Blend", "cubic") end, "\"linear\" or \"smooth\"" },
  { function() orbane.OpenComp(path .. ".missing") end, "missing" },
}
for i, case in ipairs(bad) do
  check.fails(case[1], case[2], "bad call " .. i)
end
check.eq(seen(), before, "refused calls change nothing")
check.eq(orbane.IsModified(), false, "refused calls are no change")
os.remove(path)

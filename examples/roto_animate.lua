-- The demo comp's sun mask animated over two keyframes: the sun sets between
-- frame 0 and frame 24, and the mask follows it. Run it headless with
--   orbane --headless --script examples/roto_animate.lua
-- to get a picture of frame 12 (the mask half way, the two keyframes' shapes
-- as onion skins) in $ORBANE_SHOTS (or the current folder).
local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "demo.lua")
orbane.ShowTool("Roto1")

-- Frame 24: the same points, lower and a little to the right.
local set = orbane.GetValue("Roto1", "Mask")
for _, p in ipairs(set.points) do
  for _, k in ipairs({ "x", "inX", "outX" }) do p[k] = p[k] + 0.04 end
  for _, k in ipairs({ "y", "inY", "outY" }) do p[k] = p[k] - 0.12 end
end
orbane.SetKey("Roto1", "Mask", orbane.GetValue("Roto1", "Mask"), 0)
orbane.SetKey("Roto1", "Mask", set, 24)
orbane.SetTime(12)
orbane.Process()
local out = (os.getenv("ORBANE_SHOTS") or ".") .. "/roto_frame12.png"
orbane.ViewerGrab(out)
print(out)

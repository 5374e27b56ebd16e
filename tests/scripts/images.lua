-- The viewer's picture from a script: the demo comp's image, a sequence of
-- PNG frames made here with one missing, and a file that is no picture.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
local info = orbane.WaitImage()
check.eq(info.loading, false, "the demo image is read")
check.eq(info.path:match("[^/]*$"), "dusk.png", "the comp's image")
check.eq(info.width .. "x" .. info.height .. "x" .. info.channels, "640x360x3", "its size and channels")
check.eq(info.error, nil, "no message")

local function copy(from, to)
  local i = assert(io.open(from, "rb"))
  local o = assert(io.open(to, "wb"))
  o:write(i:read("*a"))
  i:close()
  o:close()
end

-- Frames 1 and 2 are the dusk image, frame 4 a screenshot of the viewer (of
-- the viewer's size); frame 3 is missing.
local base = os.tmpname()
local function frame(n) return string.format("%s.%04d.png", base, n) end
copy(here .. "../../examples/images/dusk.png", frame(1))
copy(here .. "../../examples/images/dusk.png", frame(2))
orbane.ViewerGrab(frame(4))
local viewer = orbane.ViewerInfo()

orbane.SetTime(2)
info = orbane.ViewImage(base .. ".####.png")
check.eq(info.sequence, true, "a pattern is a sequence")
check.eq(info.first .. "-" .. info.last, "1-4", "the frames found")
info = orbane.WaitImage()
check.eq(info.frame .. "/" .. info.shownFrame, "2/2", "the frame of the time")
check.eq(info.error, nil, "frame 2 is there")

orbane.SetTime(3)
info = orbane.WaitImage()
check.eq(info.frame .. "/" .. info.shownFrame, "3/2", "frame 2 held for the missing frame 3")
check.eq(info.error:match("frame 3 is missing") ~= nil, true, "the message says so: " .. info.error)

orbane.SetTime(4)
info = orbane.WaitImage()
check.eq(info.shownFrame, 4, "frame 4")
check.eq(info.width .. "x" .. info.height, viewer.width .. "x" .. viewer.height, "frame 4's own size")
check.eq(orbane.ViewerInfo().imageWidth, viewer.width, "the viewer shows it")

-- The same sequence by a printf pattern, at a time before its first frame.
orbane.SetTime(0)
orbane.ViewImage(base .. ".%04d.png")
info = orbane.WaitImage(60)
check.eq(info.shownFrame, 1, "before the first frame: the first")

local bad = base .. ".exr"
local f = assert(io.open(bad, "wb"))
f:write("no picture here")
f:close()
info = orbane.ViewImage(bad)
check.eq(info.loading, false, "refused from its header, nothing to wait for")
check.eq(info.error:match("not a readable image") ~= nil, true, "a corrupt file: " .. info.error)
check.eq(orbane.ViewerImageInfo().path, bad, "the path asked for is still reported")

orbane.ViewImage("")
info = orbane.WaitImage()
check.eq(info.path .. "|" .. tostring(info.error), "|nil", "no picture")
check.eq(orbane.ViewerInfo().imageWidth, 1920, "the checkerboard's default size")

for _, file in ipairs({ frame(1), frame(2), frame(4), bad, base }) do
  os.remove(file)
end

-- The demo comp's warp mesh and point tracker worked from a script: vertices
-- picked and dragged through viewer events, then a tracker run over a
-- sequence written here, its keys compared with where the feature is.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")
orbane.ShowTool("Warp1")
orbane.Process()

-- The mesh: 7 x 5 vertices, the 9th the first inner one.
local function mesh() return orbane.OverlayState("Warp1", "Mesh") end
check.eq(mesh().vertices, 35, "vertices")
check.eq(mesh().status, "", "drawn")
local function vertex(i)
  local m = orbane.GetValue("Warp1", "Mesh")
  return m.points[2 * i - 1], m.points[2 * i]
end
local x9, y9 = vertex(9)
local x10, y10 = vertex(10)
orbane.ViewerPress({ ix = x9, iy = y9 })
orbane.ViewerRelease({ ix = x9, iy = y9 })
-- The hand holds Shift down through the click, as overlays read the keyboard.
orbane.ViewerKey(0x01000020, "shift", "press") -- Qt::Key_Shift
orbane.ViewerPress({ ix = x10, iy = y10 })
orbane.ViewerRelease({ ix = x10, iy = y10 })
orbane.ViewerKey(0x01000020, "", "release")
check.eq(table.concat(mesh().selection, ","), "9,10", "click, then Shift-click adds")

-- Both move with the one dragged, 20 pixels right.
local info = orbane.ViewerInfo()
local across = info.imageWidth * info.zoom * info.pixelAspect
orbane.ViewerPress({ ix = x9, iy = y9 })
orbane.ViewerMove({ ix = x9, iy = y9, dx = 10 })
orbane.ViewerMove({ ix = x9, iy = y9, dx = 20 })
orbane.ViewerRelease({ ix = x9, iy = y9, dx = 20 })
check.near(vertex(9), x9 + 20 / across, "vertex 9", 1e-9)
check.near(vertex(10), x10 + 20 / across, "vertex 10 went along", 1e-9)
local names = orbane.UndoNames()
check.eq(names[#names], "Move Mesh Points", "one named step")
orbane.Undo()
check.near(vertex(9), x9, "undone", 1e-12)

-- A sequence of eight frames: five soft blobs drifting between pixels.
local W, H = 160, 120
local function truth(f) return 60 + 1.7 * (f - 1), 50 + 0.9 * (f - 1) end
local dir = os.tmpname()
os.remove(dir)
assert(os.execute("mkdir -p '" .. dir .. "'"))
local blobs = { { 0, 0, 1 }, { -6, -4, 0.6 }, { 5, -5, 0.8 }, { -4, 6, 0.5 }, { 7, 4, 0.7 } }
for f = 1, 8 do
  local cx, cy = truth(f)
  local rows = {}
  for y = 0, H - 1 do
    local row = {}
    for x = 0, W - 1 do
      local v = 0.15
      for _, b in ipairs(blobs) do
        local dx, dy = x - cx - b[1], y - cy - b[2]
        v = v + 0.8 * b[3] * math.exp(-(dx * dx + dy * dy) / 12.5)
      end
      row[#row + 1] = math.min(255, math.floor(255 * v + 0.5))
    end
    rows[#rows + 1] = table.concat(row, " ")
  end
  local file = assert(io.open(string.format("%s/shot.%04d.pgm", dir, f), "w"))
  file:write(string.format("P2\n%d %d\n255\n", W, H), table.concat(rows, "\n"), "\n")
  file:close()
end

orbane.ViewImage(dir .. "/shot.####.pgm")
orbane.WaitImage()
orbane.SetTime(1)
local function image(px, py) return { (px + 0.5) / W, 1 - (py + 0.5) / H } end
orbane.SetValue("Warp1", "Track", image(truth(1)))
orbane.SetValue("Warp1", "PatternSize", { 21 / W, 21 / H })
orbane.SetValue("Warp1", "SearchSize", { 41 / W, 41 / H })
local tracked, said = orbane.Track("Warp1", "Track", "forward")
check.eq(tracked, 7, "frames tracked: " .. said)
check.eq(#orbane.Keys("Warp1", "Track"), 8, "a key per frame")
for f = 1, 8 do
  local p = orbane.GetValue("Warp1", "Track", f)
  local tx, ty = truth(f)
  local ex, ey = p[1] * W - 0.5 - tx, (1 - p[2]) * H - 0.5 - ty
  assert(math.sqrt(ex * ex + ey * ey) < 0.5, string.format("frame %d off by %.3f, %.3f", f, ex, ey))
end
names = orbane.UndoNames()
check.eq(names[#names], "Track Forward", "the run is one step")
check.eq(orbane.OverlayState("Warp1", "Track").tracked, 7, "the state says so")

-- Backward over part of the sequence, from frame 6 down to frame 4.
orbane.SetTime(6)
check.eq(orbane.Track("Warp1", "Track", "backward", { from = 4 }), 2, "two frames back")

-- Nothing to track without a sequence: a message, no step.
orbane.ViewImage("")
local steps = #orbane.UndoNames()
local none, why = orbane.Track("Warp1", "Track", "forward")
check.eq(none, 0, "nothing tracked")
assert(why:find("no image sequence"), why)
check.eq(#orbane.UndoNames(), steps, "no step")
check.fails(function() orbane.Track("Warp1", "Track", "sideways") end, "forward", "a bad direction")

for f = 1, 8 do
  os.remove(string.format("%s/shot.%04d.pgm", dir, f))
end
os.remove(dir)

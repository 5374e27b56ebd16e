-- The file, font, clip and range controls of examples/tools/Files.lua, in
-- the demo comp, worked through the headless application: typed ends and
-- a dragged span, paths typed, a sequence found in a folder made here.
local check = require("check")

local here = debug.getinfo(1, "S").source:match("^@(.*/)") or "./"
orbane.LoadComp(here .. "../../examples/demo.lua")

local tool = "Files1"
local function target(input, child) return { tool = tool, input = input, child = child } end
local function value(input) return orbane.GetValue(tool, input) end
local function lastStep() local names = orbane.UndoNames() return names[#names] end
local function typeInto(t, text)
  orbane.Key(t, "A", "ctrl")
  orbane.Type(t, text)
  orbane.Key(t, "Return")
end

-- Ranges: a low end typed above the high one stops the least span below it.
typeInto(target("LumaLow", "low"), "0.9")
check.eq(value("LumaLow"), 0.65, "Luma low stops a tenth under the high end")
check.eq(value("LumaHigh"), 0.75, "the high end stays")
check.eq(lastStep(), "Change Luma Low", "the step is named for the end")

-- The bar between the knobs moves both ends by the same amount.
local span = target("LumaLow", "span")
local width = orbane.State(span).width
local function x(v) return math.floor(6 + v * (width - 12) + 0.5) end
local steps = #orbane.UndoNames()
orbane.Drag(span, { x = x(0.7), y = 7 }, { x = x(0.8), y = 7 }, {})
check.near(value("LumaLow"), 0.75, "the span's low end", 0.011)
check.near(value("LumaHigh") - value("LumaLow"), 0.1, "the span keeps its width", 1e-9)
check.eq(#orbane.UndoNames(), steps + 1, "one drag, one step")
check.eq(lastStep(), "Change Luma", "a span move is named for the range")

-- Whole frames: an end pushed past the allowed range takes the other along.
typeInto(target("FirstFrame", "high"), "300")
check.eq(value("LastFrame"), 240, "the high end stops at the allowed end")
typeInto(target("FirstFrame", "low"), "250")
check.eq(value("FirstFrame"), 239, "the low end stops a frame under")
check.eq(value("LastFrame"), 240, "the high end held at the allowed end")

-- A path typed into the file control is written as typed.
typeInto(target("Source", "edit"), "images/none.png")
check.eq(value("Source"), "images/none.png", "the typed path")
check.eq(lastStep(), "Change Source", "one step named for the Input")

-- A family that is not installed is shown as such, with its style.
orbane.SetValue(tool, "Font", "Orbane Missing Face")
check.eq(orbane.State(target("Font", "family")).text, "Orbane Missing Face (not installed)", "marked family")
check.eq(orbane.State(target("Font", "style")).text, "Bold", "the style kept")

-- A sequence made here: choosing one of its files finds all and trims to them.
local folder = os.tmpname()
os.remove(folder)
assert(os.execute("mkdir " .. folder))
for frame = 10, 14 do
  assert(io.open(string.format("%s/shot.%04d.exr", folder, frame), "w")):close()
end
typeInto(target("Plate", "edit"), folder .. "/shot.0012.exr")
check.eq(value("Plate"), folder .. "/shot.####.exr", "the sequence's pattern")
check.eq(value("PlateIn"), 10, "trim in at the first frame")
check.eq(value("PlateOut"), 14, "trim out at the last frame")
check.eq(orbane.State(target("Plate", "frames")).text, "10-14 (5 frames)", "what was found")
orbane.Key(target("Plate", "in"), "Up")
check.eq(value("PlateIn"), 11, "the in box trims")
orbane.Undo()
check.eq(value("PlateIn"), 10, "undo takes the trim back")
orbane.Undo()
check.eq(value("Plate"), "images/dusk.png", "undo takes the whole choice back")
check.eq(value("PlateOut"), 0, "with its trims")
os.execute("rm -r " .. folder)

-- Bad tags are errors naming the tag; good ones read back by name.
check.fails(function() orbane.Create("RangeControl", { RNGC_TickCount = "many" }) end, "RNGC_TickCount",
  "a text for a number tag")
check.fails(function() orbane.Create("FileControl", { FC_Savefile = true }) end, "FC_Savefile", "a misspelt tag")
local range = orbane.Create("RangeControl", { RNGCD_MinSpan = 0.1, RNGCS_LowName = "In" })
check.eq(range:GetAttrs().RNGCD_MinSpan, 0.1, "the least span read back")
check.eq(range:GetAttrs().RNGCS_LowName, "In", "the low end's name read back")
check.eq(orbane.Create("FontFileControl", { FFCS_PreviewText = "Aa" }):GetAttrs().FFCS_PreviewText, "Aa",
  "the font's preview text read back")

-- A grid warp and a point tracker over the demo image. The mesh's vertices
-- are picked by click, Shift-click or a box between them, and dragged
-- together (Ctrl finer); its outline slides along the image's edges, and
-- the toolbar resets it to an even grid. The tracker's pattern box sits on
-- the sun: drag inside it to move it, its corners (or the dashed search
-- box's) to resize; over a sequence, "Track Forward" follows it frame by frame.
local cols, rows = 7, 5
local points = {}
for r = 0, rows - 1 do
  for c = 0, cols - 1 do
    local x, y = 0.1 + 0.8 * c / (cols - 1), 0.1 + 0.8 * r / (rows - 1)
    -- A gentle bulge about the middle, so the warp shows.
    local dx, dy = x - 0.5, y - 0.5
    local pull = 0.25 * math.exp(-(dx * dx + dy * dy) * 8)
    if c > 0 and c < cols - 1 and r > 0 and r < rows - 1 then
      x, y = x + dx * pull, y + dy * pull
    end
    points[#points + 1] = x
    points[#points + 1] = y
  end
end
return {
  type = "Warp",
  inputs = {
    { id = "Mesh", name = "Mesh", type = "ScriptVal", control = "ScriptValListControl",
      overlay = "MeshControl", default = { cols = cols, rows = rows, points = points },
      tags = { MSC_SlideBorder = true, MSC_ShowDiagonals = true, MSC_Columns = cols, MSC_Rows = rows,
               MSCS_Label = "Warp", MSC_LineStyle = "Dash", MSCP_Rest = "RestMesh" } },
    { id = "RestMesh", name = "Rest Mesh", type = "ScriptVal", control = "ScriptValListControl",
      default = { cols = 2, rows = 2, points = { 0.1, 0.1, 0.9, 0.1, 0.1, 0.9, 0.9, 0.9 } } },
    { id = "Track", name = "Track", type = "Point", default = { 0.655, 0.43 },
      control = "OffsetControl", overlay = "TrackerControl",
      overlayInputs = { "PatternSize", "SearchSize" },
      tags = { TRC_PatternUpdate = "Fixed", TRCD_MinScore = 0.6 } },
    { id = "PatternSize", name = "Pattern Size", type = "Point", default = { 0.06, 0.09 },
      control = "OffsetControl" },
    { id = "SearchSize", name = "Search Size", type = "Point", default = { 0.16, 0.24 },
      control = "OffsetControl" },
  },
}

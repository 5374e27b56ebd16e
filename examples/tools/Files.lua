-- Files, fonts, clips and ranges.
--
-- Source and Output hold paths, kept relative to the comp's folder: type a
-- path and press Return, click "..." to browse, or drop a file on the row.
-- A path that is not on disk shows in red (for Output, which is written
-- later, only a missing folder does).
-- Font holds a family and Style its style, both chosen from the fonts on
-- this machine; a family that is not installed stays shown, marked.
-- Plate holds an image or an image sequence ("name.####.exr"): choosing one
-- finds its frames on disk and sets PlateIn and PlateOut, the trim, to all
-- of them; the two boxes then trim it.
-- Luma and Frames are ranges of two Inputs each: drag a knob, drag the bar
-- between them to move both, double-click to reset, or type either end.
return {
  type = "Files",
  inputs = {
    { id = "Source", name = "Source", type = "Text", default = "images/dusk.png",
      control = "FileControl",
      tags = { FCS_Filter = "Images (*.png *.exr *.jpg);;All files (*)", FC_RelativeToComp = true } },
    { id = "Output", name = "Output", type = "Text", default = "renders/dusk_graded.png",
      control = "FileControl", tags = { FC_SaveFile = true, FC_RelativeToComp = true } },
    { id = "Font", name = "Font", type = "Text", default = "DejaVu Sans",
      control = "FontFileControl", tags = { FFCP_StyleInput = "Style", FFCS_PreviewText = "Dusk over the bay" } },
    { id = "Style", name = "Style", type = "Text", default = "Bold" },
    { id = "Plate", name = "Plate", type = "Text", default = "images/dusk.png",
      control = "ClipControl",
      tags = { CLCP_InInput = "PlateIn", CLCP_OutInput = "PlateOut", CLCS_Filter = "Images (*.png *.exr)" } },
    { id = "PlateIn", name = "Plate In", type = "Number", default = 0 },
    { id = "PlateOut", name = "Plate Out", type = "Number", default = 0 },
    -- Keys the middle of the tones: at least a tenth apart, ticks at quarters.
    { id = "LumaLow", name = "Luma", type = "Number", default = 0.25,
      control = "RangeControl",
      tags = { RNGCP_HighInput = "LumaHigh", RNGCD_MinAllowed = 0, RNGCD_MaxAllowed = 1,
               RNGCD_MinSpan = 0.1, RNGCD_DefaultLow = 0.25, RNGCD_DefaultHigh = 0.75,
               RNGC_DecimalPlaces = 2, RNGC_TickCount = 5,
               RNGCS_LowName = "Luma Low", RNGCS_HighName = "Luma High" } },
    { id = "LumaHigh", name = "Luma High", type = "Number", default = 0.75 },
    -- Whole frames; an end dragged into the other pushes it along.
    { id = "FirstFrame", name = "Frames", type = "Number", default = 1,
      control = "RangeControl",
      tags = { RNGCP_HighInput = "LastFrame", RNGCD_MinAllowed = 1, RNGCD_MaxAllowed = 240,
               RNGC_IntegerDisplay = true, RNGC_PushOther = true, RNGCD_MinSpan = 1,
               RNGCD_DefaultLow = 1, RNGCD_DefaultHigh = 240 } },
    { id = "LastFrame", name = "Last Frame", type = "Number", default = 120 },
  },
}

-- Number sliders, one of each kind. Drag the knob (Ctrl: ten times finer),
-- click the track to page, Alt-click to go back to the default (the small
-- marker under the track), or type a value or "=expression" in the box.
-- Values are rounded to the Input's decimal places before they are written.
local MinAllowed, MaxAllowed = 0x20030000, 0x20030001
local MinScale, MaxScale, Default = 0x20030002, 0x20030003, 0x20030004
local Centre = 0x20040006
local Integer, KnobStyle = 0x1003000c, 0x10030011
local StepCount, Places, TimeDisplay, SnapToStep = 0x10040003, 0x10040004, 0x10040006, 0x10040007
local Forward, Inverse = 0x30040003, 0x30040004
local Ramp, ColorSpace = 0x40050000, 0x10050003

return {
  type = "Sliders",
  inputs = {
    -- Plain: 0 to 1 in three places.
    { id = "Blend", name = "Blend", type = "Number", default = 1,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 1, [Default] = 1, [Places] = 3 } },
    -- Whole numbers: values snap to steps of 1 (the key and page steps too).
    { id = "Samples", name = "Samples", type = "Number", default = 4,
      control = "SliderControl", tags = { IC_TickFreq = 4 },
      attrs = { [MinAllowed] = 1, [MaxAllowed] = 16, [Default] = 4, [Places] = 0,
                [Integer] = 1, [SnapToStep] = 1, [StepCount] = 15 } },
    -- A cube-root track: the small sizes get most of the room.
    { id = "Size", name = "Size", type = "Number", default = 10,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 1000, [Default] = 10, [Places] = 2,
                [Forward] = "value^(1/3)", [Inverse] = "value^3" } },
    -- Two linear halves about 1: 0..1 on the left half, 1..4 on the right.
    { id = "Contrast", name = "Contrast", type = "Number", default = 1,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 4, [Default] = 1, [Centre] = 1, [Places] = 3 } },
    -- A colour ramp in the track.
    { id = "Hue", name = "Hue", type = "Number", default = 0,
      control = "SliderControl", tags = { IC_TickFreq = 7 },
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 360, [Default] = 0, [Places] = 1, [ColorSpace] = 0,
                [Ramp] = { { 0, 1, 0, 0 }, { 1/6, 1, 1, 0 }, { 2/6, 0, 1, 0 }, { 3/6, 0, 1, 1 },
                           { 4/6, 0, 0, 1 }, { 5/6, 1, 0, 1 }, { 1, 1, 0, 0 } } } },
    -- A channel knob over its own ramp.
    { id = "Red", name = "Red Gain", type = "Number", default = 1,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 2, [Default] = 1, [Places] = 3, [KnobStyle] = 6,
                [Ramp] = { { 0, 0, 0, 0 }, { 1, 1, 0.15, 0.1 } } } },
    -- Captions under the ends and the middle; the allowed range is wider
    -- than the track shows (type 5 and it is taken).
    { id = "Balance", name = "Balance", type = "Number", default = 0,
      control = "SliderControl",
      tags = { SLCS_LowName = "Shadows", SLCS_MidName = "Midtones", SLCS_HighName = "Highlights" },
      attrs = { [MinAllowed] = -10, [MaxAllowed] = 10, [MinScale] = -1, [MaxScale] = 1,
                [Default] = 0, [Places] = 2 } },
    -- Frames shown as a time code at 24 frames a second, written unrounded.
    { id = "Delay", name = "Delay", type = "Number", default = 36,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0, [MaxAllowed] = 480, [Default] = 0, [TimeDisplay] = 1, [Places] = 0 } },
    -- A logarithmic track from expressions: 0.01, 0.1, 1, 10 and 100 evenly apart.
    { id = "Scale", name = "Scale", type = "Number", default = 1,
      control = "SliderControl",
      attrs = { [MinAllowed] = 0.01, [MaxAllowed] = 100, [Default] = 1, [Places] = 3,
                [Forward] = "log10(value)", [Inverse] = "10^value" } },
  },
}

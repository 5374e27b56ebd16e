-- Check boxes and buttons: two-state, tri-state (the mixed state is -1), a
-- second box on the same Input that follows the first, a wrapping label, and
-- buttons that run scripts.
return {
  type = "Switches",
  inputs = {
    { id = "Invert", name = "Invert", type = "Number", default = 0,
      control = "CheckboxControl" },
    { id = "Premultiply", name = "Premultiply", type = "Number", default = 1,
      control = "CheckboxControl", label2 = "Alpha" },
    { id = "Channels", name = "Apply to all channels", type = "Number", default = -1,
      control = { "CheckboxControl", "CheckboxControl" },
      tags = { CBC_TriState = true } },
    { id = "Clip", name = "Clip black and white values to the displayable range before the merge",
      type = "Number", default = 0, control = "CheckboxControl", attrs = { [0x10050001] = 1 } },
    { id = "Reset", name = "Reset Transform", type = "Number", default = 0,
      control = "ButtonControl",
      tags = { BTNC_Align = "Center",
               BTNCS_Execute = "orbane.SetValue(tool, 'Invert', 0)" } },
  },
}

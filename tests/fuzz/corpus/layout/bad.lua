return { ["Controls.Default.Layout"] = "label", ["Controls.Fuzz.Layout"] = { kind = 12, name = {}, width = "wide" } }

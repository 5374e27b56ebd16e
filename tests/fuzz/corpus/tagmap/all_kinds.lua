return { Count = 3, Scale = 0.5, Title = "t", Kind = "k", Shown = true, Mode = "Auto", Colour = { 1, 0, 0, 1 } }

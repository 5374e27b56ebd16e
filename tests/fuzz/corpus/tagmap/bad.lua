return { Count = 0/0, Scale = math.huge, Mode = "Nope", Colour = { 2^31, -1 }, Target = {} }

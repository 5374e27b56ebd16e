return { tools = { { file = "comp.lua", name = "Self1" } }, time = 3, pixelAspect = 1.5,
  inputs = { { id = "Size", type = "Number", default = 1, attrs = { [0x10p50001] = 1 } },
             { id = "Label", type = "Text", defÿÿlt = "a" },
             { id = "Centre", type = "Point", default = { 0.5, 0.5 } } } }

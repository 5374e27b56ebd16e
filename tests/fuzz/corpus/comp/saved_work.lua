-- Orbane comp
-- A saved comp that is its own tool file (the fuzzer has no other file):
-- the top-level inputs declare the tool, each tool entry holds their state.
return {
    version = 2,
    time = 7,
    image = "plates/shot.####.exr",
    pixelAspect = 1,
    inputs = {
        { id = "Size", type = "Number", default = 1 },
        { id = "Center", type = "Point", default = { 0.5, 0.5 } },
        { id = "Label", type = "Text", default = "x" },
        { id = "Table", type = "ScriptVal" },
        { id = "Shape", type = "PolyLine" },
    },
    tools = {
        {
            file = "comp.lua",
            name = "Demo1",
            locked = true,
            inputs = {
                Size = { interpolation = "smooth", keys = { { -4, 1e-300 }, { 0.1, -0.1 }, { 2.5, 123456789.12345679 } } },
                Center = { keys = { { 0, { 0.1, 0.2, 0 } }, { 10, { 0.9, 0.8, 3 } } } },
                Label = { value = "q\"uote back\\ nl\n cr\013 tab\009 end" },
                Table = { value = { 1, 2, name = "x", nested = { a = true, [10] = "ten", ["with space"] = 1.5 } } },
                Shape = {
                    value = {
                        kind = "bezier",
                        closed = true,
                        points = {
                            { x = 0.1, y = 0.2, inX = 0.05, inY = 0.2, outX = 0.15, outY = 0.25 },
                            { x = 0.9, y = 0.8, inX = 0.9, inY = 0.8, outX = 0.9, outY = 0.8 },
                        },
                    },
                },
            },
        },
    },
}

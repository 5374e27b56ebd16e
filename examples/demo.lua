-- The bundled demo comp: one tool per family of controls, over the demo image.
return {
  time = 0,
  image = "images/dusk.png",
  tools = {
    { file = "tools/Switches.lua", name = "Switches1" },
    { file = "tools/Points.lua", name = "Points1" },
    { file = "tools/Dials.lua", name = "Dials1" },
    { file = "tools/Sliders.lua", name = "Sliders1" },
    { file = "tools/Choices.lua", name = "Choices1" },
    { file = "tools/Transform.lua", name = "Transform1" },
    { file = "tools/Files.lua", name = "Files1" },
    { file = "tools/Groups.lua", name = "Groups1" },
    { file = "tools/Roto.lua", name = "Roto1" },
    { file = "tools/Layers.lua", name = "Layers1" },
    { file = "tools/Framing.lua", name = "Framing1" },
    { file = "tools/Colour.lua", name = "Colour1" },
    { file = "tools/Grading.lua", name = "Grading1" },
    { file = "tools/Scene.lua", name = "Scene1" },
    { file = "tools/Warp.lua", name = "Warp1" },
  },
}

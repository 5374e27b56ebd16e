-- The bundled demo comp: one tool per family of controls, over the demo image.
return {
  time = 0,
  image = "images/dusk.png",
  tools = {
    { file = "tools/Switches.lua", name = "Switches1" },
    { file = "tools/Points.lua", name = "Points1" },
  },
}

-- Three-dimensional handles seen through the viewer's camera (the default
-- view looks straight at the image: the plane Z = 0 lies on it, one unit is
-- the image's width, the origin its centre). The box's centre moves it in
-- the view's plane; a knob on each face moves that face (Shift: every size
-- alike, Ctrl: the opposite face too). The camera's position knob moves it
-- and the knob ahead of it aims it (writing its tilt and pan); the spot
-- light's knobs move it and the point it shines at. `orbane.ViewerCamera`
-- looks at the scene from elsewhere.
local MinScale, MaxScale = 0x20030002, 0x20030003
local function number(id, name, default, lo, hi)
  return { id = id, name = name, type = "Number", default = default, control = "SliderControl",
           attrs = { [MinScale] = lo, [MaxScale] = hi } }
end
return {
  type = "Scene",
  inputs = {
    { id = "Center", name = "Box Center", type = "Point", default = { -0.18, -0.06, -0.3 },
      control = "OffsetControl", overlay = "CubeControl",
      overlayInputs = { "Width", "Height", "Depth", "TiltX", "TurnY", "RollZ" },
      tags = { OBC_FillFaces = true, OBC_ShowAxes = true, OBCS_Label = "Box" } },
    number("Width", "Width", 0.3, 0, 1),
    number("Height", "Height", 0.25, 0, 1),
    number("Depth", "Depth", 0.3, 0, 1),
    number("TiltX", "Tilt", 20, -180, 180),
    number("TurnY", "Turn", 35, -180, 180),
    number("RollZ", "Roll", 0, -180, 180),
    { id = "CamPosition", name = "Camera", type = "Point", default = { 0.28, 0.02, -0.15 },
      control = "OffsetControl", overlay = "CameraControl",
      overlayInputs = { "CamTilt", "CamPan", "CamRoll", "CamFocal" },
      tags = { CCD_Far = 0.45, CCS_Label = "Camera1" } },
    number("CamTilt", "Camera Tilt", -5, -90, 90),
    number("CamPan", "Camera Pan", 40, -180, 180),
    number("CamRoll", "Camera Roll", 0, -180, 180),
    number("CamFocal", "Focal Length", 35, 8, 200),
    { id = "LightPosition", name = "Light", type = "Point", default = { 0.05, 0.2, -0.1 },
      control = "OffsetControl", overlay = "LightControl", overlayInputs = { "LightAim", "Cone" },
      tags = { LC_LightType = "Spot" } },
    { id = "LightAim", name = "Light Aim", type = "Point", default = { -0.15, -0.1, -0.3 },
      control = "OffsetControl" },
    number("Cone", "Cone Angle", 35, 1, 170),
  },
}

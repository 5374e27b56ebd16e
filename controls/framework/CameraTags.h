#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of CameraControl, in the second range of class attributes
// (group 0x06), so they never meet the transform's own tags that the
// camera inherits. Its main Input is the camera's position, a Point X, Y, Z
// in world units; the _Input tags say which of its Inputs hold the turns,
// the lens and the target (-1, or an index with no Input: the value below,
// not draggable).
constexpr Tag CC_RotXInput = 0x10068000;     // default 1 (degrees; tilt)
constexpr Tag CC_RotYInput = 0x10068001;     // default 2 (pan)
constexpr Tag CC_RotZInput = 0x10068002;     // default 3 (roll)
constexpr Tag CC_FocalInput = 0x10068003;    // default 4 (mm)
constexpr Tag CC_ApertureInput = 0x10068004; // default -1 (mm, the film back's width)
constexpr Tag CC_TargetInput = 0x10068005;   // default -1: a Point the camera looks at; its turns then follow
constexpr Tag CC_ShowFrustum = 0x10068006;   // the view's pyramid out to the far distance (default on)
constexpr Tag CC_ShowBody = 0x10068007;      // the camera's body and the up triangle (default on)
constexpr Tag CC_ShowTarget = 0x10068008;    // the aim handle and the line to it (default on)
constexpr Tag CC_ShowNearFar = 0x10068009;   // the near and far planes as frames
constexpr Tag CC_PenStyle = 0x1006800a;      // the frustum's pen: 0 solid, 1..4 dashed as the rectangle's
constexpr Tag CC_Color = 0x1006800b;         // the body's colour (default: the overlay's)
constexpr Tag CC_FrustumColor = 0x1006800c;  // the frustum's colour
constexpr Tag CC_KeysAim = 0x1006800d;       // arrows turn the camera (a degree; Shift ten) instead of moving it
constexpr Tag CCD_Focal = 0x20068000;        // where no Input gives it (50)
constexpr Tag CCD_Aperture = 0x20068001;     // (36)
constexpr Tag CCD_Near = 0x20068002;         // the near plane drawn at this distance (0.1)
constexpr Tag CCD_Far = 0x20068003;          // the frustum drawn out to this distance (1)
constexpr Tag CCD_FilmAspect = 0x20068004;   // the film's height over its width; 0: the image's own
constexpr Tag CCD_AimDistance = 0x20068005;  // the aim handle this far ahead where no target Input (1)
constexpr Tag CCD_BodySize = 0x20068006;     // the body's length in world units (0.1)
constexpr Tag CCD_LineWidth = 0x20068007;    // the lines' width (viewer pixels, 1)
constexpr Tag CCD_KnobSize = 0x20068008;     // half side of the aim knob (handle pixels, 4)
constexpr Tag CCS_Label = 0x30068000;        // a text beside the camera
constexpr Tag CCID_Visible = 0x80068000;     // a Number Input; 0 hides the camera
constexpr Tag CCP_Visible = 0x60068000;

extern const TagMapEntry CameraControlTags[];

// LightControl's one tag. Its Inputs go by order: 0 the light's position (a
// Point X, Y, Z), 1 the point it shines at (a Point; none: straight down
// -Z), 2 a spot's cone angle (a Number, degrees; none: 30).
constexpr Tag LC_LightType = 0x10068000; // 0 directional (parallel rays), 1 point (all round), 2 spot (a cone)

extern const TagMapEntry LightControlTags[];

} // namespace Orbane

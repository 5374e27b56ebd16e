#pragma once

#include "framework/PendingPreviewControl.h"

#include "inputcontrols/ButtonControl.h"
#include "inputcontrols/CheckBoxControl.h"
#include "inputcontrols/CheckListControl.h"
#include "inputcontrols/ClipControl.h"
#include "inputcontrols/ColorControl.h"
#include "inputcontrols/ColorGamutControl.h"
#include "inputcontrols/ColorRangesControl.h"
#include "inputcontrols/ColorSuppressionControl.h"
#include "inputcontrols/ColorWheelControl.h"
#include "inputcontrols/ComboControl.h"
#include "inputcontrols/CustomFilterControl.h"
#include "inputcontrols/FileControl.h"
#include "inputcontrols/FontfileControl.h"
#include "inputcontrols/GammaControl.h"
#include "inputcontrols/GradientControl.h"
#include "inputcontrols/HistogramControl.h"
#include "inputcontrols/ImageControl.h"
#include "inputcontrols/LabelControl.h"
#include "inputcontrols/LevelsControl.h"
#include "inputcontrols/LevelsOutputControl.h"
#include "inputcontrols/ListControl.h"
#include "inputcontrols/LogControl.h"
#include "inputcontrols/MultiButtonControl.h"
#include "inputcontrols/OffsetControl.h"
#include "inputcontrols/PatternControl.h"
#include "inputcontrols/RangeControl.h"
#include "inputcontrols/ScrewControl.h"
#include "inputcontrols/ScriptValListControl.h"
#include "inputcontrols/SliderControl.h"
#include "inputcontrols/SplineControl.h"
#include "overlays/AngleControl.h"
#include "overlays/CropControl.h"
#include "overlays/CrosshairControl.h"
#include "overlays/EllipseControl.h"
#include "overlays/ImgOverlayControl.h"
#include "overlays/MeshControl.h"
#include "overlays/PointControl.h"
#include "overlays/PositionerControl.h"
#include "overlays/RectangleControl.h"
#include "overlays/SliderOverlay.h"
#include "overlays/TrackerControl.h"
#include "overlays/TransformControl.h"
#include "overlays/XYOffsetControl.h"
#include "polyline/PolyLineControl.h"

#include "orbane/OverlayControl.h"

// Every control class of the library, by its native type name. A class that
// is not written yet is a pending stand-in of its family with a type of its
// own. To bring in the real class: give it a header/source pair named after
// it, replace its line here by an #include of that header, and give it
// `static bool RegCleanup(Registry *)` where the pending one declares a
// class-specific clean-up (Angle, Ellipse, Fontfile, Spline). The registration
// in Registration.cpp stays as it is.
#define ORBANE_PENDING_PREVIEW(Class) ORBANE_PENDING_DERIVED(Class, PreviewControl)
#define ORBANE_PENDING_DERIVED(Class, Base)                                                                            \
    struct Class##Marker;                                                                                              \
    using Class = PendingPreviewControl<Class##Marker, Base>

namespace Orbane {

ORBANE_PENDING_DERIVED(CameraControl, TransformControl);
ORBANE_PENDING_DERIVED(LightControl, TransformControl);
ORBANE_PENDING_PREVIEW(ObloidControl);

} // namespace Orbane

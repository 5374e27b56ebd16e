// Registers every control class of the library with the host when the library
// is loaded: one line per class ID, in this order. ControlDesc gives the
// family defaults; each line says only where a class departs from them.
// Classes whose script tag names are not published yet register without a tag
// map, but keep their tag-mapping hook (which then maps by an empty table), so
// adding the table later is a one-word change here.

#include "framework/AngleTags.h"
#include "framework/ButtonTags.h"
#include "framework/CameraTags.h"
#include "framework/CheckBoxTags.h"
#include "framework/CheckListTags.h"
#include "framework/ClipTags.h"
#include "framework/ColorSuppressionTags.h"
#include "framework/ColorTags.h"
#include "framework/ColorWheelTags.h"
#include "framework/ComboTags.h"
#include "framework/ControlClasses.h"
#include "framework/ControlRegistration.h"
#include "framework/CrosshairTags.h"
#include "framework/EllipseTags.h"
#include "framework/FFICasts.h"
#include "framework/FileTags.h"
#include "framework/FontfileTags.h"
#include "framework/GradientTags.h"
#include "framework/ImgOverlayTags.h"
#include "framework/LabelTags.h"
#include "framework/ListTags.h"
#include "framework/MeshTags.h"
#include "framework/MultiButtonTags.h"
#include "framework/ObloidTags.h"
#include "framework/OffsetTags.h"
#include "framework/PatternTags.h"
#include "framework/PointTags.h"
#include "framework/PositionerTags.h"
#include "framework/RangeTags.h"
#include "framework/RectangleTags.h"
#include "framework/ScrewTags.h"
#include "framework/SliderTags.h"
#include "framework/SplineTags.h"
#include "framework/LevelsTags.h"
#include "framework/ColorRangesTags.h"
#include "framework/TrackerTags.h"
#include "framework/TransformTags.h"
#include "framework/VariantRegistration.h"
#include "framework/XYOffsetTags.h"
#include "polyline/PolyLineTags.h"

#include "orbane/ClassIDs.h"
#include "orbane/OverlayControl.h"

namespace Orbane {

namespace {

// The base of the camera and light controls, pointed at by their registries
// for as long as they live. Made on first use, so it exists whatever the order
// in which the library's statics are made.
const OrbID &TransformControlID()
{
    static const OrbID id("TransformControl");
    return id;
}

using D = ControlDesc;

// The family tag is a pointer tag: the text travels by address.
const void *const kOverlayFamily = "OverlayControl";

// Primaries of the ID variants, described once for both registrations.
ControlDesc ComboDesc()
{
    return D::Input("ComboControl", CLSID_InputControl_Combo).Tags<ComboControlTags>();
}

ControlDesc LabelDesc()
{
    return D::Input("LabelControl", CLSID_InputControl_Label).Tags<LabelControlTags>();
}

// ListControl shares its tag names with ScriptValListControl.
ControlDesc ListDesc()
{
    return D::Input("ListControl", CLSID_InputControl_List).Tags<ListControlTags>();
}

ControlDesc MultiButtonDesc()
{
    return D::Input("MultiButtonControl", CLSID_InputControl_MultiButton).Tags<MultiButtonControlTags>();
}

ControlRegistration<AngleControl> gAngle{
    D::Preview("AngleControl").Tags<AngleControlTags>().Cleanup(&AngleControl::RegCleanup)};
ControlRegistration<ButtonControl> gButton{D::Input("ButtonControl").Tags<ButtonControlTags>()};
ControlRegistration<CameraControl, TransformControl> gCamera{D::Preview("CameraControl")
                                                                 .Base(TransformControlID(), "TransformControl")
                                                                 .Tags<CameraControlTags>()
                                                                 .Flag(REG_PreviewFlag64)
                                                                 .Flag(REG_PreviewFlag65)};
ControlRegistration<CheckBoxControl> gCheckBox{
    D::Input("CheckBoxControl", CLSID_InputControl_Checkbox).Script("CheckboxControl").Tags<CheckBoxControlTags>()};
ControlRegistration<CheckListControl> gCheckList{D::Input("CheckListControl").Tags<CheckListControlTags>()};
ControlRegistration<ClipControl> gClip{D::Input("ClipControl").Tags<ClipControlTags>()};
ControlRegistration<ColorControl> gColor{D::Input("ColorControl").Tags<ColorControlTags>()};
ControlRegistration<ColorGamutControl> gColorGamut{D::Input("ColorGamutControl")};
ControlRegistration<ColorRangesControl> gColorRanges{D::Input("ColorRangesControl").Tags<ColorRangesControlTags>()};
ControlRegistration<ColorSuppressionControl> gColorSuppression{
    D::Input("ColorSuppressionControl").Tags<ColorSuppressionControlTags>()};
ControlRegistration<ColorWheelControl> gColorWheel{D::Input("ColorWheelControl").Tags<ColorWheelControlTags>()};
ControlRegistration<ComboControl> gCombo{ComboDesc()};
VariantRegistration<ComboControl> gComboID{ComboDesc().Variant(CLSID_InputControl_ComboID, "ComboIDControl")};
ControlRegistration<CropControl> gCrop{D::Preview("CropControl", CLSID_PreviewControl_Crop).NoScript().NoHook()};
ControlRegistration<CrosshairControl> gCrosshair{D::Preview("CrosshairControl").Tags<CrosshairControlTags>()};
ControlRegistration<CustomFilterControl> gCustomFilter{D::Input("CustomFilterControl")};
ControlRegistration<EllipseControl> gEllipse{
    D::Preview("EllipseControl").Tags<EllipseControlTags>().Cleanup(&EllipseControl::RegCleanup)};
ControlRegistration<FileControl> gFile{D::Input("FileControl").Tags<FileControlTags>()};
ControlRegistration<FontfileControl> gFontfile{D::Input("FontfileControl", "FontFileControl")
                                                   .Script("FontFileControl")
                                                   .Tags<FontfileControlTags>()
                                                   .Cleanup(&FontfileControl::RegCleanup)};
ControlRegistration<GammaControl> gGamma{D::Input("GammaControl")};
ControlRegistration<GradientControl> gGradient{D::Input("GradientControl").Tags<GradientControlTags>()};
ControlRegistration<HistogramControl> gHistogram{D::Input("HistogramControl")};
ControlRegistration<ImageControl> gImage{D::Input("ImageControl")};
ControlRegistration<ImgOverlayControl> gImgOverlay{D::Preview("ImgOverlayControl")
                                                       .Script("ImageOverlayControl")
                                                       .Tags<ImgOverlayControlTags>()
                                                       .Flag(REG_PreviewFlag64)};
ControlRegistration<LabelControl> gLabel{LabelDesc()};
VariantRegistration<LabelControl> gLabelNest{LabelDesc().Variant(CLSID_InputControl_Nest)};
VariantRegistration<LabelControl> gLabelSeparator{LabelDesc().Variant(CLSID_InputControl_Separator)};
VariantRegistration<LabelControl> gLabelSpacer{LabelDesc().Variant(CLSID_InputControl_Spacer)};
ControlRegistration<LevelsControl> gLevels{D::Input("LevelsControl").Tags<LevelsControlTags>()};
ControlRegistration<LevelsOutputControl> gLevelsOutput{
    D::Input("LevelsOutputControl").Tags<LevelsOutputControlTags>()};
ControlRegistration<LightControl, TransformControl> gLight{D::Preview("LightControl")
                                                               .Base(TransformControlID(), "TransformControl")
                                                               .Tags<LightControlTags>()
                                                               .Flag(REG_PreviewFlag65)};
ControlRegistration<ListControl> gList{ListDesc()};
VariantRegistration<ListControl> gListID{ListDesc().Variant(CLSID_InputControl_ListID, "ListIDControl")};
ControlRegistration<LogControl> gLog{D::Input("LogControl")};
ControlRegistration<MeshControl> gMesh{D::Preview("MeshControl").Tags<MeshControlTags>().Flag(REG_PreviewFlag64)};
ControlRegistration<MultiButtonControl> gMultiButton{MultiButtonDesc()};
VariantRegistration<MultiButtonControl> gMultiButtonID{
    MultiButtonDesc().Variant(CLSID_InputControl_MultiButtonID, "MultiButtonIDControl")};
ControlRegistration<ObloidControl> gObloid{D::Preview("ObloidControl", "CubeControl").Tags<ObloidControlTags>()};
ControlRegistration<OffsetControl> gOffset{D::Input("OffsetControl").Tags<OffsetControlTags>()};
ControlRegistration<PatternControl> gPattern{D::Input("PatternControl").Tags<PatternControlTags>()};
ControlRegistration<PointControl> gPoint{D::Preview("PointControl").Tags<PointControlTags>()};
ControlRegistration<PolyLineControl> gPolyLine{
    D::Preview("PolyLineControl", "PolylineControl").Script("PolylineControl").Tags<PolyLineControlTags>()};
ControlRegistration<PositionerControl> gPositioner{D::Preview("PositionerControl").Tags<PositionerControlTags>()};
ControlRegistration<RangeControl> gRange{D::Input("RangeControl").Tags<RangeControlTags>()};
ControlRegistration<RectangleControl> gRectangle{D::Preview("RectangleControl").Tags<RectangleControlTags>()};
ControlRegistration<ScrewControl> gScrew{D::Input("ScrewControl").Tags<ScrewControlTags>()};
ControlRegistration<ScriptValListControl> gScriptValList{D::Input("ScriptValListControl").Tags<ListControlTags>()};
ControlRegistration<SliderControl> gSlider{
    D::Input("SliderControl", CLSID_InputControl_Slider).Tags<SliderControlTags>()};
ControlRegistration<SliderOverlay, OverlayControl> gSliderOverlay{D::Preview("SliderOverlay")
                                                                      .Base(OverlayControl::ClassID)
                                                                      .NoScript()
                                                                      .NoHook()
                                                                      .Flag(REG_PreviewFlag64)
                                                                      .Flag(REG_ClassFamily, kOverlayFamily)};
ControlRegistration<SplineControl> gSpline{D::Input("SplineControl")
                                               .Tags<SplineControlTags>()
                                               .Cleanup(&SplineControl::RegCleanup)
                                               .Flag(REG_SplineFlag)
                                               .Flag(REG_DisplayName, "Spline Control")
                                               .Flag(REG_MenuPath, "Controls\\Spline")};
// The tracker is an overlay whose map carries the inspector's name; kept so.
ControlRegistration<TrackerControl> gTracker{
    D::Preview("TrackerControl").Tags<TrackerControlTags>().MapName("InputControl.Create")};
ControlRegistration<TransformControl> gTransform{
    D::Preview("TransformControl").Tags<TransformControlTags>().Flag(REG_PreviewFlag65)};
ControlRegistration<XYOffsetControl> gXYOffset{D::Preview("XYOffsetControl").Tags<XYOffsetControlTags>()};

} // namespace

} // namespace Orbane

ORBANE_FFI_CASTS(AngleControl)
ORBANE_FFI_CASTS(ButtonControl)
ORBANE_FFI_CASTS(CameraControl)
ORBANE_FFI_CASTS(CheckBoxControl)
ORBANE_FFI_CASTS(CheckListControl)
ORBANE_FFI_CASTS(ClipControl)
ORBANE_FFI_CASTS(ColorControl)
ORBANE_FFI_CASTS(ColorGamutControl)
ORBANE_FFI_CASTS(ColorRangesControl)
ORBANE_FFI_CASTS(ColorSuppressionControl)
ORBANE_FFI_CASTS(ColorWheelControl)
ORBANE_FFI_CASTS(ComboControl)
ORBANE_FFI_CASTS(CrosshairControl)
ORBANE_FFI_CASTS(CustomFilterControl)
ORBANE_FFI_CASTS(EllipseControl)
ORBANE_FFI_CASTS(FileControl)
ORBANE_FFI_CASTS(FontfileControl)
ORBANE_FFI_CASTS(GammaControl)
ORBANE_FFI_CASTS(GradientControl)
ORBANE_FFI_CASTS(HistogramControl)
ORBANE_FFI_CASTS(ImageControl)
ORBANE_FFI_CASTS(ImgOverlayControl)
ORBANE_FFI_CASTS(LabelControl)
ORBANE_FFI_CASTS(LevelsControl)
ORBANE_FFI_CASTS(LevelsOutputControl)
ORBANE_FFI_CASTS(LightControl)
ORBANE_FFI_CASTS(ListControl)
ORBANE_FFI_CASTS(LogControl)
ORBANE_FFI_CASTS(MeshControl)
ORBANE_FFI_CASTS(MultiButtonControl)
ORBANE_FFI_CASTS(ObloidControl)
ORBANE_FFI_CASTS(OffsetControl)
ORBANE_FFI_CASTS(PatternControl)
ORBANE_FFI_CASTS(PointControl)
ORBANE_FFI_CASTS(PolyLineControl)
ORBANE_FFI_CASTS(PositionerControl)
ORBANE_FFI_CASTS(RangeControl)
ORBANE_FFI_CASTS(RectangleControl)
ORBANE_FFI_CASTS(ScrewControl)
ORBANE_FFI_CASTS(ScriptValListControl)
ORBANE_FFI_CASTS(SliderControl)
ORBANE_FFI_CASTS(SplineControl)
ORBANE_FFI_CASTS(TrackerControl)
ORBANE_FFI_CASTS(TransformControl)
ORBANE_FFI_CASTS(XYOffsetControl)

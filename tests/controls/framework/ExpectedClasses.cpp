#include "ExpectedClasses.h"

#include <cstring>

namespace Orbane {
namespace Test {

namespace {

constexpr Family I = Family::Input;
constexpr Family P = Family::Preview;
constexpr const char *IC = "InputControl";
constexpr const char *PC = "PreviewControl";
constexpr const char *TC = "TransformControl";
constexpr Tag F64 = REG_PreviewFlag64;
constexpr Tag F65 = REG_PreviewFlag65;

} // namespace

bool ExpectedClass::IsVariant() const
{
    // A second class ID for a class of the library, without a hook of its own.
    return !hook && std::strcmp(classID, name) != 0;
}

const char *ExpectedClass::MapName() const
{
    if (std::strcmp(name, "TrackerControl") == 0)
        return "InputControl.Create";
    return family == I ? "InputControl.Create" : "PreviewControl.Create";
}

const std::vector<ExpectedClass> &ExpectedClasses()
{
    // clang-format off
    static const std::vector<ExpectedClass> rows = {
        // name                      class ID                   base ID            fam script                  script base tags known extras  hook
        {"AngleControl",             "AngleControl",            PC,                P, "AngleControl",          PC, 16, true,  {},         true},
        {"ButtonControl",            "ButtonControl",           IC,                I, "ButtonControl",         IC,  2, true,  {},         true},
        {"CameraControl",            "CameraControl",           TC,                P, "CameraControl",         TC, 26, false, {F64, F65}, true},
        {"CheckBoxControl",          "CheckboxControl",         IC,                I, "CheckboxControl",       IC,  1, true,  {},         true},
        {"CheckListControl",         "CheckListControl",        IC,                I, "CheckListControl",      IC,  7, false, {},         true},
        {"ClipControl",              "ClipControl",             IC,                I, "ClipControl",           IC,  3, false, {},         true},
        {"ColorControl",             "ColorControl",            IC,                I, "ColorControl",          IC,  6, false, {},         true},
        {"ColorGamutControl",        "ColorGamutControl",       IC,                I, "ColorGamutControl",     IC,  0, true,  {},         true},
        {"ColorRangesControl",       "ColorRangesControl",      IC,                I, "ColorRangesControl",    IC,  4, false, {},         true},
        {"ColorSuppressionControl",  "ColorSuppressionControl", IC,                I, "ColorSuppressionControl", IC, 7, false, {},        true},
        {"ColorWheelControl",        "ColorWheelControl",       IC,                I, "ColorWheelControl",     IC,  3, false, {},         true},
        {"ComboControl",             "ComboControl",            IC,                I, "ComboControl",          IC,  5, true,  {},         true},
        {"ComboControl",             "ComboIDControl",          "ComboControl",    I, "ComboIDControl",        IC,  5, true,  {},         false},
        {"CropControl",              "CropControl",             PC,                P, nullptr,                 nullptr, 0, true, {},      false},
        {"CrosshairControl",         "CrosshairControl",        PC,                P, "CrosshairControl",      PC,  7, true,  {},         true},
        {"CustomFilterControl",      "CustomFilterControl",     IC,                I, "CustomFilterControl",   IC,  0, true,  {},         true},
        {"EllipseControl",           "EllipseControl",          PC,                P, "EllipseControl",        PC, 53, false, {},         true},
        {"FileControl",              "FileControl",             IC,                I, "FileControl",           IC,  4, false, {},         true},
        {"FontfileControl",          "FontFileControl",         IC,                I, "FontFileControl",       IC,  3, false, {},         true},
        {"GammaControl",             "GammaControl",            IC,                I, "GammaControl",          IC,  0, true,  {},         true},
        {"GradientControl",          "GradientControl",         IC,                I, "GradientControl",       IC,  2, false, {},         true},
        {"HistogramControl",         "HistogramControl",        IC,                I, "HistogramControl",      IC,  0, true,  {},         true},
        {"ImageControl",             "ImageControl",            IC,                I, "ImageControl",          IC,  0, true,  {},         true},
        {"ImgOverlayControl",        "ImgOverlayControl",       PC,                P, "ImageOverlayControl",   PC, 32, false, {F64},      true},
        {"LabelControl",             "LabelControl",            IC,                I, "LabelControl",          IC, 10, false, {},         true},
        {"LabelControl",             "NestControl",             "LabelControl",    I, nullptr,                 nullptr, 0, true, {},      false},
        {"LabelControl",             "SeparatorControl",        "LabelControl",    I, nullptr,                 nullptr, 0, true, {},      false},
        {"LabelControl",             "SpacerControl",           "LabelControl",    I, nullptr,                 nullptr, 0, true, {},      false},
        {"LevelsControl",            "LevelsControl",           IC,                I, "LevelsControl",         IC,  3, false, {},         true},
        {"LevelsOutputControl",      "LevelsOutputControl",     IC,                I, "LevelsOutputControl",   IC,  3, false, {},         true},
        {"LightControl",             "LightControl",            TC,                P, "LightControl",          TC,  1, false, {F65},      true},
        {"ListControl",              "ListControl",             IC,                I, "ListControl",           IC,  4, true,  {},         true},
        {"ListControl",              "ListIDControl",           "ListControl",     I, "ListIDControl",         IC,  4, true,  {},         false},
        {"LogControl",               "LogControl",              IC,                I, "LogControl",            IC,  0, true,  {},         true},
        {"MeshControl",              "MeshControl",             PC,                P, "MeshControl",           PC, 43, false, {F64},      true},
        {"MultiButtonControl",       "MultiButtonControl",      IC,                I, "MultiButtonControl",    IC, 33, false, {},         true},
        {"MultiButtonControl",       "MultiButtonIDControl",    "MultiButtonControl", I, "MultiButtonIDControl", IC, 33, false, {},       false},
        {"ObloidControl",            "CubeControl",             PC,                P, "ObloidControl",         PC, 46, false, {},         true},
        {"OffsetControl",            "OffsetControl",           IC,                I, "OffsetControl",         IC,  2, false, {},         true},
        {"PatternControl",           "PatternControl",          IC,                I, "PatternControl",        IC,  2, false, {},         true},
        {"PointControl",             "PointControl",            PC,                P, "PointControl",          PC,  4, true,  {},         true},
        {"PolyLineControl",          "PolylineControl",         PC,                P, "PolylineControl",       PC, 56, true,  {},         true},
        {"PositionerControl",        "PositionerControl",       PC,                P, "PositionerControl",     PC, 16, false, {},         true},
        {"RangeControl",             "RangeControl",            IC,                I, "RangeControl",          IC, 14, false, {},         true},
        {"RectangleControl",         "RectangleControl",        PC,                P, "RectangleControl",      PC, 35, true,  {},         true},
        {"ScrewControl",             "ScrewControl",            IC,                I, "ScrewControl",          IC,  1, false, {},         true},
        {"ScriptValListControl",     "ScriptValListControl",    IC,                I, "ScriptValListControl",  IC,  4, true,  {},         true},
        {"SliderControl",            "SliderControl",           IC,                I, "SliderControl",         IC,  4, true,  {},         true},
        {"SliderOverlay",            "SliderOverlay",           "OverlayControl",  P, nullptr,                 nullptr, 0, true, {F64, REG_ClassFamily}, false},
        {"SplineControl",            "SplineControl",           IC,                I, "SplineControl",         IC, 21, false, {REG_SplineFlag, REG_DisplayName, REG_MenuPath}, true},
        {"TrackerControl",           "TrackerControl",          PC,                P, "TrackerControl",        PC,  9, false, {},         true},
        {"TransformControl",         "TransformControl",        PC,                P, "TransformControl",      PC, 10, false, {F65},      true},
        {"XYOffsetControl",          "XYOffsetControl",         PC,                P, "XYOffsetControl",       PC,  1, false, {},         true},
    };
    // clang-format on
    return rows;
}

void PrintTo(const ExpectedClass &row, std::ostream *out)
{
    *out << row.classID;
}

} // namespace Test
} // namespace Orbane

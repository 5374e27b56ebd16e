#include "orbane/ClassIDs.h"

namespace Orbane {

// Tools name these in their Inputs, so the texts never change.
const OrbID CLSID_InputControl_Checkbox("CheckboxControl");
const OrbID CLSID_InputControl_Combo("ComboControl");
const OrbID CLSID_InputControl_ComboID("ComboIDControl");
const OrbID CLSID_InputControl_Label("LabelControl");
const OrbID CLSID_InputControl_Nest("NestControl");
const OrbID CLSID_InputControl_Separator("SeparatorControl");
const OrbID CLSID_InputControl_Spacer("SpacerControl");
const OrbID CLSID_InputControl_List("ListControl");
const OrbID CLSID_InputControl_ListID("ListIDControl");
const OrbID CLSID_InputControl_MultiButton("MultiButtonControl");
const OrbID CLSID_InputControl_MultiButtonID("MultiButtonIDControl");
const OrbID CLSID_InputControl_Slider("SliderControl");
const OrbID CLSID_PreviewControl_Crop("CropControl");

const OrbID CLSID_DataType_Number("Number");
const OrbID CLSID_DataType_Point("Point");
const OrbID CLSID_DataType_Text("Text");
const OrbID CLSID_DataType_Image("Image");
const OrbID CLSID_DataType_ID("ID");
const OrbID CLSID_DataType_Polyline("PolyLine");
const OrbID CLSID_DataType_BSplinePolyline("BSplinePolyLine");
const OrbID CLSID_DataType_ScriptVal("ScriptVal");

} // namespace Orbane

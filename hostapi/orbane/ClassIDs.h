#pragma once

#include "orbane/OrbID.h"

namespace Orbane {

// Class IDs that the host exports for the controls tools ask for most.
extern const OrbID CLSID_InputControl_Checkbox;
extern const OrbID CLSID_InputControl_Combo;
extern const OrbID CLSID_InputControl_ComboID;
extern const OrbID CLSID_InputControl_Label;
extern const OrbID CLSID_InputControl_Nest;
extern const OrbID CLSID_InputControl_Separator;
extern const OrbID CLSID_InputControl_Spacer;
extern const OrbID CLSID_InputControl_List;
extern const OrbID CLSID_InputControl_ListID;
extern const OrbID CLSID_InputControl_MultiButton;
extern const OrbID CLSID_InputControl_MultiButtonID;
extern const OrbID CLSID_InputControl_Slider;
extern const OrbID CLSID_PreviewControl_Crop;

// Data types of Inputs.
extern const OrbID CLSID_DataType_Number;
extern const OrbID CLSID_DataType_Point;
extern const OrbID CLSID_DataType_Text;
extern const OrbID CLSID_DataType_Image;
extern const OrbID CLSID_DataType_ID;
extern const OrbID CLSID_DataType_Polyline;
extern const OrbID CLSID_DataType_BSplinePolyline;
extern const OrbID CLSID_DataType_ScriptVal;

} // namespace Orbane

-- The registry seen from a script: creating controls by class ID and by
-- script name, named tags, and FFI casts against the exported symbols.
local check = require("check")
local ffi = require("ffi")

local classes = orbane.Classes()
check.eq(#classes, 53, "registrations")

-- By class ID and by script type name; the native name is neither.
local box = orbane.Create("CheckboxControl", { CBC_TriState = true })
check.eq(box:ClassID(), "CheckboxControl", "class ID of the check box")
local button = orbane.Create("ButtonControl", { BTNC_Align = "Center" })
local point = orbane.Create("PointControl", {})
check.fails(function() orbane.Create("CheckBoxControl", {}) end, 'unknown class "CheckBoxControl"', "native name")

-- An ID variant creates its primary's class.
local comboID = orbane.Create("ComboIDControl", {})
check.eq(ffi.C.ffi_ComboControl_cast(comboID) ~= nil, true, "ComboID is a ComboControl")

-- Named tags map to numbered ones.
local tags = orbane.MapTags("CheckboxControl", { CBC_TriState = true })
check.eq(#tags, 1, "one tag")
check.eq(tags[1].tag, 0x10050000, "CBC_TriState id")
check.eq(tags[1].value, 1, "CBC_TriState value")
check.fails(function() orbane.MapTags("CheckboxControl", { CBC_TriState = "yes" }) end, "CBC_TriState", "wrong type")
check.fails(function() orbane.MapTags("ButtonControl", { BTNC_Align = "Middle" }) end, "Middle", "unknown enum value")
check.fails(function() orbane.MapTags("ButtonControl", { Nope = 1 }) end, "Nope", "unknown tag")

-- Casts: the same class gives the object, another class nil, nil gives nil.
check.eq(ffi.C.ffi_CheckBoxControl_cast(box) ~= nil, true, "cast to own class")
check.eq(ffi.C.ffi_CheckBoxControl_cast(button) == nil, true, "cast to another class")
check.eq(ffi.C.ffi_PointControl_cast(box) == nil, true, "input control is no overlay")
check.eq(ffi.C.ffi_PointControl_cast(point) ~= nil, true, "overlay cast")
check.eq(ffi.C.ffi_CheckBoxControl_cast(nil) == nil, true, "cast of nil")
local back = ffi.C.ffi_CheckBoxControl_uncast(ffi.C.ffi_CheckBoxControl_cast(box))
check.eq(ffi.cast("void *", back) == ffi.cast("void *", box), true, "uncast gives the object back")

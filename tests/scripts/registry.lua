-- The registry seen from a script: creating controls by class ID with named
-- tags, and FFI casts against the exported symbols.
local check = require("check")
local ffi = require("ffi")

check.eq(#orbane.Classes(), 53, "registrations")

-- By class ID; the native name is none. An ID variant creates its primary's class.
local box = orbane.Create("CheckboxControl", { CBC_TriState = true })
check.eq(box:ClassID(), "CheckboxControl", "class ID of the check box")
local button = orbane.Create("ButtonControl", { BTNC_Align = "Center" })
local point = orbane.Create("PointControl", {})
check.fails(function() orbane.Create("CheckBoxControl", {}) end, 'unknown class "CheckBoxControl"', "native name")
check.eq(ffi.C.ffi_ComboControl_cast(orbane.Create("ComboIDControl", {})) ~= nil, true, "ComboID is a ComboControl")

-- Named tags map to numbered ones; a wrong value names the tag.
local tags = orbane.MapTags("CheckboxControl", { CBC_TriState = true })
check.eq(#tags, 1, "one tag")
check.eq(tags[1].tag, 0x10050000, "CBC_TriState id")
check.eq(tags[1].value, 1, "CBC_TriState value")
check.fails(function() orbane.MapTags("ButtonControl", { BTNC_Align = "Middle" }) end, "BTNC_Align.*Middle", "enum")

-- Casts: the same class gives the object back, another class (an overlay for
-- an inspector control) nil, nil nil.
local cast = ffi.C.ffi_CheckBoxControl_cast(box)
check.eq(ffi.cast("void *", ffi.C.ffi_CheckBoxControl_uncast(cast)) == ffi.cast("void *", box), true, "round trip")
check.eq(ffi.C.ffi_CheckBoxControl_cast(button) == nil, true, "cast to another class")
check.eq(ffi.C.ffi_PointControl_cast(box) == nil and ffi.C.ffi_PointControl_cast(point) ~= nil, true, "overlay cast")
check.eq(ffi.C.ffi_CheckBoxControl_cast(nil) == nil, true, "cast of nil")
check.eq(ffi.C.ffi_TransformControl_cast(orbane.Create("CameraControl", {})) ~= nil, true, "cast to the base class")

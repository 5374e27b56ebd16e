#pragma once

#include "orbane/Types.h"

namespace Orbane {

// A tag id names one attribute in a TagList. Read from the top:
// bits 28-31 the value type, bit 27 "may repeat", bits 16-23 the group,
// bits 0-15 the index within the group.
using Tag = uint32;

enum TagType : uint32
{
    TAGTYPE_Long = 0x1,   // GetLong / GetInt / GetBool
    TAGTYPE_Double = 0x2, // GetDouble
    TAGTYPE_String = 0x3, // GetString
    TAGTYPE_Object = 0x4, // GetObject (reference counted)
    TAGTYPE_Ptr = 0x6,    // GetPtr
    TAGTYPE_ID = 0x8,     // GetID
};

constexpr uint32 TagTypeOf(Tag tag) noexcept
{
    return tag >> 28;
}
constexpr bool TagIsRepeatable(Tag tag) noexcept
{
    return (tag >> 27) & 1u;
}
constexpr uint32 TagGroupOf(Tag tag) noexcept
{
    return (tag >> 16) & 0xFFu;
}
constexpr uint32 TagIndexOf(Tag tag) noexcept
{
    return tag & 0xFFFFu;
}
constexpr Tag MakeTag(uint32 type, uint32 group, uint32 index, bool repeatable = false) noexcept
{
    return type << 28 | (repeatable ? 1u << 27 : 0u) | (group & 0xFFu) << 16 | (index & 0xFFFFu);
}

// Tag groups.
enum TagGroup : uint32
{
    TAGGROUP_Registry = 0x00,
    TAGGROUP_Input = 0x02,  // the host's Input attributes
    TAGGROUP_Item = 0x03,   // item identifiers shared by list-like controls
    TAGGROUP_Text = 0x04,   // shared control texts
    TAGGROUP_Class = 0x05,  // a control class's own attributes
    TAGGROUP_Class2 = 0x06, // a second range of class attributes
};

// Registration tags given to Registry::_Init.
enum RegTag : Tag
{
    REG_Factory = 0x60000000,
    REG_ClassInit = 0x60000001,
    REG_ClassCleanup = 0x60000002,
    REG_ClassFamily = 0x60000004,
    REG_ScriptInfo = 0x60000005,
    REG_BaseClassID = 0x60000010,
    REG_TagMapHook = 0x60000014,
    REG_Kind = 0x10000000,
    REG_FormatLevel = 0x1000271F,
    REG_BuildStamp = 0x30000008,
    REG_Name = 0x30000015,
    REG_DisplayName = 0x30000012,
    REG_MenuPath = 0x30000013,
    REG_PreviewFlag64 = 0x10000064,
    REG_PreviewFlag65 = 0x10000065,
    REG_SplineFlag = 0x10000051,
};

// Kinds of registered class (value of REG_Kind).
constexpr int32 REGKIND_InputControl = 0x1A0000;
constexpr int32 REGKIND_PreviewControl = 0x1B0000;

// Input attributes (group 0x02) and shared texts (group 0x04).
enum InputTag : Tag
{
    INPA_Name = 0x30020014,           // the Input's display name
    INPA_InputControl = 0x88020010,   // class ID of an inspector control that shows the Input (repeatable)
    INPA_PreviewControl = 0x88020011, // class ID of a viewer overlay that edits the Input (repeatable)
    INPA_OverlayInput = 0x88020012,   // id of a further Input of the tool that the Input's overlays edit
                                      // (repeatable; the first is their Input index 1, and so on)
    INPA_LayoutHeight = 0x10020007,   // a layout object's height
    INPA_ReadOnly = 0x10020032,       // 1: the tool file declared the Input readOnly; its controls
                                      // show the value but do not edit it
    INPA_MinAllowed = 0x20030000,     // a Number Input's least value: every write is clamped to it
    INPA_MaxAllowed = 0x20030001,     // a Number Input's greatest value (the slider's allowed range)
    LINKS_Name = 0x30040000,          // label text
    LINKS_SecondName = 0x30040001,    // second label text
};

} // namespace Orbane

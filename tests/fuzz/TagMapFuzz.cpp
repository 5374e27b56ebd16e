// Script tables against a tag table with a row of every kind, both ways.
#include "FuzzInput.h"

#include "orbane/TagList.h"
#include "orbane/TagMapping.h"
#include "orbane/Tags.h"

namespace Orbane {
namespace {

const EnumEntry kModes[] = {{ENUM_NameRow, "Mode"}, {0, "Off"}, {1, "On"}, {7, "Auto"}, {0, nullptr}};

const TagMapEntry kTable[] = {
    {"Count", MakeTag(TAGTYPE_Long, 0x100, 1), TMK_Plain, nullptr, nullptr},
    {"Scale", MakeTag(TAGTYPE_Double, 0x100, 2), TMK_Plain, nullptr, nullptr},
    {"Title", MakeTag(TAGTYPE_String, 0x100, 3), TMK_Plain, nullptr, nullptr},
    {"Kind", MakeTag(TAGTYPE_ID, 0x100, 4), TMK_Plain, nullptr, nullptr},
    {"Shown", MakeTag(TAGTYPE_Long, 0x100, 5), TMK_Boolean, nullptr, nullptr},
    {"Mode", MakeTag(TAGTYPE_Long, 0x100, 6), TMK_Enumeration, kModes, nullptr},
    {"Target", MakeTag(TAGTYPE_Object, 0x100, 7), TMK_Object, "Input", nullptr},
    {"Colour", MakeTag(TAGTYPE_Long, 0x100, 8), TMK_Color, nullptr, nullptr},
    {nullptr, 0, 0, nullptr, nullptr},
};

} // namespace
} // namespace Orbane

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    using namespace Orbane;
    Fuzz::SmallLimits();
    ScriptVal args;
    if (!Fuzz::ContentTable(data, size, args))
        return 0;
    TagList tags;
    if (scriptval_maptags(kTable, MAP_ToTags, args, tags)) {
        ScriptVal back = ScriptVal::NewTable();
        scriptval_maptags(kTable, MAP_FromTags, back, tags);
    }
    return 0;
}

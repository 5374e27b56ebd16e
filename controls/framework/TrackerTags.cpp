#include "framework/TrackerTags.h"

#include "framework/TagTable.h"

namespace Orbane {

namespace {

const EnumEntry PatternUpdateEnum[] = {
    {ENUM_NameRow, "PatternUpdate"},
    {0, "Fixed"},
    {1, "EveryFrame"},
    {0, nullptr},
};

} // namespace

const TagMapEntry TrackerControlTags[] = {
    ORBANE_TAG(TRC_PatternInput, TMK_Plain),
    ORBANE_TAG(TRC_SearchInput, TMK_Plain),
    ORBANE_TAG(TRC_ShowPath, TMK_Boolean),
    ORBANE_TAG(TRC_PathFrames, TMK_Plain),
    ORBANE_ENUM_TAG(TRC_PatternUpdate, PatternUpdateEnum),
    ORBANE_TAG(TRC_SubPixel, TMK_Boolean),
    ORBANE_TAG(TRC_PathColor, TMK_Color),
    ORBANE_TAG(TRC_BoxColor, TMK_Color),
    ORBANE_TAG(TRCD_MinScore, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane

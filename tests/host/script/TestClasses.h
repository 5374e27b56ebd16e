#pragma once

#include "orbane/OrbID.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptObject.h"
#include "orbane/TagList.h"
#include "orbane/TagMapEntry.h"

#include <cstddef>

namespace Orbane {
class Registry;
class ScriptVal;
} // namespace Orbane

namespace Orbane::TestKit {

// Tags of the test widget, one of every kind a tag map knows.
enum WidgetTag : Tag
{
    WGT_Title = 0x30050000,    // plain text
    WGT_Count = 0x10050001,    // plain integer; a negative count makes the constructor throw
    WGT_Scale = 0x20050002,    // plain double
    WGT_Mode = 0x80050003,     // plain identifier
    WGT_TriState = 0x10050004, // boolean
    WGT_Align = 0x10050005,    // enumeration "Align"
    WGT_Partner = 0x40050006,  // object of script type "ScriptWidget"
    WGT_Color = 0x10050007,    // colour
    WGT_AddItem = 0x38050008,  // repeatable text
    WGT_Link = 0x60050009,     // object of script type "ScriptWidget" carried as a pointer
};

extern const TagMapEntry WidgetTags[];

// Registered as the control library registers controls: a primary, an ID
// variant with its own script type, and a derived class without a hook.
extern const OrbID WidgetClassID;
extern const OrbID WidgetIDClassID;
extern const OrbID GadgetClassID;

class TestWidget : public RefObject
{
public:
    TestWidget(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~TestWidget() override { --sAlive; }

    static void operator delete(void *block, std::size_t size) noexcept { Reuser::operator delete(block, size); }

    const Registry *GetRegistry() const override { return mRegistry; }
    const char *ScriptTypeName() const override;
    bool GetAttrsTagList(TagList &tags) const override { return (tags = mTags), true; }
    bool SetAttrsTagList(const TagList &tags) override;

    int64 Count() const { return mTags.GetLong(WGT_Count); }

    // Widgets alive right now.
    static int sAlive;

private:
    const Registry *mRegistry;
    TagList mTags;
};

class TestGadget : public TestWidget
{
public:
    using TestWidget::TestWidget;
};

} // namespace Orbane::TestKit

#include "TestClasses.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagMapping.h"

#include <new>
#include <stdexcept>

namespace Orbane::TestKit {

namespace {

const EnumEntry AlignValues[] = {
    {ENUM_NameRow, "Align"}, {0, "Left"},  {1, "CenteredLeft"}, {2, "Center"},
    {3, "CenteredRight"},    {4, "Right"}, {0, nullptr},
};

} // namespace

const TagMapEntry WidgetTags[] = {
    {"WGT_Title", WGT_Title, TMK_Plain, nullptr, nullptr},
    {"WGT_Count", WGT_Count, TMK_Plain, nullptr, nullptr},
    {"WGT_Scale", WGT_Scale, TMK_Plain, nullptr, nullptr},
    {"WGT_Mode", WGT_Mode, TMK_Plain, nullptr, nullptr},
    {"WGT_TriState", WGT_TriState, TMK_Boolean, nullptr, nullptr},
    {"WGT_Align", WGT_Align, TMK_Enumeration, AlignValues, nullptr},
    {"WGT_Partner", WGT_Partner, TMK_Object, "ScriptWidget", nullptr},
    {"WGT_Color", WGT_Color, TMK_Color, nullptr, nullptr},
    {"WGT_AddItem", WGT_AddItem, TMK_Plain, nullptr, nullptr},
    {"WGT_Link", WGT_Link, TMK_Object, "ScriptWidget", nullptr},
    {nullptr, 0, 0, nullptr, nullptr},
};

int TestWidget::sAlive = 0;

TestWidget::TestWidget(const Registry *reg, const ScriptVal &, const TagList &tags) : mRegistry(reg), mTags(tags)
{
    if (Count() < 0)
        throw std::runtime_error("negative count");
    ++sAlive;
}

const char *TestWidget::ScriptTypeName() const
{
    const FFIType *type = GetFFIType(typeid(*this));
    return type ? type->ScriptName() : "TestWidget";
}

bool TestWidget::SetAttrsTagList(const TagList &tags)
{
    for (const TagItem &item : tags.Items())
        mTags.Remove(item.tag);
    mTags.Append(tags);
    return true;
}

namespace {

// Gives the pooled memory back if the constructor throws, as the library does.
template <class T> ScriptObject *Factory(const Registry *reg, const ScriptVal &args, const TagList &tags)
{
    void *mem = Reuser::operator new(sizeof(T));
    try {
        return mem ? ::new (mem) T(reg, args, tags) : nullptr;
    } catch (...) {
        Reuser::operator delete(mem, sizeof(T));
        throw;
    }
}

bool WidgetHook(OrbID method, int32 direction, ScriptVal &args, TagList &tags)
{
    if (method == "Create" || method == "GetAttrs" || method == "SetAttrs" || method == "UserControl")
        return scriptval_maptags(WidgetTags, direction, args, tags);
    return true;
}

const OrbID RootClassID("TestRoot");

TagList Registration(const OrbID *base, ScriptInfo *info, const char *name, FactoryFunc factory, TagMapHook hook)
{
    TagList tags{{REG_BaseClassID, base}, {REG_ScriptInfo, info}, {REG_Name, name}, {REG_Factory, factory}};
    if (hook)
        tags.Add(REG_TagMapHook, hook);
    return tags;
}

} // namespace

// Ordered as a control library's initialisers: type info, class ID, registry,
// script info, the functions, then the type they belong to.
const bool kWidgetTypeInfo = (SetTypeInfo(typeid(TestWidget), typeid(RefObject)), true);
const bool kGadgetTypeInfo = (SetTypeInfo(typeid(TestGadget), typeid(TestWidget)), true);
const OrbID WidgetClassID("WidgetControl");
const OrbID WidgetIDClassID("WidgetIDControl");
const OrbID GadgetClassID("GadgetControl");

namespace {

extern FFITypeT<TestWidget> WidgetType;
extern ScriptInfoT<TestWidget> WidgetInfo;
extern ScriptInfoT<TestWidget> WidgetIDInfo;
extern ScriptInfoT<TestGadget> GadgetInfo;

Registry WidgetReg;
const bool kWidgetRegistered =
    WidgetReg._Init(ClassRegistry, WidgetClassID,
                    Registration(&RootClassID, &WidgetInfo, "TestWidget", &Factory<TestWidget>, &WidgetHook));
ScriptInfoT<TestWidget> WidgetInfo(1, "WidgetControl", "", "");
FFIFunc WidgetCast(WidgetType, "_cast", "_cast", "ffi_TestWidget_cast", "TestWidget * ffi_TestWidget_cast(void * obj)",
                   "obj", nullptr, "TestWidget *", 0);
FFITypeT<TestWidget> WidgetType("ScriptWidget", "TestWidget", "InputControl", -1, 0, nullptr);
const bool kWidgetBound = (SetFFIType(typeid(TestWidget), &WidgetType), true);
FFITagMap WidgetMap(WidgetType, "Create", "InputControl.Create", WidgetTags);

Registry WidgetIDReg;
const bool kWidgetIDRegistered =
    WidgetIDReg._Init(ClassRegistry, WidgetIDClassID,
                      Registration(&WidgetClassID, &WidgetIDInfo, "TestWidget", &Factory<TestWidget>, nullptr));
ScriptInfoT<TestWidget> WidgetIDInfo(1, "WidgetIDControl", "", "");
FFITypeT<TestWidget> WidgetIDType("WidgetIDControl", "WidgetIDControl", "InputControl", -1, 0, nullptr);
const bool kWidgetIDBound = (SetFFIType(typeid(TestWidget), &WidgetIDType), true);
FFITagMap WidgetIDMap(WidgetIDType, "Create", "InputControl.Create", WidgetTags);

Registry GadgetReg;
const bool kGadgetRegistered =
    GadgetReg._Init(ClassRegistry, GadgetClassID,
                    Registration(&WidgetClassID, &GadgetInfo, "TestGadget", &Factory<TestGadget>, nullptr));
ScriptInfoT<TestGadget> GadgetInfo(1, "GadgetControl", "", "");
FFITypeT<TestGadget> GadgetType("GadgetControl", "TestGadget", "ScriptWidget", -1, 0, nullptr);
const bool kGadgetBound = (SetFFIType(typeid(TestGadget), &GadgetType), true);

} // namespace

} // namespace Orbane::TestKit

using Orbane::ScriptObject;
using Orbane::TestKit::TestWidget;

// Exported for ffi.C, as the control library exports its casts.
extern "C" {

TestWidget *ffi_TestWidget_cast(void *obj)
{
    return dynamic_cast<TestWidget *>(static_cast<ScriptObject *>(obj));
}

} // extern "C"

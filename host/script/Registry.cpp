#include "orbane/Registry.h"

#include "orbane/RegistryList.h"

namespace Orbane {

namespace {

// Base chains come from registrations; a chain that loops must still end.
constexpr int kMaxDepth = 64;

template <class F> F PtrTag(const TagList &tags, Tag tag)
{
    return reinterpret_cast<F>(tags.GetPtr(tag));
}

} // namespace

Registry::~Registry()
{
    if (!mList)
        return;
    if (mCleanup)
        mCleanup(this);
    mList->Remove(this);
}

bool Registry::_Init(RegistryList &list, const OrbID &classID, const TagList &tags)
{
    if (mList)
        mList->Remove(this);
    mClassID = classID;
    mTags = tags;
    ReadBaseClassID(tags);
    mName = tags.GetString(REG_Name, classID.c_str());
    mKind = tags.GetInt(REG_Kind);
    mScriptInfo = static_cast<ScriptInfo *>(tags.GetPtr(REG_ScriptInfo));
    mFactory = PtrTag<FactoryFunc>(tags, REG_Factory);
    mMapHook = PtrTag<TagMapHook>(tags, REG_TagMapHook);
    mCleanup = PtrTag<ClassHook>(tags, REG_ClassCleanup);
    mList = &list;
    list.Add(this);
    const ClassHook init = PtrTag<ClassHook>(tags, REG_ClassInit);
    return !init || init(this);
}

void Registry::ReadBaseClassID(const TagList &tags)
{
    // The natural form is the address of a static OrbID (the tag is a
    // pointer tag); an identifier value is accepted too.
    mBaseRef = nullptr;
    mBaseID = OrbID();
    const TagItem *item = tags.Find(REG_BaseClassID);
    if (item && item->kind == TagKind::Ptr)
        mBaseRef = static_cast<const OrbID *>(item->ptr);
    else if (item && item->kind == TagKind::ID)
        mBaseID = item->id;
}

const Registry *Registry::Base() const
{
    const OrbID &base = BaseClassID();
    if (!mList || base.IsEmpty() || base == mClassID)
        return nullptr;
    return mList->Find(base);
}

bool Registry::IsA(const OrbID &classID) const
{
    const Registry *reg = this;
    for (int depth = 0; reg && depth < kMaxDepth; ++depth, reg = reg->Base())
        if (reg->ClassID() == classID || reg->BaseClassID() == classID)
            return true;
    return false;
}

TagMapHook Registry::FindMapHook() const
{
    const Registry *reg = this;
    for (int depth = 0; reg && depth < kMaxDepth; ++depth, reg = reg->Base())
        if (reg->MapHook())
            return reg->MapHook();
    return nullptr;
}

ScriptObject *Registry::New(const ScriptVal &args, const TagList &tags) const
{
    // An ID variant without a factory of its own borrows its primary's; the
    // factory gets this registry, so the object knows which ID made it.
    const Registry *reg = this;
    for (int depth = 0; reg && depth < kMaxDepth; ++depth, reg = reg->Base())
        if (reg->Factory())
            return reg->Factory()(this, args, tags);
    return nullptr;
}

} // namespace Orbane

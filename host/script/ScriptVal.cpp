#include "orbane/ScriptVal.h"

#include "orbane/ScriptObject.h"

namespace Orbane {

namespace {

const ScriptVal::Entries &NoEntries()
{
    static const ScriptVal::Entries none;
    return none;
}

// The index of an integer key 1..limit, else 0.
std::size_t ArrayIndex(const ScriptVal &key, std::size_t limit)
{
    if (!key.IsNumber())
        return 0;
    const float64 n = key.GetNumber();
    if (n < 1 || n > float64(limit) || n != float64(int64(n)))
        return 0;
    return std::size_t(n);
}

} // namespace

ScriptVal::ScriptVal(ScriptObject *obj) : mType(obj ? Object : Nil), mObj(obj)
{
    if (obj)
        obj->IncRef();
}

ScriptVal ScriptVal::NewTable()
{
    ScriptVal v;
    v.mType = Table;
    v.mTable = std::make_shared<Entries>();
    return v;
}

ScriptVal ScriptVal::FromPointer(void *p)
{
    ScriptVal v;
    v.mType = p ? Pointer : Nil;
    v.mPtr = p;
    return v;
}

ScriptVal::ScriptVal(const ScriptVal &o)
    : mType(o.mType), mNum(o.mNum), mStr(o.mStr), mTable(o.mTable), mObj(o.mObj), mPtr(o.mPtr)
{
    if (mObj)
        mObj->IncRef();
}

ScriptVal::ScriptVal(ScriptVal &&o) noexcept
    : mType(o.mType), mNum(o.mNum), mStr(std::move(o.mStr)), mTable(std::move(o.mTable)), mObj(o.mObj), mPtr(o.mPtr)
{
    o.mObj = nullptr;
    o.mType = Nil;
}

ScriptVal &ScriptVal::operator=(const ScriptVal &o)
{
    if (this != &o) {
        ScriptVal copy(o);
        *this = std::move(copy);
    }
    return *this;
}

ScriptVal &ScriptVal::operator=(ScriptVal &&o) noexcept
{
    if (this != &o) {
        Release();
        mType = o.mType;
        mNum = o.mNum;
        mStr = std::move(o.mStr);
        mTable = std::move(o.mTable);
        mObj = o.mObj;
        mPtr = o.mPtr;
        o.mObj = nullptr;
        o.mType = Nil;
    }
    return *this;
}

ScriptVal::~ScriptVal()
{
    Release();
}

void ScriptVal::Release() noexcept
{
    if (mObj)
        mObj->DecRef();
    mObj = nullptr;
    mTable.reset();
}

const char *ScriptVal::TypeName() const noexcept
{
    static const char *const names[] = {"nil", "boolean", "number", "string", "table", "object", "pointer"};
    return names[mType];
}

const ScriptVal *ScriptVal::FindKeyConst(const ScriptVal &key) const
{
    for (const Entry &entry : GetEntries())
        if (entry.first == key)
            return &entry.second;
    return nullptr;
}

ScriptVal *ScriptVal::FindKey(const ScriptVal &key)
{
    return const_cast<ScriptVal *>(FindKeyConst(key));
}

void ScriptVal::SetKey(const ScriptVal &key, const ScriptVal &value)
{
    if (!mTable || key.IsNil())
        return;
    for (auto it = mTable->begin(); it != mTable->end(); ++it) {
        if (it->first == key) {
            if (value.IsNil())
                mTable->erase(it);
            else
                it->second = value;
            return;
        }
    }
    if (!value.IsNil())
        mTable->emplace_back(key, value);
}

void ScriptVal::InsertNew(const ScriptVal &key, const ScriptVal &value)
{
    if (mTable && !key.IsNil() && !value.IsNil())
        mTable->emplace_back(key, value);
}

void ScriptVal::Append(const ScriptVal &value)
{
    SetKey(ScriptVal(Length() + 1), value);
}

int32 ScriptVal::Length() const
{
    // Only keys up to the entry count can belong to an unbroken run 1..n.
    const Entries &entries = GetEntries();
    std::vector<bool> present(entries.size() + 1, false);
    for (const Entry &entry : entries)
        present[ArrayIndex(entry.first, entries.size())] = true;
    int32 n = 0;
    while (std::size_t(n) < entries.size() && present[std::size_t(n) + 1])
        ++n;
    return n;
}

const ScriptVal::Entries &ScriptVal::GetEntries() const
{
    return mTable ? *mTable : NoEntries();
}

bool ScriptVal::operator==(const ScriptVal &o) const
{
    if (mType != o.mType)
        return false;
    switch (mType) {
    case Nil:
        return true;
    case Boolean:
    case Number:
        return mNum == o.mNum;
    case String:
        return mStr == o.mStr;
    case Table:
        return mTable == o.mTable;
    case Object:
        return mObj == o.mObj;
    case Pointer:
        return mPtr == o.mPtr;
    }
    return false;
}

} // namespace Orbane

#include "orbane/ScriptVal.h"

#include "orbane/ScriptObject.h"

#include <cstdint>
#include <functional>
#include <string_view>
#include <unordered_map>

namespace Orbane {

namespace {

const ScriptVal::Entries &NoEntries()
{
    static const ScriptVal::Entries none;
    return none;
}

// Hashes what operator== compares: equal keys hash alike (0.0 and -0.0 too).
struct KeyHash
{
    std::size_t operator()(const ScriptVal &key) const noexcept
    {
        const std::size_t type = std::size_t(key.GetType()) * 0x9e3779b97f4a7c15u;
        switch (key.GetType()) {
        case ScriptVal::Boolean:
            return type ^ std::size_t(key.GetBool());
        case ScriptVal::Number:
            return type ^ std::hash<float64>()(key.GetNumber() == 0.0 ? 0.0 : key.GetNumber());
        case ScriptVal::String:
            return type ^ std::hash<std::string_view>()(key.GetString());
        case ScriptVal::Table:
            return type ^ std::hash<const void *>()(&key.GetEntries());
        case ScriptVal::Object:
            return type ^ std::hash<const void *>()(key.GetObject());
        case ScriptVal::Pointer:
            return type ^ std::hash<const void *>()(key.GetPointer());
        case ScriptVal::Nil:
            break;
        }
        return type;
    }
};

} // namespace

struct ScriptVal::TableBody
{
    Entries entries;
    std::unordered_map<ScriptVal, std::size_t, KeyHash> index; // key -> position in entries
    mutable int32 length = 0; // of the array part, as far as known (it may reach further)

    // A new key can only lengthen the array part, which Length() finds by
    // looking on from the known border: appending stays constant time.
    void Add(const ScriptVal &key, const ScriptVal &value)
    {
        index.emplace(key, entries.size());
        entries.emplace_back(key, value);
    }

    void Erase(std::size_t at)
    {
        const ScriptVal key = entries[at].first;
        index.erase(key);
        entries.erase(entries.begin() + std::ptrdiff_t(at));
        for (std::size_t i = at; i < entries.size(); ++i)
            index[entries[i].first] = i;
        // Removing a key within the array part ends the part before it.
        if (key.IsNumber() && key.GetNumber() >= 1 && key.GetNumber() <= length)
            length = int32(key.GetNumber()) - 1;
    }
};

ScriptVal::ScriptVal(ScriptObject *obj) : mType(obj ? Object : Nil), mObj(obj)
{
    if (obj)
        obj->IncRef();
}

ScriptVal ScriptVal::NewTable()
{
    ScriptVal v;
    v.mType = Table;
    v.mTable = std::make_shared<TableBody>();
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
    if (!mTable)
        return nullptr;
    const auto it = mTable->index.find(key);
    return it == mTable->index.end() ? nullptr : &mTable->entries[it->second].second;
}

ScriptVal *ScriptVal::FindKey(const ScriptVal &key)
{
    return const_cast<ScriptVal *>(FindKeyConst(key));
}

void ScriptVal::SetKey(const ScriptVal &key, const ScriptVal &value)
{
    if (!mTable || key.IsNil())
        return;
    const auto it = mTable->index.find(key);
    if (it == mTable->index.end()) {
        if (!value.IsNil())
            mTable->Add(key, value);
    } else if (value.IsNil()) {
        mTable->Erase(it->second);
    } else {
        mTable->entries[it->second].second = value;
    }
}

void ScriptVal::InsertNew(const ScriptVal &key, const ScriptVal &value)
{
    if (mTable && !key.IsNil() && !value.IsNil())
        mTable->Add(key, value);
}

void ScriptVal::Append(const ScriptVal &value)
{
    SetKey(ScriptVal(Length() + 1), value);
}

int32 ScriptVal::Length() const
{
    if (!mTable)
        return 0;
    // Kept between calls: loops ask at every step.
    while (mTable->length < INT32_MAX && mTable->index.count(ScriptVal(mTable->length + 1)))
        ++mTable->length;
    return mTable->length;
}

const ScriptVal::Entries &ScriptVal::GetEntries() const
{
    return mTable ? mTable->entries : NoEntries();
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

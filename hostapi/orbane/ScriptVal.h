#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <memory>
#include <utility>
#include <vector>

namespace Orbane {

class ScriptObject;

// A script value: nil, boolean, number, string, table, object or pointer.
// Tables keep their keys in insertion order and are shared on copy (as in
// Lua, two values may name the same table); a hash index beside the ordered
// list finds a key in constant time. Objects hold one reference.
class ScriptVal
{
public:
    enum Type : uint8
    {
        Nil,
        Boolean,
        Number,
        String,
        Table,
        Object,
        Pointer
    };
    using Entry = std::pair<ScriptVal, ScriptVal>;
    using Entries = std::vector<Entry>;

    ScriptVal() noexcept = default;
    ScriptVal(bool v) : mType(Boolean), mNum(v ? 1 : 0) {}
    ScriptVal(int v) : mType(Number), mNum(v) {}
    ScriptVal(int64 v) : mType(Number), mNum(float64(v)) {}
    ScriptVal(float64 v) : mType(Number), mNum(v) {}
    ScriptVal(const char *v) : mType(v ? String : Nil), mStr(v) {}
    ScriptVal(const std::string &v) : mType(String), mStr(v) {}
    ScriptVal(const OrbString &v) : mType(String), mStr(v) {}
    ScriptVal(ScriptObject *obj);
    static ScriptVal NewTable();
    static ScriptVal FromPointer(void *p);

    ScriptVal(const ScriptVal &o);
    ScriptVal(ScriptVal &&o) noexcept;
    ScriptVal &operator=(const ScriptVal &o);
    ScriptVal &operator=(ScriptVal &&o) noexcept;
    ~ScriptVal();

    Type GetType() const noexcept { return mType; }
    bool IsNil() const noexcept { return mType == Nil; }
    bool IsTable() const noexcept { return mType == Table; }
    bool IsNumber() const noexcept { return mType == Number; }
    bool IsString() const noexcept { return mType == String; }
    bool IsBool() const noexcept { return mType == Boolean; }
    bool IsObject() const noexcept { return mType == Object; }
    bool IsPointer() const noexcept { return mType == Pointer; }

    bool GetBool() const noexcept { return mType != Nil && !(mType == Boolean && mNum == 0); }
    float64 GetNumber(float64 def = 0.0) const noexcept { return mType == Number ? mNum : def; }
    const char *GetString(const char *def = "") const noexcept { return mType == String ? mStr.c_str() : def; }
    ScriptObject *GetObject() const noexcept { return mType == Object ? mObj : nullptr; }
    void *GetPointer() const noexcept { return mType == Pointer ? mPtr : nullptr; }
    // Type name as Lua says it ("nil", "boolean", "number", "string", "table", "object", "pointer").
    const char *TypeName() const noexcept;

    // Table access. On a non-table these find nothing and change nothing.
    const ScriptVal *FindKeyConst(const ScriptVal &key) const;
    ScriptVal *FindKey(const ScriptVal &key);
    // Setting nil removes the key, as in Lua.
    void SetKey(const ScriptVal &key, const ScriptVal &value);
    // Adds an entry whose key the caller knows to be absent, without the
    // search SetKey makes (filling a fresh table from Lua).
    void InsertNew(const ScriptVal &key, const ScriptVal &value);
    // Appends at key #table + 1.
    void Append(const ScriptVal &value);
    // Number of entries of the array part 1..n.
    int32 Length() const;
    const Entries &GetEntries() const;

    bool operator==(const ScriptVal &o) const;
    bool operator!=(const ScriptVal &o) const { return !(*this == o); }

private:
    struct TableBody;

    void Release() noexcept;

    Type mType = Nil;
    float64 mNum = 0.0;
    OrbString mStr;
    std::shared_ptr<TableBody> mTable;
    ScriptObject *mObj = nullptr;
    void *mPtr = nullptr;
};

} // namespace Orbane

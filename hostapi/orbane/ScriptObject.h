#pragma once

#include "orbane/Types.h"

#include <cstddef>

namespace Orbane {

class ScriptInfo;
class Registry;
class TagList;

// The script-visible object root. Every object a script can hold starts with
// this base, so a pointer to any control is also a valid ScriptObject pointer
// (the exported uncast functions rely on it).
class ScriptObject
{
public:
    ScriptObject() = default;
    ScriptObject(const ScriptObject &) = delete;
    ScriptObject &operator=(const ScriptObject &) = delete;
    virtual ~ScriptObject();

    virtual void IncRef() noexcept {}
    virtual void DecRef() noexcept {}
    // The bytes the object itself takes (what it owns besides not counted).
    virtual std::size_t SizeOf() const { return sizeof(ScriptObject); }
    // The name scripts know this object's type by ("Input", "CheckboxControl").
    virtual const char *ScriptTypeName() const { return "Object"; }
    virtual const Registry *GetRegistry() const { return nullptr; }
    // The attributes a script reads with GetAttrs; false where the object has none.
    virtual bool GetAttrsTagList(TagList &) const { return false; }
    // Applies attributes a script sets with SetAttrs; false where the object takes none.
    virtual bool SetAttrsTagList(const TagList &) { return false; }
};

// Reference-counted object. Starts with one reference owned by its creator;
// the last DecRef deletes it.
class RefObject : public ScriptObject
{
public:
    RefObject() = default;

    void IncRef() noexcept override { ++mRefs; }
    void DecRef() noexcept override;
    int32 RefCount() const noexcept { return mRefs; }

protected:
    ~RefObject() override;

private:
    int32 mRefs = 1;
};

} // namespace Orbane

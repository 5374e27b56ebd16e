#pragma once

#include "orbane/OrbID.h"
#include "orbane/ScriptObject.h"
#include "orbane/Tags.h"

#include <cstddef>
#include <new>

namespace Orbane {

class Registry;
class ScriptVal;
class TagList;

// The host's object root for every registered class. Memory comes from the
// pooled allocator (Reuser) and goes back to it on delete.
class Object : public RefObject
{
public:
    Object(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~Object() override;

    static void *operator new(std::size_t size);
    static void *operator new(std::size_t, void *place) noexcept { return place; }
    static void operator delete(void *block, std::size_t size) noexcept;
    static void operator delete(void *, void *) noexcept {}

    // The number of bytes the factory allocated for this object.
    std::size_t SizeOf() const override { return sizeof(Object); }
    // Applies attributes; the base applies none.
    bool SetAttrsTagList(const TagList &tags) override;
    // Writes a readable attribute through `out` and returns false (a value was
    // supplied); returns true where the attribute is not one of the object's.
    virtual bool CopyAttr(Tag tag, void *out);

    const Registry *GetRegistry() const override { return mRegistry; }
    // The script type bound to the object's class, else its registry name.
    const char *ScriptTypeName() const override;

    static bool RegInit(Registry *reg);
    static bool RegCleanup(Registry *reg);
    static const OrbID ClassID;

private:
    const Registry *mRegistry;
};

// The factory every registered class uses: allocates from the pool, returns
// null where the pool gives nothing, and returns the memory if the
// constructor throws before letting the exception pass.
template <class T> ScriptObject *NewObject(const Registry *reg, const ScriptVal &args, const TagList &tags);

} // namespace Orbane

#include "orbane/Reuser.h"

template <class T>
Orbane::ScriptObject *Orbane::NewObject(const Registry *reg, const ScriptVal &args, const TagList &tags)
{
    void *mem = Reuser::operator new(sizeof(T));
    if (!mem)
        return nullptr;
    try {
        return new (mem) T(reg, args, tags);
    } catch (...) {
        Reuser::operator delete(mem, sizeof(T));
        throw;
    }
}

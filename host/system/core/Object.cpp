#include "orbane/Object.h"

#include "orbane/FFIType.h"
#include "orbane/Registry.h"
#include "orbane/Reuser.h"

#include <typeinfo>

namespace Orbane {

const OrbID Object::ClassID("Object");

Object::Object(const Registry *reg, const ScriptVal &, const TagList &) : mRegistry(reg) {}

Object::~Object() = default;

void *Object::operator new(std::size_t size)
{
    if (void *block = Reuser::operator new(size))
        return block;
    throw std::bad_alloc();
}

void Object::operator delete(void *block, std::size_t size) noexcept
{
    Reuser::operator delete(block, size);
}

bool Object::SetAttrsTagList(const TagList &)
{
    return true;
}

bool Object::CopyAttr(Tag, void *)
{
    return true;
}

const char *Object::ScriptTypeName() const
{
    if (const FFIType *type = GetFFIType(typeid(*this)))
        return type->ScriptName();
    return mRegistry ? mRegistry->Name() : "Object";
}

bool Object::RegInit(Registry *)
{
    return true;
}

bool Object::RegCleanup(Registry *)
{
    return true;
}

} // namespace Orbane

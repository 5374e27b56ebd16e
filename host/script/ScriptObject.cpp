#include "orbane/ScriptObject.h"

namespace Orbane {

ScriptObject::~ScriptObject() = default;

void RefObject::DecRef() noexcept
{
    if (--mRefs == 0)
        delete this;
}

RefObject::~RefObject() = default;

} // namespace Orbane

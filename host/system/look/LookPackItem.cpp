#include "orbane/LookPackItem.h"

#include "orbane/LookPack.h"

namespace Orbane {

LookPackItem::LookPackItem(const OrbID &name) : mName(name), mData(&LookPack::Get().FindItem(name)) {}

} // namespace Orbane

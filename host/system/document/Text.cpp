#include "orbane/Text.h"

#include "orbane/ClassIDs.h"

namespace Orbane {

const OrbID &Text::DataType() const noexcept
{
    return CLSID_DataType_Text;
}

Parameter *Text::Clone() const
{
    return new Text(Value);
}

std::size_t Text::Footprint() const noexcept
{
    return kSmallFootprint + Value.str().size();
}

bool Text::Equals(const Parameter &o) const
{
    const auto *s = dynamic_cast<const Text *>(&o);
    return s && s->Value == Value;
}

} // namespace Orbane

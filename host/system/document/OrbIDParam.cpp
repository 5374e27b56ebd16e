#include "orbane/OrbIDParam.h"

#include "orbane/ClassIDs.h"

namespace Orbane {

const OrbID &OrbIDParam::DataType() const noexcept
{
    return CLSID_DataType_ID;
}

Parameter *OrbIDParam::Clone() const
{
    return new OrbIDParam(Value);
}

bool OrbIDParam::Equals(const Parameter &o) const
{
    const auto *id = dynamic_cast<const OrbIDParam *>(&o);
    return id && id->Value == Value;
}

} // namespace Orbane

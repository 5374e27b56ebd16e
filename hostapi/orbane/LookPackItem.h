#pragma once

#include "orbane/OrbID.h"
#include "orbane/ScriptVal.h"

namespace Orbane {

// One named item of the look pack, such as "Controls.CheckBox.Layout". A
// control's layout description is key 1 of a layout item's table:
//   LookPackItem("Controls.CheckBox.Layout").GetItemData().FindKeyConst(1)
// A missing item reads as nil, with one warning naming it.
class LookPackItem
{
public:
    explicit LookPackItem(const OrbID &name);

    const OrbID &GetName() const { return mName; }
    const ScriptVal &GetItemData() const { return *mData; }
    bool IsValid() const { return !mData->IsNil(); }

private:
    OrbID mName;
    const ScriptVal *mData; // owned by the look pack, which lives as long as the process
};

} // namespace Orbane

#include "inputcontrols/ItemChoice.h"

#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/OrbIDParam.h"
#include "orbane/Registry.h"
#include "orbane/Text.h"

#include <cmath>

namespace Orbane {

namespace {

// The highest bit a double holds with every lower one exact.
constexpr int kLastBit = 52;

} // namespace

bool ItemChoice::IsIDVariant(const Registry *reg, const OrbID &plain)
{
    return reg && reg->ClassID() != plain;
}

void ItemChoice::Read(const Input *input)
{
    if (!input)
        return;
    mIsText = input->GetDataType() == CLSID_DataType_Text;
    const LockableObject::ReadGuard guard(*input);
    mItems.Read(input->GetAttrs());
}

int32 ItemChoice::SelectionFor(const Parameter *value) const
{
    if (!mIDVariant) {
        const auto *number = dynamic_cast<const Number *>(value);
        return number ? mItems.Nearest(number->Value) : -1;
    }
    if (mIsText) {
        const auto *text = dynamic_cast<const Text *>(value);
        return text ? mItems.FindID(OrbID(text->Value.str())) : -1;
    }
    const auto *id = dynamic_cast<const OrbIDParam *>(value);
    return id ? mItems.FindID(id->Value) : -1;
}

int32 ItemChoice::SelectionAt(Input *input, float64 time, int32 current) const
{
    const AutoParameter now(input ? input->GetValue(time) : nullptr);
    return now ? SelectionFor(now) : current;
}

bool ItemChoice::Follow(const Parameter *value, int32 &selection) const
{
    const int32 chosen = SelectionFor(value);
    if (chosen == selection)
        return false;
    selection = chosen;
    return true;
}

AutoParameter ItemChoice::ValueOf(int32 index) const
{
    const std::size_t i = std::size_t(index);
    if (!mIDVariant)
        return AutoParameter(AutoNumber(index >= 0 && i < mItems.Values.size() ? mItems.Values[i] : 0.0));
    const AutoOrbIDParam id(mItems.IsItem(index) ? mItems.IDs[i] : OrbID());
    if (mIsText)
        return AutoParameter(AutoText(OrbString(id->Value.str())));
    return AutoParameter(id);
}

TagList ItemChoice::ItemTags(int32 index) const
{
    TagList tags;
    if (!mItems.IsItem(index))
        return tags;
    if (const int64 integer = mItems.Integers[std::size_t(index)])
        tags.Set(ItemIntegerSent, TagValue(static_cast<long long>(integer)));
    if (void *pointer = mItems.Pointers[std::size_t(index)])
        tags.Set(ItemPointerSent, pointer);
    return tags;
}

bool ItemChoice::WriteOnDisconnect(Input *input, int32 selection) const
{
    if (!input || !IsChoosable(selection))
        return false;
    const TagList tags = ItemTags(selection);
    return input->SetValue(ValueOf(selection), TIME_DISCONNECT, SETVALUE_NoUndo, tags.IsEmpty() ? nullptr : &tags);
}

uint64 ItemChoice::BitOf(int32 index) const
{
    if (!IsChoosable(index))
        return 0;
    const float64 bit = std::floor(mItems.Values[std::size_t(index)] + 0.5);
    return bit >= 0.0 && bit <= kLastBit ? uint64(1) << uint32(bit) : 0;
}

uint64 ItemChoice::BitsOf(float64 value)
{
    const float64 rounded = std::floor(value + 0.5);
    return rounded >= 0.0 && rounded < std::ldexp(1.0, kLastBit + 1) ? uint64(rounded) : 0;
}

} // namespace Orbane

#pragma once

#include "inputcontrols/ComboItems.h"

#include "orbane/AutoParam.h"

namespace Orbane {

class Input;
class Registry;

// The items of a control that chooses one of them (the combo box, the
// button row, the list) and how a choice is held in its Input: the plain
// variant holds the item's value as a number; the identifier variant holds
// the item's identifier, as an identifier or, for a Text Input, as text.
class ItemChoice
{
public:
    // Sent with every write, in the tag list that reaches each control of
    // the Input: the chosen item's integer (0x18040000) where it is not 0,
    // and its pointer (0x68040000) where it is not null.
    static constexpr Tag ItemIntegerSent = 0x100003e8;
    static constexpr Tag ItemPointerSent = 0x600003e8;

    // Is a control created through `reg` the identifier variant of the
    // class whose plain class ID is `plain`?
    static bool IsIDVariant(const Registry *reg, const OrbID &plain);

    explicit ItemChoice(bool idVariant = false) : mIDVariant(idVariant) {}

    // Reads the items that the Input's attributes declare (under its read
    // lock) and notes whether the Input holds text.
    void Read(const Input *input);

    ComboItems &Items() { return mItems; }
    const ComboItems &Items() const { return mItems; }
    bool IsIDVariant() const { return mIDVariant; }

    // The item a value chooses, or -1: the nearest within reach by value,
    // or the first with the identifier.
    int32 SelectionFor(const Parameter *value) const;
    // The item the Input's value at `time` chooses; `current` where the
    // Input has no value.
    int32 SelectionAt(Input *input, float64 time, int32 current) const;
    // Sets `selection` to the item `value` chooses; false where that is
    // the one it held (the notify gate: nothing to show again).
    bool Follow(const Parameter *value, int32 &selection) const;
    // The value that chooses item `index`; outside the items, 0 (plain) or
    // an empty identifier.
    AutoParameter ValueOf(int32 index) const;
    // The tags sent with a write of item `index`.
    TagList ItemTags(int32 index) const;
    // What a control that shows item `selection` writes when unbound from
    // `input`: the item's value or identifier, with its tags, at the
    // disconnect time and without undo. With no item shown it writes
    // nothing: no value stands for none but the one the Input holds.
    bool WriteOnDisconnect(Input *input, int32 selection) const;
    // Is `index` an item that can be chosen (no separator)?
    bool IsChoosable(int32 index) const { return mItems.IsItem(index) && !mItems.IsSeparator(index); }

    // Where several items are chosen at once, a number holds them as bits:
    // item `index` is bit n of it, n its value (its ordinal, unless given).
    // 0 for a separator or a value that names no bit (below 0, above 52,
    // where a double stops holding every integer).
    uint64 BitOf(int32 index) const;
    // The bits of a number, rounded; 0 for anything that is no such number.
    static uint64 BitsOf(float64 value);

private:
    ComboItems mItems;
    bool mIDVariant;
    bool mIsText = false;
};

} // namespace Orbane

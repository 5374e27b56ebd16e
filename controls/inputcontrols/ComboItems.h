#pragma once

#include "orbane/OrbID.h"
#include "orbane/OrbString.h"
#include "orbane/TagList.h"

#include <vector>

namespace Orbane {

// The items of a combo box, read from its Input's attributes, as parallel
// lists in declaration order (separators included, so an item's index is its
// place in the declaration):
//   0x38040000 starts an item; up to the next item or separator,
//   0x18040000 gives its integer, 0x28030000 its value, 0x38050000 its
//   second text, 0x68040000 its pointer, 0x88030000 its identifier;
//   0x38040001 adds a separator.
// An item's value defaults to its ordinal among the text items (0, 1, 2...),
// which separators and explicit values do not disturb; its identifier
// defaults to its text.
class ComboItems
{
public:
    static constexpr Tag AddString = 0x38040000;
    static constexpr Tag AddSeparator = 0x38040001;
    static constexpr Tag ItemInteger = 0x18040000;
    static constexpr Tag ItemValue = 0x28030000;
    static constexpr Tag ItemSecondText = 0x38050000;
    static constexpr Tag ItemPointer = 0x68040000;
    static constexpr Tag ItemID = 0x88030000;
    // The value of a separator: far from any value an item is given.
    static constexpr float64 kSeparatorValue = -1000000.0;
    // An Input value selects the nearest item only when it is closer than
    // this: half the step between two ordinal values.
    static constexpr float64 kNearEnough = 0.5;

    // Appends the items that `attrs` declares, in its order.
    void Read(const TagList &attrs);
    void Clear();

    int32 Count() const { return mCount; }
    bool IsItem(int32 index) const { return index >= 0 && index < mCount; }
    bool IsSeparator(int32 index) const { return IsItem(index) && mSeparator[std::size_t(index)]; }

    // The text item whose value is nearest to `value`, the first of equals,
    // where it is nearer than kNearEnough; -1 otherwise.
    int32 Nearest(float64 value) const;
    // The first text item with identifier `id`; -1 where none has it.
    int32 FindID(const OrbID &id) const;
    // The item indices in the order the list shows them: as declared, or
    // sorted by text within each run between separators (which stay put).
    std::vector<int32> RowOrder(bool alphaSort) const;

    // Does text `a` sort before `b`, as people sort names: letters without
    // regard to case, and runs of digits by their number, so "Layer 2"
    // comes before "layer 10". Equal names fall back to a plain comparison
    // so that the order never depends on where the items started.
    static bool TextLess(const OrbString &a, const OrbString &b);

    std::vector<OrbString> Texts;
    std::vector<OrbString> SecondTexts;
    std::vector<OrbID> IDs;
    std::vector<float64> Values;
    std::vector<int64> Integers;
    std::vector<void *> Pointers;

private:
    void Append(const OrbString &text, bool separator);

    std::vector<bool> mSeparator;
    int32 mCount = 0;
};

} // namespace Orbane

#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Input.h"

#include <cstddef>
#include <map>
#include <utility>
#include <vector>

namespace Orbane {

// The Input slots an edit touched, each once, with the value the slot held
// before the edit. Swapping exchanges those values with the stored ones, so
// the same set serves undo, redo and rollback.
class ChangeSet
{
public:
    // Remembers `before` for the slot unless the slot is already known.
    void Note(Input *in, const Input::Slot &slot, const AutoRef<Parameter> &before);
    // Remembers whether the Input was animated before the edit, once.
    void NoteAnimated(Input *in, bool before);
    // Exchanges every held value with the one stored now, then tells the
    // watchers of each Input concerned, once per Input.
    void Swap();
    // Forgets slots whose value is back to what it was before the edit.
    void Prune();

    std::size_t Size() const noexcept { return mEntries.size() + mSwitches.size(); }
    // About how many bytes the held values and their bookkeeping take.
    std::size_t Footprint() const noexcept;
    bool IsEmpty() const noexcept { return mEntries.empty() && mSwitches.empty(); }

private:
    struct Entry
    {
        AutoRef<Input> input;
        Input::Slot slot;
        AutoRef<Parameter> held;
    };
    // An Input's animation switch as it was before the edit.
    struct Switch
    {
        AutoRef<Input> input;
        bool held;
    };
    using Key = std::pair<const Input *, Input::Slot>;

    void Reindex();

    std::vector<Entry> mEntries;
    std::map<Key, std::size_t> mIndex;
    std::vector<Switch> mSwitches;
};

} // namespace Orbane

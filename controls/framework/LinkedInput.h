#pragma once

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/PreviewControl.h"
#include "orbane/TagList.h"

#include <cstddef>

namespace Orbane {

class Operator;

// One optional Input that an overlay links besides its main one: the tag
// that passes the Input itself, the tag that names it by id (0 where the
// overlay takes it by pointer only), and the overlay's slot for it. An
// overlay lists its rows in one table and walks them with the functions
// below, instead of one hand-written branch per Input.
template <class Owner> struct LinkedInput
{
    Tag ptrTag;
    Tag idTag;
    Input *Owner::*slot;
};

// Attaches (or keeps, or lets go of) each row's Input as `tags` says, in
// table order, watching each. Returns a mask of the rows whose slot now
// holds another Input than before, so the overlay can read their values.
template <class Owner, std::size_t N>
uint32 AttachLinkedInputs(Owner &owner, const LinkedInput<Owner> (&rows)[N], Operator *tool, const TagList &tags)
{
    static_assert(N <= 32, "one bit per row");
    uint32 changed = 0;
    for (std::size_t i = 0; i < N; ++i) {
        Input *&slot = owner.*(rows[i].slot);
        const Input *before = slot;
        owner.AttachToInput(slot, tool, tags, rows[i].ptrTag, rows[i].idTag, ATTACH_Watch, ATTACH_Watch);
        if (slot != before && slot)
            changed |= 1u << i;
    }
    return changed;
}

template <class Owner, std::size_t N> void DetachLinkedInputs(Owner &owner, const LinkedInput<Owner> (&rows)[N])
{
    for (const LinkedInput<Owner> &row : rows)
        owner.DetachFromInput(owner.*(row.slot));
}

// Tells the overlay the values of the rows in `mask` (AttachLinkedInputs'
// answer), so that a newly linked Input shows from the moment it is linked,
// not only after its next change.
template <class Owner, std::size_t N>
void PullLinkedInputs(Owner &owner, const LinkedInput<Owner> (&rows)[N], uint32 mask)
{
    for (std::size_t i = 0; i < N; ++i)
        if (Input *in = owner.*(rows[i].slot); in && (mask & (1u << i))) {
            const AutoParameter value(in->GetValue(owner.GetCurrentTime()));
            owner.NotifyChanged(in, value.get(), nullptr);
        }
}

// Lets go of `input` in every slot that holds it (one Input may fill
// several); true where any did.
template <class Owner, std::size_t N>
bool DetachLinkedInput(Owner &owner, const LinkedInput<Owner> (&rows)[N], const Input *input)
{
    bool held = false;
    for (const LinkedInput<Owner> &row : rows)
        if (input && owner.*(row.slot) == input) {
            owner.DetachFromInput(owner.*(row.slot));
            held = true;
        }
    return held;
}

// The row whose slot holds `input`, or null (also for a null `input`).
template <class Owner, std::size_t N>
const LinkedInput<Owner> *FindLinkedInput(const Owner &owner, const LinkedInput<Owner> (&rows)[N], const Input *input)
{
    if (!input)
        return nullptr;
    for (const LinkedInput<Owner> &row : rows)
        if (owner.*(row.slot) == input)
            return &row;
    return nullptr;
}

// Writes the id of every attached Input under its row's id tag (rows taken
// by pointer only have none), for GetAttrs.
template <class Owner, std::size_t N>
void WriteLinkedInputIds(const Owner &owner, const LinkedInput<Owner> (&rows)[N], TagList &tags)
{
    for (const LinkedInput<Owner> &row : rows)
        if (const Input *in = owner.*(row.slot); in && row.idTag)
            tags.Set(row.idTag, in->GetID());
}

} // namespace Orbane

#pragma once

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/PreviewControl.h"
#include "orbane/TagList.h"

#include <cmath>
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

// Lets go of `input` where a row holds it, for RemoveInput; the row that
// held it, or null.
template <class Owner, std::size_t N>
const LinkedInput<Owner> *DetachLinkedInput(Owner &owner, const LinkedInput<Owner> (&rows)[N], const Input *input)
{
    const LinkedInput<Owner> *row = FindLinkedInput(owner, rows, input);
    if (row)
        owner.DetachFromInput(owner.*(row->slot));
    return row;
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

// Tells the overlay the value now of each row that `linked` names (the mask
// AttachLinkedInputs answers), so linked Inputs show from the moment they
// are linked, not from their next change.
template <class Owner, std::size_t N>
void NotifyLinkedInputs(Owner &owner, const LinkedInput<Owner> (&rows)[N], uint32 linked)
{
    for (std::size_t i = 0; i < N; ++i)
        if (linked & (1u << i)) {
            Input *in = owner.*(rows[i].slot);
            const AutoParameter value(in->GetValue(owner.GetCurrentTime()));
            owner.NotifyChanged(in, value.get(), nullptr);
        }
}

// A linked Number Input's value, where it is a finite number.
inline bool ReadLinkedNumber(const Parameter *value, float64 &out)
{
    const auto *n = dynamic_cast<const Number *>(value);
    if (!n || !std::isfinite(n->Value))
        return false;
    out = n->Value;
    return true;
}

// Takes `to` into the overlay's `copy` where it moved by more than the
// threshold; true where it did.
inline bool TakeMoved(float64 &copy, float64 to)
{
    if (!PreviewControl::Moved(copy, to))
        return false;
    copy = to;
    return true;
}

} // namespace Orbane

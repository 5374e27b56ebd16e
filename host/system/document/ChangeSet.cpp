#include "ChangeSet.h"

#include "ExpressionGraph.h"

#include "orbane/OrbaneDoc.h"

#include <algorithm>

namespace Orbane {

namespace {
bool SameValue(const Parameter *a, const Parameter *b)
{
    return a == b || (a && b && a->Equals(*b));
}
} // namespace

void ChangeSet::Note(Input *in, const Input::Slot &slot, const AutoRef<Parameter> &before)
{
    const auto [it, added] = mIndex.emplace(Key(in, slot), mEntries.size());
    if (added)
        mEntries.push_back({AutoRef<Input>::Share(in), slot, before});
}

void ChangeSet::NoteAnimated(Input *in, bool before)
{
    const auto known = [in](const Switch &s) { return s.input.get() == in; };
    if (std::none_of(mSwitches.begin(), mSwitches.end(), known))
        mSwitches.push_back({AutoRef<Input>::Share(in), before});
}

void ChangeSet::Swap()
{
    std::vector<Input *> touched;
    for (Switch &s : mSwitches) {
        std::swap(s.held, s.input->mAnimated);
        touched.push_back(s.input.get());
    }
    for (Entry &e : mEntries) {
        e.held = e.input->Exchange(e.slot, std::move(e.held));
        if (std::find(touched.begin(), touched.end(), e.input.get()) == touched.end())
            touched.push_back(e.input.get());
    }
    for (Input *in : touched)
        in->Notify();
    // Expressions may have come or gone, and what they read has changed.
    if (!touched.empty())
        if (OrbaneDoc *doc = touched.front()->GetDoc())
            doc->Expressions().EvaluateAll();
}

void ChangeSet::Prune()
{
    const auto unchanged = [](const Entry &e) { return SameValue(e.held, e.input->Peek(e.slot)); };
    mEntries.erase(std::remove_if(mEntries.begin(), mEntries.end(), unchanged), mEntries.end());
    const auto unswitched = [](const Switch &s) { return s.held == s.input->mAnimated; };
    mSwitches.erase(std::remove_if(mSwitches.begin(), mSwitches.end(), unswitched), mSwitches.end());
    Reindex();
}

void ChangeSet::Reindex()
{
    mIndex.clear();
    for (std::size_t i = 0; i < mEntries.size(); ++i)
        mIndex.emplace(Key(mEntries[i].input.get(), mEntries[i].slot), i);
}

std::size_t ChangeSet::Footprint() const noexcept
{
    std::size_t bytes = mSwitches.size() * sizeof(Switch);
    for (const Entry &e : mEntries)
        bytes += sizeof(Entry) + sizeof(std::pair<Key, std::size_t>) + (e.held ? e.held->Footprint() : 0);
    return bytes;
}

} // namespace Orbane

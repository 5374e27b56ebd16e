#include "orbane/Input.h"

#include "KeyBlend.h"
#include "UndoRecorder.h"

#include "orbane/ClassIDs.h"
#include "orbane/InputWatcher.h"
#include "orbane/Number.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptError.h"
#include "orbane/Tags.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>

namespace Orbane {

Input::Input(Operator *tool, const OrbID &id, const char *name, const OrbID &dataType, const TagList &attrs,
             const Parameter *def)
    : mID(id), mName(name), mDataType(dataType), mAttrs(attrs), mOperator(tool), mDefault(def ? def->Clone() : nullptr),
      mValue(def ? def->Clone() : nullptr)
{
}

Input::~Input() = default;

OrbaneDoc *Input::GetDoc() const noexcept
{
    return mOperator ? mOperator->GetDoc() : nullptr;
}

float64 Input::CurrentTime() const noexcept
{
    const OrbaneDoc *doc = GetDoc();
    return doc ? doc->GetCurrentTime() : 0.0;
}

Parameter *Input::GetValue(float64 time) const
{
    if (!mAnimated || mKeys.empty())
        return mValue ? mValue->Clone() : nullptr;
    const auto after = mKeys.lower_bound(time);
    if (after == mKeys.end())
        return std::prev(after)->second->Clone();
    if (after == mKeys.begin() || after->first == time)
        return after->second->Clone();
    return KeyBlend::Between(mKeys, after, time, mInterpolation);
}

bool Input::StoreValue(Parameter *value, float64 time, uint32 flags, const TagList *tags)
{
    if (!Accepts(value))
        return false;
    // A key at NaN would break the order of the keys; one at infinity is
    // beyond every time anyone can scrub to.
    if (mAnimated && !std::isfinite(time)) {
        SetScriptError(std::string("Input \"") + GetName() + "\": a key needs a finite time");
        return false;
    }
    Slot slot;
    if (!SlotFor(time, slot))
        return true;
    AutoRef<Parameter> copy = Bounded(*value);
    const Parameter *stored = Peek(slot);
    if (stored && stored->Equals(*copy))
        return true;
    // A watcher may drop the last other reference to this Input.
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    OrbaneDoc *doc = GetDoc();
    if (doc && !(flags & SETVALUE_NoUndo))
        doc->Recorder().Record(this, slot, std::move(copy));
    else
        Exchange(slot, std::move(copy));
    Notify(tags);
    ValueChanged();
    return true;
}

void Input::Notify(const TagList *tags)
{
    std::vector<InputWatcher *> watchers;
    {
        ReadGuard guard(*this);
        watchers = mWatchers;
    }
    if (watchers.empty())
        return;
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    const AutoRef<Parameter> value(GetValue(CurrentTime()));
    // A watcher told earlier may detach a later one (and delete it).
    for (InputWatcher *w : watchers)
        if (IsWatching(w))
            w->OnInputChanged(this, value, tags);
}

void Input::SetAnimated(bool animated)
{
    if (animated == mAnimated)
        return;
    if (!animated) {
        mValue.Reset(GetValue(CurrentTime()));
        mKeys.clear();
    } else if (mKeys.empty() && mValue) {
        mKeys.emplace(CurrentTime(), AutoRef<Parameter>(mValue->Clone()));
    }
    mAnimated = animated;
    Notify();
}

bool Input::Animate(bool animated)
{
    OrbaneDoc *doc = GetDoc();
    if (animated == mAnimated || !doc) {
        if (animated == mAnimated)
            return false;
        SetAnimated(animated);
        return true;
    }
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    UndoRecorder &recorder = doc->Recorder();
    const float64 now = CurrentTime();
    doc->StartUndo(animated ? "Animate" : "Remove Animation");
    if (animated) {
        recorder.RecordAnimated(this, true);
        if (mKeys.empty() && mValue)
            recorder.Record(this, Slot{true, now}, AutoRef<Parameter>(mValue->Clone()));
    } else {
        AutoRef<Parameter> kept(GetValue(now));
        for (const float64 time : KeyTimes())
            recorder.Record(this, Slot{true, time}, nullptr);
        recorder.RecordAnimated(this, false);
        if (kept)
            recorder.Record(this, Slot{}, std::move(kept));
    }
    doc->EndUndo();
    Notify();
    return true;
}

std::vector<float64> Input::KeyTimes() const
{
    std::vector<float64> times;
    times.reserve(mKeys.size());
    for (const auto &key : mKeys)
        times.push_back(key.first);
    return times;
}

Parameter *Input::GetKey(float64 time) const
{
    const auto it = mKeys.find(time);
    return it == mKeys.end() ? nullptr : it->second->Clone();
}

bool Input::RemoveKey(float64 time, uint32 flags)
{
    const Slot slot{true, time};
    if (!mAnimated || !Peek(slot))
        return false;
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    OrbaneDoc *doc = GetDoc();
    if (doc && !(flags & SETVALUE_NoUndo))
        doc->Recorder().Record(this, slot, nullptr);
    else
        Exchange(slot, nullptr);
    Notify();
    return true;
}

void Input::SetInterpolation(Interpolation mode)
{
    if (mode == mInterpolation)
        return;
    mInterpolation = mode;
    if (OrbaneDoc *doc = GetDoc())
        doc->MarkModified();
    if (mAnimated)
        Notify();
}

bool Input::AttachWatcher(InputWatcher *w)
{
    WriteGuard guard(*this);
    if (!w || std::find(mWatchers.begin(), mWatchers.end(), w) != mWatchers.end())
        return false;
    mWatchers.push_back(w);
    return true;
}

bool Input::DetachWatcher(InputWatcher *w)
{
    WriteGuard guard(*this);
    const auto it = std::find(mWatchers.begin(), mWatchers.end(), w);
    if (it == mWatchers.end())
        return false;
    mWatchers.erase(it);
    return true;
}

bool Input::IsWatching(InputWatcher *w) const
{
    ReadGuard guard(*this);
    return std::find(mWatchers.begin(), mWatchers.end(), w) != mWatchers.end();
}

bool Input::Accepts(const Parameter *value) const
{
    if (value && value->DataType() == mDataType)
        return true;
    std::string message = std::string("Input \"") + GetName() + "\"";
    if (mOperator)
        message += std::string(" of tool \"") + mOperator->GetName() + "\"";
    SetScriptError(message + " takes " + mDataType.str() + ", not " + (value ? value->DataType().str() : "nil"));
    return false;
}

AutoRef<Parameter> Input::Bounded(const Parameter &value) const
{
    AutoRef<Parameter> copy(value.Clone());
    if (value.DataType() != CLSID_DataType_Number)
        return copy;
    float64 &v = static_cast<Number &>(*copy).Value;
    // An absent bound does not bound; a reversed pair is ordered, as the
    // slider orders it.
    constexpr float64 kNone = std::numeric_limits<float64>::infinity();
    const float64 a = mAttrs.GetDouble(INPA_MinAllowed, -kNone), b = mAttrs.GetDouble(INPA_MaxAllowed, kNone);
    v = std::clamp(v, std::min(a, b), std::max(a, b));
    return copy;
}

bool Input::SlotFor(float64 time, Slot &slot) const
{
    if (!mAnimated) {
        slot = Slot{};
        return true;
    }
    if (time <= TIME_UNDEFINED)
        return false;
    slot = Slot{true, time};
    return true;
}

const Parameter *Input::Peek(const Slot &slot) const
{
    if (slot.expression)
        return mExpression.get();
    if (!slot.keyed)
        return mValue.get();
    const auto it = mKeys.find(slot.time);
    return it == mKeys.end() ? nullptr : it->second.get();
}

AutoRef<Parameter> Input::Exchange(const Slot &slot, AutoRef<Parameter> value)
{
    if (slot.expression)
        return ExchangeExpression(std::move(value));
    if (!slot.keyed) {
        mValue.Swap(value);
        return value;
    }
    AutoRef<Parameter> old;
    const auto it = mKeys.find(slot.time);
    if (it != mKeys.end()) {
        old = std::move(it->second);
        if (value)
            it->second = std::move(value);
        else
            mKeys.erase(it);
    } else if (value) {
        mKeys.emplace(slot.time, std::move(value));
    }
    return old;
}

} // namespace Orbane

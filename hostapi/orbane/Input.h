#pragma once

#include "orbane/AutoRef.h"
#include "orbane/LockableObject.h"
#include "orbane/OrbID.h"
#include "orbane/OrbString.h"
#include "orbane/Parameter.h"
#include "orbane/ScriptObject.h"
#include "orbane/TagList.h"

#include <map>
#include <string>
#include <vector>

namespace Orbane {

class InputWatcher;
class Operator;
class OrbaneDoc;

// How an animated Input blends between its keys. Smooth is a cubic through
// the keys whose slope at a key comes from its neighbours (non-uniform
// Catmull-Rom) and is flat at the first and last key, so the value neither
// overshoots past the ends nor jumps in speed at a key. Numbers and Points
// blend by their components; other kinds that blend (shapes) ease the blend
// factor between two keys instead (slow out of one, slow into the next).
enum class Interpolation : uint8
{
    Linear,
    Smooth,
};

// Flags of Input::SetValue.
enum SetValueFlags : uint32
{
    // Store without an undo record: the write a control makes when it is
    // unbound restores what it showed; it is no user edit.
    SETVALUE_NoUndo = 1u << 0,
};

// One parameter of a tool: an identifier, a display name, a data type, the
// attributes the tool declared it with, and a value that is either plain or
// animated (keyframes, blended between). Controls attach to it as watchers.
// Values are touched on the UI thread only; the read/write lock guards the
// watcher list, which other threads may walk.
class Input : public RefObject, public LockableObject
{
public:
    // Where a value lives: the plain value, or the keyframe at `time`.
    // The expression slot holds the expression's text (a Text), so undo
    // keeps an expression and the value it wrote in one step.
    struct Slot
    {
        bool keyed = false;
        float64 time = 0.0;
        bool expression = false;

        bool operator==(const Slot &o) const noexcept
        {
            return expression == o.expression && keyed == o.keyed && (!keyed || time == o.time);
        }
        bool operator<(const Slot &o) const noexcept
        {
            if (expression != o.expression)
                return expression < o.expression;
            return keyed != o.keyed ? keyed < o.keyed : keyed && time < o.time;
        }
    };

    // The value starts as a copy of `def` (may be null: no value yet).
    Input(Operator *tool, const OrbID &id, const char *name, const OrbID &dataType, const TagList &attrs,
          const Parameter *def);

    const OrbID &GetID() const noexcept { return mID; }
    // The display name; the identifier's text where none was given.
    const char *GetName() const noexcept { return mName.IsEmpty() ? mID.c_str() : mName.c_str(); }
    const OrbID &GetDataType() const noexcept { return mDataType; }
    const TagList &GetAttrs() const noexcept { return mAttrs; }
    // Adds attributes after the Input was made: for a tool file's tags that
    // name another Input of the tool, which exists only once all are made.
    // Set-up only: before any control reads the attributes.
    void AddAttrs(const TagList &more) { mAttrs.Append(more); }
    const Parameter *GetDefault() const noexcept { return mDefault.get(); }
    Operator *GetOperator() const noexcept { return mOperator; }
    OrbaneDoc *GetDoc() const noexcept;
    // The document's current time; 0 for an Input outside any document.
    float64 CurrentTime() const noexcept;
    const char *ScriptTypeName() const override { return "Input"; }

    // The value at `time` as a new reference (hold it in an AutoParameter),
    // or null where there is none. Animated: a key's own value at its time,
    // blended between keys, the first or last key's value beyond them.
    Parameter *GetValue(float64 time) const;
    // Stores `value` (a copy of it) at `time`: as the keyframe at `time` where
    // the Input is animated, as the plain value otherwise. Records undo in the
    // document unless `flags` has SETVALUE_NoUndo, then tells every watcher,
    // passing `tags` on. A value equal to the stored one changes nothing and
    // tells nobody. A value of another data type is refused: false, with a
    // script error naming the Input, its tool and both types.
    // A Number outside the Input's INPA_MinAllowed..INPA_MaxAllowed is stored
    // clamped, whoever writes it: a script, a comp or a control.
    // A time at or below TIME_UNDEFINED is an unset or disconnect time; on an
    // animated Input it sets nothing (a sentinel must never become a key),
    // on a plain one it sets the plain value.
    bool SetValue(Parameter *value, float64 time, uint32 flags = 0, const TagList *tags = nullptr);
    // Tells every watcher the value at the current time again.
    void Notify(const TagList *tags = nullptr);

    bool IsAnimated() const noexcept { return mAnimated; }
    // Switching on keeps existing keys, or makes one at the current time from
    // the plain value; switching off keeps the value at the current time as
    // the plain value and drops the keys. Set-up, not an edit: no undo.
    void SetAnimated(bool animated);
    // The user's switch of animation, an edit recorded for undo (in the open
    // gesture, else as a step of its own): on, it keeps existing keys or makes
    // one at the current time; off, it keeps the value at the current time as
    // the plain value. Undo brings back the keys and the plain value exactly.
    // False where the Input is already in that state.
    bool Animate(bool animated);
    // The times of the keys, earliest first.
    std::vector<float64> KeyTimes() const;
    // The value stored in the key at `time` (not blended), as a new
    // reference; null where no key is at exactly that time.
    Parameter *GetKey(float64 time) const;
    // Removes the key at `time`, with undo unless `flags` has
    // SETVALUE_NoUndo, and tells the watchers. False where there is none.
    bool RemoveKey(float64 time, uint32 flags = 0);
    // How keys blend (Linear until set). Set-up like SetAnimated, no undo
    // step; the document counts it as a change (OrbaneDoc::IsModified).
    Interpolation GetInterpolation() const noexcept { return mInterpolation; }
    void SetInterpolation(Interpolation mode);

    // Live expressions. An expression keeps a number Input's value computed
    // from the time and other Inputs ("Blur1.Size * 2 + time"); the document
    // evaluates it again when the time or an Input it names changes. A write
    // with undo (a user's or a script's edit) makes the Input plain again, in
    // the same undo step; writes without undo leave the expression in place.
    // The text, or "" where the value is plain.
    const char *GetExpression() const noexcept;
    bool HasExpression() const noexcept;
    // Sets the expression and stores its value at once (null or "" removes
    // it, keeping the value). With undo unless `flags` has SETVALUE_NoUndo:
    // expression and value are one step. Refused (false, `why` filled,
    // nothing changed) where the text does not parse, names no number Input,
    // would close a cycle, or this Input is animated or holds no number.
    bool SetExpression(const char *text, uint32 flags = 0, std::string *why = nullptr);
    // Why a kept expression is not evaluated now ("" where it is): an Input
    // it names was removed, a cycle came in through loading, the Input was
    // animated since, or the result is not a number.
    const char *GetExpressionError() const noexcept { return mExpressionError.c_str(); }

    // Watchers are told in the order they were attached. Returns false for a
    // null watcher or one already attached (or, on detach, not attached).
    bool AttachWatcher(InputWatcher *w);
    bool DetachWatcher(InputWatcher *w);
    // Hold ReadLock (or a ReadGuard) while walking this list.
    const std::vector<InputWatcher *> &Watchers() const noexcept { return mWatchers; }

protected:
    ~Input() override;

private:
    friend class Operator;
    friend class ChangeSet;
    friend class UndoRecorder;
    friend class ExpressionGraph;

    bool Accepts(const Parameter *value) const;
    // A copy of `value` as it is stored: Numbers clamped to the allowed range.
    AutoRef<Parameter> Bounded(const Parameter &value) const;
    bool SlotFor(float64 time, Slot &slot) const;
    const Parameter *Peek(const Slot &slot) const;
    // Puts `value` into `slot` (null removes a key) and returns what was
    // there, without undo or notification.
    AutoRef<Parameter> Exchange(const Slot &slot, AutoRef<Parameter> value);
    bool IsWatching(InputWatcher *w) const;
    // SetValue without the hand-over from an expression to the plain value.
    bool StoreValue(Parameter *value, float64 time, uint32 flags, const TagList *tags);
    // Stores the expression slot, with undo unless `flags` has SETVALUE_NoUndo.
    void StoreExpression(const char *text, uint32 flags);
    // Tells the document's expressions that this Input's value changed.
    void ValueChanged();
    AutoRef<Parameter> ExchangeExpression(AutoRef<Parameter> text);
    void ForgetOperator() noexcept { mOperator = nullptr; }

    OrbID mID;
    OrbString mName;
    OrbID mDataType;
    TagList mAttrs;
    Operator *mOperator;
    AutoRef<Parameter> mDefault;
    AutoRef<Parameter> mValue;
    std::map<float64, AutoRef<Parameter>> mKeys;
    bool mAnimated = false;
    Interpolation mInterpolation = Interpolation::Linear;
    AutoRef<Parameter> mExpression; // a Text, or null: the value is plain
    std::string mExpressionError;
    std::vector<InputWatcher *> mWatchers;
};

} // namespace Orbane

// The live expression of an Input: kept in its own undo slot, evaluated by
// the document's ExpressionGraph.

#include "orbane/Input.h"

#include "ExpressionGraph.h"
#include "UndoRecorder.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <cstring>

namespace Orbane {

namespace {

const Input::Slot kExpressionSlot{false, 0.0, true};

} // namespace

const char *Input::GetExpression() const noexcept
{
    return mExpression ? static_cast<const Text *>(mExpression.get())->Value.c_str() : "";
}

bool Input::HasExpression() const noexcept
{
    return mExpression.IsValid();
}

bool Input::SetExpression(const char *text, uint32 flags, std::string *why)
{
    const bool remove = !text || !*text;
    if (remove ? !HasExpression() : std::strcmp(text, GetExpression()) == 0)
        return true;
    float64 value = 0.0;
    OrbaneDoc *doc = GetDoc();
    std::string error;
    if (remove)
        ;
    else if (mDataType != CLSID_DataType_Number)
        error = "holds no number";
    else if (mAnimated)
        error = "is animated: its keys set the value";
    else if (!doc)
        error = "is in no document";
    else
        error = doc->Expressions().Try(this, text, &value);
    if (!error.empty()) {
        if (why)
            *why = std::string("Input \"") + GetID().c_str() + "\": " + error;
        return false;
    }
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    const bool undo = doc && !(flags & SETVALUE_NoUndo);
    if (undo)
        doc->StartUndo((std::string(remove ? "Remove Expression " : "Expression ") + GetName()).c_str());
    StoreExpression(remove ? nullptr : text, flags);
    if (!remove) {
        AutoNumber number(value);
        StoreValue(number, CurrentTime(), flags, nullptr);
    }
    // Controls show the expression even where the value stayed the same.
    Notify();
    if (undo)
        doc->EndUndo(true);
    if (doc)
        doc->Expressions().Settle();
    return true;
}

void Input::StoreExpression(const char *text, uint32 flags)
{
    AutoRef<Parameter> param(text ? new Text(text) : nullptr);
    OrbaneDoc *doc = GetDoc();
    if (doc && !(flags & SETVALUE_NoUndo))
        doc->Recorder().Record(this, kExpressionSlot, std::move(param));
    else
        Exchange(kExpressionSlot, std::move(param));
}

AutoRef<Parameter> Input::ExchangeExpression(AutoRef<Parameter> text)
{
    mExpression.Swap(text);
    if (!mExpression)
        mExpressionError.clear();
    if (OrbaneDoc *doc = GetDoc())
        doc->Expressions().Invalidate();
    return text;
}

void Input::ValueChanged()
{
    if (OrbaneDoc *doc = GetDoc())
        doc->Expressions().ValueChanged(this);
}

// A user's or a script's write takes the Input over from its expression, in
// the same undo step; writes without undo (the graph's own, a control's
// disconnect) leave the expression in place.
bool Input::SetValue(Parameter *value, float64 time, uint32 flags, const TagList *tags)
{
    OrbaneDoc *doc = GetDoc();
    if (!HasExpression() || (flags & SETVALUE_NoUndo) || !doc || !Accepts(value))
        return StoreValue(value, time, flags, tags);
    const AutoRef<Input> self = AutoRef<Input>::Share(this);
    doc->StartUndo((std::string("Change ") + GetName()).c_str());
    StoreExpression(nullptr, flags);
    const bool ok = StoreValue(value, time, flags, tags);
    Notify();
    doc->EndUndo(true);
    return ok;
}

} // namespace Orbane

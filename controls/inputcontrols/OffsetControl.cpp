#include "inputcontrols/OffsetControl.h"

#include "framework/OffsetTags.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/Point.h"
#include "orbane/TimeCodeEdit.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Offset.Layout";

} // namespace

OffsetControl::OffsetControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mEditX(MakeEdit("x")), mEditY(MakeEdit("y"))
{
    mDecimals = std::max(-1, tags.GetInt(OFC_Decimals, mDecimals));
    mDragStep = tags.GetDouble(OFCD_DragStep, mDragStep);
    AddAttr(OFC_Decimals, &mDecimals, Attr_CopyAndList);
    AddAttr(OFCD_DragStep, &mDragStep, Attr_CopyAndList);
    Label()->setFocusProxy(mEditX);
    ClassLayout(kLayoutItem);
}

OffsetControl::~OffsetControl() = default;

TimeCodeEdit *OffsetControl::MakeEdit(const char *name)
{
    auto *edit = new TimeCodeEdit(this);
    edit->setObjectName(name);
    edit->SetVirtual(true);
    connect(edit, SIGNAL(editingFinished()), this, SLOT(OnTyped()));
    connect(edit, SIGNAL(digitChanged(TimeCodeEdit *)), this, SLOT(OnTyped()));
    connect(edit, SIGNAL(StartDrag(TimeCodeEdit *)), this, SLOT(OnStartDrag(TimeCodeEdit *)));
    connect(edit, SIGNAL(Drag(float64, TimeCodeEdit *)), this, SLOT(OnDrag(float64, TimeCodeEdit *)));
    connect(edit, SIGNAL(EndDrag(TimeCodeEdit *)), this, SLOT(OnEndDrag(TimeCodeEdit *)));
    RegisterChild(name, edit);
    return edit;
}

bool OffsetControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    mDecimals = std::max(-1, tags.GetInt(OFC_Decimals, mDecimals));
    mDragStep = tags.GetDouble(OFCD_DragStep, mDragStep);
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool OffsetControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (GetCurrentInput()) {
        const AutoPoint now(GetCurrentInput(), GetCurrentTime());
        if (now) {
            mX = now->X;
            mY = now->Y;
        }
    }
    ShowValue();
    Label()->show();
    mEditX->show();
    mEditY->show();
    // A point has no number expression of its own: the boxes evaluate
    // what is typed into them.
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

void OffsetControl::ShowValue()
{
    // The box being typed into keeps the user's text.
    if (!mEditX->hasFocus() || mEditX->IsDragging())
        mEditX->SetValue(mX, mDecimals);
    if (!mEditY->hasFocus() || mEditY->IsDragging())
        mEditY->SetValue(mY, mDecimals);
}

bool OffsetControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *point = dynamic_cast<const Point *>(value);
    if (!point)
        return value ? true : LabelledInputControl::NotifyChanged(input, value, tags);
    if (std::fabs(point->X - mX) <= kSamePoint && std::fabs(point->Y - mY) <= kSamePoint)
        return true;
    mX = point->X;
    mY = point->Y;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool OffsetControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void OffsetControl::Write(float64 x, float64 y)
{
    mX = x;
    mY = y;
    SetInputs(AutoPoint(x, y), GetCurrentTime(), 0, false, nullptr);
    // The write's notice finds the point already cached: show it here.
    ShowValue();
}

void OffsetControl::OnTyped()
{
    auto *edit = qobject_cast<TimeCodeEdit *>(sender());
    bool ok = false;
    const float64 typed = edit ? edit->GetValue(&ok) : 0.0;
    const bool isX = edit == mEditX;
    if (ok && std::fabs(typed - (isX ? mX : mY)) > kSamePoint) {
        Write(isX ? typed : mX, isX ? mY : typed);
        ResetUndo(nullptr);
    }
    // What cannot be read goes back to the value.
    if (edit)
        edit->SetValue(isX ? mX : mY, mDecimals);
}

void OffsetControl::OnStartDrag(TimeCodeEdit *edit)
{
    mAnchor = edit == mEditX ? mX : mY;
}

void OffsetControl::OnDrag(float64 dist, TimeCodeEdit *edit)
{
    const float64 v = mAnchor + mDragStep * dist;
    if (edit == mEditX)
        Write(v, mY);
    else
        Write(mX, v);
}

void OffsetControl::OnEndDrag(TimeCodeEdit *)
{
    ResetUndo(nullptr);
}

bool OffsetControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (input)
        input->SetValue(AutoPoint(mX, mY), TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

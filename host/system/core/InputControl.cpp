#include "orbane/InputControl.h"

#include "InputStateMark.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/LookPackItem.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Theme.h"

#include <QApplication>
#include <QLayout>
#include <QLineEdit>
#include <QResizeEvent>

#include <algorithm>
#include <cmath>
#include <string>

namespace Orbane {

const OrbID InputControl::ClassID("InputControl");

_InputControl::_InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags) : Object(reg, args, tags)
{
}

_InputControl::~_InputControl() = default;

InputControl::InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : _InputControl(reg, args, tags), mControlFont(Theme::ControlFont())
{
    mDisabled = GetDisabledTags(tags, false);
    // Before a subclass makes its children, so that they are born with the
    // control font instead of each being told of it again when Open sets it.
    setFont(mControlFont);
}

InputControl::~InputControl()
{
    // A gesture still open would leave the document waiting for its end.
    ResetUndo(nullptr);
    for (Input *in : mInputs) {
        in->DetachWatcher(this);
        in->DecRef();
    }
    mInputs.clear();
    // The layout only watches the children; it goes before them.
    mLayout.reset();
}

bool InputControl::GetAttrsTagList(TagList &tags) const
{
    if (const Input *in = GetCurrentInput()) {
        tags.Set(LINKS_Name, LabelOf(in));
        tags.Set(LINKS_SecondName, SecondLabelOf(in));
    }
    tags.Set(ICA_Disabled, mDisabled);
    return true;
}

bool InputControl::SetAttrsTagList(const TagList &tags)
{
    return SetAttrsTagList(GetCurrentInput(), tags);
}

QList<Input *> InputControl::GetInputsAt(const QPoint &pos) const
{
    QList<Input *> found;
    if (rect().contains(pos))
        for (Input *in : mInputs)
            found.append(in);
    return found;
}

bool InputControl::SetAttrsTagList(Input *, const TagList &tags)
{
    SetDisabled(GetDisabledTags(tags, mDisabled));
    return true;
}

bool InputControl::Open(QWidget *host, const QRect &rect, const TagList *)
{
    if (host && parentWidget() != host)
        setParent(host);
    if (rect.isValid())
        setGeometry(rect);
    setFont(mControlFont);
    setEnabled(!mDisabled);
    mOpen = true;
    InputStateMark::Update(this, GetCurrentInput());
    if (host)
        show();
    return true;
}

void InputControl::Close(const TagList *)
{
    ResetUndo(nullptr);
    mOpen = false;
    hide();
}

QSize InputControl::GetMinSize(const TagList *) const
{
    if (mLayout)
        return mLayout->minimumSize();
    return layout() ? layout()->minimumSize() : minimumSizeHint();
}

QSize InputControl::GetMaxSize(const TagList *) const
{
    if (mLayout)
        return mLayout->maximumSize();
    return layout() ? layout()->maximumSize() : maximumSize();
}

bool InputControl::SetSize(int32 &width, int32 &height, const TagList *)
{
    width = std::max(width, 0);
    if (mLayout)
        height = mLayout->Arrange(width);
    else if (layout())
        height = layout()->hasHeightForWidth() ? layout()->heightForWidth(width) : layout()->sizeHint().height();
    mArrangedWidth = width;
    mArrangedHeight = height;
    resize(width, height);
    updateGeometry();
    return true;
}

bool InputControl::AttachInput(Input *input, const TagList *)
{
    return input && input->AttachWatcher(this);
}

bool InputControl::DetachInput(Input *input, const TagList *)
{
    return input && input->DetachWatcher(this);
}

bool InputControl::AddInput(Input *input, const TagList *tags)
{
    if (!input || std::find(mInputs.begin(), mInputs.end(), input) != mInputs.end())
        return false;
    input->IncRef();
    mInputs.push_back(input);
    AttachInput(input, tags);
    SyncExpression(input);
    return true;
}

bool InputControl::RemoveInput(Input *input, const TagList *tags)
{
    const auto it = std::find(mInputs.begin(), mInputs.end(), input);
    if (it == mInputs.end())
        return false;
    const auto index = std::size_t(it - mInputs.begin());
    DetachInput(input, tags);
    mInputs.erase(it);
    if (index < mExpressions.size())
        mExpressions.erase(mExpressions.begin() + std::ptrdiff_t(index));
    if (index < mExpressionEdits.size()) {
        delete mExpressionEdits[index].data();
        mExpressionEdits.erase(mExpressionEdits.begin() + std::ptrdiff_t(index));
    }
    if (index < mShown.size())
        mShown.erase(mShown.begin() + std::ptrdiff_t(index));
    input->DecRef();
    return true;
}

bool InputControl::IsLocked() const
{
    return std::any_of(mInputs.begin(), mInputs.end(),
                       [](const Input *in) { return in->GetOperator() && in->GetOperator()->IsLocked(); });
}

bool InputControl::SetInputs(Parameter *value, float64 time, uint32 flags, bool quiet, const TagList *tags)
{
    if (!value || mInputs.empty() || IsLocked())
        return false;
    OpenUndo();
    // Watchers told of the write may unbind Inputs from this control.
    std::vector<AutoRef<Input>> inputs;
    for (Input *in : mInputs)
        inputs.push_back(AutoRef<Input>::Share(in));
    const bool wasQuiet = std::exchange(mQuietWrite, quiet);
    bool ok = true;
    for (const AutoRef<Input> &in : inputs)
        ok = in->SetValue(value, time, flags, tags) && ok;
    mQuietWrite = wasQuiet;
    return ok;
}

void InputControl::OpenUndo()
{
    if (mUndoOpen)
        return;
    OrbaneDoc *doc = GetDoc();
    if (!doc)
        return;
    doc->StartUndo(UndoName().c_str());
    mUndoDoc = doc;
    mUndoOpen = true;
}

void InputControl::ResetUndo(const TagList *)
{
    if (!mUndoOpen)
        return;
    mUndoOpen = false;
    mUndoName = OrbString();
    if (mUndoDoc)
        mUndoDoc->EndUndo(true);
    mUndoDoc = nullptr;
}

OrbString InputControl::UndoName() const
{
    if (!mUndoName.IsEmpty())
        return mUndoName;
    const Input *in = GetCurrentInput();
    return OrbString("Change " + LabelOf(in).str());
}

void InputControl::SetUndo(const char *name, const TagList *)
{
    mUndoName = OrbString(name);
}

bool InputControl::NotifyChanged(Input *input, Parameter *, const TagList *tags)
{
    return UpdateDisplay(input, tags);
}

bool InputControl::UpdateDisplay(Input *, const TagList *)
{
    if (mOpen)
        setEnabled(!mDisabled);
    // Children repaint themselves when a control hands them a new value; the
    // base repaints only the control's own face. Repainting every child here
    // cost most of a slider drag's time.
    update();
    return true;
}

void InputControl::OnInputChanged(Input *input, Parameter *value, const TagList *tags)
{
    SyncExpression(input);
    if (!mQuietWrite)
        NotifyChanged(input, value, tags);
    if (input == GetCurrentInput())
        InputStateMark::Update(this, input, value);
}

bool InputControl::OnConnect(Input *input, const TagList *)
{
    return input && std::find(mInputs.begin(), mInputs.end(), input) != mInputs.end();
}

bool InputControl::OnDisconnect(Input *input, const TagList *tags)
{
    return RemoveInput(input, tags);
}

bool InputControl::HasFocus() const
{
    const QWidget *focus = QApplication::focusWidget();
    return focus && (focus == this || isAncestorOf(focus));
}

Input *InputControl::GetInputFrom(const QWidget *child) const
{
    const int32 index = IndexOf(child);
    if (index >= 0 && std::size_t(index) < mInputs.size())
        return mInputs[std::size_t(index)];
    return child && (child == this || isAncestorOf(child)) ? GetCurrentInput() : nullptr;
}

bool InputControl::CreateLayout(const ScriptVal &description, bool replace, void *hook)
{
    if ((mLayout && !replace) || hook)
        return false;
    mLayout = Layout::Container::Create(description, mChildren);
    // Fields made for an earlier layout move to the new one's place.
    if (Layout::LayoutObj *where = FindLayoutObj("expression"))
        if (Layout::Container *box = where->AsContainer())
            for (std::size_t i = 0; i < mExpressionEdits.size(); ++i)
                if (mExpressionEdits[i])
                    box->AddWidget(OrbID("expression." + std::to_string(i)), mExpressionEdits[i]);
    return true;
}

bool InputControl::LoadLayout(const char *itemName)
{
    return CreateLayout(ReadLayoutItem(itemName), true, nullptr);
}

Layout::LayoutObj *InputControl::FindLayoutObj(const char *name) const
{
    return mLayout && name ? mLayout->Find(OrbID(name)) : nullptr;
}

void InputControl::RegisterChild(const char *name, QWidget *child)
{
    if (name)
        mChildren.Register(OrbID(name), child);
}

ScriptVal InputControl::ReadLayoutItem(const char *itemName)
{
    if (!itemName)
        return ScriptVal();
    const ScriptVal *description = LookPackItem(OrbID(itemName)).GetItemData().FindKeyConst(ScriptVal(1));
    return description ? *description : ScriptVal();
}

bool InputControl::HasValueChanged(bool integer, float64 value, float64 current, float64 tolerance)
{
    if (integer)
        return std::floor(value + 0.5) != std::floor(current + 0.5);
    return std::fabs(value - current) > tolerance;
}

bool InputControl::GetDisabledTags(const TagList &tags, bool current)
{
    return tags.GetBool(ICA_Disabled, current);
}

OrbString InputControl::LabelOf(const Input *input)
{
    if (!input)
        return OrbString();
    const TagList &attrs = input->GetAttrs();
    if (const char *text = attrs.GetString(LINKS_Name))
        return OrbString(text);
    if (const char *text = attrs.GetString(INPA_Name))
        return OrbString(text);
    return OrbString(input->GetID().c_str());
}

OrbString InputControl::SecondLabelOf(const Input *input)
{
    return input ? OrbString(input->GetAttrs().GetString(LINKS_SecondName, "")) : OrbString();
}

QColor InputControl::GetBackgroundColor() const
{
    return palette().color(QPalette::Window);
}

OrbaneDoc *InputControl::GetDoc() const
{
    for (const Input *in : mInputs)
        if (OrbaneDoc *doc = in->GetDoc())
            return doc;
    return nullptr;
}

float64 InputControl::GetCurrentTime() const
{
    const OrbaneDoc *doc = GetDoc();
    return doc ? doc->GetCurrentTime() : 0.0;
}

void InputControl::SetDisabled(bool disabled)
{
    mDisabled = disabled;
}

bool InputControl::AllInputsPassive() const
{
    return std::all_of(mInputs.begin(), mInputs.end(),
                       [](const Input *in) { return in->GetAttrs().GetBool(ICA_Passive, false); });
}

bool InputControl::hasHeightForWidth() const
{
    return mLayout != nullptr;
}

int InputControl::heightForWidth(int width) const
{
    return mLayout ? mLayout->HeightForWidth(width) : QWidget::heightForWidth(width);
}

QSize InputControl::sizeHint() const
{
    if (mArrangedWidth >= 0)
        return QSize(mArrangedWidth, mArrangedHeight);
    return mLayout ? mLayout->sizeHint() : QWidget::sizeHint();
}

void InputControl::resizeEvent(QResizeEvent *event)
{
    QWidget::resizeEvent(event);
    // A parent layout may give another width than SetSize did: place the
    // children for the width the control really has.
    if (mLayout && event->size().width() != mArrangedWidth) {
        mArrangedWidth = event->size().width();
        mArrangedHeight = mLayout->HeightForWidth(mArrangedWidth);
        mLayout->Place(QRect(QPoint(0, 0), event->size()));
    }
    if (event->size().height() != event->oldSize().height())
        InputStateMark::Update(this, GetCurrentInput());
}

void InputControl::Relayout()
{
    if (!mOpen || mArrangedWidth < 0)
        return;
    int32 width = mArrangedWidth;
    int32 height = mArrangedHeight;
    SetSize(width, height, nullptr);
}

} // namespace Orbane

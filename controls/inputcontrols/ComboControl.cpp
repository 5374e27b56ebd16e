#include "inputcontrols/ComboControl.h"

#include "framework/ComboTags.h"

#include "orbane/ClassIDs.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/OrbComboBox.h"
#include "orbane/Registry.h"

namespace Orbane {

namespace {

enum LabelPosition : int32
{
    Label_Horizontal = 0,
    Label_Vertical = 1,
};

// The class layout description of a label position.
const char *LayoutItemFor(int32 labelPosition)
{
    return labelPosition == Label_Vertical ? "Controls.Combo.Layout.Vertical" : "Controls.Combo.Layout.Horizontal";
}

QString ToQString(const OrbString &s)
{
    return QString::fromStdString(s.str());
}

} // namespace

ComboControl::ComboControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mChoice(ItemChoice::IsIDVariant(reg, CLSID_InputControl_Combo)),
      mCombo(new OrbComboBox(this))
{
    mLabelPosition =
        tags.GetInt(CC_LabelPosition, Label_Horizontal) == Label_Vertical ? Label_Vertical : Label_Horizontal;
    mAlphaSort = tags.GetBool(CC_AlphaSort, false);
    AddAttr(CC_LabelPosition, &mLabelPosition, Attr_CopyAndList);
    AddAttr(CC_AlphaSort, &mAlphaSort, Attr_CopyAndList);
    mCombo->setObjectName("combo");
    connect(mCombo, SIGNAL(activated(int)), this, SLOT(OnCombo(int)));
    connect(mCombo, SIGNAL(highlighted(int)), this, SLOT(TestCombo(int)));
    connect(mCombo, SIGNAL(popupShow()), this, SLOT(PopupShow()));
    connect(mCombo, SIGNAL(popupHide()), this, SLOT(PopupHide()));
    RegisterChild("combo", mCombo);
    Label()->setFocusProxy(mCombo);
    // Each description is read when the first instance that places its
    // label that way is made.
    ClassLayout(LayoutItemFor(mLabelPosition));
}

ComboControl::~ComboControl() = default;

bool ComboControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    if (tags.FindQuery(CC_AlphaSort) && tags.GetBool(CC_AlphaSort, mAlphaSort) != mAlphaSort) {
        mAlphaSort = !mAlphaSort;
        FillRows();
    }
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ComboControl::AddInput(Input *input, const TagList *tags)
{
    // The items belong to the first Input; further ones share them.
    if (IsFirstInput(input)) {
        mChoice.Read(input);
        FillRows();
    }
    return BindKeepingFirstTexts(input, tags);
}

void ComboControl::FillRows()
{
    mCombo->clear();
    for (int32 index : mChoice.Items().RowOrder(mAlphaSort)) {
        const std::size_t i = std::size_t(index);
        if (mChoice.Items().IsSeparator(index))
            mCombo->AddSeparator(index);
        else
            mCombo->AddItem(ToQString(mChoice.Items().Texts[i]), index, ToQString(mChoice.Items().SecondTexts[i]));
    }
    ShowSelection();
}

bool ComboControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    mSelection = mChoice.SelectionAt(GetCurrentInput(), GetCurrentTime(), mSelection);
    ShowSelection();
    ShowChild(Label());
    ShowChild(mCombo);
    // Only a number can come from a typed expression.
    PlaceChildren(ClassLayout(LayoutItemFor(mLabelPosition)), !IsIDVariant());
    return true;
}

void ComboControl::ShowTexts()
{
    Label()->setText(ToQString(GetLabelTexts().label));
    Label()->setToolTip(ToQString(GetLabelTexts().second));
}

// A selected separator has no row text to show: the drop-down shows none.
void ComboControl::ShowSelection()
{
    mCombo->ShowItem(mChoice.Items().IsSeparator(mSelection) ? -1 : mSelection);
}

bool ComboControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (value && !mChoice.Follow(value, mSelection))
        return true;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ComboControl::UpdateDisplay(Input *input, const TagList *tags)
{
    // A preview leaves the list and the texts as they are: the user is
    // still choosing.
    if (mPreviewing)
        return InputControl::UpdateDisplay(input, tags);
    if (IsOpen())
        ShowSelection();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

bool ComboControl::Write(int32 index, float64 time)
{
    const AutoParameter value = mChoice.ValueOf(index);
    const TagList tags = mChoice.ItemTags(index);
    return SetInputs(value, time, 0, false, tags.IsEmpty() ? nullptr : &tags);
}

void ComboControl::Select(int row, bool final)
{
    const int32 index = mCombo->ItemIndexOf(row);
    if (mChoice.IsChoosable(index) && index != mSelection) {
        mSelection = index;
        mPreviewing = !final;
        Write(index, GetCurrentTime());
        mPreviewing = false;
    }
    // Every write opens the gesture's undo step; a choice closes it, so the
    // previews before it and the choice are one step. A choice of the item
    // already previewed writes nothing but still ends the gesture.
    if (final) {
        ResetUndo(nullptr);
        mGesture = false;
    }
}

void ComboControl::OnCombo(int row)
{
    Select(row, true);
}

void ComboControl::TestCombo(int row)
{
    if (mLivePreview)
        Select(row, false);
}

void ComboControl::PopupShow()
{
    mLivePreview = true;
    mGesture = true;
    Input *in = GetCurrentInput();
    mBeforePopup = AutoParameter(in ? in->GetValue(GetCurrentTime()) : nullptr);
}

void ComboControl::PopupHide()
{
    // The list hides before the choice is reported: decide once both are in.
    QMetaObject::invokeMethod(this, "EndPopup", Qt::QueuedConnection);
}

void ComboControl::EndPopup()
{
    mLivePreview = false;
    // Closed without a choice (Escape, a click elsewhere): the previews go,
    // and the gesture then changed nothing, so it leaves no undo step.
    if (mGesture) {
        mGesture = false;
        if (IsUndoOpen() && mBeforePopup)
            SetInputs(mBeforePopup, GetCurrentTime(), 0, false, nullptr);
        ResetUndo(nullptr);
    }
    mBeforePopup = AutoParameter();
}

bool ComboControl::OnDisconnect(Input *input, const TagList *tags)
{
    // The identifier variant has no identifier to write without a choice.
    if (!IsIDVariant() || mChoice.Items().IsItem(mSelection)) {
        const bool gestureOpen = IsUndoOpen();
        Write(mSelection, TIME_DISCONNECT);
        if (!gestureOpen)
            ResetUndo(nullptr);
    }
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

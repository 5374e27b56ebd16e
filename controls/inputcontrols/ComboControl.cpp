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
    : LabelledInputControl(reg, args, tags), mCombo(new OrbComboBox(this))
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

bool ComboControl::IsIDVariant() const
{
    const Registry *reg = GetRegistry();
    return reg && reg->ClassID() != CLSID_InputControl_Combo;
}

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
    if (input && !GetCurrentInput()) {
        mIsText = input->GetDataType() == CLSID_DataType_Text;
        {
            const LockableObject::ReadGuard guard(*input);
            mItems.Read(input->GetAttrs());
        }
        FillRows();
    }
    // The host's AddInput, not the base's: the texts, too, are the first Input's.
    if (!InputControl::AddInput(input, tags))
        return false;
    if (GetCurrentInput() == input)
        ReadTexts(input);
    return true;
}

void ComboControl::FillRows()
{
    mCombo->clear();
    for (int32 index : mItems.RowOrder(mAlphaSort)) {
        const std::size_t i = std::size_t(index);
        if (mItems.IsSeparator(index))
            mCombo->AddSeparator(index);
        else
            mCombo->AddItem(ToQString(mItems.Texts[i]), index, ToQString(mItems.SecondTexts[i]));
    }
    ShowSelection();
}

bool ComboControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        if (now)
            mSelection = SelectionFor(now);
    }
    ShowSelection();
    Label()->show();
    mCombo->show();
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
    mCombo->ShowItem(mItems.IsSeparator(mSelection) ? -1 : mSelection);
}

int32 ComboControl::SelectionFor(const Parameter *value) const
{
    if (!IsIDVariant()) {
        const auto *number = dynamic_cast<const Number *>(value);
        return number ? mItems.Nearest(number->Value) : -1;
    }
    if (mIsText) {
        const auto *text = dynamic_cast<const Text *>(value);
        return text ? mItems.FindID(OrbID(text->Value.str())) : -1;
    }
    const auto *id = dynamic_cast<const OrbIDParam *>(value);
    return id ? mItems.FindID(id->Value) : -1;
}

bool ComboControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const int32 selection = SelectionFor(value);
    if (selection == mSelection)
        return true;
    mSelection = selection;
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

AutoParameter ComboControl::ValueOf(int32 index) const
{
    const std::size_t i = std::size_t(index);
    if (!IsIDVariant())
        return AutoParameter(AutoNumber(index >= 0 && i < mItems.Values.size() ? mItems.Values[i] : 0.0));
    const AutoOrbIDParam id(mItems.IsItem(index) ? mItems.IDs[i] : OrbID());
    if (mIsText)
        return AutoParameter(AutoText(OrbString(id->Value.str())));
    return AutoParameter(id);
}

TagList ComboControl::ItemTags(int32 index) const
{
    TagList tags;
    if (!mItems.IsItem(index))
        return tags;
    if (const int64 integer = mItems.Integers[std::size_t(index)])
        tags.Set(CCA_ItemInteger, TagValue(static_cast<long long>(integer)));
    if (void *pointer = mItems.Pointers[std::size_t(index)])
        tags.Set(CCAP_ItemPointer, pointer);
    return tags;
}

bool ComboControl::Write(int32 index, float64 time)
{
    const AutoParameter value = ValueOf(index);
    const TagList tags = ItemTags(index);
    return SetInputs(value, time, 0, false, tags.IsEmpty() ? nullptr : &tags);
}

void ComboControl::Select(int row, bool final)
{
    const int32 index = mCombo->ItemIndexOf(row);
    if (mItems.IsItem(index) && !mItems.IsSeparator(index) && index != mSelection) {
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
    if (!IsIDVariant() || mItems.IsItem(mSelection)) {
        const bool gestureOpen = IsUndoOpen();
        Write(mSelection, TIME_DISCONNECT);
        if (!gestureOpen)
            ResetUndo(nullptr);
    }
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

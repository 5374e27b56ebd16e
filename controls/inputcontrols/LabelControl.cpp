#include "inputcontrols/LabelControl.h"

#include "framework/LabelTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/LookTags.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbColor.h"
#include "orbane/ParameterPanel.h"
#include "orbane/Registry.h"

#include <QFrame>
#include <QMouseEvent>
#include <QToolButton>
#include <QVariant>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Label.Layout";

LabelControl::Variant VariantOf(const Registry *reg)
{
    const OrbID id = reg ? reg->ClassID() : CLSID_InputControl_Label;
    if (id == CLSID_InputControl_Nest)
        return LabelControl::Variant_Nest;
    if (id == CLSID_InputControl_Separator)
        return LabelControl::Variant_Separator;
    if (id == CLSID_InputControl_Spacer)
        return LabelControl::Variant_Spacer;
    return LabelControl::Variant_Label;
}

// Does the Input show a header that folds? Read from its attributes, so
// that Ctrl-click reaches the groups whose controls are not built yet.
bool IsFoldingHeader(const Input *input)
{
    const TagList &attrs = input->GetAttrs();
    for (const TagItem *item = attrs.Find(INPA_InputControl); item; item = attrs.FindNext(item)) {
        if (item->id == CLSID_InputControl_Nest)
            return true;
        if (item->id == CLSID_InputControl_Label && attrs.GetBool(LBLC_DropDownButton, false))
            return true;
    }
    return false;
}

} // namespace

LabelControl::LabelControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mVariant(VariantOf(reg)), mTextColor(OrbColor::None),
      mLineColor(OrbColor::None), mHeader(new QToolButton(this)), mLine(new QFrame(this)), mSpace(new QWidget(this))
{
    mExpanded = tags.GetBool(LBLC_Expanded, true);
    ReadLook(tags);
    AddAttr(LBLC_DropDownButton, &mDropDown, Attr_CopyAndList);
    AddAttr(LBLC_NumInputs, &mNumInputs, Attr_CopyAndList);
    AddAttr(LBLC_NestLevel, &mNestLevel, Attr_CopyAndList);
    AddAttr(LBLC_Expanded, &mExpanded, Attr_CopyAndList);
    AddAttr(LBLC_Align, &mAlign, Attr_CopyAndList);
    AddAttr(LBLC_Bold, &mBold, Attr_CopyAndList);
    AddAttr(LBLC_Height, &mHeight, Attr_CopyAndList);
    AddAttr(LBLC_TextColor, &mTextColor, Attr_CopyAndList);
    AddAttr(LBLC_LineColor, &mLineColor, Attr_CopyAndList);
    ListAttr(LBLCS_Tooltip, &mTooltip);
    mHeader->setObjectName("header");
    mHeader->setAutoRaise(true);
    mHeader->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    mHeader->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    mHeader->installEventFilter(this);
    connect(mHeader, SIGNAL(clicked()), this, SLOT(OnHeaderClicked()));
    mLine->setObjectName("line");
    mLine->setFrameShape(QFrame::HLine);
    mLine->setFrameShadow(QFrame::Plain);
    mSpace->setObjectName("space");
    auto *indent = new QWidget(this);
    indent->setObjectName("indent");
    RegisterChild("indent", indent);
    RegisterChild("header", mHeader);
    RegisterChild("line", mLine);
    RegisterChild("space", mSpace);
    Label()->setFocusProxy(mHeader);
    ClassLayout(kLayoutItem);
}

LabelControl::~LabelControl() = default;

bool LabelControl::Folds() const
{
    return mVariant == Variant_Nest || (mVariant == Variant_Label && mDropDown);
}

void LabelControl::ReadLook(const TagList &tags)
{
    mDropDown = tags.GetBool(LBLC_DropDownButton, mDropDown);
    mNumInputs = std::max(0, tags.GetInt(LBLC_NumInputs, mNumInputs));
    mNestLevel = std::max(0, tags.GetInt(LBLC_NestLevel, mNestLevel));
    mAlign = tags.GetInt(LBLC_Align, mAlign);
    mBold = tags.GetBool(LBLC_Bold, mBold);
    mHeight = std::max(0, tags.GetInt(LBLC_Height, mHeight));
    mTextColor = uint32(tags.GetLong(LBLC_TextColor, mTextColor));
    mLineColor = uint32(tags.GetLong(LBLC_LineColor, mLineColor));
    if (const char *tip = tags.GetString(LBLCS_Tooltip))
        mTooltip = OrbString(tip);
}

bool LabelControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadLook(tags);
    if (IsOpen())
        ApplyLook();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

void LabelControl::ApplyLook()
{
    const bool text = mVariant == Variant_Label || mVariant == Variant_Nest;
    mHeader->setVisible(Folds());
    Label()->setVisible(text && !Folds());
    mLine->setVisible(mVariant == Variant_Separator);
    mSpace->setVisible(mVariant == Variant_Spacer);
    mLine->setFixedHeight(std::max(1, mHeight));
    mSpace->setFixedHeight(mHeight);
    if (QWidget *indent = findChild<QWidget *>("indent")) {
        indent->setFixedWidth(mNestLevel * kIndentStep);
        indent->setVisible(text && mNestLevel > 0);
    }
    LookTags::SetBold(mHeader, mBold);
    LookTags::SetBold(Label(), mBold);
    LookTags::SetTextColor(mHeader, mTextColor);
    LookTags::SetTextColor(Label(), mTextColor);
    LookTags::SetTextColor(mLine, mLineColor);
    Label()->setAlignment(LookTags::AlignmentOf(mAlign) | Qt::AlignVCenter);
    const QString tip = QString::fromStdString(mTooltip.str());
    mHeader->setToolTip(tip);
    Label()->setToolTip(tip);
}

bool LabelControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoNumber now(in, GetCurrentTime());
        if (now)
            mExpanded = std::floor(now->Value + 0.5) != 0.0;
    }
    ApplyLook();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    UpdateDisplay(nullptr, nullptr);
    return true;
}

void LabelControl::ShowTexts()
{
    const QString text = QString::fromStdString(GetLabelTexts().label.str());
    Label()->setText(text);
    mHeader->setText(text);
}

bool LabelControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return value ? true : LabelledInputControl::NotifyChanged(input, value, tags);
    const bool expanded = std::floor(number->Value + 0.5) != 0.0;
    if (expanded == mExpanded)
        return true;
    mExpanded = expanded;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool LabelControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen()) {
        mHeader->setArrowType(mExpanded ? Qt::DownArrow : Qt::RightArrow);
        ApplyFold();
    }
    return LabelledInputControl::UpdateDisplay(input, tags);
}

std::vector<Input *> LabelControl::GroupInputs() const
{
    const Input *in = GetCurrentInput();
    const Operator *tool = in ? in->GetOperator() : nullptr;
    if (!tool)
        return {};
    const std::vector<Input *> &all = tool->Inputs();
    const auto at = std::find(all.begin(), all.end(), in);
    const auto first = at == all.end() ? all.end() : at + 1;
    const auto last = first + std::min<std::ptrdiff_t>(mNumInputs, all.end() - first);
    return std::vector<Input *>(first, last);
}

// The inspector hides the group while this header is closed; the calls
// pair up, so the header's share in hiding a row is taken back exactly.
void LabelControl::ApplyFold()
{
    const bool hide = Folds() && !mExpanded;
    if (hide == mHiding)
        return;
    if (ParameterPanel *panel = ParameterPanel::Of(this)) {
        panel->HideInputs(GroupInputs(), hide);
        mHiding = hide;
    }
}

void LabelControl::SetExpanded(bool expanded)
{
    Input *in = GetCurrentInput();
    if (!in) {
        mExpanded = expanded;
        UpdateDisplay(nullptr, nullptr);
        return;
    }
    // The view changes, not the tool's result: no undo step.
    in->SetValue(AutoNumber(expanded ? 1.0 : 0.0), GetCurrentTime(), SETVALUE_NoUndo, nullptr);
}

void LabelControl::FoldAll(bool expanded)
{
    const Input *in = GetCurrentInput();
    const Operator *tool = in ? in->GetOperator() : nullptr;
    if (!tool)
        return SetExpanded(expanded);
    const AutoNumber value(expanded ? 1.0 : 0.0);
    for (Input *each : tool->Inputs())
        if (IsFoldingHeader(each))
            each->SetValue(value, GetCurrentTime(), SETVALUE_NoUndo, nullptr);
}

bool LabelControl::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == mHeader && event->type() == QEvent::MouseButtonPress)
        mPressModifiers = static_cast<QMouseEvent *>(event)->modifiers();
    return LabelledInputControl::eventFilter(watched, event);
}

void LabelControl::OnHeaderClicked()
{
    const bool ctrl = mPressModifiers & Qt::ControlModifier;
    mPressModifiers = Qt::NoModifier;
    if (ctrl)
        FoldAll(!mExpanded);
    else
        SetExpanded(!mExpanded);
}

bool LabelControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, mExpanded ? 1.0 : 0.0);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

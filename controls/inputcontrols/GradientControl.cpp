#include "inputcontrols/GradientControl.h"

#include "framework/GradientTags.h"
#include "widgets/GradientBar.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QColorDialog>
#include <QComboBox>
#include <QLineEdit>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Gradient.Layout";

} // namespace

GradientControl::GradientControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mBar(new GradientBar), mInterp(new QComboBox(this)),
      mPosition(new QLineEdit(this)), mHex(new QLineEdit(this))
{
    // Painted widgets are made without a parent, then adopted.
    mBar->setParent(this);
    mBar->SetOwner(this);
    mInterp->addItems({tr("Linear"), tr("Smooth")});
    const std::pair<const char *, QWidget *> children[] = {
        {"bar", mBar}, {"interp", mInterp}, {"position", mPosition}, {"hex", mHex}};
    for (const auto &[name, child] : children) {
        child->setObjectName(name);
        RegisterChild(name, child);
    }
    mPosition->setToolTip(tr("The selected stop's position, 0 to 1"));
    mHex->setToolTip(tr("The selected stop's colour, #RRGGBB or #RRGGBBAA"));
    connect(mBar, SIGNAL(Edited()), this, SLOT(OnBarEdited()));
    connect(mBar, SIGNAL(GestureEnded()), this, SLOT(OnBarGestureEnded()));
    connect(mBar, SIGNAL(SelectionChanged(int)), this, SLOT(OnSelectionChanged()));
    connect(mBar, SIGNAL(ColorAsked(int)), this, SLOT(OnColorAsked(int)));
    connect(mInterp, SIGNAL(activated(int)), this, SLOT(OnInterpChosen(int)));
    connect(mPosition, SIGNAL(editingFinished()), this, SLOT(OnPositionTyped()));
    connect(mHex, SIGNAL(editingFinished()), this, SLOT(OnHexTyped()));
    Label()->setFocusProxy(mBar);
    AddAttr(GRDC_ShowAlpha, &mShowAlpha, Attr_CopyAndList);
    AddAttr(GRDC_MaxStops, &mMaxStops, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

GradientControl::~GradientControl() = default;

void GradientControl::ReadOwnTags(const TagList &tags)
{
    mShowAlpha = tags.GetBool(GRDC_ShowAlpha, mShowAlpha);
    mMaxStops = std::max(GradientStops::kMinStops, tags.GetInt(GRDC_MaxStops, mMaxStops));
    mBar->SetMaxStops(mMaxStops);
}

bool GradientControl::Take(const ScriptVal &value)
{
    std::string why;
    GradientStops stops;
    const bool ok = GradientStops::FromScript(value, stops, &why);
    mStops = ok ? stops : GradientStops::Default();
    mBar->setToolTip(ok ? QString() : tr("Not a gradient (%1): showing the default").arg(QString::fromStdString(why)));
    return ok;
}

bool GradientControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool GradientControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        const auto *table = dynamic_cast<const ScriptValParam *>(now.get());
        Take(table ? table->Value : ScriptVal());
    }
    ShowChild(Label());
    for (QWidget *child : {static_cast<QWidget *>(mBar), static_cast<QWidget *>(mInterp),
                           static_cast<QWidget *>(mPosition), static_cast<QWidget *>(mHex)})
        ShowChild(child);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool GradientControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *table = dynamic_cast<const ScriptValParam *>(value);
    if (!table)
        return true;
    const GradientStops before = mStops;
    const QString tipBefore = mBar->toolTip();
    Take(table->Value);
    if (mStops == before && mBar->toolTip() == tipBefore)
        return true;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool GradientControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

GradientStops::Stop *GradientControl::SelectedStop()
{
    const int32 i = mBar->Selected();
    return i >= 0 && i < int32(mStops.stops.size()) ? &mStops.stops[size_t(i)] : nullptr;
}

void GradientControl::ShowValue()
{
    // The bar's own copy is what the user is dragging: it is not replaced midway.
    if (!mGesture.IsOpen())
        mBar->SetStops(mStops);
    mInterp->setCurrentIndex(mStops.smooth ? 1 : 0);
    if (const GradientStops::Stop *stop = SelectedStop()) {
        if (!mPosition->isModified())
            mPosition->setText(QString::number(stop->pos, 'f', 3));
        if (!mHex->isModified())
            mHex->setText(ColorMath::ToHex(stop->color, mShowAlpha));
    }
}

void GradientControl::Write(const GradientStops &stops)
{
    if (stops == mStops)
        return;
    mGesture.Write(GetCurrentInput(), AutoScriptValParam(stops.ToScript()), InputGesture::StepName(*this));
}

void GradientControl::OnBarEdited()
{
    Write(mBar->Stops());
    ShowValue();
}

void GradientControl::OnBarGestureEnded()
{
    mGesture.End();
    // A refused write (a locked tool) puts the bar back to the value.
    mBar->SetStops(mStops);
    ShowValue();
}

void GradientControl::OnSelectionChanged()
{
    mPosition->setModified(false);
    mHex->setModified(false);
    ShowValue();
}

void GradientControl::OnInterpChosen(int index)
{
    GradientStops next = mStops;
    next.smooth = index == 1;
    Write(next);
    mGesture.End();
    ShowValue();
}

void GradientControl::OnPositionTyped()
{
    if (!mPosition->isModified())
        return;
    mPosition->setModified(false);
    bool ok = false;
    const float64 pos = mPosition->text().toDouble(&ok);
    if (ok && SelectedStop()) {
        GradientStops next = mStops;
        const int32 index = next.Move(mBar->Selected(), pos);
        Write(next);
        mGesture.End();
        mBar->SetStops(mStops);
        mBar->Select(index);
    }
    ShowValue();
}

void GradientControl::OnHexTyped()
{
    if (!mHex->isModified())
        return;
    mHex->setModified(false);
    GradientStops next = mStops;
    const int32 i = mBar->Selected();
    if (i >= 0 && i < int32(next.stops.size()) && ColorMath::FromHex(mHex->text(), next.stops[size_t(i)].color)) {
        Write(next);
        mGesture.End();
    }
    ShowValue();
}

void GradientControl::OnColorAsked(int index)
{
    if (!mDialog) {
        mDialog = new QColorDialog(this);
        mDialog->setObjectName("colorDialog");
        connect(mDialog, SIGNAL(colorSelected(QColor)), this, SLOT(OnDialogChosen(QColor)));
    }
    mDialogStop = index;
    mDialog->setOption(QColorDialog::ShowAlphaChannel, mShowAlpha);
    if (index >= 0 && index < int32(mStops.stops.size()))
        mDialog->setCurrentColor(ColorMath::ToDisplay(mStops.stops[size_t(index)].color));
    mDialog->open();
}

void GradientControl::OnDialogChosen(const QColor &colour)
{
    if (mDialogStop < 0 || mDialogStop >= int32(mStops.stops.size()))
        return;
    GradientStops next = mStops;
    ColorRGBA &c = next.stops[size_t(mDialogStop)].color;
    const float64 alpha = c.a;
    c = ColorMath::FromQColor(colour);
    if (!mShowAlpha)
        c.a = alpha;
    Write(next);
    mGesture.End();
    ShowValue();
}

bool GradientControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (input)
        input->SetValue(AutoScriptValParam(mStops.ToScript()), TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

#include "inputcontrols/ColorControl.h"

#include "framework/ColorTags.h"
#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/ViewerPicker.h"
#include "widgets/ColorSwatch.h"
#include "widgets/CustomSlider.h"
#include "widgets/SkinImages.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Gradient.h"
#include "orbane/Input.h"

#include <QColorDialog>
#include <QLineEdit>
#include <QPushButton>
#include <QRegularExpression>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Color.Layout";
constexpr const char *kSliderNames[ColorControl::ChannelCount] = {"red", "green", "blue", "alpha"};
// The slider knobs of the look pack, one colour per channel.
constexpr const char *kKnobs[ColorControl::ChannelCount][2] = {{"Controls.Color.Knob.2.1", "Controls.Color.Knob.2.2"},
                                                               {"Controls.Color.Knob.3.1", "Controls.Color.Knob.3.2"},
                                                               {"Controls.Color.Knob.4.1", "Controls.Color.Knob.4.2"},
                                                               {"Controls.Color.Knob.5.1", "Controls.Color.Knob.5.2"}};
// Stops of a channel's ramp: enough that the sRGB curve between them looks smooth.
constexpr int32 kRampStops = 9;

// NaN is the same as NaN here: a value that stays NaN changes nothing.
bool Same(float64 a, float64 b)
{
    return a == b || (std::isnan(a) && std::isnan(b));
}

float64 &ChannelRef(ColorRGBA &c, int32 channel)
{
    return channel == ColorControl::Red     ? c.r
           : channel == ColorControl::Green ? c.g
           : channel == ColorControl::Blue  ? c.b
                                            : c.a;
}

QString TripleText(const ColorTriple &t, int32 model)
{
    // Hue in degrees; the rest in the units of the channels.
    return model == ColorMath::Model_YUV ? QString::asprintf("%.3f %.3f %.3f", t.c[0], t.c[1], t.c[2])
                                         : QString::asprintf("%.1f %.3f %.3f", t.c[0], t.c[1], t.c[2]);
}

} // namespace

ColorControl::ColorControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mSwatch(new ColorSwatch), mHex(new QLineEdit(this)),
      mModelButton(new QPushButton(this)), mSpace(new QLineEdit(this)), mPick(new QPushButton(tr("Pick"), this)),
      mPicker(new ViewerPicker(this))
{
    for (int32 c = 0; c < ChannelCount; ++c)
        mSliders[size_t(c)] = MakeSlider(Channel(c));
    mSwatch->setParent(this);
    mSwatch->SetOwner(this);
    const std::pair<const char *, QWidget *> children[] = {
        {"swatch", mSwatch}, {"hex", mHex}, {"model", mModelButton}, {"space", mSpace}, {"pick", mPick}};
    for (const auto &[name, child] : children) {
        child->setObjectName(name);
        RegisterChild(name, child);
    }
    mPick->setCheckable(true);
    mPick->setToolTip(tr("Click a pixel of the viewer, or drag a box to take its average"));
    mHex->setToolTip(tr("#RRGGBB or #RRGGBBAA, as the screen shows the colour"));
    connect(mSwatch, SIGNAL(DoubleClicked()), this, SLOT(OnSwatchDoubleClicked()));
    connect(mHex, SIGNAL(editingFinished()), this, SLOT(OnHexTyped()));
    connect(mSpace, SIGNAL(editingFinished()), this, SLOT(OnSpaceTyped()));
    connect(mModelButton, SIGNAL(clicked()), this, SLOT(OnModelClicked()));
    connect(mPick, SIGNAL(toggled(bool)), this, SLOT(OnPickToggled(bool)));
    connect(mPicker, SIGNAL(ArmedChanged(bool)), mPick, SLOT(setChecked(bool)));
    connect(mPicker, SIGNAL(Picked(Orbane::ColorRGBA)), this, SLOT(OnPicked(Orbane::ColorRGBA)));
    Label()->setFocusProxy(mSliders[Red]);
    AddAttr(CLRC_ColorSpace, &mModel, Attr_CopyAndList);
    AddAttr(CLRC_ShowPicker, &mShowPicker, Attr_CopyAndList);
    AddAttr(CLRCD_MaxScale, &mMaxScale, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

ColorControl::~ColorControl()
{
    for (Gradient *ramp : mRamps)
        ramp->DecRef();
}

CustomSlider *ColorControl::MakeSlider(Channel channel)
{
    // Painted widgets are made without a parent, then adopted.
    auto *slider = new CustomSlider;
    slider->setParent(this);
    slider->SetOwner(this);
    slider->setObjectName(kSliderNames[channel]);
    slider->SetKnobImage(SkinImages::Get(kKnobs[channel][0]), SkinImages::Get(kKnobs[channel][1]));
    slider->SetStepCount(100);
    mRamps[size_t(channel)] = new Gradient;
    slider->SetGradients(mRamps[size_t(channel)], nullptr);
    connect(slider, SIGNAL(ValueChanged(float64)), this, SLOT(OnSliderChanged(float64)));
    connect(slider, SIGNAL(Released(CustomController *)), this, SLOT(OnSliderReleased(CustomController *)));
    RegisterChild(kSliderNames[channel], slider);
    return slider;
}

void ColorControl::ReadOwnTags(const TagList &tags)
{
    mModel = std::clamp(tags.GetInt(CLRC_ColorSpace, mModel), 0, int32(ColorMath::Model_Count) - 1);
    mShowPicker = tags.GetBool(CLRC_ShowPicker, mShowPicker);
    const float64 scale = tags.GetDouble(CLRCD_MaxScale, mMaxScale);
    // A scale that is no positive number would leave no track: keep the old one.
    if (scale > 0.0 && std::isfinite(scale))
        mMaxScale = scale;
    for (CustomSlider *slider : mSliders)
        slider->SetScale(0.0, mMaxScale, false);
    mModelButton->setText(ColorMath::ModelName(mModel));
}

void ColorControl::LinkChannels(const TagList &tags)
{
    const std::pair<Channel, Tag> links[] = {
        {Green, CLRCP_GreenInput}, {Blue, CLRCP_BlueInput}, {Alpha, CLRCP_AlphaInput}};
    for (const auto &[channel, tag] : links)
        if (LinkInput(*this, tags, tag, mInputs[size_t(channel)]))
            ReadChannel(channel);
}

void ColorControl::ReadChannel(Channel channel)
{
    if (const AutoNumber now(mInputs[size_t(channel)], GetCurrentTime()); now)
        Value(channel) = now->Value;
}

float64 &ColorControl::Value(Channel channel)
{
    return ChannelRef(mColor, channel);
}

ColorControl::Channel ColorControl::ChannelOf(const Input *input) const
{
    for (int32 c = 0; c < ChannelCount; ++c)
        if (input && mInputs[size_t(c)] == input)
            return Channel(c);
    return ChannelCount;
}

bool ColorControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    LinkChannels(tags);
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ColorControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (first) {
        mInputs[Red] = input;
        ReadChannel(Red);
        LinkChannels(input->GetAttrs());
    }
    return true;
}

bool ColorControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    for (int32 c = 0; c < ChannelCount; ++c)
        ReadChannel(Channel(c));
    ShowChild(Label());
    for (QWidget *child : {static_cast<QWidget *>(mSwatch), static_cast<QWidget *>(mHex),
                           static_cast<QWidget *>(mModelButton), static_cast<QWidget *>(mSpace)})
        ShowChild(child);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    return true;
}

bool ColorControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *number = dynamic_cast<const Number *>(value);
    const Channel channel = ChannelOf(input ? input : GetCurrentInput());
    if (!number || channel == ChannelCount || Same(number->Value, Value(channel)))
        return true;
    Value(channel) = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ColorControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ColorControl::ShowValue()
{
    for (int32 c = 0; c < ChannelCount; ++c) {
        CustomSlider *slider = mSliders[size_t(c)];
        const float64 v = Value(Channel(c));
        slider->SetValue(std::isnan(v) ? 0.0 : v, true);
        slider->SetDisabled(!mInputs[size_t(c)] || IsDisabled());
    }
    // RGB is always shown (an unlinked channel greyed); alpha only with its Input.
    mSliders[Alpha]->setVisible(mInputs[Alpha] != nullptr);
    mPick->setVisible(mShowPicker);
    mSwatch->SetColor(mColor);
    if (!mHex->isModified())
        mHex->setText(ColorMath::ToHex(mColor, mInputs[Alpha] != nullptr));
    if (!mSpace->isModified())
        mSpace->setText(TripleText(ColorMath::ToModel(mColor, mModel), mModel));
    mSpace->setToolTip(tr("%1, typed as three numbers").arg(ColorMath::ModelName(mModel)));
    ShowRamps();
}

// Each track shows the colour its channel makes from 0 to the scale's end,
// the other channels as they are.
void ColorControl::ShowRamps()
{
    for (int32 c = 0; c < ChannelCount; ++c) {
        Gradient *ramp = mRamps[size_t(c)];
        ramp->Clear();
        for (int32 i = 0; i < kRampStops; ++i) {
            const float64 t = float64(i) / (kRampStops - 1);
            ColorRGBA at = mColor;
            ChannelRef(at, c) = t * mMaxScale;
            if (c != Alpha)
                at.a = 1.0;
            const QColor shown = ColorMath::ToDisplay(at);
            ramp->AddStop(t, GradientColor{shown.redF(), shown.greenF(), shown.blueF(), shown.alphaF()});
        }
        mSliders[size_t(c)]->Redraw(true);
    }
}

void ColorControl::Write(const ColorRGBA &colour)
{
    const OrbString name = InputGesture::StepName(*this);
    ColorRGBA next = colour;
    for (int32 c = 0; c < ChannelCount; ++c) {
        const float64 v = ChannelRef(next, c);
        if (mInputs[size_t(c)] && !Same(v, Value(Channel(c))))
            mGesture.Write(mInputs[size_t(c)], AutoNumber(v), name);
    }
    // A refused write (a locked tool) shows what the Inputs hold.
    ShowValue();
}

void ColorControl::WriteOnce(const ColorRGBA &colour)
{
    Write(colour);
    mGesture.End();
}

void ColorControl::OnSliderChanged(float64 value)
{
    auto *slider = qobject_cast<CustomSlider *>(sender());
    const auto it = std::find(mSliders.begin(), mSliders.end(), slider);
    if (it == mSliders.end())
        return;
    ColorRGBA next = mColor;
    ChannelRef(next, int32(it - mSliders.begin())) = value;
    Write(next);
    // A key press or a page click is a gesture of its own; a drag ends on release.
    if (!slider->IsDragging())
        mGesture.End();
}

void ColorControl::OnSliderReleased(CustomController *)
{
    mGesture.End();
}

void ColorControl::OnHexTyped()
{
    if (!mHex->isModified())
        return;
    mHex->setModified(false);
    ColorRGBA next = mColor;
    if (ColorMath::FromHex(mHex->text(), next))
        WriteOnce(next);
    // What cannot be read goes back to the value.
    ShowValue();
}

void ColorControl::OnSpaceTyped()
{
    if (!mSpace->isModified())
        return;
    mSpace->setModified(false);
    const QStringList parts = mSpace->text().split(QRegularExpression("[\\s,;]+"), Qt::SkipEmptyParts);
    ColorTriple t;
    bool ok = parts.size() == 3;
    for (int32 i = 0; ok && i < 3; ++i)
        t.c[i] = parts[i].toDouble(&ok);
    if (ok)
        WriteOnce(ColorMath::FromModel(t, mModel, mColor.a));
    ShowValue();
}

void ColorControl::OnModelClicked()
{
    // Which model the second view shows is the user's view, not a value: no undo.
    mModel = (mModel + 1) % ColorMath::Model_Count;
    mModelButton->setText(ColorMath::ModelName(mModel));
    mSpace->setModified(false);
    ShowValue();
}

void ColorControl::OnPickToggled(bool on)
{
    if (on)
        mPicker->Arm();
    else
        mPicker->Disarm();
}

void ColorControl::OnPicked(const ColorRGBA &colour)
{
    ColorRGBA next = colour;
    // Without an alpha Input the picked alpha has nowhere to go.
    if (!mInputs[Alpha])
        next.a = mColor.a;
    WriteOnce(next);
}

void ColorControl::OnSwatchDoubleClicked()
{
    if (!mDialog) {
        mDialog = new QColorDialog(this);
        mDialog->setObjectName("colorDialog");
        connect(mDialog, SIGNAL(colorSelected(QColor)), this, SLOT(OnDialogChosen(QColor)));
    }
    mDialog->setOption(QColorDialog::ShowAlphaChannel, mInputs[Alpha] != nullptr);
    mDialog->setCurrentColor(ColorMath::ToDisplay(mColor));
    // Not modal: a script or the user may go on while it is open.
    mDialog->open();
}

void ColorControl::OnDialogChosen(const QColor &colour)
{
    ColorRGBA next = ColorMath::FromQColor(colour);
    if (!mInputs[Alpha])
        next.a = mColor.a;
    WriteOnce(next);
}

bool ColorControl::OnDisconnect(Input *input, const TagList *tags)
{
    const Channel channel = ChannelOf(input);
    if (channel != ChannelCount)
        WriteOnDisconnect(input, Value(channel));
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (channel != ChannelCount && channel != Red)
        mInputs[size_t(channel)] = nullptr;
    return done;
}

} // namespace Orbane

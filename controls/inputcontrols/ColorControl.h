#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "widgets/ColorMath.h"

#include <array>

class QColorDialog;
class QLineEdit;
class QPushButton;

namespace Orbane {

class ColorSwatch;
class CustomController;
class CustomSlider;
class Gradient;
class ViewerPicker;

// A colour of up to four Number Inputs: red (the Input the control stands
// on), green, blue and alpha (linked by CLRCP_*Input). Children: a slider per
// channel ("red", "green", "blue", "alpha") whose track shows the colour
// that channel would make; a "swatch" (double click: the system colour
// dialog, "colorDialog"); a "hex" box (#RRGGBB or #RRGGBBAA, sRGB-encoded);
// the second view, "model" (a click cycles HSV, HLS, YUV) and "space" (its
// three numbers, typed as "h s v"); and "pick", which arms the viewer
// picker. Every gesture is one undo step, however many channels it changes;
// values outside 0..1 and NaN are kept exactly and shown clipped.
class ColorControl : public LabelledInputControl
{
    Q_OBJECT
public:
    enum Channel : int32
    {
        Red,
        Green,
        Blue,
        Alpha,
        ChannelCount
    };

    ColorControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ColorControl() override;

    std::size_t SizeOf() const override { return sizeof(ColorControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    const ColorRGBA &GetColor() const noexcept { return mColor; }

private slots:
    void OnSliderChanged(float64 value);
    void OnSliderReleased(CustomController *slider);
    void OnHexTyped();
    void OnSpaceTyped();
    void OnModelClicked();
    void OnPickToggled(bool on);
    void OnPicked(const Orbane::ColorRGBA &colour);
    void OnSwatchDoubleClicked();
    void OnDialogChosen(const QColor &colour);

private:
    CustomSlider *MakeSlider(Channel channel);
    void ReadOwnTags(const TagList &tags);
    void LinkChannels(const TagList &tags);
    void ReadChannel(Channel channel);
    Channel ChannelOf(const Input *input) const;
    // Writes every channel of `colour` that has an Input and differs; the
    // gesture stays open until EndGesture.
    void Write(const ColorRGBA &colour);
    void WriteOnce(const ColorRGBA &colour);
    void ShowValue();
    void ShowRamps();
    float64 &Value(Channel channel);

    ColorRGBA mColor;
    std::array<Input *, ChannelCount> mInputs{};
    int32 mModel = ColorMath::Model_HSV;
    bool mShowPicker = true;
    float64 mMaxScale = 1.0;
    InputGesture mGesture;
    std::array<CustomSlider *, ChannelCount> mSliders{};
    std::array<Gradient *, ChannelCount> mRamps{};
    ColorSwatch *mSwatch;
    QLineEdit *mHex;
    QPushButton *mModelButton;
    QLineEdit *mSpace;
    QPushButton *mPick;
    ViewerPicker *mPicker;
    QColorDialog *mDialog = nullptr;
};

} // namespace Orbane

#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "widgets/HueHexagon.h"

#include <array>

class QLineEdit;

namespace Orbane {

// How much of each of six hues to suppress: red (the Input the control
// stands on), yellow, green, cyan, blue and magenta (further Number Inputs
// named by CSCP_*Input). Children: "hexagon", the six spokes (press or drag
// along one; Ctrl finer), and the value boxes "red" .. "magenta". Each drag
// or typed value is one undo step. A hue without an Input stays at 0.
class ColorSuppressionControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr int32 kHues = HueHexagon::kSpokes;
    static const char *const kHueNames[kHues];

    ColorSuppressionControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ColorSuppressionControl() override;

    std::size_t SizeOf() const override { return sizeof(ColorSuppressionControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnMoved(int hue, float64 value);
    void OnReleased();
    void OnTyped();

private:
    void ReadOwnTags(const TagList &tags);
    void LinkHues(const TagList &tags);
    void ReadHue(int32 hue);
    int32 HueOf(const Input *input) const;
    void ShowValue();

    std::array<float64, kHues> mValues{};
    std::array<Input *, kHues> mInputs{};
    float64 mMax = 1.0;
    bool mShowValues = true;
    InputGesture mGesture;
    HueHexagon *mHexagon;
    std::array<QLineEdit *, kHues> mEdits{};
};

} // namespace Orbane

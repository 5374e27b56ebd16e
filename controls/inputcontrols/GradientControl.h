#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "widgets/GradientStops.h"

class QColorDialog;
class QComboBox;
class QLineEdit;

namespace Orbane {

class GradientBar;

// A colour gradient on a ScriptVal Input (see GradientStops for its table).
// Children: "bar" (click to add a stop, drag a marker to move it, drag it
// off the bar to delete it, double click it for the colour dialog
// "colorDialog"); "interp", Linear or Smooth; "position" and "hex", the
// selected stop's place and colour, typed. Each gesture is one undo step.
// A value that is no gradient is shown as the default gradient with the
// reason in the bar's tip, and is replaced by the first edit.
class GradientControl : public LabelledInputControl
{
    Q_OBJECT
public:
    GradientControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~GradientControl() override;

    std::size_t SizeOf() const override { return sizeof(GradientControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnBarEdited();
    void OnBarGestureEnded();
    void OnSelectionChanged();
    void OnInterpChosen(int index);
    void OnPositionTyped();
    void OnHexTyped();
    void OnColorAsked(int index);
    void OnDialogChosen(const QColor &colour);

private:
    void ReadOwnTags(const TagList &tags);
    // Takes a script value; false where it is no gradient (mStops then the default).
    bool Take(const ScriptVal &value);
    void Write(const GradientStops &stops);
    void ShowValue();
    GradientStops::Stop *SelectedStop();

    GradientStops mStops = GradientStops::Default();
    bool mShowAlpha = true;
    int32 mMaxStops = 16;
    InputGesture mGesture;
    GradientBar *mBar;
    QComboBox *mInterp;
    QLineEdit *mPosition;
    QLineEdit *mHex;
    QColorDialog *mDialog = nullptr;
    int32 mDialogStop = -1;
};

} // namespace Orbane

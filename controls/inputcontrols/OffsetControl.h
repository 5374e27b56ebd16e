#pragma once

#include "framework/LabelledInputControl.h"

class QLineEdit;

namespace Orbane {

class TimeCodeEdit;

// A point Input in the inspector: its X and Y in two edit boxes ("x" and
// "y") beside the label. A box takes a typed number or expression
// ("0.5*2", "=time/100" evaluates once), and dragged sideways it moves its
// coordinate by OFCD_DragStep a pixel (Ctrl a tenth, Shift ten times), the
// drag being one undo step. The viewer's overlay of the same Input and
// this control follow each other through the Input.
class OffsetControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr float64 kDefaultDragStep = 0.001;
    // Values closer than this are the same point: no redisplay.
    static constexpr float64 kSamePoint = 1e-9;

    OffsetControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~OffsetControl() override;

    std::size_t SizeOf() const override { return sizeof(OffsetControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnTyped();
    void OnStartDrag(TimeCodeEdit *edit);
    void OnDrag(float64 dist, TimeCodeEdit *edit);
    void OnEndDrag(TimeCodeEdit *edit);

private:
    TimeCodeEdit *MakeEdit(const char *name);
    void ShowValue();
    void Write(float64 x, float64 y);

    float64 mX = 0.0;
    float64 mY = 0.0;
    float64 mAnchor = 0.0; // the dragged coordinate at the drag's start
    float64 mDragStep = kDefaultDragStep;
    int32 mDecimals = 3;
    TimeCodeEdit *mEditX;
    TimeCodeEdit *mEditY;
};

} // namespace Orbane

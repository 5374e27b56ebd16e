#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <QLineEdit>
#include <QPoint>

namespace Orbane {

// The host's number edit box. Shows a value with a given number of decimal
// places, as an integer, or as a time code; takes typed numbers, arithmetic
// ("2*pi") and, after a leading "=", expressions that the owner links to its
// Input. Up and Down change the digit at the cursor. A virtual edit also acts
// as a slider: dragging sideways before it has focus reports an accumulated
// distance instead of selecting text, and a click without a drag starts typing.
class TimeCodeEdit : public QLineEdit
{
    Q_OBJECT
public:
    // Pixels the mouse must travel before a press becomes a drag.
    static constexpr int32 DragThreshold = 3;

    explicit TimeCodeEdit(QWidget *parent = nullptr);
    ~TimeCodeEdit() override;

    // Shows `value`; `decimals` -1 shows as many as needed (up to six).
    void SetValue(float64 value, int32 decimals = -1);
    // The number shown or typed: plain numbers, time codes in time display,
    // arithmetic and expressions evaluated. Where the text gives no number,
    // *ok is set false and the last value set is returned.
    float64 GetValue(bool *ok = nullptr) const;
    // Does the text ask for an expression link (starts with "=")?
    bool IsExpression() const;
    // The expression without its "=", trimmed; empty where there is none.
    OrbString GetExpression() const;

    void SetInteger(bool on);
    bool IsInteger() const noexcept { return mInteger; }
    // Time display: values are frames shown as hours:minutes:seconds:frames.
    void SetTimeType(bool on);
    bool IsTimeType() const noexcept { return mTimeType; }
    void SetFrameRate(float64 fps);
    float64 FrameRate() const noexcept { return mFrameRate; }
    void SetDisabled(bool disabled);

    void SetVirtual(bool on);
    bool IsVirtual() const noexcept { return mVirtual; }
    bool IsDragging() const noexcept { return mDragging; }
    // The distance accumulated by the current drag (pixels, ten times less
    // with Ctrl, ten times more with Shift). The slider sets it back when it
    // clamps, so that dragging back turns the value round at once.
    float64 GetDragDistance() const noexcept { return mDragDistance; }
    void SetDragDistance(float64 dist) noexcept { mDragDistance = dist; }

    // The text for a value: integer display rounds half up; decimals -1 trims
    // trailing zeros after six places.
    static QString FormatNumber(float64 value, int32 decimals, bool integer);
    // Frames as "[-]hh:mm:ss:ff" at `fps`; decimals apply to the frame field.
    static QString FormatTime(float64 frames, float64 fps, int32 decimals);
    // Reads "[-][[hh:]mm:]ss:ff" back into frames; false where it is not one.
    static bool ParseTime(const QString &text, float64 fps, float64 *frames);

signals:
    void StartDrag(TimeCodeEdit *edit);
    void Drag(float64 dist, TimeCodeEdit *edit);
    void EndDrag(TimeCodeEdit *edit);
    // The user stepped a digit with Up or Down; the new value is in the text.
    void digitChanged(TimeCodeEdit *edit);

protected:
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    void paintEvent(QPaintEvent *event) override;

private:
    bool StepDigit(int32 direction);
    bool StepNumberDigit(int32 direction);
    QString Format(float64 value) const;
    bool EvaluateText(const QString &text, float64 *value) const;
    bool VirtualPress() const;

    float64 mValue = 0.0;
    int32 mDecimals = -1;
    bool mInteger = false;
    bool mTimeType = false;
    float64 mFrameRate = 24.0;
    bool mVirtual = false;
    Qt::FocusPolicy mFocusPolicy = Qt::StrongFocus;
    bool mPressed = false;
    bool mDragging = false;
    QPoint mPressPos;
    int32 mLastX = 0;
    float64 mDragDistance = 0.0;
};

} // namespace Orbane

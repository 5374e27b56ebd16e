#pragma once

#include "orbane/OrbColor.h"
#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <QColor>
#include <QMargins>
#include <QString>
#include <QWidget>

namespace Orbane {

// The host's painted push button, and the base of the check box. It paints
// itself with QPainter only (no pixmaps), so it is crisp at any device pixel
// ratio, and follows the application palette unless given base colours.
//
// The style decides what a click does to the check state:
//   0 push button: the state never changes;
//   1 two-state: 0 <-> 1;
//   2 three-state: 0 -> 1 -> 2 -> 0 (2 is the mixed state).
// A click (left button released over the button, or Space / Enter while it
// has focus) emits ButtonPressed with the keyboard modifiers of the click as
// a Qt::KeyboardModifiers word, and whether the button is now checked.
class CustomButton : public QWidget
{
    Q_OBJECT
public:
    enum Style : int32
    {
        Style_Push = 0,
        Style_TwoState = 1,
        Style_TriState = 2
    };

    explicit CustomButton(QWidget *parent = nullptr);
    ~CustomButton() override;

    void SetStyle(int32 style);
    int32 GetStyle() const { return mStyle; }

    void SetFont(const QFont &font);
    void SetLabel(const QString &text);
    void SetLabel(const OrbString &text);
    void SetLabel(const char *utf8);
    const QString &GetLabel() const { return mLabel; }

    // The colour behind the button, filled before the face; none leaves the
    // parent showing through.
    void SetBackgroundColor(OrbColor color);
    // Base colours of the face, its text, its frame and the accent used for
    // the checked look and keyboard focus; a none colour keeps the palette's.
    void SetBasicCols(OrbColor face, OrbColor text = OrbColor(), OrbColor frame = OrbColor(),
                      OrbColor accent = OrbColor());

    // Programmatic state change: repaints, emits nothing. Out-of-range values
    // are clamped to the states the style offers.
    void SetCheck(int32 state);
    int32 GetCheck() const { return mCheck; }

    // Lets the label wrap onto several lines; the button then grows in height
    // with its text (height-for-width).
    void AllowWrap(bool allow);
    bool IsWrapAllowed() const { return mWrap; }

    bool IsHovered() const { return mHover; }
    bool IsDown() const { return mDown; }

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;
    bool hasHeightForWidth() const override;
    int heightForWidth(int width) const override;

signals:
    void ButtonPressed(uint64 modifiers, bool checked);

protected:
    // A completed click; the base steps the check state by the style and
    // emits ButtonPressed.
    virtual void Clicked(uint64 modifiers);
    // The state a click moves to from the current one.
    int32 NextCheck() const;
    // Sets the state without signals; true where it changed.
    bool StoreCheck(int32 state);

    // Room around the label inside the widget; the check box keeps its box
    // in the left margin.
    virtual QMargins LabelMargins() const;
    virtual Qt::Alignment LabelAlignment() const;
    QRect LabelRect() const;
    int LabelHeight(int width) const;
    int TextFlags() const;

    // Colours after the palette and the base colours are combined.
    QColor FaceColor() const;
    QColor TextColor() const;
    QColor FrameColor() const;
    QColor AccentColor() const;

    void PaintBackground(QPainter &p) const;
    virtual void PaintFace(QPainter &p) const;
    void PaintLabel(QPainter &p, const QRect &r) const;

    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    void keyReleaseEvent(QKeyEvent *event) override;
    void enterEvent(QEvent *event) override;
    void leaveEvent(QEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;
    void changeEvent(QEvent *event) override;

private:
    void SetDown(bool down);
    void SetHover(bool hover);

    int32 mStyle = Style_Push;
    int32 mCheck = 0;
    QString mLabel;
    bool mWrap = false;
    bool mDown = false; // pressed look: mouse held over the button, or Space held
    bool mHover = false;
    bool mMouseHeld = false;
    OrbColor mBackground;
    OrbColor mFace, mText, mFrame, mAccent;
};

} // namespace Orbane

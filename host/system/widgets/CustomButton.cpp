#include "orbane/CustomButton.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>

#include <algorithm>

namespace Orbane {

namespace {

constexpr int kMinHeight = 20; // a push button never gets smaller than this
constexpr qreal kRadius = 3.0; // corner radius of the face
constexpr int kPadH = 8;       // room left and right of a push button's label
constexpr int kPadV = 3;       // room above and below the label

QColor ToQColor(OrbColor c, const QColor &fallback)
{
    return c.IsNone() ? fallback : QColor(c.R(), c.G(), c.B(), c.A());
}

// A rectangle whose 1-pixel outline falls exactly on device pixels at any
// integer device pixel ratio: the pen's centre sits half a logical pixel in.
QRectF OutlineRect(const QRect &r)
{
    return QRectF(r).adjusted(0.5, 0.5, -0.5, -0.5);
}

// The signals carry the host's typedef names; spies and queued connections
// need those names known to Qt's type system.
void RegisterSignalTypes()
{
    static const bool done = [] {
        qRegisterMetaType<int32>("int32");
        qRegisterMetaType<uint64>("uint64");
        return true;
    }();
    (void)done;
}

} // namespace

CustomButton::CustomButton(QWidget *parent) : QWidget(parent)
{
    RegisterSignalTypes();
    setFocusPolicy(Qt::StrongFocus);
    setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Fixed);
}

CustomButton::~CustomButton() = default;

void CustomButton::SetStyle(int32 style)
{
    style = std::clamp<int32>(style, Style_Push, Style_TriState);
    if (style == mStyle)
        return;
    mStyle = style;
    update();
}

void CustomButton::SetFont(const QFont &font)
{
    setFont(font);
}

void CustomButton::SetLabel(const QString &text)
{
    if (text == mLabel)
        return;
    mLabel = text;
    updateGeometry();
    update();
}

void CustomButton::SetLabel(const OrbString &text)
{
    SetLabel(QString::fromStdString(text.str()));
}

void CustomButton::SetLabel(const char *utf8)
{
    SetLabel(QString::fromUtf8(utf8 ? utf8 : ""));
}

void CustomButton::SetBackgroundColor(OrbColor color)
{
    if (color == mBackground)
        return;
    mBackground = color;
    setAttribute(Qt::WA_OpaquePaintEvent, !color.IsNone() && color.A() == 255);
    update();
}

void CustomButton::SetBasicCols(OrbColor face, OrbColor text, OrbColor frame, OrbColor accent)
{
    mFace = face;
    mText = text;
    mFrame = frame;
    mAccent = accent;
    update();
}

void CustomButton::SetCheck(int32 state)
{
    if (StoreCheck(state))
        update();
}

bool CustomButton::StoreCheck(int32 state)
{
    state = std::clamp<int32>(state, 0, 2);
    if (state == mCheck)
        return false;
    mCheck = state;
    return true;
}

int32 CustomButton::NextCheck() const
{
    switch (mStyle) {
    case Style_TwoState:
        return mCheck == 1 ? 0 : 1;
    case Style_TriState:
        return (mCheck + 1) % 3;
    default:
        return mCheck;
    }
}

void CustomButton::AllowWrap(bool allow)
{
    if (allow == mWrap)
        return;
    mWrap = allow;
    // A wrapping label must be free to grow to its height for the width.
    QSizePolicy policy = sizePolicy();
    policy.setVerticalPolicy(allow ? QSizePolicy::Preferred : QSizePolicy::Fixed);
    policy.setHeightForWidth(allow);
    setSizePolicy(policy);
    updateGeometry();
    update();
}

void CustomButton::Clicked(uint64 modifiers)
{
    if (StoreCheck(NextCheck()))
        update();
    emit ButtonPressed(modifiers, mCheck != 0);
}

QMargins CustomButton::LabelMargins() const
{
    return QMargins(kPadH, kPadV, kPadH, kPadV);
}

Qt::Alignment CustomButton::LabelAlignment() const
{
    return Qt::AlignHCenter;
}

QRect CustomButton::LabelRect() const
{
    return rect().marginsRemoved(LabelMargins());
}

int CustomButton::TextFlags() const
{
    return int(LabelAlignment()) | (mWrap ? Qt::AlignTop | Qt::TextWordWrap : Qt::AlignVCenter | Qt::TextSingleLine);
}

int CustomButton::LabelHeight(int width) const
{
    const QRect box(0, 0, std::max(width, 1), 100000);
    return fontMetrics().boundingRect(box, TextFlags(), mLabel).height();
}

QSize CustomButton::sizeHint() const
{
    const QFontMetrics fm = fontMetrics();
    const QMargins m = LabelMargins();
    const int width = m.left() + fm.horizontalAdvance(mLabel) + m.right();
    return QSize(width, std::max(kMinHeight, fm.height() + m.top() + m.bottom()));
}

QSize CustomButton::minimumSizeHint() const
{
    // The label elides, so only an ellipsis must fit.
    const QMargins m = LabelMargins();
    const int width = m.left() + fontMetrics().horizontalAdvance(QChar(0x2026)) + m.right();
    return QSize(width, sizeHint().height());
}

bool CustomButton::hasHeightForWidth() const
{
    return mWrap;
}

int CustomButton::heightForWidth(int width) const
{
    if (!mWrap)
        return -1;
    const QMargins m = LabelMargins();
    return std::max(sizeHint().height(), LabelHeight(width - m.left() - m.right()) + m.top() + m.bottom());
}

QColor CustomButton::FaceColor() const
{
    return ToQColor(mFace, palette().color(QPalette::Button));
}

QColor CustomButton::TextColor() const
{
    QColor c = ToQColor(mText, palette().color(QPalette::ButtonText));
    if (!isEnabled())
        c.setAlphaF(c.alphaF() * 0.45);
    return c;
}

QColor CustomButton::FrameColor() const
{
    return ToQColor(mFrame, palette().color(QPalette::Dark));
}

QColor CustomButton::AccentColor() const
{
    return ToQColor(mAccent, palette().color(QPalette::Active, QPalette::Highlight));
}

void CustomButton::PaintBackground(QPainter &p) const
{
    if (!mBackground.IsNone())
        p.fillRect(rect(), ToQColor(mBackground, Qt::transparent));
}

void CustomButton::PaintFace(QPainter &p) const
{
    QColor face = FaceColor();
    if (mDown)
        face = face.darker(125);
    else if (mCheck != 0)
        face = QColor::fromRgbF(face.redF() * 0.6 + AccentColor().redF() * 0.4,
                                face.greenF() * 0.6 + AccentColor().greenF() * 0.4,
                                face.blueF() * 0.6 + AccentColor().blueF() * 0.4);
    else if (mHover && isEnabled())
        face = face.lighter(115);
    if (!isEnabled())
        face = face.darker(115);

    QLinearGradient shade(0, 0, 0, height());
    shade.setColorAt(0, face.lighter(mDown ? 100 : 107));
    shade.setColorAt(1, face.darker(mDown ? 100 : 104));

    p.setRenderHint(QPainter::Antialiasing, true);
    p.setPen(QPen(hasFocus() ? AccentColor() : FrameColor(), 1.0));
    p.setBrush(shade);
    p.drawRoundedRect(OutlineRect(rect()), kRadius, kRadius);
    p.setRenderHint(QPainter::Antialiasing, false);
}

void CustomButton::PaintLabel(QPainter &p, const QRect &r) const
{
    p.setPen(TextColor());
    p.setFont(font());
    const QString text = mWrap ? mLabel : fontMetrics().elidedText(mLabel, Qt::ElideRight, r.width());
    p.drawText(r, TextFlags(), text);
}

void CustomButton::paintEvent(QPaintEvent *)
{
    QPainter p(this);
    PaintBackground(p);
    PaintFace(p);
    PaintLabel(p, LabelRect());
}

void CustomButton::SetDown(bool down)
{
    if (down == mDown)
        return;
    mDown = down;
    update();
}

void CustomButton::SetHover(bool hover)
{
    if (hover == mHover)
        return;
    mHover = hover;
    update();
}

void CustomButton::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton) {
        QWidget::mousePressEvent(event);
        return;
    }
    mMouseHeld = true;
    SetDown(true);
    event->accept();
}

void CustomButton::mouseMoveEvent(QMouseEvent *event)
{
    if (mMouseHeld)
        SetDown(rect().contains(event->pos()));
    event->accept();
}

void CustomButton::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !mMouseHeld) {
        QWidget::mouseReleaseEvent(event);
        return;
    }
    mMouseHeld = false;
    const bool over = rect().contains(event->pos());
    SetDown(false);
    event->accept();
    if (over)
        Clicked(uint64(event->modifiers()));
}

void CustomButton::keyPressEvent(QKeyEvent *event)
{
    switch (event->key()) {
    case Qt::Key_Space:
        if (!event->isAutoRepeat())
            SetDown(true);
        event->accept();
        return;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        event->accept();
        if (!event->isAutoRepeat())
            Clicked(uint64(event->modifiers()));
        return;
    default:
        QWidget::keyPressEvent(event);
    }
}

void CustomButton::keyReleaseEvent(QKeyEvent *event)
{
    if (event->key() != Qt::Key_Space || event->isAutoRepeat()) {
        QWidget::keyReleaseEvent(event);
        return;
    }
    event->accept();
    if (!mDown || mMouseHeld)
        return;
    SetDown(false);
    Clicked(uint64(event->modifiers()));
}

void CustomButton::enterEvent(QEvent *event)
{
    SetHover(true);
    QWidget::enterEvent(event);
}

void CustomButton::leaveEvent(QEvent *event)
{
    SetHover(false);
    QWidget::leaveEvent(event);
}

void CustomButton::focusOutEvent(QFocusEvent *event)
{
    // A Space held while focus leaves must not click later.
    if (!mMouseHeld)
        SetDown(false);
    QWidget::focusOutEvent(event);
}

void CustomButton::changeEvent(QEvent *event)
{
    if (event->type() == QEvent::EnabledChange && !isEnabled()) {
        mMouseHeld = false;
        mDown = false;
        mHover = false;
    }
    if (event->type() == QEvent::FontChange)
        updateGeometry();
    QWidget::changeEvent(event);
}

} // namespace Orbane

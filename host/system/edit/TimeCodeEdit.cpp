#include "orbane/TimeCodeEdit.h"

#include "orbane/Parser.h"

#include <QKeyEvent>
#include <QLocale>
#include <QMouseEvent>
#include <QPainter>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// "-0", "-0.00" and the like read as zero.
QString NoNegativeZero(QString text)
{
    if (text.startsWith(QLatin1Char('-')) && QLocale::c().toDouble(text) == 0.0)
        text.remove(0, 1);
    return text;
}

bool ReadNumber(const QString &text, float64 *value)
{
    bool ok = false;
    const float64 v = QLocale::c().toDouble(text, &ok);
    if (ok && std::isfinite(v))
        *value = v;
    return ok && std::isfinite(v);
}

// The signals name their arguments with the host's type names; queued
// connections and signal spies look them up by those names.
void RegisterSignalTypes()
{
    static const bool done = [] {
        qRegisterMetaType<float64>("float64");
        qRegisterMetaType<TimeCodeEdit *>("TimeCodeEdit*");
        return true;
    }();
    (void)done;
}

} // namespace

// Made with the text of its first value, 0 in the default format: a setText
// afterwards would lay the line out a second time (the cost of a few
// microseconds that every inspector row paid).
TimeCodeEdit::TimeCodeEdit(QWidget *parent) : QLineEdit(FormatNumber(0.0, -1, false), parent)
{
    RegisterSignalTypes();
    // The style's framed panel cost most of a slider drag's repaint; the edit
    // draws its own one-pixel frame instead.
    setFrame(false);
    setTextMargins(1, 0, 1, 0);
}

void TimeCodeEdit::paintEvent(QPaintEvent *event)
{
    QLineEdit::paintEvent(event);
    QPainter p(this);
    const QColor frame = palette().color(hasFocus() ? QPalette::Highlight : QPalette::Mid);
    const QRect r = rect();
    // Stroking the rectangle costs the raster engine some fifty microseconds,
    // most of an edit's repaint during a drag; at a device pixel ratio of 1
    // four filled lines cover exactly the same pixels.
    if (devicePixelRatioF() == 1.0 && r.width() >= 2 && r.height() >= 2) {
        p.fillRect(r.left(), r.top(), r.width(), 1, frame);
        p.fillRect(r.left(), r.bottom(), r.width(), 1, frame);
        p.fillRect(r.left(), r.top() + 1, 1, r.height() - 2, frame);
        p.fillRect(r.right(), r.top() + 1, 1, r.height() - 2, frame);
        return;
    }
    p.setPen(frame);
    p.drawRect(QRectF(r).adjusted(0.5, 0.5, -0.5, -0.5));
}

TimeCodeEdit::~TimeCodeEdit() = default;

QString TimeCodeEdit::FormatNumber(float64 value, int32 decimals, bool integer)
{
    if (integer)
        return NoNegativeZero(QString::number(std::floor(value + 0.5), 'f', 0));
    if (decimals >= 0)
        return NoNegativeZero(QString::number(value, 'f', decimals));
    QString text = QString::number(value, 'f', 6);
    while (text.endsWith(QLatin1Char('0')))
        text.chop(1);
    if (text.endsWith(QLatin1Char('.')))
        text.chop(1);
    return NoNegativeZero(text);
}

QString TimeCodeEdit::FormatTime(float64 frames, float64 fps, int32 decimals)
{
    const int32 places = std::max(0, decimals);
    const float64 scale = std::pow(10.0, places);
    const float64 total = std::floor(std::fabs(frames) * scale + 0.5) / scale;
    const int64 rate = std::max<int64>(1, std::llround(fps));
    const int64 whole = int64(std::floor(total));
    const int64 seconds = whole / rate;
    const float64 frame = float64(whole % rate) + (total - float64(whole));
    QString text = QString::asprintf("%02lld:%02lld:%02lld:", static_cast<long long>(seconds / 3600),
                                     static_cast<long long>(seconds / 60 % 60), static_cast<long long>(seconds % 60));
    text += QString::number(frame, 'f', places).rightJustified(places ? places + 3 : 2, QLatin1Char('0'));
    return frames < 0.0 && total > 0.0 ? QLatin1Char('-') + text : text;
}

bool TimeCodeEdit::ParseTime(const QString &text, float64 fps, float64 *frames)
{
    QString t = text.trimmed();
    const bool negative = t.startsWith(QLatin1Char('-'));
    if (negative)
        t.remove(0, 1);
    const QStringList fields = t.split(QLatin1Char(':'));
    if (fields.size() > 4 || fps <= 0.0)
        return false;
    float64 frame = 0.0;
    if (!ReadNumber(fields.last(), &frame) || frame < 0.0)
        return false;
    int64 seconds = 0;
    for (int32 i = 0; i + 1 < fields.size(); ++i) {
        bool ok = false;
        const int64 field = fields[i].toLongLong(&ok);
        if (!ok || field < 0)
            return false;
        seconds = seconds * 60 + field;
    }
    const float64 result = float64(seconds) * std::llround(fps) + frame;
    *frames = negative ? -result : result;
    return true;
}

QString TimeCodeEdit::Format(float64 value) const
{
    if (mTimeType)
        return FormatTime(value, mFrameRate, mInteger ? 0 : mDecimals);
    return FormatNumber(value, mDecimals, mInteger);
}

void TimeCodeEdit::SetValue(float64 value, int32 decimals)
{
    mValue = value;
    mDecimals = decimals;
    const QString formatted = Format(value);
    if (formatted != text())
        setText(formatted);
}

bool TimeCodeEdit::EvaluateText(const QString &text, float64 *value) const
{
    QString t = text.trimmed();
    if (t.startsWith(QLatin1Char('=')))
        t = t.mid(1).trimmed();
    if (t.isEmpty())
        return false;
    if (ReadNumber(t, value))
        return true;
    if (mTimeType && ParseTime(t, mFrameRate, value))
        return true;
    Parser parser;
    if (!parser.SetExpression(t.toUtf8().constData()))
        return false;
    bool ok = false;
    const float64 v = parser.Evaluate(&ok);
    if (!ok || !std::isfinite(v))
        return false;
    *value = v;
    return true;
}

float64 TimeCodeEdit::GetValue(bool *ok) const
{
    float64 value = mValue;
    const bool good = EvaluateText(text(), &value);
    if (ok)
        *ok = good;
    return good ? value : mValue;
}

bool TimeCodeEdit::IsExpression() const
{
    return text().trimmed().startsWith(QLatin1Char('='));
}

OrbString TimeCodeEdit::GetExpression() const
{
    if (!IsExpression())
        return OrbString();
    return OrbString(text().trimmed().mid(1).trimmed().toStdString());
}

void TimeCodeEdit::SetInteger(bool on)
{
    if (on == mInteger)
        return;
    mInteger = on;
    setText(Format(mValue));
}

void TimeCodeEdit::SetTimeType(bool on)
{
    if (on == mTimeType)
        return;
    mTimeType = on;
    setText(Format(mValue));
}

void TimeCodeEdit::SetFrameRate(float64 fps)
{
    if (fps > 0.0 && fps != mFrameRate) {
        mFrameRate = fps;
        setText(Format(mValue));
    }
}

void TimeCodeEdit::SetDisabled(bool disabled)
{
    setEnabled(!disabled);
}

void TimeCodeEdit::SetVirtual(bool on)
{
    if (on == mVirtual)
        return;
    mVirtual = on;
    // A click must not give focus before the press is seen: a press on an
    // edit without focus may become a drag. The click gives focus itself.
    if (on) {
        mFocusPolicy = focusPolicy();
        setFocusPolicy(Qt::TabFocus);
    } else {
        setFocusPolicy(mFocusPolicy);
    }
}

bool TimeCodeEdit::VirtualPress() const
{
    return mVirtual && isEnabled() && !hasFocus();
}

void TimeCodeEdit::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton || !VirtualPress())
        return QLineEdit::mousePressEvent(event);
    mPressed = true;
    mDragging = false;
    mPressPos = event->pos();
    mLastX = event->pos().x();
    event->accept();
}

void TimeCodeEdit::mouseMoveEvent(QMouseEvent *event)
{
    if (!mPressed)
        return QLineEdit::mouseMoveEvent(event);
    const int32 x = event->pos().x();
    if (!mDragging) {
        if (std::abs(x - mPressPos.x()) < DragThreshold)
            return;
        mDragging = true;
        mDragDistance = 0.0;
        emit StartDrag(this);
    }
    const float64 factor = event->modifiers() & Qt::ControlModifier ? 0.1
                           : event->modifiers() & Qt::ShiftModifier ? 10.0
                                                                    : 1.0;
    mDragDistance += (x - mLastX) * factor;
    mLastX = x;
    emit Drag(mDragDistance, this);
}

void TimeCodeEdit::mouseReleaseEvent(QMouseEvent *event)
{
    if (!mPressed || event->button() != Qt::LeftButton)
        return QLineEdit::mouseReleaseEvent(event);
    mPressed = false;
    if (mDragging) {
        mDragging = false;
        emit EndDrag(this);
        return;
    }
    // A click without a drag starts typing, with the whole value selected.
    setFocus(Qt::MouseFocusReason);
    selectAll();
}

void TimeCodeEdit::keyPressEvent(QKeyEvent *event)
{
    const int32 direction = event->key() == Qt::Key_Up ? 1 : event->key() == Qt::Key_Down ? -1 : 0;
    if (direction && StepDigit(direction)) {
        event->accept();
        emit digitChanged(this);
        return;
    }
    QLineEdit::keyPressEvent(event);
}

bool TimeCodeEdit::StepDigit(int32 direction)
{
    if (IsExpression() || isReadOnly())
        return false;
    if (!mTimeType)
        return StepNumberDigit(direction);
    float64 frames = 0.0;
    if (!EvaluateText(text(), &frames))
        return false;
    const int32 cursor = cursorPosition();
    mValue = frames + direction;
    setText(Format(mValue));
    setCursorPosition(std::min(cursor, int32(text().size())));
    return true;
}

// Steps the digit right of the cursor (or left of it at the end of a
// number) by one unit of its place, keeping the cursor on that place.
bool TimeCodeEdit::StepNumberDigit(int32 direction)
{
    const QString t = text();
    float64 value = 0.0;
    if (!ReadNumber(t, &value) || t.trimmed() != t)
        return false;
    const int32 cursor = cursorPosition();
    int32 pos = cursor < t.size() && t[cursor].isDigit() ? cursor : cursor - 1;
    if (pos < 0 || !t[pos].isDigit())
        return false;
    const int32 dot = t.contains(QLatin1Char('.')) ? int32(t.indexOf(QLatin1Char('.'))) : int32(t.size());
    const int32 place = pos < dot ? dot - pos - 1 : dot - pos;
    const int32 decimals = mInteger ? 0 : std::max(0, int32(t.size()) - dot - 1);
    mValue = value + direction * std::pow(10.0, place);
    const QString next = NoNegativeZero(QString::number(mValue, 'f', decimals));
    const int32 nextDot = next.contains(QLatin1Char('.')) ? int32(next.indexOf(QLatin1Char('.'))) : int32(next.size());
    const int32 nextPos = place >= 0 ? nextDot - place - 1 : nextDot - place;
    setText(next);
    setCursorPosition(std::min(std::max(0, nextPos + cursor - pos), int32(next.size())));
    return true;
}

} // namespace Orbane

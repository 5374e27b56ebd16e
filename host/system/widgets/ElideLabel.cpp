#include "orbane/ElideLabel.h"

#include <QPainter>
#include <QStyle>

namespace Orbane {

ElideLabel::ElideLabel(QWidget *parent) : QLabel(parent) {}

ElideLabel::ElideLabel(const QString &text, QWidget *parent) : QLabel(text, parent) {}

ElideLabel::~ElideLabel() = default;

void ElideLabel::setElideMode(int mode)
{
    mode = (mode >= Elide_None && mode <= Elide_Middle) ? mode : Elide_None;
    if (mode == mMode)
        return;
    mMode = mode;
    if (mMode != Elide_None)
        setWordWrap(false);
    updateGeometry();
    update();
}

Qt::TextElideMode ElideLabel::QtMode() const
{
    switch (mMode) {
    case Elide_Right:
        return Qt::ElideRight;
    case Elide_Left:
        return Qt::ElideLeft;
    case Elide_Middle:
        return Qt::ElideMiddle;
    default:
        return Qt::ElideNone;
    }
}

QString ElideLabel::displayedText() const
{
    if (mMode == Elide_None)
        return text();
    return fontMetrics().elidedText(text(), QtMode(), contentsRect().width() - 2 * margin());
}

bool ElideLabel::isElided() const
{
    return displayedText() != text();
}

QSize ElideLabel::minimumSizeHint() const
{
    if (mMode == Elide_None)
        return QLabel::minimumSizeHint();
    const QMargins m = contentsMargins();
    const int width = fontMetrics().horizontalAdvance(QChar(0x2026)) + m.left() + m.right() + 2 * margin();
    return QSize(width, QLabel::minimumSizeHint().height());
}

void ElideLabel::paintEvent(QPaintEvent *event)
{
    if (mMode == Elide_None || textFormat() == Qt::RichText) {
        QLabel::paintEvent(event);
        return;
    }
    QPainter p(this);
    drawFrame(&p);
    const QRect r = contentsRect().adjusted(margin(), margin(), -margin(), -margin());
    style()->drawItemText(&p, r, int(alignment()) | Qt::TextSingleLine, palette(), isEnabled(), displayedText(),
                          foregroundRole());
}

} // namespace Orbane

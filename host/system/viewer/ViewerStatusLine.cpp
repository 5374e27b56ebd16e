#include "ViewerStatusLine.h"

#include <QFileInfo>
#include <QFontMetrics>
#include <QPainter>

#include <cmath>

namespace Orbane {

namespace {

const QColor kPlate(0, 0, 0, 170), kText(220, 220, 220), kError(255, 176, 120), kBar(110, 170, 255);
constexpr int kMargin = 8, kPad = 6, kBarHeight = 3;

} // namespace

QString ViewerStatusLine::Text(const ViewerImageState &state)
{
    QString text;
    if (state.loading)
        text = QString("Reading %1  %2%")
                   .arg(QFileInfo(state.file).fileName())
                   .arg(int(std::floor(state.progress * 100.0f)));
    if (!state.error.isEmpty())
        text = text.isEmpty() ? state.error : state.error + "  |  " + text;
    return text;
}

void ViewerStatusLine::Paint(QPainter &p, const QRect &viewer, const ViewerImageState &state)
{
    const QString text = Text(state);
    if (text.isEmpty())
        return;
    const QFontMetrics fm(p.font());
    const int width = std::min(fm.horizontalAdvance(text) + 2 * kPad, viewer.width() - 2 * kMargin);
    const QRect plate(viewer.left() + kMargin, viewer.bottom() - kMargin - fm.height() - 2 * kPad - kBarHeight, width,
                      fm.height() + 2 * kPad + kBarHeight);
    p.save();
    p.fillRect(plate, kPlate);
    p.setPen(state.error.isEmpty() ? kText : kError);
    const QRect words = plate.adjusted(kPad, kPad, -kPad, -kPad - kBarHeight);
    p.drawText(words, Qt::AlignLeft | Qt::AlignVCenter, fm.elidedText(text, Qt::ElideMiddle, words.width()));
    if (state.loading) {
        const QRect track(words.left(), words.bottom() + 2, words.width(), kBarHeight);
        p.fillRect(track, kPlate);
        p.fillRect(
            QRect(track.topLeft(), QSize(int(track.width() * std::clamp(state.progress, 0.0f, 1.0f)), kBarHeight)),
            kBar);
    }
    p.restore();
}

} // namespace Orbane

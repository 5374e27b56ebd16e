#include "inputcontrols/LazyComboBox.h"

#include <QEvent>

#include <utility>

namespace Orbane {

void LazyComboBox::showPopup()
{
    if (std::exchange(mFontPending, false)) {
        QEvent change(QEvent::FontChange);
        QComboBox::changeEvent(&change);
    }
    mListMade = true;
    emit FillRequested();
    QComboBox::showPopup();
}

// The box's own size hint is first asked for when the control is laid out,
// after its font is set, so only the list waits for the font.
void LazyComboBox::changeEvent(QEvent *event)
{
    if (event->type() == QEvent::FontChange && !mListMade) {
        mFontPending = true;
        updateGeometry();
        QWidget::changeEvent(event);
        return;
    }
    QComboBox::changeEvent(event);
}

} // namespace Orbane

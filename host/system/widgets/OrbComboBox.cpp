#include "orbane/OrbComboBox.h"

#include <QAbstractItemView>
#include <QEvent>

namespace Orbane {

OrbComboBox::OrbComboBox(QWidget *parent) : QComboBox(parent)
{
    // The list lives in a popup window of its own; its hiding is the one
    // event that every way of closing the list goes through.
    view()->window()->installEventFilter(this);
}

OrbComboBox::~OrbComboBox() = default;

void OrbComboBox::AddItem(const QString &text, int32 index, const QString &tip)
{
    addItem(text, QVariant(index));
    if (!tip.isEmpty())
        setItemData(count() - 1, tip, Qt::ToolTipRole);
}

void OrbComboBox::AddSeparator(int32 index)
{
    insertSeparator(count());
    setItemData(count() - 1, QVariant(index), Qt::UserRole);
}

int32 OrbComboBox::ItemIndexOf(int row) const
{
    const QVariant data = itemData(row, Qt::UserRole);
    bool ok = false;
    const int32 index = data.toInt(&ok);
    return ok ? index : -1;
}

int OrbComboBox::RowOfItem(int32 index) const
{
    return index < 0 ? -1 : findData(QVariant(index), Qt::UserRole, Qt::MatchExactly);
}

void OrbComboBox::ShowItem(int32 index)
{
    const int row = RowOfItem(index);
    if (row != currentIndex())
        setCurrentIndex(row);
}

void OrbComboBox::showPopup()
{
    QComboBox::showPopup();
    if (!mPopupVisible && view()->window()->isVisible()) {
        mPopupVisible = true;
        emit popupShow();
    }
}

bool OrbComboBox::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::Hide && watched == view()->window() && mPopupVisible) {
        mPopupVisible = false;
        emit popupHide();
    }
    return QComboBox::eventFilter(watched, event);
}

} // namespace Orbane

#pragma once

#include "orbane/Types.h"

#include <QComboBox>

namespace Orbane {

// The host's drop-down list for inspector controls. Every row carries, as its
// user data (Qt::UserRole), the index of the item it shows in the owning
// control's own item lists, so a control may sort or group its rows without
// losing track of its items.
//
// It tells when its list pops up (popupShow, once the list is visible) and
// when the list goes away (popupHide), however it goes: a choice, Escape, a
// click elsewhere or hidePopup. Qt hides the list before it emits activated
// for the row chosen, so popupHide comes first; a control that treats the
// open list as one gesture finishes it after both.
class OrbComboBox : public QComboBox
{
    Q_OBJECT
public:
    explicit OrbComboBox(QWidget *parent = nullptr);
    ~OrbComboBox() override;

    // Appends a row for item `index`; `tip` (may be empty) is its tool tip.
    void AddItem(const QString &text, int32 index, const QString &tip = QString());
    // Appends a separator row for item `index`; it cannot be chosen.
    void AddSeparator(int32 index);
    // The item index that row `row` carries; -1 outside the rows.
    int32 ItemIndexOf(int row) const;
    // The first row that carries item `index`; -1 where none does.
    int RowOfItem(int32 index) const;
    // Shows the row of item `index` as the current one (none for an index no
    // row carries). A program change: emits neither activated nor highlighted.
    void ShowItem(int32 index);
    bool IsPopupVisible() const { return mPopupVisible; }

    void showPopup() override;

signals:
    void popupShow();
    void popupHide();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    bool mPopupVisible = false;
};

} // namespace Orbane

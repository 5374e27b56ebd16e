#pragma once

#include <QComboBox>

namespace Orbane {

// A drop-down list that asks for its rows only when the user opens it: a
// list of every font on the machine costs more to fill than the rest of an
// inspector row, and most rows are never opened. FillRequested comes before
// the list shows, so the rows filled in it are the rows shown.
class LazyComboBox : public QComboBox
{
    Q_OBJECT
public:
    explicit LazyComboBox(QWidget *parent = nullptr) : QComboBox(parent) {}

    void showPopup() override;

signals:
    void FillRequested();
};

} // namespace Orbane

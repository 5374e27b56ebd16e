#pragma once

#include <QComboBox>

namespace Orbane {

// A drop-down list that asks for its rows only when the user opens it: a
// list of every font on the machine costs more to fill than the rest of an
// inspector row, and most rows are never opened. FillRequested comes before
// the list shows, so the rows filled in it are the rows shown.
//
// For the same reason it puts off a font change until the list is first
// opened: Qt makes the list's window to hand it the new font, and building
// an inspector sets the font of every control.
class LazyComboBox : public QComboBox
{
    Q_OBJECT
public:
    explicit LazyComboBox(QWidget *parent = nullptr) : QComboBox(parent) {}

    void showPopup() override;

protected:
    void changeEvent(QEvent *event) override;

signals:
    void FillRequested();

private:
    bool mListMade = false;
    bool mFontPending = false;
};

} // namespace Orbane

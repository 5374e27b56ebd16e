#pragma once

#include "orbane/Types.h"

#include <QLabel>

namespace Orbane {

// A one-line label that shortens its text with an ellipsis when it does not
// fit, instead of pushing the layout wider. Elide modes:
//   0 none (plain QLabel), 1 at the right, 2 at the left, 3 in the middle.
// While eliding it asks the layout only for the room of an ellipsis.
class ElideLabel : public QLabel
{
    Q_OBJECT
public:
    enum ElideMode : int32
    {
        Elide_None = 0,
        Elide_Right = 1,
        Elide_Left = 2,
        Elide_Middle = 3
    };

    explicit ElideLabel(QWidget *parent = nullptr);
    explicit ElideLabel(const QString &text, QWidget *parent = nullptr);
    ~ElideLabel() override;

    void setElideMode(int mode);
    int elideMode() const { return mMode; }

    // The text as it is painted at the current width.
    QString displayedText() const;
    bool isElided() const;

    QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent *event) override;

private:
    Qt::TextElideMode QtMode() const;

    int mMode = Elide_None;
};

} // namespace Orbane

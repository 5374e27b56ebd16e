#pragma once

#include <QDockWidget>

class QUndoView;

namespace Orbane {

class OrbaneDoc;

// The undo history in a dock: every step of the document's undo stack by
// name, the current one selected; choosing a row undoes or redoes up to it.
class UndoHistoryDock : public QDockWidget
{
    Q_OBJECT
public:
    explicit UndoHistoryDock(OrbaneDoc *doc, QWidget *parent = nullptr);

    QUndoView *View() const { return mView; }
    // The rows as shown: "<empty>" first, then each step's name.
    QStringList Rows() const;

private:
    QUndoView *mView;
};

} // namespace Orbane

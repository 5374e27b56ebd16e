#include "UndoHistoryDock.h"

#include "orbane/OrbaneDoc.h"

#include <QUndoView>

namespace Orbane {

UndoHistoryDock::UndoHistoryDock(OrbaneDoc *doc, QWidget *parent)
    : QDockWidget(tr("History"), parent), mView(new QUndoView(doc->UndoStack()))
{
    setObjectName("history");
    mView->setObjectName("undoView");
    mView->setEmptyLabel(tr("<empty>"));
    mView->setAccessibleName(tr("Undo history"));
    setWidget(mView);
}

QStringList UndoHistoryDock::Rows() const
{
    QStringList rows;
    const QAbstractItemModel *model = mView->model();
    for (int row = 0; row < model->rowCount(); ++row)
        rows << model->index(row, 0).data().toString();
    return rows;
}

} // namespace Orbane

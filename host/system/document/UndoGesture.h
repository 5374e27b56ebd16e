#pragma once

#include "ChangeSet.h"

#include <QUndoCommand>

namespace Orbane {

class UndoRecorder;

// One undo step: the values a gesture (or a single write) changed. It is
// pushed after the values are already stored, so the push's redo does
// nothing; later undo and redo swap the held values in and out.
class UndoGesture : public QUndoCommand
{
public:
    UndoGesture(UndoRecorder &recorder, const QString &name, ChangeSet changes);

    void undo() override;
    void redo() override;

    // The Input slots the step restores.
    std::size_t ChangeCount() const noexcept { return mChanges.Size(); }

private:
    void Replay();

    UndoRecorder &mRecorder;
    ChangeSet mChanges;
    bool mPushed = false;
};

} // namespace Orbane

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
    std::size_t Footprint() const noexcept { return mChanges.Footprint(); }
    // Lets go of the held values when the history outgrows its memory bound:
    // the step stays on the stack as an empty shell that cannot be undone.
    void Drop();
    bool IsDropped() const noexcept { return mDropped; }

private:
    void Replay();

    UndoRecorder &mRecorder;
    ChangeSet mChanges;
    bool mPushed = false;
    bool mDropped = false;
};

} // namespace Orbane

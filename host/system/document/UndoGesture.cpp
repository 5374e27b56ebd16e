#include "UndoGesture.h"

#include "UndoRecorder.h"

namespace Orbane {

UndoGesture::UndoGesture(UndoRecorder &recorder, const QString &name, ChangeSet changes)
    : QUndoCommand(name), mRecorder(recorder), mChanges(std::move(changes))
{
}

void UndoGesture::undo()
{
    Replay();
}

void UndoGesture::redo()
{
    // The first redo is QUndoStack::push: the values are stored already.
    if (!mPushed) {
        mPushed = true;
        return;
    }
    Replay();
}

void UndoGesture::Drop()
{
    mChanges = ChangeSet();
    mDropped = true;
}

void UndoGesture::Replay()
{
    UndoRecorder::Replay replay(mRecorder);
    mChanges.Swap();
}

} // namespace Orbane

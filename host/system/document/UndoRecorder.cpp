#include "UndoRecorder.h"

#include "UndoGesture.h"

#include <QCoreApplication>
#include <QUndoStack>

#include <utility>

namespace Orbane {

void UndoRecorder::Start(const char *name)
{
    if (mLevels.empty())
        mName = name && *name ? QString::fromUtf8(name) : QCoreApplication::translate("OrbaneDoc", "Edit");
    mLevels.emplace_back();
}

bool UndoRecorder::End(bool keep)
{
    if (mLevels.empty())
        return false;
    ChangeSet level = std::move(mLevels.back());
    mLevels.pop_back();
    if (!keep) {
        Replay replay(*this);
        level.Swap();
    } else if (mLevels.empty()) {
        level.Prune();
        if (!level.IsEmpty())
            Push(mName, std::move(level));
    }
    return true;
}

void UndoRecorder::Record(Input *in, const Input::Slot &slot, AutoRef<Parameter> value)
{
    AutoRef<Parameter> before = in->Exchange(slot, std::move(value));
    if (mReplaying)
        return;
    if (mLevels.empty()) {
        ChangeSet one;
        one.Note(in, slot, before);
        Push(QCoreApplication::translate("OrbaneDoc", "Change %1").arg(QString::fromUtf8(in->GetName())),
             std::move(one));
        return;
    }
    for (ChangeSet &level : mLevels)
        level.Note(in, slot, before);
}

void UndoRecorder::RecordAnimated(Input *in, bool animated)
{
    const bool before = std::exchange(in->mAnimated, animated);
    if (mReplaying)
        return;
    for (ChangeSet &level : mLevels)
        level.NoteAnimated(in, before);
}

void UndoRecorder::Push(const QString &name, ChangeSet changes)
{
    mStack.push(new UndoGesture(*this, name, std::move(changes)));
    Trim();
}

void UndoRecorder::SetBounds(int steps, std::size_t bytes)
{
    // QUndoStack drops its oldest steps past the count by itself, but takes
    // a new count only while it is empty.
    if (mStack.count() == 0)
        mStack.setUndoLimit(steps);
    mMaxBytes = bytes;
}

const UndoGesture *UndoRecorder::StepAt(int i) const
{
    const auto *step = dynamic_cast<const UndoGesture *>(mStack.command(i));
    return step && !step->IsDropped() ? step : nullptr;
}

// Past the memory bound the oldest steps let go of their values, never the
// newest step: a history of one step keeps it, however large.
void UndoRecorder::Trim()
{
    std::size_t total = 0;
    for (int i = 0; i < mStack.count(); ++i)
        total += StepAt(i) ? StepAt(i)->Footprint() : 0;
    for (int i = 0; i + 1 < mStack.count() && total > mMaxBytes; ++i) {
        // The stack hands out its steps as const; they are ours to change.
        auto *step = const_cast<UndoGesture *>(StepAt(i));
        if (!step)
            continue;
        total -= step->Footprint();
        step->Drop();
    }
}

} // namespace Orbane

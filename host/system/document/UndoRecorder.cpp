#include "UndoRecorder.h"

#include "UndoGesture.h"

#include <QCoreApplication>
#include <QUndoStack>

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

void UndoRecorder::Push(const QString &name, ChangeSet changes)
{
    mStack.push(new UndoGesture(*this, name, std::move(changes)));
}

} // namespace Orbane

#pragma once

#include "ChangeSet.h"

#include <QString>

#include <vector>

class QUndoStack;

namespace Orbane {

class UndoGesture;

// Turns the values Inputs store into undo steps on a QUndoStack. Each open
// StartUndo level keeps a ChangeSet of the slots it touched; the outermost
// one becomes the step.
class UndoRecorder
{
public:
    explicit UndoRecorder(QUndoStack &stack) : mStack(stack) {}

    void Start(const char *name);
    bool End(bool keep);
    int Depth() const noexcept { return int(mLevels.size()); }
    // Drops any open gesture without touching values.
    void Abandon() noexcept { mLevels.clear(); }

    // Stores `value` in the Input's slot and records the change: in every
    // open level, or as a step of its own where none is open.
    void Record(Input *in, const Input::Slot &slot, AutoRef<Parameter> value);
    // Switches the Input's animation and records the switch in every open
    // level; callers open a gesture around it (Input::Animate does).
    void RecordAnimated(Input *in, bool animated);

    // While a step is undone, redone or rolled back, values written in reply
    // (by watchers) are stored but not recorded: the stack is busy with the
    // step, and the step already says what the values are.
    class Replay
    {
    public:
        explicit Replay(UndoRecorder &r) : mRecorder(r), mWas(r.mReplaying) { r.mReplaying = true; }
        ~Replay() { mRecorder.mReplaying = mWas; }
        Replay(const Replay &) = delete;
        Replay &operator=(const Replay &) = delete;

    private:
        UndoRecorder &mRecorder;
        bool mWas;
    };

    // The bounds of the history; the count only while the stack is empty.
    void SetBounds(int steps, std::size_t bytes);
    // The step at the stack's index i, null where it was dropped.
    const UndoGesture *StepAt(int i) const;

private:
    void Push(const QString &name, ChangeSet changes);
    void Trim();

    QUndoStack &mStack;
    QString mName;
    std::vector<ChangeSet> mLevels;
    bool mReplaying = false;
    std::size_t mMaxBytes = 0;
};

} // namespace Orbane

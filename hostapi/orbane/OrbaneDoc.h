#pragma once

#include "orbane/Operator.h"
#include "orbane/OrbString.h"
#include "orbane/Prefs.h"
#include "orbane/TagList.h"

#include <QObject>
#include <QStringList>

#include <map>
#include <memory>
#include <string>
#include <vector>

class QUndoStack;

namespace Orbane {

class ExpressionGraph;
class Input;
class UndoRecorder;

// The document: its tools, the current time, preferences, and undo.
//
// Undo: every value an Input stores through SetValue is recorded here. Inside
// StartUndo/EndUndo (nestable; the outermost pair counts) all writes form one
// step named by the outermost StartUndo, however many there are: each Input
// slot (plain value or key) is recorded once, with its value from before the
// gesture, so a drag of a thousand moves is one small record, and slots the
// gesture put back as they were are dropped. A gesture that changed nothing
// leaves no step. A write outside any gesture is a step of its own, named
// "Change <Input name>". Undo and redo swap the exact stored values back and
// tell every watcher of the Inputs concerned.
class OrbaneDoc : public QObject
{
    Q_OBJECT
public:
    explicit OrbaneDoc(QObject *parent = nullptr);
    ~OrbaneDoc() override;

    float64 GetCurrentTime() const noexcept { return mCurrentTime; }
    // Emits currentTimeChanged and tells every Input's watchers the value at
    // the new time; a time equal to the current one does nothing.
    void SetCurrentTime(float64 time);

    // Preferences, by PREF_ tag; read them with a default (GetLong(PREF_..., 0)).
    const TagList &GetPrefs() const noexcept { return mPrefs; }
    void SetPref(Tag pref, const TagValue &value);

    // Takes a reference to the tool. Refuses null, a tool that already has a
    // document, and a name that another tool has.
    bool AddTool(Operator *tool);
    // Emits toolRemoving first, so views can unbind their controls.
    bool RemoveTool(Operator *tool);
    const std::vector<Operator *> &Tools() const noexcept { return mTools; }
    Operator *FindTool(const char *name) const;

    // Saved work: the comp file the document was last saved to or opened
    // from (empty for new work), and whether it changed since. A change is an
    // undo step away from the saved one, or a change outside undo that its
    // maker marks (a tool added or removed, an interpolation switched).
    const std::string &CompPath() const noexcept { return mCompPath; }
    bool IsModified() const;
    void MarkModified();
    // After a save (or an open): the document is `path` and unmodified.
    void MarkSaved(const std::string &path);
    // New work: removes every tool (toolRemoving first), empties the undo
    // history, time 0, no viewer image (pixel aspect 1), no comp path,
    // unmodified.
    void Clear();

    QUndoStack *UndoStack() const noexcept { return mUndoStack.get(); }
    // The history keeps at most this many steps and about this many bytes of
    // recorded values; past either bound the oldest steps go first.
    static constexpr int kMaxUndoSteps = 1000;
    static constexpr std::size_t kMaxUndoBytes = std::size_t(256) << 20;
    // Other bounds; the step count can change only while the history is empty.
    void SetUndoBounds(int steps, std::size_t bytes);
    void StartUndo(const char *name, const TagList *tags = nullptr);
    // Closes one level. At the outermost level `keep` pushes the gesture as
    // one undo step; at any level `keep == false` puts back every value the
    // level changed and records nothing of it. False where nothing is open.
    bool EndUndo(bool keep = true, const TagList *tags = nullptr);
    int UndoDepth() const noexcept;
    // Texts of the steps that can be undone, oldest first, and of those that
    // can be redone, next first.
    QStringList UndoNames() const;
    QStringList RedoNames() const;
    // While a gesture is open there is nothing to undo or redo.
    bool CanUndo() const;
    bool CanRedo() const;
    bool Undo();
    bool Redo();

    // Hooks the application serves: a flag it reads, and requests it answers.
    void SetAutoProxy(bool on);
    bool GetAutoProxy() const noexcept { return mAutoProxy; }
    void SyncRender();
    void RenderInteractive();
    void UpdateScripting();
    // Maps "Prefix:rest" to "<folder>/rest" for a prefix set with SetPathMap
    // (compared without case); any other path comes back unchanged.
    void SetPathMap(const char *prefix, const char *folder);
    OrbString MapPath(const char *path) const;

signals:
    void currentTimeChanged(float64 time);
    void toolAdded(Orbane::Operator *tool);
    void toolRemoving(Orbane::Operator *tool);
    void prefChanged(uint32 pref);
    void autoProxyChanged(bool on);
    void syncRenderRequested();
    void interactiveRenderRequested();
    void scriptingUpdateRequested();
    void modifiedChanged(bool modified);
    void compPathChanged(const QString &path);

private:
    friend class Input;
    friend class ChangeSet;
    // Where Input::SetValue stores values that are recorded for undo.
    UndoRecorder &Recorder() const noexcept { return *mRecorder; }
    void TellModified();
    // The live expressions of the Inputs, evaluated in dependency order.
    ExpressionGraph &Expressions() const noexcept { return *mExpressions; }

    float64 mCurrentTime = 0.0;
    TagList mPrefs;
    std::vector<Operator *> mTools; // one reference each
    std::unique_ptr<QUndoStack> mUndoStack;
    std::unique_ptr<UndoRecorder> mRecorder;
    std::unique_ptr<ExpressionGraph> mExpressions;
    bool mAutoProxy = false;
    std::map<std::string, std::string> mPathMap; // lower-case prefix -> folder
    std::string mCompPath;
    bool mChangedOutsideUndo = false;
    bool mToldModified = false;
};

} // namespace Orbane

Q_DECLARE_METATYPE(Orbane::Operator *)

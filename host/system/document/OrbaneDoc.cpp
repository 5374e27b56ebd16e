#include "orbane/OrbaneDoc.h"

#include "ExpressionGraph.h"
#include "UndoRecorder.h"

#include "orbane/AutoRef.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QUndoStack>

#include <algorithm>
#include <cctype>
#include <cstring>

namespace Orbane {

namespace {
std::string Lower(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) { return char(std::tolower(c)); });
    return text;
}
} // namespace

OrbaneDoc::OrbaneDoc(QObject *parent)
    : QObject(parent), mUndoStack(std::make_unique<QUndoStack>()),
      mRecorder(std::make_unique<UndoRecorder>(*mUndoStack)), mExpressions(std::make_unique<ExpressionGraph>(*this))
{
    // Signals carry these by their contract names; queued connections and
    // spies need to know them.
    qRegisterMetaType<float64>("float64");
    qRegisterMetaType<uint32>("uint32");
    qRegisterMetaType<Operator *>("Orbane::Operator*");
    SetUndoBounds(kMaxUndoSteps, kMaxUndoBytes);
    mPrefs.Set(PREF_ExportSplineMode, 0);
    mPrefs.Set(PREF_SelectPointsFromMultiPolies, 0);
    connect(mUndoStack.get(), &QUndoStack::cleanChanged, this, [this](bool) { TellModified(); });
}

OrbaneDoc::~OrbaneDoc()
{
    // Steps hold Inputs and refer to the recorder: they go first.
    mRecorder->Abandon();
    mUndoStack->clear();
    for (Operator *tool : mTools) {
        tool->SetDoc(nullptr);
        tool->DecRef();
    }
}

void OrbaneDoc::SetCurrentTime(float64 time)
{
    if (time == mCurrentTime)
        return;
    mCurrentTime = time;
    mExpressions->TimeChanged();
    // Watchers may remove tools while they are told.
    std::vector<AutoRef<Operator>> tools;
    for (Operator *tool : mTools)
        tools.push_back(AutoRef<Operator>::Share(tool));
    for (const AutoRef<Operator> &tool : tools)
        for (std::size_t i = 0; i < tool->Inputs().size(); ++i)
            tool->Inputs()[i]->Notify();
    emit currentTimeChanged(time);
}

void OrbaneDoc::SetPref(Tag pref, const TagValue &value)
{
    mPrefs.Set(pref, value);
    emit prefChanged(pref);
}

bool OrbaneDoc::AddTool(Operator *tool)
{
    if (!tool || tool->GetDoc() || FindTool(tool->GetName()))
        return false;
    tool->IncRef();
    tool->SetDoc(this);
    mTools.push_back(tool);
    mExpressions->ToolsChanged();
    emit toolAdded(tool);
    MarkModified();
    return true;
}

bool OrbaneDoc::RemoveTool(Operator *tool)
{
    if (std::find(mTools.begin(), mTools.end(), tool) == mTools.end())
        return false;
    emit toolRemoving(tool);
    // A slot may have removed it already.
    const auto it = std::find(mTools.begin(), mTools.end(), tool);
    if (it == mTools.end())
        return true;
    mTools.erase(it);
    tool->SetDoc(nullptr);
    mExpressions->ToolsChanged();
    tool->DecRef();
    MarkModified();
    return true;
}

Operator *OrbaneDoc::FindTool(const char *name) const
{
    if (!name)
        return nullptr;
    for (Operator *tool : mTools)
        if (std::strcmp(tool->GetName(), name) == 0)
            return tool;
    return nullptr;
}

bool OrbaneDoc::IsModified() const
{
    return mChangedOutsideUndo || !mUndoStack->isClean();
}

void OrbaneDoc::MarkModified()
{
    mChangedOutsideUndo = true;
    TellModified();
}

void OrbaneDoc::MarkSaved(const std::string &path)
{
    mChangedOutsideUndo = false;
    mUndoStack->setClean();
    TellModified();
    if (path != mCompPath) {
        mCompPath = path;
        emit compPathChanged(QString::fromStdString(path));
    }
}

// Both the undo stack and marks change the state; watchers hear of each
// change once.
void OrbaneDoc::TellModified()
{
    const bool now = IsModified();
    if (now == mToldModified)
        return;
    mToldModified = now;
    emit modifiedChanged(now);
}

void OrbaneDoc::Clear()
{
    while (!mTools.empty())
        RemoveTool(mTools.back());
    mRecorder->Abandon();
    mUndoStack->clear();
    SetCurrentTime(0.0);
    SetPref(PREF_ViewerImage, "");
    SetPref(PREF_ViewerPixelAspect, 1.0);
    MarkSaved(std::string());
}

void OrbaneDoc::StartUndo(const char *name, const TagList *)
{
    mRecorder->Start(name);
}

bool OrbaneDoc::EndUndo(bool keep, const TagList *)
{
    return mRecorder->End(keep);
}

int OrbaneDoc::UndoDepth() const noexcept
{
    return mRecorder->Depth();
}

void OrbaneDoc::SetUndoBounds(int steps, std::size_t bytes)
{
    mRecorder->SetBounds(steps, bytes);
}

// Dropped steps are gone from the history as the user sees it.
QStringList OrbaneDoc::UndoNames() const
{
    QStringList names;
    for (int i = 0; i < mUndoStack->index(); ++i)
        if (mRecorder->StepAt(i))
            names << mUndoStack->text(i);
    return names;
}

QStringList OrbaneDoc::RedoNames() const
{
    QStringList names;
    for (int i = mUndoStack->index(); i < mUndoStack->count(); ++i)
        names << mUndoStack->text(i);
    return names;
}

bool OrbaneDoc::CanUndo() const
{
    return UndoDepth() == 0 && mUndoStack->canUndo() && mRecorder->StepAt(mUndoStack->index() - 1);
}

bool OrbaneDoc::CanRedo() const
{
    return UndoDepth() == 0 && mUndoStack->canRedo();
}

bool OrbaneDoc::Undo()
{
    if (!CanUndo())
        return false;
    mUndoStack->undo();
    return true;
}

bool OrbaneDoc::Redo()
{
    if (!CanRedo())
        return false;
    mUndoStack->redo();
    return true;
}

void OrbaneDoc::SetAutoProxy(bool on)
{
    if (on == mAutoProxy)
        return;
    mAutoProxy = on;
    emit autoProxyChanged(on);
}

void OrbaneDoc::SyncRender()
{
    emit syncRenderRequested();
}

void OrbaneDoc::RenderInteractive()
{
    emit interactiveRenderRequested();
}

void OrbaneDoc::UpdateScripting()
{
    emit scriptingUpdateRequested();
}

void OrbaneDoc::SetPathMap(const char *prefix, const char *folder)
{
    if (!prefix || !*prefix)
        return;
    if (folder)
        mPathMap[Lower(prefix)] = folder;
    else
        mPathMap.erase(Lower(prefix));
}

OrbString OrbaneDoc::MapPath(const char *path) const
{
    if (!path)
        return OrbString();
    const char *colon = std::strchr(path, ':');
    if (!colon)
        return OrbString(path);
    const auto it = mPathMap.find(Lower(std::string(path, colon)));
    if (it == mPathMap.end())
        return OrbString(path);
    std::string rest(colon + 1);
    std::string mapped = it->second;
    if (!rest.empty() && !mapped.empty() && mapped.back() != '/' && rest.front() != '/')
        mapped += '/';
    return OrbString(mapped + rest);
}

} // namespace Orbane

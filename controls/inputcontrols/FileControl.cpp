#include "inputcontrols/FileControl.h"

#include "framework/FileTags.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/PathChooser.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Text.h"

#include <QDir>
#include <QFileInfo>
#include <QLineEdit>
#include <QToolButton>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.File.Layout";

} // namespace

FileControl::FileControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mChooser(new PathChooser(this))
{
    connect(mChooser, SIGNAL(Chosen(QString)), this, SLOT(OnChosen(QString)));
    RegisterChild("edit", mChooser->Edit());
    RegisterChild("browse", mChooser->Browse());
    Label()->setFocusProxy(mChooser->Edit());
    AddAttr(FC_SaveFile, &mSave, Attr_CopyAndList);
    AddAttr(FC_Directory, &mDirectory, Attr_CopyAndList);
    AddAttr(FC_RelativeToComp, &mRelative, Attr_CopyAndList);
    ListAttr(FCS_Filter, &mFilter);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

FileControl::~FileControl() = default;

void FileControl::ReadOwnTags(const TagList &tags)
{
    mSave = tags.GetBool(FC_SaveFile, mSave);
    mDirectory = tags.GetBool(FC_Directory, mDirectory);
    mRelative = tags.GetBool(FC_RelativeToComp, mRelative);
    if (tags.FindQuery(FCS_Filter))
        mFilter = OrbString(tags.GetString(FCS_Filter, ""));
    mChooser->SetMode(mDirectory ? PathChooser::Mode_Folder : mSave ? PathChooser::Mode_Save : PathChooser::Mode_Open);
    mChooser->SetFilter(QString::fromStdString(mFilter.str()));
}

bool FileControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const bool wasSave = mSave, wasDirectory = mDirectory;
    ReadOwnTags(tags);
    // What counts as missing depends on the mode.
    if (IsOpen() && (wasSave != mSave || wasDirectory != mDirectory))
        ShowPath();
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool FileControl::AddInput(Input *input, const TagList *tags)
{
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (const AutoText now(input, GetCurrentTime()); now && input == GetCurrentInput())
        mPath = now->Value;
    return true;
}

bool FileControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    Label()->show();
    mChooser->Edit()->show();
    mChooser->Browse()->show();
    ShowPath();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool FileControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *text = dynamic_cast<const Text *>(value);
    if (!text || text->Value == mPath)
        return true;
    mPath = text->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool FileControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowPath();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

QString FileControl::MissingReason(const QString &path, bool save, bool folder)
{
    if (path.isEmpty())
        return QString();
    const QFileInfo info(path);
    if (folder)
        return info.isDir() ? QString() : "No such folder: " + path;
    if (save)
        return info.absoluteDir().exists() ? QString() : "No such folder: " + info.absolutePath();
    return info.isFile() ? QString() : "No such file: " + path;
}

void FileControl::ShowPath()
{
    const QString path = QString::fromStdString(mPath.str());
    const QString why = MissingReason(PathChooser::Resolve(path, PathChooser::CompFolder(GetDoc())), mSave, mDirectory);
    mChooser->Show(path, !why.isEmpty(), why);
}

void FileControl::OnChosen(const QString &path)
{
    const OrbString stored(PathChooser::Stored(path, PathChooser::CompFolder(GetDoc()), mRelative).toStdString());
    if (stored != mPath) {
        const AutoText text(stored);
        SetInputs(text, GetCurrentTime(), 0, false, nullptr);
        ResetUndo(nullptr);
    }
    // A relative path typed or a refused write shows what the Input holds.
    ShowPath();
}

bool FileControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, AutoText(mPath).get());
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

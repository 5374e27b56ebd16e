#include "FileMenu.h"

#include "RecentFiles.h"

#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <QFileDialog>
#include <QFileInfo>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>

#include <string>

namespace Orbane {

namespace {

const char kCompFilter[] = "Comps (*.lua);;All files (*)";

FileMenu::Answer AskWithDialog(QWidget *parent, const QString &question)
{
    const auto button =
        QMessageBox::warning(parent, QObject::tr("Unsaved changes"), question,
                             QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel, QMessageBox::Save);
    if (button == QMessageBox::Save)
        return FileMenu::Answer::Save;
    return button == QMessageBox::Discard ? FileMenu::Answer::Discard : FileMenu::Answer::Cancel;
}

QString ChooseWithDialog(QWidget *parent, bool saving, const QString &suggested)
{
    return saving ? QFileDialog::getSaveFileName(parent, QObject::tr("Save Comp"), suggested, kCompFilter)
                  : QFileDialog::getOpenFileName(parent, QObject::tr("Open Comp"), suggested, kCompFilter);
}

} // namespace

FileMenu::FileMenu(OrbaneDoc *doc, QMainWindow *window, RecentFiles *recent)
    : QObject(window), mDoc(doc), mWindow(window), mRecent(recent)
{
    mAsk = [window](const QString &question) { return AskWithDialog(window, question); };
    mChoose = [window](bool saving, const QString &suggested) { return ChooseWithDialog(window, saving, suggested); };
    mTell = [window](const QString &message) { QMessageBox::critical(window, tr("Orbane"), message); };
    BuildMenu();
    connect(recent, &RecentFiles::changed, this, &FileMenu::FillRecent);
    // Another window may have saved or opened comps since.
    connect(mRecentMenu, &QMenu::aboutToShow, this, &FileMenu::FillRecent);
    connect(doc, &OrbaneDoc::modifiedChanged, this, &FileMenu::UpdateTitle);
    connect(doc, &OrbaneDoc::compPathChanged, this, &FileMenu::UpdateTitle);
    FillRecent();
    UpdateTitle();
}

void FileMenu::BuildMenu()
{
    mMenu = mWindow->menuBar()->addMenu(tr("&File"));
    mMenu->setObjectName("fileMenu");
    mMenu->addAction(tr("&New"), this, &FileMenu::New, QKeySequence::New);
    mMenu->addAction(tr("&Open..."), this, &FileMenu::Open, QKeySequence::Open);
    mRecentMenu = mMenu->addMenu(tr("Open &Recent"));
    mMenu->addSeparator();
    mMenu->addAction(tr("&Save"), this, &FileMenu::Save, QKeySequence::Save);
    mMenu->addAction(tr("Save &As..."), this, &FileMenu::SaveAs, QKeySequence::SaveAs);
    mMenu->addSeparator();
    mMenu->addAction(
        tr("&Quit"), this,
        [this] {
            if (MaybeKeepWork())
                emit quitRequested();
        },
        QKeySequence::Quit);
}

void FileMenu::FillRecent()
{
    mRecentMenu->clear();
    const QStringList paths = mRecent->Paths();
    for (const QString &path : paths)
        mRecentMenu->addAction(path, this, [this, path] { OpenPath(path); });
    if (!paths.isEmpty()) {
        mRecentMenu->addSeparator();
        mRecentMenu->addAction(tr("Clear Menu"), mRecent, &RecentFiles::Clear);
    }
}

QString FileMenu::TitleName() const
{
    const QString path = QString::fromStdString(mDoc->CompPath());
    return path.isEmpty() ? tr("Untitled") : QFileInfo(path).fileName();
}

void FileMenu::UpdateTitle()
{
    mWindow->setWindowTitle(TitleName() + "[*] - Orbane");
    mWindow->setWindowModified(mDoc->IsModified());
}

void FileMenu::Tell(const QString &message)
{
    mLastMessage = message;
    mTell(message);
}

bool FileMenu::Fail(const QString &message)
{
    Tell(message);
    return false;
}

bool FileMenu::MaybeKeepWork()
{
    if (!mDoc->IsModified())
        return true;
    switch (mAsk(tr("%1 has unsaved changes. Save them?").arg(TitleName()))) {
    case Answer::Save:
        return Save();
    case Answer::Discard:
        return true;
    case Answer::Cancel:
        break;
    }
    return false;
}

bool FileMenu::New()
{
    if (!MaybeKeepWork())
        return false;
    mDoc->Clear();
    mLastMessage.clear();
    return true;
}

bool FileMenu::Open()
{
    if (!MaybeKeepWork())
        return false;
    const QString path = mChoose(false, QFileInfo(QString::fromStdString(mDoc->CompPath())).path());
    return !path.isEmpty() && Load(path);
}

// A comp that cannot be read leaves the document as it was; a recent entry
// whose file is gone leaves the list.
bool FileMenu::OpenPath(const QString &path)
{
    return MaybeKeepWork() && Load(path);
}

bool FileMenu::Load(const QString &path)
{
    std::string why;
    if (!ToolLoader::OpenComp(*mDoc, path.toStdString(), &why)) {
        if (!QFileInfo::exists(path))
            mRecent->Remove(path);
        return Fail(tr("Cannot open %1: %2").arg(path, QString::fromStdString(why)));
    }
    mRecent->Add(path);
    mLastMessage.clear();
    return true;
}

bool FileMenu::Save()
{
    const QString path = QString::fromStdString(mDoc->CompPath());
    return path.isEmpty() ? SaveAs() : SaveTo(path);
}

bool FileMenu::SaveAs()
{
    const QString current = QString::fromStdString(mDoc->CompPath());
    const QString path = mChoose(true, current.isEmpty() ? QStringLiteral("untitled.lua") : current);
    return !path.isEmpty() && SaveTo(path);
}

bool FileMenu::SaveTo(const QString &path)
{
    std::string why;
    if (!ToolLoader::SaveComp(*mDoc, path.toStdString(), &why))
        return Fail(tr("Cannot save %1: %2").arg(path, QString::fromStdString(why)));
    mRecent->Add(path);
    mLastMessage.clear();
    return true;
}

} // namespace Orbane

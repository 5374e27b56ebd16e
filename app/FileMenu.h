#pragma once

#include <QObject>
#include <QString>

#include <functional>

class QAction;
class QMainWindow;
class QMenu;

namespace Orbane {

class OrbaneDoc;
class RecentFiles;

// The File menu and what it does to the document: New, Open, Open Recent,
// Save, Save As and Quit with the platform's shortcuts; the window title
// with the comp's name and the modified mark; and the question before work
// would be lost. The dialogs go through replaceable hooks, so tests and
// headless scripts answer them the way a user would.
class FileMenu : public QObject
{
    Q_OBJECT
public:
    enum class Answer
    {
        Save,
        Discard,
        Cancel
    };
    // Asked before unsaved work would be lost.
    using AskFn = std::function<Answer(const QString &question)>;
    // A comp path to open or to save to; empty where the user cancelled.
    using ChooseFn = std::function<QString(bool saving, const QString &suggested)>;
    // A failure the user must hear of.
    using TellFn = std::function<void(const QString &message)>;

    FileMenu(OrbaneDoc *doc, QMainWindow *window, RecentFiles *recent);

    QMenu *Menu() const { return mMenu; }
    QMenu *RecentMenu() const { return mRecentMenu; }

    void SetAsk(AskFn ask) { mAsk = std::move(ask); }
    void SetChoose(ChooseFn choose) { mChoose = std::move(choose); }
    void SetTell(TellFn tell) { mTell = std::move(tell); }
    // The last failure told (empty after a success).
    const QString &LastMessage() const { return mLastMessage; }

    // The gestures; false where nothing was done (cancelled or failed).
    bool New();
    bool Open();
    bool OpenPath(const QString &path);
    bool Save();
    bool SaveAs();
    bool SaveTo(const QString &path);
    // Asks to keep unsaved work where there is any: true where the caller
    // may go on (saved, discarded or nothing to lose).
    bool MaybeKeepWork();

    QString TitleName() const;
    // The hooks, for the window's own questions (recovery at start-up).
    Answer Ask(const QString &question) const { return mAsk(question); }
    void Tell(const QString &message);

signals:
    // Quit was chosen and the work is safe: the window closes.
    void quitRequested();

private:
    void BuildMenu();
    void FillRecent();
    void UpdateTitle();
    bool Fail(const QString &message);
    // Opens without asking: the caller asked already.
    bool Load(const QString &path);

    OrbaneDoc *mDoc;
    QMainWindow *mWindow;
    RecentFiles *mRecent;
    QMenu *mMenu = nullptr;
    QMenu *mRecentMenu = nullptr;
    AskFn mAsk;
    ChooseFn mChoose;
    TellFn mTell;
    QString mLastMessage;
};

} // namespace Orbane

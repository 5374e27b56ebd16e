#pragma once

#include <QObject>
#include <QString>

class QTimer;

namespace Orbane {

class OrbaneDoc;

// Writes the document to a recovery file while it has unsaved changes, so a
// crash loses at most one interval of work. The file lives in the
// application's data folder (QStandardPaths::AppDataLocation); one per user:
// a second window of the same user shares it, the last writer wins. It is
// removed whenever the document becomes unmodified (saved, opened, new) and on
// a clean quit, so finding it at start-up means the last session ended
// without either: the window then offers to restore it.
class AutoSave : public QObject
{
    Q_OBJECT
public:
    // Starts off; SetEnabled(true) arms it.
    explicit AutoSave(OrbaneDoc *doc, QObject *parent = nullptr);
    ~AutoSave() override;

    static constexpr int kIntervalMs = 60 * 1000;
    // Off, it neither writes nor removes the recovery file: headless runs
    // start with it off, so a script never touches a user's recovery file
    // unless it asks to.
    void SetEnabled(bool on);
    bool IsEnabled() const { return mEnabled; }
    void SetInterval(int ms);
    int Interval() const;

    static QString RecoveryPath();
    static bool HasRecovery();
    // The comp the recovered work was saved under (empty for an unsaved one).
    static QString RecoveredCompPath();

    // Writes the recovery file now where the document is modified; false
    // where it was not written (clean document, or an error in `error`).
    bool WriteNow(QString *error = nullptr);
    // Loads the recovery file into the (emptied) document, which keeps the
    // comp path it had and stays modified; then removes the file.
    bool Restore(QString *error);
    // Removes the recovery file (a clean quit, or the user declined it).
    static void Discard();

private slots:
    void OnModifiedChanged(bool modified);
    void OnTimeout();

private:
    OrbaneDoc *mDoc;
    QTimer *mTimer;
    bool mEnabled = false;
};

} // namespace Orbane

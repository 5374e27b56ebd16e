#pragma once

#include "orbane/Types.h"

#include <QObject>
#include <QString>

class QLineEdit;
class QToolButton;
class QWidget;

namespace Orbane {

class OrbaneDoc;

// The path part of the file and clip controls: an edit box ("edit") that
// takes a typed path on Enter, a browse button ("browse") that opens a file
// dialog, and drops of a file anywhere on the owning control. Whichever way
// the user gives a path, Chosen tells the control once; the control decides
// what to write. The edit shows a path in red, with the reason as its tip
// and the "missing" property set, where the control says it is missing.
class PathChooser : public QObject
{
    Q_OBJECT
public:
    enum Mode : int32
    {
        Mode_Open,   // an existing file
        Mode_Save,   // a file that may not exist yet
        Mode_Folder, // a folder
    };

    // Makes the edit and the button as children of `owner`, and takes the
    // file drops on it.
    explicit PathChooser(QWidget *owner);

    QLineEdit *Edit() const { return mEdit; }
    QToolButton *Browse() const { return mBrowse; }

    void SetMode(Mode mode) { mMode = mode; }
    void SetFilter(const QString &filter) { mFilter = filter; }
    // Shows `path` (unless the user is typing one), marked where `missing`.
    void Show(const QString &path, bool missing, const QString &why);

    // A path as written in an Input made absolute: a relative one starts at
    // `folder` (the comp's).
    static QString Resolve(const QString &path, const QString &folder);
    // What to write for a path the user gave: with `relative`, an absolute
    // path is written relative to `folder`.
    static QString Stored(const QString &path, const QString &folder, bool relative);
    // Where relative paths start: the folder of the document's comp, or
    // empty (the current directory).
    static QString CompFolder(const OrbaneDoc *doc);

signals:
    void Chosen(const QString &path);

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private slots:
    void OnBrowse();
    void OnEdited();
    void OnDialogChosen(const QString &path);

private:
    QWidget *mOwner;
    QLineEdit *mEdit;
    QToolButton *mBrowse;
    Mode mMode = Mode_Open;
    QString mFilter;
    QString mShown;
};

} // namespace Orbane

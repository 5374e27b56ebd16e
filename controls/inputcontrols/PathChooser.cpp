#include "inputcontrols/PathChooser.h"

#include "orbane/OrbaneDoc.h"
#include "orbane/Prefs.h"

#include <QDir>
#include <QDragEnterEvent>
#include <QDropEvent>
#include <QFileDialog>
#include <QLineEdit>
#include <QMimeData>
#include <QToolButton>
#include <QUrl>

namespace Orbane {

namespace {

// The colour of a path that is not on disk: readable on the dark and the
// light theme alike.
const QColor kMissingColour(224, 88, 64);

// The first local file of a drag, or empty.
QString DroppedFile(const QMimeData *mime)
{
    if (!mime || !mime->hasUrls())
        return QString();
    for (const QUrl &url : mime->urls())
        if (url.isLocalFile())
            return url.toLocalFile();
    return QString();
}

} // namespace

PathChooser::PathChooser(QWidget *owner)
    : QObject(owner), mOwner(owner), mEdit(new QLineEdit(owner)), mBrowse(new QToolButton(owner))
{
    mEdit->setObjectName("edit");
    mBrowse->setObjectName("browse");
    mBrowse->setText("...");
    mBrowse->setToolTip("Browse");
    connect(mEdit, SIGNAL(editingFinished()), this, SLOT(OnEdited()));
    connect(mBrowse, SIGNAL(clicked()), this, SLOT(OnBrowse()));
    // The edit would take a dropped file as text: both go through the filter.
    owner->setAcceptDrops(true);
    owner->installEventFilter(this);
    mEdit->installEventFilter(this);
}

void PathChooser::Show(const QString &path, bool missing, const QString &why)
{
    mShown = path;
    if (!mEdit->isModified())
        mEdit->setText(path);
    mEdit->setProperty("missing", missing);
    mEdit->setToolTip(missing ? why : path);
    QPalette palette = mOwner->palette();
    if (missing)
        palette.setColor(QPalette::Text, kMissingColour);
    mEdit->setPalette(palette);
}

QString PathChooser::Resolve(const QString &path, const QString &folder)
{
    if (path.isEmpty() || QDir::isAbsolutePath(path))
        return path;
    return QDir(folder.isEmpty() ? QDir::currentPath() : folder).absoluteFilePath(path);
}

QString PathChooser::Stored(const QString &path, const QString &folder, bool relative)
{
    if (!relative || path.isEmpty() || !QDir::isAbsolutePath(path))
        return path;
    return QDir(folder.isEmpty() ? QDir::currentPath() : folder).relativeFilePath(path);
}

QString PathChooser::CompFolder(const OrbaneDoc *doc)
{
    return doc ? QString::fromUtf8(doc->GetPrefs().GetString(PREF_CompFolder, "")) : QString();
}

void PathChooser::OnEdited()
{
    // Leaving the box untouched chooses nothing.
    if (!mEdit->isModified())
        return;
    mEdit->setModified(false);
    emit Chosen(mEdit->text().trimmed());
}

// A dialog of Qt's own, opened without blocking: the inspector keeps
// painting, and a script can reach it like any other window.
void PathChooser::OnBrowse()
{
    auto *dialog = new QFileDialog(mOwner, "Choose", QFileInfo(mShown).absolutePath(), mFilter);
    dialog->setObjectName("browseDialog");
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setOption(QFileDialog::DontUseNativeDialog);
    if (mMode == Mode_Folder) {
        dialog->setFileMode(QFileDialog::Directory);
        dialog->setOption(QFileDialog::ShowDirsOnly);
    } else if (mMode == Mode_Save) {
        dialog->setAcceptMode(QFileDialog::AcceptSave);
    } else {
        dialog->setFileMode(QFileDialog::ExistingFile);
    }
    dialog->open(this, SLOT(OnDialogChosen(QString)));
}

void PathChooser::OnDialogChosen(const QString &path)
{
    emit Chosen(QDir::cleanPath(path));
}

bool PathChooser::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::DragEnter || event->type() == QEvent::DragMove) {
        auto *drag = static_cast<QDragMoveEvent *>(event);
        if (DroppedFile(drag->mimeData()).isEmpty())
            return false;
        drag->acceptProposedAction();
        return true;
    }
    if (event->type() == QEvent::Drop) {
        auto *drop = static_cast<QDropEvent *>(event);
        const QString file = DroppedFile(drop->mimeData());
        if (file.isEmpty())
            return false;
        drop->acceptProposedAction();
        mEdit->setModified(false);
        emit Chosen(file);
        return true;
    }
    return QObject::eventFilter(watched, event);
}

} // namespace Orbane

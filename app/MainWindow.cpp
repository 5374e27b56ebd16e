#include "MainWindow.h"

#include "AutoSave.h"
#include "FileMenu.h"
#include "RecentFiles.h"
#include "TimeRuler.h"
#include "TimeScale.h"
#include "UndoHistoryDock.h"

#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterPanel.h"
#include "orbane/ViewerPanel.h"

#include <QCloseEvent>
#include <QComboBox>
#include <QDockWidget>
#include <QLabel>
#include <QMenuBar>
#include <QStatusBar>
#include <QUndoStack>
#include <QVBoxLayout>

namespace Orbane {

MainWindow::MainWindow(OrbaneDoc *doc, QWidget *parent) : QMainWindow(parent), mDoc(doc)
{
    resize(1280, 800);
    setCentralWidget(BuildCentre());
    // What an overlay tells the user stays long enough to be read.
    connect(mViewer, &ViewerPanel::overlayMessage, this,
            [this](const QString &message) { statusBar()->showMessage(message, 8000); });

    auto *dock = new QDockWidget(tr("Inspector"), this);
    dock->setObjectName("inspector");
    dock->setFeatures(QDockWidget::NoDockWidgetFeatures);
    dock->setWidget(BuildInspectorDock());
    addDockWidget(Qt::RightDockWidgetArea, dock);
    mHistory = new UndoHistoryDock(doc, this);
    addDockWidget(Qt::RightDockWidgetArea, mHistory);
    resizeDocks({dock}, {380}, Qt::Horizontal);
    resizeDocks({dock, mHistory}, {600, 160}, Qt::Vertical);

    mRecent = new RecentFiles(this);
    mFile = new FileMenu(doc, this, mRecent);
    connect(mFile, &FileMenu::quitRequested, this, [this] {
        // The work is settled already: close without asking again.
        mWorkSettled = true;
        close();
        mWorkSettled = false;
    });
    BuildEditMenu();
    BuildStatusBar();
    mAutoSave = new AutoSave(doc, this);

    connect(doc, SIGNAL(toolAdded(Orbane::Operator *)), this, SLOT(OnToolAdded(Orbane::Operator *)));
    connect(doc, SIGNAL(toolRemoving(Orbane::Operator *)), this, SLOT(OnToolRemoving(Orbane::Operator *)));
    connect(doc, SIGNAL(syncRenderRequested()), this, SLOT(OnRenderRequested()));
    connect(doc, SIGNAL(autoProxyChanged(bool)), this, SLOT(OnAutoProxyChanged(bool)));
    for (Operator *tool : doc->Tools())
        OnToolAdded(tool);
}

MainWindow::~MainWindow() = default;

QWidget *MainWindow::BuildCentre()
{
    auto *box = new QWidget;
    auto *column = new QVBoxLayout(box);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    mViewer = new ViewerPanel(mDoc);
    mRuler = new TimeRuler(mDoc);
    column->addWidget(mViewer, 1);
    column->addWidget(mRuler);
    return box;
}

QWidget *MainWindow::BuildInspectorDock()
{
    auto *box = new QWidget;
    auto *column = new QVBoxLayout(box);
    column->setContentsMargins(0, 0, 0, 0);
    mToolChooser = new QComboBox;
    mToolChooser->setAccessibleName(tr("Tool"));
    mInspector = new ParameterPanel(mDoc);
    column->addWidget(mToolChooser);
    column->addWidget(mInspector, 1);
    connect(mToolChooser, SIGNAL(currentIndexChanged(int)), this, SLOT(OnToolChosen(int)));
    return box;
}

// Undo and Redo name the step they act on ("Undo Move Points").
void MainWindow::BuildEditMenu()
{
    mEditMenu = menuBar()->addMenu(tr("&Edit"));
    mEditMenu->setObjectName("editMenu");
    QAction *undo = mDoc->UndoStack()->createUndoAction(this, tr("Undo"));
    QAction *redo = mDoc->UndoStack()->createRedoAction(this, tr("Redo"));
    undo->setShortcut(QKeySequence::Undo);
    redo->setShortcut(QKeySequence::Redo);
    mEditMenu->addAction(undo);
    mEditMenu->addAction(redo);
    QMenu *view = menuBar()->addMenu(tr("&View"));
    view->addAction(mHistory->toggleViewAction());
}

void MainWindow::BuildStatusBar()
{
    mProxyState = new QLabel;
    statusBar()->addPermanentWidget(mProxyState);
}

bool MainWindow::OfferRecovery()
{
    if (!AutoSave::HasRecovery())
        return false;
    const auto answer = mFile->Ask(tr("Orbane did not close cleanly last time. Restore the unsaved work? "
                                      "(Save restores it, Discard drops it.)"));
    if (answer == FileMenu::Answer::Discard)
        AutoSave::Discard();
    if (answer != FileMenu::Answer::Save)
        return false;
    QString why;
    if (!mAutoSave->Restore(&why)) {
        mFile->Tell(tr("Cannot restore the unsaved work: %1").arg(why));
        return false;
    }
    return true;
}

void MainWindow::closeEvent(QCloseEvent *event)
{
    if (!mWorkSettled && !mFile->MaybeKeepWork()) {
        event->ignore();
        return;
    }
    if (mAutoSave->IsEnabled())
        AutoSave::Discard();
    event->accept();
}

void MainWindow::OnRenderRequested()
{
    statusBar()->showMessage(QString("Render %1 of frame %2").arg(++mRenders).arg(mDoc->GetCurrentTime()), 2000);
}

void MainWindow::OnAutoProxyChanged(bool on)
{
    mProxyState->setText(on ? "Proxy" : QString());
}

bool MainWindow::ShowTool(const QString &name)
{
    const int index = mToolChooser->findText(name);
    if (index < 0)
        return false;
    mToolChooser->setCurrentIndex(index);
    OnToolChosen(index);
    return true;
}

void MainWindow::OnToolAdded(Operator *tool)
{
    mToolChooser->addItem(QString::fromUtf8(tool->GetName()));
}

void MainWindow::OnToolRemoving(Operator *tool)
{
    if (mRuler->Scale()->Tool() == tool)
        mRuler->SetTool(nullptr);
    const int index = mToolChooser->findText(QString::fromUtf8(tool->GetName()));
    if (index >= 0)
        mToolChooser->removeItem(index);
}

void MainWindow::OnToolChosen(int index)
{
    Operator *tool = index < 0 ? nullptr : mDoc->FindTool(mToolChooser->itemText(index).toUtf8().constData());
    mInspector->ShowTool(tool);
    mViewer->ShowTool(tool);
    mRuler->SetTool(tool);
}

} // namespace Orbane

#include "MainWindow.h"

#include "orbane/ParameterPanel.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <QComboBox>
#include <QDockWidget>
#include <QLabel>
#include <QSlider>
#include <QStatusBar>
#include <QToolBar>
#include <QUndoStack>
#include <QVBoxLayout>

namespace Orbane {

MainWindow::MainWindow(OrbaneDoc *doc, QWidget *parent) : QMainWindow(parent), mDoc(doc)
{
    setWindowTitle("Orbane");
    resize(1280, 800);
    mViewer = new ViewerPanel(doc);
    setCentralWidget(mViewer);
    // What an overlay tells the user stays long enough to be read.
    connect(mViewer, &ViewerPanel::overlayMessage, this,
            [this](const QString &message) { statusBar()->showMessage(message, 8000); });

    auto *dock = new QDockWidget("Inspector", this);
    dock->setObjectName("inspector");
    dock->setFeatures(QDockWidget::NoDockWidgetFeatures);
    dock->setWidget(BuildInspectorDock());
    addDockWidget(Qt::RightDockWidgetArea, dock);
    resizeDocks({dock}, {380}, Qt::Horizontal);
    BuildToolBar();
    BuildStatusBar();

    connect(doc, SIGNAL(toolAdded(Orbane::Operator *)), this, SLOT(OnToolAdded(Orbane::Operator *)));
    connect(doc, SIGNAL(toolRemoving(Orbane::Operator *)), this, SLOT(OnToolRemoving(Orbane::Operator *)));
    connect(doc, SIGNAL(currentTimeChanged(float64)), this, SLOT(OnTimeChanged(double)));
    connect(doc, SIGNAL(syncRenderRequested()), this, SLOT(OnRenderRequested()));
    connect(doc, SIGNAL(autoProxyChanged(bool)), this, SLOT(OnAutoProxyChanged(bool)));
    for (Operator *tool : doc->Tools())
        OnToolAdded(tool);
}

MainWindow::~MainWindow() = default;

QWidget *MainWindow::BuildInspectorDock()
{
    auto *box = new QWidget;
    auto *column = new QVBoxLayout(box);
    column->setContentsMargins(0, 0, 0, 0);
    mToolChooser = new QComboBox;
    mInspector = new ParameterPanel(mDoc);
    column->addWidget(mToolChooser);
    column->addWidget(mInspector, 1);
    connect(mToolChooser, SIGNAL(currentIndexChanged(int)), this, SLOT(OnToolChosen(int)));
    return box;
}

void MainWindow::BuildToolBar()
{
    QToolBar *bar = addToolBar("Edit");
    bar->setObjectName("edit");
    bar->setMovable(false);
    QAction *undo = mDoc->UndoStack()->createUndoAction(this, "Undo");
    QAction *redo = mDoc->UndoStack()->createRedoAction(this, "Redo");
    undo->setShortcut(QKeySequence::Undo);
    redo->setShortcut(QKeySequence::Redo);
    bar->addAction(undo);
    bar->addAction(redo);
    bar->addSeparator();
    bar->addWidget(new QLabel(" Time "));
    bar->addWidget(BuildTimeSlider());
}

QSlider *MainWindow::BuildTimeSlider()
{
    mTimeSlider = new QSlider(Qt::Horizontal);
    mTimeSlider->setRange(0, 100);
    mTimeSlider->setMinimumWidth(300);
    connect(mTimeSlider, &QSlider::valueChanged, this, [this](int frame) { mDoc->SetCurrentTime(frame); });
    return mTimeSlider;
}

void MainWindow::BuildStatusBar()
{
    mProxyState = new QLabel;
    statusBar()->addPermanentWidget(mProxyState);
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
    const int index = mToolChooser->findText(QString::fromUtf8(tool->GetName()));
    if (index >= 0)
        mToolChooser->removeItem(index);
}

void MainWindow::OnToolChosen(int index)
{
    Operator *tool = index < 0 ? nullptr : mDoc->FindTool(mToolChooser->itemText(index).toUtf8().constData());
    mInspector->ShowTool(tool);
    mViewer->ShowTool(tool);
}

void MainWindow::OnTimeChanged(double time)
{
    const QSignalBlocker block(mTimeSlider);
    mTimeSlider->setValue(int(time));
}

} // namespace Orbane

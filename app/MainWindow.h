#pragma once

#include "orbane/ParameterPanel.h"
#include "orbane/ViewerPanel.h"

#include <QMainWindow>

class QComboBox;
class QLabel;
class QSlider;

namespace Orbane {

class Operator;
class OrbaneDoc;

// The application window: the viewer in the middle, the inspector of the
// chosen tool on the right, a time slider below, undo and redo above.
class MainWindow : public QMainWindow
{
    Q_OBJECT
public:
    explicit MainWindow(OrbaneDoc *doc, QWidget *parent = nullptr);
    ~MainWindow() override;

    ParameterPanel *Inspector() const { return mInspector; }
    ViewerPanel *Viewer() const { return mViewer; }
    // Shows the named tool's controls and overlays; false where there is no such tool.
    bool ShowTool(const QString &name);

private slots:
    void OnToolAdded(Orbane::Operator *tool);
    void OnToolRemoving(Orbane::Operator *tool);
    void OnToolChosen(int index);
    void OnTimeChanged(double time);
    // The document's render hooks: this host has no renderer, so the window
    // says what a renderer would have been asked to do.
    void OnRenderRequested();
    void OnAutoProxyChanged(bool on);

private:
    QWidget *BuildInspectorDock();
    void BuildToolBar();
    void BuildStatusBar();
    QSlider *BuildTimeSlider();

    OrbaneDoc *mDoc;
    ParameterPanel *mInspector = nullptr;
    ViewerPanel *mViewer = nullptr;
    QComboBox *mToolChooser = nullptr;
    QSlider *mTimeSlider = nullptr;
    QLabel *mProxyState = nullptr;
    int mRenders = 0;
};

} // namespace Orbane

#pragma once

#include "orbane/ParameterPanel.h"
#include "orbane/ViewerPanel.h"

#include <QMainWindow>

class QComboBox;
class QLabel;

namespace Orbane {

class AutoSave;
class FileMenu;
class Operator;
class OrbaneDoc;
class RecentFiles;
class TimeRuler;
class UndoHistoryDock;

// The application window: the viewer in the middle with the time ruler
// under it, the inspector of the chosen tool on the right, the undo history
// below it, and the File and Edit menus.
class MainWindow : public QMainWindow
{
    Q_OBJECT
public:
    explicit MainWindow(OrbaneDoc *doc, QWidget *parent = nullptr);
    ~MainWindow() override;

    ParameterPanel *Inspector() const { return mInspector; }
    ViewerPanel *Viewer() const { return mViewer; }
    TimeRuler *Ruler() const { return mRuler; }
    FileMenu *File() const { return mFile; }
    UndoHistoryDock *History() const { return mHistory; }
    AutoSave *Recovery() const { return mAutoSave; }
    QMenu *EditMenu() const { return mEditMenu; }
    // Shows the named tool's controls and overlays; false where there is no such tool.
    bool ShowTool(const QString &name);

    // At start-up: where an earlier session left unsaved work, asks (through
    // the File menu's question hook: Save restores, Discard drops it) and
    // restores it. True where work was restored.
    bool OfferRecovery();

protected:
    void closeEvent(QCloseEvent *event) override;

private slots:
    void OnToolAdded(Orbane::Operator *tool);
    void OnToolRemoving(Orbane::Operator *tool);
    void OnToolChosen(int index);
    // The document's render hooks: this host has no renderer, so the window
    // says what a renderer would have been asked to do.
    void OnRenderRequested();
    void OnAutoProxyChanged(bool on);

private:
    QWidget *BuildInspectorDock();
    QWidget *BuildCentre();
    void BuildEditMenu();
    void BuildStatusBar();

    OrbaneDoc *mDoc;
    ParameterPanel *mInspector = nullptr;
    ViewerPanel *mViewer = nullptr;
    TimeRuler *mRuler = nullptr;
    QComboBox *mToolChooser = nullptr;
    QLabel *mProxyState = nullptr;
    RecentFiles *mRecent = nullptr;
    FileMenu *mFile = nullptr;
    QMenu *mEditMenu = nullptr;
    UndoHistoryDock *mHistory = nullptr;
    AutoSave *mAutoSave = nullptr;
    int mRenders = 0;
    bool mWorkSettled = false; // File > Quit asked already
};

} // namespace Orbane

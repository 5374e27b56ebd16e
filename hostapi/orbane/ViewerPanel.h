#pragma once

#include "orbane/FloatImage.h"
#include "orbane/PreviewControl.h"
#include "orbane/PreviewInfo.h"
#include "orbane/TagList.h"
#include "orbane/ViewMapping.h"
#include "orbane/ViewerImageState.h"

#include <QImage>
#include <QPointer>
#include <QWidget>

#include <array>

#include <map>
#include <memory>
#include <set>
#include <vector>

class QAction;
class QMenu;
class QToolBar;

namespace Orbane {

class HoverIndex;
class Input;
class Operator;
class OrbaneDoc;
class ViewerBackdrop;
class ViewerImageFeed;

// Shows an image (or a checkerboard) with the overlays of one tool over it.
//
// The view: the image is fitted to the widget until the user zooms (the
// wheel, about the mouse) or pans (middle drag); from then on the view stays
// where the user put it. Everything is in logical pixels, so handles keep
// their size at any device pixel ratio.
//
// Overlays: ShowTool creates, for each Input, the overlay classes it names
// (INPA_PreviewControl) through the class registry, binds them (AddInput,
// SetAttrsTagList with the Input's attributes, the current value) and
// switches them on. Overlays of later Inputs lie above earlier ones: they
// draw later and are asked first. Pass 1 draws the overlays that are
// switched off, pass 2 those that are on, above them.
//
// The mouse: hovering asks the overlays CCMD_HitTest (bit 0: claimed, bit 1:
// redraw), topmost first, and repaints only when one asks. A spatial index
// of the overlays' hover bounds leaves out those that cannot answer, so a
// hover costs about the same with ten overlays or a thousand. A left press goes to the overlays
// in turn until one answers a drag type: that one is the hot control; the
// others are then told of it and join the drag where they answer a drag
// type too (a linked handle). Moves and the release go to every overlay in
// the drag. Keys go to the overlay under the mouse, else the one pressed
// last, else the first that claims them (CCMD_NeedsKey); it keeps them until
// every key is up, when it is sent CCMD_KeyUpAll.
class ViewerPanel : public QWidget
{
    Q_OBJECT
public:
    explicit ViewerPanel(OrbaneDoc *doc, QWidget *parent = nullptr);
    ~ViewerPanel() override;

    // --- the tool ---
    void ShowTool(Operator *tool);
    Operator *GetTool() const { return mTool; }
    // In creation order (Input order), one reference each.
    const std::vector<PreviewControl *> &Overlays() const { return mOverlays; }
    std::vector<PreviewControl *> OverlaysOf(const Input *input) const;

    // --- the image ---
    // Shows a file, or a sequence by a pattern ("plate.####.exr",
    // "plate.%04d.exr") at the frame of the document's time, read on a
    // worker thread: the size is known at once, the pixels follow, and the
    // viewer says how far the read has come and what went wrong (a missing
    // frame, a corrupt file, one over the pixel limit). Empty: none. The
    // document's PREF_ViewerImage drives this.
    void ViewImage(const QString &pathOrPattern);
    const ViewerImageState &ImageState() const;
    // Runs the event loop until the read under way ends or `timeoutMs`
    // passes; true where no read is under way any more. For headless runs
    // and tests: a window never needs to wait.
    bool WaitForImage(int32 timeoutMs);
    // The pixels shown, as linear light: a file's values as read, an image
    // set from Qt decoded from sRGB (ColourSpaces). Colour pickers sample
    // it and the histograms count it (published as ViewedImage); null with
    // no image.
    const FloatImage &LinearImage() const { return mLinear; }
    // Reads the file now, on this thread. False where it cannot be read;
    // what was shown stays.
    bool LoadImage(const QString &path);
    // A null image shows the checkerboard.
    void SetImage(const QImage &image);
    bool HasImage() const;
    QSize ImageSize() const;
    // The average of LinearImage's pixels within `pixels` (the image's own
    // grid, row 0 at the top; clipped to the image) as straight linear
    // RGBA. False, with `rgba` untouched, where no image pixel lies inside.
    // What colour pickers sample, whatever the image's storage.
    bool SampleLinear(const QRect &pixels, std::array<float64, 4> &rgba) const;
    // The width of one image pixel over its height; the view refits. Not
    // positive or not a number: 1.
    void SetPixelAspect(float64 aspect);
    float64 PixelAspect() const { return mPixelAspect; }

    // --- the view ---
    const ViewMapping &Mapping() const { return mInfo.Mapping(); }
    // The whole image, as large as fits.
    void FitImage();
    // The image centred at `zoom` (viewer units per image pixel), moved by
    // `pan` viewer units.
    void SetView(float64 zoom, OrbPoint pan = {});
    // A new zoom keeping the image point under `anchor` (viewer units) in place.
    void ZoomAbout(float64 zoom, OrbPoint anchor);
    void PanBy(OrbPoint delta);
    // The next zoom for a wheel turn of `angleDelta` eighths of a degree:
    // a factor of 1.25 per notch, kept within 1/64 and 64.
    static float64 WheelZoom(float64 zoom, int32 angleDelta) noexcept;
    OrbPoint WidgetToImage(QPointF widget) const;
    QPointF ImageToWidget(OrbPoint image) const;
    // The camera the 3D overlays are seen through (the default view until
    // set); a camera that is not valid is refused.
    bool SetCamera(const ViewCamera &camera);
    const ViewCamera &Camera() const { return mInfo.Camera(); }

    // What every overlay call is given: tolerance, colours, Highlight.
    PreviewInfo &Info() { return mInfo; }
    // PCA_EventFlags of each press: PEF_StartGrab echoes where a drag began.
    void SetPressFlags(uint32 flags) { mPressFlags = flags; }

    // --- interaction ---
    PreviewControl *HotControl() const { return mHot; }
    PreviewControl *HoverControl() const { return mHover; }
    // Hover asks every overlay instead of those the index finds: the plain
    // walk that the index is tested and measured against.
    void SetPlainHover(bool plain) { mPlainHover = plain; }
    // How many overlays the last hover asked.
    int32 HoverAsked() const { return mHoverAsked; }
    // The overlay that holds the keys until every key is up.
    PreviewControl *KeyControl() const { return mKeyOwner; }
    // The overlay's point follows the mouse until the next click: applies
    // `attrs` with PCA_FollowCursor set, then CCMD_FollowCursor. False where
    // the overlay is not one of this viewer's.
    bool BeginFollowCursor(PreviewControl *overlay, const TagList &attrs);
    PreviewControl *Follower() const { return mFollower; }
    // Builds the context menu of the position last seen, and acts on one of
    // its actions: what a right click does, without running the menu.
    void FillContextMenu(QMenu *menu);
    bool TriggerMenuAction(QAction *action);
    QToolBar *OverlayToolBar() const { return mToolBar; }
    // The tags that menu choices and toolbar presses pass to the overlay
    // (PCA_CommandValue, PCA_FromScript): a script sets them around a choice.
    void SetCommandTags(const TagList &tags) { mCommandTags = tags; }
    // The last message an overlay gave the user (PreviewControl::Tell).
    const QString &LastMessage() const { return mLastMessage; }
    // The tip the overlays give at `widget`; empty where none.
    QString TipAt(QPointF widget);
    // How often the panel has painted itself.
    int32 PaintCount() const { return mPaintCount; }

signals:
    void toolShown(Orbane::Operator *tool);
    // The image's state changed: a read began, progressed or ended.
    void imageStateChanged();
    // An overlay tells the user something (the window shows it).
    void overlayMessage(const QString &message);

protected:
    void paintEvent(QPaintEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void wheelEvent(QWheelEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    void keyReleaseEvent(QKeyEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;
    void contextMenuEvent(QContextMenuEvent *event) override;
    bool event(QEvent *event) override;

private slots:
    void OnToolRemoving(Orbane::Operator *tool);
    void OnPrefChanged(uint32 pref);
    void OnTimeChanged(float64 time);

private:
    // ViewerPanel.cpp: tool, image, view, painting.
    PreviewControl *CreateOverlay(Input *input, const char *classID);
    void Clear();
    void BuildToolBar();
    void AddToolbarEvent(PreviewControl *overlay, const PreviewControl::ToolbarEvent &e);
    void ToolbarAction(QAction *action, PreviewControl *overlay, const PreviewControl::ToolbarEvent &e);
    void SetMapping(const ViewMapping &mapping);
    void OnSizeKnown(QSize size);
    void OnImageReady(const QImage &display, const FloatImage &linear);
    void OnImageCleared();
    void SetLinear(const FloatImage &linear);
    void SendAll(const OrbID &command, uint64 data);
    void RequestRedraw();
    void DrawPass(int32 pass, bool active);
    // ViewerPanelInput.cpp: the mouse, keys, menus and tips.
    OrbPointI SetMouse(QPointF widget);
    std::vector<PreviewControl *> ByPriority() const;
    bool IsOverlay(const PreviewControl *overlay) const;
    void Hover();
    void Press(const TagList &tags);
    void Drag();
    void Release();
    PreviewControl *UnderMouse();
    PreviewControl *KeyTarget(int key);
    void EndKeys();

    OrbaneDoc *mDoc;
    Operator *mTool = nullptr;
    std::vector<PreviewControl *> mOverlays; // one reference each
    std::unique_ptr<ViewerBackdrop> mBackdrop;
    ViewerImageFeed *mFeed; // a child
    FloatImage mLinear;     // what is shown, as linear light
    std::unique_ptr<HoverIndex> mHoverIndex;
    bool mPlainHover = false;
    int32 mHoverAsked = 0;
    PreviewInfo mInfo;
    bool mUserView = false; // the user zoomed or panned: keep the view on resize
    uint32 mPressFlags = 0;
    float64 mPixelAspect = 1.0;

    PreviewControl *mHot = nullptr;
    PreviewControl *mHover = nullptr;
    PreviewControl *mLastPressed = nullptr;
    PreviewControl *mKeyOwner = nullptr;
    PreviewControl *mFollower = nullptr;
    std::vector<PreviewControl *> mDragging; // the hot control first, then linked ones
    std::set<int> mHeldKeys;
    QPointF mLastMouse;
    bool mPanning = false;
    QPointF mPanFrom;

    std::map<QAction *, PreviewControl *> mMenuOwners;
    QToolBar *mToolBar = nullptr;
    TagList mCommandTags;
    QString mLastMessage;
    bool mDirty = true;
    int32 mPaintCount = 0;
};

} // namespace Orbane

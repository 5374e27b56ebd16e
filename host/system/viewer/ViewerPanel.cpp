#include "orbane/ViewerPanel.h"
#include "orbane/ViewedImage.h"

#include "HoverIndex.h"
#include "QtGPainter.h"
#include "ViewerAccessible.h"
#include "ViewerBackdrop.h"
#include "ViewerImageFeed.h"
#include "ViewerStatusLine.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"

#include <QAccessible>
#include <QAction>
#include <QEventLoop>
#include <QMenu>
#include <QPainter>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>

#include <algorithm>
#include <cmath>
#include <set>
#include <string>

namespace Orbane {

namespace {

const QColor kBackground(36, 36, 36);
constexpr float64 kMinZoom = 1.0 / 64.0, kMaxZoom = 64.0;
// A wheel notch is 120 eighths of a degree.
constexpr float64 kNotch = 120.0, kNotchFactor = 1.25;

} // namespace

ViewerPanel::ViewerPanel(OrbaneDoc *doc, QWidget *parent)
    : QWidget(parent), mDoc(doc), mBackdrop(std::make_unique<ViewerBackdrop>()), mFeed(new ViewerImageFeed(this)),
      mHoverIndex(std::make_unique<HoverIndex>())
{
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    // Overlays are painted: accessibility tools learn of them through the
    // viewer's interface, one child per overlay.
    static const bool factoryInstalled = (QAccessible::installFactory(ViewerAccessible::Factory), true);
    Q_UNUSED(factoryInstalled);
    setAccessibleName(tr("Viewer"));
    setMinimumSize(64, 64);
    mInfo.SetCursorHandler([this](const QCursor *cursor) {
        if (cursor)
            setCursor(*cursor);
        else
            unsetCursor();
    });
    mInfo.SetDialogParent(this);
    mToolBar = new QToolBar(this);
    mToolBar->hide();
    connect(doc, SIGNAL(toolRemoving(Orbane::Operator *)), this, SLOT(OnToolRemoving(Orbane::Operator *)));
    connect(doc, SIGNAL(prefChanged(uint32)), this, SLOT(OnPrefChanged(uint32)));
    connect(doc, SIGNAL(currentTimeChanged(float64)), this, SLOT(OnTimeChanged(float64)));
    connect(mFeed, &ViewerImageFeed::sizeKnown, this, &ViewerPanel::OnSizeKnown);
    connect(mFeed, &ViewerImageFeed::imageReady, this, &ViewerPanel::OnImageReady);
    connect(mFeed, &ViewerImageFeed::cleared, this, &ViewerPanel::OnImageCleared);
    connect(mFeed, &ViewerImageFeed::stateChanged, this, [this] {
        update();
        emit imageStateChanged();
    });
    mPixelAspect = doc->GetPrefs().GetDouble(PREF_ViewerPixelAspect, 1.0);
    if (!(mPixelAspect > 0.0) || !std::isfinite(mPixelAspect))
        mPixelAspect = 1.0;
    OnPrefChanged(PREF_ViewerImage);
    FitImage();
}

ViewerPanel::~ViewerPanel()
{
    Clear();
}

// --- the tool ---

void ViewerPanel::ShowTool(Operator *tool)
{
    if (tool == mTool)
        return;
    Clear();
    mTool = tool;
    if (tool)
        for (Input *input : tool->Inputs())
            for (const TagItem *item = input->GetAttrs().Find(INPA_PreviewControl); item;
                 item = input->GetAttrs().FindNext(item))
                if (PreviewControl *overlay = CreateOverlay(input, item->id.c_str()))
                    mOverlays.push_back(overlay);
    for (PreviewControl *overlay : mOverlays)
        overlay->SetActive(1, nullptr);
    mHoverIndex->Reset();
    BuildToolBar();
    RequestRedraw();
    emit toolShown(tool);
}

std::vector<PreviewControl *> ViewerPanel::OverlaysOf(const Input *input) const
{
    std::vector<PreviewControl *> found;
    for (PreviewControl *overlay : mOverlays)
        if (overlay->GetMainInput() == input)
            found.push_back(overlay);
    return found;
}

PreviewControl *ViewerPanel::CreateOverlay(Input *input, const char *classID)
{
    const TagList &attrs = input->GetAttrs();
    const Registry *reg = ClassRegistry.FindScriptName(classID);
    ScriptObject *obj = reg ? reg->New(ScriptVal(), attrs) : nullptr;
    auto *overlay = dynamic_cast<PreviewControl *>(obj);
    if (!overlay) {
        qWarning("viewer: Input \"%s\" of tool \"%s\" names overlay class \"%s\", which %s", input->GetName(),
                 mTool->GetName(), classID, obj ? "is no overlay" : "is unknown");
        if (obj)
            obj->DecRef();
        return nullptr;
    }
    // A redraw request may mean that the overlay's handles moved.
    overlay->SetRedrawHandler([this](PreviewControl *o) {
        mHoverIndex->Touch(o);
        RequestRedraw();
    });
    overlay->SetMessageHandler([this](PreviewControl *, const char *message) {
        mLastMessage = QString::fromUtf8(message);
        emit overlayMessage(mLastMessage);
    });
    overlay->AddInput(input, &attrs);
    // Further Inputs the overlay edits (a rectangle's height), in the order named.
    for (const TagItem *item = attrs.Find(INPA_OverlayInput); item; item = attrs.FindNext(item))
        if (Input *more = mTool->FindInput(item->id))
            overlay->AddInput(more, &attrs);
    overlay->SetAttrsTagList(input, attrs);
    overlay->SetView(&mInfo, nullptr);
    for (Input *in : std::vector<Input *>(overlay->Inputs())) {
        const AutoParameter value(in->GetValue(mDoc->GetCurrentTime()));
        overlay->NotifyChanged(in, value.get(), nullptr);
    }
    return overlay;
}

// Unbinds and lets go of every overlay. A script may still hold one: it
// must no longer reach this panel.
void ViewerPanel::Clear()
{
    EndKeys();
    for (PreviewControl *overlay : mDragging)
        overlay->ControlUp(&mInfo, OrbPointI(mInfo.MouseInViewer()), nullptr);
    mDragging.clear();
    mHot = mHover = mLastPressed = mFollower = nullptr;
    mInfo.HotControl = nullptr;
    for (PreviewControl *overlay : mOverlays) {
        overlay->SetRedrawHandler(nullptr);
        overlay->SetMessageHandler(nullptr);
        const std::vector<Input *> inputs = overlay->Inputs();
        for (Input *in : inputs)
            overlay->RemoveInput(in, nullptr);
        overlay->DecRef();
    }
    mOverlays.clear();
    mHoverIndex->Reset();
    mMenuOwners.clear();
    mTool = nullptr;
}

void ViewerPanel::BuildToolBar()
{
    mToolBar->clear();
    // Overlays of one class offer the same buttons: the bar shows them once.
    std::set<std::string> shown;
    for (PreviewControl *overlay : mOverlays) {
        std::vector<PreviewControl::ToolbarEvent> events;
        overlay->GetAvailableEvents(events, nullptr);
        if (events.empty() || !shown.insert(overlay->GetRegistry() ? overlay->GetRegistry()->Name() : "").second)
            continue;
        for (const PreviewControl::ToolbarEvent &e : events)
            AddToolbarEvent(overlay, e);
    }
    mToolBar->adjustSize();
    mToolBar->setVisible(!mToolBar->actions().isEmpty());
}

// A button, a separator, or a pop-down whose menu holds its items. The
// labels and tips of a button may change with what it does (a count in its
// label), so the bar is built again after each press, once the press is over.
void ViewerPanel::AddToolbarEvent(PreviewControl *overlay, const PreviewControl::ToolbarEvent &e)
{
    if (e.id == PreviewControl::ToolbarSeparator) {
        mToolBar->addSeparator();
        return;
    }
    QAction *action = mToolBar->addAction(QString::fromUtf8(e.label.c_str()));
    action->setToolTip(QString::fromUtf8(e.tip.c_str()));
    if (e.id == PreviewControl::ToolbarPopDown) {
        auto *menu = new QMenu(mToolBar);
        for (const PreviewControl::ToolbarEvent &item : e.items)
            ToolbarAction(menu->addAction(QString::fromUtf8(item.label.c_str())), overlay, item);
        action->setMenu(menu);
        if (auto *button = qobject_cast<QToolButton *>(mToolBar->widgetForAction(action)))
            button->setPopupMode(QToolButton::InstantPopup);
        return;
    }
    ToolbarAction(action, overlay, e);
}

void ViewerPanel::ToolbarAction(QAction *action, PreviewControl *overlay, const PreviewControl::ToolbarEvent &e)
{
    action->setToolTip(QString::fromUtf8(e.tip.c_str()));
    const OrbID id = e.id;
    connect(action, &QAction::triggered, this, [this, overlay, id]() {
        // A shared button acts on the overlay of its class that was pressed
        // last, where there is one.
        if (!IsOverlay(overlay))
            return;
        PreviewControl *target = overlay;
        if (IsOverlay(mLastPressed) && mLastPressed->GetRegistry() == overlay->GetRegistry())
            target = mLastPressed;
        target->HandleEvent(id, &mInfo, &mCommandTags);
        QTimer::singleShot(0, this, [this]() { BuildToolBar(); });
    });
}

void ViewerPanel::OnToolRemoving(Operator *tool)
{
    if (tool == mTool)
        ShowTool(nullptr);
}

// --- the image ---

void ViewerPanel::ViewImage(const QString &pathOrPattern)
{
    mFeed->SetSource(pathOrPattern, mDoc->GetCurrentTime());
}

const ViewerImageState &ViewerPanel::ImageState() const
{
    return mFeed->State();
}

bool ViewerPanel::WaitForImage(int32 timeoutMs)
{
    if (!ImageState().loading)
        return true;
    QEventLoop loop;
    QTimer::singleShot(std::max(timeoutMs, 0), &loop, &QEventLoop::quit);
    connect(this, &ViewerPanel::imageStateChanged, &loop, [this, &loop] {
        if (!ImageState().loading)
            loop.quit();
    });
    loop.exec();
    return !ImageState().loading;
}

bool ViewerPanel::LoadImage(const QString &path)
{
    return mFeed->LoadNow(path, nullptr);
}

void ViewerPanel::SetImage(const QImage &image)
{
    mFeed->Forget();
    mBackdrop->SetPlaceholderSize(QSize());
    mBackdrop->SetImage(image);
    SetLinear(FloatImage::FromDisplay(image));
    mUserView = false;
    FitImage();
    SendAll(CCMD_ImageChanged, 0);
}

// The next picture's size: a new size shows the checkerboard at it until
// the pixels come; the same size keeps the picture shown, so stepping
// through a sequence does not flash.
void ViewerPanel::OnSizeKnown(QSize size)
{
    const bool sameSize = size == ImageSize();
    if (sameSize && HasImage())
        return;
    mBackdrop->SetImage(QImage());
    mBackdrop->SetPlaceholderSize(size);
    SetLinear(FloatImage());
    if (!sameSize)
        FitImage();
    SendAll(CCMD_ImageChanged, 0);
    RequestRedraw();
}

// The view is kept where the size is (a frame of the same sequence).
void ViewerPanel::OnImageReady(const QImage &display, const FloatImage &linear)
{
    const bool refit = display.size() != ImageSize();
    mBackdrop->SetImage(display);
    SetLinear(linear);
    if (refit)
        FitImage();
    SendAll(CCMD_ImageChanged, 0);
    RequestRedraw();
}

// Nothing to show: the checkerboard, at the size the picture had, unless
// there is no source at all.
void ViewerPanel::OnImageCleared()
{
    const QSize size = ImageState().source.isEmpty() ? QSize() : ImageSize();
    mBackdrop->SetImage(QImage());
    mBackdrop->SetPlaceholderSize(size);
    SetLinear(FloatImage());
    if (ImageSize() != QSize(Mapping().ImageWidth(), Mapping().ImageHeight()))
        FitImage();
    SendAll(CCMD_ImageChanged, 0);
    RequestRedraw();
}

// The one place the viewer's linear pixels change: what is published is
// what the viewer holds. Nothing after nothing is no change to tell of.
void ViewerPanel::SetLinear(const FloatImage &linear)
{
    if (linear.IsNull() && mLinear.IsNull())
        return;
    mLinear = linear;
    ViewedImage::Instance().Set(mLinear);
}

bool ViewerPanel::HasImage() const
{
    return mBackdrop->HasImage();
}

QSize ViewerPanel::ImageSize() const
{
    return QSize(mBackdrop->Width(), mBackdrop->Height());
}

void ViewerPanel::SetPixelAspect(float64 aspect)
{
    mPixelAspect = aspect > 0.0 && std::isfinite(aspect) ? aspect : 1.0;
    mUserView = false;
    FitImage();
}

void ViewerPanel::OnPrefChanged(uint32 pref)
{
    if (pref == PREF_ViewerPixelAspect)
        SetPixelAspect(mDoc->GetPrefs().GetDouble(PREF_ViewerPixelAspect, 1.0));
    if (pref != PREF_ViewerImage)
        return;
    ViewImage(QString::fromUtf8(mDoc->GetPrefs().GetString(PREF_ViewerImage, "")));
}

void ViewerPanel::OnTimeChanged(float64 time)
{
    mFeed->SetTime(time);
    SendAll(CCMD_TimeChanged, 0);
}

// --- the view ---

void ViewerPanel::FitImage()
{
    mUserView = false;
    SetMapping(ViewMapping::Fitted(mBackdrop->Width(), mBackdrop->Height(), mPixelAspect, width(), height()));
}

void ViewerPanel::SetView(float64 zoom, OrbPoint pan)
{
    mUserView = true;
    SetMapping(
        ViewMapping::Centered(mBackdrop->Width(), mBackdrop->Height(), mPixelAspect, zoom, width(), height(), pan));
}

void ViewerPanel::ZoomAbout(float64 zoom, OrbPoint anchor)
{
    mUserView = true;
    SetMapping(Mapping().ZoomedAbout(std::clamp(zoom, kMinZoom, kMaxZoom), anchor));
}

void ViewerPanel::PanBy(OrbPoint delta)
{
    const ViewMapping &m = Mapping();
    mUserView = true;
    SetMapping(ViewMapping(m.ImageWidth(), m.ImageHeight(), m.PixelAspect(), m.Zoom(), m.Origin() + delta,
                           m.ViewportHeight()));
}

float64 ViewerPanel::WheelZoom(float64 zoom, int32 angleDelta) noexcept
{
    return std::clamp(zoom * std::pow(kNotchFactor, angleDelta / kNotch), kMinZoom, kMaxZoom);
}

OrbPoint ViewerPanel::WidgetToImage(QPointF widget) const
{
    return Mapping().ToImage(Mapping().WidgetToViewer({widget.x(), widget.y()}));
}

QPointF ViewerPanel::ImageToWidget(OrbPoint image) const
{
    const OrbPoint w = Mapping().ViewerToWidget(Mapping().ToViewer(image));
    return QPointF(w.x, w.y);
}

void ViewerPanel::SetMapping(const ViewMapping &mapping)
{
    if (mapping == Mapping())
        return;
    mInfo.SetMapping(mapping);
    for (PreviewControl *overlay : mOverlays)
        overlay->SetView(&mInfo, nullptr);
    RequestRedraw();
}

bool ViewerPanel::SetCamera(const ViewCamera &camera)
{
    if (!camera.IsValid())
        return false;
    if (camera == Camera())
        return true;
    mInfo.SetCamera(camera);
    // Every 3D handle moved: the hover index is built again.
    mHoverIndex->Reset();
    for (PreviewControl *overlay : mOverlays)
        overlay->SetView(&mInfo, nullptr);
    RequestRedraw();
    return true;
}

void ViewerPanel::resizeEvent(QResizeEvent *event)
{
    QWidget::resizeEvent(event);
    if (mUserView)
        SetMapping(Mapping().WithViewportHeight(height()));
    else
        FitImage();
}

// --- painting ---

void ViewerPanel::SendAll(const OrbID &command, uint64 data)
{
    const std::vector<PreviewControl *> overlays = mOverlays;
    for (PreviewControl *overlay : overlays)
        overlay->ControlCommand(&mInfo, command, data, nullptr);
}

void ViewerPanel::RequestRedraw()
{
    mDirty = true;
    update();
}

void ViewerPanel::paintEvent(QPaintEvent *)
{
    QPainter qp(this);
    qp.fillRect(rect(), kBackground);
    mBackdrop->Paint(qp, Mapping(), devicePixelRatioF());
    // Whole viewer units fall on pixel centres, so one-pixel handle lines
    // at whole positions are crisp rather than smeared over two pixels.
    qp.translate(0.5, 0.5);
    {
        Graphics::QtGPainter painter(&qp, height());
        mInfo.SetPainter(&painter);
        mInfo.HotControl = mHot;
        mInfo.ShowDrag = mDragging.empty() ? 0 : 1;
        DrawPass(1, false);
        DrawPass(2, true);
        mInfo.SetPainter(nullptr);
    }
    qp.translate(-0.5, -0.5);
    ViewerStatusLine::Paint(qp, rect(), ImageState());
    mDirty = false;
    ++mPaintCount;
}

void ViewerPanel::DrawPass(int32 pass, bool active)
{
    mInfo.DrawPass = pass;
    for (PreviewControl *overlay : mOverlays)
        if (overlay->IsActive() == active)
            overlay->DrawControls(&mInfo, nullptr);
}

} // namespace Orbane

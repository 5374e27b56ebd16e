#include "inputcontrols/ViewerPicker.h"

#include "orbane/ViewerPanel.h"

#include <QApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QRubberBand>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

QPoint PixelAt(const ViewerPanel &viewer, QPointF widget)
{
    const QSize size = viewer.ImageSize();
    const OrbPoint at = viewer.WidgetToImage(widget);
    // Image coordinates run with Y up; the pixel grid has row 0 at the top.
    return QPoint(int(std::floor(at.x * size.width())), int(std::floor((1.0 - at.y) * size.height())));
}

} // namespace

ViewerPicker::ViewerPicker(QObject *parent) : QObject(parent) {}

ViewerPicker::~ViewerPicker()
{
    Disarm();
}

QRect ViewerPicker::PixelBox(const ViewerPanel &viewer, QPointF from, QPointF to)
{
    const QPoint a = PixelAt(viewer, from), b = PixelAt(viewer, to);
    return QRect(QPoint(std::min(a.x(), b.x()), std::min(a.y(), b.y())),
                 QPoint(std::max(a.x(), b.x()), std::max(a.y(), b.y())));
}

void ViewerPicker::Arm()
{
    if (mArmed)
        return;
    mArmed = true;
    // Viewers are found when armed, so one opened later is watched too.
    for (QWidget *w : QApplication::allWidgets())
        if (auto *viewer = qobject_cast<ViewerPanel *>(w))
            viewer->installEventFilter(this);
    emit ArmedChanged(true);
}

void ViewerPicker::Disarm()
{
    if (!mArmed)
        return;
    mArmed = false;
    for (QWidget *w : QApplication::allWidgets())
        if (auto *viewer = qobject_cast<ViewerPanel *>(w))
            viewer->removeEventFilter(this);
    delete mBand;
    mBand = nullptr;
    mViewer = nullptr;
    emit ArmedChanged(false);
}

bool ViewerPicker::eventFilter(QObject *watched, QEvent *event)
{
    auto *viewer = qobject_cast<ViewerPanel *>(watched);
    if (!mArmed || !viewer)
        return false;
    switch (event->type()) {
    case QEvent::MouseButtonPress:
        Press(viewer, static_cast<QMouseEvent *>(event)->pos());
        return true;
    case QEvent::MouseMove:
        Move(static_cast<QMouseEvent *>(event)->pos());
        return mViewer != nullptr;
    case QEvent::MouseButtonRelease:
        Release(static_cast<QMouseEvent *>(event)->pos());
        return true;
    case QEvent::KeyPress:
        if (static_cast<QKeyEvent *>(event)->key() != Qt::Key_Escape)
            return false;
        Disarm();
        return true;
    default:
        return false;
    }
}

void ViewerPicker::Press(ViewerPanel *viewer, QPoint at)
{
    mViewer = viewer;
    mFrom = at;
    if (!mBand)
        mBand = new QRubberBand(QRubberBand::Rectangle, viewer);
    mBand->setGeometry(QRect(at, at));
}

void ViewerPicker::Move(QPoint at)
{
    if (!mViewer || !mBand)
        return;
    mBand->setGeometry(QRect(mFrom, at).normalized());
    mBand->show();
}

void ViewerPicker::Release(QPoint at)
{
    ViewerPanel *viewer = mViewer.data();
    if (!viewer)
        return;
    std::array<float64, 4> rgba{};
    const bool sampled = viewer->SampleLinear(PixelBox(*viewer, mFrom, at), rgba);
    Disarm();
    // A press outside the image picks nothing; the pick is over all the same.
    if (sampled)
        emit Picked(ColorRGBA{rgba[0], rgba[1], rgba[2], rgba[3]});
}

} // namespace Orbane

#pragma once

#include "widgets/ColorMath.h"

#include <QObject>
#include <QPoint>
#include <QPointer>
#include <QRect>

class QRubberBand;

namespace Orbane {

class ViewerPanel;

// Samples the colour of the viewed image for a control. Armed, it watches
// every viewer of the application: a click takes the pixel under the mouse,
// a drag the average of the box it spans (shown as a rubber band), both in
// the image's linear values (ViewerPanel::SampleLinear). The viewer's
// overlays see none of these events. One pick disarms it; Escape or
// Disarm cancels.
class ViewerPicker : public QObject
{
    Q_OBJECT
public:
    explicit ViewerPicker(QObject *parent = nullptr);
    ~ViewerPicker() override;

    void Arm();
    void Disarm();
    bool IsArmed() const noexcept { return mArmed; }

    // The image pixels that the widget points `from` and `to` of `viewer`
    // span, both ends included: the mapping of a box drag, kept pure.
    static QRect PixelBox(const ViewerPanel &viewer, QPointF from, QPointF to);

signals:
    void Picked(const Orbane::ColorRGBA &colour);
    void ArmedChanged(bool armed);

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void Press(ViewerPanel *viewer, QPoint at);
    void Move(QPoint at);
    void Release(QPoint at);

    bool mArmed = false;
    QPointer<ViewerPanel> mViewer; // the viewer being pressed in
    QPoint mFrom;
    QRubberBand *mBand = nullptr;
};

} // namespace Orbane

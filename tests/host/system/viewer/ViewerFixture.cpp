#include "ViewerFixture.h"
#include "LoadControlModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"

#include <QApplication>
#include <QMouseEvent>


namespace Orbane {
namespace Test {

ViewerFixture::ViewerFixture() : tool(new Operator("Tool1", "TestTool")), viewer(&doc)
{
    doc.AddTool(tool);
    tool->DecRef();
    QImage image(400, 200, QImage::Format_RGB32);
    image.fill(Qt::black);
    viewer.SetImage(image);
    viewer.resize(kViewWidth, kViewHeight);
}

Input *ViewerFixture::AddPoint(const char *id, float64 x, float64 y, const TagList &attrs)
{
    const AutoPoint def(x, y);
    return tool->AddInput(OrbID(id), id, CLSID_DataType_Point, attrs, def);
}

bool ViewerFixture::Show()
{
    viewer.ShowTool(tool);
    viewer.show();
    if (!QTest::qWaitForWindowExposed(&viewer))
        return false;
    viewer.SetView(1.0);
    viewer.activateWindow();
    viewer.setFocus();
    QApplication::processEvents();
    return viewer.width() == kViewWidth && viewer.height() == kViewHeight;
}

PreviewControl *ViewerFixture::OverlayOf(const Input *input, int index) const
{
    const std::vector<PreviewControl *> overlays = viewer.OverlaysOf(input);
    return index < int(overlays.size()) ? overlays[std::size_t(index)] : nullptr;
}

QPoint ViewerFixture::At(OrbPoint image, QPoint offset) const
{
    const QPointF w = viewer.ImageToWidget(image);
    return QPoint(int(std::lround(w.x())) + offset.x(), int(std::lround(w.y())) - offset.y());
}

OrbPoint ViewerFixture::PointOf(const Input *input) const
{
    const AutoPoint p(const_cast<Input *>(input), doc.GetCurrentTime());
    return p ? OrbPoint(p->X, p->Y) : OrbPoint(-1.0, -1.0);
}

void ViewerFixture::Send(QEvent::Type type, QPoint at, Qt::MouseButton button, Qt::MouseButtons held)
{
    QMouseEvent event(type, at, viewer.mapToGlobal(at), button, held, Qt::NoModifier);
    QApplication::sendEvent(&viewer, &event);
}

void ViewerFixture::Drag(QPoint from, QPoint to, int steps)
{
    Press(from);
    for (int i = 1; i <= steps; ++i)
        Move(from + (to - from) * i / steps);
    Release(to);
}

bool ViewerFixture::LoadControls(std::string *error)
{
    return LoadControlModule(error);
}

} // namespace Test
} // namespace Orbane

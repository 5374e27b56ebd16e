#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"

#include <QApplication>
#include <QMouseEvent>
#include <QTest>
#include <QUndoStack>

#include <cmath>
#include <cstdlib>
#include <dlfcn.h>

namespace Orbane {
namespace Test {

ViewerFixture::ViewerFixture(int imageWidth, int imageHeight, const char *toolName)
    : tool(new Operator(toolName, "TestTool")), viewer(&doc), image(imageWidth, imageHeight, QImage::Format_RGB32)
{
    doc.AddTool(tool);
    tool->DecRef();
    image.fill(Qt::black);
    viewer.SetImage(image);
    viewer.resize(kViewWidth, kViewHeight);
}

ViewerFixture::~ViewerFixture()
{
    viewer.ShowTool(nullptr);
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

namespace {

void Send(QWidget *w, QEvent::Type type, QPoint at, Qt::MouseButton button, Qt::MouseButtons held,
          Qt::KeyboardModifiers mods)
{
    QMouseEvent event(type, at, w->mapToGlobal(at), button, held, mods);
    QApplication::sendEvent(w, &event);
}

} // namespace

void ViewerFixture::Press(QPoint at, Qt::KeyboardModifiers mods, Qt::MouseButton button)
{
    Send(&viewer, QEvent::MouseButtonPress, at, button, button, mods);
}

void ViewerFixture::Move(QPoint at, Qt::KeyboardModifiers mods)
{
    Send(&viewer, QEvent::MouseMove, at, Qt::NoButton, Qt::LeftButton, mods);
}

void ViewerFixture::Release(QPoint at, Qt::KeyboardModifiers mods, Qt::MouseButton button)
{
    Send(&viewer, QEvent::MouseButtonRelease, at, button, Qt::NoButton, mods);
}

void ViewerFixture::Hover(QPoint at)
{
    Send(&viewer, QEvent::MouseMove, at, Qt::NoButton, Qt::NoButton, Qt::NoModifier);
}

void ViewerFixture::Drag(QPoint from, QPoint to, int steps)
{
    Press(from);
    for (int i = 1; i <= steps; ++i)
        Move(from + (to - from) * i / steps);
    Release(to);
}

void ViewerFixture::Key(Qt::Key key, Qt::KeyboardModifiers mods)
{
    QTest::keyClick(&viewer, key, mods);
}

QImage ViewerFixture::Grab()
{
    return viewer.grab().toImage();
}

int ViewerFixture::UndoSteps() const
{
    return doc.UndoNames().size();
}

bool ViewerFixture::LoadControls(std::string *error)
{
    static void *handle = nullptr;
    static std::string failure;
    if (!handle && failure.empty()) {
        const char *path = std::getenv("ORBANE_CONTROLS");
        handle = path ? dlopen(path, RTLD_NOW | RTLD_GLOBAL) : nullptr;
        if (!handle)
            failure = path ? dlerror() : "ORBANE_CONTROLS is not set";
    }
    if (error)
        *error = failure;
    return handle != nullptr;
}

} // namespace Test
} // namespace Orbane

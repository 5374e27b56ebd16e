#pragma once

#include "orbane/OrbaneDoc.h"
#include "orbane/TagList.h"
#include "orbane/ViewerPanel.h"

#include <QByteArray>
#include <QImage>
#include <QPoint>
#include <QTest>

#include <cmath>
#include <string>

namespace Orbane {
namespace Test {

// A document with one tool and a 500 x 300 viewer showing a black 400 x 200
// image at zoom 1, centred: image (0.5, 0.5) is widget pixel (250, 150).
class ViewerFixture
{
public:
    static constexpr int kViewWidth = 500;
    static constexpr int kViewHeight = 300;

    ViewerFixture();
    ~ViewerFixture() { viewer.ShowTool(nullptr); }
    ViewerFixture(const ViewerFixture &) = delete;
    ViewerFixture &operator=(const ViewerFixture &) = delete;

    Input *AddPoint(const char *id, float64 x, float64 y, const TagList &attrs = TagList());
    // Shows the tool in the viewer and the viewer on screen, at zoom 1.
    bool Show();
    PreviewControl *OverlayOf(const Input *input, int index = 0) const;

    // The widget pixel of an image point, moved by `offset` viewer pixels (Y up).
    QPoint At(OrbPoint image, QPoint offset = QPoint()) const;
    OrbPoint PointOf(const Input *input) const;

    void Press(QPoint at, Qt::MouseButton button = Qt::LeftButton)
    {
        Send(QEvent::MouseButtonPress, at, button, button);
    }
    void Move(QPoint at, Qt::MouseButtons held = Qt::LeftButton) { Send(QEvent::MouseMove, at, Qt::NoButton, held); }
    void Hover(QPoint at) { Move(at, Qt::NoButton); }
    void Release(QPoint at, Qt::MouseButton button = Qt::LeftButton)
    {
        Send(QEvent::MouseButtonRelease, at, button, Qt::NoButton);
    }
    void Click(QPoint at)
    {
        Press(at);
        Release(at);
    }
    void Drag(QPoint from, QPoint to, int steps = 4);
    void Key(Qt::Key key, Qt::KeyboardModifiers mods = Qt::NoModifier) { QTest::keyClick(&viewer, key, mods); }

    QImage Grab() { return viewer.grab().toImage(); }
    int UndoSteps() const { return doc.UndoNames().size(); }

    static bool LoadControls(std::string *error);

    OrbaneDoc doc;
    Operator *tool = nullptr; // owned by the document
    ViewerPanel viewer;

private:
    void Send(QEvent::Type type, QPoint at, Qt::MouseButton button, Qt::MouseButtons held);
};

// Points that agree to far below anything a viewer shows.
inline bool Near(OrbPoint a, OrbPoint b)
{
    return std::fabs(a.x - b.x) <= 1e-12 && std::fabs(a.y - b.y) <= 1e-12;
}

} // namespace Test

// Readable failures of QCOMPARE on points.
inline char *toString(const OrbPoint &p)
{
    return qstrdup(QByteArray::number(p.x, 'g', 17) + ", " + QByteArray::number(p.y, 'g', 17));
}

} // namespace Orbane

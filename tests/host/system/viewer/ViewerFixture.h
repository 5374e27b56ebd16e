#pragma once

#include "orbane/OrbaneDoc.h"
#include "orbane/TagList.h"
#include "orbane/ViewerPanel.h"

#include <QByteArray>
#include <QImage>
#include <QPoint>

#include <cmath>
#include <string>

namespace Orbane {
namespace Test {

// A document with one tool and a viewer that shows it, laid out so that
// image and widget pixels meet exactly: a 500 x 300 viewer showing a black
// image of 400 x 200 (by default) at zoom 1, centred, so the image point
// (0.5, 0.5) is widget pixel (250, 150) and one image pixel one widget pixel.
// Everything reaches the viewer as Qt events.
class ViewerFixture
{
public:
    static constexpr int kViewWidth = 500;
    static constexpr int kViewHeight = 300;

    explicit ViewerFixture(int imageWidth = 400, int imageHeight = 200, const char *toolName = "Tool1");
    ~ViewerFixture();
    ViewerFixture(const ViewerFixture &) = delete;
    ViewerFixture &operator=(const ViewerFixture &) = delete;

    Input *AddPoint(const char *id, float64 x, float64 y, const TagList &attrs = TagList());
    // Shows the tool in the viewer and the viewer on screen, at zoom 1.
    bool Show();
    PreviewControl *OverlayOf(const Input *input, int index = 0) const;

    // The widget pixel of an image point, moved by `offset` viewer pixels
    // (X right, Y up, as overlays count).
    QPoint At(OrbPoint image, QPoint offset = QPoint()) const;
    OrbPoint PointOf(const Input *input) const;

    void Press(QPoint at, Qt::KeyboardModifiers mods = Qt::NoModifier, Qt::MouseButton button = Qt::LeftButton);
    // A move with the left button held.
    void Move(QPoint at, Qt::KeyboardModifiers mods = Qt::NoModifier);
    void Release(QPoint at, Qt::KeyboardModifiers mods = Qt::NoModifier, Qt::MouseButton button = Qt::LeftButton);
    // A move with no button held.
    void Hover(QPoint at);
    // Press, moves in `steps`, release: one drag.
    void Drag(QPoint from, QPoint to, int steps = 4);
    // A key pressed and released, the modifier keys around it, as hands do.
    void Key(Qt::Key key, Qt::KeyboardModifiers mods = Qt::NoModifier);

    QImage Grab();
    int UndoSteps() const;

    // The control library as the host loads it, once per process.
    static bool LoadControls(std::string *error);

    OrbaneDoc doc;
    Operator *tool = nullptr; // owned by the document
    ViewerPanel viewer;
    QImage image;
};

// Points that agree to far below anything a viewer shows.
inline bool Near(OrbPoint a, OrbPoint b, float64 tolerance = 1e-12)
{
    return std::fabs(a.x - b.x) <= tolerance && std::fabs(a.y - b.y) <= tolerance;
}

} // namespace Test

// Readable failures of QCOMPARE on points.
inline char *toString(const OrbPoint &p)
{
    return qstrdup(QByteArray::number(p.x, 'g', 17) + ", " + QByteArray::number(p.y, 'g', 17));
}

} // namespace Orbane

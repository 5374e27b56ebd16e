#pragma once

#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Operator.h"
#include "orbane/ScriptVal.h"

#include <QImage>
#include <QPoint>
#include <QtTest>

#include <algorithm>
#include <utility>
#include <vector>

Q_DECLARE_METATYPE(Orbane::OrbPoint)

namespace Orbane {
namespace Test {

// The brightest grey level within `radius` pixels of `at`.
inline int Level(const QImage &image, QPoint at, int radius = 1)
{
    int level = 0;
    for (int dy = -radius; dy <= radius; ++dy)
        for (int dx = -radius; dx <= radius; ++dx) {
            const QPoint p = at + QPoint(dx, dy);
            if (image.rect().contains(p))
                level = std::max(level, qGray(image.pixel(p)));
        }
    return level;
}

inline bool Lit(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) > 60;
}

inline bool Dark(const QImage &image, QPoint at, int radius = 1)
{
    return Level(image, at, radius) < 20;
}

// Holds modifier keys down while it lives, as a hand on the keyboard does
// during a drag: overlays read the keyboard's state, not the mouse event's.
class HeldKeys
{
public:
    HeldKeys(QWidget *widget, Qt::KeyboardModifiers mods) : mWidget(widget), mMods(mods)
    {
        for (const auto &[mod, key] : Keys())
            if (mMods & mod)
                QTest::keyPress(mWidget, key, mod);
    }
    ~HeldKeys()
    {
        for (const auto &[mod, key] : Keys())
            if (mMods & mod)
                QTest::keyRelease(mWidget, key, Qt::NoModifier);
    }
    HeldKeys(const HeldKeys &) = delete;
    HeldKeys &operator=(const HeldKeys &) = delete;

private:
    static std::vector<std::pair<Qt::KeyboardModifier, Qt::Key>> Keys()
    {
        return {{Qt::ShiftModifier, Qt::Key_Shift}, {Qt::ControlModifier, Qt::Key_Control}};
    }
    QWidget *mWidget;
    Qt::KeyboardModifiers mMods;
};

// The overlay's state field `key` as a number (a boolean as 0 or 1; -1
// where there is none).
inline double StateOf(const PreviewControl *overlay, const char *key)
{
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    const ScriptVal *v = state.FindKeyConst(ScriptVal(key));
    return v ? (v->IsBool() ? double(v->GetBool()) : v->GetNumber()) : -1.0;
}

// A Number Input's value now, or -1000 where it holds none.
inline double NumberOf(const ViewerFixture &f, const char *id)
{
    const AutoNumber n(f.tool->FindInput(OrbID(id)), f.doc.GetCurrentTime());
    return n ? n->Value : -1000.0;
}

// Hovers and drags a little from every point of a grid over the whole
// viewer, drawing before and after: a hand that tries everything, for
// shapes that must never crash.
inline void SweepDrags(ViewerFixture &f)
{
    f.Grab();
    for (int x = 30; x < ViewerFixture::kViewWidth; x += 40)
        for (int y = 20; y < ViewerFixture::kViewHeight; y += 40) {
            f.Hover(QPoint(x, y));
            f.Drag(QPoint(x, y), QPoint(x + 23, y - 17), 2);
        }
    f.Grab();
}

// Arrow-key nudges and how far they move a point, in image pixels.
inline void NudgeRows()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("dx");
    QTest::addColumn<double>("dy");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << 1.0 << 0.0;
    QTest::newRow("up increases Y") << int(Qt::Key_Up) << int(Qt::NoModifier) << 0.0 << 1.0;
    QTest::newRow("left with shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << -10.0 << 0.0;
    QTest::newRow("down with control: a tenth") << int(Qt::Key_Down) << int(Qt::ControlModifier) << 0.0 << -0.1;
    QTest::newRow("up with both: one") << int(Qt::Key_Up) << int(Qt::ShiftModifier | Qt::ControlModifier) << 0.0 << 1.0;
}

// One nudge of a centred point; a Y step is one pixel of `yPixels`.
inline void CheckNudge(const TagList &attrs, double yPixels)
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, dx);
    QFETCH(double, dy);
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, attrs);
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QVERIFY(Near(f.PointOf(p), {0.5 + dx / 400, 0.5 + dy / yPixels}));
    QCOMPARE(f.UndoSteps(), 1);
}

} // namespace Test
} // namespace Orbane

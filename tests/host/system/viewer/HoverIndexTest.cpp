// The viewer's spatial hover index against the plain walk over every
// overlay: two viewers show the same random scene and live through the same
// random moves, hovers, drags, zooms and switches; after each step they must
// agree on which overlay claimed the mouse and on every overlay's hover
// state and redraw answers.
#include "TestOverlay.h"
#include "ViewerFixture.h"

#include "orbane/Input.h"

#include <QtTest>

#include <random>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

// One viewer and its scene; `plain` asks every overlay on each hover.
struct Scene
{
    // Every `fadeEvery`-th overlay fades; 0: none.
    Scene(bool plain, const std::vector<OrbPoint> &points, int fadeEvery = 0)
    {
        f.viewer.SetPlainHover(plain);
        for (std::size_t i = 0; i < points.size(); ++i) {
            const bool fades = fadeEvery && i % std::size_t(fadeEvery) == 0;
            TagList attrs{{INPA_PreviewControl, kTestOverlayID}, {TestOverlay::TO_Fades, fades ? 1 : 0}};
            inputs.push_back(f.AddPoint(("P" + std::to_string(i)).c_str(), points[i].x, points[i].y, attrs));
        }
    }
    // Shows the viewer and collects the overlays in the inputs' order.
    bool Show()
    {
        const bool shown = f.Show();
        for (Input *in : inputs)
            overlays.push_back(dynamic_cast<TestOverlay *>(f.OverlayOf(in)));
        return shown;
    }
    int HoverIndex() const
    {
        const auto &all = f.viewer.Overlays();
        const auto it = std::find(all.begin(), all.end(), f.viewer.HoverControl());
        return it == all.end() ? -1 : int(it - all.begin());
    }

    ViewerFixture f;
    std::vector<Input *> inputs;
    std::vector<TestOverlay *> overlays;
};

// The same random step applied to both scenes.
class Stepper
{
public:
    Stepper(unsigned seed, Scene &a, Scene &b) : mRandom(seed), mA(a), mB(b) {}

    // Returns what the step did, for failure messages.
    QString Step()
    {
        const int kind = Int(0, 99);
        const std::size_t i = std::size_t(Int(0, int(mA.inputs.size()) - 1));
        if (kind < 60) {
            // Mostly near a handle, so that hovers claim and let go.
            const QPoint at = kind < 30 ? mA.f.At(mA.f.PointOf(mA.inputs[i]), QPoint(Int(-8, 8), Int(-8, 8)))
                                        : QPoint(Int(0, ViewerFixture::kViewWidth), Int(0, ViewerFixture::kViewHeight));
            Both([at](Scene &s) { s.f.Hover(at); });
            return QString("hover %1, %2").arg(at.x()).arg(at.y());
        }
        if (kind < 75) {
            const OrbPoint to(Real(-0.1, 1.1), Real(-0.1, 1.1));
            Both([&](Scene &s) { s.inputs[i]->SetValue(AutoPoint(to.x, to.y).get(), 0.0); });
            return QString("move P%1").arg(i);
        }
        if (kind < 85) {
            const QPoint from = mA.f.At(mA.f.PointOf(mA.inputs[i]), QPoint(Int(-3, 3), Int(-3, 3)));
            const QPoint to = from + QPoint(Int(-60, 60), Int(-60, 60));
            Both([&](Scene &s) { s.f.Drag(from, to, 2); });
            return QString("drag from %1, %2").arg(from.x()).arg(from.y());
        }
        if (kind < 92) {
            const bool on = Int(0, 1) == 1;
            Both([&](Scene &s) { s.overlays[i]->SetActive(on ? 1 : 0, nullptr); });
            return QString("P%1 %2").arg(i).arg(on ? "on" : "off");
        }
        if (kind < 97) {
            const float64 zoom = Real(0.5, 2.5);
            const OrbPoint pan(Real(-80, 80), Real(-80, 80));
            Both([&](Scene &s) { s.f.viewer.SetView(zoom, pan); });
            return QString("zoom %1").arg(zoom);
        }
        const int tolerance = Int(3, 12);
        Both([&](Scene &s) { s.f.viewer.Info().PickTolerance = tolerance; });
        return QString("tolerance %1").arg(tolerance);
    }

private:
    template <class F> void Both(F f)
    {
        for (Scene *s : {&mA, &mB})
            f(*s);
    }
    int Int(int lo, int hi) { return std::uniform_int_distribution<int>(lo, hi)(mRandom); }
    float64 Real(float64 lo, float64 hi) { return std::uniform_real_distribution<float64>(lo, hi)(mRandom); }

    std::mt19937 mRandom;
    Scene &mA;
    Scene &mB;
};

} // namespace

class HoverIndexTest : public QObject
{
    Q_OBJECT

private slots:
    void agreesWithThePlainWalk_data();
    void agreesWithThePlainWalk();
    void switchedOffHoverIsLetGoWhenBack();

private:
    TestOverlayClass mTestOverlayClass;
};

void HoverIndexTest::agreesWithThePlainWalk_data()
{
    QTest::addColumn<unsigned>("seed");
    QTest::addColumn<int>("count");
    QTest::addColumn<int>("fadeEvery"); // every n-th overlay fades; 0: none
    QTest::newRow("150 overlays, none fades") << 1u << 150 << 0;
    QTest::newRow("150 overlays, every 7th fades") << 2u << 150 << 7;
    QTest::newRow("12 overlays, every 3rd fades") << 3u << 12 << 3;
    QTest::newRow("250 crowded overlays") << 4u << 250 << 50;
}

void HoverIndexTest::agreesWithThePlainWalk()
{
    QFETCH(unsigned, seed);
    QFETCH(int, count);
    QFETCH(int, fadeEvery);
    std::mt19937 random(seed);
    std::uniform_real_distribution<float64> place(-0.1, 1.1);
    std::vector<OrbPoint> points;
    for (int i = 0; i < count; ++i)
        points.emplace_back(place(random), place(random));
    Scene indexed(false, points, fadeEvery), plain(true, points, fadeEvery);
    QVERIFY(indexed.Show() && plain.Show());
    Stepper stepper(seed, indexed, plain);
    int askedIndexed = 0, askedPlain = 0;
    for (int step = 0; step < 300; ++step) {
        const QString what = QString("step %1: %2").arg(step).arg(stepper.Step());
        QVERIFY2(indexed.HoverIndex() == plain.HoverIndex(), qPrintable(what));
        for (std::size_t i = 0; i < points.size(); ++i) {
            const TestOverlay *a = indexed.overlays[i], *b = plain.overlays[i];
            QVERIFY2(a->hover == b->hover && a->redraws == b->redraws && a->fadeStep == b->fadeStep,
                     qPrintable(what + QString(", P%1").arg(i)));
        }
        askedIndexed += indexed.f.viewer.HoverAsked();
        askedPlain += plain.f.viewer.HoverAsked();
    }
    // The index earns its keep: far fewer overlays are asked.
    if (count >= 100)
        QVERIFY2(askedIndexed * 4 < askedPlain, qPrintable(QString("%1 of %2").arg(askedIndexed).arg(askedPlain)));
}

// An overlay switched off keeps its hover; back on, away from the mouse, it
// must still be asked to let go of it.
void HoverIndexTest::switchedOffHoverIsLetGoWhenBack()
{
    Scene indexed(false, {{0.25, 0.5}, {0.75, 0.5}}), plain(true, {{0.25, 0.5}, {0.75, 0.5}});
    for (Scene *s : {&indexed, &plain}) {
        QVERIFY(s->Show());
        s->f.Hover(s->f.At({0.25, 0.5}));
        s->overlays[0]->SetActive(0, nullptr);
        s->f.Hover(s->f.At({0.75, 0.5}));
        s->overlays[0]->SetActive(1, nullptr);
        s->f.Hover(s->f.At({0.75, 0.5}, QPoint(2, 0)));
    }
    QVERIFY(!plain.overlays[0]->hover && !indexed.overlays[0]->hover);
    QCOMPARE(indexed.overlays[0]->redraws, plain.overlays[0]->redraws);
}

QTEST_MAIN(HoverIndexTest)
#include "HoverIndexTest.moc"

// A drag of 1000 mouse moves on an inspector slider, end to end: the event,
// the rounded value written to the Input with undo, every control bound to
// the Input notified, and the repaint the event loop does. Against a stock
// QSlider wired to a QDoubleSpinBox through a plain value, doing the same.
#include "BenchModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QDoubleSpinBox>
#include <QMouseEvent>
#include <QSlider>
#include <QStyle>
#include <QStyleOptionSlider>
#include <QVBoxLayout>

#include <cmath>
#include <memory>
#include <vector>

using namespace Orbane;

namespace {

constexpr int Moves = 1000;
constexpr int Width = 300;
constexpr int KnobY = 7;
constexpr int KnobWidth = 11;

// The moves sweep the track to and fro, so that every move changes the value.
int MoveX(int i)
{
    const int span = Width - 40, step = i % (2 * span);
    return 20 + (step < span ? step : 2 * span - step);
}

void SendMouse(QWidget *w, QEvent::Type type, int x, Qt::MouseButtons buttons)
{
    const QPoint pos(x, KnobY);
    QMouseEvent event(type, pos, w->mapToGlobal(pos), type == QEvent::MouseMove ? Qt::NoButton : Qt::LeftButton,
                      buttons, Qt::NoModifier);
    QApplication::sendEvent(w, &event);
}

// One tool with a number Input 0..1 in three places, shown by `count`
// slider controls on one inspector page, as the inspector builds them.
class SliderPage
{
public:
    explicit SliderPage(int count)
    {
        const TagList attrs{{0x20030000, 0.0}, {0x20030001, 1.0}, {0x10040004, 3}};
        Operator *tool = new Operator("Bench1", "Bench");
        mDoc.AddTool(tool);
        tool->DecRef();
        mInput = tool->AddInput(OrbID("Blend"), "Blend", CLSID_DataType_Number, attrs, AutoNumber(0.5));
        for (int i = 0; i < count; ++i)
            Add(attrs, i);
        mPage.resize(Width, 60 * count);
        mPage.show();
        QApplication::processEvents();
    }
    ~SliderPage()
    {
        for (InputControl *c : mControls) {
            c->OnDisconnect(mInput, nullptr);
            c->setParent(nullptr);
            c->DecRef();
        }
    }

    bool IsValid() const { return !mControls.empty() && mControls.front(); }
    // Did the drags reach the Input (the press caught the knob)?
    bool Moved() const { return AutoNumber(mInput, mDoc.GetCurrentTime())->Value != 0.5; }
    QWidget *Slider() const { return mControls.front()->findChild<QWidget *>("slider"); }
    // The knob's column for the Input's value: its centre runs from half a
    // knob in from the left to half a knob in from the right.
    int KnobX() const
    {
        const AutoNumber value(mInput, mDoc.GetCurrentTime());
        const double lo = KnobWidth / 2, hi = Slider()->width() - (KnobWidth - KnobWidth / 2);
        return int(std::floor(lo + (hi - lo) * value->Value + 0.5));
    }

private:
    void Add(const TagList &attrs, int row)
    {
        auto *c = dynamic_cast<InputControl *>(ClassRegistry.New(CLSID_InputControl_Slider, ScriptVal(), attrs));
        mControls.push_back(c);
        if (!c)
            return;
        c->AddInput(mInput, &attrs);
        c->SetAttrsTagList(mInput, attrs);
        c->Open(&mPage, QRect(), nullptr);
        int32 w = Width, h = 0;
        c->SetSize(w, h, nullptr);
        c->move(0, row * 60);
    }

    OrbaneDoc mDoc;
    Input *mInput = nullptr;
    QWidget mPage;
    std::vector<InputControl *> mControls;
};

void BM_SliderControl_Drag(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    SliderPage page(int(state.range(0)));
    if (!page.IsValid())
        return state.SkipWithError("no SliderControl in the registry");
    QWidget *slider = page.Slider();
    for (auto _ : state) {
        SendMouse(slider, QEvent::MouseButtonPress, page.KnobX(), Qt::LeftButton);
        for (int i = 0; i < Moves; ++i) {
            SendMouse(slider, QEvent::MouseMove, MoveX(i), Qt::LeftButton);
            QApplication::processEvents();
        }
        SendMouse(slider, QEvent::MouseButtonRelease, MoveX(Moves - 1), Qt::NoButton);
        QApplication::processEvents();
    }
    state.SetItemsProcessed(state.iterations() * Moves);
    if (!page.Moved())
        state.SkipWithError("the drags did not move the value");
}
BENCHMARK(BM_SliderControl_Drag)->Arg(1)->Arg(3)->Unit(benchmark::kMillisecond);

// The stock alternative: a QSlider and a QDoubleSpinBox per view, each
// showing a plain value that the slider's moves write.
class StockSlider : public QSlider
{
public:
    StockSlider() : QSlider(Qt::Horizontal) { setRange(0, 1000); }
    int HandleX() const
    {
        QStyleOptionSlider opt;
        initStyleOption(&opt);
        return style()->subControlRect(QStyle::CC_Slider, &opt, QStyle::SC_SliderHandle, this).center().x();
    }
};

class StockValue : public QObject
{
    Q_OBJECT
public:
    void Set(double v)
    {
        if (v == mValue)
            return;
        mValue = v;
        emit changed(v);
    }

signals:
    void changed(double value);

private:
    double mValue = 0.5;
};

class StockPage
{
public:
    explicit StockPage(int count)
    {
        auto *layout = new QVBoxLayout(&mPage);
        for (int i = 0; i < count; ++i) {
            auto *slider = new StockSlider;
            auto *spin = new QDoubleSpinBox;
            spin->setDecimals(3);
            spin->setRange(0.0, 1.0);
            layout->addWidget(spin);
            layout->addWidget(slider);
            mSliders.push_back(slider);
            QObject::connect(slider, &QSlider::valueChanged, &mValue, [this](int v) { mValue.Set(v / 1000.0); });
            QObject::connect(&mValue, &StockValue::changed, spin, [spin, slider](double v) {
                const QSignalBlocker blockSpin(spin), blockSlider(slider);
                spin->setValue(v);
                slider->setValue(int(std::lround(v * 1000)));
            });
        }
        mValue.Set(0.5);
        mPage.resize(Width, 60 * count);
        mPage.show();
        QApplication::processEvents();
    }
    StockSlider *Slider() const { return mSliders.front(); }
    bool Moved() const { return mSliders.back()->value() != 500; }

private:
    StockValue mValue;
    QWidget mPage;
    std::vector<StockSlider *> mSliders;
};

void BM_QSliderSpinBox_Drag(benchmark::State &state)
{
    StockPage page(int(state.range(0)));
    StockSlider *slider = page.Slider();
    for (auto _ : state) {
        SendMouse(slider, QEvent::MouseButtonPress, slider->HandleX(), Qt::LeftButton);
        for (int i = 0; i < Moves; ++i) {
            SendMouse(slider, QEvent::MouseMove, MoveX(i), Qt::LeftButton);
            QApplication::processEvents();
        }
        SendMouse(slider, QEvent::MouseButtonRelease, MoveX(Moves - 1), Qt::NoButton);
        QApplication::processEvents();
    }
    state.SetItemsProcessed(state.iterations() * Moves);
    if (!page.Moved())
        state.SkipWithError("the drags did not move the value");
}
BENCHMARK(BM_QSliderSpinBox_Drag)->Arg(1)->Arg(3)->Unit(benchmark::kMillisecond);

} // namespace

#include "SliderDragBench.moc"

// A painted number slider against a stock QSlider of the same size: the cost
// of showing a new value, as a drag does on every mouse move.
#include "widgets/CustomSlider.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QSlider>

#include <memory>

namespace {

constexpr int Width = 300, Height = 24;

// Values that move the knob by a few pixels each time, as a drag does.
double NextValue(int i)
{
    return (i % 200) / 200.0;
}

std::unique_ptr<Orbane::CustomSlider> MakeCustomSlider()
{
    auto slider = std::make_unique<Orbane::CustomSlider>();
    slider->SetAllowedRange(0.0, 1.0, false);
    slider->SetScale(0.0, 1.0, false);
    slider->SetDefault(0.5, false);
    slider->resize(Width, Height);
    slider->show();
    QApplication::processEvents();
    return slider;
}

std::unique_ptr<QSlider> MakeQSlider()
{
    auto slider = std::make_unique<QSlider>(Qt::Horizontal);
    slider->setRange(0, 200);
    slider->resize(Width, Height);
    slider->show();
    QApplication::processEvents();
    return slider;
}

// Value change, then the repaint that the event loop would do: only the
// damaged part for the custom slider, as its Redraw asks.
void BM_CustomSlider_ValueUpdate(benchmark::State &state)
{
    auto slider = MakeCustomSlider();
    int i = 0;
    for (auto _ : state) {
        slider->SetValue(NextValue(++i), true);
        QApplication::processEvents();
    }
}
BENCHMARK(BM_CustomSlider_ValueUpdate);

void BM_QSlider_ValueUpdate(benchmark::State &state)
{
    auto slider = MakeQSlider();
    int i = 0;
    for (auto _ : state) {
        slider->setValue(++i % 200);
        QApplication::processEvents();
    }
}
BENCHMARK(BM_QSlider_ValueUpdate);

// Qt's own share of both rows above: a widget that paints nothing, given the
// same damage as the slider's knob move and the same trip through the event
// loop, the repaint manager and the backing store.
class Unpainted : public QWidget
{
protected:
    void paintEvent(QPaintEvent *) override {}
};

void BM_Unpainted_ValueUpdate(benchmark::State &state)
{
    Unpainted widget;
    widget.setAttribute(Qt::WA_OpaquePaintEvent);
    widget.resize(Width, Height);
    widget.show();
    QApplication::processEvents();
    int i = 0;
    for (auto _ : state) {
        widget.update(int(NextValue(++i) * (Width - 20)), 0, 24, Height);
        QApplication::processEvents();
    }
}
BENCHMARK(BM_Unpainted_ValueUpdate);

// Value change and a synchronous repaint of the whole widget.
void BM_CustomSlider_FullRepaint(benchmark::State &state)
{
    auto slider = MakeCustomSlider();
    int i = 0;
    for (auto _ : state) {
        slider->SetValue(NextValue(++i), false);
        slider->repaint();
    }
}
BENCHMARK(BM_CustomSlider_FullRepaint);

void BM_QSlider_FullRepaint(benchmark::State &state)
{
    auto slider = MakeQSlider();
    int i = 0;
    for (auto _ : state) {
        slider->setValue(++i % 200);
        slider->repaint();
    }
}
BENCHMARK(BM_QSlider_FullRepaint);

} // namespace

// The inspector as the application drives it: building and showing a page of
// N slider controls, tearing it down, and switching to a very large tool and
// back. Against stock Qt rows (a QLabel, a QSlider and a QDoubleSpinBox in a
// layout, built hidden and shown once) in a scroll area of the same size.
#include "BenchModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterPanel.h"
#include "orbane/Tags.h"
#include "orbane/Text.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QDoubleSpinBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QScrollArea>
#include <QSlider>
#include <QVBoxLayout>

#include <string>

using namespace Orbane;

namespace {

constexpr int PanelWidth = 360, PanelHeight = 700;

// A tool of `count` number Inputs, each shown by a slider control.
Operator *AddSliderTool(OrbaneDoc &doc, const char *name, int count)
{
    const TagList attrs{
        {0x20030000, 0.0}, {0x20030001, 1.0}, {0x10040004, 3}, {INPA_InputControl, OrbID("SliderControl")}};
    Operator *tool = new Operator(name, "Bench");
    doc.AddTool(tool);
    tool->DecRef();
    for (int i = 0; i < count; ++i) {
        const std::string id = "Value" + std::to_string(i + 1);
        tool->AddInput(OrbID(id.c_str()), id.c_str(), CLSID_DataType_Number, attrs, AutoNumber(0.5));
    }
    return tool;
}

// A tool of `count` controls, the file, font, clip and range controls and
// the slider in turn; each range has a second Input, shown by no control.
Operator *AddMixedTool(OrbaneDoc &doc, const char *name, int count)
{
    Operator *tool = new Operator(name, "Bench");
    doc.AddTool(tool);
    tool->DecRef();
    const char *const texts[3][2] = {
        {"FileControl", "images/dusk.png"}, {"FontFileControl", "DejaVu Sans"}, {"ClipControl", "plate.####.exr"}};
    for (int i = 0; i < count; ++i) {
        const std::string id = "Value" + std::to_string(i + 1);
        const OrbID oid(id.c_str());
        if (i % 5 < 3) {
            const TagList attrs{{INPA_InputControl, OrbID(texts[i % 5][0])}};
            tool->AddInput(oid, id.c_str(), CLSID_DataType_Text, attrs, AutoText(texts[i % 5][1]));
        } else if (i % 5 == 3) {
            const std::string high = id + "High";
            Input *end =
                tool->AddInput(OrbID(high.c_str()), high.c_str(), CLSID_DataType_Number, TagList(), AutoNumber(0.8));
            const TagList attrs{{INPA_InputControl, OrbID("RangeControl")},
                                {0x40050000, static_cast<ScriptObject *>(end)}};
            tool->AddInput(oid, id.c_str(), CLSID_DataType_Number, attrs, AutoNumber(0.2));
        } else {
            const TagList attrs{{INPA_InputControl, OrbID("SliderControl")}};
            tool->AddInput(oid, id.c_str(), CLSID_DataType_Number, attrs, AutoNumber(0.5));
        }
    }
    return tool;
}

// A shown panel with one tool of `count` sliders and one of three.
struct Inspector
{
    explicit Inspector(int count)
    {
        large = AddSliderTool(doc, "Large", count);
        small = AddSliderTool(doc, "Small", 3);
        panel.resize(PanelWidth, PanelHeight);
        panel.show();
        QApplication::processEvents();
    }
    OrbaneDoc doc;
    Operator *large = nullptr, *small = nullptr;
    ParameterPanel panel{&doc};
};

void ShowAndSettle(ParameterPanel &panel, Operator *tool)
{
    panel.ShowTool(tool);
    QApplication::processEvents();
}

// Shows the tool with every control built, not only those in view: the cost
// of building a control, for comparison with a stock row.
void ShowAllAndSettle(ParameterPanel &panel, Operator *tool)
{
    panel.ShowTool(tool);
    panel.ControlsOf(tool->Inputs().back());
    QApplication::processEvents();
}

void BM_Inspector_Build(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    Inspector in(int(state.range(0)));
    size_t built = 0;
    for (auto _ : state) {
        ShowAllAndSettle(in.panel, in.large);
        state.PauseTiming();
        built = in.panel.Controls().size();
        ShowAndSettle(in.panel, nullptr);
        state.ResumeTiming();
    }
    state.counters["built"] = double(built);
}
BENCHMARK(BM_Inspector_Build)->Arg(500)->Arg(2000)->Unit(benchmark::kMillisecond);

// The same for a tool of mixed controls, every one built.
void BM_Inspector_BuildMixed(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    Inspector in(3);
    Operator *mixed = AddMixedTool(in.doc, "Mixed", int(state.range(0)));
    for (auto _ : state) {
        ShowAllAndSettle(in.panel, mixed);
        state.PauseTiming();
        ShowAndSettle(in.panel, nullptr);
        state.ResumeTiming();
    }
}
BENCHMARK(BM_Inspector_BuildMixed)->Arg(500)->Unit(benchmark::kMillisecond);

void BM_Inspector_Teardown(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    Inspector in(int(state.range(0)));
    for (auto _ : state) {
        state.PauseTiming();
        ShowAllAndSettle(in.panel, in.large);
        state.ResumeTiming();
        ShowAndSettle(in.panel, nullptr);
    }
}
BENCHMARK(BM_Inspector_Teardown)->Arg(500)->Arg(2000)->Unit(benchmark::kMillisecond);

// To the large tool and back to a small one, as a user clicking between two
// tools does; both pages are shown and painted, built as far as they show.
void BM_Inspector_SwitchLarge(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    Inspector in(int(state.range(0)));
    ShowAndSettle(in.panel, in.small);
    size_t built = 0;
    for (auto _ : state) {
        ShowAndSettle(in.panel, in.large);
        built = in.panel.Controls().size();
        ShowAndSettle(in.panel, in.small);
    }
    state.counters["built"] = double(built);
}
BENCHMARK(BM_Inspector_SwitchLarge)->Arg(10000)->Iterations(2)->Unit(benchmark::kMillisecond);

// The stock alternative: one row per value, in a page built hidden and shown
// once inside a scroll area.
QWidget *BuildStockPage(int count)
{
    auto *page = new QWidget;
    page->hide();
    auto *column = new QVBoxLayout(page);
    for (int i = 0; i < count; ++i) {
        auto *row = new QHBoxLayout;
        auto *spin = new QDoubleSpinBox;
        spin->setDecimals(3);
        spin->setRange(0.0, 1.0);
        spin->setValue(0.5);
        auto *slider = new QSlider(Qt::Horizontal);
        slider->setRange(0, 1000);
        slider->setValue(500);
        row->addWidget(new QLabel(QString("Value%1").arg(i + 1)));
        row->addWidget(slider, 1);
        row->addWidget(spin);
        column->addLayout(row);
    }
    return page;
}

struct StockInspector
{
    StockInspector()
    {
        area.setWidgetResizable(true);
        area.setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        area.resize(PanelWidth, PanelHeight);
        area.show();
        QApplication::processEvents();
    }
    void Show(int count)
    {
        area.setWidget(BuildStockPage(count));
        area.widget()->show();
        QApplication::processEvents();
    }
    void Clear()
    {
        delete area.takeWidget();
        QApplication::processEvents();
    }
    QScrollArea area;
};

void BM_StockRows_Build(benchmark::State &state)
{
    StockInspector stock;
    for (auto _ : state) {
        stock.Show(int(state.range(0)));
        state.PauseTiming();
        stock.Clear();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_StockRows_Build)->Arg(500)->Arg(2000)->Unit(benchmark::kMillisecond);

void BM_StockRows_Teardown(benchmark::State &state)
{
    StockInspector stock;
    for (auto _ : state) {
        state.PauseTiming();
        stock.Show(int(state.range(0)));
        state.ResumeTiming();
        stock.Clear();
    }
}
BENCHMARK(BM_StockRows_Teardown)->Arg(500)->Arg(2000)->Unit(benchmark::kMillisecond);

} // namespace

// Building an inspector of colour controls (four channel Inputs each: the
// sliders, swatch, hex box and picker), against stock Qt rows of what a
// colour needs (a QLabel, four QSliders, a QLineEdit and a swatch QFrame),
// each page built hidden and shown once in a scroll area of the same size.
#include "BenchModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterPanel.h"
#include "orbane/Tags.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QFrame>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QScrollArea>
#include <QSlider>
#include <QVBoxLayout>

#include <string>

using namespace Orbane;

namespace {

constexpr int PanelWidth = 360, PanelHeight = 700;

// `count` colour controls, each on a red Input linking green, blue and alpha.
Operator *AddColourTool(OrbaneDoc &doc, int count)
{
    Operator *tool = new Operator("Colours", "Bench");
    doc.AddTool(tool);
    tool->DecRef();
    for (int i = 0; i < count; ++i) {
        const std::string id = "Colour" + std::to_string(i + 1);
        TagList attrs{{INPA_InputControl, OrbID("ColorControl")}};
        const char *const channels[3] = {"Green", "Blue", "Alpha"};
        for (int c = 0; c < 3; ++c) {
            const std::string cid = id + channels[c];
            Input *in =
                tool->AddInput(OrbID(cid.c_str()), cid.c_str(), CLSID_DataType_Number, TagList(), AutoNumber(0.5));
            attrs.Add(Tag(0x40050000 + c), static_cast<ScriptObject *>(in));
        }
        tool->AddInput(OrbID(id.c_str()), id.c_str(), CLSID_DataType_Number, attrs, AutoNumber(0.8));
    }
    return tool;
}

void BM_Inspector_BuildColours(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    OrbaneDoc doc;
    Operator *tool = AddColourTool(doc, int(state.range(0)));
    ParameterPanel panel(&doc);
    panel.resize(PanelWidth, PanelHeight);
    panel.show();
    QApplication::processEvents();
    for (auto _ : state) {
        // Every control built, not only those in view.
        panel.ShowTool(tool);
        panel.ControlsOf(tool->Inputs().back());
        QApplication::processEvents();
        state.PauseTiming();
        panel.ShowTool(nullptr);
        QApplication::processEvents();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_Inspector_BuildColours)->Arg(200)->Unit(benchmark::kMillisecond);

QWidget *BuildStockColourPage(int count)
{
    auto *page = new QWidget;
    page->hide();
    auto *column = new QVBoxLayout(page);
    for (int i = 0; i < count; ++i) {
        auto *top = new QHBoxLayout;
        auto *swatch = new QFrame;
        swatch->setFrameShape(QFrame::Box);
        swatch->setAutoFillBackground(true);
        swatch->setPalette(QPalette(QColor(204, 128, 128)));
        swatch->setFixedSize(48, 18);
        top->addWidget(new QLabel(QString("Colour%1").arg(i + 1)), 1);
        top->addWidget(swatch);
        top->addWidget(new QLineEdit("#CC8080FF"));
        column->addLayout(top);
        for (int c = 0; c < 4; ++c) {
            auto *slider = new QSlider(Qt::Horizontal);
            slider->setRange(0, 1000);
            slider->setValue(500);
            column->addWidget(slider);
        }
    }
    return page;
}

void BM_StockColourRows_Build(benchmark::State &state)
{
    QScrollArea area;
    area.setWidgetResizable(true);
    area.setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    area.resize(PanelWidth, PanelHeight);
    area.show();
    QApplication::processEvents();
    for (auto _ : state) {
        area.setWidget(BuildStockColourPage(int(state.range(0))));
        area.widget()->show();
        QApplication::processEvents();
        state.PauseTiming();
        delete area.takeWidget();
        QApplication::processEvents();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_StockColourRows_Build)->Arg(200)->Unit(benchmark::kMillisecond);

} // namespace

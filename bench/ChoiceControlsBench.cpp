// Building an inspector of the choosing and grouping controls: button rows,
// lists, check lists, offsets, screws and group headers, in turn. Against
// stock Qt rows that show the same (a row of tool buttons, a list widget, a
// column of check boxes, two spin boxes, a spin box over a dial, a label),
// built hidden and shown once in a scroll area of the same size.
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
#include <QCheckBox>
#include <QDial>
#include <QDoubleSpinBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QScrollArea>
#include <QToolButton>
#include <QVBoxLayout>

#include <string>

using namespace Orbane;

namespace {

constexpr int PanelWidth = 360, PanelHeight = 700;
constexpr Tag kAddString = 0x38040000;
const char *const kItems[] = {"Red", "Green", "Blue", "Alpha"};
// The classes in the order they repeat down the page.
const char *const kClasses[] = {"MultiButtonControl", "ListControl",  "CheckListControl",
                                "OffsetControl",      "ScrewControl", "LabelControl"};
constexpr int kKinds = 6;

TagList ItemAttrs(const char *classID)
{
    TagList attrs{{INPA_InputControl, OrbID(classID)}};
    for (const char *item : kItems)
        attrs.Append(TagList{{kAddString, item}});
    return attrs;
}

Operator *AddMixedTool(OrbaneDoc &doc, int count)
{
    Operator *tool = new Operator("Mixed", "Bench");
    doc.AddTool(tool);
    tool->DecRef();
    for (int i = 0; i < count; ++i) {
        const std::string id = "Value" + std::to_string(i + 1);
        const char *classID = kClasses[i % kKinds];
        const bool point = i % kKinds == 3;
        tool->AddInput(OrbID(id.c_str()), id.c_str(), point ? CLSID_DataType_Point : CLSID_DataType_Number,
                       ItemAttrs(classID), point ? AutoParameter(AutoPoint(0.5, 0.5)) : AutoParameter(AutoNumber(1.0)));
    }
    return tool;
}

void BM_Inspector_BuildChoices(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    OrbaneDoc doc;
    Operator *tool = AddMixedTool(doc, int(state.range(0)));
    ParameterPanel panel(&doc);
    panel.resize(PanelWidth, PanelHeight);
    panel.show();
    QApplication::processEvents();
    for (auto _ : state) {
        panel.ShowTool(tool);
        panel.ControlsOf(tool->Inputs().back());
        QApplication::processEvents();
        state.PauseTiming();
        panel.ShowTool(nullptr);
        QApplication::processEvents();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_Inspector_BuildChoices)->Arg(500)->Unit(benchmark::kMillisecond);

QLayout *StockRow(int kind, int i)
{
    auto *row = new QHBoxLayout;
    row->addWidget(new QLabel(QString("Value%1").arg(i + 1)));
    switch (kind) {
    case 0:
        for (const char *item : kItems) {
            auto *button = new QToolButton;
            button->setText(item);
            button->setCheckable(true);
            row->addWidget(button);
        }
        break;
    case 1: {
        auto *list = new QListWidget;
        for (const char *item : kItems)
            list->addItem(item);
        row->addWidget(list);
        break;
    }
    case 2: {
        auto *column = new QVBoxLayout;
        for (const char *item : kItems)
            column->addWidget(new QCheckBox(item));
        row->addLayout(column);
        break;
    }
    case 3:
        row->addWidget(new QDoubleSpinBox);
        row->addWidget(new QDoubleSpinBox);
        break;
    case 4: {
        auto *column = new QVBoxLayout;
        column->addWidget(new QDoubleSpinBox);
        column->addWidget(new QDial);
        row->addLayout(column);
        break;
    }
    default:
        break;
    }
    return row;
}

void BM_StockChoiceRows_Build(benchmark::State &state)
{
    QScrollArea area;
    area.setWidgetResizable(true);
    area.setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    area.resize(PanelWidth, PanelHeight);
    area.show();
    QApplication::processEvents();
    for (auto _ : state) {
        auto *page = new QWidget;
        page->hide();
        auto *column = new QVBoxLayout(page);
        for (int i = 0; i < int(state.range(0)); ++i)
            column->addLayout(StockRow(i % kKinds, i));
        area.setWidget(page);
        page->show();
        QApplication::processEvents();
        state.PauseTiming();
        delete area.takeWidget();
        QApplication::processEvents();
        state.ResumeTiming();
    }
}
BENCHMARK(BM_StockChoiceRows_Build)->Arg(500)->Unit(benchmark::kMillisecond);

} // namespace

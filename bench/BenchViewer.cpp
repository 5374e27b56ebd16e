#include "BenchViewer.h"

#include "orbane/Operator.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QColor>

using namespace Orbane;

BenchViewer::BenchViewer(const char *toolName, const char *toolType)
    : tool(new Operator(toolName, toolType)), viewer(&doc)
{
    doc.AddTool(tool);
    tool->DecRef();
}

void BenchViewer::Show()
{
    viewer.SetImage(Backdrop());
    viewer.resize(Width, Height);
    viewer.ShowTool(tool);
    viewer.show();
    QApplication::processEvents();
}

void BenchViewer::Repaints(benchmark::State &state)
{
    QImage target(Width, Height, QImage::Format_ARGB32_Premultiplied);
    for (auto _ : state) {
        viewer.render(&target);
        benchmark::DoNotOptimize(target.bits());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

QImage BenchViewer::Backdrop()
{
    QImage image(ImageWidth, ImageHeight, QImage::Format_ARGB32_Premultiplied);
    image.fill(QColor(40, 60, 90));
    return image;
}

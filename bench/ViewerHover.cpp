#include "ViewerHover.h"

#include "orbane/ViewerPanel.h"

#include <QApplication>
#include <QImage>
#include <QMouseEvent>

void ViewerHover::Show(Orbane::ViewerPanel &viewer, Orbane::Operator *tool, int imageWidth, int imageHeight, int width,
                       int height)
{
    QImage image(imageWidth, imageHeight, QImage::Format_ARGB32_Premultiplied);
    image.fill(QColor(40, 60, 90));
    viewer.SetImage(image);
    viewer.resize(width, height);
    viewer.ShowTool(tool);
    viewer.show();
    QApplication::processEvents();
}

std::vector<QPointF> ViewerHover::Path(int width, int height)
{
    std::vector<QPointF> path;
    for (int i = 0; i < 256; ++i)
        path.emplace_back(40 + (i * 37) % (width - 80), 30 + (i * 53) % (height - 60));
    return path;
}

void ViewerHover::Run(benchmark::State &state, Orbane::ViewerPanel &viewer, const std::vector<QPointF> &path)
{
    std::size_t i = 0;
    for (auto _ : state) {
        const QPointF at = path[i++ % path.size()];
        QMouseEvent event(QEvent::MouseMove, at, viewer.mapToGlobal(at.toPoint()), Qt::NoButton, Qt::NoButton,
                          Qt::NoModifier);
        QApplication::sendEvent(&viewer, &event);
        benchmark::DoNotOptimize(viewer.HoverControl());
        if (i % 64 == 0) {
            state.PauseTiming();
            QApplication::processEvents();
            state.ResumeTiming();
        }
    }
    state.SetItemsProcessed(state.iterations());
}

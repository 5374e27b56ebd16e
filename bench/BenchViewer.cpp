#include "BenchViewer.h"

#include "orbane/Operator.h"

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

QImage BenchViewer::Backdrop()
{
    QImage image(ImageWidth, ImageHeight, QImage::Format_ARGB32_Premultiplied);
    image.fill(QColor(40, 60, 90));
    return image;
}

#include "inputcontrols/LookTags.h"

#include "orbane/OrbColor.h"

#include <QApplication>
#include <QWidget>

namespace Orbane {

void LookTags::SetTextColor(QWidget *widget, uint32 packed)
{
    const OrbColor c(packed);
    QPalette palette = widget->parentWidget() ? widget->parentWidget()->palette() : QApplication::palette();
    if (!c.IsNone()) {
        const QColor colour(c.R(), c.G(), c.B(), c.A());
        palette.setColor(QPalette::WindowText, colour);
        palette.setColor(QPalette::ButtonText, colour);
        palette.setColor(QPalette::Text, colour);
    }
    widget->setPalette(palette);
}

void LookTags::SetBold(QWidget *widget, bool bold)
{
    QFont font = widget->font();
    if (font.bold() != bold) {
        font.setBold(bold);
        widget->setFont(font);
    }
}

Qt::Alignment LookTags::AlignmentOf(int32 align)
{
    switch (align) {
    case 2:
        return Qt::AlignHCenter;
    case 3:
    case 4:
        return Qt::AlignRight;
    default:
        return Qt::AlignLeft;
    }
}

} // namespace Orbane

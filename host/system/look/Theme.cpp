#include "orbane/Theme.h"

#include <QApplication>
#include <QStyle>
#include <QStyleFactory>

namespace Orbane {

namespace {

bool gApplied = false;

// Neutral greys, slightly cool, so that no panel colour tints the artist's
// judgement of the image.
const QColor kWindow(0x2b, 0x2d, 0x30);
const QColor kBase(0x1c, 0x1d, 0x20);
const QColor kAlternate(0x24, 0x26, 0x29);
const QColor kButton(0x3a, 0x3d, 0x42);
const QColor kText(0xd6, 0xd8, 0xdb);
const QColor kDimText(0x6e, 0x72, 0x78);
const QColor kAccent(0xe3, 0x93, 0x3c);

void SetDisabled(QPalette &pal)
{
    pal.setColor(QPalette::Disabled, QPalette::WindowText, kDimText);
    pal.setColor(QPalette::Disabled, QPalette::Text, kDimText);
    pal.setColor(QPalette::Disabled, QPalette::ButtonText, kDimText);
    pal.setColor(QPalette::Disabled, QPalette::Button, kButton.darker(115));
    pal.setColor(QPalette::Disabled, QPalette::Highlight, QColor(0x55, 0x58, 0x5d));
    pal.setColor(QPalette::Disabled, QPalette::HighlightedText, kDimText);
}

} // namespace

QPalette Theme::Palette()
{
    QPalette pal;
    pal.setColor(QPalette::Window, kWindow);
    pal.setColor(QPalette::WindowText, kText);
    pal.setColor(QPalette::Base, kBase);
    pal.setColor(QPalette::AlternateBase, kAlternate);
    pal.setColor(QPalette::ToolTipBase, kBase);
    pal.setColor(QPalette::ToolTipText, kText);
    pal.setColor(QPalette::PlaceholderText, kDimText);
    pal.setColor(QPalette::Text, kText);
    pal.setColor(QPalette::Button, kButton);
    pal.setColor(QPalette::ButtonText, kText);
    pal.setColor(QPalette::BrightText, Qt::white);
    pal.setColor(QPalette::Light, kButton.lighter(130));
    pal.setColor(QPalette::Midlight, kButton.lighter(115));
    pal.setColor(QPalette::Mid, kWindow.darker(120));
    pal.setColor(QPalette::Dark, QColor(0x17, 0x18, 0x1a));
    pal.setColor(QPalette::Shadow, QColor(0x0c, 0x0c, 0x0d));
    pal.setColor(QPalette::Highlight, kAccent);
    pal.setColor(QPalette::HighlightedText, kBase);
    pal.setColor(QPalette::Link, QColor(0x6c, 0xb0, 0xf0));
    pal.setColor(QPalette::LinkVisited, QColor(0xa0, 0x8c, 0xe8));
    SetDisabled(pal);
    return pal;
}

QFont Theme::ControlFont()
{
    QFont font = QApplication::font();
    font.setPointSizeF(9.0);
    return font;
}

QColor Theme::Accent()
{
    return kAccent;
}

void Theme::Apply(QApplication &app)
{
    // Fusion draws every stock widget from the palette, so the dark colours
    // reach menus, scroll bars and edits alike.
    if (QStyle *fusion = QStyleFactory::create(QStringLiteral("Fusion")))
        app.setStyle(fusion);
    app.setPalette(Palette());
    app.setFont(ControlFont());
    gApplied = true;
}

bool Theme::IsApplied()
{
    return gApplied;
}

} // namespace Orbane

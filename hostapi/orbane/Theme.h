#pragma once

#include <QColor>
#include <QFont>
#include <QPalette>

class QApplication;

namespace Orbane {

// The application's look: a dark, low-contrast palette that keeps the eye
// on the image, one warm accent for what is on or selected, and a compact
// font for dense inspectors. Apply it once, before the first window shows.
class Theme
{
public:
    static void Apply(QApplication &app);
    static bool IsApplied();

    static QPalette Palette();
    // The font of inspector controls: the application font at a compact size.
    static QFont ControlFont();
    static QColor Accent();
};

} // namespace Orbane

#include "OverlayAccessible.h"

#include "../core/InputStateMark.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/PreviewControl.h"
#include "orbane/ViewerPanel.h"

#include <algorithm>

namespace Orbane {

OverlayAccessible::OverlayAccessible(ViewerPanel *viewer, const PreviewControl *overlay)
    : mViewer(viewer), mOverlay(overlay)
{
}

bool OverlayAccessible::isValid() const
{
    if (!mViewer)
        return false;
    const auto &overlays = mViewer->Overlays();
    return std::find(overlays.begin(), overlays.end(), mOverlay) != overlays.end();
}

QWindow *OverlayAccessible::window() const
{
    return mViewer ? mViewer->window()->windowHandle() : nullptr;
}

QAccessibleInterface *OverlayAccessible::parent() const
{
    return mViewer ? QAccessible::queryAccessibleInterface(mViewer.data()) : nullptr;
}

QString OverlayAccessible::text(QAccessible::Text t) const
{
    const Input *input = isValid() && !mOverlay->Inputs().empty() ? mOverlay->Inputs().front() : nullptr;
    if (!input)
        return QString();
    if (t == QAccessible::Name)
        return QString::fromUtf8(input->GetName());
    if (t == QAccessible::Value || t == QAccessible::Description) {
        const AutoParameter value(input->GetValue(input->CurrentTime()));
        return InputStateMark::ValueText(value);
    }
    return QString();
}

// The overlay may be drawn anywhere over the image: the viewer's area.
QRect OverlayAccessible::rect() const
{
    if (!mViewer)
        return QRect();
    return QRect(mViewer->mapToGlobal(QPoint(0, 0)), mViewer->size());
}

QAccessible::State OverlayAccessible::state() const
{
    QAccessible::State s;
    s.invisible = !isValid() || !mViewer->isVisible();
    return s;
}

} // namespace Orbane

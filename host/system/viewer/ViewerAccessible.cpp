#include "ViewerAccessible.h"

#include "OverlayAccessible.h"

#include "orbane/ViewerPanel.h"

#include <algorithm>

namespace Orbane {

ViewerAccessible::ViewerAccessible(ViewerPanel *viewer) : QAccessibleWidget(viewer, QAccessible::Canvas) {}

QAccessibleInterface *ViewerAccessible::Factory(const QString &className, QObject *object)
{
    auto *viewer = qobject_cast<ViewerPanel *>(object);
    return viewer && className == QLatin1String("Orbane::ViewerPanel") ? new ViewerAccessible(viewer) : nullptr;
}

ViewerPanel *ViewerAccessible::Viewer() const
{
    return static_cast<ViewerPanel *>(widget());
}

int ViewerAccessible::childCount() const
{
    return QAccessibleWidget::childCount() + int(Viewer()->Overlays().size());
}

QAccessibleInterface *ViewerAccessible::child(int index) const
{
    const int widgets = QAccessibleWidget::childCount();
    if (index < widgets)
        return QAccessibleWidget::child(index);
    const auto &overlays = Viewer()->Overlays();
    const std::size_t at = std::size_t(index - widgets);
    return at < overlays.size() ? OverlayInterface(overlays[at]) : nullptr;
}

int ViewerAccessible::indexOfChild(const QAccessibleInterface *child) const
{
    const auto *overlay = dynamic_cast<const OverlayAccessible *>(child);
    if (!overlay)
        return QAccessibleWidget::indexOfChild(child);
    const auto &overlays = Viewer()->Overlays();
    const auto it = std::find(overlays.begin(), overlays.end(), overlay->Overlay());
    return it == overlays.end() ? -1 : QAccessibleWidget::childCount() + int(it - overlays.begin());
}

// An overlay's interface lives as long as the overlay is shown; one that the
// viewer let go of is dropped from the cache the next time it is asked for.
QAccessibleInterface *ViewerAccessible::OverlayInterface(const PreviewControl *overlay) const
{
    for (auto it = mIds.begin(); it != mIds.end();) {
        QAccessibleInterface *known = QAccessible::accessibleInterface(it->second);
        if (known && known->isValid()) {
            ++it;
            continue;
        }
        QAccessible::deleteAccessibleInterface(it->second);
        it = mIds.erase(it);
    }
    const auto found = mIds.find(overlay);
    if (found != mIds.end())
        return QAccessible::accessibleInterface(found->second);
    auto *made = new OverlayAccessible(Viewer(), overlay);
    mIds[overlay] = QAccessible::registerAccessibleInterface(made);
    return made;
}

} // namespace Orbane

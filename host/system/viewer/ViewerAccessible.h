#pragma once

#include <QAccessibleWidget>

#include <map>

namespace Orbane {

class PreviewControl;
class ViewerPanel;

// The viewer as accessibility tools see it: its child widgets, then one
// child per overlay (OverlayAccessible), in the order the viewer holds them.
class ViewerAccessible : public QAccessibleWidget
{
public:
    explicit ViewerAccessible(ViewerPanel *viewer);

    int childCount() const override;
    QAccessibleInterface *child(int index) const override;
    int indexOfChild(const QAccessibleInterface *child) const override;

    // The factory QAccessible asks for the viewer's interface.
    static QAccessibleInterface *Factory(const QString &className, QObject *object);

private:
    ViewerPanel *Viewer() const;
    QAccessibleInterface *OverlayInterface(const PreviewControl *overlay) const;

    // Overlay interfaces are made once and kept by QAccessible's cache.
    mutable std::map<const PreviewControl *, QAccessible::Id> mIds;
};

} // namespace Orbane

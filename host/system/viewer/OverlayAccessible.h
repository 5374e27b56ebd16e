#pragma once

#include <QAccessibleInterface>
#include <QPointer>

namespace Orbane {

class PreviewControl;
class ViewerPanel;

// What screen readers and UI test tools see of an overlay, which is painted
// and has no widget of its own: its Input's name and its value now, placed
// over the viewer. It stays valid while the viewer shows the overlay.
class OverlayAccessible : public QAccessibleInterface
{
public:
    OverlayAccessible(ViewerPanel *viewer, const PreviewControl *overlay);

    bool isValid() const override;
    QObject *object() const override { return nullptr; }
    QWindow *window() const override;
    QAccessibleInterface *parent() const override;
    QAccessibleInterface *child(int) const override { return nullptr; }
    QAccessibleInterface *childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface *) const override { return -1; }
    QString text(QAccessible::Text t) const override;
    void setText(QAccessible::Text, const QString &) override {}
    QRect rect() const override;
    QAccessible::Role role() const override { return QAccessible::Graphic; }
    QAccessible::State state() const override;

    const PreviewControl *Overlay() const { return mOverlay; }

private:
    QPointer<ViewerPanel> mViewer;
    const PreviewControl *mOverlay;
};

} // namespace Orbane

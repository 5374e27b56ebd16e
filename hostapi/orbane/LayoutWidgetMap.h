#pragma once

#include "orbane/OrbID.h"
#include "orbane/Types.h"

#include <QPointer>
#include <QWidget>

#include <utility>
#include <vector>

namespace Orbane {
namespace Layout {

// The children a control offers to its layout, by the fixed names its
// layout description uses ("label", "checkbox", "button", ...), in the
// order they were registered. Widgets are watched, not owned.
class WidgetMap
{
public:
    using Entry = std::pair<OrbID, QPointer<QWidget>>;

    // Registers or replaces the widget under `name`; a null widget removes it.
    void Register(const OrbID &name, QWidget *widget);
    QWidget *Find(const OrbID &name) const;
    void Clear() { mEntries.clear(); }

    int32 Count() const { return int32(mEntries.size()); }
    const std::vector<Entry> &Entries() const { return mEntries; }

private:
    std::vector<Entry> mEntries;
};

} // namespace Layout
} // namespace Orbane

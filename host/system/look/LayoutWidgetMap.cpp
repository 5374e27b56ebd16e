#include "orbane/LayoutWidgetMap.h"

#include <algorithm>

namespace Orbane {
namespace Layout {

void WidgetMap::Register(const OrbID &name, QWidget *widget)
{
    auto it = std::find_if(mEntries.begin(), mEntries.end(), [&](const Entry &e) { return e.first == name; });
    if (it == mEntries.end()) {
        if (widget)
            mEntries.emplace_back(name, widget);
        return;
    }
    if (widget)
        it->second = widget;
    else
        mEntries.erase(it);
}

QWidget *WidgetMap::Find(const OrbID &name) const
{
    for (const Entry &e : mEntries)
        if (e.first == name)
            return e.second.data();
    return nullptr;
}

} // namespace Layout
} // namespace Orbane

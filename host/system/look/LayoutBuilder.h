#pragma once

#include "orbane/LayoutContainer.h"
#include "orbane/LayoutWidgetMap.h"

#include <unordered_set>

namespace Orbane {
namespace Layout {

// Turns a layout description (format in LayoutContainer.h) into a tree of
// layout objects for one control's registered children.
class LayoutBuilder
{
public:
    explicit LayoutBuilder(const WidgetMap &widgets) : mWidgets(widgets) {}

    std::unique_ptr<Container> Build(const ScriptVal &description);

    // The layout used when neither the control nor the look pack has one:
    // every child in a row, an expression container under it.
    static ScriptVal BuiltInDefault();

private:
    static const ScriptVal &DefaultDescription();
    void CollectNames(const ScriptVal &node);
    std::unique_ptr<LayoutObj> MakeNode(const ScriptVal &node);
    std::unique_ptr<LayoutObj> MakeItem(const OrbID &name);
    std::unique_ptr<Container> MakeContainer(const ScriptVal &node, Container::Kind kind);
    void AddChildren(Container &box, const ScriptVal &node);
    void AddRest(Container &box);
    void AddChild(Container &box, std::unique_ptr<LayoutObj> obj, const ScriptVal &node);
    static void ApplySizes(LayoutObj &obj, const ScriptVal &node);
    static void ApplyBox(Container &box, const ScriptVal &node);

    const WidgetMap &mWidgets;
    std::unordered_set<OrbID> mNamed;  // every name a node mentions
    std::unordered_set<OrbID> mPlaced; // children already given a place
};

} // namespace Layout
} // namespace Orbane

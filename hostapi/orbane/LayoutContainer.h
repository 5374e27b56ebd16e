#pragma once

#include "orbane/LayoutObj.h"
#include "orbane/ScriptVal.h"

#include <QLayout>

#include <memory>
#include <vector>

namespace Orbane {
namespace Layout {

class WidgetMap;

// A row, column or grid of layout objects, itself a layout object so that
// containers nest. A control builds its whole layout with Create from the
// description in the look pack and the children it registered by name;
// SetSize then calls Arrange with the width the inspector offers.
//
// Description format (a Lua table; sizes in logical pixels):
//
//   node      = "name"                          -- shorthand for { name = "name" }
//             | { name = "label", <sizes> }     -- the registered child "label"
//             | { kind = "hbox" | "vbox", name = "...", <sizes>, <box>, node, node, ... }
//             | { kind = "grid", name = "...", <sizes>, <grid>, node, node, ... }
//             | { kind = "space", <sizes> }     -- a gap of the given size
//             | { kind = "stretch", stretch = n } -- a gap that takes spare room
//             | { kind = "rest" }               -- every registered child that no
//                                               -- other node names, in registration order
//   <sizes>   = width, height (fixed), minwidth, minheight, maxwidth, maxheight,
//               stretch (share of spare room in the parent box, default 0),
//               align ("left", "right", "hcenter", "top", "bottom", "vcenter",
//               "center", joined with "|")
//   <box>     = spacing (default 4), margins (a number or { left, top, right, bottom }, default 0)
//   <grid>    = hspacing, vspacing (default 4), margins, colstretch = { n, n, ... },
//               rowstretch = { n, ... }; each child gives row, col (from 1) and
//               optionally rowspan, colspan
//
// A table with children and no kind is a "vbox". A child name that nothing
// registered is left out (Find returns null for it). A container may be
// empty and filled later by the control (the "expression" container);
// empty objects take no room and no spacing. A nil or malformed
// description gives the look pack's "Controls.Default.Layout".
class Container : public LayoutObj
{
public:
    enum Kind : int32
    {
        HBox,
        VBox,
        Grid
    };

    Container(const OrbID &name, Kind kind);
    ~Container() override;

    // Builds the layout of `description` for the registered children.
    // Never null.
    static std::unique_ptr<Container> Create(const ScriptVal &description, const WidgetMap &widgets);

    Container *AsContainer() override { return this; }
    Kind GetKind() const { return mKind; }

    // Depth-first search of this container's objects (itself included).
    LayoutObj *Find(const OrbID &name);
    const LayoutObj *Find(const OrbID &name) const;

    // Appends to a row or column; takes ownership. Returns the object.
    LayoutObj *Add(std::unique_ptr<LayoutObj> obj, int32 stretch = 0);
    // Appends a place for a widget (the control's expression field, say).
    LayoutObj *AddWidget(const OrbID &name, QWidget *widget, int32 stretch = 0);
    // Places in a grid cell, counted from 0; takes ownership.
    LayoutObj *AddAt(std::unique_ptr<LayoutObj> obj, int32 row, int32 col, int32 rowSpan = 1, int32 colSpan = 1);

    int32 Count() const { return int32(mObjs.size()); }
    LayoutObj *At(int32 index) const;

    void SetSpacing(int32 horizontal, int32 vertical);
    void SetMargins(const QMargins &margins);
    void SetColumnStretch(int32 col, int32 stretch);
    void SetRowStretch(int32 row, int32 stretch);

    // The height the layout needs at this width.
    int32 HeightForWidth(int32 width) const;
    // Places everything in (0, 0, width, the height it needs); returns that height.
    int32 Arrange(int32 width);
    // Places everything in the given rectangle of the owner widget.
    void Place(const QRect &rect);

    void invalidate() override;

protected:
    QLayoutItem *Content() const override;
    bool ContentIsEmpty() const override;

private:
    Kind mKind;
    std::unique_ptr<QLayout> mLayout; // owns the objects
    std::vector<LayoutObj *> mObjs;   // in order of adding
};

} // namespace Layout
} // namespace Orbane

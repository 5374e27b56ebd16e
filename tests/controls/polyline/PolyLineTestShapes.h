#pragma once

#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PolyLine.h"
#include "orbane/ScriptVal.h"

#include <vector>

namespace Orbane {
namespace Test {

using Points = std::vector<OrbPoint>;

// Corners at `points`.
inline AutoRef<PolyLine> MakeShape(const Points &points, bool closed = false)
{
    AutoRef<PolyLine> shape(new PolyLine);
    for (const OrbPoint &p : points)
        shape->AddPoint(PolyPoint(p.x, p.y));
    if (closed)
        shape->Close();
    return shape;
}

// A shape Input shown with the polyline overlay, with more attributes.
inline Input *AddShapeValue(ViewerFixture &f, const PolyLine *shape, const TagList &more = TagList(),
                            const char *id = "Shape")
{
    TagList attrs{{INPA_PreviewControl, OrbID("PolylineControl")}};
    attrs.Append(more);
    return f.tool->AddInput(OrbID(id), id, CLSID_DataType_Polyline, attrs, shape);
}

inline Input *AddShape(ViewerFixture &f, const Points &points, const TagList &more = TagList(),
                       const char *id = "Shape")
{
    return AddShapeValue(f, MakeShape(points).get(), more, id);
}

inline ScriptVal StateOf(const PreviewControl *overlay)
{
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    return state;
}

// A list of numbers of the overlay's state (`selected`, `lockedPoints`).
inline std::vector<int> ListOf(const PreviewControl *overlay, const char *key)
{
    const ScriptVal state = StateOf(overlay);
    const ScriptVal *list = state.FindKeyConst(ScriptVal(key));
    std::vector<int> out;
    for (int i = 1; list && i <= list->Length(); ++i)
        out.push_back(int(list->FindKeyConst(ScriptVal(i))->GetNumber()));
    return out;
}

inline AutoParam<PolyLine> ShapeOf(const ViewerFixture &f, Input *input)
{
    return AutoParam<PolyLine>(input, f.doc.GetCurrentTime());
}

} // namespace Test
} // namespace Orbane

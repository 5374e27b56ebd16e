#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/ScriptVal.h"

#include <vector>

namespace Orbane {

// A warp mesh: `cols` x `rows` vertices in image coordinates (0..1, Y up),
// row by row from the bottom, each row from the left. Its Input holds it as
// a script table { cols = 3, rows = 2, points = { x1, y1, x2, y2, ... } }:
// a flat list, so that a 100 x 100 mesh is one table of numbers rather than
// ten thousand small ones. Anything else (a wrong count, a value that is no
// number) is no mesh: zero vertices.
struct MeshGrid
{
    int32 cols = 0;
    int32 rows = 0;
    std::vector<OrbPoint> points;

    int32 Count() const noexcept { return int32(points.size()); }
    bool Empty() const noexcept { return points.empty(); }
    int32 Index(int32 col, int32 row) const noexcept { return row * cols + col; }
    int32 ColOf(int32 i) const noexcept { return i % cols; }
    int32 RowOf(int32 i) const noexcept { return i / cols; }
    bool IsBorder(int32 i) const noexcept;
    bool IsCorner(int32 i) const noexcept;
    // The vertex in the same row on the other side of the middle column.
    int32 MirrorOf(int32 i) const noexcept { return Index(cols - 1 - ColOf(i), RowOf(i)); }

    // An even grid over the whole image; sizes below 2 are taken as 2.
    static MeshGrid Regular(int32 cols, int32 rows);
    static MeshGrid FromScript(const ScriptVal &v);
    ScriptVal ToScript() const;
};

// How a move of selected vertices is bounded, as the mesh's tags say.
struct MeshMoveRules
{
    bool lockBorder = false;
    bool lockCorners = false;
    bool slideBorder = false; // outline vertices keep to their side
    bool clampToImage = false;
    bool mirrorX = false;
    float64 snapX = 0.0, snapY = 0.0;       // a grid step in image units; 0: none
    float64 falloffX = 0.0, falloffY = 0.0; // soft-selection radius per axis, image units; 0: none
};

// Pure functions of a mesh edit, apart from any drawing.
class MeshEdit
{
public:
    // `from` with every vertex in `selected` moved by `delta` as `rules`
    // allow; unselected vertices within the falloff follow by a smooth
    // weight of their distance to the nearest selected vertex.
    static MeshGrid Moved(const MeshGrid &from, const std::vector<uint8> &selected, OrbPoint delta,
                          const MeshMoveRules &rules);
    // The vertices inside the box from `a` to `b` (either corner first).
    static std::vector<int32> InBox(const MeshGrid &mesh, OrbPoint a, OrbPoint b);
    // 1 at distance 0, 0 at `radius` and beyond, smooth in between.
    static float64 FalloffWeight(float64 distance) noexcept;
};

} // namespace Orbane

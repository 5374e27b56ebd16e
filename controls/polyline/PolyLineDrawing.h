#pragma once

#include "framework/HandleHit.h"

#include "orbane/AutoRef.h"
#include "orbane/GColor.h"
#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

class PolyLine;
class SelMask;

namespace Graphics {
class GPainter;
} // namespace Graphics

// Bits of the polyline overlay's display flags: what it draws.
enum PolyLineDisplay : uint16
{
    PLD_KeyPoints = 0x0001,
    PLD_Handles = 0x0002,
    PLD_Curve = 0x0004,
    PLD_SelectedWhenHidden = 0x0008, // selected points even with points and handles hidden
    PLD_Dash = 0x0010,
    PLD_Style2 = 0x0020, // draw style 2: dotted, with no menu entry
    PLD_Null = 0x0040,   // no curve at all
    PLD_TaggedIDs = 0x0080,
    PLD_NoSingleHighlight = 0x0200, // the single selected point is not drawn on top
    PLD_Styles = PLD_Dash | PLD_Style2 | PLD_Null,
    PLD_Default = 0x0087,
};

// How one shape is drawn: the overlay works it out once per draw.
struct PolyLineStyle
{
    uint16 flags = PLD_Default;
    Graphics::GColor curve;    // the curve's colour
    Graphics::GColor keyPoint; // key points
    Graphics::GColor handle;   // handle lines and ends
    Graphics::GColor active;   // the single selected point
    Graphics::GColor hover;    // the point or handle end under the pointer
    Graphics::GColor shadow;   // of all of them
    uint16 stipple = 0;        // of the curve and handle lines; 0 solid
    OrbPoint half;             // half a marker's side, image units per axis
    OrbPoint span{1.0, 1.0};   // viewer pixels per image unit, per axis
    HandleHit hot;             // the part under the pointer or dragged
    bool pending = false;      // a point is being placed or dragged alone
};

// Draws shapes in image coordinates (the painter's matrix maps them to the
// viewer): the curve as line strips, then the markers. The flattened curve
// of the last shape drawn is kept, with the shape it came from, so a shape
// that did not change is not flattened again on the next frame.
class PolyLineDrawing
{
public:
    // The curve's line stipple per draw style flag; 0 for solid.
    static uint16 StippleFor(uint16 flags) noexcept;
    // The side of a key point's square in viewer pixels: four fifths of four
    // times the viewer's control size, which is at least 2.
    static float64 MarkerSide(float64 controlSize) noexcept;

    // Steps that flatten the cubic with control points `hull` (viewer
    // pixels) to within a quarter pixel (Wang's bound), at least 1.
    static int32 StepsFor(const OrbPoint hull[4]) noexcept;
    // The curve of `shape` as x, y, z triples, with the first vertex of each
    // strip in `starts` (a gap segment starts a new strip); `span` scales
    // image units to viewer pixels to choose the density.
    static void Flatten(const PolyLine &shape, OrbPoint span, std::vector<float64> &xyz, std::vector<int32> &starts);

    // Everything of one shape in `style`.
    void Draw(Graphics::GPainter &p, const PolyLine &shape, const SelMask &selection, const PolyLineStyle &style);
    // The curve alone (an onion skin), flattened afresh.
    static void DrawCurve(Graphics::GPainter &p, const PolyLine &shape, OrbPoint span);
    // A line strip through `points` (image coordinates): a stroke being drawn.
    static void DrawStrip(Graphics::GPainter &p, const std::vector<OrbPoint> &points);

    int32 CurveVertexCount() const { return int32(mCurve.size() / 3); }

private:
    void UpdateCurve(const PolyLine &shape, OrbPoint span);
    static void DrawStrips(Graphics::GPainter &p, const std::vector<float64> &xyz, const std::vector<int32> &starts);
    static void DrawMarkers(Graphics::GPainter &p, const PolyLine &shape, const SelMask &selection,
                            const PolyLineStyle &style, bool selectedOnly);
    static void DrawHandles(Graphics::GPainter &p, const PolyLine &shape, const SelMask &selection,
                            const PolyLineStyle &style);
    static void DrawTaggedIDs(Graphics::GPainter &p, const PolyLine &shape, const PolyLineStyle &style);

    AutoRef<PolyLine> mCurveOf; // held, so its address is not reused
    OrbPoint mCurveSpan;
    std::vector<float64> mCurve;
    std::vector<int32> mStarts;
};

} // namespace Orbane

#pragma once

#include "orbane/GColor.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// The shapes of the crosshair styles in handle pixels (Y up, the centre at
// 0, 0), built once per style into the arrays a GPainter draws from, and
// the colour pairs of their parts, made again only when what they are made
// from changes.
class CrosshairGeometry
{
public:
    // The fill colours of the parts: the highlight of a poised or picked
    // part is the overlay's to choose.
    struct PartFills
    {
        Graphics::GColor centre, xArm, yArm;
        bool operator==(const PartFills &o) const noexcept
        {
            return centre == o.centre && xArm == o.xArm && yArm == o.yArm;
        }
    };

    // Styles 0 to 4 have shapes; others draw nothing.
    void Build(int32 style);
    // `fill` and `shadow` are the overlay's own; the drag feedback is drawn
    // in them at half strength.
    void SetColors(const PartFills &fills, const Graphics::GColor &fill, const Graphics::GColor &shadow);
    // How often the colour pairs were made: once per change of their inputs.
    int32 ColorUploads() const { return mUploads; }

    // Hands the arrays to the painter, and takes them back: the painter
    // keeps pointers, which must not outlive one drawing.
    void Bind(Graphics::GPainter &p) const;
    static void Unbind(Graphics::GPainter &p);
    // The built style at the painter's origin.
    void Draw(Graphics::GPainter &p) const;
    // Where a drag of style 0 began: a ghost of the centre, and for a drag
    // along one axis a guide along it.
    void DrawFeedback(Graphics::GPainter &p, bool alongX, bool alongY) const;

private:
    int32 mStyle = -1;
    std::vector<float64> mVertices; // x, y, z each
    std::vector<uint32> mIndices;
    std::vector<Graphics::GColor> mColors; // (fill, shadow) per part
    Graphics::GColor mFill, mShadow;
    PartFills mFills;
    int32 mUploads = 0;
};

} // namespace Orbane

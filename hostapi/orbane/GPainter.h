#pragma once

#include "orbane/GColor.h"
#include "orbane/Types.h"

class QImage;

namespace Orbane {
namespace Graphics {

// Primitive modes of Begin and DrawArrays, numbered as in OpenGL.
enum GPrimitive : int32
{
    GP_Points = 0,
    GP_Lines = 1,
    GP_LineLoop = 2,
    GP_LineStrip = 3,
    GP_Triangles = 4,
    GP_TriangleStrip = 5,
    GP_TriangleFan = 6,
    GP_Quads = 7,
    GP_QuadStrip = 8,
    GP_Polygon = 9,
};

// Capabilities of Enable and Disable.
enum GCapability : int32
{
    GC_Blend = 0,       // colours mix with what is below by BlendFunc; off: drawn opaque
    GC_LineStipple = 1, // lines follow the LineStipple pattern
    GC_LineSmooth = 2,  // antialiased edges
    GC_DepthTest = 3,   // kept for 3D gizmos; a 2D painter has no depth buffer
};

enum GMatrixMode : int32
{
    GM_ModelView = 0,
    GM_Projection = 1,
    GM_Texture = 2,
};

// Blend factors of BlendFunc. (SrcAlpha, OneMinusSrcAlpha) is ordinary
// transparency, (One, OneMinusSrcColor) a screen, (DstColor, Zero) a multiply.
enum GBlendFactor : int32
{
    GBF_Zero = 0,
    GBF_One = 1,
    GBF_OneMinusSrcAlpha = 2,
    GBF_SrcAlpha = 3,
    GBF_DstAlpha = 4,
    GBF_OneMinusDstAlpha = 5,
    GBF_DstColor = 6,
    GBF_OneMinusSrcColor = 7,
    GBF_SrcColor = 8,
    GBF_OneMinusDstColor = 9,
};

enum GShadeModel : int32
{
    GSM_Flat = 0,
    GSM_Smooth = 1,
};

// The immediate-mode drawing interface of the viewer's overlay passes.
//
// Coordinates are viewer units (PreviewInfo::TransformOut's output: logical
// pixels, Y up) after the current matrices: a vertex is multiplied by the
// projection and model-view matrices and projected orthographically (z is
// dropped). Line widths, point sizes and stipple lengths are in viewer
// pixels and ignore the matrices, so handles scaled by HandleScale keep thin
// outlines.
//
// Colour(fill, shadow): every primitive, rectangle and text is drawn twice
// when the shadow is visible: first in the shadow colour one pixel down and
// to the right, then in the fill colour, so handles read on any image.
class GPainter
{
public:
    GPainter() = default;
    GPainter(const GPainter &) = delete;
    GPainter &operator=(const GPainter &) = delete;
    virtual ~GPainter();

    // Matrix stack; operations apply to the stack MatrixMode selected, and
    // Translate, Scale, Rotate and MultMatrix multiply on the right (they act
    // on the vertices first). Popping an empty stack is ignored.
    virtual void MatrixMode(int32 mode) = 0;
    virtual void PushMatrix() = 0;
    virtual void PopMatrix() = 0;
    virtual void LoadIdentity() = 0;
    virtual void Translate(float64 x, float64 y, float64 z) = 0;
    virtual void Scale(float64 x, float64 y, float64 z) = 0;
    // `angle` in degrees, counter-clockwise about the axis (x, y, z).
    virtual void Rotate(float64 angle, float64 x, float64 y, float64 z) = 0;
    // Sixteen values in column-major order, as OpenGL takes them.
    virtual void MultMatrix(const float64 *m) = 0;

    void Translate(float64 x, float64 y) { Translate(x, y, 0.0); }
    void Scale(float64 x, float64 y) { Scale(x, y, 1.0); }

    // Immediate primitives: Begin(mode), Vertex..., End draws. Vertices of an
    // incomplete last primitive (one of a pair of lines, ...) are dropped; an
    // unknown mode draws nothing.
    virtual void Begin(int32 mode) = 0;
    virtual void Vertex(float64 x, float64 y, float64 z) = 0;
    virtual void End() = 0;
    void Vertex(float64 x, float64 y) { Vertex(x, y, 0.0); }

    // A filled rectangle in the current coordinates.
    virtual void Rectangle(float64 x1, float64 y1, float64 x2, float64 y2) = 0;
    // UTF-8 text with its baseline starting at the transformed point; the
    // glyphs stay upright and unscaled.
    virtual void Text(float64 x, float64 y, const char *text) = 0;
    // `image` mapped onto the quad `corners` (four x, y pairs in the current
    // coordinates: the image's bottom-left, bottom-right, top-right and
    // top-left), its colours multiplied by `color` (grey and alpha), blended
    // by BlendFunc while GC_Blend is on and opaque while it is off. No shadow
    // pass. Painters that cannot draw images draw nothing.
    virtual void Texture(const QImage &image, const float64 *corners, const GColor &color);

    // Arrays for geometry built once and drawn every frame. The painter keeps
    // the pointers, not copies: the arrays must stay alive and unchanged
    // while DrawArrays reads them. Passing null (or a count of 0) unsets one.
    //   vertices: `count` vertices of three values each (x, y, z);
    //   indices:  when set, DrawArrays takes vertex numbers from it;
    //   uniforms: colour pairs (fill, shadow), `count` colours in all;
    //             Uniform(n) makes pair n the current colour.
    virtual void SetVertexArray(const float64 *xyz, int32 count) = 0;
    virtual void SetIndexArray(const uint32 *indices, int32 count) = 0;
    virtual void SetUniformArray(const GColor *colors, int32 count) = 0;
    virtual void Uniform(int32 pair) = 0;
    // Draws `count` vertices starting at `first`, through the index array
    // when one is set. Ranges outside the arrays draw nothing.
    virtual void DrawArrays(int32 mode, int32 first, int32 count) = 0;

    // State.
    virtual void Color(const GColor &fill, const GColor &shadow) = 0;
    void Color(const GColor &fill) { Color(fill, GColor()); }
    virtual void LineWidth(float32 width) = 0;
    virtual void PointSize(float32 size) = 0;
    // Each bit of `pattern`, lowest first, is `factor` pixels on (1) or off
    // (0) along a line; the pattern restarts at each Begin and at each
    // segment of GP_Lines. Takes effect while GC_LineStipple is enabled.
    virtual void LineStipple(int32 factor, uint16 pattern) = 0;
    virtual void Enable(int32 capability) = 0;
    virtual void Disable(int32 capability) = 0;
    virtual bool IsEnabled(int32 capability) const = 0;
    // Saves and restores every state above (not the matrices).
    virtual void PushAttrib() = 0;
    virtual void PopAttrib() = 0;
    virtual void BlendFunc(int32 source, int32 destination) = 0;
    virtual void DepthMask(bool write) = 0;
    virtual void ShadeModel(int32 model) = 0;
};

} // namespace Graphics
} // namespace Orbane

#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of MeshControl, the warp mesh's wireframe and vertices. Each
// is described in docs/overlays.md; defaults in brackets.
// The grid a mesh Input without a value starts as, and what "Reset Mesh" makes.
constexpr Tag MSC_Columns = 0x10058000; // vertices across [5]
constexpr Tag MSC_Rows = 0x10058001;    // vertices up [5]
// What is drawn.
constexpr Tag MSC_ShowVertices = 0x10058002;  // the vertex handles [on]
constexpr Tag MSC_ShowRows = 0x10058003;      // the lines along each row [on]
constexpr Tag MSC_ShowColumns = 0x10058004;   // the lines along each column [on]
constexpr Tag MSC_ShowBorder = 0x10058005;    // the outline in its own colour and width [on]
constexpr Tag MSC_ShowDiagonals = 0x10058006; // each cell's diagonal, as the warp splits it [off]
constexpr Tag MSC_LineEvery = 0x10058007;     // only every n-th inner row and column line [1]
constexpr Tag MSC_VertexShape = 0x10058008;   // Square, Disc, Diamond [Square]
constexpr Tag MSC_LineStyle = 0x10058009;     // Solid, Dash, Dot [Solid]
// What may move, and where it lands.
constexpr Tag MSC_LockBorder = 0x1005800a;        // vertices of the outline stay [off]
constexpr Tag MSC_LockCorners = 0x1005800b;       // the four corners stay [off]
constexpr Tag MSC_SlideBorder = 0x1005800c;       // outline vertices move only along their side [off]
constexpr Tag MSC_SnapToPixels = 0x1005800d;      // moved vertices land on whole image pixels [off]
constexpr Tag MSC_SnapToGrid = 0x1005800e;        // moved vertices land on a grid of MSCD_SnapSpacing [off]
constexpr Tag MSC_ClampToImage = 0x1005800f;      // moved vertices stay within the image [off]
constexpr Tag MSC_BoxSelect = 0x10058010;         // a press between vertices draws a selection box [on]
constexpr Tag MSC_ReadOnly = 0x10058011;          // drawn only: takes no press and no key [off]
constexpr Tag MSC_ShowLabels = 0x10058012;        // the number of each selected vertex beside it [off]
constexpr Tag MSC_HideWhileDragging = 0x10058013; // the wireframe hides while vertices are dragged [off]
constexpr Tag MSC_ShowRest = 0x10058014;          // the rest mesh (MSCP_Rest) drawn under it [on]
// Colours (no colour: the viewer's overlay colour or the highlight).
constexpr Tag MSC_HandleColor = 0x10058015;   // vertices
constexpr Tag MSC_LineColor = 0x10058016;     // row and column lines
constexpr Tag MSC_SelectedColor = 0x10058017; // selected vertices [the highlight]
constexpr Tag MSC_BorderColor = 0x10058018;   // the outline [the line colour]
constexpr Tag MSC_RestColor = 0x10058019;     // the rest mesh [grey]
constexpr Tag MSC_BoxColor = 0x1005801a;      // the selection box [the highlight]
constexpr Tag MSC_MirrorX = 0x1005801b;       // a move is mirrored on the vertex across the middle column [off]
// Sizes and steps.
constexpr Tag MSCD_VertexSize = 0x20058000;  // half the vertex handle's side, handle pixels [3]
constexpr Tag MSCD_LineWidth = 0x20058001;   // row and column lines, viewer pixels [1]
constexpr Tag MSCD_BorderWidth = 0x20058002; // the outline, viewer pixels [2]
constexpr Tag MSCD_SnapSpacing = 0x20058003; // MSC_SnapToGrid's grid, image pixels [10]
constexpr Tag MSCD_Opacity = 0x20058004;     // of the lines, 0..1 [1]
constexpr Tag MSCD_Falloff = 0x20058005;     // soft selection: radius in image pixels within which
                                             // unselected vertices follow a drag, fading out [0: off]
constexpr Tag MSCD_FineFactor = 0x20058006;  // speed of a drag with Ctrl held [0.1]
constexpr Tag MSCD_NudgeStep = 0x20058007;   // an arrow key's step, image pixels [1]
constexpr Tag MSCS_Label = 0x30058000;       // a text at the mesh's top-left vertex
// Inputs the overlay reads: by id (ID) or by the Input itself (P).
constexpr Tag MSCID_Rest = 0x80058000; // a mesh Input: the undeformed mesh, drawn faintly under
constexpr Tag MSCP_Rest = 0x60058000;
constexpr Tag MSCID_Offset = 0x80058001; // a Point Input: the mesh is drawn and edited moved by it
constexpr Tag MSCP_Offset = 0x60058001;
constexpr Tag MSCID_Visible = 0x80058002; // a Number Input; 0 hides the mesh
constexpr Tag MSCP_Visible = 0x60058002;

extern const TagMapEntry MeshControlTags[];

} // namespace Orbane

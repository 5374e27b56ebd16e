#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"
#include "overlays/MeshGrid.h"

#include "orbane/OrbColor.h"

#include <string>
#include <vector>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A warp mesh over the image: its main Input holds the mesh (see MeshGrid
// for the table), drawn as a wireframe of row and column lines with a
// handle on every vertex.
//   - click a vertex: it alone is selected; Shift-click adds it (or takes a
//     selected one out);
//   - press between vertices and drag: a selection box (Shift adds);
//     a click there clears the selection;
//   - drag a vertex: every selected vertex moves with it, Ctrl slower, the
//     whole drag one undo step "Move Mesh Points";
//   - arrow keys nudge the selection (Shift ten steps, Ctrl a tenth), one
//     step "Nudge Mesh Points" until every key is up.
// The toolbar resets the mesh to an even grid ("Reset Mesh") and selects
// all or none. A mesh without vertices draws nothing and says so in its
// state. Tags: MeshTags.h.
class MeshControl : public HandleOverlay
{
public:
    // The selection box's drag, beside the vertices' own (DRAG_Handle).
    static constexpr DragType DRAG_MeshBox = DragType(3);

    MeshControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~MeshControl() override;

    std::size_t SizeOf() const override { return sizeof(MeshControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `cols`, `rows`, `vertices`, `selected` (a count), `selection`
    // (the selected vertices' numbers, 1 = bottom left, row by row),
    // `boxing` and `status` ("" or why nothing is drawn).
    void GetState(ScriptVal &state) const override;
    void GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *tags) override;
    bool HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags) override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;
    HandleHit HoverHit(PreviewInfo &info) override;

private:
    // What the tags set; see MeshTags.h for each.
    struct Look
    {
        int32 cols = 5, rows = 5;
        bool showVertices = true, showRows = true, showColumns = true, showBorder = true;
        bool showDiagonals = false, showLabels = false, hideWhileDragging = false, showRest = true;
        bool boxSelect = true, readOnly = false, snapToPixels = false, snapToGrid = false;
        int32 lineEvery = 1, vertexShape = 0, lineStyle = 0;
        OrbColor handle, line, selected, border, rest, box;
        float64 vertexSize = 3.0, lineWidth = 1.0, borderWidth = 2.0, snapSpacing = 10.0, opacity = 1.0;
        float64 fineFactor = 0.1, nudgeStep = 1.0, falloff = 0.0;
        MeshMoveRules rules;
        std::string label;
    };

    static const LinkedInput<MeshControl> Links[];

    void ReadLook(const TagList &tags);
    void TakeMesh(const Parameter *value);
    MeshMoveRules RulesFor(const PreviewInfo &info) const;
    bool Shows() const { return mVisible && !mMesh.Empty(); }
    OrbPoint ViewerPoint(const PreviewInfo &info, OrbPoint p) const;
    void Select(int32 vertex, bool add);
    void SelectBox();
    bool WriteMesh(const MeshGrid &mesh, const char *gesture);
    void Nudge(const PreviewInfo &info, uint64 key);

    void DrawMesh(Graphics::GPainter &p, const PreviewInfo &info, const MeshGrid &mesh, Graphics::GColor line,
                  bool rest) const;
    void DrawLines(Graphics::GPainter &p, const std::vector<OrbPoint> &at, const MeshGrid &mesh, bool diagonals) const;
    static OrbPoint CellSizes(const std::vector<OrbPoint> &at, const MeshGrid &mesh);
    void DrawVertices(Graphics::GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at) const;
    void DrawVertexSet(Graphics::GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at,
                       const std::vector<int32> &which) const;
    void DrawBox(Graphics::GPainter &p, const PreviewInfo &info) const;
    void DrawLabels(Graphics::GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at) const;

    Input *mRestInput = nullptr, *mOffsetInput = nullptr, *mVisibleInput = nullptr;
    Look mLook;
    MeshGrid mMesh, mRest;
    OrbPoint mOffset;
    bool mVisible = true;
    std::vector<uint8> mSelected; // one flag per vertex
    // The drag: the mesh at the press, the move so far (image units) and
    // the mouse at the last move (viewer units); the box's corners (image).
    MeshGrid mDragFrom;
    OrbPoint mDelta, mLastMouse;
    OrbPoint mBoxFrom, mBoxTo;
    bool mBoxing = false, mBoxAdds = false;
};

} // namespace Orbane

#pragma once

#include "framework/HandleOverlay.h"

#include "orbane/OrbColor.h"

#include <QString>

#include <vector>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A point tracker over the image: its main Input is the tracked point (a
// Point, image coordinates), drawn with the pattern box about it (what is
// followed) and the wider search box (where the next frame is searched),
// and the path through the point's keys.
//   - drag inside the pattern box: moves the point ("Move Tracker");
//   - drag a corner of either box: resizes it about the point
//     ("Resize Tracker Pattern", "Resize Tracker Search Area");
//   - the toolbar's "Track Forward" and "Track Backward" follow the pattern
//     through the viewer's image sequence from the current frame, one key
//     per frame, with a progress dialog that can cancel; the keys tracked
//     so far are one undo step ("Track Forward" / "Track Backward").
// Scripts track through the same events (orbane.Track), without a dialog.
// Tags: TrackerTags.h.
class TrackerControl : public HandleOverlay
{
public:
    TrackerControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~TrackerControl() override = default;

    std::size_t SizeOf() const override { return sizeof(TrackerControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `x`, `y`, the boxes' `patternWidth`, `patternHeight`,
    // `searchWidth`, `searchHeight` (image units), `keys` (the point's keys),
    // `tracked` (frames the last run tracked; -1 before any) and
    // `trackMessage` (what the last run said).
    void GetState(ScriptVal &state) const override;
    void GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *tags) override;
    // "TrackForward", "TrackBackward". PCA_CommandValue may give the frames
    // as "start:end" (either may be empty: the current frame, the
    // sequence's end).
    bool HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags) override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    enum Role : int32
    {
        R_Pattern,
        R_Search,
        R_Count,
    };
    // A run's frames and direction, and what it ended with.
    struct Run
    {
        int32 start = 0, end = 0, step = 1;
        bool fromScript = false;
    };

    void ReadLook(const TagList &tags);
    void TakeValue(int32 index, const Parameter *value);
    OrbPoint &BoxSize(int32 role) { return role == R_Pattern ? mPattern : mSearch; }
    void Resize(const PreviewInfo &info, int32 role, OrbPoint size);
    bool ParseRun(const TagList *tags, bool forward, Run &run);
    // TrackerControlTracking.cpp: the tracking run.
    int32 Track(const Run &run);
    void Finish(int32 tracked, const QString &message);

    void DrawBox(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint size, uint32 corners) const;
    void DrawPath(Graphics::GPainter &p, const PreviewInfo &info) const;

    int32 mRoles[R_Count] = {1, 2};
    OrbPoint mPoint{0.5, 0.5};
    OrbPoint mPattern{0.05, 0.05}, mSearch{0.15, 0.15}; // image units
    bool mShowPath = true, mSubPixel = true;
    int32 mPathFrames = 0, mPatternUpdate = 0;
    OrbColor mPathColor, mBoxColor;
    float64 mMinScore = 0.5;
    int32 mTracked = -1;
    QString mTrackMessage;
};

} // namespace Orbane

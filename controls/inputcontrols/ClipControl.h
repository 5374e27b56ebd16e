#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "orbane/ClipSequence.h"

#include "orbane/OrbString.h"

class QLabel;
class QSpinBox;

namespace Orbane {

class PathChooser;

// Shows an image or image sequence: the Text Input it stands on holds the
// path ("plate.####.exr" for a sequence), and two further Number Inputs,
// given by CLCP_InInput and CLCP_OutInput, hold the first and last frame
// used. The frames on disk are found whenever the path changes; choosing a
// clip (typed, browsed or dropped) sets the trim to all its frames in the
// same undo step. The trim boxes ("in", "out") keep in <= out inside the
// frames found; they are made only where there are trim Inputs.
class ClipControl : public LabelledInputControl
{
    Q_OBJECT
public:
    ClipControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ClipControl() override;

    std::size_t SizeOf() const override { return sizeof(ClipControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnChosen(const QString &path);
    void OnIn(int frame);
    void OnOut(int frame);

private:
    void ReadOwnTags(const TagList &tags);
    void LinkTrimInputs(const TagList &tags);
    bool MakeTrimBoxes();
    void ReadTrims();
    void Detect();
    void ShowClip();
    void ShowTrims();
    bool WriteFrame(Input *input, int32 frame);

    OrbString mPath;
    OrbString mFilter;
    int32 mIn = 0;
    int32 mOut = 0;
    bool mDetected = false;
    ClipSequence mClip;
    Input *mInInput = nullptr;
    Input *mOutInput = nullptr;
    InputGesture mGesture;
    PathChooser *mChooser;
    QSpinBox *mInBox = nullptr;
    QSpinBox *mOutBox = nullptr;
    QLabel *mFrames;
};

} // namespace Orbane

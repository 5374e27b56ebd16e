#pragma once

#include "framework/SplineTags.h"
#include "inputcontrols/TableInputControl.h"
#include "widgets/Curve.h"

#include "orbane/OrbColor.h"

#include <array>

class QPushButton;

namespace Orbane {

class CurveGraph;

// A curves editor: the luminance, red, green, blue and alpha curves of one
// script-table Input, in one graph ("graph"). The buttons "luma", "red",
// "green", "blue" and "alpha" choose the curve the mouse edits, "linear"
// switches that curve between smooth and straight segments, and "reset"
// puts it back to the identity. The value is a table of curves by name,
// each in the form of CurveTable; a curve missing from it is the identity.
class SplineControl : public TableInputControl
{
    Q_OBJECT
public:
    SplineControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~SplineControl() override;

    std::size_t SizeOf() const override { return sizeof(SplineControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    // The class frees its static buffers (the curves' key names), then the family's.
    static bool RegCleanup(Registry *reg);
    // The key of each curve in the value's table.
    static const char *CurveKey(int32 curve);

    int32 ActiveCurve() const;

protected:
    void ShowValue() override;

private slots:
    void OnEdited(int line);
    void OnReleased();
    void OnCurveChosen();
    void OnLinearToggled(bool linear);
    void OnReset();
    void OnHistogram();

private:
    void AddAttrRows();
    void ReadOwnTags(const TagList &tags);
    void ApplyTags();
    void WriteCurves();
    void ShowButtons();

    uint32 mLumaColour = OrbColor(230, 230, 230).Packed();
    std::array<bool, SPLINE_CurveCount> mShown = {true, true, true, true, false};
    int32 mActive = SPLINE_Luma;
    bool mLinear = false;
    int32 mGrid = 4;
    int32 mMaxPoints = 32;
    bool mLockEnds = false;
    bool mShowHistogram = false;
    int32 mHeight = 160;
    bool mDiagonal = true;
    bool mCoords = true;
    float64 mSnapX = 0.0;
    float64 mSnapY = 0.0;
    float64 mMinX = 0.0;
    float64 mMaxX = 1.0;
    float64 mMinY = 0.0;
    float64 mMaxY = 1.0;

    CurveGraph *mGraph;
    std::array<QPushButton *, SPLINE_CurveCount> mChoosers;
    QPushButton *mLinearButton;
    QPushButton *mResetButton;
};

} // namespace Orbane

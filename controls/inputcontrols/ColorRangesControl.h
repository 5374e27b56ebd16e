#pragma once

#include "inputcontrols/TableInputControl.h"

#include <array>

class QPushButton;

namespace Orbane {

class CurveGraph;

// The shadow and highlight ranges as two falloff curves over the tones
// 0..1, in one script-table Input: { lowStart = 0.1, lowEnd = 0.4,
// highStart = 0.6, highEnd = 0.9 }. The shadows are whole up to lowStart
// and fall to nothing at lowEnd; the highlights rise from highStart to
// whole at highEnd; the midtones are what is left. The four ends are
// handles in the graph ("graph") that drag sideways (Ctrl finer, Shift on
// the grid); the curves may overlap. "reset" puts back the defaults.
class ColorRangesControl : public TableInputControl
{
    Q_OBJECT
public:
    enum End : int32
    {
        LowStart,
        LowEnd,
        HighStart,
        HighEnd
    };
    using Ends = std::array<float64, 4>;
    static constexpr Ends kDefaults = {0.1, 0.4, 0.6, 0.9};

    ColorRangesControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ColorRangesControl() override;

    std::size_t SizeOf() const override { return sizeof(ColorRangesControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    // The ends of a value: missing keys take the defaults, each end is
    // kept within 0..1 and each range's end after its start.
    static Ends EndsOf(const ScriptVal &table);
    static ScriptVal TableOf(const Ends &ends);

protected:
    void ShowValue() override;

private slots:
    void OnEdited();
    void OnReleased();
    void OnReset();

private:
    void ReadOwnTags(const TagList &tags);

    bool mSmooth = true;
    bool mShowMidtones = true;
    int32 mHeight = 110;
    float64 mSnap = 0.0;
    CurveGraph *mGraph;
    QPushButton *mReset;
};

} // namespace Orbane

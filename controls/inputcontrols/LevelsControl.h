#pragma once

#include "inputcontrols/LevelsBase.h"

namespace Orbane {

class HistogramChoice;

// Input levels over the viewed image's histogram: the black point (the
// Input the control stands on), the gamma (LVLCP_GammaInput) and the white
// point (LVLCP_WhiteInput), as handles under the histogram ("histogram")
// and edit boxes ("black", "gamma", "white"). The gamma handle sits where
// the output is one half: black + (white - black) * 0.5^gamma. Black stays
// below white; gamma stays within 0.1 .. 10.
class LevelsControl : public LevelsBase
{
    Q_OBJECT
public:
    static constexpr float64 kMinGamma = 0.1;
    static constexpr float64 kMaxGamma = 10.0;
    static constexpr float64 kMinSpan = 0.001;

    LevelsControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~LevelsControl() override;

    std::size_t SizeOf() const override { return sizeof(LevelsControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    // Where the gamma handle sits, and the gamma of a handle there.
    static float64 GammaToPosition(float64 black, float64 white, float64 gamma);
    static float64 PositionToGamma(float64 black, float64 white, float64 x);

protected:
    std::vector<LevelsBar::Handle> Handles(const std::vector<float64> &values) const override;
    void HandleMoved(int32 handle, float64 x, std::vector<float64> &values) const override;
    void Constrain(std::vector<float64> &values, int32 moved) const override;

private:
    bool mLogScale = true;
    HistogramChoice *mChoice;
};

} // namespace Orbane

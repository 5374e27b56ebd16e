#pragma once

#include "inputcontrols/LevelsBase.h"

namespace Orbane {

// Output levels: the black (the Input the control stands on) and the white
// (LVLOCP_WhiteInput) that the output is mapped into, as handles under a
// ramp from black to LVLOC_GradientColor ("ramp") and edit boxes ("black",
// "white"). Black stays below white unless LVLOC_AllowInvert lets it pass,
// which inverts the output.
class LevelsOutputControl : public LevelsBase
{
    Q_OBJECT
public:
    LevelsOutputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~LevelsOutputControl() override;

    std::size_t SizeOf() const override { return sizeof(LevelsOutputControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

protected:
    std::vector<LevelsBar::Handle> Handles(const std::vector<float64> &values) const override;
    void Constrain(std::vector<float64> &values, int32 moved) const override;

private:
    void ReadOwnTags(const TagList &tags);

    uint32 mGradientColour;
    bool mAllowInvert = false;
};

} // namespace Orbane

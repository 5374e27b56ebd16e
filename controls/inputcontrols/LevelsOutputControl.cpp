#include "inputcontrols/LevelsOutputControl.h"

#include "framework/LevelsTags.h"

#include "orbane/OrbColor.h"

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.LevelsOutput.Layout";
constexpr float64 kMinSpan = 0.001;

QColor ToQColor(uint32 packed)
{
    const OrbColor c(packed);
    return c.IsNone() ? QColor(Qt::white) : QColor(c.R(), c.G(), c.B());
}

} // namespace

LevelsOutputControl::LevelsOutputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LevelsBase(reg, args, tags, {{"black", 0, 0.0, 0.0}, {"white", LVLOCP_WhiteInput, 1.0, 1.0}}, "ramp"),
      mGradientColour(OrbColor(255, 255, 255).Packed())
{
    AddAttr(LVLOC_GradientColor, &mGradientColour, Attr_CopyAndList);
    AddAttr(LVLOC_AllowInvert, &mAllowInvert, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

LevelsOutputControl::~LevelsOutputControl() = default;

void LevelsOutputControl::ReadOwnTags(const TagList &tags)
{
    mGradientColour = uint32(tags.GetLong(LVLOC_GradientColor, mGradientColour));
    mAllowInvert = tags.GetBool(LVLOC_AllowInvert, mAllowInvert);
    Bar()->SetRamp(Qt::black, ToQColor(mGradientColour));
}

bool LevelsOutputControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    return LevelsBase::SetAttrsTagList(input, tags);
}

bool LevelsOutputControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    return OpenLevels(host, rect, tags, kLayoutItem);
}

std::vector<LevelsBar::Handle> LevelsOutputControl::Handles(const std::vector<float64> &values) const
{
    return {{std::clamp(values[0], 0.0, 1.0), QColor(20, 20, 20)},
            {std::clamp(values[1], 0.0, 1.0), ToQColor(mGradientColour)}};
}

void LevelsOutputControl::Constrain(std::vector<float64> &values, int32 moved) const
{
    if (mAllowInvert)
        return;
    if (moved == 1)
        values[1] = std::max(values[1], values[0] + kMinSpan);
    else
        values[0] = std::min(values[0], values[1] - kMinSpan);
}

} // namespace Orbane

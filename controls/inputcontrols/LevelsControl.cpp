#include "inputcontrols/LevelsControl.h"

#include "framework/LevelsTags.h"
#include "inputcontrols/HistogramChoice.h"

#include <QComboBox>
#include <QPushButton>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Levels.Layout";
enum : int32
{
    kBlack,
    kGamma,
    kWhite
};

std::vector<LevelsBase::End> Ends()
{
    return {{"black", 0, 0.0, 0.0}, {"gamma", LVLCP_GammaInput, 1.0, 1.0}, {"white", LVLCP_WhiteInput, 1.0, 1.0}};
}

} // namespace

LevelsControl::LevelsControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LevelsBase(reg, args, tags, Ends(), "histogram"), mChoice(new HistogramChoice(this, Bar()))
{
    RegisterChild("channel", mChoice->Channels());
    RegisterChild("scale", mChoice->Scale());
    AddAttr(LVLC_LogScale, &mLogScale, Attr_CopyAndList);
    mLogScale = tags.GetBool(LVLC_LogScale, mLogScale);
    mChoice->SetLogScale(mLogScale);
    ClassLayout(kLayoutItem);
}

LevelsControl::~LevelsControl() = default;

bool LevelsControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    if (tags.FindQuery(LVLC_LogScale)) {
        mLogScale = tags.GetBool(LVLC_LogScale, mLogScale);
        mChoice->SetLogScale(mLogScale);
    }
    return LevelsBase::SetAttrsTagList(input, tags);
}

bool LevelsControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!OpenLevels(host, rect, tags, kLayoutItem))
        return false;
    mChoice->Start();
    return true;
}

float64 LevelsControl::GammaToPosition(float64 black, float64 white, float64 gamma)
{
    return black + (white - black) * std::pow(0.5, gamma);
}

float64 LevelsControl::PositionToGamma(float64 black, float64 white, float64 x)
{
    const float64 t = (x - black) / (white - black);
    if (!(t > 0.0))
        return kMaxGamma;
    if (!(t < 1.0))
        return kMinGamma;
    return std::clamp(std::log(t) / std::log(0.5), kMinGamma, kMaxGamma);
}

std::vector<LevelsBar::Handle> LevelsControl::Handles(const std::vector<float64> &values) const
{
    const float64 black = values[kBlack], white = values[kWhite];
    const float64 mid = GammaToPosition(black, white, values[kGamma]);
    return {{std::clamp(black, 0.0, 1.0), QColor(20, 20, 20)},
            {std::clamp(mid, 0.0, 1.0), QColor(128, 128, 128)},
            {std::clamp(white, 0.0, 1.0), QColor(245, 245, 245)}};
}

void LevelsControl::HandleMoved(int32 handle, float64 x, std::vector<float64> &values) const
{
    if (handle == kGamma)
        values[kGamma] = PositionToGamma(values[kBlack], values[kWhite], x);
    else
        values[std::size_t(handle)] = x;
}

void LevelsControl::Constrain(std::vector<float64> &values, int32 moved) const
{
    if (moved == kWhite)
        values[kWhite] = std::max(values[kWhite], values[kBlack] + kMinSpan);
    else
        values[kBlack] = std::min(values[kBlack], values[kWhite] - kMinSpan);
    values[kGamma] = std::clamp(values[kGamma], kMinGamma, kMaxGamma);
}

} // namespace Orbane

#include "inputcontrols/GammaControl.h"

#include "inputcontrols/DisconnectWrite.h"
#include "widgets/CurveGraph.h"
#include "widgets/TransferFunctions.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/TimeCodeEdit.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Gamma.Layout";
constexpr int32 kPlaces = 3;
constexpr int32 kSamples = 96;
const QColor kCurveColour(230, 200, 120);

} // namespace

GammaControl::GammaControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mEdit(new TimeCodeEdit(this)),
      mGraph(new CurveGraph(this))
{
    mEdit->setObjectName("edit");
    mGraph->setObjectName("graph");
    RegisterChild("edit", mEdit);
    RegisterChild("graph", mGraph);
    connect(mEdit, SIGNAL(editingFinished()), this, SLOT(OnTyped()));
    connect(mGraph, SIGNAL(Edited(int)), this, SLOT(OnEdited()));
    connect(mGraph, SIGNAL(Released()), this, SLOT(OnReleased()));
    mGraph->SetDiagonal(true);
    mGraph->SetShowCoords(false);
    Label()->setFocusProxy(mEdit);
    ClassLayout(kLayoutItem);
}

GammaControl::~GammaControl() = default;

float64 GammaControl::Tidy(float64 gamma)
{
    return std::isfinite(gamma) ? std::clamp(gamma, kMinGamma, kMaxGamma) : 1.0;
}

bool GammaControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = IsFirstInput(input);
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (const AutoNumber now(input, GetCurrentTime()); first && now)
        mGamma = now->Value;
    return true;
}

bool GammaControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    Show();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    return true;
}

bool GammaControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (value && (!number || !HasValueChanged(false, number->Value, mGamma, 0.5e-6)))
        return true;
    if (number)
        mGamma = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool GammaControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        Show();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

// A value out of range from elsewhere is shown as it is in the box and
// drawn at the nearest gamma the control allows.
void GammaControl::Show()
{
    if (!mEdit->isModified())
        mEdit->SetValue(mGamma, kPlaces);
    const float64 gamma = Tidy(mGamma);
    CurveGraph::Line handle;
    handle.curve = Curve({{0.5, TransferFunctions::Gamma(0.5, gamma)}});
    handle.colour = kCurveColour;
    handle.flags = CurveGraph::Line_Fixed | CurveGraph::Line_LockX | CurveGraph::Line_PointsOnly;
    if (mGraph->Lines().empty())
        mGraph->SetLines({handle});
    else
        mGraph->SetCurve(0, handle.curve);
    mGraph->SetPlots({{TransferFunctions::Sample([gamma](float64 x) { return TransferFunctions::Gamma(x, gamma); }, 0.0,
                                                 1.0, kSamples),
                       kCurveColour, false}});
}

void GammaControl::Write(float64 gamma)
{
    gamma = Tidy(gamma);
    if (HasValueChanged(false, gamma, mGamma, 0.5e-6))
        mGesture.Write(GetCurrentInput(), AutoNumber(gamma), InputGesture::StepName(*this));
    Show();
}

void GammaControl::OnEdited()
{
    const float64 y = mGraph->GetCurve(0).Points().front().y;
    Write(TransferFunctions::GammaThrough(std::clamp(y, 1e-6, 1.0 - 1e-6)));
}

void GammaControl::OnReleased()
{
    mGesture.End();
}

void GammaControl::OnTyped()
{
    if (!mEdit->isModified())
        return;
    mEdit->setModified(false);
    bool ok = false;
    const float64 typed = mEdit->GetValue(&ok);
    if (ok)
        Write(typed);
    mGesture.End();
    Show();
}

bool GammaControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, mGamma);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

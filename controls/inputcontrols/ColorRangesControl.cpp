#include "inputcontrols/ColorRangesControl.h"

#include "framework/ColorRangesTags.h"
#include "inputcontrols/CurveTable.h"
#include "widgets/CurveGraph.h"
#include "widgets/TransferFunctions.h"

#include "orbane/ElideLabel.h"
#include "orbane/LayoutObj.h"

#include <QPushButton>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.ColorRanges.Layout";
constexpr const char *kKeys[4] = {"lowStart", "lowEnd", "highStart", "highEnd"};
// The least width of a falloff: two ends on one x would merge into one point.
constexpr float64 kMinWidth = 1e-3;
constexpr int32 kSamples = 96;
const QColor kShadowColour(110, 140, 255);
const QColor kHighlightColour(255, 190, 90);
const QColor kMidtoneColour(200, 200, 200, 150);

enum Line : int32
{
    kShadows,
    kHighlights
};

} // namespace

constexpr ColorRangesControl::Ends ColorRangesControl::kDefaults;

ColorRangesControl::ColorRangesControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TableInputControl(reg, args, tags), mGraph(new CurveGraph(this)), mReset(new QPushButton("Reset", this))
{
    mGraph->setObjectName("graph");
    mReset->setObjectName("reset");
    RegisterChild("graph", mGraph);
    RegisterChild("reset", mReset);
    connect(mGraph, SIGNAL(Edited(int)), this, SLOT(OnEdited()));
    connect(mGraph, SIGNAL(Released()), this, SLOT(OnReleased()));
    connect(mReset, SIGNAL(clicked()), this, SLOT(OnReset()));
    mGraph->SetPickAnyLine(true);
    mGraph->SetDiagonal(false);
    Label()->setFocusProxy(mGraph);
    AddAttr(CRC_SmoothFalloff, &mSmooth, Attr_CopyAndList);
    AddAttr(CRC_ShowMidtones, &mShowMidtones, Attr_CopyAndList);
    AddAttr(CRC_Height, &mHeight, Attr_CopyAndList);
    AddAttr(CRCD_SnapStep, &mSnap, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

ColorRangesControl::~ColorRangesControl() = default;

void ColorRangesControl::ReadOwnTags(const TagList &tags)
{
    mSmooth = tags.GetBool(CRC_SmoothFalloff, mSmooth);
    mShowMidtones = tags.GetBool(CRC_ShowMidtones, mShowMidtones);
    mHeight = std::clamp(tags.GetInt(CRC_Height, mHeight), 40, 2000);
    mSnap = std::max(0.0, tags.GetDouble(CRCD_SnapStep, mSnap));
    mGraph->SetSnap(mSnap, 0.0);
    if (Layout::LayoutObj *graph = FindLayoutObj("graph"))
        graph->SetAttrs(TagList{{INPA_LayoutHeight, mHeight}});
}

bool ColorRangesControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    if (IsOpen())
        ShowValue();
    return TableInputControl::SetAttrsTagList(input, tags);
}

bool ColorRangesControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!TableInputControl::Open(host, rect, tags))
        return false;
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    ReadOwnTags(TagList());
    return true;
}

ColorRangesControl::Ends ColorRangesControl::EndsOf(const ScriptVal &table)
{
    Ends ends = kDefaults;
    for (int32 i = 0; i < 4; ++i) {
        const float64 v = CurveTable::NumberAt(table, kKeys[i], kDefaults[std::size_t(i)]);
        ends[std::size_t(i)] = std::isfinite(v) ? std::clamp(v, 0.0, 1.0) : kDefaults[std::size_t(i)];
    }
    // A range given backwards is taken the right way round.
    for (int32 start : {LowStart, HighStart}) {
        float64 &a = ends[std::size_t(start)], &b = ends[std::size_t(start) + 1];
        if (a > b)
            std::swap(a, b);
        if (b - a < kMinWidth) {
            b = std::min(1.0, a + kMinWidth);
            a = b - kMinWidth;
        }
    }
    return ends;
}

ScriptVal ColorRangesControl::TableOf(const Ends &ends)
{
    ScriptVal table = ScriptVal::NewTable();
    for (int32 i = 0; i < 4; ++i)
        table.SetKey(ScriptVal(kKeys[i]), ScriptVal(ends[std::size_t(i)]));
    return table;
}

void ColorRangesControl::ShowValue()
{
    const Ends e = EndsOf(Value());
    const uint32 flags = CurveGraph::Line_Fixed | CurveGraph::Line_LockY;
    std::vector<CurveGraph::Line> lines(2);
    lines[kShadows] = {Curve({{e[LowStart], 1.0}, {e[LowEnd], 0.0}}, !mSmooth), kShadowColour, flags, true};
    lines[kHighlights] = {Curve({{e[HighStart], 0.0}, {e[HighEnd], 1.0}}, !mSmooth), kHighlightColour, flags, true};
    // While a drag lasts the graph keeps its lines; only the curves change.
    if (mGraph->Lines().size() == 2) {
        mGraph->SetCurve(kShadows, lines[kShadows].curve);
        mGraph->SetCurve(kHighlights, lines[kHighlights].curve);
    } else {
        mGraph->SetLines(std::move(lines));
    }
    std::vector<CurveGraph::Plot> plots;
    if (mShowMidtones) {
        const Curve shadows = mGraph->GetCurve(kShadows), highlights = mGraph->GetCurve(kHighlights);
        const auto midtones = [shadows, highlights](float64 x) {
            return std::max(0.0, 1.0 - shadows.Evaluate(x) - highlights.Evaluate(x));
        };
        plots.push_back({TransferFunctions::Sample(midtones, 0.0, 1.0, kSamples), kMidtoneColour, true});
    }
    mGraph->SetPlots(std::move(plots));
}

void ColorRangesControl::OnEdited()
{
    const auto &s = mGraph->GetCurve(kShadows).Points(), &h = mGraph->GetCurve(kHighlights).Points();
    if (s.size() != 2 || h.size() != 2)
        return;
    WriteValue(TableOf(EndsOf(TableOf({s[0].x, s[1].x, h[0].x, h[1].x}))));
    ShowValue();
}

void ColorRangesControl::OnReleased()
{
    EndGesture();
}

void ColorRangesControl::OnReset()
{
    if (Value().IsTable() && EndsOf(Value()) == kDefaults)
        return;
    WriteValue(TableOf(kDefaults));
    EndGesture();
    ShowValue();
}

} // namespace Orbane

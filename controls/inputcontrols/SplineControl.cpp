#include "inputcontrols/SplineControl.h"

#include "inputcontrols/CurveTable.h"
#include "widgets/CurveGraph.h"
#include "widgets/HistogramFeed.h"

#include "orbane/ElideLabel.h"
#include "orbane/LayoutObj.h"

#include <QPushButton>

#include <utility>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Spline.Layout";
constexpr const char *kKeys[SPLINE_CurveCount] = {"luma", "red", "green", "blue", "alpha"};
constexpr const char *kButtonTexts[SPLINE_CurveCount] = {"L", "R", "G", "B", "A"};
const QColor kCurveColours[SPLINE_CurveCount] = {{}, {235, 80, 70}, {90, 200, 90}, {90, 140, 240}, {200, 200, 200}};
const Histogram::Channel kChannels[SPLINE_CurveCount] = {Histogram::Luma, Histogram::Red, Histogram::Green,
                                                         Histogram::Blue, Histogram::Alpha};

// The identity curves (smooth, straight) as tables, made on first use and
// freed by the class's clean-up; plain pointers, so that no static
// destructor runs before it.
ScriptVal *gIdentity[2] = {nullptr, nullptr};

const ScriptVal &IdentityTable(bool linear)
{
    ScriptVal *&table = gIdentity[linear ? 1 : 0];
    if (!table)
        table = new ScriptVal(CurveTable::FromCurve(Curve::Identity(linear)));
    return *table;
}

QColor ToQColor(OrbColor c)
{
    return c.IsNone() ? QColor(230, 230, 230) : QColor(c.R(), c.G(), c.B(), c.A());
}

} // namespace

SplineControl::SplineControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TableInputControl(reg, args, tags), mGraph(new CurveGraph(this)), mLinearButton(new QPushButton("Linear", this)),
      mResetButton(new QPushButton("Reset", this))
{
    mGraph->setObjectName("graph");
    RegisterChild("graph", mGraph);
    connect(mGraph, SIGNAL(Edited(int)), this, SLOT(OnEdited(int)));
    connect(mGraph, SIGNAL(Released()), this, SLOT(OnReleased()));
    for (int32 i = 0; i < SPLINE_CurveCount; ++i) {
        QPushButton *button = new QPushButton(kButtonTexts[i], this);
        button->setObjectName(kKeys[i]);
        button->setCheckable(true);
        button->setFocusPolicy(Qt::NoFocus);
        connect(button, SIGNAL(clicked()), this, SLOT(OnCurveChosen()));
        RegisterChild(kKeys[i], button);
        mChoosers[std::size_t(i)] = button;
    }
    mLinearButton->setObjectName("linear");
    mLinearButton->setCheckable(true);
    mResetButton->setObjectName("reset");
    connect(mLinearButton, SIGNAL(toggled(bool)), this, SLOT(OnLinearToggled(bool)));
    connect(mResetButton, SIGNAL(clicked()), this, SLOT(OnReset()));
    RegisterChild("linear", mLinearButton);
    RegisterChild("reset", mResetButton);
    Label()->setFocusProxy(mGraph);
    AddAttrRows();
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

SplineControl::~SplineControl() = default;

bool SplineControl::RegCleanup(Registry *reg)
{
    for (ScriptVal *&table : gIdentity)
        delete std::exchange(table, nullptr);
    return InputControl::RegCleanup(reg);
}

const char *SplineControl::CurveKey(int32 curve)
{
    return curve >= 0 && curve < SPLINE_CurveCount ? kKeys[curve] : nullptr;
}

int32 SplineControl::ActiveCurve() const
{
    return mActive;
}

void SplineControl::AddAttrRows()
{
    AddAttr(SPC_SplineColor, &mLumaColour, Attr_CopyAndList);
    const Tag shows[SPLINE_CurveCount] = {SPC_ShowLuma, SPC_ShowRed, SPC_ShowGreen, SPC_ShowBlue, SPC_ShowAlpha};
    for (int32 i = 0; i < SPLINE_CurveCount; ++i)
        AddAttr(shows[i], &mShown[std::size_t(i)], Attr_CopyAndList);
    AddAttr(SPC_ActiveCurve, &mActive, Attr_CopyAndList);
    AddAttr(SPC_Linear, &mLinear, Attr_CopyAndList);
    AddAttr(SPC_GridDivisions, &mGrid, Attr_CopyAndList);
    AddAttr(SPC_MaxPoints, &mMaxPoints, Attr_CopyAndList);
    AddAttr(SPC_LockEnds, &mLockEnds, Attr_CopyAndList);
    AddAttr(SPC_ShowHistogram, &mShowHistogram, Attr_CopyAndList);
    AddAttr(SPC_Height, &mHeight, Attr_CopyAndList);
    AddAttr(SPC_ShowDiagonal, &mDiagonal, Attr_CopyAndList);
    AddAttr(SPC_ShowCoords, &mCoords, Attr_CopyAndList);
    for (const auto &[tag, field] : {std::pair<Tag, const float64 *>{SPCD_SnapX, &mSnapX},
                                     {SPCD_SnapY, &mSnapY},
                                     {SPCD_MinX, &mMinX},
                                     {SPCD_MaxX, &mMaxX},
                                     {SPCD_MinY, &mMinY},
                                     {SPCD_MaxY, &mMaxY}})
        AddAttr(tag, field, Attr_CopyAndList);
}

void SplineControl::ReadOwnTags(const TagList &tags)
{
    mLumaColour = uint32(tags.GetLong(SPC_SplineColor, mLumaColour));
    const Tag shows[SPLINE_CurveCount] = {SPC_ShowLuma, SPC_ShowRed, SPC_ShowGreen, SPC_ShowBlue, SPC_ShowAlpha};
    for (int32 i = 0; i < SPLINE_CurveCount; ++i)
        mShown[std::size_t(i)] = tags.GetBool(shows[i], mShown[std::size_t(i)]);
    mActive = std::clamp(tags.GetInt(SPC_ActiveCurve, mActive), 0, SPLINE_CurveCount - 1);
    mLinear = tags.GetBool(SPC_Linear, mLinear);
    mGrid = std::clamp(tags.GetInt(SPC_GridDivisions, mGrid), 0, 64);
    mMaxPoints = std::max(CurveGraph::kMinPoints, tags.GetInt(SPC_MaxPoints, mMaxPoints));
    mLockEnds = tags.GetBool(SPC_LockEnds, mLockEnds);
    mShowHistogram = tags.GetBool(SPC_ShowHistogram, mShowHistogram);
    mHeight = std::clamp(tags.GetInt(SPC_Height, mHeight), 40, 2000);
    mDiagonal = tags.GetBool(SPC_ShowDiagonal, mDiagonal);
    mCoords = tags.GetBool(SPC_ShowCoords, mCoords);
    mSnapX = std::max(0.0, tags.GetDouble(SPCD_SnapX, mSnapX));
    mSnapY = std::max(0.0, tags.GetDouble(SPCD_SnapY, mSnapY));
    mMinX = tags.GetDouble(SPCD_MinX, mMinX);
    mMaxX = tags.GetDouble(SPCD_MaxX, mMaxX);
    mMinY = tags.GetDouble(SPCD_MinY, mMinY);
    mMaxY = tags.GetDouble(SPCD_MaxY, mMaxY);
    // The curve chosen must be one that is offered; else the first offered.
    if (!mShown[std::size_t(mActive)])
        for (int32 i = 0; i < SPLINE_CurveCount; ++i)
            if (mShown[std::size_t(i)]) {
                mActive = i;
                break;
            }
    ApplyTags();
}

// A view range given upside down or empty falls back to 0..1.
void SplineControl::ApplyTags()
{
    std::vector<CurveGraph::Line> lines(SPLINE_CurveCount);
    for (int32 i = 0; i < SPLINE_CurveCount; ++i) {
        auto &line = lines[std::size_t(i)];
        line.curve = i < int32(mGraph->Lines().size()) ? mGraph->GetCurve(i) : Curve::Identity(mLinear);
        line.colour = i == SPLINE_Luma ? ToQColor(OrbColor(mLumaColour)) : kCurveColours[i];
        line.flags = mLockEnds ? uint32(CurveGraph::Line_LockEnds) : 0u;
        line.visible = mShown[std::size_t(i)];
    }
    mGraph->SetLines(std::move(lines));
    mGraph->SetActive(mActive);
    mGraph->SetGrid(mGrid);
    mGraph->SetMaxPoints(mMaxPoints);
    mGraph->SetSnap(mSnapX, mSnapY);
    mGraph->SetDiagonal(mDiagonal);
    mGraph->SetShowCoords(mCoords);
    const bool sane = mMaxX > mMinX && mMaxY > mMinY;
    mGraph->SetDefaultView(sane ? QRectF(mMinX, mMinY, mMaxX - mMinX, mMaxY - mMinY) : QRectF(0, 0, 1, 1));
    if (mShowHistogram)
        connect(&HistogramFeed::Instance(), SIGNAL(Updated()), this, SLOT(OnHistogram()), Qt::UniqueConnection);
    else
        disconnect(&HistogramFeed::Instance(), SIGNAL(Updated()), this, SLOT(OnHistogram()));
    OnHistogram();
    ShowButtons();
    if (Layout::LayoutObj *graph = FindLayoutObj("graph"))
        graph->SetAttrs(TagList{{INPA_LayoutHeight, mHeight}});
}

bool SplineControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    return TableInputControl::SetAttrsTagList(input, tags);
}

bool SplineControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!TableInputControl::Open(host, rect, tags))
        return false;
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    if (Layout::LayoutObj *graph = FindLayoutObj("graph"))
        graph->SetAttrs(TagList{{INPA_LayoutHeight, mHeight}});
    if (mShowHistogram)
        HistogramFeed::Instance().Refresh();
    return true;
}

void SplineControl::ShowButtons()
{
    for (int32 i = 0; i < SPLINE_CurveCount; ++i) {
        mChoosers[std::size_t(i)]->setVisible(mShown[std::size_t(i)]);
        mChoosers[std::size_t(i)]->setChecked(i == mActive);
    }
    const QSignalBlocker quiet(mLinearButton);
    mLinearButton->setChecked(mGraph->GetCurve(mActive).IsLinear());
}

void SplineControl::ShowValue()
{
    const ScriptVal &value = Value();
    for (int32 i = 0; i < SPLINE_CurveCount; ++i) {
        const ScriptVal *table = value.IsTable() ? value.FindKeyConst(ScriptVal(kKeys[i])) : nullptr;
        mGraph->SetCurve(i, CurveTable::ToCurve(table, Curve::Identity(mLinear)));
    }
    ShowButtons();
}

// The whole table is written on every step: a curve is one value, and
// undo keeps it whole.
void SplineControl::WriteCurves()
{
    ScriptVal table = ScriptVal::NewTable();
    for (int32 i = 0; i < SPLINE_CurveCount; ++i)
        table.SetKey(ScriptVal(kKeys[i]), CurveTable::FromCurve(mGraph->GetCurve(i)));
    WriteValue(table);
}

void SplineControl::OnEdited(int)
{
    WriteCurves();
}

void SplineControl::OnReleased()
{
    EndGesture();
}

void SplineControl::OnCurveChosen()
{
    for (int32 i = 0; i < SPLINE_CurveCount; ++i)
        if (sender() == mChoosers[std::size_t(i)])
            mActive = i;
    mGraph->SetActive(mActive);
    ShowButtons();
    OnHistogram();
}

void SplineControl::OnLinearToggled(bool linear)
{
    Curve curve = mGraph->GetCurve(mActive);
    if (curve.IsLinear() == linear)
        return;
    curve.SetLinear(linear);
    mGraph->SetCurve(mActive, curve);
    WriteCurves();
    EndGesture();
}

void SplineControl::OnReset()
{
    const Curve identity = CurveTable::ToCurve(&IdentityTable(mLinear), Curve::Identity(mLinear));
    if (mGraph->GetCurve(mActive) == identity)
        return;
    mGraph->SetCurve(mActive, identity);
    WriteCurves();
    EndGesture();
    ShowButtons();
}

void SplineControl::OnHistogram()
{
    if (!mShowHistogram) {
        mGraph->SetHistogram({}, QColor());
        return;
    }
    const auto histogram = HistogramFeed::Instance().Current();
    QColor colour = mGraph->Lines()[std::size_t(mActive)].colour;
    colour.setAlpha(60);
    mGraph->SetHistogram(histogram->Heights(kChannels[mActive], true), colour);
}

} // namespace Orbane

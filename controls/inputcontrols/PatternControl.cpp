#include "inputcontrols/PatternControl.h"

#include "framework/PatternTags.h"
#include "inputcontrols/DisconnectWrite.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Pattern.Layout";

int32 PatternOf(float64 value)
{
    const float64 r = std::floor(value + 0.5);
    return std::isfinite(r) && r >= 0 && r < PatternSwatch::PatternCount ? int32(r) : -1;
}

} // namespace

PatternControl::PatternControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags)
{
    for (int32 i = 0; i < PatternSwatch::PatternCount; ++i) {
        // Painted widgets are made without a parent, then adopted.
        auto *swatch = new PatternSwatch(i);
        swatch->setParent(this);
        swatch->SetOwner(this);
        const QByteArray name = "pattern" + QByteArray::number(i + 1);
        swatch->setObjectName(name);
        connect(swatch, SIGNAL(Clicked(int)), this, SLOT(OnClicked(int)));
        RegisterChild(name.constData(), swatch);
        mSwatches[size_t(i)] = swatch;
    }
    Label()->setFocusProxy(mSwatches[0]);
    AddAttr(PTNC_TileSize, &mTile, Attr_CopyAndList);
    AddAttr(PTNC_InkColor, &mInk, Attr_CopyAndList);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

PatternControl::~PatternControl() = default;

void PatternControl::ReadOwnTags(const TagList &tags)
{
    mTile = std::clamp(tags.GetInt(PTNC_TileSize, mTile), 2, 64);
    mInk = uint32(tags.GetLong(PTNC_InkColor, int64(mInk)));
    const OrbColor ink(mInk);
    // "No colour" keeps the default ink.
    const QColor shown = ink.IsNone() ? QColor(230, 230, 230) : QColor(ink.R(), ink.G(), ink.B(), ink.A());
    for (PatternSwatch *s : mSwatches)
        s->SetLook(mTile, shown);
}

bool PatternControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool PatternControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (const AutoNumber now(GetCurrentInput(), GetCurrentTime()); now)
        mValue = now->Value;
    ShowChild(Label());
    for (PatternSwatch *s : mSwatches)
        ShowChild(s);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), true);
    return true;
}

bool PatternControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number || PatternOf(number->Value) == PatternOf(mValue))
        return true;
    mValue = number->Value;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool PatternControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void PatternControl::ShowValue()
{
    const int32 chosen = PatternOf(mValue);
    for (PatternSwatch *s : mSwatches)
        s->SetChosen(s->GetPattern() == chosen);
    Label()->setToolTip(chosen < 0 ? tr("The value %1 names no pattern").arg(mValue) : PatternSwatch::Name(chosen));
}

void PatternControl::OnClicked(int pattern)
{
    if (pattern == PatternOf(mValue))
        return;
    mValue = pattern;
    SetInputs(AutoNumber(float64(pattern)), GetCurrentTime(), 0, false, nullptr);
    ResetUndo(nullptr);
    ShowValue();
}

bool PatternControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, mValue);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

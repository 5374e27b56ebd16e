#include "framework/LabelledInputControl.h"

#include "orbane/ElideLabel.h"

#include <map>
#include <string>

namespace Orbane {

namespace {

// The class layouts and how often each item was read. Only the UI thread
// makes controls, so the maps need no lock.
struct ClassLayouts
{
    std::map<std::string, ScriptVal> descriptions;
    std::map<std::string, int32> reads;
};

ClassLayouts &Layouts()
{
    static ClassLayouts layouts;
    return layouts;
}

} // namespace

LabelledInputControl::LabelledInputControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : InputControl(reg, args, tags), mLabel(new ElideLabel(this))
{
    mLabel->setObjectName("label");
    mLabel->setElideMode(ElideLabel::Elide_Right);
    RegisterChild("label", mLabel);
}

LabelledInputControl::~LabelledInputControl() = default;

// ---- attributes ----

void LabelledInputControl::AddAttr(Tag tag, const bool *field, AttrUse use)
{
    mAttrs.push_back({tag, AttrKind::Bool, use, field});
}

void LabelledInputControl::AddAttr(Tag tag, const int32 *field, AttrUse use)
{
    mAttrs.push_back({tag, AttrKind::Int, use, field});
}

void LabelledInputControl::AddAttr(Tag tag, const uint32 *field, AttrUse use)
{
    mAttrs.push_back({tag, AttrKind::UInt, use, field});
}

void LabelledInputControl::AddAttr(Tag tag, const float64 *field, AttrUse use)
{
    mAttrs.push_back({tag, AttrKind::Double, use, field});
}

void LabelledInputControl::ListAttr(Tag tag, const OrbString *field)
{
    mAttrs.push_back({tag, AttrKind::Text, Attr_List, field});
}

void LabelledInputControl::ListAttr(Tag tag, const OrbID *field)
{
    mAttrs.push_back({tag, AttrKind::ID, Attr_List, field});
}

const LabelledInputControl::AttrRow *LabelledInputControl::FindCopyRow(Tag tag) const
{
    for (const AttrRow &row : mAttrs)
        if (row.tag == tag && (row.use & Attr_Copy))
            return &row;
    return nullptr;
}

bool LabelledInputControl::CopyAttr(Tag tag, void *out)
{
    const AttrRow *row = out ? FindCopyRow(tag) : nullptr;
    if (!row)
        return InputControl::CopyAttr(tag, out);
    switch (row->kind) {
    case AttrKind::Bool:
        *static_cast<int32 *>(out) = *static_cast<const bool *>(row->field) ? 1 : 0;
        break;
    case AttrKind::Int:
        *static_cast<int32 *>(out) = *static_cast<const int32 *>(row->field);
        break;
    case AttrKind::UInt:
        *static_cast<int32 *>(out) = int32(*static_cast<const uint32 *>(row->field));
        break;
    case AttrKind::Double:
        *static_cast<float64 *>(out) = *static_cast<const float64 *>(row->field);
        break;
    case AttrKind::Text:
    case AttrKind::ID:
        return InputControl::CopyAttr(tag, out);
    }
    // False: the value was supplied.
    return false;
}

TagValue LabelledInputControl::ValueOf(const AttrRow &row)
{
    switch (row.kind) {
    case AttrKind::Bool:
        return *static_cast<const bool *>(row.field);
    case AttrKind::Int:
        return *static_cast<const int32 *>(row.field);
    case AttrKind::UInt:
        return *static_cast<const uint32 *>(row.field);
    case AttrKind::Double:
        return *static_cast<const float64 *>(row.field);
    case AttrKind::Text:
        return *static_cast<const OrbString *>(row.field);
    case AttrKind::ID:
        return static_cast<const OrbID *>(row.field)->c_str();
    }
    return 0;
}

bool LabelledInputControl::GetAttrsTagList(TagList &tags) const
{
    InputControl::GetAttrsTagList(tags);
    mTexts.AddTo(tags);
    for (const AttrRow &row : mAttrs)
        if (row.use & Attr_List)
            tags.Set(row.tag, ValueOf(row));
    return true;
}

// ---- texts ----

void LabelledInputControl::ReadTexts(const Input *input)
{
    mTexts.Read(input);
}

void LabelledInputControl::TakeTexts(const TagList &tags)
{
    mTexts.Take(tags);
}

void LabelledInputControl::ShowChild(QWidget *child)
{
    if (child->testAttribute(Qt::WA_WState_ExplicitShowHide) && child->isHidden())
        child->show();
}

void LabelledInputControl::ShowTexts()
{
    mLabel->setText(QString::fromStdString(mTexts.label.str()));
}

bool LabelledInputControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const bool wasDisabled = IsDisabled();
    InputControl::SetAttrsTagList(input, tags);
    TakeTexts(tags);
    if (mDisabledShowsWithTexts && IsDisabled() != wasDisabled)
        MarkTextsChanged();
    if (TextsChanged())
        NotifyChanged(nullptr, nullptr, nullptr);
    return true;
}

bool LabelledInputControl::AddInput(Input *input, const TagList *tags)
{
    if (!InputControl::AddInput(input, tags))
        return false;
    ReadTexts(input);
    return true;
}

bool LabelledInputControl::BindKeepingFirstTexts(Input *input, const TagList *tags)
{
    if (!InputControl::AddInput(input, tags))
        return false;
    if (GetCurrentInput() == input)
        ReadTexts(input);
    return true;
}

bool LabelledInputControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!InputControl::Open(host, rect, tags))
        return false;
    ShowTexts();
    mTexts.changed = false;
    return true;
}

bool LabelledInputControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen() && TextsChanged()) {
        ShowTexts();
        mTexts.changed = false;
    }
    return InputControl::UpdateDisplay(input, tags);
}

// ---- layout ----

const ScriptVal &LabelledInputControl::ClassLayout(const char *itemName)
{
    const std::string name(itemName ? itemName : "");
    ClassLayouts &layouts = Layouts();
    const auto known = layouts.descriptions.find(name);
    if (known != layouts.descriptions.end())
        return known->second;
    ++layouts.reads[name];
    return layouts.descriptions[name] = ReadLayoutItem(itemName);
}

int32 LabelledInputControl::LayoutReadCount(const char *itemName)
{
    const std::map<std::string, int32> &reads = Layouts().reads;
    const auto it = reads.find(itemName ? itemName : "");
    return it == reads.end() ? 0 : it->second;
}

void LabelledInputControl::PlaceChildren(const ScriptVal &description, bool expressionField)
{
    CreateLayout(description, true, nullptr);
    if (Layout::LayoutObj *where = FindLayoutObj("expression"); expressionField && where && where->AsContainer())
        CreateExpressionEdit(where->AsContainer(), 0);
}

} // namespace Orbane

// The read counter as the tests find it in the loaded library.
extern "C" __attribute__((visibility("default"))) int32 orbanecontrols_LayoutReadCount(const char *itemName)
{
    return Orbane::LabelledInputControl::LayoutReadCount(itemName);
}

#include "inputcontrols/ScriptValListControl.h"

#include "framework/ListTags.h"
#include "inputcontrols/ScriptValTreeWidget.h"

#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QHeaderView>
#include <QStyle>
#include <QStyleOptionViewItem>

#include <algorithm>

namespace Orbane {

namespace {

constexpr int32 kIndentation = 16;

// A tree shorter than one row shows nothing at all.
uint32 RowsFrom(const TagList &tags, uint32 def)
{
    return uint32(std::max<int64>(1, tags.GetLong(LC_Rows, def)));
}

} // namespace

ScriptValListControl::ScriptValListControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mTree(new ScriptValTreeWidget(this))
{
    mRows = RowsFrom(tags, kDefaultRows);
    AddAttr(LC_Rows, &mRows, Attr_CopyAndList);
    // The list's label is a plain one: it is cut at the right, not elided.
    Label()->setElideMode(ElideLabel::Elide_None);
    mTree->setObjectName("list");
    RegisterChild("list", mTree);
}

ScriptValListControl::~ScriptValListControl() = default;

bool ScriptValListControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    if (tags.FindQuery(LC_Rows)) {
        mRows = RowsFrom(tags, mRows);
        ApplyTreeHeight();
    }
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

void ScriptValListControl::SetupTree()
{
    mTree->setColumnCount(2);
    mTree->setHeaderLabels({QString(), QString()});
    mTree->setHeaderHidden(false);
    mTree->setSortingEnabled(true);
    mTree->sortByColumn(0, Qt::AscendingOrder);
    mTree->setSelectionMode(QAbstractItemView::ExtendedSelection);
    mTree->setSelectionBehavior(QAbstractItemView::SelectRows);
    mTree->setIndentation(kIndentation);
    mTree->setAlternatingRowColors(true);
    // SetSize shares the width out itself, leaving room for a scroll bar.
    mTree->header()->setStretchLastSection(false);
}

int32 ScriptValListControl::RowHeight() const
{
    QStyleOptionViewItem item;
    item.initFrom(mTree);
    item.font = mTree->font();
    item.fontMetrics = mTree->fontMetrics();
    item.features = QStyleOptionViewItem::HasDisplay;
    item.text = QStringLiteral("Xy");
    return mTree->style()->sizeFromContents(QStyle::CT_ItemViewItem, &item, QSize(), mTree).height();
}

void ScriptValListControl::Hold(Parameter *value)
{
    if (value != mHeldValue.get())
        mHeldValue = AutoParameter(AutoRef<Parameter>::Share(value));
}

void ScriptValListControl::ApplyTreeHeight()
{
    if (Layout::LayoutObj *list = FindLayoutObj("list")) {
        const int32 height = 2 * mTree->frameWidth() + RowHeight() * int32(mRows);
        list->SetAttrs(TagList{{INPA_LayoutHeight, height}});
    }
}

bool ScriptValListControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    Label()->setAlignment(Qt::AlignLeft);
    Label()->setWordWrap(false);
    ShowChild(Label());
    SetupTree();
    ShowChild(mTree);
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        Hold(now);
    }
    LoadLayout("Controls.ScriptValList.Layout");
    ApplyTreeHeight();
    // The tree shows the value from the start, not from the first change.
    UpdateDisplay(GetCurrentInput(), nullptr);
    return true;
}

bool ScriptValListControl::SetSize(int32 &width, int32 &height, const TagList *tags)
{
    const bool sized = LabelledInputControl::SetSize(width, height, tags);
    const int32 room =
        mTree->width() - 2 * mTree->frameWidth() - mTree->style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    const int32 keys = room * 2 / 5;
    mTree->setColumnWidth(0, keys);
    mTree->setColumnWidth(1, room - keys);
    return sized;
}

bool ScriptValListControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    // No gate: a table may change inside while the parameter stays the same.
    if (value)
        Hold(value);
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ScriptValListControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen()) {
        mTree->clear();
        const AutoParameter held = mHeldValue;
        if (const auto *table = dynamic_cast<const ScriptValParam *>(held.get()); table && table->Value.IsTable())
            mTree->Fill(mTree->invisibleRootItem(), table->Value, false);
    }
    return LabelledInputControl::UpdateDisplay(input, tags);
}

} // namespace Orbane

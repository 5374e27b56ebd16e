#include "inputcontrols/ListControl.h"

#include "framework/ListTags.h"
#include "inputcontrols/DisconnectWrite.h"

#include "orbane/ClassIDs.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/Number.h"

#include <QListWidget>
#include <QScopedValueRollback>

#include <algorithm>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.List.Layout";

int32 ItemOfRow(const QListWidgetItem *row)
{
    return row ? row->data(Qt::UserRole).toInt() : -1;
}

} // namespace

ListControl::ListControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mChoice(ItemChoice::IsIDVariant(reg, CLSID_InputControl_List)),
      mList(new QListWidget(this))
{
    mRows = std::max(1, tags.GetInt(LC_Rows, mRows));
    mAlphaSort = tags.GetBool(LC_AlphaSort, false);
    AddAttr(LC_Rows, &mRows, Attr_CopyAndList);
    AddAttr(LC_AlphaSort, &mAlphaSort, Attr_CopyAndList);
    mList->setObjectName("list");
    mList->setUniformItemSizes(true);
    connect(mList, SIGNAL(itemSelectionChanged()), this, SLOT(OnSelectionChanged()));
    RegisterChild("list", mList);
    Label()->setFocusProxy(mList);
    ClassLayout(kLayoutItem);
}

ListControl::~ListControl() = default;

bool ListControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const int32 rows = std::max(1, tags.GetInt(LC_Rows, mRows));
    const bool sort = tags.GetBool(LC_AlphaSort, mAlphaSort);
    if (sort != mAlphaSort) {
        mAlphaSort = sort;
        FillRows();
    }
    if (rows != mRows) {
        mRows = rows;
        FitRows();
    }
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ListControl::AddInput(Input *input, const TagList *tags)
{
    // The items belong to the first Input; further ones share them.
    if (IsFirstInput(input)) {
        mChoice.Read(input);
        mMulti = !IsIDVariant() && input->GetAttrs().GetBool(LCA_MultiSelect, false);
        mList->setSelectionMode(mMulti ? QAbstractItemView::ExtendedSelection : QAbstractItemView::SingleSelection);
        FillRows();
    }
    return BindKeepingFirstTexts(input, tags);
}

void ListControl::FillRows()
{
    const QScopedValueRollback<bool> showing(mShowing, true);
    mList->clear();
    const ComboItems &items = mChoice.Items();
    for (int32 index : items.RowOrder(mAlphaSort)) {
        auto *row = new QListWidgetItem(QString::fromStdString(items.Texts[std::size_t(index)].str()), mList);
        row->setData(Qt::UserRole, index);
        row->setToolTip(QString::fromStdString(items.SecondTexts[std::size_t(index)].str()));
        if (items.IsSeparator(index))
            row->setFlags(Qt::NoItemFlags);
    }
    FitRows();
    ShowChoice();
}

// The list is as high as its rows, however many items it has.
void ListControl::FitRows()
{
    const int32 rowHeight = std::max(mList->sizeHintForRow(0), mList->fontMetrics().height() + 2);
    mList->setFixedHeight(rowHeight * mRows + 2 * mList->frameWidth());
}

bool ListControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        if (const auto *number = dynamic_cast<const Number *>(now.get()); number && mMulti)
            mBits = ItemChoice::BitsOf(number->Value);
        else if (now)
            mSelection = mChoice.SelectionFor(now);
    }
    FitRows();
    ShowChoice();
    Label()->show();
    mList->show();
    PlaceChildren(ClassLayout(kLayoutItem), !IsIDVariant());
    return true;
}

void ListControl::ShowChoice()
{
    const QScopedValueRollback<bool> showing(mShowing, true);
    QListWidgetItem *current = nullptr;
    for (int row = 0; row < mList->count(); ++row) {
        QListWidgetItem *item = mList->item(row);
        const int32 index = ItemOfRow(item);
        const bool chosen = mMulti ? (mChoice.BitOf(index) & mBits) != 0 : index == mSelection;
        item->setSelected(chosen);
        if (chosen && !current)
            current = item;
    }
    if (current) {
        mList->setCurrentItem(current, QItemSelectionModel::NoUpdate);
        mList->scrollToItem(current);
    }
}

bool ListControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    if (mMulti) {
        const auto *number = dynamic_cast<const Number *>(value);
        const uint64 bits = number ? ItemChoice::BitsOf(number->Value) : 0;
        if (bits == mBits)
            return true;
        mBits = bits;
    } else if (!mChoice.Follow(value, mSelection)) {
        return true;
    }
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ListControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowChoice();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

uint64 ListControl::ChosenBits() const
{
    uint64 bits = 0;
    for (const QListWidgetItem *row : mList->selectedItems())
        bits |= mChoice.BitOf(ItemOfRow(row));
    return bits;
}

int32 ListControl::ChosenItem() const
{
    const QList<QListWidgetItem *> rows = mList->selectedItems();
    return rows.isEmpty() ? -1 : ItemOfRow(rows.front());
}

AutoParameter ListControl::ValueToWrite() const
{
    return mMulti ? AutoParameter(AutoNumber(float64(mBits))) : mChoice.ValueOf(mSelection);
}

// Each change of the selection by the user (a click, a key, a drag over
// rows ends each time the selection settles) is one undo step.
void ListControl::OnSelectionChanged()
{
    if (mShowing)
        return;
    if (mMulti) {
        const uint64 bits = ChosenBits();
        if (bits == mBits)
            return;
        mBits = bits;
    } else {
        const int32 index = ChosenItem();
        if (index == mSelection || !mChoice.IsChoosable(index))
            return;
        mSelection = index;
    }
    const TagList items = mMulti ? TagList() : mChoice.ItemTags(mSelection);
    SetInputs(ValueToWrite(), GetCurrentTime(), 0, false, items.IsEmpty() ? nullptr : &items);
    ResetUndo(nullptr);
}

bool ListControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (!mMulti)
        mChoice.WriteOnDisconnect(input, mSelection);
    else
        WriteOnDisconnect(input, float64(mBits));
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

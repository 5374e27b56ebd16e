#include "inputcontrols/CheckListControl.h"

#include "framework/CheckListTags.h"
#include "inputcontrols/DisconnectWrite.h"

#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/Number.h"

#include <QCheckBox>
#include <QToolButton>
#include <QVariant>

#include <algorithm>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.CheckList.Layout";

QString ToQString(const OrbString &s)
{
    return QString::fromStdString(s.str());
}

} // namespace

CheckListControl::CheckListControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mAllText("All"), mNoneText("None"), mAll(new QToolButton(this)),
      mNone(new QToolButton(this))
{
    ReadLook(tags);
    AddAttr(CLC_Columns, &mColumns, Attr_CopyAndList);
    AddAttr(CLC_SelectButtons, &mSelectButtons, Attr_CopyAndList);
    AddAttr(CLC_AlphaSort, &mAlphaSort, Attr_CopyAndList);
    ListAttr(CLCS_AllText, &mAllText);
    ListAttr(CLCS_NoneText, &mNoneText);
    mAll->setObjectName("all");
    mNone->setObjectName("none");
    connect(mAll, SIGNAL(clicked()), this, SLOT(OnAll()));
    connect(mNone, SIGNAL(clicked()), this, SLOT(OnNone()));
    RegisterChild("all", mAll);
    RegisterChild("none", mNone);
    ClassLayout(kLayoutItem);
}

CheckListControl::~CheckListControl() = default;

void CheckListControl::ReadLook(const TagList &tags)
{
    mColumns = std::max(1, tags.GetInt(CLC_Columns, mColumns));
    mSelectButtons = tags.GetBool(CLC_SelectButtons, mSelectButtons);
    mAlphaSort = tags.GetBool(CLC_AlphaSort, mAlphaSort);
    if (const char *all = tags.GetString(CLCS_AllText))
        mAllText = OrbString(all);
    if (const char *none = tags.GetString(CLCS_NoneText))
        mNoneText = OrbString(none);
}

bool CheckListControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const int32 columns = mColumns;
    const bool sort = mAlphaSort;
    ReadLook(tags);
    if (sort != mAlphaSort)
        MakeBoxes();
    if (IsOpen() && (sort != mAlphaSort || columns != mColumns))
        Arrange();
    mAll->setText(ToQString(mAllText));
    mNone->setText(ToQString(mNoneText));
    mAll->setVisible(IsOpen() && mSelectButtons);
    mNone->setVisible(IsOpen() && mSelectButtons);
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool CheckListControl::AddInput(Input *input, const TagList *tags)
{
    // The boxes belong to the first Input; further ones share them.
    if (IsFirstInput(input)) {
        mChoice.Read(input);
        MakeBoxes();
    }
    return BindKeepingFirstTexts(input, tags);
}

void CheckListControl::MakeBoxes()
{
    qDeleteAll(mBoxes);
    mBoxes.clear();
    const ComboItems &items = mChoice.Items();
    for (int32 index : items.RowOrder(mAlphaSort)) {
        if (items.IsSeparator(index))
            continue;
        auto *box = new QCheckBox(ToQString(items.Texts[std::size_t(index)]), this);
        box->setObjectName(QString("item%1").arg(mBoxes.size() + 1));
        box->setToolTip(ToQString(items.SecondTexts[std::size_t(index)]));
        box->setProperty("item", index);
        // A box whose value names no bit could never hold its state.
        box->setEnabled(mChoice.BitOf(index) != 0);
        connect(box, SIGNAL(clicked()), this, SLOT(OnBoxToggled()));
        mBoxes.push_back(box);
    }
}

// The boxes go into the description's "items" grid, mColumns to a row.
void CheckListControl::Arrange()
{
    PlaceChildren(ClassLayout(kLayoutItem), true);
    Layout::LayoutObj *where = FindLayoutObj("items");
    Layout::Container *grid = where ? where->AsContainer() : nullptr;
    if (!grid)
        return;
    for (std::size_t i = 0; i < mBoxes.size(); ++i) {
        QCheckBox *box = mBoxes[i];
        box->show();
        grid->AddAt(std::make_unique<Layout::LayoutObj>(OrbID(box->objectName().toStdString()), box),
                    int32(i) / mColumns, int32(i) % mColumns);
    }
}

bool CheckListControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (GetCurrentInput()) {
        const AutoNumber now(GetCurrentInput(), GetCurrentTime());
        if (now)
            mBits = ItemChoice::BitsOf(now->Value);
    }
    mAll->setText(ToQString(mAllText));
    mNone->setText(ToQString(mNoneText));
    mAll->setVisible(mSelectButtons);
    mNone->setVisible(mSelectButtons);
    Label()->show();
    ShowBits();
    Arrange();
    return true;
}

uint64 CheckListControl::AllBits() const
{
    uint64 bits = 0;
    for (const QCheckBox *box : mBoxes)
        bits |= mChoice.BitOf(box->property("item").toInt());
    return bits;
}

void CheckListControl::ShowBits()
{
    for (QCheckBox *box : mBoxes)
        box->setChecked((mChoice.BitOf(box->property("item").toInt()) & mBits) != 0);
}

bool CheckListControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number)
        return value ? true : LabelledInputControl::NotifyChanged(input, value, tags);
    const uint64 bits = ItemChoice::BitsOf(number->Value);
    if (bits == mBits)
        return true;
    mBits = bits;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool CheckListControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowBits();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void CheckListControl::Write(uint64 bits)
{
    if (bits != mBits) {
        mBits = bits;
        SetInputs(AutoNumber(float64(bits)), GetCurrentTime(), 0, false, nullptr);
        ResetUndo(nullptr);
    }
    // The write's notice finds the bits already shown here: show them now.
    ShowBits();
}

void CheckListControl::OnBoxToggled()
{
    const auto *box = qobject_cast<QCheckBox *>(sender());
    if (!box)
        return;
    const uint64 bit = mChoice.BitOf(box->property("item").toInt());
    Write(box->isChecked() ? mBits | bit : mBits & ~bit);
}

// Bits that no box shows (another tool's, or a box removed since) are kept.
void CheckListControl::OnAll()
{
    Write(mBits | AllBits());
}

void CheckListControl::OnNone()
{
    Write(mBits & ~AllBits());
}

bool CheckListControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, float64(mBits));
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

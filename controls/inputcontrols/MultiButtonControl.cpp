#include "inputcontrols/MultiButtonControl.h"

#include "framework/MultiButtonTags.h"
#include "inputcontrols/LookTags.h"

#include "orbane/ClassIDs.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"
#include "orbane/OrbColor.h"
#include "orbane/ResDIB.h"

#include <QKeyEvent>
#include <QToolButton>
#include <QVariant>

#include <algorithm>

namespace Orbane {

namespace {

// Room a separator leaves between two buttons.
constexpr int32 kGapWidth = 8;
// Room of the label beside the buttons, as the layout gives it at most.
constexpr int32 kLabelRoom = 116;
// The value a plain row writes for no choice: no item is within reach of it
// unless one is given this value.
constexpr float64 kNoChoice = -1.0;

QString ColorName(uint32 packed)
{
    const OrbColor c(packed);
    return QColor(c.R(), c.G(), c.B(), c.A()).name(QColor::HexArgb);
}

} // namespace

MultiButtonControl::MultiButtonControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mChoice(ItemChoice::IsIDVariant(reg, CLSID_InputControl_MultiButton))
{
    mLook.checkedColor = mLook.checkedTextColor = mLook.textColor = mLook.buttonColor = OrbColor::None;
    ReadLook(tags);
    AddLookAttrs();
    ClassLayout(LayoutItem());
}

MultiButtonControl::~MultiButtonControl() = default;

void MultiButtonControl::AddLookAttrs()
{
    const std::pair<Tag, const int32 *> ints[] = {
        {MBTNC_Columns, &mLook.columns},
        {MBTNC_WidthMode, &mLook.widthMode},
        {MBTNC_MinButtonWidth, &mLook.minWidth},
        {MBTNC_MaxButtonWidth, &mLook.maxWidth},
        {MBTNC_ButtonHeight, &mLook.height},
        {MBTNC_HSpacing, &mLook.hSpacing},
        {MBTNC_VSpacing, &mLook.vSpacing},
        {MBTNC_Align, &mLook.align},
        {MBTNC_LabelPosition, &mLook.labelPosition},
        {MBTNC_IconSize, &mLook.iconSize},
        {MBTNC_IconPosition, &mLook.iconPosition},
    };
    for (const auto &[tag, field] : ints)
        AddAttr(tag, field, Attr_CopyAndList);
    const std::pair<Tag, const bool *> bools[] = {
        {MBTNC_ShowLabel, &mLook.showLabel},         {MBTNC_AlphaSort, &mLook.alphaSort},
        {MBTNC_IconsOnly, &mLook.iconsOnly},         {MBTNC_Flat, &mLook.flat},
        {MBTNC_AllowNone, &mLook.allowNone},         {MBTNC_BoldChosen, &mLook.boldChosen},
        {MBTNC_KeyNavigation, &mLook.keyNavigation},
    };
    for (const auto &[tag, field] : bools)
        AddAttr(tag, field, Attr_CopyAndList);
    const std::pair<Tag, const uint32 *> colors[] = {
        {MBTNC_CheckedColor, &mLook.checkedColor},
        {MBTNC_CheckedTextColor, &mLook.checkedTextColor},
        {MBTNC_TextColor, &mLook.textColor},
        {MBTNC_ButtonColor, &mLook.buttonColor},
    };
    for (const auto &[tag, field] : colors)
        AddAttr(tag, field, Attr_CopyAndList);
    ListAttr(MBTNCS_Tooltip, &mLook.tooltip);
    ListAttr(MBTNCS_UndoName, &mLook.undoName);
}

void MultiButtonControl::ReadLook(const TagList &tags)
{
    Look &l = mLook;
    l.columns = std::max(0, tags.GetInt(MBTNC_Columns, l.columns));
    l.widthMode = std::clamp(tags.GetInt(MBTNC_WidthMode, l.widthMode), int32(Width_Fill), int32(Width_Text));
    l.minWidth = std::max(0, tags.GetInt(MBTNC_MinButtonWidth, l.minWidth));
    l.maxWidth = std::max(0, tags.GetInt(MBTNC_MaxButtonWidth, l.maxWidth));
    l.height = std::max(0, tags.GetInt(MBTNC_ButtonHeight, l.height));
    l.hSpacing = std::max(0, tags.GetInt(MBTNC_HSpacing, l.hSpacing));
    l.vSpacing = std::max(0, tags.GetInt(MBTNC_VSpacing, l.vSpacing));
    l.align = tags.GetInt(MBTNC_Align, l.align);
    l.labelPosition = tags.GetInt(MBTNC_LabelPosition, l.labelPosition) == 1 ? 1 : 0;
    l.iconSize = std::max(1, tags.GetInt(MBTNC_IconSize, l.iconSize));
    l.iconPosition = tags.GetInt(MBTNC_IconPosition, l.iconPosition) == 1 ? 1 : 0;
    l.showLabel = tags.GetBool(MBTNC_ShowLabel, l.showLabel);
    l.alphaSort = tags.GetBool(MBTNC_AlphaSort, l.alphaSort);
    l.iconsOnly = tags.GetBool(MBTNC_IconsOnly, l.iconsOnly);
    l.flat = tags.GetBool(MBTNC_Flat, l.flat);
    l.allowNone = tags.GetBool(MBTNC_AllowNone, l.allowNone);
    l.boldChosen = tags.GetBool(MBTNC_BoldChosen, l.boldChosen);
    l.keyNavigation = tags.GetBool(MBTNC_KeyNavigation, l.keyNavigation);
    l.checkedColor = uint32(tags.GetLong(MBTNC_CheckedColor, l.checkedColor));
    l.checkedTextColor = uint32(tags.GetLong(MBTNC_CheckedTextColor, l.checkedTextColor));
    l.textColor = uint32(tags.GetLong(MBTNC_TextColor, l.textColor));
    l.buttonColor = uint32(tags.GetLong(MBTNC_ButtonColor, l.buttonColor));
    if (const char *tip = tags.GetString(MBTNCS_Tooltip))
        l.tooltip = OrbString(tip);
    if (const char *name = tags.GetString(MBTNCS_UndoName))
        l.undoName = OrbString(name);
}

const char *MultiButtonControl::LayoutItem() const
{
    return mLook.labelPosition == 1 ? "Controls.MultiButton.Layout.Vertical" : "Controls.MultiButton.Layout.Horizontal";
}

// The icon, disabled and new-row tags of each button, by the same item
// index as the shared lists (separators count).
void MultiButtonControl::ReadExtras(const TagList &attrs)
{
    mExtras.clear();
    bool open = false;
    for (const TagItem *item = attrs.First(); item; item = attrs.Next(item)) {
        if (item->tag == MBTNCS_AddButton || item->tag == MBTNCS_AddSeparator) {
            mExtras.emplace_back();
            open = item->tag == MBTNCS_AddButton;
        } else if (open && item->tag == MBTNCS_ButtonIcon && item->kind == TagKind::Text) {
            mExtras.back().icon = item->s;
        } else if (open && item->tag == MBTNC_ButtonDisabled && item->kind == TagKind::Long) {
            mExtras.back().disabled = item->l != 0;
        } else if (open && item->tag == MBTNC_ButtonNewRow && item->kind == TagKind::Long) {
            mExtras.back().newRow = item->l != 0;
        }
    }
}

bool MultiButtonControl::AddInput(Input *input, const TagList *tags)
{
    // The buttons belong to the first Input; further ones share them.
    if (IsFirstInput(input)) {
        mChoice.Read(input);
        {
            const LockableObject::ReadGuard guard(*input);
            ReadExtras(input->GetAttrs());
        }
        MakeButtons();
    }
    return BindKeepingFirstTexts(input, tags);
}

void MultiButtonControl::MakeButtons()
{
    qDeleteAll(mButtons);
    mButtons.clear();
    mShown = mChoice.Items().RowOrder(mLook.alphaSort);
    for (int32 index : mShown) {
        if (mChoice.Items().IsSeparator(index))
            continue;
        auto *button = new QToolButton(this);
        button->setObjectName(QString("button%1").arg(mButtons.size() + 1));
        button->setCheckable(true);
        button->setProperty("item", index);
        button->installEventFilter(this);
        connect(button, SIGNAL(clicked()), this, SLOT(OnButtonClicked()));
        mButtons.push_back(button);
    }
}

QString MultiButtonControl::StyleSheet() const
{
    QString normal, checked;
    if (!OrbColor(mLook.buttonColor).IsNone())
        normal += "background-color: " + ColorName(mLook.buttonColor) + ";";
    if (!OrbColor(mLook.textColor).IsNone())
        normal += "color: " + ColorName(mLook.textColor) + ";";
    if (!OrbColor(mLook.checkedColor).IsNone())
        checked += "background-color: " + ColorName(mLook.checkedColor) + ";";
    if (!OrbColor(mLook.checkedTextColor).IsNone())
        checked += "color: " + ColorName(mLook.checkedTextColor) + ";";
    QString sheet;
    if (!normal.isEmpty())
        sheet += "QToolButton { " + normal + " }";
    if (!checked.isEmpty())
        sheet += " QToolButton:checked { " + checked + " }";
    return sheet;
}

void MultiButtonControl::StyleButton(QToolButton *button, int32 index) const
{
    const ComboItems &items = mChoice.Items();
    const std::size_t i = std::size_t(index);
    const ButtonExtras extras = i < mExtras.size() ? mExtras[i] : ButtonExtras();
    const QString text = QString::fromStdString(items.Texts[i].str());
    const QString tip = QString::fromStdString(items.SecondTexts[i].str());
    const ResDIB *icon = extras.icon.IsEmpty() ? nullptr : ResDIB::Find(OrbID(extras.icon.str()));
    button->setText(text);
    button->setIcon(icon ? QIcon(icon->Pixmap(devicePixelRatioF())) : QIcon());
    button->setIconSize(QSize(mLook.iconSize, mLook.iconSize));
    const bool iconOnly = icon && mLook.iconsOnly;
    button->setToolButtonStyle(!icon                     ? Qt::ToolButtonTextOnly
                               : iconOnly                ? Qt::ToolButtonIconOnly
                               : mLook.iconPosition == 1 ? Qt::ToolButtonTextUnderIcon
                                                         : Qt::ToolButtonTextBesideIcon);
    // A button that shows no text names itself in its tip.
    button->setToolTip(iconOnly && tip.isEmpty() ? text : tip);
    button->setEnabled(!extras.disabled);
    button->setAutoRaise(mLook.flat);
    button->setSizePolicy(mLook.widthMode == Width_Fill ? QSizePolicy::Expanding : QSizePolicy::Fixed,
                          QSizePolicy::Fixed);
    button->setMinimumWidth(mLook.minWidth);
    button->setMaximumWidth(mLook.maxWidth > 0 ? mLook.maxWidth : QWIDGETSIZE_MAX);
    if (mLook.height > 0)
        button->setFixedHeight(mLook.height);
}

void MultiButtonControl::StyleButtons()
{
    const QString sheet = StyleSheet();
    int32 widest = 0;
    for (QToolButton *button : mButtons) {
        StyleButton(button, button->property("item").toInt());
        // A style sheet, even an empty one, costs a polish of its own.
        if (!sheet.isEmpty() || !button->styleSheet().isEmpty())
            button->setStyleSheet(sheet);
        widest = std::max(widest, button->sizeHint().width());
    }
    if (mLook.widthMode == Width_Equal)
        for (QToolButton *button : mButtons)
            button->setMinimumWidth(std::max(mLook.minWidth, widest));
    Label()->setVisible(mLook.showLabel);
    Label()->setToolTip(QString::fromStdString(mLook.tooltip.str()));
}

bool MultiButtonControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadLook(tags);
    if (IsOpen()) {
        StyleButtons();
        if (GetLayout())
            Arrange(mColumnsShown);
    }
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool MultiButtonControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    mSelection = mChoice.SelectionAt(GetCurrentInput(), GetCurrentTime(), mSelection);
    StyleButtons();
    for (QToolButton *button : mButtons)
        button->show();
    // Rows that follow the width are laid out when the width is known.
    if (mLook.columns > 0)
        Arrange(mLook.columns);
    ShowChoice();
    return true;
}

// As many buttons a row as the width holds at the width the buttons ask
// for, where the tags do not fix the count.
int32 MultiButtonControl::ColumnsFor(int32 width) const
{
    const int32 count = int32(mButtons.size());
    if (mLook.columns > 0 || count == 0)
        return std::max(1, mLook.columns > 0 ? mLook.columns : count);
    int32 widest = mLook.minWidth;
    for (const QToolButton *button : mButtons)
        widest = std::max(widest, button->sizeHint().width());
    const bool beside = mLook.showLabel && mLook.labelPosition == 0;
    const int32 room = width - (beside ? kLabelRoom : 0);
    return std::clamp((room + mLook.hSpacing) / std::max(1, widest + mLook.hSpacing), 1, count);
}

// Builds the layout again with the buttons in a grid of `columns`.
void MultiButtonControl::Arrange(int32 columns)
{
    mColumnsShown = std::max(1, columns);
    PlaceChildren(ClassLayout(LayoutItem()), !IsIDVariant());
    Layout::LayoutObj *where = FindLayoutObj("buttons");
    Layout::Container *grid = where ? where->AsContainer() : nullptr;
    if (!grid)
        return;
    grid->SetSpacing(mLook.hSpacing, mLook.vSpacing);
    if (mLook.widthMode != Width_Fill)
        grid->SetAlign(LookTags::AlignmentOf(mLook.align) | Qt::AlignVCenter);
    int32 row = 0, col = 0, next = 0;
    for (int32 index : mShown) {
        const std::size_t i = std::size_t(index);
        const bool gap = mChoice.Items().IsSeparator(index);
        if (col > 0 && (col >= mColumnsShown || (!gap && i < mExtras.size() && mExtras[i].newRow))) {
            ++row;
            col = 0;
        }
        if (gap) {
            auto obj = std::make_unique<Layout::LayoutObj>(OrbID(), nullptr);
            obj->SetFixedSize(kGapWidth, -1);
            grid->AddAt(std::move(obj), row, col++);
            continue;
        }
        QToolButton *button = mButtons[std::size_t(next++)];
        grid->AddAt(std::make_unique<Layout::LayoutObj>(OrbID(button->objectName().toStdString()), button), row, col++);
    }
}

bool MultiButtonControl::SetSize(int32 &width, int32 &height, const TagList *tags)
{
    const int32 columns = ColumnsFor(width);
    if (IsOpen() && (columns != mColumnsShown || !GetLayout()))
        Arrange(columns);
    return LabelledInputControl::SetSize(width, height, tags);
}

void MultiButtonControl::ShowChoice()
{
    for (QToolButton *button : mButtons) {
        const bool chosen = button->property("item").toInt() == mSelection;
        button->setChecked(chosen);
        LookTags::SetBold(button, chosen && mLook.boldChosen);
    }
}

bool MultiButtonControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (value && !mChoice.Follow(value, mSelection))
        return true;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool MultiButtonControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowChoice();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void MultiButtonControl::Choose(int32 index)
{
    if (index == mSelection) {
        ShowChoice();
        return;
    }
    mSelection = index;
    SetUndo(mLook.undoName.IsEmpty() ? nullptr : mLook.undoName.c_str(), nullptr);
    const TagList tags = mChoice.ItemTags(index);
    const AutoParameter value =
        index < 0 && !IsIDVariant() ? AutoParameter(AutoNumber(kNoChoice)) : mChoice.ValueOf(index);
    SetInputs(value, GetCurrentTime(), 0, false, tags.IsEmpty() ? nullptr : &tags);
    ResetUndo(nullptr);
    ShowChoice();
}

void MultiButtonControl::OnButtonClicked()
{
    const auto *button = qobject_cast<QToolButton *>(sender());
    if (!button)
        return;
    const int32 index = button->property("item").toInt();
    Choose(index == mSelection && mLook.allowNone ? -1 : index);
}

// The next enabled button in the order shown, `direction` 1 or -1.
bool MultiButtonControl::Step(QToolButton *from, int32 direction)
{
    const auto at = std::find(mButtons.begin(), mButtons.end(), from);
    if (at == mButtons.end())
        return false;
    for (auto i = (at - mButtons.begin()) + direction; i >= 0 && i < std::ptrdiff_t(mButtons.size()); i += direction) {
        QToolButton *to = mButtons[std::size_t(i)];
        if (to->isEnabled()) {
            to->setFocus(Qt::TabFocusReason);
            Choose(to->property("item").toInt());
            return true;
        }
    }
    return true;
}

bool MultiButtonControl::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::KeyPress && mLook.keyNavigation && !IsDisabled()) {
        const int key = static_cast<QKeyEvent *>(event)->key();
        if (key == Qt::Key_Left || key == Qt::Key_Right)
            return Step(qobject_cast<QToolButton *>(watched), key == Qt::Key_Left ? -1 : 1);
    }
    return LabelledInputControl::eventFilter(watched, event);
}

bool MultiButtonControl::OnDisconnect(Input *input, const TagList *tags)
{
    mChoice.WriteOnDisconnect(input, mSelection);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane

#pragma once

#include "framework/LabelledInputControl.h"
#include "inputcontrols/ItemChoice.h"

#include <vector>

class QToolButton;

namespace Orbane {

// A row of exclusive buttons, one per item, with a label. Registered twice
// like the combo box: the plain row (CLSID_InputControl_MultiButton) holds
// the chosen button's value as a number, the identifier variant
// (CLSID_InputControl_MultiButtonID) its identifier. Buttons flow into
// several rows when there are many (MBTNC_Columns, or as many as the width
// holds), each with a text or a skin icon and a tip. Scripts reach them as
// the children "button1" to "buttonN", in the order shown.
class MultiButtonControl : public LabelledInputControl
{
    Q_OBJECT
public:
    enum WidthMode : int32
    {
        Width_Fill = 0,  // the buttons share the width
        Width_Equal = 1, // every button as wide as the widest text
        Width_Text = 2,  // every button as wide as its own text
    };

    MultiButtonControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~MultiButtonControl() override;

    std::size_t SizeOf() const override { return sizeof(MultiButtonControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool SetSize(int32 &width, int32 &height, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    bool IsIDVariant() const { return mChoice.IsIDVariant(); }
    // The item shown chosen, -1 for none.
    int32 Selection() const { return mSelection; }
    // Buttons per row as laid out last.
    int32 ColumnsShown() const { return mColumnsShown; }

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private slots:
    void OnButtonClicked();

private:
    // What the look tags say, read at creation and on every SetAttrs.
    struct Look
    {
        int32 columns = 0;
        int32 widthMode = Width_Fill;
        int32 minWidth = 0;
        int32 maxWidth = 0;
        int32 height = 0;
        int32 hSpacing = 2;
        int32 vSpacing = 2;
        int32 align = 0;
        int32 labelPosition = 0;
        int32 iconSize = 16;
        int32 iconPosition = 0;
        bool showLabel = true;
        bool alphaSort = false;
        bool iconsOnly = false;
        bool flat = false;
        bool allowNone = false;
        bool boldChosen = false;
        bool keyNavigation = true;
        uint32 checkedColor;
        uint32 checkedTextColor;
        uint32 textColor;
        uint32 buttonColor;
        OrbString tooltip;
        OrbString undoName;
    };

    // What the item tags of a button add to the shared item lists.
    struct ButtonExtras
    {
        OrbString icon;
        bool disabled = false;
        bool newRow = false;
    };

    void AddLookAttrs();
    void ReadLook(const TagList &tags);
    void ReadExtras(const TagList &attrs);
    void MakeButtons();
    void StyleButtons();
    void StyleButton(QToolButton *button, int32 index) const;
    QString StyleSheet() const;
    int32 ColumnsFor(int32 width) const;
    void Arrange(int32 columns);
    void ShowChoice();
    void Choose(int32 index);
    bool Step(QToolButton *from, int32 direction);
    const char *LayoutItem() const;

    ItemChoice mChoice;
    std::vector<ButtonExtras> mExtras;   // by item index
    std::vector<QToolButton *> mButtons; // in the order shown
    std::vector<int32> mShown;           // item index of each shown place (separators too)
    Look mLook;
    int32 mSelection = -1;
    int32 mColumnsShown = 0;
};

} // namespace Orbane

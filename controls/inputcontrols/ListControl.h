#pragma once

#include "framework/LabelledInputControl.h"
#include "inputcontrols/ItemChoice.h"

class QListWidget;

namespace Orbane {

// A list of items with a label, LC_Rows rows high and scrolling beyond,
// chosen with the mouse or the keys. Registered twice like the combo box:
// the plain list (CLSID_InputControl_List) holds the chosen item's value as
// a number, the identifier variant (CLSID_InputControl_ListID) its
// identifier. With the Input attribute LCA_MultiSelect the plain list lets
// several items be chosen and holds them as bits (ItemChoice::BitOf).
class ListControl : public LabelledInputControl
{
    Q_OBJECT
public:
    // Input attribute: several items may be chosen (plain list only).
    static constexpr Tag LCA_MultiSelect = 0x10050002;
    // Rows shown where LC_Rows is absent.
    static constexpr int32 kDefaultRows = 5;

    ListControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ListControl() override;

    std::size_t SizeOf() const override { return sizeof(ListControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    bool IsIDVariant() const { return mChoice.IsIDVariant(); }
    bool IsMultiSelect() const { return mMulti; }

private slots:
    void OnSelectionChanged();

private:
    void FillRows();
    void FitRows();
    void ShowChoice();
    uint64 ChosenBits() const;
    int32 ChosenItem() const;
    AutoParameter ValueToWrite() const;

    ItemChoice mChoice;
    int32 mRows = kDefaultRows;
    bool mAlphaSort = false;
    bool mMulti = false;
    bool mShowing = false; // the control itself changes the list's selection
    int32 mSelection = -1; // single choice
    uint64 mBits = 0;      // several chosen
    QListWidget *mList;
};

} // namespace Orbane

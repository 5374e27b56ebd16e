#pragma once

#include "framework/LabelledInputControl.h"
#include "inputcontrols/ItemChoice.h"

#include <vector>

class QCheckBox;
class QToolButton;

namespace Orbane {

// Named check boxes kept in one number Input: box n is a bit of the value
// (its CLCD_ItemBit, else its place among the boxes), so that a tool reads
// every state from one number. "All" and "None" set or clear every box in
// one step. Scripts reach the boxes as "item1" to "itemN" in the order
// shown, and the buttons as "all" and "none".
class CheckListControl : public LabelledInputControl
{
    Q_OBJECT
public:
    CheckListControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CheckListControl() override;

    std::size_t SizeOf() const override { return sizeof(CheckListControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // The bits of every box.
    uint64 AllBits() const;

private slots:
    void OnBoxToggled();
    void OnAll();
    void OnNone();

private:
    void ReadLook(const TagList &tags);
    void MakeBoxes();
    void Arrange();
    void ShowBits();
    void Write(uint64 bits);

    ItemChoice mChoice;
    std::vector<QCheckBox *> mBoxes; // in the order shown
    int32 mColumns = 1;
    bool mSelectButtons = true;
    bool mAlphaSort = false;
    OrbString mAllText;
    OrbString mNoneText;
    uint64 mBits = 0;
    QToolButton *mAll;
    QToolButton *mNone;
};

} // namespace Orbane

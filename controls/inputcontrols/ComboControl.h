#pragma once

#include "framework/LabelledInputControl.h"
#include "inputcontrols/ItemChoice.h"

#include "orbane/AutoParam.h"

namespace Orbane {

class OrbComboBox;

// Shows an Input as a drop-down list of items with a label. Registered
// twice: the plain combo box (CLSID_InputControl_Combo), whose Input holds
// the chosen item's value as a number, and the identifier variant
// (CLSID_InputControl_ComboID), whose Input holds the chosen item's
// identifier, as an identifier or, for a Text Input, as text. One class
// serves both and tells them apart by the class ID it was created as.
//
// While the list is open, the item under the mouse or the keyboard is
// written at once, so the user sees its effect before choosing; the choice
// (or Escape, which puts the value back) ends that gesture as one undo step.
class ComboControl : public LabelledInputControl
{
    Q_OBJECT
public:
    // Sent with every write, in the tag list that reaches each control of
    // the Input: the chosen item's integer (0x18040000) where it is not 0,
    // and its pointer (0x68040000) where it is not null.
    static constexpr Tag CCA_ItemInteger = ItemChoice::ItemIntegerSent;
    static constexpr Tag CCAP_ItemPointer = ItemChoice::ItemPointerSent;

    ComboControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ComboControl() override;

    std::size_t SizeOf() const override { return sizeof(ComboControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    bool IsIDVariant() const { return mChoice.IsIDVariant(); }

protected:
    // The label shows the label text, with the second text as its tip.
    void ShowTexts() override;

private slots:
    void OnCombo(int row);
    void TestCombo(int row);
    void PopupShow();
    void PopupHide();
    void EndPopup();

private:
    void FillRows();
    void ShowSelection();
    void Select(int row, bool final);
    bool Write(int32 index, float64 time);

    ItemChoice mChoice;
    int32 mSelection = -1;
    bool mAlphaSort = false;
    int32 mLabelPosition = 0;
    // The list is open: highlighted items are written as previews.
    bool mLivePreview = false;
    // A preview write is running.
    bool mPreviewing = false;
    // The open list's gesture has not been ended by a choice yet.
    bool mGesture = false;
    AutoParameter mBeforePopup;
    OrbComboBox *mCombo;
};

} // namespace Orbane

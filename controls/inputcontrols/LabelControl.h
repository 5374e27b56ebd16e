#pragma once

#include "framework/LabelledInputControl.h"

#include <vector>

class QFrame;
class QToolButton;

namespace Orbane {

// A text in the inspector, and, as a group header, the fold that shows and
// hides the Inputs under it. Registered four times: the label
// (CLSID_InputControl_Label), the nest (CLSID_InputControl_Nest, a header
// that always folds), the separator (a thin line) and the spacer (an empty
// row of LBLC_Height pixels); one class tells them apart by its class ID.
//
// The open state is the Input's value (1 open, 0 closed), so each tool
// keeps its own and every control of the Input follows it. Folding is a
// change of the view, not an edit: it is written without undo. The group is
// the LBLC_NumInputs Inputs after the header's, inner groups included; the
// inspector hides their rows. Ctrl-click opens or closes every group of
// the tool alike.
class LabelControl : public LabelledInputControl
{
    Q_OBJECT
public:
    enum Variant : uint8
    {
        Variant_Label,
        Variant_Nest,
        Variant_Separator,
        Variant_Spacer,
    };

    // Pixels of indentation per nest level.
    static constexpr int32 kIndentStep = 12;
    // Height of a spacer, and room of a separator, where LBLC_Height is absent.
    static constexpr int32 kDefaultHeight = 8;

    LabelControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~LabelControl() override;

    std::size_t SizeOf() const override { return sizeof(LabelControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    Variant GetVariant() const { return mVariant; }
    bool Folds() const;
    bool IsExpanded() const { return mExpanded; }
    // The Inputs of the group, in the tool's order.
    std::vector<Input *> GroupInputs() const;
    // Opens or closes the group as a click on the header does.
    void SetExpanded(bool expanded);

protected:
    void ShowTexts() override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private slots:
    void OnHeaderClicked();

private:
    void ReadLook(const TagList &tags);
    void ApplyLook();
    void ApplyFold();
    void FoldAll(bool expanded);

    Variant mVariant;
    bool mDropDown = false;
    bool mExpanded = true;
    bool mHiding = false; // the inspector hides the group for this control
    bool mBold = false;
    int32 mNumInputs = 0;
    int32 mNestLevel = 0;
    int32 mAlign = 0;
    int32 mHeight = kDefaultHeight;
    uint32 mTextColor;
    uint32 mLineColor;
    OrbString mTooltip;
    Qt::KeyboardModifiers mPressModifiers;
    QToolButton *mHeader;
    QFrame *mLine;
    QWidget *mSpace;
};

} // namespace Orbane

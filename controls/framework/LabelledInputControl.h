#pragma once

#include "framework/LabelTexts.h"

#include "orbane/InputControl.h"

#include <vector>

namespace Orbane {

class ElideLabel;

// The base of the inspector controls that show a label beside their own
// child: it owns the label widget (an ElideLabel registered with the layout
// as "label", eliding at the right), the label texts and their redisplay, the
// class layout descriptions (read from the look pack once per process), and
// the control's own readable attributes as rows of a table.
//
// A control derived from it:
// - in its constructor, registers its own children, sets the label's focus
//   proxy, adds a row per readable attribute (AddAttr, ListAttr) and asks for
//   its class layout (ClassLayout) so that the first instance reads it;
// - in Open, calls this Open first (the host's Open, then the texts shown),
//   then sets up its children and calls PlaceChildren with its layout;
// - overrides ShowTexts where the texts go elsewhere than the label;
// - reads its own tags in SetAttrsTagList and then calls this one, which
//   takes the label texts and asks for a redisplay where they changed.
//
// Like InputControl it adds no base of its own, so the script-visible root
// stays at the start of every control.
class LabelledInputControl : public InputControl
{
    Q_OBJECT
public:
    LabelledInputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~LabelledInputControl() override;

    std::size_t SizeOf() const override { return sizeof(LabelledInputControl); }
    // A row marked for copying writes its value (an integer as int32, a
    // number as float64) and answers false, as the host expects of a supplied
    // value; other tags go to the host.
    bool CopyAttr(Tag tag, void *out) override;
    // The host's attributes, the label texts, then the rows marked for listing.
    bool GetAttrsTagList(TagList &tags) const override;

    using InputControl::SetAttrsTagList;
    // The host's attributes, then the label texts of the list (where its tags
    // are present); a change of the texts asks for a redisplay.
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    // Binds the Input and takes the label texts from its attributes.
    bool AddInput(Input *input, const TagList *tags) override;
    // The host's Open, then the texts shown.
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    // Texts changed since they were shown are shown again; then the host's.
    bool UpdateDisplay(Input *input, const TagList *tags) override;

    const LabelTexts &GetLabelTexts() const { return mTexts; }

    // How often a class layout item was read from the look pack in this
    // process: tests check that each class reads its description once.
    static int32 LayoutReadCount(const char *itemName);

protected:
    // How a row's attribute is offered: to CopyAttr, to GetAttrsTagList, or both.
    enum AttrUse : uint8
    {
        Attr_Copy = 1,
        Attr_List = 2,
        Attr_CopyAndList = Attr_Copy | Attr_List,
    };

    // Rows of the attribute table, pointing at the control's own fields, in
    // the order GetAttrsTagList lists them. Add them in the constructor.
    void AddAttr(Tag tag, const bool *field, AttrUse use);
    void AddAttr(Tag tag, const int32 *field, AttrUse use);
    void AddAttr(Tag tag, const uint32 *field, AttrUse use);
    void AddAttr(Tag tag, const float64 *field, AttrUse use);
    // Texts are listed only; an identifier is listed as its text.
    void ListAttr(Tag tag, const OrbString *field);
    void ListAttr(Tag tag, const OrbID *field);

    // The class layout description in the look-pack item `itemName` (key 1
    // of its table), read by the first call in the process and kept.
    static const ScriptVal &ClassLayout(const char *itemName);
    // Shows a child at Open. A child never hidden shows with the control
    // already; showing it on its own would have Qt guess its size from its
    // size hint (measuring its text), only for the layout to place it anew.
    static void ShowChild(QWidget *child);
    // Builds the layout from `description` and, with `expressionField`,
    // places the Input's expression field in its "expression" container.
    void PlaceChildren(const ScriptVal &description, bool expressionField);

    // Shows the texts; by default the label shows the label text.
    virtual void ShowTexts();

    ElideLabel *Label() const { return mLabel; }
    // The rule of AddInput, for controls that bind otherwise.
    void ReadTexts(const Input *input);
    // Binds with the host's AddInput, taking the texts of the first Input
    // only: for controls whose items, too, are the first Input's (read them
    // before, while IsFirstInput).
    bool BindKeepingFirstTexts(Input *input, const TagList *tags);
    bool IsFirstInput(const Input *input) const { return input && !GetCurrentInput(); }
    // The texts of a tag list, as SetAttrsTagList takes them.
    void TakeTexts(const TagList &tags);
    // Something else that ShowTexts shows has changed.
    void MarkTextsChanged() { mTexts.changed = true; }
    bool TextsChanged() const { return mTexts.changed; }
    // From now on a change of the disabled state is shown the way a change
    // of the texts is (a control whose texts show the state).
    void ShowDisabledWithTexts() { mDisabledShowsWithTexts = true; }

private:
    enum class AttrKind : uint8
    {
        Bool,
        Int,
        UInt,
        Double,
        Text,
        ID
    };

    struct AttrRow
    {
        Tag tag;
        AttrKind kind;
        AttrUse use;
        const void *field;
    };

    const AttrRow *FindCopyRow(Tag tag) const;
    static TagValue ValueOf(const AttrRow &row);

    ElideLabel *mLabel;
    LabelTexts mTexts;
    bool mDisabledShowsWithTexts = false;
    std::vector<AttrRow> mAttrs;
};

} // namespace Orbane

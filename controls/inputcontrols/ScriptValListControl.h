#pragma once

#include "orbane/AutoParam.h"
#include "orbane/InputControl.h"
#include "orbane/LabelTexts.h"

class QLabel;

namespace Orbane {

class ScriptValTreeWidget;

// Shows an Input whose value is a script table (metadata, say) as a
// read-only two-column tree of keys and values under a label, sorted by key.
// The user may select rows and copy them as tab-separated text. The tree is
// LC_Rows rows tall (6 by default) and scrolls beyond that.
class ScriptValListControl : public InputControl
{
    Q_OBJECT
public:
    static constexpr uint32 kDefaultRows = 6;

    ScriptValListControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ScriptValListControl() override;

    std::size_t SizeOf() const override { return sizeof(ScriptValListControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool SetSize(int32 &width, int32 &height, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;

    uint32 GetRows() const { return mRows; }
    // The height of one row of the tree, as its style draws an item.
    int32 RowHeight() const;

private:
    void SetupTree();
    void Hold(Parameter *value);
    void ApplyTreeHeight();

    AutoParameter mHeldValue;
    ScriptValTreeWidget *mTree;
    QLabel *mLabel;
    uint32 mRows = kDefaultRows;
    LabelTexts mTexts;
};

} // namespace Orbane

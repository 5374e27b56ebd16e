#pragma once

#include "framework/LabelledInputControl.h"

#include "orbane/AutoParam.h"

namespace Orbane {

class ScriptValTreeWidget;

// Shows an Input whose value is a script table (metadata, say) as a
// read-only two-column tree of keys and values under a label, sorted by key.
// The user may select rows and copy them as tab-separated text. The tree is
// LC_Rows rows tall (6 by default) and scrolls beyond that.
class ScriptValListControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr uint32 kDefaultRows = 6;

    ScriptValListControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ScriptValListControl() override;

    std::size_t SizeOf() const override { return sizeof(ScriptValListControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
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
    uint32 mRows = kDefaultRows;
};

} // namespace Orbane

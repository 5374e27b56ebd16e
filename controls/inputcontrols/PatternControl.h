#pragma once

#include "framework/LabelledInputControl.h"
#include "widgets/PatternSwatch.h"

#include "orbane/OrbColor.h"

#include <array>

namespace Orbane {

// A chooser of tiled patterns on a Number Input (the pattern's index): a
// row of painted previews, "pattern1" .. "pattern6", the chosen one framed.
// A click chooses (one undo step). A value that names no pattern (out of
// range, NaN) frames none and says so in the tip, until the user chooses.
class PatternControl : public LabelledInputControl
{
    Q_OBJECT
public:
    PatternControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PatternControl() override;

    std::size_t SizeOf() const override { return sizeof(PatternControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void OnClicked(int pattern);

private:
    void ReadOwnTags(const TagList &tags);
    void ShowValue();

    float64 mValue = 0.0;
    int32 mTile = 8;
    uint32 mInk = OrbColor(230, 230, 230).Packed();
    std::array<PatternSwatch *, PatternSwatch::PatternCount> mSwatches{};
};

} // namespace Orbane

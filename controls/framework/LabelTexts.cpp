#include "framework/LabelTexts.h"

#include "orbane/InputControl.h"
#include "orbane/TagList.h"

namespace Orbane {

namespace {

// Takes the text of `tag` where the list has it; true where it differs.
bool TakeText(const TagList &tags, Tag tag, OrbString &text)
{
    if (!tags.FindQuery(tag))
        return false;
    const OrbString given(tags.GetString(tag, ""));
    const bool differs = given != text;
    text = given;
    return differs;
}

} // namespace

void LabelTexts::Read(const Input *input)
{
    label = InputControl::LabelOf(input);
    second = InputControl::SecondLabelOf(input);
}

void LabelTexts::Take(const TagList &tags)
{
    const Tag labelTag = tags.FindQuery(LINKS_Name) ? Tag(LINKS_Name) : Tag(INPA_Name);
    const bool labelChanged = TakeText(tags, labelTag, label);
    const bool secondChanged = TakeText(tags, LINKS_SecondName, second);
    changed = changed || labelChanged || secondChanged;
}

void LabelTexts::AddTo(TagList &tags) const
{
    tags.Set(LINKS_Name, label);
    tags.Set(LINKS_SecondName, second);
}

} // namespace Orbane

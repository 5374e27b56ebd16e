#include "orbane/TagList.h"

#include "orbane/ScriptObject.h"

#include <functional>

namespace Orbane {

namespace {

void Retain(const TagItem &item)
{
    if (item.kind == TagKind::Object && item.obj)
        item.obj->IncRef();
}

void Drop(const TagItem &item)
{
    if (item.kind == TagKind::Object && item.obj)
        item.obj->DecRef();
}

TagItem Stored(Tag tag, const TagValue &value)
{
    TagItem item = value.item();
    item.tag = tag;
    Retain(item);
    return item;
}

} // namespace

TagList::TagList(std::initializer_list<std::pair<Tag, TagValue>> items)
{
    mItems.reserve(items.size());
    for (const auto &[tag, value] : items)
        Add(tag, value);
}

TagList::TagList(const TagList &o) : mItems(o.mItems)
{
    for (const TagItem &item : mItems)
        Retain(item);
}

TagList::TagList(TagList &&o) noexcept : mItems(std::move(o.mItems))
{
    o.mItems.clear();
}

TagList &TagList::operator=(const TagList &o)
{
    if (this != &o) {
        TagList copy(o);
        *this = std::move(copy);
    }
    return *this;
}

TagList &TagList::operator=(TagList &&o) noexcept
{
    if (this != &o) {
        Clear();
        mItems = std::move(o.mItems);
        o.mItems.clear();
    }
    return *this;
}

TagList::~TagList()
{
    Clear();
}

void TagList::Add(Tag tag, const TagValue &value)
{
    mItems.push_back(Stored(tag, value));
}

void TagList::Set(Tag tag, const TagValue &value)
{
    for (TagItem &item : mItems) {
        if (item.tag == tag) {
            TagItem old = item;
            item = Stored(tag, value);
            Drop(old);
            return;
        }
    }
    Add(tag, value);
}

int32 TagList::Remove(Tag tag)
{
    int32 removed = 0;
    for (auto it = mItems.begin(); it != mItems.end();) {
        if (it->tag == tag) {
            Drop(*it);
            it = mItems.erase(it);
            ++removed;
        } else {
            ++it;
        }
    }
    return removed;
}

void TagList::Clear()
{
    // Take the items first: a released object may reach this list again.
    std::vector<TagItem> items;
    items.swap(mItems);
    for (const TagItem &item : items)
        Drop(item);
}

void TagList::Append(const TagList &o)
{
    // Copy first, so that appending a list to itself is safe.
    std::vector<TagItem> items = o.mItems;
    for (TagItem &item : items) {
        Retain(item);
        mItems.push_back(std::move(item));
    }
}

bool TagList::KindFits(Tag tag, TagKind kind) noexcept
{
    // Other type bits promise nothing a Get* could read.
    switch (TagTypeOf(tag)) {
    case TAGTYPE_Long:
        return kind == TagKind::Long;
    case TAGTYPE_Double:
        return kind == TagKind::Double;
    case TAGTYPE_String:
        return kind == TagKind::Text;
    case TAGTYPE_Object:
        return kind == TagKind::Object;
    case TAGTYPE_Ptr:
        return kind == TagKind::Ptr;
    case TAGTYPE_ID:
        return kind == TagKind::ID;
    }
    return false;
}

const TagItem *TagList::Typed(Tag tag, TagKind kind) const
{
    if (!KindFits(tag, kind))
        return nullptr;
    const TagItem *item = Find(tag);
    return item && item->kind == kind ? item : nullptr;
}

int64 TagList::GetLong(Tag tag, int64 def) const
{
    const TagItem *item = Typed(tag, TagKind::Long);
    return item ? item->l : def;
}

int32 TagList::GetInt(Tag tag, int32 def) const
{
    const TagItem *item = Typed(tag, TagKind::Long);
    return item ? int32(item->l) : def;
}

bool TagList::GetBool(Tag tag, bool def) const
{
    const TagItem *item = Typed(tag, TagKind::Long);
    return item ? item->l != 0 : def;
}

float64 TagList::GetDouble(Tag tag, float64 def) const
{
    const TagItem *item = Typed(tag, TagKind::Double);
    return item ? item->d : def;
}

const char *TagList::GetString(Tag tag, const char *def) const
{
    const TagItem *item = Typed(tag, TagKind::Text);
    return item ? item->s.c_str() : def;
}

void *TagList::GetPtr(Tag tag, void *def) const
{
    const TagItem *item = Typed(tag, TagKind::Ptr);
    return item ? item->ptr : def;
}

ScriptObject *TagList::GetObject(Tag tag, ScriptObject *def) const
{
    const TagItem *item = Typed(tag, TagKind::Object);
    return item ? item->obj : def;
}

OrbID TagList::GetID(Tag tag, const OrbID &def) const
{
    const TagItem *item = Typed(tag, TagKind::ID);
    return item ? item->id : def;
}

const TagItem *TagList::Find(Tag tag) const
{
    for (const TagItem &item : mItems)
        if (item.tag == tag)
            return &item;
    return nullptr;
}

const TagItem *TagList::FindNext(const TagItem *after) const
{
    for (const TagItem *item = Next(after); item; item = Next(item))
        if (item->tag == after->tag)
            return item;
    return nullptr;
}

const TagItem *TagList::First() const
{
    return mItems.empty() ? nullptr : mItems.data();
}

const TagItem *TagList::Next(const TagItem *after) const
{
    // An item of another list (or none) ends the walk rather than running wild.
    const TagItem *begin = mItems.data();
    const TagItem *end = begin + mItems.size();
    std::less<const TagItem *> before;
    if (!after || before(after, begin) || !before(after, end))
        return nullptr;
    return after + 1 < end ? after + 1 : nullptr;
}

} // namespace Orbane

#pragma once

#include "orbane/OrbID.h"
#include "orbane/OrbString.h"
#include "orbane/Tags.h"

#include <initializer_list>
#include <vector>

namespace Orbane {

class ScriptObject;

// What a stored value really is. A Get* whose tag type disagrees with it
// answers its default.
enum class TagKind : uint8 { Long, Double, Text, Object, Ptr, ID };

// One (tag, value) pair. The value's type comes from the tag's top four bits;
// only the member that `kind` names is meaningful.
struct TagItem
{
    Tag tag = 0;
    TagKind kind = TagKind::Long;
    int64 l = 0;
    float64 d = 0.0;
    OrbString s;
    ScriptObject *obj = nullptr; // holds one reference
    void *ptr = nullptr;
    OrbID id;
};

// A value for building tag lists in one expression:
// TagList{{0x10050000, 1}, {0x30040000, "Label"}}.
class TagValue
{
public:
    TagValue(int v) : mItem(MakeLong(v)) {}
    TagValue(long v) : mItem(MakeLong(v)) {}
    TagValue(long long v) : mItem(MakeLong(v)) {}
    TagValue(unsigned v) : mItem(MakeLong(v)) {}
    TagValue(unsigned long v) : mItem(MakeLong(int64(v))) {}
    TagValue(bool v) : mItem(MakeLong(v ? 1 : 0)) {}
    TagValue(double v) { mItem.d = v; mItem.kind = TagKind::Double; }
    TagValue(const char *v) { mItem.s = v; mItem.kind = TagKind::Text; }
    TagValue(const std::string &v) { mItem.s = v; mItem.kind = TagKind::Text; }
    TagValue(const OrbString &v) { mItem.s = v; mItem.kind = TagKind::Text; }
    TagValue(const OrbID &v) { mItem.id = v; mItem.kind = TagKind::ID; }
    TagValue(ScriptObject *v) { mItem.obj = v; mItem.kind = TagKind::Object; }
    TagValue(void *v) { mItem.ptr = v; mItem.kind = TagKind::Ptr; }
    TagValue(const void *v) { mItem.ptr = const_cast<void *>(v); mItem.kind = TagKind::Ptr; }
    // Function pointers (factories, hooks) travel as pointers.
    template <class R, class... A>
    TagValue(R (*fn)(A...)) { mItem.ptr = reinterpret_cast<void *>(fn); mItem.kind = TagKind::Ptr; }

    const TagItem &item() const { return mItem; }

private:
    static TagItem MakeLong(int64 v) { TagItem t; t.l = v; return t; }
    TagItem mItem;
};

// An ordered list of (tag id, value). Repeatable tags keep list order; every
// Get* takes a default that is returned when the tag is absent or when its
// value is of another type than the tag id says.
class TagList
{
public:
    TagList() = default;
    TagList(std::initializer_list<std::pair<Tag, TagValue>> items);
    TagList(const TagList &o);
    TagList(TagList &&o) noexcept;
    TagList &operator=(const TagList &o);
    TagList &operator=(TagList &&o) noexcept;
    ~TagList();

    // Appends, even where the tag is already present.
    void Add(Tag tag, const TagValue &value);
    // Replaces the first occurrence, or appends.
    void Set(Tag tag, const TagValue &value);
    // Removes every occurrence; returns how many.
    int32 Remove(Tag tag);
    void Clear();
    // Appends every item of another list.
    void Append(const TagList &o);

    int64 GetLong(Tag tag, int64 def = 0) const;
    int32 GetInt(Tag tag, int32 def = 0) const;
    bool GetBool(Tag tag, bool def = false) const;
    float64 GetDouble(Tag tag, float64 def = 0.0) const;
    const char *GetString(Tag tag, const char *def = nullptr) const;
    void *GetPtr(Tag tag, void *def = nullptr) const;
    ScriptObject *GetObject(Tag tag, ScriptObject *def = nullptr) const;
    OrbID GetID(Tag tag, const OrbID &def = OrbID()) const;

    // Is the tag present (with any value)?
    bool FindQuery(Tag tag) const { return Find(tag) != nullptr; }
    // The first occurrence, then each next one in list order.
    const TagItem *Find(Tag tag) const;
    const TagItem *FindNext(const TagItem *after) const;
    // Plain walk over all items.
    const TagItem *First() const;
    const TagItem *Next(const TagItem *after) const;

    int32 Count() const noexcept { return int32(mItems.size()); }
    bool IsEmpty() const noexcept { return mItems.empty(); }
    const std::vector<TagItem> &Items() const noexcept { return mItems; }

    // Does the tag id's type promise values of this kind?
    static bool KindFits(Tag tag, TagKind kind) noexcept;

private:
    const TagItem *Typed(Tag tag, TagKind kind) const;
    std::vector<TagItem> mItems;
};

} // namespace Orbane

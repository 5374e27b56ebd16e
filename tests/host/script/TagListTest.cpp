#include "Counted.h"

#include "orbane/TagList.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Orbane {

namespace {

constexpr Tag kLong = 0x10050000;
constexpr Tag kDouble = 0x20050001;
constexpr Tag kText = 0x30050002;
constexpr Tag kObject = 0x40050003;
constexpr Tag kPtr = 0x60050004;
constexpr Tag kID = 0x80050005;
constexpr Tag kAddItem = 0x38040000;

std::vector<std::string> Texts(const TagList &tags, Tag tag)
{
    std::vector<std::string> texts;
    for (const TagItem *item = tags.Find(tag); item; item = tags.FindNext(item))
        texts.push_back(item->s.str());
    return texts;
}

} // namespace

// A value of the wrong kind, or of a tag whose type bits promise nothing,
// yields the default, as a missing tag does.
TEST(TagList, GettersGiveTheDefaultForAValueOfAnotherKind)
{
    const TagList wrong{{kLong, "not a number"}, {kDouble, 3}, {kText, 12},    {kObject, 5},
                        {kID, "text"},           {kPtr, 1.0},  {0x50050000, 9}};
    EXPECT_EQ(wrong.GetLong(kLong, -1), -1);
    EXPECT_DOUBLE_EQ(wrong.GetDouble(kDouble, 0.5), 0.5);
    EXPECT_STREQ(wrong.GetString(kText, "def"), "def");
    EXPECT_EQ(wrong.GetObject(kObject), nullptr);
    EXPECT_EQ(wrong.GetID(kID), OrbID());
    EXPECT_EQ(wrong.GetPtr(kPtr), nullptr);
    EXPECT_EQ(wrong.GetLong(0x50050000, 4), 4);
    EXPECT_EQ(wrong.GetID(0x80050099, OrbID("Def")), OrbID("Def")) << "a missing tag";
}

TEST(TagList, RepeatedTagsKeepListOrder)
{
    TagList tags;
    tags.Add(kAddItem, "First");
    tags.Add(kText, "Other");
    tags.Add(kAddItem, "Second");
    tags.Add(kAddItem, "Third");
    EXPECT_EQ(Texts(tags, kAddItem), (std::vector<std::string>{"First", "Second", "Third"}));
    EXPECT_STREQ(tags.GetString(kAddItem), "First");
    std::vector<Tag> walked;
    for (const TagItem *item = tags.First(); item; item = tags.Next(item))
        walked.push_back(item->tag);
    EXPECT_EQ(walked, (std::vector<Tag>{kAddItem, kText, kAddItem, kAddItem}));
    EXPECT_EQ((TagList{{kAddItem, "x"}}.FindNext(tags.First())), nullptr) << "walks end at items of another list";
}

TEST(TagList, ObjectReferencesAreCounted)
{
    int deaths = 0;
    auto *obj = new TestKit::Counted(&deaths);
    {
        TagList tags;
        tags.Add(kObject, obj);
        tags.Add(kObject, obj);
        TagList copy(tags);
        EXPECT_EQ(obj->RefCount(), 5);
        TagList moved(std::move(copy));
        EXPECT_EQ(obj->RefCount(), 5);
        tags.Remove(kObject);
        moved.Set(kObject, 7);
        EXPECT_EQ(obj->RefCount(), 2);
        tags = moved;
        EXPECT_EQ(obj->RefCount(), 3);
    }
    EXPECT_EQ(obj->RefCount(), 1);
    TagList last{{kObject, obj}};
    obj->DecRef();
    EXPECT_EQ(deaths, 0) << "the last reference may live in the list";
    last.Set(kObject, 1);
    EXPECT_EQ(deaths, 1) << "replacing the value released the object";
}

} // namespace Orbane

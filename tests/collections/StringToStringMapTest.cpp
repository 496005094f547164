#include "tarnkiln/collections/StringToStringMap.h"

#include "tests/support/ExpectRaises.h"

namespace tarn::kiln {
namespace {

using Map = StringToStringMap;

/// The values under `key`, sorted.
std::vector<ustring> valuesOf(Map const& map, ustring const& key)
{
    std::vector<ustring> result;
    for (auto const& [present, value] : map)
    {
        if (present == key)
            result.push_back(value);
    }
    std::sort(result.begin(), result.end());
    return result;
}

/// A map that belongs to no element.
class StringToStringMapSnapshot : public ::testing::Test
{
protected:
    Map map{nullptr, Feature()};
    Map other{nullptr, Feature()};
};

TEST_F(StringToStringMapSnapshot, AddsUnderANewKeyWhateverThePolicy)
{
    map.insert(u"fail", u"1", Map::Fail);
    map.insert(u"keep", u"2", Map::Keep);
    map.insert(u"replace", u"3", Map::Replace);
    map.insert(u"add", u"4", Map::Add);

    EXPECT_EQ(map.size(), 4u);
    EXPECT_EQ(map.find(u"replace")->second, u"3");
    EXPECT_EQ(map.find(u"missing"), map.end());
}

TEST_F(StringToStringMapSnapshot, IgnoresAPairThatItHoldsWhateverThePolicy)
{
    map.insert(u"key", u"value", Map::Fail);

    for (int policy = -1; policy < 5; ++policy)
        map.insert(u"key", u"value", static_cast<Map::CollisionResolution>(policy));

    EXPECT_EQ(map.size(), 1u);
}

TEST_F(StringToStringMapSnapshot, RefusesAnotherValueUnderFailAndStaysAsItWas)
{
    map.insert(u"key", u"old", Map::Fail);

    EXPECT_RAISES(messages::UniquenessConstraint, map.insert(u"key", u"new", Map::Fail));

    EXPECT_EQ(valuesOf(map, u"key"), (std::vector<ustring>{u"old"}));
}

TEST_F(StringToStringMapSnapshot, KeepsTheOldValueUnderKeep)
{
    map.insert(u"key", u"old", Map::Fail);

    map.insert(u"key", u"new", Map::Keep);

    EXPECT_EQ(valuesOf(map, u"key"), (std::vector<ustring>{u"old"}));
}

TEST_F(StringToStringMapSnapshot, OverwritesTheFirstValueUnderReplace)
{
    map.insert(u"key", u"one", Map::Add);
    map.insert(u"key", u"two", Map::Add);
    ustring const first = map.find(u"key")->second;
    ustring const second = first == u"one" ? u"two" : u"one";

    map.insert(u"key", u"new", Map::Replace);

    EXPECT_EQ(map.size(), 2u);
    EXPECT_EQ(map.find(u"key")->second, u"new");
    EXPECT_EQ(valuesOf(map, u"key"), (std::vector<ustring>{u"new", second}));
}

TEST_F(StringToStringMapSnapshot, AddsAFurtherEntryUnderAddAndAnyUnknownPolicy)
{
    map.insert(u"key", u"a", Map::Fail);

    map.insert(u"key", u"b", Map::Add);
    map.insert(u"key", u"c", static_cast<Map::CollisionResolution>(17));
    map.insert(u"key", u"d", static_cast<Map::CollisionResolution>(-1));

    EXPECT_EQ(valuesOf(map, u"key"), (std::vector<ustring>{u"a", u"b", u"c", u"d"}));
}

TEST_F(StringToStringMapSnapshot, FindsAnExactPairBehindOthersBeforeItFails)
{
    map.insert(u"key", u"a", Map::Add);
    map.insert(u"key", u"b", Map::Add);

    map.insert(u"key", u"a", Map::Fail);
    map.insert(u"key", u"b", Map::Fail);

    EXPECT_EQ(map.size(), 2u);
}

TEST_F(StringToStringMapSnapshot, ErasesAllEntriesOfAKeyAndCountsThem)
{
    map.insert(u"key", u"a", Map::Add);
    map.insert(u"key", u"b", Map::Add);
    map.insert(u"other", u"a", Map::Add);

    EXPECT_EQ(map.erase(u"key"), 2u);
    EXPECT_EQ(map.erase(u"key"), 0u);

    EXPECT_EQ(map.size(), 1u);
}

TEST_F(StringToStringMapSnapshot, ErasesAtAPositionAndGoesOnBehindIt)
{
    map.insert(u"a", u"1", Map::Add);
    map.insert(u"b", u"2", Map::Add);
    auto const behind = std::next(map.begin());
    ustring const kept = behind->first;

    auto const next = map.erase(map.begin());

    ASSERT_EQ(next, map.begin());
    EXPECT_EQ(next->first, kept);
    EXPECT_EQ(map.erase(next), map.end());
    EXPECT_TRUE(map.empty());
}

TEST_F(StringToStringMapSnapshot, ErasesARange)
{
    map.insert(u"a", u"1", Map::Add);
    map.insert(u"b", u"2", Map::Add);

    map.erase(map.begin(), map.end());

    EXPECT_TRUE(map.empty());
}

TEST_F(StringToStringMapSnapshot, TakesAnothersEntriesInPlaceOfItsOwn)
{
    map.insert(u"mine", u"1", Map::Add);
    other.insert(u"theirs", u"2", Map::Add);
    other.insert(u"theirs", u"3", Map::Add);

    map.assign(other);
    EXPECT_EQ(valuesOf(map, u"theirs"), (std::vector<ustring>{u"2", u"3"}));
    EXPECT_EQ(map.size(), 2u);

    other.clear();
    map.copyContents(other);
    EXPECT_TRUE(map.empty());
}

TEST_F(StringToStringMapSnapshot, MergesOverTheFirstValueOfAKeyThatItHas)
{
    map.insert(u"shared", u"old", Map::Add);
    other.insert(u"shared", u"new", Map::Add);
    other.insert(u"fresh", u"value", Map::Add);

    map.merge(other);

    EXPECT_EQ(valuesOf(map, u"shared"), (std::vector<ustring>{u"new"}));
    EXPECT_EQ(valuesOf(map, u"fresh"), (std::vector<ustring>{u"value"}));
}

TEST_F(StringToStringMapSnapshot, MergesWithItself)
{
    map.insert(u"key", u"value", Map::Add);

    map.merge(map);

    EXPECT_EQ(map.size(), 1u);
}

TEST_F(StringToStringMapSnapshot, EqualsAMapWithTheSamePairs)
{
    EXPECT_TRUE(map == other);
    map.insert(u"a", u"1", Map::Add);
    map.insert(u"b", u"2", Map::Add);
    other.insert(u"b", u"2", Map::Add);
    EXPECT_FALSE(map == other) << "the sizes differ";

    other.insert(u"a", u"1", Map::Add);
    EXPECT_TRUE(map == other);

    other.insert(u"a", u"3", Map::Replace);
    EXPECT_FALSE(map == other) << "a value differs";
    other.erase(u"a");
    other.insert(u"c", u"1", Map::Add);
    EXPECT_FALSE(map == other) << "a key differs";
}

TEST_F(StringToStringMapSnapshot, ComparesAKeysValuesWithOneOfTheOtherSide)
{
    map.insert(u"key", u"a", Map::Add);
    map.insert(u"key", u"b", Map::Add);

    EXPECT_FALSE(map == map) << "the second value is compared with the first one";
}
}  // namespace
}  // namespace tarn::kiln

#include "tarnkiln/collections/SaturatedBloomFilter.h"

namespace tarn::kiln {
namespace {

UUID uuidOf(std::uint8_t firstByte)
{
    UUID result{};
    for (std::uint8_t index = 0; index < 16; ++index)
        result.data[index] = static_cast<std::uint8_t>(firstByte + index);
    return result;
}

TEST(SaturatedBloomFilter, RulesOutWhatWasNeverAdded)
{
    SaturatedBloomFilter filter;
    EXPECT_FALSE(filter.contains(uuidOf(1)));

    filter.add(uuidOf(1));

    EXPECT_TRUE(filter.contains(uuidOf(1)));
    EXPECT_FALSE(filter.contains(uuidOf(2))) << "one of its bytes was not added";
}

TEST(SaturatedBloomFilter, RulesOutWhatWasRemoved)
{
    SaturatedBloomFilter filter;
    filter.add(uuidOf(1));
    filter.add(uuidOf(100));

    filter.remove(uuidOf(1));

    EXPECT_FALSE(filter.contains(uuidOf(1)));
    EXPECT_TRUE(filter.contains(uuidOf(100)));
}

TEST(SaturatedBloomFilter, CountsAByteThatOccursTwiceInOneUuidTwice)
{
    SaturatedBloomFilter filter;
    UUID sameBytes{};
    std::fill(std::begin(sameBytes.data), std::end(sameBytes.data), std::uint8_t{7});
    filter.add(sameBytes);

    // sixteen counts of the byte 7, of which a UUID with distinct bytes takes one
    filter.remove(uuidOf(7));

    EXPECT_TRUE(filter.contains(sameBytes));
    filter.add(uuidOf(7));
    filter.remove(sameBytes);
    EXPECT_FALSE(filter.contains(sameBytes));
}

TEST(SaturatedBloomFilter, SaysYesWrongfullyWhenOtherUuidsHaveAllTheBytes)
{
    SaturatedBloomFilter filter;
    filter.add(uuidOf(0));
    filter.add(uuidOf(16));

    EXPECT_TRUE(filter.contains(uuidOf(8))) << "half of its bytes come from each of the others";
}

TEST(SaturatedBloomFilter, KeepsACounterThatReached255)
{
    SaturatedBloomFilter filter;
    for (int round = 0; round < 255; ++round)
        filter.add(uuidOf(1));

    for (int round = 0; round < 255; ++round)
        filter.remove(uuidOf(1));

    EXPECT_TRUE(filter.contains(uuidOf(1)));
}

TEST(SaturatedBloomFilter, StaysExactUpTo254)
{
    SaturatedBloomFilter filter;
    for (int round = 0; round < 254; ++round)
        filter.add(uuidOf(1));

    for (int round = 0; round < 254; ++round)
        filter.remove(uuidOf(1));

    EXPECT_FALSE(filter.contains(uuidOf(1)));
}

TEST(SaturatedBloomFilter, WrapsACounterAtZeroAndKeepsItSaturated)
{
    SaturatedBloomFilter filter;

    filter.remove(uuidOf(1));
    EXPECT_TRUE(filter.contains(uuidOf(1)));

    filter.remove(uuidOf(1));
    EXPECT_TRUE(filter.contains(uuidOf(1)));
}
}  // namespace
}  // namespace tarn::kiln

/// \file
/// How values are kept and let go by the converter of their type.
#include "tarnkiln/meta/ValueOwnershipConverter.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln::meta {
namespace {

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

/// Adds a number to what it converts, and notes down what it releases.
class AddingConverter : public ValueOwnershipConverter
{
public:
    AddingConverter(int added, std::vector<int>& released) : m_added(added), m_released(released) {}

    Value convert(Value const& value) override
    {
        return Value(value.getType(), value.getValue<int>() + m_added);
    }
    void release(Value const& value) override { m_released.push_back(value.getValue<int>()); }

private:
    int m_added;
    std::vector<int>& m_released;
};

class OwnedValues : public ::testing::Test
{
protected:
    void TearDown() override { registry().unregisterOwnershipConverter(integer()); }

    static PrimitiveType const& integer()
    {
        registry();
        return StandardTypes::integerMeta;
    }
    void addConverter(int added)
    {
        registry().registerOwnershipConverter(integer(),
                                              std::make_unique<AddingConverter>(added, released));
    }

    std::vector<int> released;
};

TEST_F(OwnedValues, ArePlainCopiesWithoutAConverter)
{
    Value const value(integer(), 7);

    Value const owned = registry().convertValueForOwnership(value);

    EXPECT_EQ(owned, value);
    EXPECT_NO_THROW(registry().releaseOwnedValue(owned));
}

TEST_F(OwnedValues, AreMadeAndReleasedByTheConverterOfTheirType)
{
    addConverter(100);

    Value const owned = registry().convertValueForOwnership(Value(integer(), 7));
    registry().releaseOwnedValue(owned);

    EXPECT_EQ(owned.getValue<int>(), 107);
    EXPECT_EQ(released, (std::vector<int>{107}));
}

TEST_F(OwnedValues, AreLeftAloneByTheConverterOfAnotherType)
{
    addConverter(100);
    Value const value(StandardTypes::integer16Meta, short{7});

    EXPECT_EQ(registry().convertValueForOwnership(value), value);
    registry().releaseOwnedValue(value);
    EXPECT_TRUE(released.empty());
}

TEST_F(OwnedValues, KeepTheFirstConverterOfTheirType)
{
    addConverter(100);
    addConverter(1000);

    EXPECT_EQ(registry().convertValueForOwnership(Value(integer(), 7)).getValue<int>(), 107);
}

TEST_F(OwnedValues, ArePlainCopiesAgainOnceTheConverterIsUnregistered)
{
    addConverter(100);
    registry().unregisterOwnershipConverter(integer());

    EXPECT_EQ(registry().convertValueForOwnership(Value(integer(), 7)).getValue<int>(), 7);
}
}  // namespace
}  // namespace tarn::kiln::meta

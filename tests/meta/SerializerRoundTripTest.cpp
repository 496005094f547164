// Random values on their way into text and back.
#include "tests/meta/SerializerText.h"

#include <boost/date_time/posix_time/posix_time.hpp>
#include <rapidcheck.h>

#include <bit>
#include <cmath>

namespace tarn::kiln::meta {
namespace {

using boost::posix_time::ptime;
using tarnkiln::tests::read;
using tarnkiln::tests::write;
using Types = StandardTypes;

class RandomValue : public ::testing::Test
{
protected:
    RandomValue() { Types::ensureInitialized(); }
};

template <class T> bool comesBack(Type const& type, T const& value, char const* flavour = "")
{
    return read<T>(type, write(type, value, flavour), flavour) == value;
}

template <class T> bool allComeBack(Type const& type, char const* flavour = "")
{
    return rc::check([&](T const value) { RC_ASSERT(comesBack<T>(type, value, flavour)); });
}

ustring toUstring(std::vector<std::uint16_t> const& units)
{
    return ustring(units.begin(), units.end());
}

TEST_F(RandomValue, OfAnIntegralTypeComesBack)
{
    EXPECT_TRUE(allComeBack<int>(Types::integerMeta));
    EXPECT_TRUE(allComeBack<signed char>(Types::integer8Meta));
    EXPECT_TRUE(allComeBack<short>(Types::integer16Meta));
    EXPECT_TRUE(allComeBack<long>(Types::integer64Meta));
    EXPECT_TRUE(allComeBack<unsigned int>(Types::unlimitedNaturalMeta));
    EXPECT_TRUE(allComeBack<unsigned char>(Types::uinteger8Meta));
    EXPECT_TRUE(allComeBack<unsigned short>(Types::uinteger16Meta));
    EXPECT_TRUE(allComeBack<unsigned long>(Types::uinteger64Meta));
    EXPECT_TRUE(allComeBack<bool>(Types::booleanMeta));
    EXPECT_TRUE(allComeBack<bool>(Types::booleanMeta, "numeric"));
}

TEST_F(RandomValue, OfARealTypeComesBackToTheBit)
{
    EXPECT_TRUE(rc::check([](std::uint64_t bits) {
        double const value = std::bit_cast<double>(bits);
        double const back = read<double>(Types::realMeta, write(Types::realMeta, value));
        bool const same =
            std::isnan(value) ? std::isnan(back) : std::bit_cast<std::uint64_t>(back) == bits;
        RC_ASSERT(same);
    }));
}

TEST_F(RandomValue, OfATextTypeComesBack)
{
    EXPECT_TRUE(allComeBack<string>(Types::stdstringMeta));
    EXPECT_TRUE(rc::check([](std::vector<std::uint16_t> const& units) {
        RC_ASSERT(comesBack<ustring>(Types::stringMeta, toUstring(units)));
    }));
}

TEST_F(RandomValue, OfTheUuidTypeComesBack)
{
    EXPECT_TRUE(rc::check([] {
        UUID id{};
        for (auto& byte : id.data)
            byte = *rc::gen::arbitrary<std::uint8_t>();
        RC_ASSERT(comesBack<UUID>(Types::uuidMeta, id));
    }));
}

TEST_F(RandomValue, OfADateTimeComesBackInBothFlavours)
{
    EXPECT_TRUE(rc::check([] {
        long const day = *rc::gen::inRange(0L, 3000000L);
        long const tick = *rc::gen::inRange(0L, 86400000000L);
        ptime const time(boost::gregorian::date(1400, 1, 1) + boost::gregorian::days(day),
                         boost::posix_time::microseconds(tick));
        RC_ASSERT(comesBack<ptime>(Types::dateTimeMeta, time));
        RC_ASSERT(comesBack<ptime>(Types::dateTimeMeta, time, "Rev17"));
    }));
}

TEST_F(RandomValue, NoTextMakesAParserFailOtherThanByABadCast)
{
    EXPECT_TRUE(rc::check([] {
        std::string const alphabet = "0123456789+-.,/TeNIinfty:true";
        std::string const text = *rc::gen::container<std::string>(rc::gen::elementOf(alphabet));
        for (auto const& [type, flavour] : std::initializer_list<std::pair<Type, char const*>>{
                 {Types::integerMeta, ""},
                 {Types::integer8Meta, ""},
                 {Types::uinteger64Meta, ""},
                 {Types::realMeta, ""},
                 {Types::realMeta, "doubleBackwardsCompatible"},
                 {Types::booleanMeta, ""},
                 {Types::booleanMeta, "numeric"},
                 {Types::uuidMeta, ""},
                 {Types::dateTimeMeta, ""},
                 {Types::dateTimeMeta, "Rev17"}})
        {
            try
            {
                Value const value = tarnkiln::tests::serializerOf(type, flavour)
                                        .parseValue(ustring(text.begin(), text.end()), type);
                RC_ASSERT(value.getType() == type);
            }
            catch (std::bad_cast const&)
            {
                // As expected of most texts.
            }
        }
    }));
}
}  // namespace
}  // namespace tarn::kiln::meta

/// \file
/// What all plain types have in common, for each of them.
#include "bedrock/core/except/ExceptionBase.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/TransactionOrigin.h"
#include "tests/kernel/ValueFixture.h"
#include "tests/support/ExpectRaises.h"

#include <boost/date_time/gregorian/gregorian_types.hpp>
#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <set>
#include <type_traits>
#include <utility>
#include <vector>

namespace {
using namespace tarnkiln::tests;
using boost::posix_time::ptime;
using meta::ExtensionPrototype;
using meta::Language;
using meta::StandardTypes;
using meta::TransactionOrigin;

/// A type of the metamodel's own package.
meta::Type catalogueType(ustring const& name)
{
    return meta::MetaRegistry::getInstance().getType(name);
}

/// The type of a `T`, and two different `T`s, neither of them the default, in ascending order.
template <class T> struct Sample;

#define SAMPLE(T, TYPE, FIRST, SECOND)                                                             \
    template <> struct Sample<T>                                                                   \
    {                                                                                              \
        static meta::Type type() { return TYPE; }                                                  \
        static T first() { return FIRST; }                                                         \
        static T second() { return SECOND; }                                                       \
    };

template <class T, class Member, class Argument>
T with(void (T::*set)(Member), Argument const& argument)
{
    T result;
    (result.*set)(argument);
    return result;
}

Model modelWithLastByte(unsigned char last)
{
    UUID id{};
    id.data[0] = 1;
    id.data[15] = last;
    return Model::createTransientModel(id);
}

Model firstModel()
{
    static Model const MODEL = modelWithLastByte(1);
    return MODEL;
}

Model secondModel()
{
    static Model const MODEL = modelWithLastByte(2);
    return MODEL;
}

SAMPLE(ustring, StandardTypes::stringMeta, u"a", u"b")
SAMPLE(int, StandardTypes::integerMeta, -7, 8)
SAMPLE(signed char, StandardTypes::integer8Meta, -7, 8)
SAMPLE(short, StandardTypes::integer16Meta, -7, 8)
SAMPLE(long, StandardTypes::integer64Meta, -7'000'000'000, 8)
SAMPLE(double, StandardTypes::realMeta, -0.5, 8.25)
SAMPLE(unsigned int, StandardTypes::unlimitedNaturalMeta, 7u, 0xFFFFFFFFu)
SAMPLE(unsigned char, StandardTypes::uinteger8Meta, 7, 255)
SAMPLE(unsigned short, StandardTypes::uinteger16Meta, 7, 65535)
SAMPLE(unsigned long, StandardTypes::uinteger64Meta, 7, ~0UL)
SAMPLE(UUID, StandardTypes::uuidMeta, (UUID{{1, 2}}), (UUID{{2, 1}}))
SAMPLE(ptime, StandardTypes::dateTimeMeta, ptime(boost::gregorian::date(1970, 1, 1)),
       ptime(boost::gregorian::date(2026, 5, 4)))
SAMPLE(string, StandardTypes::stdstringMeta, "a", "b")
SAMPLE(TransactionOrigin, catalogueType(u"tarn.kiln.meta.TransactionOrigin"),
       with(&TransactionOrigin::setLanguage, Language::CPlusPlus),
       with(&TransactionOrigin::setLanguage, Language::JavaScript))
SAMPLE(ExtensionPrototype, catalogueType(u"tarn.kiln.meta.ExtensionPrototype"),
       with(&ExtensionPrototype::setName, ustring(u"a")),
       with(&ExtensionPrototype::setName, ustring(u"b")))
SAMPLE(Language, catalogueType(u"tarn.kiln.meta.Language"), Language::CPlusPlus,
       Language::JavaScript)
SAMPLE(Model, catalogueType(u"tarn.kiln.TarnModel"), firstModel(), secondModel())
SAMPLE(bool, StandardTypes::booleanMeta, true, false)

template <class T> class PlainValue : public ValueFixture
{
protected:
    using Optional = boost::optional<T>;

    /// A type whose values are of another C++ type.
    meta::Type otherType() const
    {
        bool const isText = std::is_same_v<T, ustring>;
        return isText ? meta::Type(StandardTypes::stdstringMeta) : StandardTypes::stringMeta;
    }
    ustring otherName() const { return std::is_same_v<T, ustring> ? u"StdString" : u"String"; }

    meta::Type const type = Sample<T>::type();
    T const first = Sample<T>::first();
    T const second = Sample<T>::second();
};

using PlainTypes = testing::Types<bool, signed char, unsigned char, short, unsigned short, int,
                                  unsigned int, long, unsigned long, double, ustring, string, UUID,
                                  ptime, TransactionOrigin, ExtensionPrototype, Language, Model>;
TYPED_TEST_SUITE(PlainValue, PlainTypes);

/// Whether `value` may be read as a `T`.
template <class T> bool reads(Value const& value)
{
    try
    {
        value.getValue<T>();
    }
    catch (messages::CannotCastIncompatibleTypes const&)
    {
        return false;
    }
    return true;
}

TYPED_TEST(PlainValue, HasATypeThatStandsForIt)
{
    EXPECT_TRUE(this->type);
    EXPECT_EQ(meta::standardTypeOf<TypeParam>(), this->type);
}

TYPED_TEST(PlainValue, IsReadAsItWasMade)
{
    Value const value(this->type, this->first);

    EXPECT_EQ(value.getValue<TypeParam>(), this->first);
    EXPECT_EQ(value.getType(), this->type);
    EXPECT_FALSE(value.getKeyType());
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_FALSE(value.isReflective());
    EXPECT_TRUE(value.isManaged());
    EXPECT_FALSE(value.isAbsent());
}

TYPED_TEST(PlainValue, IsMadeForAPropertyWhateverItsShape)
{
    meta::Property const optional = this->makeProperty(this->type, 0, 1);

    Value const value = Value::createPrimitiveValue(optional, this->first);

    EXPECT_EQ(value.getValue<TypeParam>(), this->first);
    EXPECT_EQ(value.getType(), this->type);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_TRUE(value.isCompatibleWithProperty(optional));
}

TYPED_TEST(PlainValue, IsReadAsAnOptional)
{
    Value const value(this->type, this->first);

    EXPECT_TRUE(value.getValue<boost::optional<TypeParam>>() == this->first);
}

TYPED_TEST(PlainValue, CanNotBeMadeOfAnotherType)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(this->otherType(), this->first),
                       this->otherName());
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        Value::createPrimitiveValue(this->makeProperty(this->otherType(), 1, 1), this->first),
        this->otherName());
}

TYPED_TEST(PlainValue, CanNotBeMadeWithoutAType)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(meta::Type(), this->first),
                       u"");
}

TYPED_TEST(PlainValue, IsEqualToOneWithTheSamePayload)
{
    Value const value(this->type, this->first);

    EXPECT_TRUE(value == Value(this->type, this->first));
    EXPECT_FALSE(value == Value(this->type, this->second));
    EXPECT_FALSE(Value(this->type, this->second) == value);
}

TYPED_TEST(PlainValue, CopiesItsPayload)
{
    Value value(this->type, this->first);
    Value const copy = value;
    value = Value(this->type, this->second);

    EXPECT_EQ(copy.getValue<TypeParam>(), this->first);
    EXPECT_EQ(value.getValue<TypeParam>(), this->second);
}

TYPED_TEST(PlainValue, ReadsAsTheDefaultOnceItWasMovedFrom)
{
    Value source(this->type, this->first);
    Value const target = std::move(source);

    EXPECT_EQ(target.getValue<TypeParam>(), this->first);
    EXPECT_EQ(source.getValue<TypeParam>(), TypeParam());
    EXPECT_TRUE(source.getValue<boost::optional<TypeParam>>() == boost::none);
    EXPECT_TRUE(source.isAbsent());
    EXPECT_EQ(source.getType(), this->type);
}

TYPED_TEST(PlainValue, IsItsOwnEntry)
{
    Value const value(this->type, this->first);

    std::vector<Value> const entries = value.extractEntryValues();

    ASSERT_EQ(entries.size(), 1u);
    EXPECT_TRUE(entries[0] == value);
}

TYPED_TEST(PlainValue, CanBeOptionalAndPresent)
{
    using Optional = boost::optional<TypeParam>;
    Value const value =
        Value::createPrimitiveValue(this->makeProperty(this->type, 0, 1), Optional(this->first));

    EXPECT_EQ(value.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(value.template getValue<Optional>() == this->first);
    EXPECT_FALSE(value.isAbsent());
    EXPECT_TRUE(value == Value(this->type, Optional(this->first)));
    EXPECT_FALSE(value == Value(this->type, Optional(this->second)));
    EXPECT_FALSE(value == Value(this->type, Optional()));
}

TYPED_TEST(PlainValue, CanBeOptionalAndAbsent)
{
    using Optional = boost::optional<TypeParam>;
    Value const value(this->type, Optional());

    EXPECT_EQ(value.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(value.template getValue<Optional>() == boost::none);
    EXPECT_TRUE(value.isAbsent());
    EXPECT_TRUE(value == Value(this->type, Optional()));
    EXPECT_FALSE(value == Value(this->type, Optional(this->first)));

    Value const copy = value;
    EXPECT_TRUE(copy == value);
}

TYPED_TEST(PlainValue, IsNotReadAsRequiredIfItIsOptional)
{
    using Optional = boost::optional<TypeParam>;
    Value const value(this->type, Optional(this->first));

    // A handle can itself express that there is nothing.
    EXPECT_EQ(reads<TypeParam>(value), (std::is_same_v<TypeParam, Model>));
    if constexpr (!std::is_same_v<TypeParam, Model>)
    {
        EXPECT_TRUE(tarnkiln::tests::raises<messages::CannotCastIncompatibleTypes>(
            [&] { value.getValue<TypeParam>(); },
            tarnkiln::tests::toArguments(this->type->getQualifiedName())));
    }
}

TYPED_TEST(PlainValue, HasNoEntryIfItIsOptional)
{
    using Optional = boost::optional<TypeParam>;

    EXPECT_TRUE(Value(this->type, Optional(this->first)).extractEntryValues().empty());
    EXPECT_TRUE(Value(this->type, Optional()).extractEntryValues().empty());
}

TYPED_TEST(PlainValue, CanNotBeOptionalOfAnotherType)
{
    using Optional = boost::optional<TypeParam>;

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(this->otherType(), Optional(this->first)), this->otherName());
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(this->otherType(), Optional()),
                       this->otherName());
}

TYPED_TEST(PlainValue, CanBeASequence)
{
    using Sequence = std::vector<TypeParam>;
    Sequence const sequence{this->second, this->first, this->second};

    Value const value(this->type, sequence);

    EXPECT_EQ(value.getFlags(), ValueFlags::Sequence);
    EXPECT_FALSE(value.isManaged());
    EXPECT_EQ(value.getValue<Sequence>(), sequence);
    EXPECT_TRUE(value == Value(this->type, sequence));
    EXPECT_FALSE(value == Value(this->type, Sequence{this->second}));
    EXPECT_FALSE(reads<std::set<TypeParam>>(value));
    EXPECT_FALSE(reads<TypeParam>(value));
}

TYPED_TEST(PlainValue, CanBeASet)
{
    using Set = std::set<TypeParam>;
    Set const set{this->second, this->first};

    Value const value(this->type, set);

    EXPECT_EQ(value.getFlags(), ValueFlags::Set);
    EXPECT_FALSE(value.isManaged());
    EXPECT_EQ(value.getValue<Set>(), set);
    EXPECT_TRUE(value == Value(this->type, set));
    EXPECT_FALSE(value == Value(this->type, Set{this->second}));
    EXPECT_FALSE(reads<std::vector<TypeParam>>(value));
    EXPECT_FALSE(reads<boost::optional<TypeParam>>(value));
}

TYPED_TEST(PlainValue, CanNotBeACollectionOfAnotherType)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(this->otherType(), std::vector<TypeParam>()), this->otherName());
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(this->otherType(), std::set<TypeParam>()), this->otherName());
}

TYPED_TEST(PlainValue, GivesTheEntriesOfASequenceInOrder)
{
    Value const value(this->type, std::vector<TypeParam>{this->second, this->first, this->second});

    std::vector<Value> const entries = value.extractEntryValues();

    ASSERT_EQ(entries.size(), 3u);
    EXPECT_TRUE(entries[0] == Value(this->type, this->second));
    EXPECT_TRUE(entries[1] == Value(this->type, this->first));
    EXPECT_TRUE(entries[2] == Value(this->type, this->second));
    EXPECT_TRUE(Value(this->type, std::vector<TypeParam>()).extractEntryValues().empty());
}

TYPED_TEST(PlainValue, GivesTheEntriesOfASetInItsOrder)
{
    std::set<TypeParam> const set{this->second, this->first};
    Value const value(this->type, set);

    std::vector<Value> const entries = value.extractEntryValues();

    ASSERT_EQ(entries.size(), 2u);
    EXPECT_TRUE(entries[0] == Value(this->type, *set.begin()));
    EXPECT_TRUE(entries[1] == Value(this->type, *std::next(set.begin())));
}

TYPED_TEST(PlainValue, ReadsAsAnEmptyCollectionOnceThatWasMovedFrom)
{
    Value source(this->type, std::vector<TypeParam>{this->first});
    Value const target = std::move(source);

    EXPECT_EQ(target.extractEntryValues().size(), 1u);
    EXPECT_TRUE(source.getValue<std::vector<TypeParam>>().empty());
    EXPECT_TRUE(source.extractEntryValues().empty());
}
}  // namespace

// Single plain values of reflective elements.
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tests/meta/ReflectiveFixture.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <cmath>
#include <limits>

namespace testkit {
namespace {

class ReflectiveValue : public ReflectiveFixture
{
protected:
    PropertySketch plain(ustring const& name, meta::Type const& type)
    {
        return metamodel.property(book, name, type);
    }

    meta::Class const book = metamodel.makeClass(u"Book");
};

template <class T> class ReflectiveValueOf : public ReflectiveValue
{
protected:
    static T sample()
    {
        if constexpr (std::is_same_v<T, ustring>)
            return u"a text that is too long for the small buffer";
        else if constexpr (std::is_same_v<T, string>)
            return "a text that is too long for the small buffer";
        else if constexpr (std::is_same_v<T, UUID>)
            return UUID{{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16}};
        else if constexpr (std::is_same_v<T, boost::posix_time::ptime>)
            return {boost::gregorian::date(2001, 2, 3), boost::posix_time::seconds(4)};
        else if constexpr (std::is_same_v<T, bool>)
            return true;
        else
            return std::numeric_limits<T>::max();
    }
};

using PlainTypes = ::testing::Types<bool, signed char, short, int, long, unsigned char,
                                    unsigned short, unsigned int, unsigned long, double, ustring,
                                    string, UUID, boost::posix_time::ptime>;
TYPED_TEST_SUITE(ReflectiveValueOf, PlainTypes);

TYPED_TEST(ReflectiveValueOf, IsReadAsItWasSetIfRequired)
{
    meta::Property const property = this->plain(u"p", meta::standardTypeOf<TypeParam>()).required();
    ModelElement const made = this->make(this->book);
    EXPECT_EQ(valueOf(made, property), Value::createEmptyValue(property));
    EXPECT_EQ(valueOf(made, property).getFlags(), ValueFlags::Single);
    EXPECT_TRUE(has(made, property)) << "a required value is always there";

    set(made, property, this->sample());

    Value const value = valueOf(made, property);
    EXPECT_EQ(value, Value(property->getType(), this->sample()));
    EXPECT_EQ(value.getType(), property->getType());
    EXPECT_EQ(value.template getValue<TypeParam>(), this->sample());
}

TYPED_TEST(ReflectiveValueOf, IsReadWithTheShapeInWhichItWasSetIfOptional)
{
    using Optional = boost::optional<TypeParam>;
    meta::Property const property = this->plain(u"p", meta::standardTypeOf<TypeParam>());
    ModelElement const made = this->make(this->book);
    EXPECT_EQ(valueOf(made, property), Value::createEmptyValue(property));
    EXPECT_FALSE(getOptional<TypeParam>(made, property));
    EXPECT_FALSE(has(made, property));

    set(made, property, Optional(this->sample()));
    EXPECT_EQ(valueOf(made, property).getFlags(), ValueFlags::OptionalSingle);
    EXPECT_EQ(getOptional<TypeParam>(made, property), this->sample());
    EXPECT_TRUE(has(made, property));

    set(made, property, this->sample());
    EXPECT_EQ(valueOf(made, property).getFlags(), ValueFlags::Single);
    EXPECT_EQ(get<TypeParam>(made, property), this->sample());

    clear(made, property);
    EXPECT_FALSE(getOptional<TypeParam>(made, property));
    EXPECT_FALSE(has(made, property));
}

TYPED_TEST(ReflectiveValueOf, ThatIsTheDefaultOfItsTypeIsPresentAllTheSame)
{
    using Optional = boost::optional<TypeParam>;
    meta::Property const property = this->plain(u"p", meta::standardTypeOf<TypeParam>());
    ModelElement const made = this->make(this->book);

    set(made, property, Optional(TypeParam()));

    EXPECT_TRUE(has(made, property));
    EXPECT_EQ(getOptional<TypeParam>(made, property), TypeParam());
}

TYPED_TEST(ReflectiveValueOf, ComesBackWithARollback)
{
    meta::Property const property = this->plain(u"p", meta::standardTypeOf<TypeParam>()).required();
    meta::Property const optional = this->plain(u"o", meta::standardTypeOf<TypeParam>());
    ModelElement const made = this->make(this->book);
    set(made, property, this->sample());
    Transaction const transaction = this->begin();

    set(made, property, TypeParam());
    set(made, optional, this->sample());
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(get<TypeParam>(made, property), this->sample());
    EXPECT_FALSE(has(made, optional));
}

TYPED_TEST(ReflectiveValueOf, IsTheSameAgainWhereverTheTransactionStands)
{
    meta::Property const property = this->plain(u"p", meta::standardTypeOf<TypeParam>()).required();
    ModelElement const made = this->make(this->book);
    {
        Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);
        set(made, property, this->sample());
        EXPECT_EQ(get<TypeParam>(made, property), this->sample());
        set(made, property, TypeParam());
        set(made, property, this->sample());
        transaction.commit();
    }
    EXPECT_EQ(get<TypeParam>(made, property), this->sample());
    set(made, property, TypeParam());
    EXPECT_EQ(get<TypeParam>(made, property), TypeParam());
}

TEST_F(ReflectiveValue, KeepsItsSign)
{
    meta::Property const small = plain(u"small", meta::StandardTypes::integer8Meta).required();
    meta::Property const number = plain(u"number", meta::StandardTypes::integerMeta).required();
    ModelElement const made = make(book);

    set(made, small, static_cast<signed char>(-1));
    set(made, number, -7);

    EXPECT_EQ(get<signed char>(made, small), -1);
    EXPECT_EQ(get<int>(made, number), -7);
}

TEST_F(ReflectiveValue, IsUnchangedByAnEqualOne)
{
    meta::Property const price = plain(u"price", meta::StandardTypes::realMeta).required();
    ModelElement const made = make(book);
    int calls = 0;
    auto const setAlone = [&](double value) {
        Transaction const transaction = begin();
        transaction.addFirstChangeCallback([&] { ++calls; });
        set(made, price, value);
        transaction.commit();
    };
    setAlone(-0.0);
    EXPECT_EQ(calls, 0) << "zero has two forms";
    EXPECT_FALSE(std::signbit(get<double>(made, price)));

    setAlone(2);
    setAlone(2);
    EXPECT_EQ(calls, 1);

    setAlone(std::numeric_limits<double>::quiet_NaN());
    setAlone(std::numeric_limits<double>::quiet_NaN());
    EXPECT_EQ(calls, 3) << "what is no number equals nothing";
}

TEST_F(ReflectiveValue, IsReadWithTheMarksThatItWasSetWith)
{
    meta::Property const property = plain(u"p", meta::StandardTypes::integerMeta).required();
    ModelElement const made = make(book);
    Value marked(meta::StandardTypes::integerMeta, 3);
    marked.setReflective();
    marked.setUnmanaged();

    setValue(made, property, marked);
    EXPECT_TRUE(valueOf(made, property).isReflective());
    EXPECT_FALSE(valueOf(made, property).isManaged());
    EXPECT_EQ(get<int>(made, property), 3);

    set(made, property, 4);
    EXPECT_FALSE(valueOf(made, property).isReflective());
    EXPECT_EQ(get<int>(made, property), 4);
}

TEST_F(ReflectiveValue, HoldsWhatIsSetForEnumerations)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"blue"});
    meta::Property const required = plain(u"required", colour).required();
    meta::Property const optional = plain(u"optional", colour);
    ModelElement const made = make(book);
    EXPECT_EQ(get<long>(made, required), 1) << "blue comes first by name";
    EXPECT_FALSE(has(made, optional));

    setValue(made, required, Value::createEnumValue(colour->findLiteralByValue(0)));
    setValue(made, optional, Value::createEnumValue(colour->findLiteralByValue(1)));
    EXPECT_EQ(get<long>(made, required), 0);
    EXPECT_EQ(get<long>(made, optional), 1);
    EXPECT_TRUE(has(made, optional));

    setValue(made, optional, Value::createOptionalEnumValue(optional, 0L));
    EXPECT_TRUE(valueOf(made, optional).getEnumNumber() == 0L);
    EXPECT_EQ(valueOf(made, optional).getFlags(), ValueFlags::OptionalSingle);
}

TEST_F(ReflectiveValue, OfAnOptionalEnumerationIsClearedByItsEmptyValue)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red"});
    meta::Property const optional = plain(u"optional", colour);
    ModelElement const made = make(book);
    Value const red = Value::createEnumValue(colour->findLiteralByValue(0));

    setValue(made, optional, red);
    clear(made, optional);
    EXPECT_FALSE(has(made, optional));
    EXPECT_EQ(valueOf(made, optional), Value::createEmptyValue(optional));

    setValue(made, optional, red);
    setValue(made, optional, Value::createOptionalEnumValue(optional, boost::none));
    EXPECT_FALSE(has(made, optional));
}

TEST_F(ReflectiveValue, StartsWithTheDeclaredDefault)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"blue"});
    meta::Property const number =
        plain(u"number", StandardTypes::integerMeta).required().byDefault(u"42");
    meta::Property const text = plain(u"text", StandardTypes::stringMeta).byDefault(u"none");
    meta::Property const paint = plain(u"paint", colour).required().byDefault(u"red");
    meta::Property const broken =
        plain(u"broken", StandardTypes::integerMeta).required().byDefault(u"many");
    ModelElement const made = make(book);

    EXPECT_EQ(get<int>(made, number), 42);
    EXPECT_EQ(getOptional<ustring>(made, text), ustring(u"none"));
    EXPECT_TRUE(has(made, text));
    EXPECT_EQ(get<long>(made, paint), 0);
    EXPECT_EQ(get<int>(made, broken), 0) << "a text that can not be read is no default";
}

TEST_F(ReflectiveValue, StartsWithADynamicDefaultOfItsOwn)
{
    meta::Property const token =
        plain(u"token", StandardTypes::uuidMeta).required().byDefault(u"random");
    ModelElement const one = make(book), other = make(book);

    EXPECT_FALSE(get<UUID>(one, token).is_nil());
    EXPECT_NE(get<UUID>(one, token), get<UUID>(other, token));
    EXPECT_EQ(get<UUID>(one, token), get<UUID>(one, token)) << "computed once, at creation";
}

TEST_F(ReflectiveValue, NeedsATypeThatHasValues)
{
    plain(u"array", StandardTypes::hostArrayMeta);

    EXPECT_RAISES(messages::InvalidValue, make(book));
}

TEST_F(ReflectiveValue, OfTheWrongTypeIsRefused)
{
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
    meta::Property const text = plain(u"text", StandardTypes::stringMeta);
    ModelElement const made = make(book);
    set(made, number, 7);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       setValue(made, number, Value(StandardTypes::integer64Meta, 8L)), u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       setValue(made, text, Value(StandardTypes::integerMeta, 8)), u"String");
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        setValue(made, number, Value(StandardTypes::integerMeta, boost::optional<int>())),
        u"Integer");
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        setValue(made, number, Value(StandardTypes::integerMeta, boost::optional<int>(8))),
        u"Integer");
    EXPECT_RAISES(messages::InvalidValue,
                  setValue(made, number, Value(StandardTypes::integerMeta, std::vector<int>{8})));

    EXPECT_EQ(get<int>(made, number), 7);
    EXPECT_FALSE(has(made, text));
}

TEST_F(ReflectiveValue, ThatIsPrivateIsReachedByThePrivilegedOnly)
{
    meta::Property const secret =
        plain(u"secret", StandardTypes::integerMeta).required().notReadable();
    meta::Property const shown =
        plain(u"shown", StandardTypes::integerMeta).required().notWritable();
    ModelElement const made = make(book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       valueOf(made, secret, ModelElement::Impl::PUBLIC_ACCESS), u"secret",
                       u"rt.Book");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, has(made, secret), u"secret", u"rt.Book");
    EXPECT_EQ(get<int>(made, secret), 0);
    EXPECT_TRUE(made->hasPropertyValue(secret, ModelElement::Impl::NO_PROXY_RESOLVE));

    EXPECT_RAISES_WITH(messages::NoSuchProperty, set(made, shown, 1), u"shown", u"rt.Book");
    made->setPropertyValue(shown, Value(StandardTypes::integerMeta, 1),
                           ModelElement::Impl::NO_PROXY_RESOLVE);
    EXPECT_EQ(get<int>(made, shown), 1);
}

TEST_F(ReflectiveValue, ThatIsReadOnlyIsSetByThePrivilegedOnly)
{
    meta::Property const fixed = plain(u"fixed", StandardTypes::integerMeta).required().readOnly();
    ModelElement const made = make(book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, set(made, fixed, 1), u"fixed", u"rt.Book");
    made->setPropertyValue(fixed, Value(StandardTypes::integerMeta, 1),
                           ModelElement::Impl::PRIVILEGED_ACCESS);

    EXPECT_EQ(get<int>(made, fixed), 1);
}

TEST_F(ReflectiveValue, ThatIsSetOnceRefusesASecondTimeBeforeItLooksWhetherAnythingWouldChange)
{
    meta::Property const once = plain(u"once", StandardTypes::integerMeta).readOnly().setOnce();
    ModelElement const made = make(book);

    clear(made, once);  // still the empty value
    set(made, once, 5);
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, set(made, once, 5), u"once");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, set(made, once, 6), u"once");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, clear(made, once), u"once");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty,
                       made->setPropertyValue(once, Value(StandardTypes::integerMeta, 5),
                                              ModelElement::Impl::PRIVILEGED_ACCESS),
                       u"once");

    EXPECT_EQ(get<int>(made, once), 5);
}

TEST_F(ReflectiveValue, ThatIsManyValuedIsNotSet)
{
    meta::Property const numbers = plain(u"numbers", StandardTypes::integerMeta).many();
    ModelElement const made = make(book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, setValue(made, numbers, valueOf(made, numbers)),
                       u"numbers", u"rt.Book");
}

TEST_F(ReflectiveValue, EqualToThePresentOneChangesNothing)
{
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
    meta::Property const text = plain(u"text", StandardTypes::stringMeta);
    ModelElement const made = make(book);
    set(made, number, 7);
    set(made, text, u"same");
    ScriptedListener listener;
    listen(model, listener);

    set(made, number, 7);  // would need a transaction
    set(made, text, u"same");
    EXPECT_RAISES(messages::NoOpenTransaction, set(made, number, 8));
    EXPECT_RAISES(messages::NoOpenTransaction, set(made, text, boost::optional<ustring>(u"same")));

    EXPECT_EQ(get<int>(made, number), 7);
    EXPECT_THAT(listener.committed, IsEmpty());
}

TEST_F(ReflectiveValue, IsNotSetInAFrozenModel)
{
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
    ModelElement const made = make(book);
    Model::Freezer const frozen = model->freeze();

    EXPECT_RAISES(messages::ModelFrozen, set(made, number, 8));

    EXPECT_EQ(get<int>(made, number), 0);
}

TEST_F(ReflectiveValue, OfADestroyedElementStaysAsItIs)
{
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
    ModelElement const made = make(book);
    set(made, number, 7);

    made->destroy();
    set(made, number, 8);

    EXPECT_EQ(get<int>(made, number), 7);
}

TEST_F(ReflectiveValue, IsNotSetOnAStandIn)
{
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
    ModelElement const proxy = danglingProxy(book);

    EXPECT_RAISES(messages::CannotModifyProxy, set(proxy, number, 8));
}

TEST_F(ReflectiveValue, OfADataTypeIsAValueOfItsOwn)
{
    meta::DataType const place = metamodel.makeDataType(u"Place");
    meta::Property const row =
        metamodel.field(place, u"row", StandardTypes::integerMeta).required();
    meta::Property const seat = plain(u"seat", place).required();
    meta::Property const spare = plain(u"spare", place);
    ModelElement const made = make(book);
    ReflectiveDataType first(place), second(place);
    second.setPropertyValue(row, Value(StandardTypes::integerMeta, 2));
    EXPECT_EQ(valueOf(made, seat), Value::createReflectiveDataTypeValue(first));
    EXPECT_FALSE(has(made, spare));

    setValue(made, seat, Value::createReflectiveDataTypeValue(second));
    setValue(made, spare, Value::createReflectiveDataTypeValue(second));
    EXPECT_EQ(valueOf(made, seat).toReflectiveDataType(), second);
    EXPECT_TRUE(has(made, spare));

    Transaction const transaction = begin();
    setValue(made, seat, Value::createReflectiveDataTypeValue(first));
    clear(made, spare);
    EXPECT_FALSE(has(made, spare));
    transaction.rollBack();
    EXPECT_EQ(valueOf(made, seat).toReflectiveDataType(), second);
    EXPECT_EQ(valueOf(made, spare).toReflectiveDataType(), second);
}

TEST_F(ReflectiveValue, OfTypeStringToStringMapIsACollectionOfTheElement)
{
    meta::Property const notes = plain(u"notes", StandardTypes::stringToStringMapMeta);
    ModelElement const made = make(book), other = make(book);
    EXPECT_FALSE(has(made, notes));

    get<StringToStringMap&>(made, notes).insert(u"a", u"1", StringToStringMap::Fail);
    EXPECT_TRUE(has(made, notes));
    EXPECT_EQ(valueOf(made, notes), valueOf(made, notes)) << "the same collection each time";
    EXPECT_EQ(valueOf(made, notes).getFlags(), ValueFlags::Single);

    setValue(other, notes, valueOf(made, notes));
    EXPECT_EQ(get<StringToStringMap&>(other, notes), get<StringToStringMap&>(made, notes));
    EXPECT_FALSE(valueOf(other, notes) == valueOf(made, notes)) << "a copy of its own";

    Transaction const transaction = begin();
    get<StringToStringMap&>(made, notes).clear();
    transaction.rollBack();
    EXPECT_EQ(get<StringToStringMap&>(made, notes).size(), 1u);
}

TEST_F(ReflectiveValue, OfAPlainTypeWithManyValuesIsThePrimitiveCollectionOfTheType)
{
    meta::Property const list = plain(u"list", StandardTypes::integerMeta).many().ordered();
    meta::Property const bag = plain(u"bag", StandardTypes::stringMeta).many();
    ModelElement const made = make(book);
    EXPECT_FALSE(has(made, list));

    valuesOf(made, list).genericAdd(Value(StandardTypes::integerMeta, 3));
    valuesOf(made, bag).genericAdd(Value(StandardTypes::stringMeta, ustring(u"x")));

    EXPECT_TRUE(has(made, list));
    EXPECT_EQ(valuesOf(made, list).getKind(), AbstractPrimitiveCollection::SEQUENCE);
    EXPECT_EQ(valuesOf(made, bag).getKind(), AbstractPrimitiveCollection::SET);
    EXPECT_EQ(valueOf(made, list).getFlags(), ValueFlags::Sequence);
    EXPECT_FALSE(valueOf(made, list).isReflective());
    EXPECT_EQ(&valuesOf(made, list), &valuesOf(made, list));
}

TEST_F(ReflectiveValue, OfATypeWithoutCollectionsIsNone)
{
    meta::Property const arrays = plain(u"arrays", StandardTypes::hostArrayMeta).many();
    ModelElement const made = make(book);

    EXPECT_FALSE(has(made, arrays));
    EXPECT_TRUE(valueOf(made, arrays).isAbsent());
    made->destroy();
}

// ---------------------------------------------------------------------------- ownership

/// Counts what is kept and let go, and marks what it has converted.
class CountingConverter final : public meta::ValueOwnershipConverter
{
public:
    explicit CountingConverter(std::vector<int>& kept) : m_kept(kept) {}

    Value convert(Value const& value) override
    {
        m_kept.push_back(value.getValue<int>());
        return value;
    }
    void release(Value const& value) override
    {
        auto const place = std::find(m_kept.begin(), m_kept.end(), value.getValue<int>());
        ASSERT_NE(place, m_kept.end()) << "what was not converted is released";
        m_kept.erase(place);
    }

private:
    std::vector<int>& m_kept;
};

class OwnedReflectiveValue : public ReflectiveValue
{
protected:
    OwnedReflectiveValue()
    {
        meta::MetaRegistry::getInstance().registerOwnershipConverter(
            StandardTypes::integerMeta, std::make_unique<CountingConverter>(kept));
    }
    ~OwnedReflectiveValue() override
    {
        meta::MetaRegistry::getInstance().unregisterOwnershipConverter(StandardTypes::integerMeta);
    }

    std::vector<int> kept;
    meta::Property const number = plain(u"number", StandardTypes::integerMeta).required();
};

TEST_F(OwnedReflectiveValue, IsConvertedWhenStoredAndReleasedWhenReplacedOrGone)
{
    ModelElement made = make(book);
    EXPECT_THAT(kept, ElementsAre(0));
    set(made, number, 7);
    EXPECT_THAT(kept, ElementsAre(7));
    set(made, number, 8);
    EXPECT_THAT(kept, ElementsAre(8));

    made->destroy();
    EXPECT_THAT(kept, ElementsAre(8)) << "it may come back";
    made = ModelElement();
    EXPECT_THAT(kept, IsEmpty());
}

TEST_F(OwnedReflectiveValue, IsKeptByTheRecordToo)
{
    ModelElement made = make(book);
    set(made, number, 7);
    {
        Transaction const transaction = begin();
        set(made, number, 8);
        EXPECT_THAT(kept, UnorderedElementsAre(7, 8));
        transaction.rollBack();
    }
    EXPECT_THAT(kept, ElementsAre(7));
    EXPECT_EQ(get<int>(made, number), 7);
}
}  // namespace
}  // namespace testkit

#include "tarnkiln/query/ValueComparatorRegistry.h"

#include "tarnkiln/meta/MetaRegistry.h"
#include "tests/query/QueryFixture.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <gtest/gtest.h>

#include <limits>
#include <locale>
#include <regex>
#include <set>
#include <utility>

namespace testkit {
namespace {

using enum ValueMatchRelation;
using boost::posix_time::ptime;
using query::ValueComparatorRegistry;

ValueComparatorRegistry::Comparator const* find(ValueMatchRelation relation, meta::Type const& type,
                                                bool required)
{
    return ValueComparatorRegistry::getInstance().findComparator(relation, type, required);
}

bool compare(Value const& left, ValueMatchRelation relation, Value const& right,
             bool required = true)
{
    return (*find(relation, left.getType(), required))(left, right);
}

/// One C++ type with two values, the lesser first.
template <class T> struct Sample
{
    meta::Type const& type;
    T lesser;
    T greater;
};

template <class Visit> void forEachSample(Visit visit)
{
    StandardTypes::ensureInitialized();
    ptime const day(boost::gregorian::date(2026, 11, 21));
    UUID const nil{};
    visit(Sample<ustring>{StandardTypes::stringMeta, u"a", u"ab"});
    visit(Sample<ustring>{StandardTypes::stringMeta, u"Z", u"a"});
    visit(Sample<ustring>{StandardTypes::stringMeta, u"\xD800", u"\xE000"});
    visit(Sample<int>{StandardTypes::integerMeta, -1, 1});
    visit(Sample<signed char>{StandardTypes::integer8Meta, -1, 1});
    visit(Sample<short>{StandardTypes::integer16Meta, -1, 1});
    visit(Sample<long>{StandardTypes::integer64Meta, -1, 1L << 40});
    visit(Sample<double>{StandardTypes::realMeta, -0.5, 0.25});
    visit(Sample<bool>{StandardTypes::booleanMeta, false, true});
    visit(Sample<unsigned char>{StandardTypes::uinteger8Meta, 1, 200});
    visit(Sample<unsigned short>{StandardTypes::uinteger16Meta, 1, 60000});
    visit(Sample<unsigned int>{StandardTypes::unlimitedNaturalMeta, 1, 0xFFFFFFFF});
    visit(Sample<unsigned long>{StandardTypes::uinteger64Meta, 1, ~0UL});
    visit(Sample<UUID>{StandardTypes::uuidMeta, nil, UUID{{0, 1}}});
    visit(Sample<ptime>{StandardTypes::dateTimeMeta, day, day + boost::posix_time::seconds(1)});
    visit(Sample<string>{StandardTypes::stdstringMeta, "a", "\x80"});
}

class ValueComparator : public QueryFixture
{
protected:
    static Value literal(meta::Enum const& type, long number) { return Value(type, number); }
    Value maybe(boost::optional<long> number) const
    {
        return Value::createOptionalEnumValue(mood, number);
    }
};

// ---------------------------------------------------------------------------- what there is

TEST_F(ValueComparator, ExistsForTheseRelationsAndNoOthers)
{
    std::set<ValueMatchRelation> const equality{equal, notEqual};
    std::set<ValueMatchRelation> const order{equal,   notEqual,       less,
                                             greater, greaterOrEqual, lessOrEqual};
    std::set<ValueMatchRelation> texts = order;
    texts.insert(equalStringNocase);
    std::set<ValueMatchRelation> requiredTexts = texts;
    requiredTexts.insert(regexp);

    auto const expectRelations = [](meta::Type const& type, bool required,
                                    std::set<ValueMatchRelation> const& expected) {
        for (int number = -1; number < 11; ++number)
            EXPECT_EQ(find(ValueMatchRelation(number), type, required) != nullptr,
                      expected.contains(ValueMatchRelation(number)))
                << testing::PrintToString(type->getName()) << ' ' << number << ' ' << required;
    };
    for (auto const& type :
         {StandardTypes::integerMeta, StandardTypes::integer8Meta, StandardTypes::integer16Meta,
          StandardTypes::integer64Meta, StandardTypes::realMeta, StandardTypes::booleanMeta,
          StandardTypes::uinteger8Meta, StandardTypes::uinteger16Meta,
          StandardTypes::unlimitedNaturalMeta, StandardTypes::uinteger64Meta,
          StandardTypes::uuidMeta, StandardTypes::dateTimeMeta})
    {
        expectRelations(type, true, order);
        expectRelations(type, false, order);
    }
    for (auto const& type : {StandardTypes::stringMeta, StandardTypes::stdstringMeta})
    {
        expectRelations(type, true, requiredTexts);
        expectRelations(type, false, texts);
    }
    for (auto const& type : {StandardTypes::hostArrayMeta, StandardTypes::jsonValueMeta,
                             StandardTypes::stringToStringMapMeta})
    {
        expectRelations(type, true, {});
        expectRelations(type, false, {});
    }
    expectRelations(metamodel.makeDataType(u"Money"), true, {});
    for (meta::Type const& type : {meta::Type(genre), meta::Type(book)})
    {
        expectRelations(type, true, equality);
        expectRelations(type, false, equality);
    }
}

TEST_F(ValueComparator, ForgetsWhetherAReferenceIsRequired)
{
    EXPECT_EQ(find(equal, book, false), find(equal, book, true));
    EXPECT_EQ(find(notEqual, author, false), find(notEqual, book, true));
    EXPECT_NE(find(equal, genre, false), find(equal, genre, true));
}

TEST_F(ValueComparator, IsLookedUpWithAFailureThatAlwaysNamesLess)
{
    auto const& registry = ValueComparatorRegistry::getInstance();

    EXPECT_EQ(registry.getComparator(regexp, StandardTypes::stringMeta, true),
              find(regexp, StandardTypes::stringMeta, true));
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       registry.getComparator(like, StandardTypes::stringMeta, true), "less",
                       u"String");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       registry.getComparator(greater, genre, false), "less", u"Genre");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       registry.getComparator(ValueMatchRelation(99), book, true), "less", u"Book");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       registry.getComparator(equal, meta::Type(), true), "less", u"");
}

// ---------------------------------------------------------------------------- what it answers

TEST_F(ValueComparator, OrdersRequiredValuesOfEveryType)
{
    forEachSample([&](auto const& sample) {
        Value const low(sample.type, sample.lesser);
        Value const high(sample.type, sample.greater);
        struct
        {
            ValueMatchRelation relation;
            bool lowHigh, highLow, same;
        } const table[] = {{equal, false, false, true},   {notEqual, true, true, false},
                           {less, true, false, false},    {lessOrEqual, true, false, true},
                           {greater, false, true, false}, {greaterOrEqual, false, true, true}};
        for (auto const& row : table)
        {
            for (bool const required : {true, false})
            {
                SCOPED_TRACE(query::ValueMatchRelationName(row.relation));
                EXPECT_EQ(compare(low, row.relation, high, required), row.lowHigh);
                EXPECT_EQ(compare(high, row.relation, low, required), row.highLow);
                EXPECT_EQ(compare(low, row.relation, low, required), row.same);
            }
        }
    });
}

TEST_F(ValueComparator, FindsNoOrderWhereAValueIsAbsent)
{
    forEachSample([&]<class T>(Sample<T> const& sample) {
        Value const some(sample.type, boost::optional<T>(sample.greater));
        Value const single(sample.type, sample.greater);
        Value const none(sample.type, boost::optional<T>());
        for (ValueMatchRelation const relation : {less, lessOrEqual, greater, greaterOrEqual})
        {
            bool const whenEqual = relation == lessOrEqual || relation == greaterOrEqual;
            EXPECT_EQ(compare(some, relation, some, false), whenEqual);
            EXPECT_EQ(compare(some, relation, single, false), whenEqual);
            EXPECT_EQ(compare(single, relation, some, false), whenEqual);
            EXPECT_FALSE(compare(some, relation, none, false));
            EXPECT_FALSE(compare(none, relation, some, false));
            EXPECT_FALSE(compare(none, relation, none, false));
        }
    });
}

TEST_F(ValueComparator, TakesValuesOfAnotherShapeForDifferent)
{
    forEachSample([&]<class T>(Sample<T> const& sample) {
        Value const some(sample.type, boost::optional<T>(sample.greater));
        Value const single(sample.type, sample.greater);
        Value const none(sample.type, boost::optional<T>());
        for (bool const required : {true, false})
        {
            EXPECT_TRUE(compare(some, equal, some, required));
            EXPECT_TRUE(compare(none, equal, none, required));
            EXPECT_FALSE(compare(none, notEqual, none, required));
            EXPECT_FALSE(compare(some, equal, none, required));
            EXPECT_FALSE(compare(some, equal, single, required));
            EXPECT_TRUE(compare(some, notEqual, single, required));
        }
    });
    EXPECT_FALSE(compare(integer(3), equal, Value(StandardTypes::integer64Meta, 3L)));
    EXPECT_TRUE(compare(integer(3), notEqual, Value(StandardTypes::integer64Meta, 3L)));
}

TEST_F(ValueComparator, DoesNotOrderWhatIsNotOfTheType)
{
    Value const none(StandardTypes::integerMeta, boost::optional<int>());
    Value const wide(StandardTypes::integer64Meta, 3L);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, compare(integer(1), less, wide),
                       u"Integer64");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, compare(integer(1), less, none),
                       u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       compare(none, greater, wide, /*required=*/false), u"Integer64");
    // The first is looked at first.
    auto const* const comparator = find(greaterOrEqual, StandardTypes::integerMeta, true);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, (*comparator)(wide, text(u"a")),
                       u"Integer64");
}

TEST_F(ValueComparator, FindsNaNUnequalAndUnordered)
{
    Value const nan(StandardTypes::realMeta, std::numeric_limits<double>::quiet_NaN());
    Value const zero(StandardTypes::realMeta, 0.0);
    Value const negativeZero(StandardTypes::realMeta, -0.0);

    EXPECT_FALSE(compare(nan, equal, nan));
    EXPECT_TRUE(compare(nan, notEqual, nan));
    for (ValueMatchRelation const relation : {less, lessOrEqual, greater, greaterOrEqual})
    {
        EXPECT_FALSE(compare(nan, relation, zero));
        EXPECT_FALSE(compare(zero, relation, nan));
    }
    EXPECT_TRUE(compare(zero, equal, negativeZero));
}

TEST_F(ValueComparator, OrdersSpecialTimesAsTheirTypeDoes)
{
    ptime const never(boost::posix_time::not_a_date_time);
    ptime const day(boost::gregorian::date(2026, 11, 21));
    ptime const end(boost::posix_time::pos_infin);
    for (ptime const& first : {never, day, end})
    {
        for (ptime const& second : {never, day, end})
        {
            Value const left(StandardTypes::dateTimeMeta, first);
            Value const right(StandardTypes::dateTimeMeta, second);
            EXPECT_EQ(compare(left, less, right), first < second);
            EXPECT_EQ(compare(left, equal, right), first == second);
        }
    }
}

TEST_F(ValueComparator, ComparesElementsByIdentity)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    Value const first = Value::createElementValue(writer, jane);
    Value const second = Value::createElementValue(writer, mary);
    Value const none = Value::createElementValue(writer, ModelElement());

    EXPECT_TRUE(compare(first, equal, first));
    EXPECT_FALSE(compare(first, equal, second));
    EXPECT_TRUE(compare(first, notEqual, second));
    EXPECT_TRUE(compare(none, equal, none));
    EXPECT_FALSE(compare(first, equal, none));
    // A value that was not made for the property is of another type.
    EXPECT_FALSE(compare(first, equal, Value(ModelElement::metaClass(), jane)));
}

TEST_F(ValueComparator, ComparesRequiredLiteralsByNumber)
{
    meta::Enum const other = metamodel.makeEnum(u"Other", {u"none", u"some"});

    EXPECT_TRUE(compare(literal(genre, 1), equal, literal(genre, 1)));
    EXPECT_FALSE(compare(literal(genre, 1), equal, literal(genre, 0)));
    EXPECT_TRUE(compare(literal(genre, 1), notEqual, literal(genre, 0)));
    EXPECT_FALSE(compare(literal(genre, 1), notEqual, literal(genre, 1)));
    EXPECT_TRUE(compare(literal(genre, 1), equal, literal(other, 1)));
    EXPECT_TRUE(compare(literal(genre, 1), equal, integer(1)));
    EXPECT_TRUE(compare(literal(genre, -1), equal, integer(-1)));
    // As 32 bits.
    EXPECT_TRUE(compare(literal(genre, (1L << 32) + 1), equal, literal(genre, 1)));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       compare(literal(genre, 1), equal, text(u"prose")), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       compare(literal(genre, 1), equal, maybe(1)), u"rt.Genre");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       compare(maybe(boost::none), notEqual, integer(1)), u"rt.Genre");
}

TEST_F(ValueComparator, AnswersOddlyForAbsentLiterals)
{
    Value const none = maybe(boost::none);
    Value const one = maybe(1);
    Value const zero = maybe(0);

    EXPECT_TRUE(compare(none, equal, none, false));
    EXPECT_TRUE(compare(none, notEqual, none, false));
    EXPECT_FALSE(compare(none, equal, one, false));
    EXPECT_FALSE(compare(none, notEqual, one, false));
    EXPECT_FALSE(compare(one, equal, none, false));
    EXPECT_FALSE(compare(one, notEqual, none, false));
    EXPECT_TRUE(compare(one, equal, one, false));
    EXPECT_FALSE(compare(one, notEqual, one, false));
    EXPECT_FALSE(compare(one, equal, zero, false));
    EXPECT_TRUE(compare(one, notEqual, zero, false));
    // Shapes and the type of empty values do not matter here.
    EXPECT_TRUE(compare(one, equal, literal(genre, 1), false));
    EXPECT_TRUE(compare(none, equal, Value::createEmptyValue(mood), false));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       compare(one, equal, text(u"prose"), false), u"String");
}

TEST_F(ValueComparator, IgnoresTheCaseOfTexts)
{
    EXPECT_TRUE(compare(bytes("Abc"), equalStringNocase, bytes("aBC")));
    EXPECT_FALSE(compare(bytes("Abc"), equalStringNocase, bytes("Abcd")));
    EXPECT_FALSE(compare(bytes("Abcd"), equalStringNocase, bytes("Abc")));
    EXPECT_FALSE(compare(bytes("Abc"), equalStringNocase, bytes("Abd")));
    EXPECT_TRUE(compare(bytes(""), equalStringNocase, bytes("")));
    EXPECT_TRUE(compare(text(u"Abc"), equalStringNocase, text(u"aBC")));
    EXPECT_FALSE(compare(text(u"Abc"), equalStringNocase, text(u"Abcd")));
    // Letter by letter of the 8-bit text: the classic locale knows ASCII only.
    EXPECT_TRUE(compare(text(u"\u00C4x"), equalStringNocase, text(u"\u00C4X")));
    EXPECT_FALSE(compare(text(u"\u00C4"), equalStringNocase, text(u"\u00E4")));
}

TEST_F(ValueComparator, AsksTheGlobalLocaleForTheCaseOfLetters)
{
    /// Takes "1" for the small form of "2".
    class OddLetters : public std::ctype<char>
    {
        char do_toupper(char letter) const override { return letter == '1' ? '2' : letter; }
    };
    std::locale const before = std::locale::global(std::locale(std::locale(), new OddLetters));

    EXPECT_TRUE(compare(bytes("1"), equalStringNocase, bytes("2")));
    EXPECT_FALSE(compare(bytes("a"), equalStringNocase, bytes("A")));
    std::locale::global(before);
    EXPECT_FALSE(compare(bytes("1"), equalStringNocase, bytes("2")));
}

TEST_F(ValueComparator, IgnoresTheCaseOfOptionalTexts)
{
    auto const maybeText = [](char16_t const* characters) {
        return Value(StandardTypes::stringMeta,
                     characters ? boost::optional<ustring>(characters) : boost::none);
    };
    auto const maybeBytes = [](char const* characters) {
        return Value(StandardTypes::stdstringMeta,
                     characters ? boost::optional<string>(characters) : boost::none);
    };

    EXPECT_TRUE(compare(maybeText(u"ab"), equalStringNocase, maybeText(u"AB"), false));
    EXPECT_TRUE(compare(maybeText(u"ab"), equalStringNocase, text(u"AB"), false));
    EXPECT_FALSE(compare(maybeText(u"ab"), equalStringNocase, maybeText(nullptr), false));
    EXPECT_FALSE(compare(maybeText(nullptr), equalStringNocase, maybeText(u"ab"), false));
    EXPECT_TRUE(compare(maybeText(nullptr), equalStringNocase, maybeText(nullptr), false));
    EXPECT_TRUE(compare(maybeBytes("ab"), equalStringNocase, maybeBytes("AB"), false));
    EXPECT_FALSE(compare(maybeBytes("ab"), equalStringNocase, maybeBytes(nullptr), false));
    EXPECT_FALSE(compare(maybeBytes(nullptr), equalStringNocase, maybeBytes("ab"), false));
    EXPECT_TRUE(compare(maybeBytes(nullptr), equalStringNocase, maybeBytes(nullptr), false));
}

TEST_F(ValueComparator, MatchesAllOfAnEightBitText)
{
    EXPECT_TRUE(compare(bytes("abc"), regexp, bytes("a.c")));
    EXPECT_FALSE(compare(bytes("xabc"), regexp, bytes("a.c")));
    EXPECT_TRUE(compare(bytes("aab"), regexp, bytes("(a)\\1b")));
    EXPECT_THROW(compare(bytes("abc"), regexp, bytes("(")), std::regex_error);
}

TEST_F(ValueComparator, SearchesInAUTF16Text)
{
    EXPECT_TRUE(compare(text(u"xabcx"), regexp, text(u"a.c")));
    EXPECT_FALSE(compare(text(u"xabcx"), regexp, text(u"^a.c$")));
    EXPECT_FALSE(compare(text(u"ABC"), regexp, text(u"abc")));
    EXPECT_TRUE(compare(text(u"\u00E4\U0001F600"), regexp, text(u"^..$")));
    EXPECT_THROW(compare(text(u"abc"), regexp, text(u"(")), std::runtime_error);
}
}  // namespace
}  // namespace testkit

// Random queries over random models: both engines must give the same rows in the same order, or
// fail with the same failure.
#include "shapes/OptionalsImpl.h"
#include "shapes/ScalarsImpl.h"
#include "tests/query/QueryFixture.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/PlainEngine.h"
#include "tests/support/SpecialNodeImpl.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <boost/uuid/uuid_io.hpp>
#include <gtest/gtest.h>

#include <random>
#include <typeinfo>

namespace testkit {
namespace {

/// A class of a client that answers for some of its properties itself.
class OwnNode : public Node::Impl
{
public:
    using Node::Impl::Impl;

    Value getPropertyValue(meta::Property const& property,
                           ReflectionPrivateTag const& tag) const override
    {
        if (property == propertyOf<2>())  // count
            return Value::createPrimitiveValue(property, 2);
        if (property == propertyOf<8>())  // note
            throw std::runtime_error("no note can be read");
        return Node::Impl::getPropertyValue(property, tag);
    }
};

/// Numbers, and choices among things.
class Dice
{
public:
    explicit Dice(unsigned seed) : m_random(seed) {}

    std::size_t below(std::size_t bound) { return m_random() % bound; }
    bool chance(int percent) { return below(100) < static_cast<std::size_t>(percent); }
    template <class Container> auto const& pick(Container const& container)
    {
        return container[below(std::size(container))];
    }
    template <class T> T oneOf(std::initializer_list<T> values)
    {
        return *(values.begin() + below(values.size()));
    }

private:
    std::mt19937 m_random;
};

ustring wide(string const& characters)
{
    return ustring(characters.begin(), characters.end());
}

/// The classes, with run-time ones that have a property of every kind.
class Zoo : public RuntimeMetamodel
{
public:
    Zoo()
    {
        base = makeClass(u"Base");
        derived = makeClass(u"Derived", base);
        kinds = makeEnum(u"Kind", {u"zero", u"one", u"two"});
        for (meta::Type const& type : std::vector<meta::Type>{
                 StandardTypes::stringMeta, StandardTypes::stdstringMeta,
                 StandardTypes::integerMeta, StandardTypes::integer64Meta, StandardTypes::realMeta,
                 StandardTypes::booleanMeta, StandardTypes::uuidMeta, StandardTypes::dateTimeMeta,
                 StandardTypes::uinteger8Meta, kinds})
        {
            property(base, u"required" + type->getName(), type).required();
            property(base, u"second" + type->getName(), type).required();
            property(base, u"optional" + type->getName(), type);
            property(base, u"many" + type->getName(), type).many().ordered();
        }
        property(base, u"words", StandardTypes::stringMeta).many().required();
        property(base, u"peer", base);
        property(base, u"peers", base).many().ordered();
        property(base, u"set", base).many();
        property(base, u"anyone", ModelElement::metaClass());
        parts = property(base, u"parts", base).many().ordered().composite();
        property(derived, u"special", StandardTypes::integerMeta).required();
        property(derived, u"node", Node::metaClass());
        classes = {base,
                   derived,
                   Node::metaClass(),
                   SpecialNode::metaClass(),
                   shapes::Scalars::metaClass(),
                   shapes::Optionals::metaClass(),
                   ModelElement::metaClass()};
        for (meta::Class const& metaClass : classes)
        {
            std::vector<meta::Property>& known = properties.emplace_back();
            for (meta::Class at = metaClass; at; at = at->getSuperclass())
            {
                for (auto const& [name, owned] : at->getOwnedAttributes())
                    known.push_back(owned);
            }
            all.insert(all.end(), known.begin(), known.end());
        }
    }

    std::vector<meta::Property> const& propertiesOf(meta::Class const& metaClass) const
    {
        return properties[static_cast<std::size_t>(
            std::find(classes.begin(), classes.end(), metaClass) - classes.begin())];
    }

    meta::Class base;
    meta::Class derived;
    meta::Enum kinds;
    meta::Property parts;
    std::vector<meta::Class> classes;
    std::vector<std::vector<meta::Property>> properties;  ///< By class.
    std::vector<meta::Property> all;
};

bool isEnum(meta::Type const& type)
{
    return meta::Enum::cast(type).getImpl();
}
bool isClass(meta::Type const& type)
{
    return meta::Class::cast(type).getImpl();
}

template <class T> Value shaped(meta::Type const& type, T const& payload, bool optional)
{
    return optional ? Value(type, boost::optional<T>(payload)) : Value(type, payload);
}

/// A value of few that there are, so that some are equal; of `Integer` for a type without values.
Value plainValue(Dice& dice, meta::Type const& type, bool optional)
{
    using boost::posix_time::ptime;
    static char const* const texts[] = {"", "a", "b", "ab", "A", "a\nb", "\xC3\xA4"};
    static ptime const day(boost::gregorian::date(2026, 11, 21));
    int const number = static_cast<int>(dice.below(4)) - 1;
    unsigned const natural = static_cast<unsigned>(number + 1);

    if (type == StandardTypes::stringMeta)
        return shaped(type, wide(dice.pick(texts)), optional);
    if (type == StandardTypes::stdstringMeta)
        return shaped(type, string(dice.pick(texts)), optional);
    if (type == StandardTypes::integer8Meta)
        return shaped(type, static_cast<signed char>(number), optional);
    if (type == StandardTypes::integer16Meta)
        return shaped(type, static_cast<short>(number), optional);
    if (type == StandardTypes::integer64Meta)
        return shaped(type, static_cast<long>(number) << 32, optional);
    if (type == StandardTypes::uinteger8Meta)
        return shaped(type, static_cast<unsigned char>(natural), optional);
    if (type == StandardTypes::uinteger16Meta)
        return shaped(type, static_cast<unsigned short>(natural), optional);
    if (type == StandardTypes::unlimitedNaturalMeta)
        return shaped(type, natural, optional);
    if (type == StandardTypes::uinteger64Meta)
        return shaped(type, static_cast<unsigned long>(natural), optional);
    if (type == StandardTypes::realMeta)
        return shaped(type, dice.oneOf({0.0, -0.0, 1.5, -1.5, std::nan("")}), optional);
    if (type == StandardTypes::booleanMeta)
        return shaped(type, dice.chance(50), optional);
    if (type == StandardTypes::uuidMeta)
        return shaped(type, UUID{{static_cast<std::uint8_t>(natural)}}, optional);
    if (type == StandardTypes::dateTimeMeta)
        return shaped(type,
                      dice.oneOf({day, day + boost::posix_time::hours(1), ptime(),
                                  ptime(boost::posix_time::pos_infin)}),
                      optional);
    if (isEnum(type))
        return Value(type, static_cast<long>(number));
    return shaped(StandardTypes::integerMeta, number, optional);
}

/// Some elements of all classes, which refer to each other.
class RandomModel
{
public:
    /// At most so many elements, and stand-ins besides; that share of the properties gets values.
    RandomModel(Zoo const& zoo, Dice& dice, std::size_t most, int percentFilled)
        : m_zoo(zoo),
          m_dice(dice)
    {
        for (std::size_t left = dice.below(most + 1); left > 0; --left)
            m_elements.push_back(makeElement());
        for (ModelElement const& element : m_elements)
        {
            for (meta::Property const& property : m_zoo.propertiesOf(element->getMetaClass()))
            {
                if (dice.chance(percentFilled) && !isContainment(property))
                    tryToFill(element, property);
            }
        }
        putIntoEachOther();
    }

    std::vector<ModelElement> const& elements() const { return m_elements; }

    Model const model = Model::create(ModelConstellation());

private:
    ModelElement makeElement()
    {
        switch (m_dice.below(8))
        {
        case 0:
        case 1:
            return ModelElement::createReflective(model, m_zoo.base);
        case 2:
        case 3:
            return ModelElement::createReflective(model, m_zoo.derived);
        case 4:
            return m_dice.chance(25) ? makeOwnNode() : Node::create(model);
        case 5:
            return SpecialNode::create(model);
        case 6:
            return shapes::Scalars::create(model);
        default:
            return shapes::Optionals::create(model);
        }
    }
    ModelElement makeOwnNode() const
    {
        ModelElement const made(new OwnNode(model, UUID()));
        made->notifyCreated();
        return made;
    }

    /// Whether random targets could close a circle there.
    static bool isContainment(meta::Property const& property)
    {
        meta::Property const opposite = property->getOpposite();
        return property->isComposite() || (opposite && opposite->isComposite());
    }
    void putIntoEachOther()
    {
        ModelElement whole;
        for (ModelElement const& element : m_elements)
        {
            if (!element->getMetaClass()->isA(m_zoo.base))
                continue;
            if (whole && m_dice.chance(30))
                referencesOf(whole, m_zoo.parts).getGenericInterface()->genericAdd(element);
            whole = element;
        }
    }
    /// Sets a value or adds some; leaves it if that is not possible.
    void tryToFill(ModelElement const& element, meta::Property const& property)
    {
        try
        {
            if (property->getUpper() == 1)
                setSingle(element, property);
            else if (!property->isDerived())
                addMany(element, property);
        }
        catch (std::exception const&)
        {}
    }
    void setSingle(ModelElement const& element, meta::Property const& property)
    {
        meta::Type const type = property->getType();
        Value const value = isClass(type) ? Value::createElementValue(property, target())
                                          : plainValue(m_dice, type, m_dice.chance(40));
        element->setPropertyValue(property, value, ModelElement::Impl::PRIVILEGED_ACCESS);
    }
    void addMany(ModelElement const& element, meta::Property const& property)
    {
        for (std::size_t left = m_dice.below(4); left > 0; --left)
        {
            if (isClass(property->getType()))
                referencesOf(element, property).getGenericInterface()->genericAdd(target());
            else
                valuesOf(element, property)
                    .genericAdd(plainValue(m_dice, property->getType(), /*optional=*/false));
        }
    }
    /// An element, or a stand-in for one, or for nothing.
    ModelElement target()
    {
        ModelElement const element = m_dice.pick(m_elements);
        if (m_dice.chance(60))
            return element;
        ustring const id = wide(boost::uuids::to_string(element->getUuid()));
        ustring const type = m_dice.chance(80) ? ElementId::UUID_TYPE : ustring(u"name");
        bool const isForeign = m_dice.chance(30);
        boost::optional<ustring> const modelId =
            boost::make_optional(isForeign, ustring(u"file:elsewhere"));
        return ModelElement::createProxy(
            model, element->getMetaClass(),
            ProxyId(type, m_dice.chance(80) ? id : u"nobody", modelId));
    }

    Zoo const& m_zoo;
    Dice& m_dice;
    std::vector<ModelElement> m_elements;
};

/// Builds queries that make sense now and then.
class RandomQuery
{
public:
    RandomQuery(Zoo const& zoo, RandomModel const& world, Dice& dice, std::size_t instances)
        : m_zoo(zoo),
          m_world(world),
          m_dice(dice),
          query(world.model)
    {
        for (std::size_t id = 0; id < instances; ++id)
        {
            m_classes.push_back(dice.pick(zoo.classes));
            query.addSearchClass(m_classes.back(), dice.chance(30) ? EXACTLY : WITH_SUBCLASSES);
        }
        for (std::size_t left = dice.below(4); left > 0; --left)
            tryToAdd([&] { addConstraint(); });
        std::size_t const joins = instances > 1 ? dice.below(4) : dice.below(10) / 9;
        for (std::size_t left = joins; left > 0; --left)
            tryToAdd([&] { addJoin(); });
        if (dice.chance(25))
            query.setResultLimit(dice.below(4));
        if (dice.chance(25))
            query.setResultOffset(dice.below(4));
        for (std::size_t left = dice.below(4); left > 0; --left)
            columns.push_back(dice.below(instances));
    }

private:
    template <class Add> static void tryToAdd(Add const& add)
    {
        try
        {
            add();
        }
        catch (std::exception const&)
        {}
    }
    std::size_t instance() { return m_dice.below(m_classes.size()); }
    meta::Property propertyFor(std::size_t id)
    {
        auto const& known = m_zoo.propertiesOf(m_classes[id]);
        return known.empty() || m_dice.chance(3) ? m_dice.pick(m_zoo.all) : m_dice.pick(known);
    }
    ValueMatchRelation relation()
    {
        return m_dice.chance(45) ? ValueMatchRelation::equal : ValueMatchRelation(m_dice.below(9));
    }
    void addConstraint()
    {
        std::size_t const id = instance();
        if (m_dice.chance(10))
        {
            query.addTopLevelConstraint(id);
            return;
        }
        meta::Property const property = propertyFor(id);
        if (m_dice.chance(15))
            query.addPropertyRelation(property, relation(), another(property, id), id, id);
        else
            query.addValueConstraint(property, relation(), constraintValue(property), id);
    }
    /// Mostly one that suits.
    Value constraintValue(meta::Property const& property)
    {
        meta::Type const type = property->getType();
        bool const isText =
            type == StandardTypes::stringMeta || type == StandardTypes::stdstringMeta;
        if (isText && m_dice.chance(40))
            return pattern(type);
        if (m_dice.chance(4))
            return plainValue(m_dice, m_dice.pick(m_zoo.all)->getType(), m_dice.chance(50));
        if (isClass(type))
            return Value::createElementValue(property, m_dice.chance(90) && !elements().empty()
                                                           ? m_dice.pick(elements())
                                                           : ModelElement());
        bool const optional = m_dice.chance(property->getLower() == 0 ? 60 : 5);
        if (optional && m_dice.chance(30))
            return Value::createEmptyValue(type, /*required=*/false);
        return plainValue(m_dice, type, optional);
    }
    Value pattern(meta::Type const& type)
    {
        string const characters = m_dice.oneOf<char const*>(
            {"a%", "_", "%", "a|b", "^a$", ".*", "a.b", "[ab]+", "(a)\\1?", "(", "a", "a\\.b"});
        return type == StandardTypes::stringMeta ? Value(type, wide(characters))
                                                 : Value(type, characters);
    }
    /// A property of the same type that the other instance has, if there is one.
    meta::Property another(meta::Property const& property, std::size_t id)
    {
        std::vector<meta::Property> fitting;
        for (meta::Property const& known : m_zoo.propertiesOf(m_classes[id]))
        {
            if (known->getType() == property->getType())
                fitting.push_back(known);
        }
        return fitting.empty() ? property : m_dice.pick(fitting);
    }
    void addJoin()
    {
        std::size_t const first = instance();
        std::size_t second = instance();
        if (second == first && m_dice.chance(90))
            second = (second + 1) % m_classes.size();
        if (m_dice.chance(45))
        {
            meta::Property property = propertyFor(first);
            for (int tries = 0; tries < 9 && !isClass(property->getType()); ++tries)
                property = propertyFor(first);
            query.addAssociatedObjectConstraint(property, first, second);
            return;
        }
        meta::Property const left = propertyFor(first);
        query.addPropertyRelation(left, relation(), another(left, second), first, second);
    }
    std::vector<ModelElement> const& elements() const { return m_world.elements(); }

    Zoo const& m_zoo;
    RandomModel const& m_world;
    Dice& m_dice;
    std::vector<meta::Class> m_classes;

public:
    NativeTarnkilnQuery query;
    Columns columns;
};

/// What a run gave: rows, a number, or a failure.
struct Outcome
{
    Rows rows;
    Row first;
    std::size_t count = 0;
    string failure;

    bool operator==(Outcome const& other) const = default;
};

Outcome runWith(RandomQuery& random, NativeTarnkilnQuery::Engine engine)
{
    Outcome outcome;
    random.query.useEngine(engine);
    auto const attempt = [&](auto const& call) {
        try
        {
            call();
        }
        catch (std::exception const& failure)
        {
            outcome.failure += string(typeid(failure).name()) + ": " + failure.what() + '\n';
        }
    };
    attempt([&] { outcome.rows = rowsOf(random.query, random.columns); });
    attempt([&] { outcome.first = random.query.getFirstResult(random.columns); });
    attempt([&] { outcome.count = random.query.getResultCount(); });
    return outcome;
}

/// Runs queries with both engines and compares what they give.
class Comparison
{
public:
    void run(RandomQuery& random, Dice& dice)
    {
        bool const plainFirst = dice.chance(50);
        Outcome const first = runWith(random, plainFirst ? &runPlainly : nullptr);
        Outcome const second = runWith(random, plainFirst ? nullptr : &runPlainly);
        ++m_runs;
        m_failures += !first.failure.empty();
        m_withRows += !first.rows.empty();

        ASSERT_EQ(first.failure, second.failure) << m_runs << plainFirst;
        ASSERT_EQ(first, second) << m_runs << plainFirst;
    }
    void expectVariety() const
    {
        EXPECT_GT(m_failures, m_runs / 50);
        EXPECT_GT(m_withRows, m_runs / 10);
    }

private:
    int m_runs = 0;
    int m_failures = 0;
    int m_withRows = 0;
};

class RandomQueries : public ::testing::TestWithParam<unsigned>
{};

TEST_P(RandomQueries, GiveTheSameRowsWithBothEngines)
{
    Zoo const zoo;
    Dice dice(GetParam());
    Comparison comparison;
    for (int model = 0; model < 120; ++model)
    {
        RandomModel const world(zoo, dice, dice.chance(10) ? 30 : 12, 60);
        for (int number = 0; number < 50; ++number)
        {
            RandomQuery random(zoo, world, dice, dice.oneOf<std::size_t>({1, 1, 1, 2, 2, 2, 3}));
            ASSERT_NO_FATAL_FAILURE(comparison.run(random, dice)) << model;
        }
    }
    comparison.expectVariety();
}

TEST_P(RandomQueries, GiveTheSameRowsOfManyElements)
{
    Zoo const zoo;
    Dice dice(GetParam());
    Comparison comparison;
    for (int model = 0; model < 2; ++model)
    {
        RandomModel const world(zoo, dice, 200, 4);
        for (int number = 0; number < 200; ++number)
        {
            RandomQuery random(zoo, world, dice, 1);
            ASSERT_NO_FATAL_FAILURE(comparison.run(random, dice)) << model;
        }
    }
    comparison.expectVariety();
}

INSTANTIATE_TEST_SUITE_P(Seeds, RandomQueries, ::testing::Values(1u, 2u, 3u, 4u));
}  // namespace
}  // namespace testkit

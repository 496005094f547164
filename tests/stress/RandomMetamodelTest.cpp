// Metamodels drawn at random, defined at run time, and random edits of their elements in
// transactions, beside a model of plain numbers.
#include "tests/meta/ReflectiveFixture.h"
#include "tests/stress/DrawnMetamodel.h"

#include <rapidcheck.h>

#include <numeric>

namespace testkit {
namespace {

/// What was drawn, as classes and properties of a run-time metamodel.
class DefinedMetamodel
{
public:
    DefinedMetamodel(RuntimeMetamodel& metamodel, DrawnMetamodel const& drawn)
    {
        for (int const superclass : drawn.superclasses)
        {
            m_classes.push_back(metamodel.makeClass(nameOf("C", m_classes.size()),
                                                    superclass == DrawnMetamodel::NONE
                                                        ? ModelElement::metaClass()
                                                        : metaClass(superclass)));
        }
        // a superclass has all its properties before its subclasses number theirs
        std::vector<int> order(drawn.properties.size());
        std::iota(order.begin(), order.end(), 0);
        std::stable_sort(order.begin(), order.end(), [&](int left, int right) {
            return drawn.at(left).owner < drawn.at(right).owner;
        });
        m_properties.resize(order.size());
        for (int const number : order)
            m_properties[static_cast<std::size_t>(number)] = define(metamodel, drawn, number);
        for (int const number : order)
        {
            int const opposite = drawn.at(number).opposite;
            if (opposite != DrawnMetamodel::NONE)
                property(number)->setOpposite(property(opposite));
        }
    }

    meta::Class const& metaClass(int number) const
    {
        return m_classes[static_cast<std::size_t>(number)];
    }
    meta::Property const& property(int number) const
    {
        return m_properties[static_cast<std::size_t>(number)];
    }
    int propertyCount() const { return static_cast<int>(m_properties.size()); }

private:
    static ustring nameOf(char const* prefix, std::size_t number)
    {
        string const name = prefix + std::to_string(number);
        return ustring(name.begin(), name.end());
    }
    meta::Property define(RuntimeMetamodel& metamodel, DrawnMetamodel const& drawn, int number)
    {
        DrawnMetamodel::Property const& plain = drawn.at(number);
        PropertySketch sketch = metamodel.property(
            metaClass(plain.owner), nameOf("p", static_cast<std::size_t>(number)),
            drawn.isAttribute(number) ? meta::Type(StandardTypes::integerMeta)
                                      : meta::Type(metaClass(plain.target)));
        if (plain.many)
            sketch.many();
        else if (drawn.isAttribute(number))
            sketch.required();
        if (plain.ordered)
            sketch.ordered();
        if (plain.unique)
            sketch.unique();
        if (plain.composite)
            sketch.composite();
        return sketch;
    }

    std::vector<meta::Class> m_classes;
    std::vector<meta::Property> m_properties;
};

/// A drawn metamodel in the library, elements of it, and their mirror.
class Theatre
{
public:
    explicit Theatre(std::mt19937& random)
        : m_random(random),
          m_drawn(DrawnMetamodel::draw(random)),
          m_mirror(m_drawn),
          m_defined(m_metamodel, m_drawn)
    {}

    /// A transaction with some edits, committed or taken back.
    void playScene()
    {
        ElementMirror const before = m_mirror;
        Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
        for (int steps = draw(8); steps >= 0; --steps)
        {
            edit();
            expectEqual();
        }
        if (draw(2) == 0)
        {
            transaction.rollBack();
            m_mirror = before;
        }
        else
        {
            RC_ASSERT(transaction.commit() == TransactionResult::Committed);
        }
        expectEqual();
    }

private:
    int draw(int count) { return static_cast<int>(m_random() % static_cast<unsigned>(count)); }
    ModelElement const& element(int number) const
    {
        return m_elements[static_cast<std::size_t>(number)];
    }
    meta::Property const& property(int number) const { return m_defined.property(number); }

    void edit()
    {
        std::vector<int> alive;
        for (auto const& [number, plain] : m_mirror.elements())
            alive.push_back(number);
        int const kind = draw(12);
        if (alive.empty() || kind < 2)
        {
            create();
            return;
        }
        int const x = alive[static_cast<std::size_t>(draw(static_cast<int>(alive.size())))];
        if (kind == 2)
        {
            m_mirror.destroy(x);
            element(x)->destroy();
            return;
        }
        std::vector<int> own;
        for (int number = 0; number < m_defined.propertyCount(); ++number)
        {
            if (m_drawn.isA(m_mirror.classOf(x), m_drawn.at(number).owner))
                own.push_back(number);
        }
        if (own.empty())
            return;
        int const p = own[static_cast<std::size_t>(draw(static_cast<int>(own.size())))];
        if (m_drawn.isAttribute(p))
            editNumber(x, p);
        else
            editReference(x, p, alive);
    }
    void create()
    {
        int const metaClass = draw(static_cast<int>(m_drawn.superclasses.size()));
        m_mirror.create(static_cast<int>(m_elements.size()), metaClass);
        m_elements.push_back(
            ModelElement::createReflective(m_model, m_defined.metaClass(metaClass)));
    }
    void editNumber(int x, int p)
    {
        int const number = draw(5);
        if (m_drawn.at(p).many)
        {
            m_mirror.addNumber(x, p, number);
            valuesOf(element(x), property(p)).genericAdd(Value(StandardTypes::integerMeta, number));
            return;
        }
        m_mirror.setNumber(x, p, number);
        set(element(x), property(p), number);
    }
    void editReference(int x, int p, std::vector<int> const& alive)
    {
        std::vector<int> targets;
        for (int const number : alive)
        {
            if (m_drawn.isA(m_mirror.classOf(number), m_drawn.at(p).target))
                targets.push_back(number);
        }
        bool const many = m_drawn.at(p).many;
        int const y =
            targets.empty() || (!many && draw(4) == 0)
                ? DrawnMetamodel::NONE
                : targets[static_cast<std::size_t>(draw(static_cast<int>(targets.size())))];
        if (!many)
        {
            ModelElement const target = y == DrawnMetamodel::NONE ? ModelElement() : element(y);
            expectDone(m_mirror.set(x, p, y), [&] { set(element(x), property(p), target); });
            return;
        }
        if (y == DrawnMetamodel::NONE)
            return;
        GenericCollectionInterface& collection = genericOf(element(x), property(p));
        if (draw(3) == 0)
        {
            m_mirror.remove(x, p, y);
            collection.genericRemove(element(y));
            return;
        }
        expectDone(m_mirror.add(x, p, y), [&] { collection.genericAdd(element(y)); });
    }
    static void expectDone(bool done, std::function<void()> const& call)
    {
        if (done)
            call();
        else
            RC_ASSERT(
                static_cast<bool>(tarnkiln::tests::raises<messages::CircularContainment>(call)));
    }

    int numberOf(ModelElement const& sought) const
    {
        auto const place = std::find(m_elements.begin(), m_elements.end(), sought);
        return place == m_elements.end() ? DrawnMetamodel::NONE
                                         : static_cast<int>(place - m_elements.begin());
    }
    std::vector<int> valuesIn(ModelElement const& holder, int p) const
    {
        if (m_drawn.isAttribute(p))
        {
            if (!m_drawn.at(p).many)
                return {get<int>(holder, property(p))};
            std::vector<int> numbers;
            for (Value const& value : valuesOf(holder, property(p)).getAllValues())
                numbers.push_back(value.getValue<int>());
            return numbers;
        }
        std::vector<int> numbers;
        if (m_drawn.at(p).many)
        {
            for (ModelElement const& entry : entriesOf(holder, property(p)))
                numbers.push_back(numberOf(entry));
        }
        else if (int const target = numberOf(targetOf(holder, property(p)));
                 target != DrawnMetamodel::NONE)
        {
            numbers.push_back(target);
        }
        return numbers;
    }
    void expectEqual() const
    {
        RC_ASSERT(m_model->checkInvariants() == std::vector<std::string>());
        for (int number = 0; number < static_cast<int>(m_elements.size()); ++number)
        {
            bool const alive = m_mirror.elements().count(number) != 0;
            RC_ASSERT(static_cast<bool>(element(number)) == alive);
            if (alive)
                expectEqual(number);
        }
    }
    void expectEqual(int number) const
    {
        RC_ASSERT(numberOf(element(number)->container()) ==
                  m_mirror.elements().at(number).container);
        for (int p = 0; p < m_defined.propertyCount(); ++p)
        {
            if (!m_drawn.isA(m_mirror.classOf(number), m_drawn.at(p).owner))
                continue;
            std::vector<int> actual = valuesIn(element(number), p);
            std::vector<int> expected = m_mirror.valuesOf(number, p);
            if (m_drawn.isAttribute(p) && !m_drawn.at(p).many && expected.empty())
                expected = {0};
            if (!m_drawn.at(p).ordered)
            {
                std::sort(actual.begin(), actual.end());
                std::sort(expected.begin(), expected.end());
            }
            RC_ASSERT(actual == expected);
        }
    }

    std::mt19937& m_random;
    DrawnMetamodel const m_drawn;
    ElementMirror m_mirror;
    RuntimeMetamodel m_metamodel;
    DefinedMetamodel const m_defined;
    Model const m_model = Model::create(ModelConstellation());
    std::vector<ModelElement> m_elements;  ///< All that were ever created, by number.
};

TEST(RandomMetamodels, HaveElementsThatDoWhatTheMirrorDoes)
{
    EXPECT_TRUE(rc::check("edits and transactions do what the mirror does", [] {
        std::mt19937 random(*rc::gen::arbitrary<std::uint32_t>());
        Theatre theatre(random);
        for (int scenes = 0; scenes < 10; ++scenes)
            theatre.playScene();
    }));
}

TEST(RandomMetamodels, TakeBackWholeWhatATransactionDefinedOfThem)
{
    EXPECT_TRUE(rc::check("a rolled back definition leaves no trace", [] {
        std::mt19937 random(*rc::gen::arbitrary<std::uint32_t>());
        RuntimeMetamodel metamodel;
        std::size_t const before = metamodel.model->getAllElements().size();
        Transaction const transaction = metamodel.model->beginTransaction(/*revertible=*/true);
        DefinedMetamodel const defined(metamodel, DrawnMetamodel::draw(random));
        RC_ASSERT(metamodel.model->getAllElements().size() > before);
        transaction.rollBack();
        RC_ASSERT(metamodel.model->getAllElements().size() == before);
        RC_ASSERT(metamodel.package->getOwnedTypes().empty());
        RC_ASSERT(metamodel.model->checkInvariants() == std::vector<std::string>());
    }));
}
}  // namespace
}  // namespace testkit

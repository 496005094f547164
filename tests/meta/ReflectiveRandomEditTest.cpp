// Random edits of reflective elements beside the same edits of plain structs, with rollbacks.
#include "tests/meta/ReflectiveFixture.h"

#include <rapidcheck.h>

#include <random>

namespace testkit {
namespace {

constexpr int NOBODY = -1;
constexpr int COUNT = 7;

/// What the element with that number should look like.
struct Plain
{
    bool alive = true;
    ustring name;
    int left = NOBODY, right = NOBODY, owner = NOBODY, parent = NOBODY, scope = NOBODY;
    std::vector<int> owned, children;

    int container() const { return parent != NOBODY ? parent : scope; }
};

/// All elements as plain structs; each edit answers whether it is allowed.
class PlainModel
{
public:
    enum class Refusal
    {
        None,
        Circle,
        Key
    };

    Plain const& operator[](int number) const { return m_all[static_cast<std::size_t>(number)]; }

    Refusal setName(int x, ustring const& name)
    {
        if (at(x).name != name && at(x).scope != NOBODY && isTaken(at(x).scope, name))
            return Refusal::Key;
        at(x).name = name;
        return Refusal::None;
    }
    Refusal setLeft(int x, int target)
    {
        if (at(x).left == target)
            return Refusal::None;
        if (at(x).left != NOBODY)
            at(at(x).left).right = NOBODY;
        at(x).left = target;
        if (target == NOBODY)
            return Refusal::None;
        if (at(target).right != NOBODY)
            at(at(target).right).left = NOBODY;
        at(x).left = target;
        at(target).right = x;
        return Refusal::None;
    }
    Refusal setOwner(int x, int target)
    {
        if (at(x).owner == target)
            return Refusal::None;
        if (at(x).owner != NOBODY)
            std::erase(at(at(x).owner).owned, x);
        at(x).owner = target;
        if (target != NOBODY)
            at(target).owned.push_back(x);
        return Refusal::None;
    }
    Refusal setParent(int x, int target)
    {
        if (at(x).parent == target)
            return Refusal::None;
        if (target != NOBODY && isBelow(target, x))
            return Refusal::Circle;
        leaveContainer(x);
        at(x).parent = target;
        if (target != NOBODY)
            at(target).children.push_back(x);
        return Refusal::None;
    }
    Refusal setScope(int x, int target)
    {
        if (at(x).scope == target)
            return Refusal::None;
        if (target != NOBODY && isTaken(target, at(x).name))
            return Refusal::Key;
        if (target != NOBODY && isBelow(target, x))
            return Refusal::Circle;
        leaveContainer(x);
        at(x).scope = target;
        return Refusal::None;
    }
    Refusal destroy(int x)
    {
        for (int other = 0; other < COUNT; ++other)
        {
            if (at(other).alive && other != x && at(other).container() == x)
                destroy(other);
        }
        setLeft(x, NOBODY);
        if (at(x).right != NOBODY)
            setLeft(at(x).right, NOBODY);
        setOwner(x, NOBODY);
        for (int const member : std::vector<int>(at(x).owned))
            setOwner(member, NOBODY);
        leaveContainer(x);
        at(x) = Plain();
        at(x).alive = false;
        return Refusal::None;
    }

private:
    Plain& at(int number) { return m_all[static_cast<std::size_t>(number)]; }
    bool isTaken(int scope, ustring const& name)
    {
        return std::any_of(m_all.begin(), m_all.end(), [&](Plain const& other) {
            return other.scope == scope && other.name == name;
        });
    }
    bool isBelow(int low, int high)
    {
        while (low != NOBODY && low != high)
            low = at(low).container();
        return low == high;
    }
    void leaveContainer(int x)
    {
        if (at(x).parent != NOBODY)
            std::erase(at(at(x).parent).children, x);
        at(x).parent = at(x).scope = NOBODY;
    }

    std::vector<Plain> m_all = std::vector<Plain>(COUNT);
};

using Refusal = PlainModel::Refusal;

class ReflectiveRandomEdit : public ReflectiveFixture
{
protected:
    using Edit = std::function<void()>;

    /// Which refusal `edit` ends with.
    static Refusal refusalOf(Edit const& edit)
    {
        try
        {
            edit();
            return Refusal::None;
        }
        catch (messages::CircularContainment const&)
        {
            return Refusal::Circle;
        }
        catch (messages::UniquenessConstraint const&)
        {
            return Refusal::Key;
        }
    }

    int numberOf(ModelElement const& element) const
    {
        auto const place = std::find(elements.begin(), elements.end(), element);
        return place == elements.end() ? NOBODY : static_cast<int>(place - elements.begin());
    }
    std::vector<int> numbersOf(std::vector<ModelElement> const& members) const
    {
        std::vector<int> result;
        for (ModelElement const& member : members)
            result.push_back(numberOf(member));
        return result;
    }
    void expectEqual(PlainModel const& expected) const
    {
        for (int number = 0; number < COUNT; ++number)
        {
            ModelElement const& x = elements[static_cast<std::size_t>(number)];
            Plain const& plain = expected[number];
            ASSERT_EQ(static_cast<bool>(x), plain.alive);
            if (!plain.alive)
                continue;
            ASSERT_EQ(get<ustring>(x, name), plain.name);
            ASSERT_EQ(numberOf(targetOf(x, left)), plain.left);
            ASSERT_EQ(numberOf(targetOf(x, right)), plain.right);
            ASSERT_EQ(numberOf(targetOf(x, owner)), plain.owner);
            ASSERT_EQ(numberOf(targetOf(x, parent)), plain.parent);
            ASSERT_EQ(numberOf(targetOf(x, scope)), plain.scope);
            ASSERT_EQ(numberOf(x->container()), plain.container());
            ASSERT_EQ(numbersOf(entriesOf(x, owned)), plain.owned);
            ASSERT_EQ(numbersOf(entriesOf(x, children)), plain.children);
            if (plain.scope != NOBODY)
            {
                GenericMapInterface& map = mapOf(targetOf(x, scope), byName);
                ASSERT_EQ(map.genericFind(Value(StandardTypes::stringMeta, plain.name)), x);
            }
        }
        ASSERT_THAT(model->checkInvariants(), IsEmpty());
    }

    /// One edit on both sides; elements that are gone are let be.
    void edit(std::mt19937& random, PlainModel& plain)
    {
        auto const draw = [&](int count) { return static_cast<int>(random() % count); };
        int const x = draw(COUNT);
        int target = draw(COUNT + 1) - 1;
        if (!plain[x].alive)
            return;
        if (target != NOBODY && !plain[target].alive)
            target = NOBODY;
        ModelElement const& element = elements[static_cast<std::size_t>(x)];
        ModelElement const other =
            target == NOBODY ? ModelElement() : elements[static_cast<std::size_t>(target)];

        switch (draw(16))
        {
        case 0:
            plain.destroy(x);
            element->destroy();
            return;
        case 1:
        case 2:
        case 3: {
            ustring const text(1, static_cast<char16_t>(u'a' + draw(3)));
            Refusal const expected = plain.setName(x, text);
            ASSERT_EQ(refusalOf([&] { set(element, name, text); }), expected);
            return;
        }
        case 4:
        case 5:
        case 6: {
            Refusal const expected = plain.setLeft(x, target);
            ASSERT_EQ(refusalOf([&] { set(element, left, other); }), expected);
            return;
        }
        case 7:
        case 8:
        case 9: {
            Refusal const expected = plain.setOwner(x, target);
            ASSERT_EQ(refusalOf([&] { set(element, owner, other); }), expected);
            return;
        }
        case 10:
        case 11:
        case 12: {
            Refusal const expected = plain.setScope(x, target);
            ASSERT_EQ(refusalOf([&] { set(element, scope, other); }), expected);
            return;
        }
        default: {
            Refusal const expected = plain.setParent(x, target);
            ASSERT_EQ(refusalOf([&] { set(element, parent, other); }), expected);
            return;
        }
        }
    }

    meta::Class const node = metamodel.makeClass(u"Node");
    meta::Property const name =
        metamodel.property(node, u"name", StandardTypes::stringMeta).required();
    meta::Property const left = metamodel.property(node, u"left", node);
    meta::Property const right = metamodel.property(node, u"right", node).opposite(left);
    meta::Property const owned = metamodel.property(node, u"owned", node).many().ordered();
    meta::Property const owner = metamodel.property(node, u"owner", node).opposite(owned);
    meta::Property const children =
        metamodel.property(node, u"children", node).many().ordered().composite();
    meta::Property const parent = metamodel.property(node, u"parent", node).opposite(children);
    meta::Property const byName =
        metamodel.property(node, u"byName", node).keyedBy(name).composite();
    meta::Property const scope = metamodel.property(node, u"scope", node).opposite(byName);
    std::vector<ModelElement> elements;
};

TEST_F(ReflectiveRandomEdit, GivesWhatPlainStructsGiveAndIsTakenBackWhole)
{
    bool const holds = rc::check([&] {
        std::mt19937 random(*rc::gen::arbitrary<std::uint32_t>());
        model->destroyAllContents();
        elements.clear();
        for (int number = 0; number < COUNT; ++number)
            elements.push_back(make(node));
        PlainModel plain;

        for (int round = 0; round < 12; ++round)
        {
            PlainModel const before = plain;
            Transaction const transaction = begin();
            for (int step = 0; step < 6; ++step)
            {
                edit(random, plain);
                expectEqual(plain);
            }
            if (random() % 2)
            {
                transaction.commit();
            }
            else
            {
                transaction.rollBack();
                plain = before;
            }
            expectEqual(plain);
            RC_ASSERT(!HasFatalFailure());
        }
    });
    EXPECT_TRUE(holds);
}
}  // namespace
}  // namespace testkit

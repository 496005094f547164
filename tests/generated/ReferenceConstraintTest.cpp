// What is asked of references by the members of search instances, and joins.
#include "shapes/KeyedConstrainables.h"
#include "shapes/KeyedImpl.h"
#include "shapes/NodeConstrainables.h"
#include "shapes/NodeImpl.h"
#include "shapes/OptionalsConstrainables.h"
#include "shapes/OptionalsImpl.h"
#include "shapes/ScalarsConstrainables.h"
#include "shapes/ScalarsImpl.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/query/ModelElementConstrainables.h"
#include "tarnkiln/query/RetargetableQuery.h"
#include "tests/generated/ConstrainablesFixture.h"

#include <tuple>

namespace testkit::shapes {
namespace {

constexpr auto EXACTLY = SearchClassMatchMode::MatchExactClass;
constexpr auto WITH_SUBCLASSES = SearchClassMatchMode::MatchSubclasses;

class ReferenceConstraint : public QueriedShapes
{
protected:
    Node node(ustring const& name) const
    {
        Node const result = Node::create(m_model);
        result->setName(name);
        return result;
    }
    /// The rows of all columns as a vector.
    template <class... Instance>
    static std::vector<std::tuple<typename Instance::Handle...>> rows(AbstractQuery& query,
                                                                      Instance const&... columns)
    {
        std::vector<std::tuple<typename Instance::Handle...>> result;
        for (auto const& row : query.results(columns...))
            result.push_back(row);
        return result;
    }
};

TEST_F(ReferenceConstraint, NamesTheElementThatIsReferredTo)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    Node const c = node(u"c");
    a->setBuddy(b);
    b->setBuddy(c);
    b->getLinks().push_back(a);
    b->getLinks().push_back(c);

    EXPECT_THAT(found<Node>([&](auto const& each) { each.buddy == b; }), ElementsAre(a));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.buddy != b; }),
                UnorderedElementsAre(b, c));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.buddy == Node(); }), ElementsAre(c));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.buddy != Node(); }),
                UnorderedElementsAre(a, b));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.links == c; }), ElementsAre(b));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.backlinks == b; }),
                UnorderedElementsAre(a, c));
}

TEST_F(ReferenceConstraint, TakesHandlesOfRelatedClasses)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    a->setBuddy(b);
    a->setAbout(b);
    b->setDescribed(Node::metaClass());

    EXPECT_THAT(found<Node>([&](auto const& each) { each.buddy == ModelElement(b); }),
                ElementsAre(a));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.about == b; }), ElementsAre(a));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.described == Node::metaClass(); }),
                ElementsAre(b));
}

TEST_F(ReferenceConstraint, ReachesContainersAndContents)
{
    Node const parent = node(u"parent");
    Node const child = node(u"child");
    Node const named = node(u"named");
    parent->getChildren().push_back(child);
    parent->getNamed().insert(named);

    EXPECT_THAT(found<Node>([&](auto const& each) { each.parent == parent; }), ElementsAre(child));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.children == child; }),
                ElementsAre(parent));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.named == named; }), ElementsAre(parent));
    EXPECT_THAT(found<Node>([&](auto const& each) { each.isTopLevel(); }), ElementsAre(parent));
}

TEST_F(ReferenceConstraint, ComparesTwoReferencesOfOneElement)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    a->setBuddy(b);
    a->setLeft(b);
    b->setBuddy(b);

    EXPECT_THAT(found<Node>([](auto const& each) { each.buddy == each.left; }), ElementsAre(a));
    EXPECT_THAT(found<Node>([](auto const& each) { each.buddy != each.left; }), ElementsAre(b));
}

TEST_F(ReferenceConstraint, JoinsTheReferringWithTheReferred)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    Node const c = node(u"c");
    a->setBuddy(b);
    b->setBuddy(c);
    c->getLinks().push_back(a);
    c->getLinks().push_back(b);

    AbstractQuery one(m_model);
    Node::Constrainables const source({one, EXACTLY});
    Node::Constrainables const target({one, EXACTLY});
    source.buddy.refersTo(target);
    EXPECT_THAT(rows(one, source, target),
                UnorderedElementsAre(std::tuple(a, b), std::tuple(b, c)));

    AbstractQuery many(m_model);
    Node::Constrainables const linking({many, EXACTLY});
    Node::Constrainables const linked({many, EXACTLY});
    linking.links.refersTo(linked);
    linked.name == u"b";
    EXPECT_THAT(rows(many, linked, linking), ElementsAre(std::tuple(b, c)));
}

TEST_F(ReferenceConstraint, MeetsAProxyByTheIdentityThatItNames)
{
    Node const target = node(u"target");
    Node const source = node(u"source");
    ModelElement const proxy = ModelElement::createProxy(
        m_model, Node::metaClass(), target->getPersistentProxyId(/*omitModel=*/false));
    source->setBuddy(Node::cast(proxy));

    AbstractQuery query(m_model);
    Node::Constrainables const referring({query, EXACTLY});
    Node::Constrainables const referred({query, EXACTLY});
    referring.buddy.refersTo(referred);

    EXPECT_THAT(rows(query, referring, referred), ElementsAre(std::tuple(source, target)));
    EXPECT_TRUE(source->getBuddyImpl()->isProxy());
}

TEST_F(ReferenceConstraint, JoinsAnInstanceOfAnyRelatedClass)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    a->setAbout(b);

    AbstractQuery query(m_model);
    Node::Constrainables const source({query, EXACTLY});
    Node::Constrainables const target({query, EXACTLY});
    source.about.refersTo(target);
    EXPECT_THAT(rows(query, source, target), ElementsAre(std::tuple(a, b)));

    AbstractQuery wide(m_model);
    Node::Constrainables const left({wide, EXACTLY});
    ModelElement::Constrainables const any(wide, ModelElement::metaClass(), WITH_SUBCLASSES);
    left.about.refersTo(any);
    EXPECT_THAT(rows(wide, left, any), ElementsAre(std::tuple(a, ModelElement(b))));
}

using ConstraintJoin = ReferenceConstraint;

TEST_F(ConstraintJoin, ComparesMembersOfTwoInstances)
{
    Scalars const small = Scalars::create(m_model);
    small->setInteger(1);
    small->setText(u"x");
    Scalars const large = Scalars::create(m_model);
    large->setInteger(2);
    large->setText(u"X");
    auto const pairs = [&](auto const& state) {
        AbstractQuery query(m_model);
        Scalars::Constrainables const left({query, EXACTLY});
        Scalars::Constrainables const right({query, EXACTLY});
        state(left, right);
        return rows(query, left, right);
    };
    std::tuple const rising(small, large);
    std::tuple const falling(large, small);
    std::tuple const both(small, small);
    std::tuple const bothLarge(large, large);

    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer == b.integer; }),
                UnorderedElementsAre(both, bothLarge));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer != b.integer; }),
                UnorderedElementsAre(rising, falling));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer < b.integer; }), ElementsAre(rising));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer <= b.integer; }),
                UnorderedElementsAre(rising, both, bothLarge));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer > b.integer; }), ElementsAre(falling));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.integer >= b.integer; }),
                UnorderedElementsAre(falling, both, bothLarge));
    EXPECT_THAT(pairs([](auto& a, auto& b) { a.text == b.text; }),
                UnorderedElementsAre(both, bothLarge));
    EXPECT_THAT(pairs([](auto& a, auto& b) {
                    a.text.equalNoCase(b.text);
                    a.integer < b.integer;
                }),
                ElementsAre(rising));
    EXPECT_THAT(pairs([](auto& a, auto& b) {
                    a.text.regexp(b.text);
                    a.integer != b.integer;
                }),
                IsEmpty());
}

TEST_F(ConstraintJoin, ComparesLiteralsAndReferences)
{
    Scalars const scalars = Scalars::create(m_model);
    scalars->setColour(Colour::Green);
    Keyed const keyed = Keyed::create(m_model);
    keyed->setColour(Colour::Green);
    Node const a = node(u"a");
    Node const b = node(u"b");
    a->setBuddy(b);
    b->setLeft(b);

    AbstractQuery literals(m_model);
    Scalars::Constrainables const plain({literals, EXACTLY});
    Keyed::Constrainables const derived({literals, EXACTLY});
    plain.colour == derived.colour;
    EXPECT_THAT(rows(literals, plain, derived), ElementsAre(std::tuple(scalars, keyed)));

    AbstractQuery references(m_model);
    Node::Constrainables const one({references, EXACTLY});
    Node::Constrainables const other({references, EXACTLY});
    one.buddy == other.left;
    one.buddy != Node();
    EXPECT_THAT(rows(references, one, other), ElementsAre(std::tuple(a, b)));
}

TEST_F(ConstraintJoin, ComparesMembersOfDifferentClasses)
{
    Scalars const scalars = Scalars::create(m_model);
    scalars->setText(u"same");
    scalars->setInteger(5);
    Node const match = node(u"same");
    node(u"other");
    Optionals const optionals = Optionals::create(m_model);
    optionals->setInteger(4);
    Optionals::create(m_model);

    AbstractQuery query(m_model);
    Scalars::Constrainables const left({query, EXACTLY});
    Node::Constrainables const right({query, EXACTLY});
    Optionals::Constrainables const third({query, EXACTLY});
    left.text == right.name;
    third.integer < left.integer;

    EXPECT_THAT(rows(query, left, right, third),
                ElementsAre(std::tuple(scalars, match, optionals)));
}

TEST_F(ConstraintJoin, ComparesMembersOfOneInstance)
{
    Scalars const equal = Scalars::create(m_model);
    Scalars const tied = Scalars::create(m_model);
    tied->setText(u"x");

    Node const own = node(u"own");
    own->setBuddy(own);
    Node::create(m_model);

    EXPECT_THAT(found<Scalars>([](auto const& each) { each.text == each.text; }),
                UnorderedElementsAre(equal, tied));
    EXPECT_THAT(found<Node>([](auto const& each) { each.buddy.refersTo(each); }), ElementsAre(own));
}

TEST_F(ConstraintJoin, RefusesMembersOfAnotherQuery)
{
    AbstractQuery query(m_model);
    Node::Constrainables const here({query, EXACTLY});
    AbstractQuery otherQuery(m_model);
    Node::Constrainables const there({otherQuery, EXACTLY});

    EXPECT_RAISES(tarnkiln::query::NoSuchInstanceId, here.name == there.name);
    EXPECT_RAISES(tarnkiln::query::NoSuchInstanceId, here.buddy == there.buddy);
    EXPECT_RAISES(tarnkiln::query::NoSuchInstanceId, here.buddy.refersTo(there));
}

using SearchInstance = ReferenceConstraint;

TEST_F(SearchInstance, IsNumberedInTheOrderOfConstruction)
{
    AbstractQuery query(m_model);
    Node::Constrainables const first({query, EXACTLY});
    Scalars::Constrainables const second({query, EXACTLY});

    EXPECT_EQ(first.getInstanceId(), 0u);
    EXPECT_EQ(second.getInstanceId(), 1u);
    EXPECT_EQ(&second.getQuery(), &query);
    EXPECT_EQ(&second.integer.getAttachment().getInstance(),
              static_cast<ModelElement::Constrainables const*>(&second));
    EXPECT_EQ(second.integer.getProperty(), property(Scalars::metaClass(), u"integer"));
}

TEST_F(SearchInstance, SeeksTheClassAloneOrItsSubclassesToo)
{
    Scalars const plain = Scalars::create(m_model);
    Keyed const derived = Keyed::create(m_model);

    AbstractQuery exact(m_model);
    Scalars::Constrainables const alone({exact, EXACTLY});
    EXPECT_THAT(rows(exact, alone), ElementsAre(std::tuple(plain)));

    AbstractQuery all(m_model);
    Scalars::Constrainables const family({all, WITH_SUBCLASSES});
    EXPECT_THAT(rows(all, family),
                UnorderedElementsAre(std::tuple(plain), std::tuple(Scalars(derived))));
}

TEST_F(SearchInstance, MaySeekAClassThatExtendsItsOwn)
{
    Scalars::create(m_model);
    Keyed const derived = Keyed::create(m_model);
    derived->setInteger(3);

    AbstractQuery query(m_model);
    Scalars::Constrainables const instance(query, Keyed::metaClass(), EXACTLY);
    instance.integer == 3;

    EXPECT_THAT(rows(query, instance), ElementsAre(std::tuple(Scalars(derived))));
}

TEST_F(SearchInstance, OffersInheritedMembers)
{
    Keyed const keyed = Keyed::create(m_model);
    keyed->setText(u"inherited");
    Keyed::create(m_model);

    EXPECT_THAT(found<Keyed>([](auto const& each) { each.text == u"inherited"; }),
                ElementsAre(keyed));
}

TEST_F(SearchInstance, RefusesAClassThatIsNotThere)
{
    AbstractQuery query(m_model);

    EXPECT_RAISES(tarnkiln::query::InvalidSearchClass,
                  ModelElement::Constrainables(query, meta::Class(), EXACTLY));
    EXPECT_RAISES(tarnkiln::query::InvalidSearchClass,
                  Node::Constrainables(query, meta::Class(), EXACTLY));
}

TEST_F(SearchInstance, StatesConstraintsByReflection)
{
    Node const a = node(u"a");
    Node const b = node(u"b");
    a->setBuddy(b);
    meta::Property const name = property(Node::metaClass(), u"name");
    meta::Property const buddy = property(Node::metaClass(), u"buddy");

    AbstractQuery query(m_model);
    ModelElement::Constrainables const source(query, Node::metaClass(), EXACTLY);
    ModelElement::Constrainables const target(query, Node::metaClass(), EXACTLY);
    source.constrain(name, query::ValueMatchRelation::equal,
                     Value(meta::StandardTypes::stringMeta, ustring(u"a")));
    source.constrain(name, query::ValueMatchRelation::less, target, name);
    source.constrainTarget(buddy, target);

    EXPECT_THAT(rows(query, source, target),
                ElementsAre(std::tuple(ModelElement(a), ModelElement(b))));
}

using TypedResults = ReferenceConstraint;

TEST_F(TypedResults, AreRunAnewForEachLoop)
{
    node(u"a");
    AbstractQuery query(m_model);
    Node::Constrainables const each({query, EXACTLY});
    auto const results = query.results(each);

    int rows = 0;
    for (auto const& [found] : results)
        rows += found ? 1 : 0;
    EXPECT_EQ(rows, 1);

    node(u"b");
    rows = 0;
    for (auto const& [found] : results)
        rows += found ? 1 : 0;
    EXPECT_EQ(rows, 2);
}

TEST_F(TypedResults, KeepTheirRowsWhileTheModelChanges)
{
    node(u"a");
    node(u"b");
    AbstractQuery query(m_model);
    Node::Constrainables const each({query, EXACTLY});

    int rows = 0;
    for (auto const& [found] : query.results(each))
    {
        found->destroy();
        ++rows;
    }

    EXPECT_EQ(rows, 2);
    EXPECT_THAT(ReferenceConstraint::rows(query, each), IsEmpty());
}

TEST_F(TypedResults, ObeyLimitAndOffset)
{
    for (int i = 0; i < 5; ++i)
        node(u"each");
    AbstractQuery query(m_model);
    Node::Constrainables const each({query, EXACTLY});
    query.setResultOffset(1);
    query.setResultLimit(3);

    EXPECT_EQ(rows(query, each).size(), 3u);
    query.setResultOffset(4);
    EXPECT_EQ(rows(query, each).size(), 1u);
}

TEST_F(TypedResults, HaveTheColumnsThatWereAskedFor)
{
    Node const a = node(u"a");
    Scalars const scalars = Scalars::create(m_model);
    AbstractQuery query(m_model);
    Node::Constrainables const nodes({query, EXACTLY});
    Scalars::Constrainables const plain({query, EXACTLY});

    EXPECT_THAT(rows(query, plain, nodes), ElementsAre(std::tuple(scalars, a)));
    EXPECT_THAT(rows(query, nodes), ElementsAre(std::tuple(a)));
    EXPECT_THAT(rows(query, nodes, plain, nodes), ElementsAre(std::tuple(a, scalars, a)));
}

TEST_F(TypedResults, RaiseWhatTheRunRaises)
{
    AbstractQuery query;
    Node::Constrainables const each({query, EXACTLY});

    EXPECT_RAISES(tarnkiln::query::NoModel, query.results(each).begin());
}

TEST_F(TypedResults, HoldNoHandleForAnElementWithoutGeneratedCode)
{
    ModelElement::createReflective(m_model, Node::metaClass());
    AbstractQuery query(m_model);
    Node::Constrainables const each({query, EXACTLY});

    EXPECT_THAT(rows(query, each), ElementsAre(std::tuple(Node())));
}
}  // namespace
}  // namespace testkit::shapes

// How collections hold stand-ins for elements, and how these become the elements they name.
#include "tests/collections/CollectionFixture.h"

#include "tarnkiln/collections/ProxyTable.h"

namespace testkit {
namespace {

ustring const ELSEWHERE = u"memory://elsewhere";

class Proxies : public CollectionFixture
{
protected:
    Node const owner = node(u"owner");
    Node const target = node(u"target");
    Node const a = node(u"a");
};

// ---------------------------------------------------------------------------- sequences

TEST_F(Proxies, StandInASequenceAndCount)
{
    owner->getLinks().push_back(a);
    owner->getLinks().push_back(danglingProxy());

    EXPECT_EQ(namesIn(owner->getLinks()), (Names{u"a", u"?"}));
    EXPECT_EQ(genericOf(owner->getLinks()).genericSize(), 2u);
    EXPECT_EQ(namesOf(owner->getLinks().getAllValues()), (Names{u"a"}))
        << "what stays a proxy is left out";
}

TEST_F(Proxies, AreResolvedInTheirPlaceWhenASequenceIsRead)
{
    ElementSequence<Node> sequence(owner.getImpl(), /*unique=*/false, Node::Impl::BUDDY, Feature());
    Node const proxy = proxyOf(target);
    for (Node const& element : {a, proxy, proxy, proxy, proxy})
        sequence.push_back(element);

    EXPECT_EQ(genericOf(sequence).genericIndexOf(target), -1) << "a search resolves nothing";
    EXPECT_EQ(sequence.at(1), target);
    EXPECT_EQ(namesIn(sequence), (Names{u"a", u"target", u"?", u"?", u"?"}));
    EXPECT_EQ(genericOf(sequence).genericAt(2), target);
    EXPECT_EQ(*(sequence.begin() + 3), target);
    EXPECT_EQ(namesOf(sequence.getAllValues()),
              (Names{u"a", u"target", u"target", u"target", u"target"}));
    EXPECT_EQ(namesIn(sequence), (Names{u"a", u"target", u"target", u"target", u"target"}));
}

TEST_F(Proxies, AreResolvedByNoChangeOfTheModel)
{
    owner->getParts().push_back(proxyOf(target));
    DeepCounter counter;
    model->addListener(&counter);
    Model::Freezer const frozen = model->freeze();

    EXPECT_EQ(owner->getParts().at(0), target);

    EXPECT_EQ(counter.commits, 0);
    model->removeListener(&counter);
}

TEST_F(Proxies, AreResolvedOnTheWayToARemoval)
{
    ElementSequence<Node> sequence(owner.getImpl(), /*unique=*/false, Node::Impl::BUDDY, Feature());
    sequence.push_back(danglingProxy());
    sequence.push_back(proxyOf(target));
    sequence.push_back(proxyOf(a));

    sequence.remove(target);

    EXPECT_EQ(namesIn(sequence), (Names{u"?", u"?"}));
}

TEST_F(Proxies, StayInASequenceIfTheElementDoesNotReferBack)
{
    owner->getLinks().push_back(proxyOf(target));

    EXPECT_TRUE(owner->getLinks().at(0)->isProxy());
    owner->getLinks().resolveAll();
    EXPECT_EQ(namesIn(owner->getLinks()), (Names{u"?"}));
    EXPECT_TRUE(owner->getLinks().getAllValues().empty());
}

TEST_F(Proxies, AreResolvedOnBothSidesIfEachNamesTheOther)
{
    owner->getLinks().push_back(proxyOf(target));
    target->getBacklinks().push_back(proxyOf(owner));

    EXPECT_EQ(owner->getLinks().at(0), target);

    EXPECT_EQ(namesIn(target->getBacklinks()), (Names{u"owner"}))
        << "the other end completed its own entry as it answered";
    EXPECT_EQ(namesIn(owner->getLinks()), (Names{u"target"}));
}

TEST_F(Proxies, OfElementsThatAModelLacksStayInASequence)
{
    owner->getParts().push_back(danglingProxy());

    owner->getParts().resolveAll();
    owner->getParts().resolveLocal();

    EXPECT_EQ(namesIn(owner->getParts()), (Names{u"?"}));
}

TEST_F(Proxies, ThatNameAModelAreNotLocal)
{
    ElementSequence<Node> sequence(owner.getImpl(), /*unique=*/false, Node::Impl::BUDDY, Feature());
    sequence.push_back(proxyOf(target, /*namesModel=*/true));
    sequence.push_back(proxyOf(a));

    sequence.resolveLocal();
    EXPECT_EQ(namesIn(sequence), (Names{u"?", u"a"}));

    sequence.resolveAll();
    EXPECT_EQ(namesIn(sequence), (Names{u"target", u"a"}));
}

TEST_F(Proxies, AreReplacedAtAPositionOfASequence)
{
    owner->getLinks().push_back(proxyOf(target));
    owner->getChildren().push_back(proxyOf(a));

    owner->getLinks().replaceProxy(target, 0);
    owner->getChildren().replaceProxy(a, 0);

    EXPECT_EQ(namesIn(owner->getLinks()), (Names{u"target"}));
    EXPECT_EQ(namesIn(target->getBacklinks()), (Names{u"owner"}));
    EXPECT_EQ(namesIn(owner->getChildren()), (Names{u"a"}));
    EXPECT_EQ(a->container(), owner);
}

TEST_F(Proxies, AreReplacedByContainingIfThereIsNoWayBack)
{
    owner->getParts().push_back(proxyOf(target));

    owner->getParts().replaceProxy(target, 0);

    EXPECT_EQ(target->container(), owner);
    EXPECT_EQ(namesIn(owner->getParts()), (Names{u"target"}));
}

TEST_F(Proxies, InASequenceAreCompletedByTheOtherEndsQuestion)
{
    Opened<ElementSequence<Node>> links(owner.getImpl(), /*unique=*/true, Node::Impl::LINKS);
    links.push_back(danglingProxy());
    links.push_back(proxyOf(target));

    EXPECT_FALSE(links.basicContainsProxyTo(a));
    EXPECT_TRUE(links.basicContainsProxyTo(target));
    EXPECT_EQ(namesIn(links), (Names{u"?", u"target"}));
    EXPECT_FALSE(links.basicContainsProxyTo(target)) << "there is no proxy for it any more";
}

TEST_F(Proxies, ThatNameAModelAreNotContained)
{
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  owner->getParts().push_back(proxyOf(target, /*namesModel=*/true)));

    EXPECT_TRUE(owner->getParts().empty());
}

TEST_F(Proxies, LeaveASequenceWithoutATraceAtTheOtherEnd)
{
    owner->getParts().push_back(danglingProxy());
    owner->getChildren().push_back(danglingProxy());
    owner->getLinks().push_back(danglingProxy());
    std::size_t const before = model->getTopLevelElements().size();

    owner->getParts().erase(0);
    owner->getChildren().clear();
    owner->getLinks().replace(0, a);

    EXPECT_EQ(model->getTopLevelElements().size(), before);
    EXPECT_EQ(namesIn(a->getBacklinks()), (Names{u"owner"}));
}

TEST_F(Proxies, MayReplaceAnEntry)
{
    owner->getParts().push_back(a);

    owner->getParts().replace(0, danglingProxy());

    EXPECT_TRUE(a->isTopLevel());
    EXPECT_EQ(namesIn(owner->getParts()), (Names{u"?"}));
}

TEST_F(Proxies, AreNeverContainedForAUniqueSequence)
{
    Node const proxy = danglingProxy();
    owner->getLinks().push_back(proxy);

    EXPECT_FALSE(owner->getLinks().contains(proxy));
    owner->getLinks().push_back(proxy);
    EXPECT_EQ(owner->getLinks().size(), 2u);
    owner->getLinks().insert(0, proxy);
    EXPECT_EQ(owner->getLinks().size(), 2u) << "an insertion compares objects";
}

TEST_F(Proxies, AreCountedByAFilterOnceResolved)
{
    auto filter = std::make_unique<SaturatedBloomFilter>();
    SaturatedBloomFilter& seen = *filter;
    ElementSequence<Node> sequence(owner.getImpl(), /*unique=*/true, Node::Impl::BUDDY, Feature());
    sequence.setFilter(std::move(filter));
    Node const proxy = proxyOf(target);

    sequence.push_back(proxy);
    EXPECT_FALSE(seen.contains(proxy->getUuid()));
    sequence.resolveAll();
    EXPECT_TRUE(seen.contains(target->getUuid()));
    sequence.erase(0);
    EXPECT_FALSE(seen.contains(target->getUuid()));
}

TEST_F(Proxies, OfASnapshotStayAsTheyAre)
{
    Opened<ElementSequence<Node>> sequence(nullptr, /*unique=*/true, Node::Impl::LINKS);
    Opened<UnorderedElementSet<Node>> set(nullptr, Node::Impl::MARKS);
    sequence.push_back(proxyOf(target));
    set.insert(proxyOf(target));

    sequence.resolveAll();
    sequence.resolveLocal();
    set.resolveAll();
    set.resolveLocal();

    EXPECT_EQ(namesIn(sequence), (Names{u"?"}));
    EXPECT_EQ(namesIn(set), (Names{u"?"}));
    EXPECT_FALSE(sequence.basicContainsProxyTo(target));
    EXPECT_FALSE(set.basicContainsProxyTo(target));
}

// ---------------------------------------------------------------------------- side tables

TEST_F(Proxies, StandBesideASetAndDoNotCount)
{
    owner->getMarks().insert(a);
    owner->getMarks().insert(danglingProxy());

    EXPECT_EQ(genericOf(owner->getMarks()).genericSize(), 1u);
    EXPECT_EQ(owner->getMarks().getAllValues().size(), 1u);
    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies().size(), 2u);
}

TEST_F(Proxies, OfOneIdAreOneEntryTheFirst)
{
    Node const first = danglingProxy();
    Node const second = danglingProxy();

    owner->getMarks().insert(first);
    owner->getMarks().insert(second);

    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies(), (std::vector<ModelElement>{first}));
}

TEST_F(Proxies, WithAnEmptyModelAndWithNoneAreOneEntry)
{
    owner->getMarks().insert(danglingProxy(u"x"));
    owner->getMarks().insert(danglingProxy(u"x", ustring()));
    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies().size(), 1u);

    owner->getMarks().insert(danglingProxy(u"x", ELSEWHERE));
    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies().size(), 2u);
}

TEST_F(Proxies, ThatDifferInTheModelOnlyShareAHash)
{
    support::ProxyIdHasher const hash;
    ProxyId const local(ElementId::UUID_TYPE, u"x");
    ProxyId const remote(ElementId::UUID_TYPE, u"x", ELSEWHERE);

    EXPECT_EQ(hash(local), hash(remote));
    EXPECT_FALSE(local == remote);
    EXPECT_NE(hash(local), hash(ProxyId(ElementId::UUID_TYPE, u"y")));
    EXPECT_NE(hash(local), hash(ProxyId(u"name", u"x")));
}

TEST_F(Proxies, AreTakenOutByTheirId)
{
    owner->getMarks().insert(danglingProxy());

    owner->getMarks().erase(danglingProxy());

    EXPECT_TRUE(owner->getMarks().getAllValuesAndProxies().empty());
}

TEST_F(Proxies, ThatAreAbsentCostAnAnnouncementOnlyWhereThereAreOthers)
{
    DeepCounter counter;
    model->addListener(&counter);

    owner->getMarks().erase(danglingProxy());
    EXPECT_EQ(counter.commits, 0) << "there is no table yet";

    owner->getMarks().insert(danglingProxy(u"one"));
    owner->getMarks().erase(danglingProxy(u"two"));
    EXPECT_EQ(counter.commits, 2);
    model->removeListener(&counter);
}

TEST_F(Proxies, ThatNameAModelAreRefusedByACompositeCollection)
{
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  owner->getByName().insert(danglingProxy(u"x", ELSEWHERE)));
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  owner->getByName().addProxy(danglingProxy(u"x", ELSEWHERE)));

    owner->getByName().insert(danglingProxy(u"x"));
    EXPECT_EQ(owner->getByName().getAllValuesAndProxies().size(), 1u);
}

TEST_F(Proxies, BesideASetWithoutAnOppositeStayThereWhenAllAreResolved)
{
    UnorderedElementSet<Node> set(owner.getImpl(), Node::Impl::BUDDY, Feature());
    set.insert(proxyOf(target));
    set.insert(proxyOf(a, /*namesModel=*/true));

    set.resolveAll();
    EXPECT_TRUE(set.empty());

    set.resolveLocal();
    EXPECT_TRUE(set.contains(target));
    EXPECT_FALSE(set.contains(a)) << "its id names a model";
    EXPECT_EQ(set.getAllValuesAndProxies().size(), 2u);
}

TEST_F(Proxies, BesideASetMoveWhenTheOtherEndConfirms)
{
    owner->getMarks().insert(proxyOf(target));
    owner->getMarks().resolveAll();
    EXPECT_EQ(namesIn(owner->getMarks()), (Names{u"?"})) << "nobody refers back";

    target->getMarkedBy().insert(proxyOf(owner));
    owner->getMarks().resolveAll();

    EXPECT_EQ(namesIn(owner->getMarks()), (Names{u"target"}));
    EXPECT_EQ(namesIn(target->getMarkedBy()), (Names{u"owner"}));
}

TEST_F(Proxies, BesideASetMoveWithoutAQuestionWhenTheLocalOnesAreResolved)
{
    owner->getMarks().insert(proxyOf(target));

    owner->getMarks().resolveLocal();

    EXPECT_TRUE(owner->getMarks().contains(target));
    EXPECT_TRUE(target->getMarkedBy().empty()) << "nor is the other end told";
}

TEST_F(Proxies, BesideASetMoveWhenTheOtherEndAsks)
{
    Opened<UnorderedElementSet<Node>> marks(owner.getImpl(), Node::Impl::MARKS);
    EXPECT_FALSE(marks.basicContainsProxyTo(target)) << "no table";
    marks.insert(danglingProxy());
    marks.insert(proxyOf(target));

    EXPECT_FALSE(marks.basicContainsProxyTo(a));
    EXPECT_TRUE(marks.basicContainsProxyTo(target));
    EXPECT_FALSE(marks.basicContainsProxyTo(target));

    EXPECT_TRUE(marks.contains(target));
}

TEST_F(Proxies, BesideASetAreReplacedWhenTheElementIsKnown)
{
    owner->getMarks().replaceProxy(target, 0);
    owner->getMarks().insert(danglingProxy());
    owner->getMarks().replaceProxy(target, 0);
    EXPECT_TRUE(owner->getMarks().empty()) << "no proxy names it";

    owner->getMarks().insert(proxyOf(target));
    owner->getMarks().replaceProxy(target, 0);

    EXPECT_TRUE(owner->getMarks().contains(target));
    EXPECT_EQ(namesIn(target->getMarkedBy()), (Names{u"owner"}));
    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies().size(), 2u);
}

TEST_F(Proxies, BesideAMapAreReplacedByContaining)
{
    ElementMap<ustring, Node>& byName = owner->getByName();
    byName.insert(proxyOf(target));
    EXPECT_EQ(genericOf(byName).genericSize(), 0u);

    byName.replaceProxy(target, 0);

    EXPECT_EQ(byName.find(u"target"), target);
    EXPECT_EQ(target->container(), owner);
    EXPECT_EQ(byName.getAllValuesAndProxies().size(), 1u);
}

TEST_F(Proxies, BesideAMapStayIfTheKeyIsTaken)
{
    owner->getByName().insert(target);
    Node const sameName = node(u"target");
    owner->getByName().insert(proxyOf(sameName));

    owner->getByName().replaceProxy(sameName, 0);
    owner->getByName().resolveLocal();

    EXPECT_EQ(owner->getByName().find(u"target"), target);
    EXPECT_TRUE(sameName->isTopLevel());
    EXPECT_EQ(owner->getByName().getAllValuesAndProxies().size(), 2u);
}

TEST_F(Proxies, BesideAMapGetTheKeyOfTheElement)
{
    owner->getGrouped().insert(proxyOf(target));

    owner->getGrouped().resolveLocal();

    EXPECT_EQ(owner->getGrouped().find(u"target"), (std::vector<Node>{target}));
}

TEST_F(Proxies, ComeThroughTheDoorOfDataSources)
{
    UndoneAtEnd const undone(model);  // the ends are out of step here

    owner->getMarks().basicAddWithProxy(a);
    owner->getMarks().basicAddWithProxy(danglingProxy());
    owner->getLinks().basicAddWithProxy(danglingProxy());

    EXPECT_EQ(owner->getMarks().size(), 1u);
    EXPECT_EQ(owner->getMarks().getAllValuesAndProxies().size(), 2u);
    EXPECT_TRUE(a->getMarkedBy().empty());
    EXPECT_EQ(owner->getLinks().size(), 1u);
}

TEST_F(Proxies, GoWithAllElseWhenACollectionIsEmptied)
{
    owner->getMarks().insert(danglingProxy());
    owner->getMarks().clear();
    EXPECT_TRUE(owner->getMarks().getAllValuesAndProxies().empty());

    owner->getByName().insert(danglingProxy());
    owner->getByName().clear();
    EXPECT_TRUE(owner->getByName().getAllValuesAndProxies().empty());

    owner->getMarks().insert(danglingProxy());
    genericOf(owner->getMarks()).genericBasicClear();
    EXPECT_TRUE(owner->getMarks().getAllValuesAndProxies().empty());
}

TEST_F(Proxies, AreCopiedWithTheContents)
{
    owner->getMarks().insert(a);
    owner->getMarks().insert(danglingProxy());
    UnorderedElementSet<Node> copy(nullptr, Node::Impl::MARKS);
    copy.insert(danglingProxy(u"old"));

    copy.copyContents(owner->getMarks());
    EXPECT_EQ(copy.getAllValuesAndProxies(), owner->getMarks().getAllValuesAndProxies());

    copy.copyContents(UnorderedElementSet<Node>(nullptr, Node::Impl::MARKS));
    EXPECT_TRUE(copy.getAllValuesAndProxies().empty());
}

TEST_F(Proxies, ComeAndGoWithARollback)
{
    owner->getMarks().insert(danglingProxy(u"kept"));
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    owner->getMarks().insert(danglingProxy(u"new"));
    owner->getMarks().erase(danglingProxy(u"kept"));
    owner->getGrouped().insert(danglingProxy(u"new"));

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    std::vector<ModelElement> const proxies = owner->getMarks().getAllValuesAndProxies();
    ASSERT_EQ(proxies.size(), 1u);
    EXPECT_EQ(proxies[0]->getProxyIdImpl()->getId(), u"kept");
    EXPECT_TRUE(owner->getGrouped().getAllValuesAndProxies().empty());
}
}  // namespace
}  // namespace testkit

// Random operations on elements of all shapes, in random transactions, against a model of plain
// numbers that knows what each should do.
#include "tests/stress/NodeMirror.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodePicture.h"
#include "tests/support/ScriptedListener.h"

#include <rapidcheck.h>

#include <set>
#include <tuple>

namespace {

using namespace testkit;
using Failure = NodeMirror::Failure;

/// A step: what is done, to which two nodes, and a number for what else is needed.
using Step = std::tuple<int, int, int, int>;

/// A model, its mirror, and the transactions that are open on it.
class Play
{
public:
    explicit Play(bool withListener)
    {
        listener.keepsReports = false;
        listener.onCommitted = [](Report const& report) {
            for (ModelElement const& created : report->getCreated())
                RC_ASSERT(static_cast<bool>(created));
            for (ModelElement const& destroyed : report->getDestroyed())
                RC_ASSERT(!destroyed);
        };
        if (withListener)
            listen(model, listener);
        for (int number = 0; number < PROXIES; ++number)
        {
            string const name = "p" + std::to_string(number);
            proxies.push_back(Node::createProxy(model, ProxyId(ElementId::UUID_TYPE,
                                                               ustring(name.begin(), name.end()),
                                                               ustring(u"nowhere://model"))));
        }
    }

    void take(Step const& step)
    {
        auto const [kind, first, second, number] = step;
        if (kind < TRANSACTION_STEPS)
            takeTransactionStep(kind);
        else
            takeNodeStep(kind - TRANSACTION_STEPS, pick(first), pick(second), number);
        noticeEnd();
        RC_ASSERT(model->checkInvariants() == std::vector<std::string>());
        RC_ASSERT(pictureOf(model) == mirror.picture());
        for (int const proxy : mirror.contentProxies())
            RC_ASSERT(static_cast<bool>(contentProxy(proxy)));
    }
    void endAll()
    {
        while (!open.empty())
            takeTransactionStep(COMMIT);
        RC_ASSERT(pictureOf(model) == mirror.picture());
    }

    static constexpr int KINDS = 54;

private:
    enum TransactionStep
    {
        BEGIN,
        BEGIN_TOO,
        COMMIT,
        DROP,
        ROLL_BACK,
        TRANSACTION_STEPS
    };

    /// A live node, or none for one in eight numbers.
    int pick(int number) const
    {
        if (mirror.nodes().empty() || number % 8 == 7)
            return NodeMirror::NONE;
        auto at = mirror.nodes().begin();
        std::advance(at, number % static_cast<int>(mirror.nodes().size()));
        return at->first;
    }
    Node node(int number) const
    {
        return number == NodeMirror::NONE ? Node() : nodes.at(static_cast<std::size_t>(number));
    }

    /// A transaction that can only be rolled back may be so by any of its handles.
    void noticeEnd()
    {
        if (open.empty() || model->getCurrentTransaction())
            return;
        RC_ASSERT(doomed);
        open.clear();
        mirror = before;
    }
    void takeTransactionStep(int kind)
    {
        switch (kind)
        {
        case BEGIN:
        case BEGIN_TOO:
            if (open.empty())
            {
                before = mirror;
                changedBuddies.clear();
                doomed = false;
            }
            if (open.size() < 4)
                open.push_back(model->beginTransaction(/*revertible=*/true));
            break;
        case COMMIT:
            if (!open.empty())
                endInnermost(/*commits=*/true);
            break;
        case DROP:
            if (!open.empty())
                endInnermost(/*commits=*/false);
            break;
        case ROLL_BACK:
            if (open.empty())
                break;
            doomed = true;
            while (!open.empty())
            {
                open.back().rollBack();
                open.pop_back();
            }
            mirror = before;
            break;
        default:
            break;
        }
    }
    void endInnermost(bool commits)
    {
        doomed = doomed || !commits;
        TransactionResult const result =
            commits ? open.back().commit() : TransactionResult::NotCompleted;
        open.pop_back();
        if (!open.empty())
        {
            RC_ASSERT(result == TransactionResult::NotCompleted || doomed);
            return;
        }
        if (commits && !doomed)
            RC_ASSERT(result == TransactionResult::Committed);
        if (doomed)
            mirror = before;
    }

    void takeNodeStep(int kind, int a, int b, int number)
    {
        if (kind == 0 || kind == 1 || a == NodeMirror::NONE)
        {
            int const created = static_cast<int>(nodes.size());
            // created with its tag, in one transaction
            Transaction const transaction = model->beginTransaction(/*revertible=*/false);
            Node const made = Node::create(model, NodeMirror::uuidOfNode(created));
            nodes.push_back(made);
            made->setTag("n" + std::to_string(created));
            transaction.commit();
            mirror.create(created);
            return;
        }
        Node const x = node(a);
        Node const y = node(b);
        bool const two = b != NodeMirror::NONE;
        std::string const key(1, static_cast<char>('a' + number % 4));
        ustring const wideKey(key.begin(), key.end());
        switch (kind)
        {
        case 2:
            x->setCount(number);
            mirror.setCount(a, number);
            break;
        case 3:
        case 4:
            expect(mirror.setName(a, key), [&] { x->setName(wideKey); });
            break;
        case 5:
            x->getNumbers().push_back(number);
            mirror.addNumber(a, number);
            break;
        case 6:
            x->setBuddy(y);
            mirror.setBuddy(a, b);
            changedBuddies.insert(a);
            break;
        case 7:
            x->setLeft(y);
            mirror.setLeft(a, b);
            break;
        case 8:
            x->setRight(y);
            mirror.setRight(a, b);
            break;
        case 9:
            x->setOwner(y);
            mirror.setOwner(a, b);
            break;
        case 10:
            x->setGroup(y);
            mirror.setGroup(a, b);
            break;
        case 11:
            expect(mirror.setParent(a, b), [&] { x->setParent(y); });
            break;
        case 12:
            expect(mirror.setCore(a, b), [&] { x->setCore(y); });
            break;
        case 13:
            expect(mirror.setBody(a, b), [&] { x->setBody(y); });
            break;
        case 14:
            expect(mirror.setHost(a, b), [&] { x->setHost(y); });
            break;
        case 15:
            expect(mirror.setScope(a, b), [&] { x->setScope(y); });
            break;
        case 16:
            x->destroy();
            mirror.destroy(a);
            break;
        default:
            if (kind > LAST_PROXY_STEP)
                takeContentProxyStep(kind, a, x);
            else if (kind > LAST_PAIR_STEP)
                takeProxyStep(kind, a, number % PROXIES, x);
            else if (two)
                takePairStep(kind, a, b, x, y);
        }
    }
    void takePairStep(int kind, int a, int b, Node const& x, Node const& y)
    {
        switch (kind)
        {
        case 17:
            x->getOwned().push_back(y);
            mirror.addOwned(a, b);
            break;
        case 18:
            x->getOwned().remove(y);
            mirror.removeOwned(a, b);
            break;
        case 19:
            x->getLinks().push_back(y);
            mirror.addLink(a, b);
            break;
        case 20:
            x->getLinks().insert(0, y);
            mirror.insertLink(a, b);
            break;
        case 21:
            x->getLinks().remove(y);
            mirror.removeLink(a, b);
            break;
        case 22:
            x->getMarks().insert(y);
            mirror.addMark(a, b);
            break;
        case 23:
            x->getMarks().erase(y);
            mirror.eraseMark(a, b);
            break;
        case 24:
            x->getGrouped().insert(y);
            mirror.addGrouped(a, b);
            break;
        case 25:
        case 26:
            expect(mirror.addChild(a, b), [&] { x->getChildren().push_back(y); });
            break;
        case 27:
            expect(mirror.addPart(a, b), [&] { x->getParts().push_back(y); });
            break;
        case 28:
            x->getParts().remove(y);
            mirror.removePart(a, b);
            break;
        case 29:
        case 30:
            expect(mirror.addByName(a, b), [&] { x->getByName().insert(y); });
            break;
        case 31:
        case 32:
            x->setBuddy(Node::createProxy(model, y->getPersistentProxyId(/*omitModel=*/true)));
            mirror.setBuddy(a, NodeMirror::PROXY_OF_NODE + b);
            changedBuddies.insert(a);
            break;
        case LAST_PAIR_STEP:
            readBuddy(a, x);
            break;
        default:
            break;
        }
    }
    void takeProxyStep(int kind, int a, int number, Node const& x)
    {
        Node const proxy = proxies[static_cast<std::size_t>(number)];
        int const p = NodeMirror::PROXY + number;
        switch (kind)
        {
        case LAST_PAIR_STEP + 1:
            x->setBuddy(proxy);
            mirror.setBuddy(a, p);
            changedBuddies.insert(a);
            break;
        case LAST_PAIR_STEP + 2:
            x->getLinks().push_back(proxy);
            mirror.addLinkToProxy(a, p);
            break;
        case LAST_PAIR_STEP + 3:
            x->getLinks().remove(proxy);
            mirror.removeLinkToProxy(a, p);
            break;
        case LAST_PAIR_STEP + 4:
            x->getGrouped().insert(proxy);
            mirror.addGroupedProxy(a, p);
            break;
        case LAST_PAIR_STEP + 5:
            x->getGrouped().erase(proxy);
            mirror.eraseGroupedProxy(a, p);
            break;
        case LAST_PAIR_STEP + 6:
            x->getMarks().insert(proxy);
            mirror.addMarkOfProxy(a, p);
            break;
        default:
            x->getMarks().erase(proxy);
            mirror.eraseMarkOfProxy(a, p);
            break;
        }
    }
    /// What a proxy turns into when it is read is no change, and stays after a rollback unless the
    /// property has changed too.
    void readBuddy(int a, Node const& x)
    {
        int const proxy = mirror.nodes().at(a).buddy;
        static_cast<void>(x->getBuddy());
        mirror.readBuddy(a);
        auto const old = before.nodes().find(a);
        if (!open.empty() && changedBuddies.count(a) == 0 && old != before.nodes().end() &&
            old->second.buddy == proxy)
            before.setBuddy(a, mirror.nodes().at(a).buddy);
    }
    void takeContentProxyStep(int kind, int a, Node const& x)
    {
        using Place = NodeMirror::Place;
        switch (kind)
        {
        case LAST_PROXY_STEP + 1:
            x->getChildren().push_back(addContentProxy(a, Place::CHILDREN));
            break;
        case LAST_PROXY_STEP + 2:
            x->getParts().push_back(addContentProxy(a, Place::PARTS));
            break;
        case LAST_PROXY_STEP + 3:
            x->getByName().insert(addContentProxy(a, Place::BY_NAME));
            break;
        case LAST_PROXY_STEP + 4:
            x->setCore(addContentProxy(a, Place::CORE));
            break;
        case LAST_PROXY_STEP + 5:
            x->setBody(addContentProxy(a, Place::BODY));
            break;
        case LAST_PROXY_STEP + 6:
            x->getChildren().remove(contentProxy(mirror.removeContentProxy(a, Place::CHILDREN)));
            break;
        case LAST_PROXY_STEP + 7:
            x->getParts().remove(contentProxy(mirror.removeContentProxy(a, Place::PARTS)));
            break;
        default:
            x->getByName().erase(contentProxy(mirror.removeContentProxy(a, Place::BY_NAME)));
            break;
        }
    }
    /// A new one, which the mirror puts in its place at once.
    Node addContentProxy(int a, NodeMirror::Place place)
    {
        int const number = PROXIES + static_cast<int>(contentProxies.size());
        string const name = "p" + std::to_string(number);
        contentProxies.push_back(Node::createProxy(
            model, ProxyId(ElementId::UUID_TYPE, ustring(name.begin(), name.end()))));
        mirror.addContentProxy(a, place, NodeMirror::PROXY + number);
        return contentProxies.back();
    }
    Node contentProxy(int number) const
    {
        return number == NodeMirror::NONE ? Node()
                                          : contentProxies.at(static_cast<std::size_t>(
                                                number - NodeMirror::PROXY - PROXIES));
    }
    static void expect(Failure failure, std::function<void()> const& call)
    {
        switch (failure)
        {
        case Failure::None:
            call();
            break;
        case Failure::Circular:
            RC_ASSERT(
                static_cast<bool>(tarnkiln::tests::raises<messages::CircularContainment>(call)));
            break;
        case Failure::KeyTaken:
            RC_ASSERT(
                static_cast<bool>(tarnkiln::tests::raises<messages::UniquenessConstraint>(call)));
            break;
        }
    }

    Model const model = Model::create(ModelConstellation());
    ScriptedListener listener;
    NodeMirror mirror;
    NodeMirror before;
    static constexpr int LAST_PAIR_STEP = 33;
    static constexpr int LAST_PROXY_STEP = LAST_PAIR_STEP + 7;
    static constexpr int PROXIES = 3;
    std::vector<Node> proxies;
    std::vector<Node> contentProxies;  ///< Each in one place only; live as long as that has it.
    std::set<int> changedBuddies;      ///< Nodes whose `buddy` has changed in the transaction.
    std::vector<Node> nodes;           ///< All that were ever created, by number.
    std::vector<Transaction> open;
    bool doomed = false;
};

rc::Gen<std::vector<Step>> steps()
{
    auto const step = rc::gen::tuple(rc::gen::inRange(0, Play::KINDS), rc::gen::inRange(0, 64),
                                     rc::gen::inRange(0, 64), rc::gen::inRange(0, 16));
    return rc::gen::scale(2, rc::gen::container<std::vector<Step>>(step));
}

TEST(RandomSequences, LeaveTheModelAsTheirMirrorSays)
{
    EXPECT_TRUE(rc::check("operations and transactions do what the mirror does", [] {
        long const before = Node::liveCount();
        {
            Play play(*rc::gen::arbitrary<bool>());
            for (Step const& step : *steps())
                play.take(step);
            play.endAll();
        }
        RC_ASSERT(Node::liveCount() == before);
    }));
}
}  // namespace

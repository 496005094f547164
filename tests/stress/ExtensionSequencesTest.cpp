// Random sequences of operations on extension values, with transactions that are committed and
// taken back at random, against a mirror.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/stress/ExtensionMirror.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/ScriptedListener.h"

#include <rapidcheck.h>

#include <algorithm>
#include <tuple>

namespace {

using namespace testkit;
using meta::StandardTypes;
using Picture = std::vector<std::string>;
using Step = std::tuple<int, int, int, int>;  ///< Kind, a node, another, a number.

Value numberValue(int payload)
{
    StandardTypes::ensureInitialized();
    return Value(StandardTypes::integerMeta, payload);
}

class Play
{
public:
    enum Kind : int
    {
        CREATE,
        DESTROY,
        SET_SHELF,
        RESET_SHELF,
        SET_FRIEND,
        RESET_FRIEND,
        ADD_PAGE,
        REMOVE_PAGE,
        CLEAR_PAGES,
        BEGIN,
        COMMIT,
        ROLL_BACK,
        DROP,
        REDECLARE,
        MOVE,
        KINDS
    };

    explicit Play(bool withListener)
    {
        extend(u"shelf", u"Integer", 1, numberValue(0));
        extend(u"friend", Node::metaClass()->getQualifiedName(), 1, boost::none);
        extend(u"pages", u"Integer", 0xFFFFFFFF, boost::none);
        listener.keepsReports = false;
        hasListener = withListener;
        if (withListener)
            listen(model, listener);
    }

    void take(Step const& step)
    {
        auto const [kind, first, second, number] = step;
        if (kind == CREATE || nodes.empty())
            create();
        else if (kind >= BEGIN)
            takeOther(kind);
        else
            takeChange(kind, first, second, number);
        expectAsMirrored();
    }
    void endAll()
    {
        while (!open.empty())
            takeOther(COMMIT);
        expectAsMirrored();
    }

private:
    void extend(ustring const& name, ustring const& type, std::uint32_t upper,
                boost::optional<Value> const& byDefault)
    {
        meta::ExtensionPrototype prototype;
        prototype.setName(name);
        prototype.setTypeName(type);
        prototype.setUpper(upper);
        prototype.setIsOrdered(true);
        prototype.setIsUnique(false);
        model->extendMetaclass(Node::metaClass(), prototype, byDefault);
    }
    void create()
    {
        if (!open.empty() || !hasListener)
        {
            nodes.push_back(Node::create(model));
        }
        else
        {
            Transaction const transaction = model->beginTransaction(/*revertible=*/false);
            nodes.push_back(Node::create(model));
            transaction.commit();
        }
        mirror.create(static_cast<int>(nodes.size()) - 1);
    }
    /// A live node at or after that number, round about; `NONE` if there is none.
    int pick(int number) const
    {
        int const count = static_cast<int>(nodes.size());
        for (int i = 0; i < count; ++i)
        {
            int const node = (number + i) % count;
            if (mirror.isAlive(node))
                return node;
        }
        return ExtensionMirror::NONE;
    }
    Node const& at(int node) const { return nodes[static_cast<std::size_t>(node)]; }
    AbstractPrimitiveCollection& pages(int node) const
    {
        return at(node)->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>();
    }

    void takeChange(int kind, int first, int second, int number)
    {
        int const node = pick(first);
        int const other = pick(second);
        if (node == ExtensionMirror::NONE)
            return;
        switch (kind)
        {
        case DESTROY:
            at(node)->destroy();
            mirror.destroy(node);
            break;
        case SET_SHELF:
        case RESET_SHELF:
            number = kind == SET_SHELF ? number : 0;
            at(node)->setExtension(u"shelf", numberValue(number));
            mirror.setShelf(node, number);
            break;
        case SET_FRIEND:
            at(node)->setExtension(u"friend", Value(Node::metaClass(), at(other)));
            mirror.setFriend(node, other);
            break;
        case RESET_FRIEND:
            at(node)->setExtension(u"friend", Value::createEmptyValue(Node::metaClass(), true));
            mirror.setFriend(node, ExtensionMirror::NONE);
            break;
        case ADD_PAGE:
            pages(node).genericAdd(numberValue(number));
            mirror.addPage(node, number);
            break;
        case REMOVE_PAGE:
            pages(node).genericRemove(numberValue(number));
            mirror.removePage(node, number);
            break;
        default:
            pages(node).clear();
            mirror.clearPages(node);
            break;
        }
    }
    void takeOther(int kind)
    {
        switch (kind)
        {
        case BEGIN:
            if (open.empty())
                before = mirror;
            open.push_back(model->beginTransaction(/*revertible=*/true));
            break;
        case COMMIT:
        case ROLL_BACK:
        case DROP:
            end(kind);
            break;
        case REDECLARE:
            model->unextendMetaclass(Node::metaClass(), u"shelf");
            extend(u"shelf", u"Integer", 1, numberValue(0));
            mirror.redeclareShelf();
            before.redeclareShelf();
            break;
        default:
            move();
            break;
        }
    }
    void end(int kind)
    {
        if (open.empty())
            return;
        if (kind == COMMIT)
            open.back().commit();
        else if (kind == ROLL_BACK)
            open.back().rollBack();
        open.pop_back();
        if (kind != COMMIT)
            endDoomed();
    }
    /// What failed within another transaction dooms that; it ends at the next commit in it.
    void endDoomed()
    {
        while (!open.empty())
        {
            open.back().commit();
            open.pop_back();
        }
        mirror = before;
    }
    /// To a new model, which is the one that is played with from now on.
    void move()
    {
        if (!open.empty())
            return;
        if (hasListener)
            model->removeListener(&listener);
        Model const target = Model::create(ModelConstellation());
        model->moveAllContentsTo(target);
        RC_ASSERT(model->getElementCount() == 0u);
        model->destroy();
        model = target;
        if (hasListener)
            listen(model, listener);
    }

    void expectAsMirrored()
    {
        RC_ASSERT(model->checkInvariants().empty());
        Picture picture;
        for (int node = 0; node < static_cast<int>(nodes.size()); ++node)
        {
            if (at(node))
                picture.push_back(ExtensionMirror::line(node, stateOf(node)));
        }
        RC_ASSERT(picture == mirror.picture());
    }
    ExtensionMirror::State stateOf(int node) const
    {
        ExtensionMirror::State state;
        state.shelf = at(node)->getExtension(u"shelf").getValue<int>();
        ModelElement const other = at(node)->getExtension(u"friend").getValue<ModelElement>();
        auto const found = std::find(nodes.begin(), nodes.end(), other);
        if (other.getElementImpl())
            state.friendNumber = static_cast<int>(found - nodes.begin());
        if (at(node)->hasNonDefaultExtension(u"pages"))
        {
            for (Value const& page : pages(node).getAllValues())
                state.pages.push_back(page.getValue<int>());
        }
        return state;
    }

    Model model = Model::create(ModelConstellation());
    ScriptedListener listener;
    bool hasListener = false;
    ExtensionMirror mirror;
    ExtensionMirror before;
    std::vector<Node> nodes;  ///< All that were ever created, by number.
    std::vector<Transaction> open;
};

rc::Gen<std::vector<Step>> steps()
{
    auto const step =
        rc::gen::tuple(rc::gen::inRange(0, static_cast<int>(Play::KINDS)), rc::gen::inRange(0, 16),
                       rc::gen::inRange(0, 16), rc::gen::inRange(0, 8));
    return rc::gen::scale(2, rc::gen::container<std::vector<Step>>(step));
}

void play()
{
    long const before = Node::liveCount();
    {
        Play play(*rc::gen::arbitrary<bool>());
        for (Step const& step : *steps())
            play.take(step);
        play.endAll();
    }
    RC_ASSERT(Node::liveCount() == before);
}

TEST(RandomExtensionSequences, LeaveTheValuesAsTheirMirrorSays)
{
    WithoutInvalidationLog::Scope const noHost;
    EXPECT_TRUE(rc::check("values and transactions do what the mirror does", play));
}

TEST(RandomExtensionSequences, LeaveTheValuesAsTheirMirrorSaysWhereAHostMirrorsElements)
{
    InvalidationLog const log;
    EXPECT_TRUE(rc::check("values come back with their elements", play));
}
}  // namespace

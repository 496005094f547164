#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

#include <numeric>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::IsEmpty;

/// A constellation of two models with an element each, of which everything can be let go.
class Family
{
public:
    enum Member
    {
        CONSTELLATION,
        FIRST_MODEL,
        SECOND_MODEL,
        FIRST_ELEMENT,
        SECOND_ELEMENT,
        TRANSACTION,
        MEMBERS
    };

    Family()
        : constellation(ModelConstellation::create()),
          first(Model::create(constellation)),
          second(Model::create(constellation))
    {
        Transaction const setUp = first->beginTransaction(/*revertible=*/false);
        inFirst = Plain::create(first);
        inSecond = Plain::create(second);
        Plain const child = Plain::create(first);
        inFirst->addChild(child);
        inFirst->addLink(inSecond);
        inSecond->setPeer(inFirst);
        setUp.commit();
        impls = {constellation.getImpl(), first.getImpl(), second.getImpl()};
    }

    void beginTransaction()
    {
        transaction = first->beginTransaction(/*revertible=*/true);
        change(inFirst, 1);
        change(inSecond, 2);
    }
    void drop(int member)
    {
        switch (member)
        {
        case CONSTELLATION:
            constellation = ModelConstellation();
            break;
        case FIRST_MODEL:
            first = Model();
            break;
        case SECOND_MODEL:
            second = Model();
            break;
        case FIRST_ELEMENT:
            inFirst = Plain();
            break;
        case SECOND_ELEMENT:
            inSecond = Plain();
            break;
        default:
            transaction = Transaction();
        }
    }

    ModelConstellation constellation;
    Model first;
    Model second;
    Plain inFirst;
    Plain inSecond;
    Transaction transaction;
    std::vector<ElementImpl*> impls;  ///< Constellation and models, to ask whether they died.
};

bool allDied(InvalidationLog const& log, Family const& family)
{
    return std::all_of(family.impls.begin(), family.impls.end(),
                       [&](ElementImpl const* impl) { return log.deathsOf(impl) == 1; });
}

bool noneDied(InvalidationLog const& log, Family const& family)
{
    return std::all_of(family.impls.begin(), family.impls.end(),
                       [&](ElementImpl const* impl) { return log.deathsOf(impl) == 0; });
}

std::vector<int> numbersBelow(int end)
{
    std::vector<int> result(static_cast<std::size_t>(end));
    std::iota(result.begin(), result.end(), 0);
    return result;
}

/// Calls `use` with each order of the members below `end`.
template <class Use> void forEachOrder(int end, Use const& use)
{
    std::vector<int> order = numbersBelow(end);
    do
    {
        SCOPED_TRACE(::testing::PrintToString(order));
        use(order);
    }
    while (std::next_permutation(order.begin(), order.end()));
}

TEST(AConstellationAndItsModels, DieWithTheLastHandleInWhateverOrderTheyGo)
{
    forEachOrder(Family::FIRST_ELEMENT, [](std::vector<int> const& order) {
        ExpectNoLeakedElements const noLeaks;
        InvalidationLog const log;
        Family family;
        for (std::size_t i = 0; i < order.size(); ++i)
        {
            ASSERT_TRUE(noneDied(log, family)) << "before step " << i;
            family.drop(order[i]);
        }
        EXPECT_TRUE(allDied(log, family));
        EXPECT_FALSE(family.inFirst);
        EXPECT_FALSE(family.inSecond);
    });
}

TEST(AConstellationAndItsModels, AreNotKeptByHandlesOfElements)
{
    forEachOrder(Family::TRANSACTION, [](std::vector<int> const& order) {
        ExpectNoLeakedElements const noLeaks;
        InvalidationLog const log;
        Family family;
        int left = Family::FIRST_ELEMENT;
        for (int const member : order)
        {
            family.drop(member);
            left -= member < Family::FIRST_ELEMENT;
            EXPECT_EQ(allDied(log, family), left == 0);
        }
    });
}

TEST(AConstellationAndItsModels, AreKeptByAnOpenTransactionWhichTakesItsChangesBack)
{
    forEachOrder(Family::MEMBERS, [](std::vector<int> const& order) {
        ExpectNoLeakedElements const noLeaks;
        InvalidationLog const log;
        Family family;
        family.beginTransaction();
        bool open = true;
        int left = Family::FIRST_ELEMENT;
        for (int const member : order)
        {
            family.drop(member);
            left -= member < Family::FIRST_ELEMENT;
            open = open && member != Family::TRANSACTION;
            EXPECT_EQ(allDied(log, family), left == 0 && !open);
            if (family.inFirst && !open)
            {
                EXPECT_EQ(family.inFirst->getValue(), 0);
            }
        }
    });
}

TEST(AConstellationAndItsModels, DieWithTheHandleOfACommittedTransaction)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Family family;
    family.beginTransaction();
    for (int member = 0; member < Family::TRANSACTION; ++member)
        family.drop(member);
    EXPECT_TRUE(noneDied(log, family));

    EXPECT_EQ(family.transaction.commit(), TransactionResult::Committed);
    EXPECT_TRUE(noneDied(log, family)) << "the handle still leads to its model";
    family.drop(Family::TRANSACTION);

    EXPECT_TRUE(allDied(log, family));
}

TEST(AConstellationAndItsModels, DieWithTheHandleOfATransactionRolledBack)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Family family;
    family.beginTransaction();
    for (int member = 0; member < Family::TRANSACTION; ++member)
        family.drop(member);

    EXPECT_EQ(family.transaction.rollBack(), TransactionResult::RolledBack);
    EXPECT_TRUE(noneDied(log, family));
    family.drop(Family::TRANSACTION);

    EXPECT_TRUE(allDied(log, family));
}

/// What is destroyed by hand if it is still there, before which step, and whether in a transaction.
class Destroying : public ::testing::TestWithParam<std::tuple<Family::Member, std::size_t, bool>>
{
protected:
    static void destroy(Family& family, Family::Member member)
    {
        if (member == Family::CONSTELLATION && family.constellation)
            family.constellation->destroy();
        else if (member == Family::FIRST_MODEL && family.first)
            family.first->destroy();
        else if (member == Family::SECOND_MODEL && family.second)
            family.second->destroy();
        else if (member == Family::FIRST_ELEMENT && family.inFirst)
            family.inFirst->destroy();
        else if (member == Family::SECOND_ELEMENT && family.inSecond)
            family.inSecond->destroy();
    }
};

TEST_P(Destroying, LeaksNothingAndFreesNothingEarly)
{
    Family::Member const destroyed = std::get<0>(GetParam());
    std::size_t const before = std::get<1>(GetParam());
    bool const inTransaction = std::get<2>(GetParam());
    forEachOrder(Family::FIRST_ELEMENT + 1, [&](std::vector<int> order) {
        std::replace(order.begin(), order.end(), +Family::FIRST_ELEMENT, +Family::TRANSACTION);
        ExpectNoLeakedElements const noLeaks;
        InvalidationLog const log;
        Family family;
        if (inTransaction)
            family.beginTransaction();
        for (std::size_t step = 0; step < order.size(); ++step)
        {
            if (step == before)
                destroy(family, destroyed);
            family.drop(order[step]);
        }
        EXPECT_TRUE(allDied(log, family));
        EXPECT_FALSE(family.inFirst);
        EXPECT_FALSE(family.inSecond);
    });
}

std::string nameOfCase(::testing::TestParamInfo<Destroying::ParamType> const& info)
{
    std::vector<std::string> const names{"Constellation", "FirstModel", "SecondModel",
                                         "FirstElement", "SecondElement"};
    return names[std::get<0>(info.param)] + "BeforeStep" + std::to_string(std::get<1>(info.param)) +
           (std::get<2>(info.param) ? "InATransaction" : "");
}

INSTANTIATE_TEST_SUITE_P(
    EachMemberBeforeEachStep, Destroying,
    ::testing::Combine(::testing::Values(Family::CONSTELLATION, Family::FIRST_MODEL,
                                         Family::SECOND_MODEL, Family::FIRST_ELEMENT,
                                         Family::SECOND_ELEMENT),
                       ::testing::Values(0u, 1u, 2u, 3u), ::testing::Bool()),
    nameOfCase);

// ---------------------------------------------------------------------------- single cases

TEST(AModel, OutsideConstellationsDiesWithItsLastHandle)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Model model = Model::createTransientModel();
    ElementImpl const* const impl = model.getImpl();
    Plain::create(model);

    model = Model();

    EXPECT_EQ(log.deathsOf(impl), 1);
}

TEST(AModel, OutsideConstellationsIsKeptByItsTransaction)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Model model = Model::createTransientModel();
    ElementImpl const* const impl = model.getImpl();
    Transaction transaction = model->beginTransaction(/*revertible=*/true);
    Plain::create(model);

    model = Model();
    EXPECT_EQ(log.deathsOf(impl), 0);
    transaction = Transaction();

    EXPECT_EQ(log.deathsOf(impl), 1);
}

TEST(AModel, ThatWasDestroyedLeavesItsConstellationToItsOtherModels)
{
    InvalidationLog const log;
    Model first = Model::create(ModelConstellation::create());
    Model second = Model::create(first->getModelConstellation());
    ElementImpl const* const home = first->getModelConstellationImpl();

    first->destroy();
    first = Model();
    EXPECT_EQ(log.deathsOf(home), 0);
    second->destroy();

    EXPECT_EQ(log.deathsOf(home), 1) << "the last model was what kept it";
    EXPECT_FALSE(second);
}

TEST(AModel, ThatIsDestroyedTakesModelsWithItThatNobodyHolds)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Model const held = Model::create(ModelConstellation::create());
    Model loose = Model::create(held->getModelConstellation());
    ElementImpl const* const home = held->getModelConstellationImpl();
    ElementImpl const* const looseImpl = loose.getImpl();
    loose = Model();
    EXPECT_EQ(log.deathsOf(looseImpl), 0);

    held->destroy();

    EXPECT_EQ(log.deathsOf(looseImpl), 1);
    EXPECT_EQ(log.deathsOf(home), 1);
}

TEST(AModel, IsKeptByTheReportOfNoTransaction)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Report report;
    ElementImpl const* impl = nullptr;
    {
        Model const model = Model::create(ModelConstellation());
        impl = model.getImpl();
        ScriptedListener listener;
        listen(model, listener);
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        Plain::create(model);
        transaction.commit();
        ASSERT_EQ(listener.committed.size(), 1u);
        report = listener.committed[0];
        model->removeListener(&listener);
    }

    EXPECT_EQ(log.deathsOf(impl), 1);
    ASSERT_EQ(report->getCreated().size(), 1u);
    EXPECT_FALSE(report->getCreated()[0]);
    report.reset();
}

TEST(AModel, MayBeDestroyedByItsListenerWhenACommitIsOver)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Model model = Model::create(ModelConstellation());
    ElementImpl const* const impl = model.getImpl();
    ScriptedListener listener;
    listener.keepsReports = false;
    listener.onCommitted = [&](Report const&) {
        model->destroy();
        model = Model();
    };
    listen(model, listener);
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        Plain::create(model);
        EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    }

    EXPECT_EQ(log.deathsOf(impl), 1);
    EXPECT_EQ(listener.removals, 1);
}

TEST(AModel, DiesOnceWhenItsLastHandleGoesInTheMiddleOfItsDestruction)
{
    ExpectNoLeakedElements const noLeaks;
    InvalidationLog const log;
    Model model = Model::create(ModelConstellation());
    Model::Impl* const impl = model.getImpl();
    Plain::create(model);
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl&) { model = Model(); };

    impl->destroy();
    Plain::Impl::whenAboutToDestroy = nullptr;

    EXPECT_EQ(log.deathsOf(impl), 1);
}

TEST(ADeadElement, OutlivesItsModel)
{
    ExpectNoLeakedElements const noLeaks;
    Plain parent;
    Plain child;
    {
        Model const model = Model::create(ModelConstellation());
        parent = Plain::create(model);
        child = Plain::create(model);
        parent->addChild(child);
    }
    EXPECT_FALSE(parent);
    EXPECT_FALSE(child);

    parent = Plain();
    EXPECT_NE(child->basicContainer(), nullptr);
    child = Plain();
}

TEST(ADeadElement, HasNoModelOnceThatIsGone)
{
    ExpectNoLeakedElements const noLeaks;
    Plain destroyed, undone, left;
    {
        Model const model = Model::create(ModelConstellation());
        left = Plain::create(model);
        destroyed = Plain::create(model);
        destroyed->destroy();
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        undone = Plain::create(model);
        transaction.rollBack();

        EXPECT_EQ(destroyed->getModel(), model);
        EXPECT_EQ(undone->getModel(), model);
    }

    for (Plain const& dead : {destroyed, undone, left})
    {
        EXPECT_EQ(dead->getModel().getImpl(), nullptr);
        EXPECT_EQ(dead->getModelImpl(), nullptr);
        EXPECT_FALSE(dead->isProxy());
        EXPECT_EQ(dead->getProxyIdImpl(), nullptr);
        EXPECT_FALSE(dead->getPersistentProxyId(/*omitModel=*/false).getModelId());
        dead->destroy();
    }
}

TEST(ADeadElement, HasADestroyedModelForAsLongAsThatIsHeld)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);

    model->destroy();

    EXPECT_EQ(element->getModelImpl(), model.getImpl());
}

TEST(AnElementThatCameBack, DiesAndComesBackAgain)
{
    ExpectNoLeakedElements const noLeaks;
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    for (int round = 0; round < 3; ++round)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        element->destroy();
        transaction.rollBack();

        EXPECT_TRUE(element);
        EXPECT_EQ(element->getModel(), model);
    }
}

TEST(RolledBackCreations, LeaveNothingBehindInAThousandRounds)
{
    ExpectNoLeakedElements const noLeaks;
    Model const model = Model::create(ModelConstellation());
    for (int round = 0; round < 1'000; ++round)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        Plain const parent = Plain::create(model);
        parent->addChild(Plain::create(model));
        transaction.rollBack();
    }

    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
}
}  // namespace

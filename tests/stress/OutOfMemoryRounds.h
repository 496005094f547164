/// \file
/// Operations on a world of elements, each of whose allocations fails in turn.
///
///     struct World
///     {
///         Model const model;
///         Picture picture() const;       // all that can be seen; checks the invariants
///         void expectUsable() const;     // makes changes and takes them back
///     };
///     WorldOperation<World> const OPERATIONS[] = {{"SetANumber", [](World& w) { ... }}};
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/EachFailure.h"

#include <gmock/gmock.h>

#include <ostream>
#include <string>
#include <vector>

namespace testkit {

using Picture = std::vector<std::string>;

/// One public call.
template <class World> struct WorldOperation
{
    char const* name;
    void (*run)(World& world);

    friend void PrintTo(WorldOperation const& operation, std::ostream* out)
    {
        *out << operation.name;
    }
};

/// An operation, and what the world looks like before and after it when nothing fails.
template <class World> class OutOfMemoryRounds
{
public:
    explicit OutOfMemoryRounds(WorldOperation<World> const& operation) : m_run(operation.run)
    {
        World world;
        m_before = world.picture();
        m_run(world);
        m_after = world.picture();
    }

    /// In a transaction, what failed is taken back with it.
    void inATransaction() const
    {
        auto const round = [&](unsigned long number, Failing mode) {
            World world;
            Transaction const transaction = world.model->beginTransaction(/*revertible=*/true);
            Attempt const attempt(number, mode, [&] { m_run(world); });
            if (attempt.threw)
                transaction.rollBack();
            else
                transaction.commit();
            EXPECT_EQ(attempt.threw ? m_before : m_after, world.picture());
            expectSameAfterwards(world, attempt.threw);
            return attempt.failed;
        };
        forEachFailure(round, {Failing::Once});
    }

    /// A rollback gives everything back without memory.
    void whileRolledBack() const
    {
        auto const round = [&](unsigned long number, Failing mode) {
            World world;
            Transaction const transaction = world.model->beginTransaction(/*revertible=*/true);
            m_run(world);
            TransactionResult result = TransactionResult::NotCompleted;
            Attempt const attempt(number, mode, [&] { result = transaction.rollBack(); });
            EXPECT_FALSE(attempt.threw);
            EXPECT_EQ(TransactionResult::RolledBack, result);
            EXPECT_EQ(m_before, world.picture());
            world.expectUsable();
            return attempt.failed;
        };
        forEachFailure(round, {Failing::FromThereOn});
    }

private:
    /// What failed succeeds when there is memory again, with the same result.
    void expectSameAfterwards(World& world, bool again) const
    {
        world.expectUsable();
        if (!again)
            return;
        m_run(world);
        EXPECT_EQ(m_after, world.picture());
    }

    void (*m_run)(World& world);
    Picture m_before;
    Picture m_after;
};
}  // namespace testkit

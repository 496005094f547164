/// \file
/// What the tests of rollback share.
#pragma once
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <vector>

namespace testkit {

inline std::vector<ModelElement> membersOf(ReferenceCollection const& collection)
{
    return collection.getAllValues();
}

class TransactionRollback : public testing::Test
{
protected:
    TransactionRollback() { static_cast<void>(NodeMetamodel::get()); }

    Node make(ustring const& name = {})
    {
        Node const node = Node::create(model);
        node->setName(name);
        return node;
    }
    Transaction begin() { return model->beginTransaction(/*revertible=*/true); }
    void rollBack(Transaction const& transaction)
    {
        EXPECT_THAT(model->checkInvariants(), testing::IsEmpty());
        EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
        EXPECT_THAT(model->checkInvariants(), testing::IsEmpty());
        EXPECT_EQ(nullptr, model->getCurrentTransaction());
    }
    /// Whether `element` stands where a top-level element, and no other, stands.
    bool isAtTop(ModelElement const& element) const
    {
        std::vector<ModelElement> const top = model->getTopLevelElements();
        bool const listed = std::find(top.begin(), top.end(), element) != top.end();
        EXPECT_EQ(listed, element->isTopLevel());
        return listed;
    }

    Model const model = Model::create(ModelConstellation());
};
}  // namespace testkit

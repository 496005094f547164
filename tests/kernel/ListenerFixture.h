/// \file
/// What the tests of listeners share.
#pragma once
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

#include <gtest/gtest.h>

namespace testkit {

/// A model with an element and three listeners for everything, on which transactions run.
class Listeners : public testing::Test
{
protected:
    Listeners()
    {
        element = Plain::create(model);
        for (ScriptedListener* const listener : {&first, &second, &third})
            listen(model, *listener);
    }

    /// Changes the element in a transaction of its own.
    TransactionResult run(int value = 1)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        change(element, value);
        return transaction.commit();
    }

    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Plain element;
    Trace trace;
    ScriptedListener first{"first", &trace};
    ScriptedListener second{"second", &trace};
    ScriptedListener third{"third", &trace};
};
}  // namespace testkit

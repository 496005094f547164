/// \file
/// A model with nodes, and listeners that count, for the tests of collections.
#pragma once
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/SpecialNodeImpl.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace testkit {

using Names = std::vector<ustring>;

/// Makes transactions deep, counts what it is told and keeps what changed.
class DeepCounter : public Listener
{
public:
    void transactionCommitted(ReportData& report)
    {
        ++commits;
        changed = report.getChanged();
    }
    void transactionRolledBack(ReportData&) { ++rollbacks; }

    /// Whether the last committed transaction changed exactly these elements.
    bool sawChanged(std::vector<ModelElement> const& elements) const
    {
        return changed.size() == elements.size() &&
               std::is_permutation(changed.begin(), changed.end(), elements.begin());
    }

    int commits = 0;
    int rollbacks = 0;
    std::vector<ModelElement> changed;
};

/// Has a model tell a listener what happens, for as long as this lives.
template <class L> class Listening
{
public:
    Listening(Model const& model, L& listener) : m_model(model), m_listener(listener)
    {
        m_model->addListener(&m_listener);
    }
    Listening(Listening const&) = delete;
    Listening& operator=(Listening const&) = delete;
    ~Listening() { m_model->removeListener(&m_listener); }

private:
    Model const m_model;
    L& m_listener;
};

/// Leaves transactions shallow.
class ShallowCounter : public Listener
{
public:
    using ElementType = ModelElement;

    void transactionCommitted(ShallowChangeReport<ModelElement>&) { ++commits; }

    int commits = 0;
};

/// Refuses all transactions, which are deep because of it.
class Refuser : public Listener
{
public:
    bool transactionValidating(ReportData&) { return false; }
};

/// Takes back what follows, so that tests may leave associations in a state that no commit would
/// pass.
class UndoneAtEnd
{
public:
    explicit UndoneAtEnd(Model const& model) : m_transaction(model->beginTransaction(true)) {}
    ~UndoneAtEnd() { m_transaction.rollBack(); }

private:
    Transaction const m_transaction;
};

class CollectionFixture : public ::testing::Test
{
protected:
    Node node(ustring const& name = u"")
    {
        Node const made = Node::create(model);
        made->setName(name);
        return made;
    }

    /// A stand-in for `target` whose id names the model of `target`, or none.
    Node proxyOf(ModelElement const& target, bool namesModel = false)
    {
        return Node::createProxy(model, target->getPersistentProxyId(/*omitModel=*/!namesModel));
    }

    /// A stand-in for nothing.
    Node danglingProxy(ustring const& id = u"00000000-0000-4000-8000-000000000001",
                       boost::optional<ustring> const& modelId = boost::none)
    {
        return Node::createProxy(model, ProxyId(ElementId::UUID_TYPE, id, modelId));
    }

    Model const model = Model::create(ModelConstellation());
};

/// The name of each; "-" for a dead element and "?" for a proxy.
inline Names namesOf(std::vector<ModelElement> const& elements)
{
    Names result;
    for (ModelElement const& element : elements)
    {
        if (!element)
            result.push_back(u"-");
        else if (element->isProxy())
            result.push_back(u"?");
        else
            result.push_back(Node::cast(element)->getName());
    }
    return result;
}

/// The names of all entries, proxies as they stand; nothing is resolved.
inline Names namesIn(ReferenceCollection const& collection)
{
    return namesOf(collection.getAllValuesAndProxies());
}

/// The same, sorted.
inline Names sortedNamesIn(ReferenceCollection const& collection)
{
    Names result = namesIn(collection);
    std::sort(result.begin(), result.end());
    return result;
}

inline GenericCollectionInterface& genericOf(ReferenceCollection const& collection)
{
    return *collection.getGenericInterface();
}

template <class T> GenericSequenceInterface& genericOf(ElementSequence<T> const& sequence)
{
    return dynamic_cast<GenericSequenceInterface&>(*sequence.getGenericInterface());
}

/// Lets tests call what only elements may.
template <class Collection> class Opened : public Collection
{
public:
    using Collection::basicAdd;
    using Collection::basicClear;
    using Collection::basicContainsProxyTo;
    using Collection::basicCopyValues;
    using Collection::basicRemove;
    using Collection::Collection;
};
}  // namespace testkit

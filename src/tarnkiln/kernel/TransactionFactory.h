/// \file
/// Who begins the transactions of a model.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

namespace tarn::kiln {

/// Begins transactions. A model owns one factory and starts with a local one.
class TARNKILN_EXPORT AbstractTransactionFactoryImpl
{
public:
    virtual Transaction beginTransaction() const = 0;
    virtual Transaction beginRevertibleTransaction() const = 0;
    virtual ~AbstractTransactionFactoryImpl();
};

/// A factory that begins the transactions itself.
class TARNKILN_EXPORT DirectTransactionFactoryImpl : public AbstractTransactionFactoryImpl
{};

/// A factory that leaves it to another one, which must outlive it.
class TARNKILN_EXPORT DelegatingTransactionFactoryImpl : public AbstractTransactionFactoryImpl
{
public:
    explicit DelegatingTransactionFactoryImpl(AbstractTransactionFactoryImpl const& target)
        : m_target(&target)
    {}

    Transaction beginTransaction() const override { return m_target->beginTransaction(); }
    Transaction beginRevertibleTransaction() const override
    {
        return m_target->beginRevertibleTransaction();
    }

private:
    AbstractTransactionFactoryImpl const* m_target;
};
}  // namespace tarn::kiln

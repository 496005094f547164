/// \file
/// The factory that a model starts with.
#pragma once
#include "tarnkiln/kernel/TransactionFactory.h"

namespace tarn::kiln::internal {

/// Begins transactions that originate in this program.
class LocalTransactionFactoryImpl final : public DirectTransactionFactoryImpl
{
public:
    explicit LocalTransactionFactoryImpl(Model::Impl& model) : m_model(&model) {}

    Transaction beginTransaction() const override { return begin(/*deep=*/false); }
    Transaction beginRevertibleTransaction() const override { return begin(/*deep=*/true); }

private:
    Transaction begin(bool deep) const
    {
        meta::TransactionOrigin origin;
        origin.setModel(m_model->getUuid());
        origin.setLanguage(meta::Language::CPlusPlus);
        if (!m_model->getCurrentTransaction())  // a nested one is known by its parent's
            origin.setTransactionId(ElementImpl::generateNewUuid());
        return m_model->innerBeginTransaction(m_tag, origin, deep);
    }

    Model::Impl* m_model;
    Model::Impl::PrivateTag m_tag;
};
}  // namespace tarn::kiln::internal

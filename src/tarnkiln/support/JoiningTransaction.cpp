#include "tarnkiln/support/JoiningTransaction.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"

namespace tarn::kiln::support {
namespace {

/// What counts as a nested transaction of the open one; empty if there is none.
Transaction joinOpen(Model::Impl& model)
{
    if (!model.getCurrentTransaction())
        return {};
    if (model.isFactoryLocal())
        return Transaction(model.getCurrentTransaction());
    return model.beginTransaction(/*revertible=*/false);
}
}  // namespace

JoiningTransaction::JoiningTransaction(ModelElement::Impl const& element)
    : m_outer(joinOpen(*element.getModelImpl())),
      m_isNested(m_outer && element.getModelImpl()->isFactoryLocal()),
      m_own(m_outer ? nullptr : element.getModelImpl()),
      m_step(element.getModelImpl())
{}

JoiningTransaction::~JoiningTransaction()
{
    m_step.close();
    if (!m_isNested)
        return;
    auto& outer = static_cast<internal::TransactionImpl&>(*m_outer.getImpl());
    if (!m_isCommitted)
        outer.nestedFailed();
    outer.forgetCommit();
}

void JoiningTransaction::commit()
{
    m_step.close();
    m_isCommitted = true;
    if (!m_outer)
        m_own.commit();
    else if (m_isNested)
        static_cast<internal::TransactionImpl&>(*m_outer.getImpl()).nestedCommitted();
    else
        m_outer.commit();
}
}  // namespace tarn::kiln::support

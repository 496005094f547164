#include "EssentialGuard.h"

#include "ElementText.h"
#include "EssentialNeeds.h"
#include "model/DependencyGroupImpl.h"
#include "model/ReleaseImpl.h"

namespace debian {

using namespace tarn::kiln;

EssentialGuard::EssentialGuard(model::PackageIndex const& index) : m_index(index)
{
    for (model::DependencyGroup const& group : lackingDependencies(index))
        m_lackingBefore.insert(group->getUuid());
}

bool EssentialGuard::transactionValidating(ReportData& report)
{
    m_reason.clear();
    for (ModelElement const& element : report.getDestroyed())
    {
        auto const release = model::Release::cast(element);
        if (release.getImpl() && release->isEssential())
        {
            m_reason = textOf(release) + " is essential";
            return false;
        }
    }
    if (!m_index)
        return true;
    for (model::DependencyGroup const& group : lackingDependencies(m_index))
    {
        if (m_lackingBefore.contains(group->getUuid()))
            continue;
        m_reason = textOf(group->getRelease()) + " has nothing left for " + textOf(group);
        return false;
    }
    return true;
}

}  // namespace debian

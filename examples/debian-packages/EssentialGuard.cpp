#include "EssentialGuard.h"

#include "ElementText.h"
#include "EssentialNeeds.h"

namespace debian {

using namespace tarn::kiln;

template <ElementForm Form>
EssentialGuard<Form>::EssentialGuard(PackageIndex<Form> const& index) : m_index(index)
{
    for (DependencyGroup<Form> const& group : lackingDependencies<Form>(index))
        m_lackingBefore.insert(group->getUuid());
}

template <ElementForm Form> bool EssentialGuard<Form>::transactionValidating(ReportData& report)
{
    m_reason.clear();
    for (ModelElement const& element : report.getDestroyed())
    {
        auto const release = Release<Form>::cast(element);
        if (release.getImpl() && release->isEssential())
        {
            m_reason = textOf<Form>(release) + " is essential";
            return false;
        }
    }
    if (!m_index)
        return true;
    for (DependencyGroup<Form> const& group : lackingDependencies<Form>(m_index))
    {
        if (m_lackingBefore.contains(group->getUuid()))
            continue;
        m_reason =
            textOf<Form>(group->getRelease()) + " has nothing left for " + textOf<Form>(group);
        return false;
    }
    return true;
}

#define DEBIAN_INSTANTIATE(Form) template class EssentialGuard<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian

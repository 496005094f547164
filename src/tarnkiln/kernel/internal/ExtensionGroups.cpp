#include "tarnkiln/kernel/internal/ExtensionGroups.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/Extension.h"

namespace tarn::kiln::internal {

meta::DynamicExtensions requireExtensionGroup(meta::Class const& extended,
                                              unsigned long modelCounter)
{
    if (auto const present = extended->getExtensions().find(modelCounter))
        return present;
    auto const group = meta::DynamicExtensions::create(extended->getModel());
    group->setModelID(modelCounter);
    group->setOwningClass(extended);
    return group;
}

void dropEmptyExtensionGroup(meta::DynamicExtensions const& group)
{
    if (group && group->getExtensions().empty())
        group->destroy();
}
}  // namespace tarn::kiln::internal

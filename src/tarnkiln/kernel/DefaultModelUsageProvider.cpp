#include "tarnkiln/kernel/DefaultModelUsageProvider.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PackageImpl.h"

namespace tarn::kiln {

namespace {

meta::Package rootPackage(meta::Class const& type)
{
    meta::Package package = type->getOwningPackage();
    while (package)
    {
        meta::Package const parent = package->getParentPackage();
        if (!parent)
            break;
        package = parent;
    }
    return package;
}

}  // namespace

std::vector<meta::Package> DefaultModelUsageProvider::getUsedPackages() const
{
    std::unordered_map<meta::Package, long, std::hash<ModelElement>> counts;
    for (auto const& [metaClass, number] : m_elements)
    {
        for (meta::Class type = metaClass; type; type = type->getSuperclass())
        {
            if (meta::Package const package = rootPackage(type))
                counts[package] += number;
        }
    }
    std::vector<meta::Package> result;
    for (auto const& [package, number] : counts)
    {
        if (number != 0)
            result.push_back(package);
    }
    return result;
}

void DefaultModelUsageProvider::elementCreated(ModelElement::Impl* element)
{
    count(*element, 1);
}

void DefaultModelUsageProvider::elementDestroying(ModelElement::Impl* element)
{
    count(*element, -1);
}

void DefaultModelUsageProvider::clear()
{
    m_last = nullptr;
    m_elements.clear();
}

void DefaultModelUsageProvider::count(ModelElement::Impl const& element, long step)
{
    meta::Class const& metaClass = element.getMetaClass();
    if (!metaClass)
        return;
    if (!m_last || m_last->first != metaClass)
        m_last = &*m_elements.try_emplace(metaClass).first;
    m_last->second += step;
}
}  // namespace tarn::kiln

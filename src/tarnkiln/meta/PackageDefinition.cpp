#include "tarnkiln/meta/PackageDefinition.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ReflectiveEnumCollection.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/EnumBuilder.h"
#include "tarnkiln/meta/EnumLiteralBuilder.h"
#include "tarnkiln/meta/PackageBuilder.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

namespace tarn::kiln::meta {
namespace {

/// The highest slot of the properties that `type` has itself; 0 if there is none.
int highestOwnSlot(Class const& type)
{
    int highest = 0;
    for (auto const& [name, property] : type->getOwnedAttributes())
        highest = std::max(highest, property->getPropertyIndex());
    return highest;
}

/// The highest slot of an element of `type`.
int highestSlot(Class const& type)
{
    int highest = 0;
    for (Class here = type; here; here = here->getSuperclass())
        highest = std::max(highest, highestOwnSlot(here));
    return highest;
}

/// The types that were registered, which are taken out again unless they are kept.
class Registered
{
public:
    explicit Registered(MetaRegistry& registry) : m_registry(registry) {}
    Registered(Registered const&) = delete;
    Registered& operator=(Registered const&) = delete;
    ~Registered()
    {
        for (auto const& [type, name] : m_types)
            m_registry.unregisterType(type, name);
    }

    /// To be called before the type is registered.
    void add(Type const& type) { m_types.emplace_back(type, type->getQualifiedName()); }
    void keep() { m_types.clear(); }

private:
    MetaRegistry& m_registry;
    std::vector<std::pair<Type, ustring>> m_types;
};
}  // namespace

PackageDefinition::PackageDefinition(ustring const& name, ustring const& uri)
    : m_registry(MetaRegistry::getInstance()),
      m_locked(std::in_place, m_registry),
      m_transaction(m_locked->getModel()->beginTransaction(/*revertible=*/true)),
      m_package(
          Package::cast(Package::Builder(m_locked->getModel()).setName(name).setUri(uri).create()))
{}

PackageDefinition::~PackageDefinition() = default;

ClassDefinition PackageDefinition::defineClass(ustring const& name)
{
    Class::Builder builder(m_locked->getModel());
    builder.setName(name).setOwningPackage(m_package).setSuperclass(ModelElement::metaClass());
    m_classes.push_back(Class::cast(builder.create()));
    return ClassDefinition(m_classes.back());
}

Enum PackageDefinition::defineEnum(ustring const& name, std::initializer_list<ustring> literals)
{
    Enum::Builder builder(m_locked->getModel());
    builder.setName(name).setOwningPackage(m_package);
    int number = 0;
    for (ustring const& literal : literals)
    {
        auto nested = std::make_unique<EnumLiteral::Builder>();
        nested->setName(literal).setValue(number++);
        builder.addLiterals(std::move(nested));
    }
    m_enums.push_back(Enum::cast(builder.create()));
    return m_enums.back();
}

void PackageDefinition::numberSlots(Class const& defined)
{
    if (highestOwnSlot(defined) != 0)
        return;
    Class const superclass = defined->getSuperclass();
    if (std::find(m_classes.begin(), m_classes.end(), superclass) != m_classes.end())
        numberSlots(superclass);
    int index = superclass ? highestSlot(superclass) : 0;
    for (auto const& [name, property] : defined->getOwnedAttributes())
        if (!property->isDerived())
            property->setPropertyIndex(++index);
}

Package PackageDefinition::finish()
{
    for (Class const& defined : m_classes)
        numberSlots(defined);
    Registered registered(m_registry);
    for (Enum const& defined : m_enums)
    {
        registered.add(defined);
        m_registry.registerType(defined, &makeReflectiveEnumCollection, /*builder=*/nullptr);
    }
    for (Class const& defined : m_classes)
    {
        registered.add(defined);
        m_registry.registerReflectiveClass(defined);
    }
    auto entries = m_registry.prepareRootPackage(m_package);
    if (m_transaction.commit() == TransactionResult::RolledBack)
        throw std::runtime_error("a listener refused the definition of a package");
    registered.keep();
    m_registry.enterRootPackage(entries);
    m_locked.reset();
    return m_package;
}
}  // namespace tarn::kiln::meta

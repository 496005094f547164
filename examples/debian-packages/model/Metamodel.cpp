#include "model/Metamodel.h"

#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
#include "model/ReleaseImpl.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <iterator>

namespace debian::model {

namespace {

enum TypeName
{
    PACKAGE_INDEX,
    PACKAGE,
    RELEASE,
    DEPENDENCY_GROUP,
    ALTERNATIVE,
    STRING,
    INTEGER64,
    BOOLEAN
};

enum Flag : unsigned
{
    REQUIRED = 1,
    MANY = 2,
    ORDERED = 4,
    UNIQUE = 8,
    COMPOSITE = 16
};

constexpr int NONE = -1;

struct PropertyRow
{
    TypeName owner;
    int index;
    char16_t const* name;
    TypeName type;
    unsigned flags;
    int opposite;   ///< The row of the other end, or `NONE`.
    int qualifier;  ///< The row of the key, or `NONE`.
};

constexpr PropertyRow ROWS[] = {
    {PACKAGE_INDEX, 1, u"packages", PACKAGE, MANY | UNIQUE | COMPOSITE, 2, 1},
    {PACKAGE, 1, u"name", STRING, REQUIRED, NONE, NONE},
    {PACKAGE, 2, u"index", PACKAGE_INDEX, REQUIRED, 0, NONE},
    {PACKAGE, 3, u"releases", RELEASE, MANY | UNIQUE | COMPOSITE, 6, 5},
    {PACKAGE, 4, u"providers", RELEASE, MANY | UNIQUE | ORDERED, 15, NONE},
    {RELEASE, 1, u"label", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 2, u"package", PACKAGE, REQUIRED, 3, NONE},
    {RELEASE, 3, u"version", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 4, u"architecture", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 5, u"section", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 6, u"maintainer", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 7, u"summary", STRING, REQUIRED, NONE, NONE},
    {RELEASE, 8, u"installedSize", INTEGER64, 0, NONE, NONE},
    {RELEASE, 9, u"isEssential", BOOLEAN, REQUIRED, NONE, NONE},
    {RELEASE, 10, u"groups", DEPENDENCY_GROUP, MANY | UNIQUE | ORDERED | COMPOSITE, 17, NONE},
    {RELEASE, 11, u"provides", PACKAGE, MANY | UNIQUE | ORDERED, 4, NONE},
    {DEPENDENCY_GROUP, 1, u"kind", STRING, REQUIRED, NONE, NONE},
    {DEPENDENCY_GROUP, 2, u"release", RELEASE, REQUIRED, 14, NONE},
    {DEPENDENCY_GROUP, 3, u"alternatives", ALTERNATIVE, MANY | UNIQUE | ORDERED | COMPOSITE, 19,
     NONE},
    {ALTERNATIVE, 1, u"group", DEPENDENCY_GROUP, REQUIRED, 18, NONE},
    {ALTERNATIVE, 2, u"relation", STRING, REQUIRED, NONE, NONE},
    {ALTERNATIVE, 3, u"bound", STRING, REQUIRED, NONE, NONE},
    {ALTERNATIVE, 4, u"target", PACKAGE, REQUIRED, NONE, NONE},
};
static_assert(std::size(ROWS) == Metamodel::PROPERTY_COUNT);

constexpr std::uint32_t UNBOUNDED = 0xFFFFFFFF;

bool has(PropertyRow const& row, Flag flag)
{
    return (row.flags & flag) != 0;
}

meta::Class const& classOf(Metamodel const& metamodel, TypeName name)
{
    switch (name)
    {
    case PACKAGE_INDEX:
        return metamodel.packageIndex;
    case PACKAGE:
        return metamodel.package;
    case RELEASE:
        return metamodel.release;
    case DEPENDENCY_GROUP:
        return metamodel.dependencyGroup;
    default:
        return metamodel.alternative;
    }
}

meta::Type typeOf(Metamodel const& metamodel, TypeName name)
{
    switch (name)
    {
    case STRING:
        return meta::StandardTypes::stringMeta;
    case INTEGER64:
        return meta::StandardTypes::integer64Meta;
    case BOOLEAN:
        return meta::StandardTypes::booleanMeta;
    default:
        return classOf(metamodel, name);
    }
}

meta::Class makeClass(Model const& model, meta::Package const& root, char16_t const* name)
{
    meta::Class const made = meta::Class::create(model);
    made->setName(name);
    made->setSuperclass(ModelElement::metaClass());
    made->setOwningPackage(root);
    return made;
}

meta::Property makeProperty(Model const& model, PropertyRow const& row)
{
    meta::Property const made = meta::Property::create(model);
    made->setName(row.name);
    made->setLower(has(row, REQUIRED) ? 1 : 0);
    made->setUpper(has(row, MANY) ? UNBOUNDED : 1);
    made->setIsOrdered(has(row, ORDERED));
    made->setIsUnique(has(row, UNIQUE));
    made->setIsComposite(has(row, COMPOSITE));
    made->setPropertyIndex(row.index);
    return made;
}

/// Builds elements without setting any of their properties.
template <class Handle> class BareBuilder final : public ModelElement::Builder
{
public:
    explicit BareBuilder(Model const& model) : Builder(model, Handle::Impl::SLOTS) {}

    meta::Class const& getMetaClass() const override { return Handle::metaClass(); }

    static std::unique_ptr<ModelElement::Builder> make(Model const& model)
    {
        return std::make_unique<BareBuilder>(model);
    }

protected:
    ModelElement doCreate(bool proxy, UUID const& id) override
    {
        Handle const made(new typename Handle::Impl(getModel(), id));
        if (!proxy)
            made->notifyCreated();
        return made;
    }
};

}  // namespace

Metamodel const& Metamodel::getInstance()
{
    static Metamodel const metamodel;
    return metamodel;
}

Metamodel::Metamodel()
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    meta::MetaRegistry::LockedModel const locked(registry);
    Model const& model = locked.getModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    root = meta::Package::create(model);
    root->setName(u"debian");
    root->setUri(meta::SchemaBase + u"debian-packages/20261121");
    packageIndex = makeClass(model, root, u"PackageIndex");
    package = makeClass(model, root, u"Package");
    release = makeClass(model, root, u"Release");
    dependencyGroup = makeClass(model, root, u"DependencyGroup");
    alternative = makeClass(model, root, u"Alternative");

    for (std::size_t row = 0; row < PROPERTY_COUNT; ++row)
        properties[row] = makeProperty(model, ROWS[row]);
    for (std::size_t row = 0; row < PROPERTY_COUNT; ++row)
    {
        properties[row]->setOwningType(classOf(*this, ROWS[row].owner));
        properties[row]->setType(typeOf(*this, ROWS[row].type));
        if (ROWS[row].opposite != NONE)
            properties[row]->setOpposite(properties[static_cast<std::size_t>(ROWS[row].opposite)]);
        if (ROWS[row].qualifier != NONE)
            properties[row]->setQualifiedBy(
                properties[static_cast<std::size_t>(ROWS[row].qualifier)]);
    }
    transaction.commit();

    registry.registerType(packageIndex, BareBuilder<PackageIndex>::make);
    registry.registerType(package, BareBuilder<Package>::make);
    registry.registerType(release, BareBuilder<Release>::make);
    registry.registerType(dependencyGroup, BareBuilder<DependencyGroup>::make);
    registry.registerType(alternative, BareBuilder<Alternative>::make);
    registry.registerRootPackage(root);
}
}  // namespace debian::model

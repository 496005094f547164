#include "tests/support/NodeMetamodel.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/NodeBuilder.h"
#include "tests/support/SpecialNodeBuilder.h"

#include <iterator>

namespace testkit {

namespace {

enum TypeName
{
    STRING,
    INTEGER,
    REAL,
    BOOLEAN,
    STD_STRING,
    UUID_TYPE,
    NODE,
    SPECIAL_NODE
};

enum Flag : unsigned
{
    REQUIRED = 1,
    MANY = 2,
    ORDERED = 4,
    UNIQUE = 8,
    COMPOSITE = 16,
    ONE_A_KEY = 32
};

struct PropertyRow
{
    char16_t const* name;
    TypeName type;
    unsigned flags;
    unsigned long opposite;   ///< The index of the other end; 0 if there is none.
    unsigned long qualifier;  ///< The index of the key; 0 if there is none.
};

/// In the order of the indices, from 1.
constexpr PropertyRow ROWS[] = {
    {u"name", STRING, REQUIRED, 0, 0},
    {u"count", INTEGER, REQUIRED, 0, 0},
    {u"weight", REAL, REQUIRED, 0, 0},
    {u"isOpen", BOOLEAN, REQUIRED, 0, 0},
    {u"tag", STD_STRING, REQUIRED, 0, 0},
    {u"token", UUID_TYPE, REQUIRED, 0, 0},
    {u"rank", INTEGER, 0, 0, 0},
    {u"note", STRING, 0, 0, 0},
    {u"buddy", NODE, REQUIRED, 0, 0},
    {u"left", NODE, REQUIRED, 11, 0},
    {u"right", NODE, REQUIRED, 10, 0},
    {u"owned", NODE, MANY | ORDERED | UNIQUE, 13, 0},
    {u"owner", NODE, REQUIRED, 12, 0},
    {u"links", NODE, MANY | ORDERED | UNIQUE, 15, 0},
    {u"backlinks", NODE, MANY | ORDERED | UNIQUE, 14, 0},
    {u"children", NODE, MANY | ORDERED | UNIQUE | COMPOSITE, 17, 0},
    {u"parent", NODE, REQUIRED, 16, 0},
    {u"parts", NODE, MANY | ORDERED | COMPOSITE, 0, 0},
    {u"core", NODE, REQUIRED | COMPOSITE, 0, 0},
    {u"body", NODE, REQUIRED | COMPOSITE, 21, 0},
    {u"host", NODE, REQUIRED, 20, 0},
    {u"byName", NODE, MANY | UNIQUE | COMPOSITE | ONE_A_KEY, 23, 1},
    {u"scope", NODE, REQUIRED, 22, 0},
    {u"grouped", NODE, MANY | UNIQUE, 25, 1},
    {u"group", NODE, REQUIRED, 24, 0},
    {u"marks", NODE, MANY | UNIQUE, 27, 0},
    {u"markedBy", NODE, MANY | UNIQUE, 26, 0},
    {u"numbers", INTEGER, MANY | ORDERED, 0, 0},
    {u"labels", STRING, MANY | ORDERED | UNIQUE, 0, 0},
    {u"words", STRING, MANY | UNIQUE, 0, 0},
    {u"level", INTEGER, REQUIRED, 0, 0},
    {u"mentor", SPECIAL_NODE, REQUIRED, 0, 0},
};
static_assert(std::size(ROWS) == NodeMetamodel::LAST_INDEX);

constexpr std::uint32_t UNBOUNDED = 0xFFFFFFFF;

bool has(PropertyRow const& row, Flag flag)
{
    return (row.flags & flag) != 0;
}

meta::Type typeOf(NodeMetamodel const& metamodel, TypeName name)
{
    switch (name)
    {
    case STRING:
        return meta::StandardTypes::stringMeta;
    case INTEGER:
        return meta::StandardTypes::integerMeta;
    case REAL:
        return meta::StandardTypes::realMeta;
    case BOOLEAN:
        return meta::StandardTypes::booleanMeta;
    case STD_STRING:
        return meta::StandardTypes::stdstringMeta;
    case UUID_TYPE:
        return meta::StandardTypes::uuidMeta;
    case NODE:
        return metamodel.node;
    case SPECIAL_NODE:
        return metamodel.specialNode;
    }
    return meta::Type();
}

meta::Class makeClass(Model const& model, meta::Package const& package, char16_t const* name,
                      meta::Class const& superclass)
{
    meta::Class const made = meta::Class::create(model);
    made->setName(name);
    made->setSuperclass(superclass);
    made->setOwningPackage(package);
    return made;
}

meta::Property makeProperty(Model const& model, PropertyRow const& row, int index)
{
    meta::Property const made = meta::Property::create(model);
    made->setName(row.name);
    made->setLower(has(row, REQUIRED) ? 1 : 0);
    made->setUpper(has(row, MANY) ? UNBOUNDED : 1);
    made->setIsOrdered(has(row, ORDERED));
    made->setIsUnique(has(row, UNIQUE));
    made->setIsComposite(has(row, COMPOSITE));
    made->setIsQualificationUnique(row.qualifier == 0 || has(row, ONE_A_KEY));
    made->setPropertyIndex(index);
    return made;
}
}  // namespace

NodeMetamodel const& NodeMetamodel::get()
{
    static NodeMetamodel const metamodel;
    return metamodel;
}

NodeMetamodel::NodeMetamodel()
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    meta::MetaRegistry::LockedModel const locked(registry);
    Model const& model = locked.getModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);

    package = meta::Package::create(model);
    package->setName(u"testkit");
    node = makeClass(model, package, u"Node", ModelElement::metaClass());
    specialNode = makeClass(model, package, u"SpecialNode", node);

    for (unsigned long index = 1; index <= LAST_INDEX; ++index)
        properties[index] = makeProperty(model, ROWS[index - 1], static_cast<int>(index));
    for (unsigned long index = 1; index <= LAST_INDEX; ++index)
    {
        PropertyRow const& row = ROWS[index - 1];
        meta::Property const& property = properties[index];
        property->setOwningType(index < Node::Impl::SLOTS ? node : specialNode);
        property->setType(typeOf(*this, row.type));
        property->setOpposite(properties[row.opposite]);
        property->setQualifiedBy(properties[row.qualifier]);
    }
    transaction.commit();

    registry.registerType(node, Node::Builder::instantiate);
    registry.registerType(specialNode, SpecialNode::Builder::instantiate);
}
}  // namespace testkit

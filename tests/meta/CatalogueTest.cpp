// The catalogue as it lives in the registry, read by reflection and compared with its description.
#include "tarnkiln/meta/Catalogue.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"

#include <boost/lexical_cast.hpp>
#include <boost/optional.hpp>
#include <boost/property_tree/json_parser.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <map>
#include <set>

namespace tarn::kiln::meta {
namespace {

using Json = boost::property_tree::ptree;
using ::testing::ElementsAreArray;

/// What the transaction that built the catalogue reported, seen by a listener that was there first.
class Witness final : public Listener
{
public:
    using ElementType = ModelElement;

    Witness() { registry().getModel()->addShallowListener(this); }

    static MetaRegistry& registry() { return MetaRegistry::getInstance(); }
    void transactionCommitted(ShallowChangeReport<ModelElement>& report)
    {
        if (!created.empty())
            return;
        for (ModelElement const& element : report.getCreated())
            created.push_back(element->getUuid());
        elementCount = registry().getModel()->getElementCount();
        topLevelCount = registry().getModel()->getTopLevelElements().size();
    }

    std::vector<UUID> created;
    std::size_t elementCount = 0;
    std::size_t topLevelCount = 0;
};
auto* const witness = new Witness;

Json const& description()
{
    static Json const json = [] {
        Json read;
        boost::property_tree::read_json(TARNKILN_CATALOGUE_JSON, read);
        return read;
    }();
    return json;
}

/// The reader turns null into this text.
bool isNull(Json const& value)
{
    return value.empty() && value.data() == "null";
}

ustring text(Json const& entry, char const* key)
{
    std::string const narrow = entry.get<std::string>(key);
    return {narrow.begin(), narrow.end()};
}

boost::optional<ustring> optionalText(Json const& entry, char const* key)
{
    return isNull(entry.get_child(key)) ? boost::optional<ustring>() : text(entry, key);
}

UUID uuid(Json const& entry)
{
    return boost::lexical_cast<UUID>(entry.get<std::string>("uuid"));
}

/// The entries of a list.
std::vector<Json> list(Json const& entry, char const* key)
{
    std::vector<Json> entries;
    for (auto const& [name, child] : entry.get_child(key))
        entries.push_back(child);
    return entries;
}

/// All classes and data types, in the order of the catalogue.
std::vector<Json> structuredTypes()
{
    std::vector<Json> types = list(description(), "classes");
    for (Json const& type : list(description(), "dataTypes"))
        types.push_back(type);
    return types;
}

/// The value of the property `name` of a metamodel element, as reflection gives it.
template <class T> T get(ModelElement const& element, char16_t const* name)
{
    Property const property = element->getMetaClass()->getPropertyByName(name);
    EXPECT_TRUE(property) << "no such property";
    return element->getPropertyValue(property, ModelElement::Impl::PRIVILEGED_ACCESS).getValue<T>();
}

template <class Handle> Handle find(UUID const& id)
{
    MetaPackageMeta::getInstance();
    return Handle::cast(Witness::registry().getModel()->findElement(id));
}

/// The qualified name of a type of the catalogue or the registry.
ustring qualified(ustring const& name)
{
    Type const own = Witness::registry().getType(u"tarn.kiln.meta." + name);
    return own ? own->getQualifiedName() : name;
}

ustring nameOf(Type const& type)
{
    return type ? type->getQualifiedName() : ustring();
}

ustring nameOf(Property const& property)
{
    return property ? property->getName() : ustring();
}

TEST(Catalogue, HasTheClassesAndDataTypesOfItsDescription)
{
    for (Json const& row : structuredTypes())
    {
        SCOPED_TRACE(row.get<std::string>("name"));
        StructuredType const type = find<StructuredType>(uuid(row));
        ASSERT_TRUE(type);
        EXPECT_EQ(get<ustring>(type, u"name"), text(row, "name"));
        EXPECT_EQ(type->getQualifiedName(), text(row, "qualifiedName"));
        EXPECT_EQ(get<string>(type, u"vobjName"), row.get<string>("vobjName"));
        EXPECT_EQ(Witness::registry().getType(text(row, "qualifiedName")), type);
        EXPECT_EQ(type->getMetaClass(),
                  row.get<string>("kind") == "Class" ? Class::metaClass() : DataType::metaClass());
        EXPECT_EQ(type->getOwnedAttributes().size(), row.get_child("properties").size());
        EXPECT_EQ(get<Package>(type, u"owningPackage")->getQualifiedName(), text(row, "package"));
        EXPECT_FALSE(get<bool>(type, u"isVobjHidden"));
        EXPECT_FALSE(get<bool>(type, u"vobjCompactDisplay"));
    }
}

TEST(Catalogue, ConnectsEachClassWithItsSuperclass)
{
    for (Json const& row : list(description(), "classes"))
    {
        SCOPED_TRACE(row.get<std::string>("name"));
        Class const type = find<Class>(uuid(row));
        ASSERT_TRUE(type);
        EXPECT_EQ(nameOf(get<Class>(type, u"superclass")), qualified(text(row, "superclass")));
        EXPECT_EQ(get<bool>(type, u"isAbstract"), row.get<bool>("abstract"));
    }
}

TEST(Catalogue, HasEveryPropertyAsDescribed)
{
    int count = 0;
    for (Json const& owner : structuredTypes())
    {
        for (Json const& row : list(owner, "properties"))
        {
            SCOPED_TRACE(owner.get<std::string>("name") + '.' + row.get<std::string>("name"));
            ++count;
            Property const property = find<Property>(uuid(row));
            ASSERT_TRUE(property);
            EXPECT_EQ(get<ustring>(property, u"name"), text(row, "name"));
            EXPECT_EQ(get<int>(property, u"propertyIndex"),
                      isNull(row.get_child("index")) ? 0 : row.get<int>("index"));
            EXPECT_EQ(nameOf(get<Type>(property, u"type")), qualified(text(row, "type")));
            EXPECT_EQ(get<unsigned>(property, u"lower"), row.get<unsigned>("lower"));
            EXPECT_EQ(get<unsigned>(property, u"upper"), row.get<unsigned>("upper"));
            EXPECT_EQ(get<StructuredType>(property, u"owningType")->getUuid(), uuid(owner));
            EXPECT_EQ(nameOf(get<Property>(property, u"opposite")),
                      optionalText(row, "opposite").value_or(ustring()));
            EXPECT_EQ(nameOf(get<Property>(property, u"qualifiedBy")),
                      optionalText(row, "qualifiedBy").value_or(ustring()));
            EXPECT_TRUE(get<boost::optional<ustring>>(property, u"defaultValue") ==
                        optionalText(row, "default"));
            for (auto const& [name, key] : std::map<char16_t const*, char const*>{
                     {u"isOrdered", "ordered"},
                     {u"isUnique", "unique"},
                     {u"isComposite", "composite"},
                     {u"isDerived", "derived"},
                     {u"isReadOnly", "readOnly"},
                     {u"isTransient", "transient"},
                     {u"isSparse", "sparse"},
                     {u"isPublicAccessor", "publicAccessor"},
                     {u"isPublicMutator", "publicMutator"},
                     {u"isQualificationUnique", "qualificationUnique"}})
                EXPECT_EQ(get<bool>(property, name), row.get<bool>(key)) << key;
            EXPECT_EQ(static_cast<unsigned>(ValueMeta::doGetFlags(property)),
                      row.get<unsigned>("valueFlags"));
        }
    }
    EXPECT_EQ(count, 86);
}

TEST(Catalogue, LeavesWhatItsDescriptionDoesNotNameAsInANewProperty)
{
    for (Json const& owner : structuredTypes())
    {
        for (Json const& row : list(owner, "properties"))
        {
            Property const property = find<Property>(uuid(row));
            for (char16_t const* const name :
                 {u"isSetOnce", u"customQualification", u"isQueryIndex", u"isVobjHidden",
                  u"vobjDispSkipEmpty"})
                EXPECT_FALSE(get<bool>(property, name));
            EXPECT_FALSE(get<boost::optional<string>>(property, u"vobjDispCategory"));
        }
    }
}

TEST(Catalogue, PairsOppositesAndQualifiesByPropertiesOfTheMembers)
{
    for (Json const& owner : structuredTypes())
    {
        for (Json const& row : list(owner, "properties"))
        {
            Property const property = find<Property>(uuid(row));
            if (Property const opposite = property->getOpposite())
            {
                EXPECT_EQ(opposite->getOpposite(), property);
                EXPECT_EQ(opposite->getOwningType(), property->getType());
            }
            if (Property const key = property->getQualifiedBy())
            {
                EXPECT_TRUE(StructuredType::cast(property->getType())->isATypeOf(key));
            }
        }
    }
}

TEST(Catalogue, HasEveryOperationAsDescribed)
{
    int count = 0;
    for (Json const& owner : list(description(), "classes"))
    {
        for (Json const& row : list(owner, "operations"))
        {
            SCOPED_TRACE(owner.get<std::string>("name") + '.' + row.get<std::string>("name"));
            ++count;
            Operation const operation = find<Operation>(uuid(row));
            ASSERT_TRUE(operation);
            EXPECT_EQ(get<ustring>(operation, u"name"), text(row, "name"));
            EXPECT_EQ(get<StructuredType>(operation, u"owningType")->getUuid(), uuid(owner));
            EXPECT_EQ(get<bool>(operation, u"isAbstract"), row.get<bool>("abstract"));
            EXPECT_EQ(get<bool>(operation, u"isStatic"), row.get<bool>("static"));
            EXPECT_EQ(get<bool>(operation, u"isPublic"), row.get<bool>("public"));
            EXPECT_EQ(get<bool>(operation, u"isEvent"), row.get<bool>("event"));
            Json const& result = row.get_child("result");
            if (isNull(result))
            {
                EXPECT_FALSE(get<Type>(operation, u"type"));
            }
            else
            {
                EXPECT_EQ(nameOf(get<Type>(operation, u"type")), qualified(text(result, "type")));
                EXPECT_EQ(get<unsigned>(operation, u"lower"), result.get<unsigned>("lower"));
                EXPECT_EQ(get<unsigned>(operation, u"upper"), result.get<unsigned>("upper"));
            }
        }
    }
    EXPECT_EQ(count, 20);
}

TEST(Catalogue, HasTheArgumentsOfEveryOperationInOrder)
{
    int count = 0;
    for (Json const& owner : list(description(), "classes"))
    {
        for (Json const& row : list(owner, "operations"))
        {
            SCOPED_TRACE(owner.get<std::string>("name") + '.' + row.get<std::string>("name"));
            Operation const operation = find<Operation>(uuid(row));
            std::vector<Json> const arguments = list(row, "arguments");
            ASSERT_EQ(operation->getArguments().size(), arguments.size());
            for (std::size_t i = 0; i < arguments.size(); ++i)
            {
                ++count;
                Json const& expected = arguments[i];
                Argument const argument = operation->getArguments()[i];
                EXPECT_EQ(argument->getUuid(), uuid(expected));
                EXPECT_EQ(get<ustring>(argument, u"name"), text(expected, "name"));
                EXPECT_EQ(nameOf(get<Type>(argument, u"type")), qualified(text(expected, "type")));
                EXPECT_EQ(get<unsigned>(argument, u"lower"), expected.get<unsigned>("lower"));
                EXPECT_EQ(get<unsigned>(argument, u"upper"), expected.get<unsigned>("upper"));
                EXPECT_EQ(get<bool>(argument, u"isOrdered"), expected.get<bool>("ordered"));
                EXPECT_EQ(get<bool>(argument, u"isInput"), expected.get<bool>("isInput"));
                EXPECT_EQ(get<Operation>(argument, u"operation"), operation);
            }
        }
    }
    EXPECT_EQ(count, 21);
}

TEST(Catalogue, HasTheEnumerationOfItsDescription)
{
    for (Json const& row : list(description(), "enumerations"))
    {
        Enum const type = find<Enum>(uuid(row));
        ASSERT_TRUE(type);
        EXPECT_EQ(type->getQualifiedName(), text(row, "qualifiedName"));
        EXPECT_EQ(Witness::registry().getType(text(row, "qualifiedName")), type);
        EXPECT_EQ(nameOf(get<PrimitiveType>(type, u"underlyingType")), text(row, "underlyingType"));
        EXPECT_EQ(type->getLiterals().size(), row.get_child("literals").size());
        for (Json const& literal : list(row, "literals"))
        {
            EnumLiteral const found = type->getLiterals().find(text(literal, "name"));
            ASSERT_TRUE(found);
            EXPECT_EQ(found->getUuid(), uuid(literal));
            EXPECT_EQ(get<int>(found, u"value"), literal.get<int>("value"));
            EXPECT_EQ(get<Enum>(found, u"parentEnum"), type);
            EXPECT_FALSE(get<boost::optional<ustring>>(found, u"publicIdentifier"));
        }
    }
}

TEST(Catalogue, HasFourPackagesInARow)
{
    Package const root = MetaPackageMeta::getInstance().getRootPackage();
    EXPECT_EQ(root->getUuid(), uuid(list(description(), "packages").front()));
    Package at = root;
    ustring path;
    for (Json const& row : list(description(), "packages"))
    {
        if (row.get<std::string>("name") != "")
        {
            Package const parent = at;
            at = at->getNestedPackages().find(text(row, "name"));
            ASSERT_TRUE(at);
            EXPECT_EQ(get<Package>(at, u"parentPackage"), parent);
            path += (path.empty() ? u"" : u".") + text(row, "name");
        }
        EXPECT_EQ(get<ustring>(at, u"name"), text(row, "name"));
        EXPECT_EQ(get<ustring>(at, u"uri"), SchemaBase + text(row, "uriTail"));
        EXPECT_EQ(at->getQualifiedName(), path);
    }
    EXPECT_TRUE(at->getNestedPackages().empty());
    EXPECT_EQ(at->getOwnedTypes().size(), 27u);
}

TEST(Catalogue, KeepsTheTypeOfModelsInThePackageAboveTheOthers)
{
    PrimitiveType const type = Witness::registry().getPrimitiveType(u"tarn.kiln.TarnModel");

    ASSERT_TRUE(type);
    EXPECT_EQ(type->getUuid(), uuid(list(description(), "packagePrimitiveTypes").front()));
    EXPECT_EQ(type->getMetaClass(), PrimitiveType::metaClass());
    EXPECT_EQ(type->getOwningPackage()->getQualifiedName(), u"tarn.kiln");
    EXPECT_EQ(type->getOwningPackage()->getOwnedTypes().size(), 1u);
}

TEST(Catalogue, LeavesTheKernelClassesOutsideAllPackages)
{
    for (Class const& known : {Class(Model::metaClass()), Class(ModelElement::metaClass()),
                               Class(ModelConstellation::metaClass())})
    {
        EXPECT_FALSE(known->getOwningPackage());
        EXPECT_EQ(known->getMetaClass(), Class::metaClass());
        EXPECT_TRUE(known->isTopLevel());
    }
    EXPECT_TRUE(ModelElement::metaClass()->hasOwnedAttributes());
    EXPECT_TRUE(Model::metaClass()->hasOwnedAttributes());
    EXPECT_EQ(MetaPackageMeta::getInstance().getModelClass(), Model::metaClass());
    EXPECT_EQ(MetaPackageMeta::getInstance().getModelElementClass(), ModelElement::metaClass());
}

TEST(Catalogue, IsRegisteredAsTheCurrentPackageOfItsFamily)
{
    MetaRegistry& registry = Witness::registry();
    Package const root = MetaPackageMeta::getInstance().getRootPackage();

    EXPECT_EQ(registry.getRootPackage(SchemaBase + u"meta/19700101"), root);
    EXPECT_EQ(registry.getPackageForFamily(u"meta"), root);
    EXPECT_TRUE(registry.isVersionCurrentForFamily(SchemaBase + u"meta/19700101"));
    EXPECT_FALSE(registry.getRootPackage(SchemaBase + u"meta/19700101/tarn"));
}

TEST(Catalogue, IsWhatTheRegistryModelUses)
{
    Package const root = MetaPackageMeta::getInstance().getRootPackage();

    EXPECT_THAT(Witness::registry().getModel()->getUsedPackages(), ElementsAreArray({root}));
}

TEST(Catalogue, MakesThe162ElementsOfItsDescriptionAtOnce)
{
    MetaPackageMeta& catalogue = MetaPackageMeta::getInstance();
    std::vector<UUID> expected = {catalogue.getPrimitiveType(0)->getUuid()};
    for (std::size_t i = 0; i < 4; ++i)
        expected.push_back(catalogue.getPackage(i)->getUuid());
    for (Json const& type : structuredTypes())
    {
        expected.push_back(uuid(type));
        for (Json const& property : list(type, "properties"))
            expected.push_back(uuid(property));
        if (!type.get_child_optional("operations"))
            continue;
        for (Json const& operation : list(type, "operations"))
        {
            expected.push_back(uuid(operation));
            for (Json const& argument : list(operation, "arguments"))
                expected.push_back(uuid(argument));
        }
    }
    for (Json const& enumeration : list(description(), "enumerations"))
    {
        expected.push_back(uuid(enumeration));
        for (Json const& literal : list(enumeration, "literals"))
            expected.push_back(uuid(literal));
    }

    EXPECT_THAT(witness->created, ::testing::UnorderedElementsAreArray(expected));
    EXPECT_EQ(witness->created.size(), 162u);
    EXPECT_EQ(witness->elementCount, 182u);
    EXPECT_EQ(witness->topLevelCount, 21u);
}

TEST(Catalogue, AnswersForTheClassOfEveryHandle)
{
    std::set<UUID> seen;
    auto const expect = [&](Class const& metaClass, char16_t const* name) {
        ASSERT_TRUE(metaClass);
        EXPECT_EQ(metaClass, Witness::registry().getClass(ustring(u"tarn.kiln.meta.") + name));
        EXPECT_EQ(metaClass->getMetaClass(), Class::metaClass());
        seen.insert(metaClass->getUuid());
    };
#define EXPECT_METACLASS(C) expect(C::metaClass(), u"" #C)
    EXPECT_METACLASS(Argument);
    EXPECT_METACLASS(Attribute);
    EXPECT_METACLASS(AttributeMap);
    EXPECT_METACLASS(AttributeMapAttribute);
    EXPECT_METACLASS(BooleanAttribute);
    EXPECT_METACLASS(Class);
    EXPECT_METACLASS(DataType);
    EXPECT_METACLASS(DateTimeAttribute);
    EXPECT_METACLASS(DynamicExtensions);
    EXPECT_METACLASS(Enum);
    EXPECT_METACLASS(EnumLiteral);
    EXPECT_METACLASS(Extension);
    EXPECT_METACLASS(IntegerAttribute);
    EXPECT_METACLASS(NamedElement);
    EXPECT_METACLASS(Operation);
    EXPECT_METACLASS(Package);
    EXPECT_METACLASS(PrimitiveType);
    EXPECT_METACLASS(Property);
    EXPECT_METACLASS(RealAttribute);
    EXPECT_METACLASS(StringAttribute);
    EXPECT_METACLASS(StructuredType);
    EXPECT_METACLASS(Type);
    EXPECT_METACLASS(TypedElement);
    EXPECT_METACLASS(UUIDAttribute);
#undef EXPECT_METACLASS
    EXPECT_EQ(seen.size(), description().get_child("classes").size());
}

TEST(Catalogue, LetsAnElementFindThePropertyOfEachOfItsSlots)
{
    Model const model = Model::create(ModelConstellation());
    std::map<ustring, ModelElement> const samples = {
        {u"Argument", Argument::create(model)},   {u"Class", Class::create(model)},
        {u"Enum", Enum::create(model)},           {u"EnumLiteral", EnumLiteral::create(model)},
        {u"Extension", Extension::create(model)}, {u"Operation", Operation::create(model)},
        {u"Package", Package::create(model)},     {u"Property", Property::create(model)}};
    for (auto const& [name, element] : samples)
    {
        for (Class type = element->getMetaClass(); type; type = type->getSuperclass())
        {
            for (auto const& [key, property] : type->getOwnedAttributes())
            {
                auto const index = static_cast<unsigned long>(property->getPropertyIndex());
                EXPECT_EQ(element->getPropertyByIndex(index), index ? property : Property());
            }
        }
        EXPECT_FALSE(element->getPropertyByIndex(0));
        EXPECT_FALSE(element->getPropertyByIndex(27));
    }
}

TEST(Catalogue, GivesAnExtensionTheSlotsOfAPropertyAndOneMore)
{
    Extension const extension = Extension::create(Model::create(ModelConstellation()));

    EXPECT_EQ(Extension::Impl::SLOTS, 27u);
    EXPECT_EQ(Property::Impl::SLOTS, 26u);
    EXPECT_EQ(extension->getPropertyByIndex(26),
              Extension::metaClass()->getOwnedAttributes().find(u"owner"));
    EXPECT_EQ(extension->getPropertyByIndex(1),
              NamedElement::metaClass()->getPropertyByName(u"name"));
    EXPECT_TRUE(Extension::metaClass()->isA(Property::metaClass()));
}

TEST(Catalogue, NumbersNoDerivedProperty)
{
    EXPECT_EQ(Package::metaClass()->getPropertyByName(u"uri")->getPropertyIndex(), 4);
    EXPECT_EQ(Package::metaClass()->getPropertyByName(u"qualifiedName")->getPropertyIndex(), 0);
    EXPECT_EQ(Package::create(Model::create(ModelConstellation()))->getPropertyByIndex(4),
              Package::metaClass()->getPropertyByName(u"uri"));
}

TEST(Catalogue, FindsTheFieldsOfDataTypesThoughTheyHaveNoIndex)
{
    DataType const origin =
        DataType::cast(Witness::registry().getType(u"tarn.kiln.meta.TransactionOrigin"));
    ASSERT_TRUE(origin);
    Property const language = origin->getPropertyByName(u"language");

    ASSERT_TRUE(language);
    EXPECT_EQ(language->getPropertyIndex(), 0);
    EXPECT_EQ(language->getType(), Witness::registry().getType(u"tarn.kiln.meta.Language"));
    EXPECT_TRUE(language->getDefaultValue() == ustring(u"Unknown"));
}

TEST(Catalogue, AdmitsOverloadsOfOperationsOnly)
{
    int overloadable = 0;
    for (Json const& owner : structuredTypes())
        for (Json const& row : list(owner, "properties"))
            overloadable += !find<Property>(uuid(row))->isQualificationUnique();

    EXPECT_EQ(overloadable, 1);
    EXPECT_FALSE(StructuredType::metaClass()
                     ->getPropertyByName(u"ownedOperations")
                     ->isQualificationUnique());
}

TEST(Catalogue, DeclaresOneClassAndOneOperationAbstract)
{
    std::vector<ustring> abstractOnes;
    for (Json const& row : list(description(), "classes"))
    {
        Class const type = find<Class>(uuid(row));
        if (type->isAbstract())
            abstractOnes.push_back(type->getName());
        for (auto const& [name, operation] : type->getOwnedOperations())
            if (operation->isAbstract())
                abstractOnes.push_back(type->getName() + u"." + name);
    }

    EXPECT_THAT(abstractOnes,
                ElementsAreArray({ustring(u"Attribute"), ustring(u"Attribute.getType")}));
}

TEST(Catalogue, MakesCollectionsForItsTypes)
{
    MetaRegistry& registry = Witness::registry();
    Model const model = Model::create(ModelConstellation());
    Property const property = Property::create(model);
    property->setUpper(2);
    auto const make = [&](Type const& type, bool ordered) {
        property->setType(type);
        property->setIsOrdered(ordered);
        return std::unique_ptr<AbstractOwnedCollection>(
            registry.instantiateDynamicCollection(ModelElement(), property));
    };
    for (Json const& row : list(description(), "classes"))
    {
        Class const type = find<Class>(uuid(row));
        auto const sequence = make(type, /*ordered=*/true);
        auto const set = make(type, /*ordered=*/false);
        ASSERT_TRUE(sequence && set) << row.get<std::string>("name");
        EXPECT_EQ(sequence->getCollectionType(), type);
        EXPECT_EQ(set->getCollectionType(), type);
    }
    for (Json const& key :
         {list(description(), "dataTypes").front(), list(description(), "dataTypes").back(),
          list(description(), "enumerations").front()})
    {
        Type const type = find<Type>(uuid(key));
        auto const sequence = make(type, /*ordered=*/true);
        auto const set = make(type, /*ordered=*/false);
        ASSERT_TRUE(sequence && set) << key.get<std::string>("name");
        EXPECT_EQ(sequence->getCollectionType(), type);
        EXPECT_EQ(set->getCollectionType(), type);
    }
    EXPECT_FALSE(make(registry.getType(u"tarn.kiln.TarnModel"), /*ordered=*/true));
    EXPECT_FALSE(make(Model::metaClass(), /*ordered=*/true));
}

TEST(Catalogue, IsConsistent)
{
    MetaPackageMeta::getInstance();

    EXPECT_THAT(Witness::registry().getModel()->checkInvariants(), ::testing::IsEmpty());
}
}  // namespace
}  // namespace tarn::kiln::meta

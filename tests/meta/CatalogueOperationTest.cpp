// What the operations of the metamodel's own classes answer by reflection.
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/BooleanAttributeImpl.h"
#include "tarnkiln/meta/DateTimeAttributeImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/IntegerAttributeImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/RealAttributeImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/StringAttributeImpl.h"
#include "tarnkiln/meta/UUIDAttributeImpl.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeBuilder.h"
#include "tests/support/NodeImpl.h"

#include <set>

namespace tarn::kiln::meta {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class CatalogueOperations : public MetamodelSketch
{
protected:
    using Arguments = std::vector<Value>;

    static Operation operation(Class const& owner, ustring const& name)
    {
        std::vector<Operation> const found = owner->getOperationsByName(name);
        EXPECT_EQ(found.size(), 1u);
        return found.empty() ? Operation() : found[0];
    }
    using MetamodelSketch::operation;

    static boost::optional<Value> call(ModelElement const& element, ustring const& name,
                                       Arguments const& arguments = {})
    {
        return element->invoke(operation(element->getMetaClass(), name), arguments,
                               ModelElement::Impl::PUBLIC_ACCESS);
    }
    /// The result of a call that gives elements of the class `T`.
    template <class T>
    static T callFor(ModelElement const& element, ustring const& name, Arguments const& arguments)
    {
        auto const result = call(element, name, arguments);
        EXPECT_TRUE(result);
        return result ? result->getValue<T>() : T();
    }

    template <class T> static Value value(T const& payload)
    {
        return Value(standardTypeOf<T>(), payload);
    }
    static Value text(ustring const& payload) { return value(payload); }
    static Value path(std::vector<ustring> const& keys)
    {
        return Value(standardTypeOf<ustring>(), keys);
    }
    template <class T> static Value reference(T const& element)
    {
        return Value(T::metaClass(), element);
    }

    template <class Handle> Handle attribute(ustring const& key) const
    {
        Handle const made = Handle::create(m_model);
        made->setKey(key);
        return made;
    }
    template <class Handle> Handle add(ustring const& key) const
    {
        Handle const made = attribute<Handle>(key);
        m_map->insert(made);
        return made;
    }

    AttributeMap const m_map = AttributeMap::create(m_model);
};

TEST_F(CatalogueOperations, AllHaveAnInvokerButTheOneThatInstantiates)
{
    std::multiset<ustring> without;
    std::size_t all = 0;
    for (auto const& [name, type] : Class::metaClass()->getOwningPackage()->getOwnedTypes())
    {
        Class const owner = Class::cast(type);
        if (!owner)
            continue;
        for (auto const& [operationName, found] : owner->getOwnedOperations())
        {
            ++all;
            if (!found->getInvoker())
                without.insert(name + u"." + operationName);
            else
                EXPECT_EQ(found->getInvoker()->getOperation(), found);
        }
    }

    EXPECT_EQ(all, 20u);
    EXPECT_THAT(without, ElementsAre(u"Class.instantiate"));
}

TEST_F(CatalogueOperations, TakeAsManyArgumentsAsTheyDeclare)
{
    Class const element = cls(u"Book");
    for (ModelElement const& owner :
         {ModelElement(element), ModelElement(m_map), ModelElement(Enum::create(m_model)),
          ModelElement(Extension::create(m_model)), ModelElement(RealAttribute::create(m_model))})
    {
        for (Class at = owner->getMetaClass(); at; at = at->getSuperclass())
        {
            for (auto const& [name, found] : at->getOwnedOperations())
            {
                if (!found->getInvoker())
                    continue;
                Arguments const tooMany(found->getArguments().size() + 1, text(u""));
                EXPECT_RAISES(messages::InvalidValue,
                              owner->invoke(found, tooMany, ModelElement::Impl::PRIVILEGED_ACCESS));
                if (tooMany.size() == 1)
                    continue;
                // As many as it takes, each of a type that none takes.
                Arguments const odd(tooMany.size() - 1, value(short(1)));
                EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                                   owner->invoke(found, odd, ModelElement::Impl::PRIVILEGED_ACCESS),
                                   u"Integer16");
            }
        }
    }
}

TEST_F(CatalogueOperations, DoNotInstantiateByReflection)
{
    EXPECT_RAISES_WITH(messages::NoSuchOperation,
                       call(cls(u"Book"), u"instantiate", Arguments{value(m_model), value(UUID())}),
                       u"instantiate", u"tarn.kiln.meta.Class");
}

// ---------------------------------------------------------------------------- attributes

TEST_F(CatalogueOperations, AnswerTheTypeOfEachAttribute)
{
    for (Attribute const& made :
         {Attribute(BooleanAttribute::create(m_model)),
          Attribute(DateTimeAttribute::create(m_model)),
          Attribute(IntegerAttribute::create(m_model)), Attribute(RealAttribute::create(m_model)),
          Attribute(StringAttribute::create(m_model)), Attribute(UUIDAttribute::create(m_model)),
          Attribute(AttributeMapAttribute::create(m_model))})
    {
        auto const result = call(made, u"getType");
        ASSERT_TRUE(result);
        EXPECT_EQ(result->getValue<Type>(), made->getType());
        EXPECT_EQ(result->getType(), made->getType()->getMetaClass());
    }
    EXPECT_EQ(AttributeMapAttribute::create(m_model)->getType(), AttributeMap::metaClass());
}

TEST_F(CatalogueOperations, ChangeAttributeMaps)
{
    RealAttribute const first = attribute<RealAttribute>(u"a");
    StringAttribute const second = attribute<StringAttribute>(u"a");

    EXPECT_FALSE(call(m_map, u"insert", {reference(first)}));
    EXPECT_EQ(m_map->at(u"a"), first);
    EXPECT_RAISES(messages::UniquenessConstraint, call(m_map, u"insert", {reference(second)}));

    EXPECT_FALSE(call(m_map, u"insertOrReplace", {reference(second)}));
    EXPECT_FALSE(first);
    EXPECT_EQ(m_map->at(u"a"), second);

    EXPECT_FALSE(call(m_map, u"eraseValue", {reference(second)}));
    EXPECT_FALSE(m_map->at(u"a"));
    EXPECT_TRUE(second);

    m_map->insert(second);
    EXPECT_FALSE(call(m_map, u"erase", {text(u"a")}));
    EXPECT_FALSE(m_map->at(u"a"));
    EXPECT_TRUE(second);

    m_map->insert(second);
    EXPECT_FALSE(call(m_map, u"removeValue", {reference(second)}));
    EXPECT_FALSE(second);

    RealAttribute const last = add<RealAttribute>(u"b");
    EXPECT_FALSE(call(m_map, u"remove", {text(u"b")}));
    EXPECT_FALSE(last);
}

TEST_F(CatalogueOperations, FindAttributes)
{
    RealAttribute const attribute = add<RealAttribute>(u"a");

    auto const found = call(m_map, u"at", {text(u"a")});
    auto const missed = call(m_map, u"at", {text(u"b")});

    EXPECT_EQ(found->getValue<Attribute>(), attribute);
    EXPECT_EQ(found->getType(), RealAttribute::metaClass());
    EXPECT_EQ(found->getFlags(), ValueFlags::Single);
    ASSERT_TRUE(missed);
    EXPECT_FALSE(missed->getValue<Attribute>().getElementImpl());
    EXPECT_EQ(missed->getType(), Attribute::metaClass());
}

TEST_F(CatalogueOperations, FindAttributesByPath)
{
    AttributeMap const inner = AttributeMap::create(m_model);
    add<AttributeMapAttribute>(u"a")->setValue(inner);
    StringAttribute const leaf = attribute<StringAttribute>(u"b");
    inner->insert(leaf);
    Arguments const whole{path({u"a", u"b"}), value(0), value(2)};

    EXPECT_EQ(callFor<Attribute>(m_map, u"recursiveAt", {path({u"a", u"b"})}), leaf);
    EXPECT_FALSE(callFor<Attribute>(m_map, u"recursiveAt", {path({})}));
    EXPECT_RAISES_WITH(messages::NoSuchOperation, call(m_map, u"doRecurse", whole), u"doRecurse",
                       u"tarn.kiln.meta.AttributeMap");
    auto const recursed = m_map->invoke(operation(AttributeMap::metaClass(), u"doRecurse"), whole,
                                        ModelElement::Impl::PRIVILEGED_ACCESS);
    EXPECT_EQ(recursed->getValue<Attribute>(), leaf);
}

TEST_F(CatalogueOperations, EmplaceAttributes)
{
    Attribute const made = callFor<Attribute>(m_map, u"emplace", {text(u"Real"), text(u"k")});

    ASSERT_TRUE(RealAttribute::cast(made));
    EXPECT_EQ(m_map->at(u"k"), made);
    EXPECT_FALSE(callFor<Attribute>(m_map, u"emplace", {text(u"Nonsense"), text(u"l")}));
}

TEST_F(CatalogueOperations, EmplaceAttributesOfEveryClass)
{
    EXPECT_TRUE(BooleanAttribute::cast(m_map->emplace(u"Boolean", u"a")));
    EXPECT_TRUE(DateTimeAttribute::cast(m_map->emplace(u"DateTime", u"b")));
    EXPECT_TRUE(IntegerAttribute::cast(m_map->emplace(u"Integer", u"c")));
    EXPECT_TRUE(StringAttribute::cast(m_map->emplace(u"tarn.kiln.meta.String", u"d")));
    EXPECT_TRUE(UUIDAttribute::cast(m_map->emplace(u"UUID", u"e")));
    EXPECT_TRUE(AttributeMapAttribute::cast(m_map->emplace(u"AttributeMap", u"f")));
    Attribute const real = m_map->emplace(u"Real", u"g");

    EXPECT_EQ(RealAttribute::cast(real)->getValue(), 0.0);
    EXPECT_EQ(real->getKey(), u"g");
    EXPECT_EQ(real->getOwner(), m_map);
    EXPECT_FALSE(real->getUuid().is_nil());
    EXPECT_EQ(m_map->getAttributes().size(), 7u);
    expectConsistent();
}

TEST_F(CatalogueOperations, EmplaceNothingOfTheAbstractClass)
{
    EXPECT_FALSE(m_map->emplace(u"", u"k").getElementImpl());
    EXPECT_TRUE(m_map->getAttributes().empty());
}

TEST_F(CatalogueOperations, LeaveNothingOfAnAttributeWhoseKeyIsTaken)
{
    Attribute const present = m_map->emplace(u"Real", u"k");
    std::size_t const before = m_model->getElementCount();
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UniquenessConstraint, m_map->emplace(u"String", u"k"));

    EXPECT_EQ(m_map->at(u"k"), present);
    EXPECT_EQ(m_model->getElementCount(), before);
    EXPECT_FALSE(transaction.isRollBackOnly());
    transaction.commit();
    expectConsistent();
}

TEST_F(CatalogueOperations, LeaveNothingOfAnElementThatIsNoAttribute)
{
    tarnkiln::tests::RegistryElement<Class> const fake(u"fake.FalseAttribute");
    MetaRegistry::getInstance().registerType(fake.get(), testkit::Node::Builder::instantiate);
    std::size_t const before = m_model->getElementCount();
    long const nodes = testkit::Node::liveCount();

    EXPECT_FALSE(m_map->emplace(u"fake.False", u"k").getElementImpl());

    EXPECT_EQ(m_model->getElementCount(), before);
    EXPECT_EQ(testkit::Node::liveCount(), nodes);
    EXPECT_TRUE(m_map->getAttributes().empty());
}

// ---------------------------------------------------------------------------- types

TEST_F(CatalogueOperations, FindLiterals)
{
    Enum const colours = named<Enum>(u"Colour");
    EnumLiteral const red = literal(u"RED", 1, colours);
    EnumLiteral const blue = literal(u"BLUE", 2, colours);
    blue->setPublicIdentifier(ustring(u"azure"));

    EXPECT_EQ(callFor<EnumLiteral>(colours, u"findLiteralByValue", {value(1)}), red);
    EXPECT_FALSE(callFor<EnumLiteral>(colours, u"findLiteralByValue", {value(3)}));
    EXPECT_EQ(callFor<EnumLiteral>(colours, u"findLiteralByPublicIdentifier", {text(u"azure")}),
              blue);
    EXPECT_FALSE(callFor<EnumLiteral>(colours, u"findLiteralByPublicIdentifier", {text(u"RED")}));
}

TEST_F(CatalogueOperations, DescribeExtensions)
{
    Extension const shelf = named<Extension>(u"shelf");
    shelf->setUpper(5);

    auto const result = call(shelf, u"createPrototype");

    ASSERT_TRUE(result);
    EXPECT_EQ(result->getValue<ExtensionPrototype>(), shelf->createPrototype());
    EXPECT_EQ(result->getType()->getQualifiedName(), u"tarn.kiln.meta.ExtensionPrototype");
}

TEST_F(CatalogueOperations, FindPropertiesAndOperations)
{
    Class const book = cls(u"Book");
    Class const novel = cls(u"Novel", book);
    Property const title = property(u"title", book);
    Operation const lend = operation(u"lend", book);
    Operation const other = operation(u"lend", book);

    EXPECT_EQ(callFor<Property>(novel, u"getPropertyByName", {text(u"title")}), title);
    EXPECT_FALSE(callFor<Property>(novel, u"getPropertyByName", {text(u"author")}));

    auto const found = call(novel, u"getOperationsByName", {text(u"lend")});
    ASSERT_TRUE(found);
    EXPECT_EQ(found->getFlags(), ValueFlags::Sequence);
    EXPECT_FALSE(found->isManaged());
    EXPECT_EQ(found->getType(), Operation::metaClass());
    EXPECT_EQ(found->getValue<std::vector<Operation>>(), novel->getOperationsByName(u"lend"));
    EXPECT_EQ(found->getValue<std::vector<Operation>>().size(), 2u);
    EXPECT_THAT(
        call(novel, u"getOperationsByName", {text(u"sell")})->getValue<std::vector<Operation>>(),
        IsEmpty());
}

TEST_F(CatalogueOperations, CompareTypes)
{
    Class const book = cls(u"Book");
    Class const novel = cls(u"Novel", book);
    Property const title = property(u"title", book);

    EXPECT_TRUE(call(novel, u"isA", {reference(Type(book))})->getValue<bool>());
    EXPECT_FALSE(call(book, u"isA", {reference(Type(novel))})->getValue<bool>());
    EXPECT_TRUE(call(novel, u"isATypeOf", {reference(title)})->getValue<bool>());
    EXPECT_FALSE(call(novel, u"isATypeOf", {reference(Property())})->getValue<bool>());
}

TEST_F(CatalogueOperations, TellDynamicDefaults)
{
    tarnkiln::tests::RegistryElement<Property> const id(u"id");
    auto const isDynamic = [&] { return call(id.get(), u"isDynamicDefault")->getValue<bool>(); };
    auto const change = [&](Type const& type, ustring const& text) {
        tarnkiln::tests::RegistrySession session;
        id->setType(type);
        id->setDefaultValue(text);
        session.commit();
    };

    EXPECT_FALSE(isDynamic());
    change(StandardTypes::uuidMeta, u"random");
    EXPECT_TRUE(isDynamic());
    change(StandardTypes::uuidMeta, u"now");
    EXPECT_FALSE(isDynamic());
    change(StandardTypes::dateTimeMeta, u"now");
    EXPECT_TRUE(isDynamic());
    change(StandardTypes::stringMeta, u"now");
    EXPECT_FALSE(isDynamic());
}

TEST_F(CatalogueOperations, AreNotForElementsOfOtherClasses)
{
    EXPECT_RAISES_WITH(messages::NoSuchOperation,
                       cls(u"Book")->invoke(operation(AttributeMap::metaClass(), u"at"),
                                            Arguments{text(u"k")},
                                            ModelElement::Impl::PRIVILEGED_ACCESS),
                       u"at", u"tarn.kiln.meta.Class");
}
}  // namespace tarn::kiln::meta

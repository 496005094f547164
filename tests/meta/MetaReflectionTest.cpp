// The metamodel's own elements, read and changed by reflection.
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ReportData.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"

#include <boost/optional.hpp>

#include <functional>

namespace tarn::kiln::meta {
namespace {

using Element = ModelElement::Impl;
using ::testing::ElementsAre;

class MetaReflection : public OrdinarySketch
{
protected:
    static Property of(ModelElement const& element, char16_t const* name)
    {
        Property const found = element->getMetaClass()->getPropertyByName(name);
        EXPECT_TRUE(found);
        return found;
    }
    template <class T>
    static T get(ModelElement const& element, char16_t const* name,
                 internal::ReflectionPrivateTag const& tag = Element::PUBLIC_ACCESS)
    {
        return element->getPropertyValue(of(element, name), tag).getValue<T>();
    }
    template <class T>
    static void set(ModelElement const& element, char16_t const* name, T const& payload,
                    internal::ReflectionPrivateTag const& tag = Element::PUBLIC_ACCESS)
    {
        Property const property = of(element, name);
        element->setPropertyValue(property, Value(property->getType(), payload), tag);
    }
};

TEST_F(MetaReflection, ReadsEveryKindOfFieldOfAProperty)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);
    title->setType(StandardTypes::stringMeta);
    title->setUpper(1);
    title->setIsComposite(true);
    title->setPropertyIndex(3);
    title->setDefaultValue(ustring(u"none"));

    EXPECT_EQ(get<ustring>(title, u"name"), u"title");
    EXPECT_EQ(get<Type>(title, u"type"), StandardTypes::stringMeta);
    EXPECT_EQ(get<unsigned>(title, u"upper"), 1u);
    EXPECT_TRUE(get<bool>(title, u"isComposite"));
    EXPECT_EQ(get<int>(title, u"propertyIndex"), 3);
    EXPECT_EQ(get<StructuredType>(title, u"owningType"), book);
    EXPECT_FALSE(get<Property>(title, u"opposite"));
    EXPECT_EQ(get<boost::optional<ustring>>(title, u"defaultValue").value(), u"none");
    EXPECT_EQ(
        title->getPropertyValue(of(title, u"defaultValue"), Element::PUBLIC_ACCESS).getFlags(),
        ValueFlags::OptionalSingle);
}

TEST_F(MetaReflection, SetsEveryKindOfFieldThroughItsSetter)
{
    Class const book = cls(u"Book");
    Class const shelf = cls(u"Shelf");
    Property const title = property(u"title", book);
    Property const author = property(u"author", book);

    set(title, u"isUnique", true);
    set(title, u"lower", 1u);
    set(title, u"defaultValue", boost::optional<ustring>(u"none"));
    set(title, u"opposite", author);
    set(title, u"name", ustring(u"name"));
    set(title, u"owningType", StructuredType(shelf));

    EXPECT_TRUE(title->isUnique());
    EXPECT_EQ(title->getLower(), 1u);
    EXPECT_EQ(title->getDefaultValue().value(), u"none");
    EXPECT_EQ(title->getOpposite(), author);
    EXPECT_EQ(shelf->getOwnedAttributes().find(u"name"), title);
    EXPECT_FALSE(book->getOwnedAttributes().find(u"title"));
    expectConsistent();
}

TEST_F(MetaReflection, TakesNothingForFalse)
{
    Property const title = Property::create(m_model);
    title->setIsUnique(true);

    title->setPropertyValue(of(title, u"isUnique"),
                            Value::createEmptyValue(StandardTypes::booleanMeta, /*required=*/false),
                            Element::PUBLIC_ACCESS);

    EXPECT_FALSE(title->isUnique());
}

TEST_F(MetaReflection, ShowsFieldsWithoutPublicAccessorToOthersOnly)
{
    Property const title = Property::create(m_model);
    title->setVobjDispCategory(string("General"));

    EXPECT_EQ(get<boost::optional<string>>(title, u"vobjDispCategory", Element::PRIVILEGED_ACCESS)
                  .value(),
              "General");
    EXPECT_FALSE(get<bool>(title, u"vobjDispSkipEmpty", Element::NO_PROXY_RESOLVE));
    EXPECT_RAISES_WITH(
        messages::NoSuchProperty,
        title->getPropertyValue(of(title, u"vobjDispCategory"), Element::PUBLIC_ACCESS),
        u"vobjDispCategory", u"tarn.kiln.meta.Property");
    EXPECT_RAISES_WITH(
        messages::NoSuchProperty,
        title->hasPropertyValue(of(title, u"vobjDispSkipEmpty"), Element::PUBLIC_ACCESS),
        u"vobjDispSkipEmpty", u"tarn.kiln.meta.Property");
    EXPECT_FALSE(get<bool>(title, u"isVobjHidden"));
}

TEST_F(MetaReflection, SetsFieldsWithoutPublicMutatorForOthersOnly)
{
    Property const title = Property::create(m_model);
    Class const book = cls(u"Book");

    EXPECT_RAISES_WITH(messages::NoSuchProperty, set(title, u"propertyIndex", 5), u"propertyIndex",
                       u"tarn.kiln.meta.Property");
    EXPECT_RAISES(messages::NoSuchProperty, set(book, u"vobjName", string("Book")));
    set(title, u"propertyIndex", 5, Element::PRIVILEGED_ACCESS);
    set(book, u"vobjName", string("Book"), Element::PRIVILEGED_ACCESS);

    EXPECT_EQ(title->getPropertyIndex(), 5);
    EXPECT_EQ(book->getVobjName(), "Book");
}

TEST_F(MetaReflection, TellsWhichFieldsHaveAValue)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);
    auto const has = [](ModelElement const& element, char16_t const* name) {
        return element->hasPropertyValue(of(element, name), Element::PRIVILEGED_ACCESS);
    };

    for (char16_t const* const name : {u"name", u"isUnique", u"propertyIndex", u"lower", u"upper",
                                       u"vobjDispSkipEmpty", u"owningType"})
        EXPECT_TRUE(has(title, name));
    for (char16_t const* const name :
         {u"vobjDispCategory", u"defaultValue", u"opposite", u"qualifiedBy", u"type"})
        EXPECT_FALSE(has(title, name));
    EXPECT_TRUE(has(book, u"ownedAttributes"));
    EXPECT_FALSE(has(book, u"ownedOperations"));

    Property const dead = property(u"dead", book);
    title->setOpposite(dead);
    EXPECT_TRUE(has(title, u"opposite"));
    dead->destroy();
    EXPECT_FALSE(has(title, u"opposite"));
}

TEST_F(MetaReflection, RefusesPropertiesOfOtherClasses)
{
    Class const book = cls(u"Book");
    Property const lower = TypedElement::metaClass()->getPropertyByName(u"lower");

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       book->getPropertyValue(lower, Element::PRIVILEGED_ACCESS), u"lower",
                       u"tarn.kiln.meta.Class");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       book->setPropertyValue(lower, Value(StandardTypes::unlimitedNaturalMeta, 1u),
                                              Element::PRIVILEGED_ACCESS),
                       u"lower", u"tarn.kiln.meta.Class");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       book->hasPropertyValue(Property(), Element::PRIVILEGED_ACCESS), u"",
                       u"tarn.kiln.meta.Class");
}

TEST_F(MetaReflection, RefusesValuesOfOtherTypes)
{
    Property const title = Property::create(m_model);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       title->setPropertyValue(of(title, u"lower"),
                                               Value(StandardTypes::stringMeta, ustring()),
                                               Element::PUBLIC_ACCESS),
                       u"String");
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  title->setPropertyValue(of(title, u"owningType"),
                                          Value(Property::metaClass(), Property()),
                                          Element::PUBLIC_ACCESS));
}

/// Keeps what the last commit reported.
struct LastReport final : Listener
{
    void transactionCommitted(ReportData& report) { look(report); }

    std::function<void(ReportData&)> look = [](ReportData&) {};
};

TEST_F(MetaReflection, FindsChangedPropertiesAndOldValuesInReports)
{
    Class const book = cls(u"Book");
    Class const shelf = cls(u"Shelf");
    Property const title = property(u"title", book);
    LastReport listener;
    m_model->addListener(&listener);
    bool looked = false;
    listener.look = [&](ReportData& report) {
        looked = true;
        EXPECT_THAT(report.getChangedProperties(title),
                    ::testing::UnorderedElementsAre(of(title, u"name"), of(title, u"owningType"),
                                                    of(title, u"propertyIndex")));
        EXPECT_TRUE(report.isChanged(title, of(title, u"name")));
        EXPECT_FALSE(report.isChanged(title, of(title, u"lower")));
        EXPECT_FALSE(report.isChanged(title, of(book, u"superclass")));
        EXPECT_EQ(report.getOldValue(title, of(title, u"name")).getValue<ustring>(), u"title");
        EXPECT_EQ(report.getOldValue(title, of(title, u"propertyIndex")).getValue<int>(), 0);
        EXPECT_EQ(report.getOldValue(title, of(title, u"owningType")).getValue<StructuredType>(),
                  book);
        EXPECT_TRUE(report.isChanged(book, of(book, u"ownedAttributes")));
    };
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    title->setName(u"name");
    title->setPropertyIndex(4);
    title->setOwningType(shelf);

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_TRUE(looked);
    m_model->removeListener(&listener);
}

TEST_F(MetaReflection, ReportsTheChangeOfAnIndexAtTheSlotOfTheIndex)
{
    Property const title = Property::create(m_model);
    EXPECT_EQ(title->getPropertyByIndex(14), of(title, u"propertyIndex"));
    LastReport listener;
    m_model->addListener(&listener);
    std::vector<Property> changed;
    listener.look = [&](ReportData& report) { changed = report.getChangedProperties(title); };
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    title->setPropertyIndex(9);
    transaction.commit();

    EXPECT_THAT(changed, ElementsAre(of(title, u"propertyIndex")));
    m_model->removeListener(&listener);
}

TEST_F(MetaReflection, ShowsBothEndsOfContainment)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);

    EXPECT_EQ(title->containmentFeature(), of(book, u"ownedAttributes"));
    EXPECT_EQ(title->containerProperty(), of(title, u"owningType"));
    EXPECT_EQ(title->getMetaClass(), Property::metaClass());
    EXPECT_EQ(book->getMetaClass(), Class::metaClass());
}

TEST_F(MetaReflection, TellsTheClassOfReferencesInValues)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);
    title->setType(StandardTypes::stringMeta);
    Value const type = title->getPropertyValue(of(title, u"type"), Element::PUBLIC_ACCESS);

    EXPECT_EQ(type.getType(), Type::metaClass());
    EXPECT_TRUE(type.isCompatibleWithProperty(of(title, u"type")));
    EXPECT_FALSE(type.isCompatibleWithProperty(of(title, u"owningType")));
    EXPECT_TRUE(Value(Class::metaClass(), book).isCompatibleWithProperty(of(title, u"owningType")));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, type.getValue<Property>());
}
}  // namespace
}  // namespace tarn::kiln::meta

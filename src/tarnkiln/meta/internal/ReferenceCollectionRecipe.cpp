#include "tarnkiln/meta/internal/ReferenceCollectionRecipe.h"

#include "tarnkiln/collections/DataTypeKeys.h"
#include "tarnkiln/collections/QualifierKeys.h"
#include "tarnkiln/collections/ReflectiveElementSequence.h"
#include "tarnkiln/collections/ReflectiveKeyedCollection.h"
#include "tarnkiln/collections/ReflectiveUnorderedElementSet.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln::internal {

using meta::StandardTypes;

struct ReferenceCollectionRecipe::Makers
{
    using Made = std::unique_ptr<ReferenceCollection>;
    using Recipe = ReferenceCollectionRecipe;

    static Made sequence(Recipe const& recipe, ModelElement::Impl* owner)
    {
        return std::make_unique<ReflectiveElementSequence>(
            owner, recipe.m_elementClass, recipe.m_unique, recipe.m_property.getImpl(),
            recipe.m_opposite.getImpl());
    }
    static Made set(Recipe const& recipe, ModelElement::Impl* owner)
    {
        return std::make_unique<ReflectiveUnorderedElementSet>(
            owner, recipe.m_elementClass, recipe.m_property.getImpl(), recipe.m_opposite.getImpl());
    }
    /// `READ` reads the key of an element from the qualifying property.
    template <template <class> class Keyed, class K,
              K (*READ)(ModelElement::Impl*, meta::Property const&)>
    static Made keyed(Recipe const& recipe, ModelElement::Impl* owner)
    {
        return std::make_unique<Keyed<K>>(owner, recipe.m_elementClass,
                                          makeKeyExtractor<K>(recipe.m_qualifier, READ),
                                          recipe.m_property.getImpl(), recipe.m_opposite.getImpl());
    }

    Maker map;
    Maker multimap;

    template <class K, K (*READ)(ModelElement::Impl*, meta::Property const&) = keyOf<K>>
    static constexpr Makers of()
    {
        return {keyed<ReflectiveElementMap, K, READ>, keyed<ReflectiveElementMultimap, K, READ>};
    }
};

ReferenceCollectionRecipe::ReferenceCollectionRecipe(meta::Property const& property)
    : m_property(property),
      m_elementClass(meta::Class::cast(property->getType())),
      m_opposite(property->getOpposite()),
      m_qualifier(property->getQualifiedBy()),
      m_unique(property->isUnique())
{
    if (m_qualifier && m_qualifier->getType())
        m_maker = chooseKeyed(m_qualifier, property->isQualificationUnique());
    else
        m_maker = property->isOrdered() ? Makers::sequence : Makers::set;
}

ReferenceCollectionRecipe::Maker
ReferenceCollectionRecipe::chooseKeyed(meta::Property const& qualifier, bool oneAKey)
{
    struct Row
    {
        meta::Type const& type;
        Makers makers;
    };
    StandardTypes::ensureInitialized();
    static Row const rows[] = {
        {StandardTypes::integerMeta, Makers::of<int>()},
        {StandardTypes::integer8Meta, Makers::of<signed char>()},
        {StandardTypes::integer16Meta, Makers::of<short>()},
        {StandardTypes::integer64Meta, Makers::of<long>()},
        {StandardTypes::unlimitedNaturalMeta, Makers::of<unsigned int>()},
        {StandardTypes::uinteger8Meta, Makers::of<unsigned char>()},
        {StandardTypes::uinteger16Meta, Makers::of<unsigned short>()},
        {StandardTypes::uinteger64Meta, Makers::of<unsigned long>()},
        {StandardTypes::realMeta, Makers::of<double>()},
        {StandardTypes::stringMeta, Makers::of<ustring>()},
        {StandardTypes::stdstringMeta, Makers::of<string>()},
        {StandardTypes::uuidMeta, Makers::of<UUID>()},
    };
    auto const choose = [&](Makers const& makers) {
        return oneAKey ? makers.map : makers.multimap;
    };

    meta::Type const type = qualifier->getType();
    for (Row const& row : rows)
    {
        if (type == row.type)
            return choose(row.makers);
    }
    if (classImpl(type))
        return choose(Makers::of<UUID, referenceKeyOf>());
    if (isEnumType(type))
        return choose(Makers::of<unsigned long, enumerationKeyOf>());
    if (meta::DataType::cast(type).getElementImpl())
        return choose(Makers::of<ReflectiveDataType, dataTypeKeyOf>());
    reportException(tarnkiln::messages::UnsupportedQualification(type->getQualifiedName()));
}
}  // namespace tarn::kiln::internal

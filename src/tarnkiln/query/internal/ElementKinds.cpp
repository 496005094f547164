#include "tarnkiln/query/internal/ElementKinds.h"

#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln::internal {
namespace {

/// Of each group of joins the first one finds the pairs.
std::vector<AssociatedObjectConstraint const*> followedBy(NativeQueryState const& query)
{
    std::vector<AssociatedObjectConstraint const*> followed;
    for (auto const& [ids, constraints] : query.joins)
    {
        auto const* const first =
            dynamic_cast<AssociatedObjectConstraint const*>(constraints.front().get());
        if (first && first->getSource() != first->getTarget() && first->isOfSingleReference())
            followed.push_back(first);
    }
    return followed;
}
}  // namespace

ElementKinds::ElementKinds(NativeQueryState const& query, RegexCache& regexes)
    : m_query(query),
      m_tests(regexes),
      m_followed(followedBy(query))
{}

void ElementKinds::useType(std::type_info const& type, ModelElement::Impl const& element)
{
    auto const [entry, isNew] = m_by.try_emplace(&type, KeptBy::Nobody);
    if (isNew)
        entry->second = keptBy(element);
    m_lastType = &type;
    m_lastBy = entry->second;
}

ElementKind const& ElementKinds::makeOrFind(void const* key, ModelElement::Impl const& element)
{
    std::unique_ptr<ElementKind>& kind = m_kinds[key];
    if (!kind)
        kind = std::make_unique<ElementKind>(makeKind(element));
    return *kind;
}

ElementKind ElementKinds::makeKind(ModelElement::Impl const& element)
{
    ElementKind kind;
    if (m_lastBy != KeptBy::Nobody)
        kind.type = &typeid(element);
    if (m_lastBy == KeptBy::Layout)
    {
        kind.layout = &cellsOf(element).layout();
        kind.places[0] = offsetIn(element, &cellsOf(element));
    }
    meta::Class const& metaClass = element.getMetaClass();
    for (std::size_t id = 0; id < m_query.instances.size(); ++id)
    {
        auto const& constraints = m_query.instances[id]->constraints;
        if (!static_cast<IsAConstraint const&>(*constraints.front()).matchesClass(metaClass))
            continue;
        InstanceTests& instance = kind.instances.emplace_back(InstanceTests{id, {}, {}});
        for (std::size_t at = 1; at < constraints.size(); ++at)
            instance.tests.push_back(makeTest(*constraints[at], element));
        addFollowed(instance, element);
        if (kind.places[1] == 0 && !instance.tests.empty())
            kind.places[1] = offsetIn(element, instance.tests.front().place.fieldOf(element));
        if (kind.places[2] == 0 && !instance.followed.empty())
            kind.places[2] = offsetIn(element, instance.followed.front().second.placeIn(element));
    }
    return kind;
}

void ElementKinds::addFollowed(InstanceTests& instance, ModelElement::Impl const& element) const
{
    for (std::size_t number = 0; number < m_followed.size(); ++number)
    {
        if (m_followed[number]->getSource() == instance.instance)
            instance.followed.emplace_back(
                number, ReferencePlace::find(element, m_followed[number]->getProperty()));
    }
}

ElementTest ElementKinds::makeTest(SingleObjectConstraint const& constraint,
                                   ModelElement::Impl const& element)
{
    ElementTest test;
    test.constraint = &constraint;
    test.isTopLevel = dynamic_cast<IsTopLevelElementConstraint const*>(&constraint);
    test.valueConstraint = dynamic_cast<PropertyRelationValueConstraint const*>(&constraint);
    if (!test.valueConstraint)
        return test;
    meta::Property const& property = test.valueConstraint->getProperty();
    test.place = PlainPlace::find(element, m_lastBy, property);
    if (test.place.isKnown())
    {
        test.test = m_tests.make(*test.valueConstraint, test.place.kind(), property->getType());
        test.isInPlace = test.place.isInPlace() && test.test.single == ValueTest::Answer::Compare;
    }
    return test;
}
}  // namespace tarn::kiln::internal

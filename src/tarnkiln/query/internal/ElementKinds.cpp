#include "tarnkiln/query/internal/ElementKinds.h"

#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln::internal {

ElementKinds::ElementKinds(NativeQueryState const& query, RegexCache& regexes)
    : m_query(query),
      m_tests(regexes)
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
    kind.type = &typeid(element);
    kind.isReflective = m_lastBy == KeptBy::Layout;
    meta::Class const& metaClass = element.getMetaClass();
    for (std::size_t id = 0; id < m_query.instances.size(); ++id)
    {
        auto const& constraints = m_query.instances[id]->constraints;
        if (!static_cast<IsAConstraint const&>(*constraints.front()).matchesClass(metaClass))
            continue;
        InstanceTests& instance = kind.instances.emplace_back(InstanceTests{id, {}});
        for (std::size_t at = 1; at < constraints.size(); ++at)
            instance.tests.push_back(makeTest(*constraints[at], element));
        if (!kind.firstPlace.isKnown() && !instance.tests.empty())
            kind.firstPlace = instance.tests.front().place;
    }
    return kind;
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
        test.isOfField = test.place.isField() && test.test.single == ValueTest::Answer::Compare;
    }
    return test;
}
}  // namespace tarn::kiln::internal

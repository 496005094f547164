#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <boost/uuid/uuid_io.hpp>

#include <algorithm>

namespace tarn::kiln::internal {
namespace {

/// Tells whether entries refer to one element, whose text form it makes once.
class Target
{
public:
    explicit Target(ModelElement const& element) : m_element(element) {}

    bool isMeantBy(ModelElement const& entry)
    {
        if (!entry || !entry->isProxy())
            return entry == m_element;
        ustring const* const named = AssociatedObjectConstraint::getNamedUuid(entry);
        return named && sill::i18n::to_string(*named) == text();
    }

private:
    string const& text()
    {
        if (m_text.empty())
            m_text = boost::uuids::to_string(m_element->getUuid());
        return m_text;
    }

    ModelElement const& m_element;
    string m_text;
};
}  // namespace

JoinConstraint::~JoinConstraint() = default;

AssociatedObjectConstraint::AssociatedObjectConstraint(meta::Property const& property,
                                                       std::size_t source, std::size_t target,
                                                       ReflectionPrivateTag const& tag)
    : m_property(property),
      m_source(source),
      m_target(target),
      m_tag(tag)
{}

std::vector<std::size_t> AssociatedObjectConstraint::getInstanceIds() const
{
    return {m_source, m_target};
}

bool AssociatedObjectConstraint::isOfSingleReference() const
{
    if (!m_property || m_property->getUpper() != 1)
        return false;
    auto const* const type = classImpl(m_property->getType());
    return type && type->isLive() && type->isA(ModelElement::metaClass());
}

std::vector<ModelElement>
AssociatedObjectConstraint::readReferences(ModelElement const& source) const
{
    Value const value = source->getPropertyValue(m_property, m_tag);
    if (m_property->getUpper() == 1)
        return {value.getValue<ModelElement>()};
    return value.getValue<ReferenceCollection&>().getAllValuesAndProxies();
}

bool AssociatedObjectConstraint::matches(std::vector<ModelElement> const& row,
                                         std::vector<std::size_t> const& ids) const
{
    Target target(elementOf(m_target, row, ids));
    std::vector<ModelElement> const entries = readReferences(elementOf(m_source, row, ids));
    return std::any_of(entries.begin(), entries.end(),
                       [&](ModelElement const& entry) { return target.isMeantBy(entry); });
}

void AssociatedObjectConstraint::retarget(RetargetableQuery& target) const
{
    target.addAssociatedObjectConstraint(m_property, m_source, m_target);
}

ustring const* AssociatedObjectConstraint::getNamedUuid(ModelElement const& proxy)
{
    ProxyId const* const id = proxy->getProxyIdImpl();
    return id && id->getType() == ElementId::UUID_TYPE ? &id->getId() : nullptr;
}
}  // namespace tarn::kiln::internal

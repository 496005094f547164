#include "tarnkiln/kernel/internal/InvariantChecker.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/internal/DeclaredExtensions.h"
#include "tarnkiln/kernel/internal/ExtensionValues.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/Property.h"

#include "sill/i18n/StringConversion.h"

#include <boost/uuid/uuid_io.hpp>

#include <algorithm>
#include <functional>
#include <new>

namespace tarn::kiln {

std::vector<string> Model::Impl::checkInvariants() const
{
    return internal::InvariantChecker(*this).run();
}

void Model::Impl::checkInvariantsAtEnd()
{
#ifdef TARNKILN_CHECKED
    constexpr std::size_t ALWAYS = 2000;
    bool const powerOfTwo = (m_endedTransactions & (m_endedTransactions - 1)) == 0;
    if (isInStep() || (m_elements.size() > ALWAYS && !powerOfTwo))
        return;
    std::vector<string> violations;
    try
    {
        violations = checkInvariants();
    }
    catch (std::bad_alloc const&)
    {
        return;  // the transaction has ended all the same
    }
    TARNKILN_ASSERT(violations.empty(), "a model is consistent when a transaction has ended",
                    violations.front());
#endif
}

namespace internal {

std::vector<string> InvariantChecker::run()
{
    m_model.m_elements.forEach([this](ModelElement::Impl* element) { checkElement(*element); });
    for (ModelElement const& element : m_model.m_topLevelElements.all())
    {
        if (!isHere(*element.getImpl()) || !element->isTopLevel())
            report("stands in the top-level set without being a top-level element of the model",
                   *element.getImpl());
    }
    m_model.m_elements.forEach(
        [this](ModelElement::Impl* element) { collectReferences(*element); });
    std::sort(m_references.begin(), m_references.end(),
              [](Reference const& left, Reference const& right) {
                  std::less<> const before;
                  return left.source != right.source ? before(left.source, right.source)
                                                     : before(left.target, right.target);
              });
    for (Reference const& reference : m_references)
        checkReference(reference);
    m_model.m_elements.forEach([this](ModelElement::Impl* element) { checkContainer(*element); });
    checkCycles();
    checkDeclaredExtensions();
    m_model.m_elements.forEach(
        [this](ModelElement::Impl* element) { checkExtensionValues(*element); });
    return std::move(m_violations);
}

bool InvariantChecker::isHere(ModelElement::Impl const& element) const
{
    return m_model.m_elements.contains(&element);
}

void InvariantChecker::checkElement(ModelElement::Impl const& element)
{
    if (element.getModelImpl() != &m_model)
        report("is registered in a model that is not its own", element);
    if (element.getValidity() != ElementImpl::ElementValidity::Valid)
        report("is registered without being valid", element);
    if (element.isProxy())
        report("is a registered proxy", element);
    if (!isHere(element))
        report("is registered under another UUID", element);
    if (element.isTopLevel() != m_model.m_topLevelElements.contains(&element))
        report("disagrees with the top-level set", element);
}

void InvariantChecker::collectReferences(ModelElement::Impl const& element)
{
    element.visitReferences([&](ModelElement const& target, Feature const& feature) {
        if (target.getImpl() && !target->isProxy())
            m_references.push_back(Reference{&element, target.getImpl(), feature});
    });
}

bool InvariantChecker::refersBack(Reference const& reference) const
{
    Feature const opposite = reference.feature.opposite();
    if (opposite.isComposite())
        return reference.source->basicContainer() == reference.target;
    auto const first = std::lower_bound(m_references.begin(), m_references.end(), reference,
                                        [](Reference const& left, Reference const& right) {
                                            std::less<> const before;
                                            return left.source != right.target
                                                       ? before(left.source, right.target)
                                                       : before(left.target, right.source);
                                        });
    for (auto at = first; at != m_references.end() && at->source == reference.target &&
                          at->target == reference.source;
         ++at)
    {
        if (at->feature == opposite)
            return true;
    }
    return false;
}

void InvariantChecker::checkReference(Reference const& reference)
{
    ModelElement::Impl const& target = *reference.target;
    if (!target.isLive())
        return;  // stays until a rollback revives it or a client lets go
    Feature const opposite = reference.feature.opposite();
    if (reference.feature.isComposite())
    {
        if (target.basicContainer() != reference.source ||
            !(target.getContainment() == reference.feature))
            report("is held by a composite that it does not call its container", target);
    }
    else if (opposite && isHere(target) && !opposite.isKeyed() && !m_model.isParsing() &&
             !refersBack(reference))
    {
        report("is referred to and does not refer back", target);
    }
}

void InvariantChecker::checkContainer(ModelElement::Impl const& element)
{
    ModelElement::Impl const* const container = element.basicContainer();
    if (!container)
        return;
    if (!isHere(*container))
    {
        report("lies in a container that the model does not hold", element);
        return;
    }
    if (element.getContainment().isKeyed())
        return;  // a taken key can shut an element out of the collection
    Reference const wanted{container, &element, element.getContainment()};
    bool const held = std::binary_search(m_references.begin(), m_references.end(), wanted,
                                         [](Reference const& left, Reference const& right) {
                                             std::less<> const before;
                                             return left.source != right.source
                                                        ? before(left.source, right.source)
                                                        : before(left.target, right.target);
                                         });
    if (!held)
        report("calls a container its own that does not hold it", element);
}

/// Walks up from each element no further than to one that was seen; the path of a walk that comes
/// back to itself is a cycle.
void InvariantChecker::checkCycles()
{
    std::unordered_set<ModelElement::Impl const*> settled;
    std::vector<ModelElement::Impl const*> path;
    m_model.m_elements.forEach([&](ModelElement::Impl* element) {
        path.clear();
        std::unordered_set<ModelElement::Impl const*> onPath;
        ModelElement::Impl const* at = element;
        while (at && settled.count(at) == 0 && onPath.insert(at).second)
        {
            path.push_back(at);
            at = at->basicContainer();
        }
        if (at && onPath.count(at) != 0)
            report("contains itself", *at);
        settled.insert(path.begin(), path.end());
    });
}

/// The registry may have lost any of them, or gained others in this model's name.
void InvariantChecker::checkDeclaredExtensions()
{
    for (auto const& [name, record] : m_model.m_extensions->records())
    {
        if (!record.extension)
            continue;
        bool const isSingle = record.extension->getUpper() == 1;
        if (isSingle && !record.defaultValue)
            m_violations.push_back("the extension '" + sill::i18n::to_string(name) +
                                   "' has a single value and no default");
    }
}

void InvariantChecker::checkExtensionValues(ModelElement::Impl const& element)
{
    ExtensionValues const* const values = element.extensionValues();
    if (!values)
        return;
    if (values->anchor)
        report("is alive and anchored as a dead one", element);
    for (ExtensionValues::Entry const& entry : values->entries())
    {
        if (entry.value.isEmpty() || !entry.extension)
            continue;
        if (entry.value.isCollection() == (entry.extension->getUpper() == 1))
            report("has a value of another shape than its extension", element);
        auto const* const group = entry.extension->getOwnerImpl();
        if (!group || group->getModelID() != m_model.m_modelCounter)
            report("has a value of an extension of another model", element);
        AbstractOwnedCollection const* const collection = entry.value.getCollection();
        if (collection && (collection->getOwner() != &element ||
                           collection->getCollectionProperty() != entry.extension))
            report("has an extension's collection that is of something else", element);
        auto const* const record =
            m_model.m_extensions->find(entry.extension->getName(), entry.extension);
        if (!collection && record && record->defaultValue &&
            entry.value.getValue() == *record->defaultValue)
            report("stores the default of an extension", element);
    }
}

void InvariantChecker::report(string const& sentence, ModelElement::Impl const& element)
{
    m_violations.push_back(
        "the element " + boost::uuids::to_string(element.getUuid()) + " of class '" +
        sill::i18n::to_string(qualifiedName(element.getMetaClass())) + "' " + sentence);
}
}  // namespace internal
}  // namespace tarn::kiln

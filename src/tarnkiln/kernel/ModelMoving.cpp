/// \file
/// How a model hands all that it holds over to another one.
#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/DeclaredExtensions.h"
#include "tarnkiln/kernel/internal/ExtensionGroups.h"
#include "tarnkiln/kernel/internal/ExtensionValues.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/support/OpenStep.h"

#include <unordered_map>
#include <utility>

namespace tarn::kiln {

namespace messages = tarnkiln::messages;
using internal::DeclaredExtensionRecord;
using meta::MetaRegistry;

// ---------------------------------------------------------------------------- matching

namespace {

/// Whether values of the one can be values of the other.
bool haveSameShape(DeclaredExtensionRecord const& one, meta::Extension const& other,
                   boost::optional<Value> const& otherDefault)
{
    meta::Extension const& extension = one.extension;
    meta::Type const type = extension->getType();
    if (type != other->getType() || (extension->getUpper() < 2) != (other->getUpper() < 2))
        return false;
    if (extension->getUpper() < 2)
        return internal::classImpl(type) || one.defaultValue == otherDefault;
    return extension->isUnique() == other->isUnique() &&
           extension->isOrdered() == other->isOrdered();
}
}  // namespace

meta::Extension Model::Impl::validateExtension(meta::Extension const& extension,
                                               boost::optional<Value> const& defaultValue) const
{
    meta::Class const wanted = extension->getExtendedMetaclass();
    auto const [first, last] = m_extensions->records().equal_range(extension->getName());
    for (auto place = first; wanted && place != last; ++place)
    {
        DeclaredExtensionRecord const& record = place->second;
        meta::Class const present = record.extension->getExtendedMetaclass();
        if (!present)
            continue;
        if (present != wanted && present->isA(wanted))
            return meta::Extension();
        if (wanted->isA(present))
            return haveSameShape(record, extension, defaultValue) ? record.extension
                                                                  : meta::Extension();
    }
    return extension;
}

// ---------------------------------------------------------------------------- the move

/// One move. Dropped before it is finished, it puts back what it has moved.
class Model::Impl::ContentsMove
{
public:
    ContentsMove(Impl& source, Impl& target) : m_source(source), m_target(target) {}
    ContentsMove(ContentsMove const&) = delete;
    ContentsMove& operator=(ContentsMove const&) = delete;
    ~ContentsMove()
    {
        if (m_extensionsMoved && !m_elementsMoved)
            takeBackExtensions();
    }

    // The steps, in their order.
    void matchExtensions();
    void checkElements() const;
    void moveExtensions();
    void moveElements();
    void endMatchedExtensions();

private:
    using Mapping = std::unordered_map<meta::Extension, meta::Extension>;

    void giveExtensionsTo(Impl const& owner) const;
    void takeBackExtensions();
    void moveElement(ModelElement::Impl& element);
    void takeBackElements();
    void takeBackValues(ModelElement::Impl& element) const;
    void leaveTarget(ModelElement::Impl& element);

    Impl& m_source;
    Impl& m_target;
    std::vector<std::pair<ustring, DeclaredExtensionRecord>> m_moving;  ///< By name.
    Mapping m_matched;  ///< From those that end to those of the target that stand for them.
    std::vector<ModelElement> m_elements;
    std::size_t m_begun = 0;  ///< So many of the elements are no more as they were, ...
    std::size_t m_moved = 0;  ///< ... of which so many have arrived.
    UUID m_uuid;              ///< Of the element that was begun last.
    bool m_extensionsMoved = false;
    bool m_elementsMoved = false;
};

void Model::Impl::moveAllContentsTo(Model const& target)
{
    if (!target || target.getImpl() == this || hasListeners() || m_currentTransaction)
        reportException(messages::CannotChangeModel());
    Model const self(this);
    Model const keep(target);
    ContentsMove move(*this, *keep.getImpl());
    move.matchExtensions();
    move.checkElements();
    move.moveExtensions();
    move.moveElements();
    move.endMatchedExtensions();
}

/// What was destroyed in the registry stays behind.
void Model::Impl::ContentsMove::matchExtensions()
{
    for (auto const& [name, record] : m_source.m_extensions->records())
    {
        if (!record.extension)
            continue;
        meta::Extension const match =
            m_target.validateExtension(record.extension, record.defaultValue);
        if (!match)
            reportException(messages::ExtensionNameMustBeUnique());
        if (match == record.extension)
        {
            m_moving.emplace_back(name, record);
            continue;
        }
        m_matched.emplace(record.extension, match);
    }
}

/// What can be foreseen fails before anything has moved.
void Model::Impl::ContentsMove::checkElements() const
{
    if (m_source.m_elements.size() != 0 && m_target.isFrozen())
        reportException(messages::ModelFrozen());
    m_source.m_elements.forEach([this](ModelElement::Impl const* element) {
        if (m_target.m_elements.find(element->getUuid()))
            reportException(messages::UUIDConflict());
    });
}

// ---------------------------------------------------------------------------- extensions

void Model::Impl::ContentsMove::moveExtensions()
{
    if (m_moving.empty())
        return;
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    giveExtensionsTo(m_target);
    TransactionResult const result = transaction.commit();
    if (result == TransactionResult::RolledBack || result == TransactionResult::NotRevertible)
        reportException(messages::CannotChangeModel());
    m_extensionsMoved = true;
    for (auto const& [name, record] : m_moving)
        m_target.m_extensions->add(name, record);
    for (auto const& [name, record] : m_moving)
        m_target.notifyExtensionAdded(record.extension);
}

/// Under a `LockedModel`, in a transaction of the registry's model.
void Model::Impl::ContentsMove::giveExtensionsTo(Impl const& owner) const
{
    for (auto const& [name, record] : m_moving)
    {
        meta::DynamicExtensions const left = record.extension->getOwner();
        record.extension->setOwner(
            internal::requireExtensionGroup(record.extended, owner.m_modelCounter));
        internal::dropEmptyExtensionGroup(left);
    }
}

/// As far as it goes: there is a failure under way already.
void Model::Impl::ContentsMove::takeBackExtensions()
{
    try
    {
        MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
        Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
        for (auto const& [name, record] : m_moving)
        {
            meta::Extension const& extension = record.extension;
            if (m_target.m_extensions->find(name, extension))
                m_target.tellExtensionListeners([&](ExtensionListener& listener) {
                    listener.extensionRemoved(m_target.getModel(), extension);
                });
        }
        giveExtensionsTo(m_source);
        transaction.commit();
    }
    catch (...)
    {
        // the elements are back all the same
    }
    for (auto const& [name, record] : m_moving)
        m_target.m_extensions->remove(name, record.extension);
}

/// The extensions that the target had already have taken the place of these.
void Model::Impl::ContentsMove::endMatchedExtensions()
{
    if (!m_matched.empty())
    {
        MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
        Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
        for (auto const& [extension, match] : m_matched)
        {
            meta::DynamicExtensions const group =
                extension ? extension->getOwner() : meta::DynamicExtensions();
            if (group)
                group->destroy();
        }
        transaction.commit();
    }
    m_source.m_extensions->clear();
}

// ---------------------------------------------------------------------------- elements

/// The source lets go before the commit: its transaction may be of the same group, and listeners
/// may change the elements.
void Model::Impl::ContentsMove::moveElements()
{
    m_elements = m_source.getElementsInOrder();
    Transaction const transaction = m_target.beginTransaction(/*revertible=*/false);
    support::OpenStep step(&m_target);
    try
    {
        for (ModelElement const& element : m_elements)
            moveElement(*element.getImpl());
    }
    catch (...)
    {
        takeBackElements();
        throw;
    }
    m_elementsMoved = true;
    m_target.m_proxies->takeOver(*m_source.m_proxies,
                                 [this](ModelElement::Impl& proxy) { proxy.m_model = &m_target; });
    m_source.m_elements.clear();
    m_source.m_anchor.get()->changed();
    m_source.m_topLevelElements.abandon();
    for (auto const& [name, record] : m_moving)
        m_source.m_extensions->remove(name, record.extension);
    step.close();
    transaction.commit();
    if (m_source.m_usageProvider)
        m_source.m_usageProvider->clear();
}

void Model::Impl::ContentsMove::moveElement(ModelElement::Impl& element)
{
    m_uuid = element.getUuid();
    ++m_begun;
    element.m_model = &m_target;
    if (!m_matched.empty())
        element.updateDynamicValuesOnMoveToAnotherModel(m_matched);
    m_target.elementCreated(&element, element.isTopLevel());
    ++m_moved;
}

/// The source still knows all elements; only their places at its top level are not theirs any more.
void Model::Impl::ContentsMove::takeBackElements()
{
    for (std::size_t i = 0; i < m_begun; ++i)
    {
        ModelElement::Impl& element = *m_elements[i].getImpl();
        if (i < m_moved)
            leaveTarget(element);
        m_target.m_elements.erase(&element);
        m_target.m_topLevelElements.erase(&element);
        element.m_model = &m_source;
        takeBackValues(element);
    }
    if (m_begun != m_moved)  // a conflict has made it nil
        m_elements[m_moved].getImpl()->m_uuid = m_uuid;
    m_source.m_topLevelElements.resume();
}

/// Extensions of several classes may have given way to one of a class above them.
void Model::Impl::ContentsMove::takeBackValues(ModelElement::Impl& element) const
{
    internal::ExtensionValues* const values = element.extensionValues();
    if (!values)
        return;
    for (auto const& [extension, match] : m_matched)
    {
        if (element.isExtensionOfClass(extension))
            values->replaceExtension(match, extension);
    }
}

void Model::Impl::ContentsMove::leaveTarget(ModelElement::Impl& element)
{
    if (m_target.m_currentTransaction)
        m_target.m_currentTransaction->forgetCreation(&element);
    try
    {
        if (m_target.m_usageProvider)
            m_target.m_usageProvider->elementDestroying(&element);
    }
    catch (...)
    {
        // it counts wrong; there is a failure under way already
    }
}
}  // namespace tarn::kiln

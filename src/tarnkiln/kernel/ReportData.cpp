#include "tarnkiln/kernel/ReportData.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include "sill/i18n/StringConversion.h"

#include <iostream>

namespace tarn::kiln {

ReportData::ReportData(Model const& model, std::shared_ptr<ChangeRecords> changes,
                       boost::optional<Value> const& message, bool revertUnchanged, bool deep,
                       std::shared_ptr<DeferredInvocations> deferred, bool destroyAll,
                       meta::TransactionOrigin const& origin)
    : m_changes(std::move(changes)),
      m_deferredInvocations(std::move(deferred)),
      m_model(model.getImpl()),
      m_message(message),
      m_revertUnchanged(revertUnchanged),
      m_deep(deep),
      m_destroyAll(destroyAll),
      m_origin(origin)
{}

ReportData::~ReportData() = default;

Model ReportData::getModel() const
{
    return Model(m_model);
}

bool ReportData::isEmpty() const
{
    return !m_destroyAll && (!m_deferredInvocations || m_deferredInvocations->empty()) &&
           m_created.empty() && m_changed.empty() && m_destroyed.empty() &&
           m_createdAndDestroyed.empty();
}

void ReportData::processElement(ModelElement const& element, ModelElement::Impl::Changes* changes)
{
    if (changes->isCreated() && changes->isDestroyed())
        m_createdAndDestroyed.push_back(element);
    else if (changes->isCreated())
        m_created.push_back(element);
    else if (changes->isDestroyed())
        m_destroyed.push_back(element);
    else if (!m_revertUnchanged || changes->revertUnchanged(element.getImpl()))
        m_changed.push_back(element);
    else
        std::cout << "Reverted unchanged element "
                  << sill::i18n::to_string(internal::qualifiedName(element->getMetaClass()))
                  << std::endl;
}

ModelElement::Impl::Changes* ReportData::findRecord(ModelElement const& element) const
{
    return element.getImpl() ? m_changes->findAnyTime(element.getImpl()) : nullptr;
}

bool ReportData::isChanged(ModelElement const& element, meta::Property const& property) const
{
    if (!element || !property)
        return false;
    ModelElement::Impl::Changes const* const record = findRecord(element);
    return record && record->isChanged(property);
}

std::vector<meta::Property> ReportData::getChangedProperties(ModelElement const& element) const
{
    ModelElement::Impl::Changes const* const record = element ? findRecord(element) : nullptr;
    return record ? record->getChangedProperties() : std::vector<meta::Property>();
}

bool ReportData::isExtensionChanged(ModelElement const& element, ustring const& name) const
{
    ModelElement::Impl::Changes const* const record = element ? findRecord(element) : nullptr;
    return record && record->isExtensionChanged(name);
}

std::vector<meta::Extension> ReportData::getChangedExtensions(ModelElement const& element) const
{
    ModelElement::Impl::Changes const* const record = element ? findRecord(element) : nullptr;
    return record ? record->getChangedExtensions() : std::vector<meta::Extension>();
}

Value ReportData::getExtensionOldValue(ModelElement const& element, ustring const& name) const
{
    if (!m_deep)
        reportException(tarnkiln::messages::GetOldValueFromNonDeep());
    auto const* const record = findRecord(element);
    if (!record)
        reportException(tarnkiln::messages::NoSuchProperty(
            name,
            element.getImpl() ? internal::qualifiedName(element->getMetaClass()) : ustring()));
    return static_cast<ModelElement::Impl::Storage const*>(record)->getExtensionOldValue(name);
}

Value ReportData::getOldValue(ModelElement const& element, meta::Property const& property) const
{
    if (!m_deep)
        reportException(tarnkiln::messages::GetOldValueFromNonDeep());
    if (property)
    {
        auto const* const record = findRecord(element);
        meta::Class const metaClass = record ? record->getMetaClass() : meta::Class();
        if (metaClass && metaClass->isATypeOf(property))
            return static_cast<ModelElement::Impl::Storage const*>(record)->getOldValue(
                property, ModelElement::Impl::PUBLIC_ACCESS);
    }
    return Value::createEmptyValue(property);
}
}  // namespace tarn::kiln

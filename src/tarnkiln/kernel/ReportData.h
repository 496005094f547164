/// \file
/// What a transaction tells its listeners.
#pragma once
#include "tarnkiln/kernel/ChangeRecords.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractDeferredInvocation.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/optional.hpp>

#include <memory>
#include <vector>

namespace tarn::kiln {

/// What was created, changed and destroyed, the commit message and the origin.
///
/// Shared with the transaction's records, which stay readable when it has gone; what needs the
/// model must be asked while the model lives.
///
/// Threads: as the model.
class TARNKILN_EXPORT ReportData
{
public:
    using DeferredInvocations = std::vector<std::unique_ptr<meta::AbstractDeferredInvocation>>;

    ReportData(Model const& model, std::shared_ptr<ChangeRecords> changes,
               boost::optional<Value> const& message, bool revertUnchanged, bool deep,
               std::shared_ptr<DeferredInvocations> deferred, bool destroyAll,
               meta::TransactionOrigin const& origin);
    ~ReportData();

    meta::TransactionOrigin const& getOrigin() const { return m_origin; }
    Model getModel() const;
    boost::optional<Value> const& getMessage() const { return m_message; }
    bool isDeep() const { return m_deep; }
    bool isDestroyAll() const { return m_destroyAll; }
    /// Whether there is nothing to tell.
    bool isEmpty() const;

    std::vector<ModelElement> const& getCreated() const { return m_created; }
    std::vector<ModelElement> const& getChanged() const { return m_changed; }
    std::vector<ModelElement> const& getDestroyed() const { return m_destroyed; }
    std::vector<ModelElement> const& getCreatedAndDestroyed() const
    {
        return m_createdAndDestroyed;
    }

    /// Enters an element into the list that its record decides. Writes a line to standard output
    /// for an element that was changed back, if such elements are left out.
    void processElement(ModelElement const& element, ModelElement::Impl::Changes* changes);

    /// False for an element that is not live or did not change.
    bool isChanged(ModelElement const& element, meta::Property const& property) const;
    /// Empty for an element that is not live or did not change.
    std::vector<meta::Property> getChangedProperties(ModelElement const& element) const;
    /// The same for the extension of that name.
    bool isExtensionChanged(ModelElement const& element, ustring const& name) const;
    /// Those that are still there, in the order of their first change.
    std::vector<meta::Extension> getChangedExtensions(ModelElement const& element) const;
    /// The value that the extension had before the transaction, also of a destroyed element.
    ///
    /// \throws tarnkiln::messages::GetOldValueFromNonDeep  if the transaction was shallow.
    /// \throws tarnkiln::messages::NoSuchProperty  (name, qualified class name; empty for an empty
    ///     handle) if the extension of the element did not change, or there is none.
    Value getExtensionOldValue(ModelElement const& element, ustring const& name) const;
    /// The value before the transaction, also of a destroyed element; the empty value for a
    /// property that the transaction did not record.
    ///
    /// \throws tarnkiln::messages::GetOldValueFromNonDeep  if the transaction was shallow.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  for a many-valued property of an
    ///     element that did not change.
    Value getOldValue(ModelElement const& element, meta::Property const& property) const;

private:
    ModelElement::Impl::Changes* findRecord(ModelElement const& element) const;

    std::shared_ptr<ChangeRecords> m_changes;
    std::shared_ptr<DeferredInvocations> m_deferredInvocations;
    Model::Impl* m_model;
    std::vector<ModelElement> m_created;
    std::vector<ModelElement> m_changed;
    std::vector<ModelElement> m_destroyed;
    std::vector<ModelElement> m_createdAndDestroyed;
    boost::optional<Value> m_message;
    bool m_revertUnchanged;
    bool m_deep;
    bool m_destroyAll;
    meta::TransactionOrigin m_origin;
};
}  // namespace tarn::kiln

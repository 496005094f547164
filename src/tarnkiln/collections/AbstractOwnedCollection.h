/// \file
/// The frame of every collection that is the value of a many-valued property.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/Feature.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/support/OpenStep.h"
#include "tarnkiln/support/OwnTransaction.h"

#include <optional>

namespace tarn::kiln {

/// The values of one many-valued property of one element, or a snapshot of them.
///
/// The element owns its collection, at one address for as long as it lives, and the collection
/// announces each change to the element before it makes it. It keeps no log: the record of a deep
/// transaction takes a snapshot when a property changes for the first time.
///
/// | State | Owner | Behaviour |
/// |---|---|---|
/// | attached | the element | changes are announced, the other end and the container kept in step |
/// | snapshot | null | changes are silent and touch nothing else; proxies stay as they are |
///
/// Each public change tests its arguments, opens an `Operation`, calls `modifying()`, changes the
/// contents, keeps the other end in step, and commits, in that order. A change of a collection
/// whose element is destroyed does nothing.
///
/// Iterators are positions in the storage and do not survive a change.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT AbstractOwnedCollection
{
public:
    class Operation;
    class AnnouncedOperation;

    AbstractOwnedCollection(AbstractOwnedCollection const&) = delete;
    AbstractOwnedCollection& operator=(AbstractOwnedCollection const&) = delete;
    virtual ~AbstractOwnedCollection();

    /// The type of the entries; empty while its metamodel is being built.
    virtual meta::Type getCollectionType() const = 0;
    /// Replaces the contents by those of `other`, which must be of the same class.
    virtual void copyContents(AbstractOwnedCollection const& other) = 0;
    /// \name Rollback: silent, without upkeep and without an allocation, so that it never fails
    /// @{
    /// Exchanges the contents with those of `other`, which must be of the same class.
    virtual void basicSwapContents(AbstractOwnedCollection& other) noexcept = 0;
    /// Drops all contents.
    virtual void basicDropContents() noexcept = 0;
    /// @}
    /// Makes this the collection of another property of the same type and shape; for an extension
    /// that gives way to that of another model.
    void basicSetProperty(meta::Property const& property) noexcept;

    /// Empty for a snapshot without one and while the metamodel is being built.
    meta::Property const& getCollectionProperty() const;
    Feature const& getCollectionFeature() const { return m_feature; }
    /// Null for a snapshot.
    ModelElement::Impl* getOwner() const { return m_owner; }

    /// Announces a change to the owner, before it is made. Silent for a snapshot and without a
    /// live property.
    ///
    /// \throws tarnkiln::messages::ModelFrozen, NoOpenTransaction, ChangesProhibited  if the model
    ///     may not be changed now.
    void modifying();

protected:
    /// \param owner    null makes a snapshot.
    /// \param feature  a property or a slot; a property is kept alive.
    AbstractOwnedCollection(ModelElement::Impl* owner, Feature const& feature);

    /// Whether the owner is destroyed, so that public changes do nothing.
    bool isOwnerDead() const { return m_owner && !m_owner->isLive(); }
    /// Whether a change that is made now could neither fail nor be heard of, kept or taken back.
    bool isChangedInSilence() const;

    ModelElement::Impl* const m_owner;

private:
    Feature m_feature;
    meta::Property m_property;  ///< Empty if the property is given by a slot.
};

/// Shows the entries to people, `{Book "Emma" 8d5a0ea6-..., Book "Persuasion" 09b1fcdb-...}`;
/// proxies as they stand. A long collection is cut.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out,
                                         AbstractOwnedCollection const& collection);

/// The bracket around one change of a collection: a transaction if none is open, else nothing.
///
/// An `Operation` that is not committed takes the change back if its own transaction is deep.
class TARNKILN_EXPORT AbstractOwnedCollection::Operation
{
public:
    explicit Operation(AbstractOwnedCollection& collection);
    Operation(Operation const&) = delete;
    Operation& operator=(Operation const&) = delete;
    ~Operation();

    /// Commits what this bracket opened; `NotCompleted` if it opened nothing. Raises nothing: a
    /// listener that refuses a change makes it `RolledBack` or `NotRevertible`.
    TransactionResult commit();

private:
    support::OwnTransaction m_transaction;
    support::OpenStep m_step;
};

/// The same around a change of nothing but this collection, in one step, which is announced here;
/// nothing where that is to be done in silence.
///
/// \throws  as `modifying`.
class AbstractOwnedCollection::AnnouncedOperation
{
public:
    explicit AnnouncedOperation(AbstractOwnedCollection& collection)
    {
        if (collection.isChangedInSilence())
            return;
        m_operation.emplace(collection);
        collection.modifying();
    }
    void commit()
    {
        if (m_operation)
            m_operation->commit();
    }

private:
    std::optional<Operation> m_operation;
};
}  // namespace tarn::kiln

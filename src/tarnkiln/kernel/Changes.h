/// \file
/// What a transaction remembers about one element.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/support/SlotSet.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"

#include <boost/optional.hpp>

#include <cstdint>
#include <vector>

namespace tarn::kiln {

/// The record of a shallow transaction: which slots of an element changed, and no values.
///
/// Bits of `modified`, of which there are `count` + 2:
///
/// | Bit | Meaning |
/// |---|---|
/// | 0 | the element was created in the transaction |
/// | i | the slot i changed |
/// | count | the container changed |
/// | count + 1 | the element was destroyed in the transaction |
///
/// Records never leave the thread of the transaction and may outlive it and the element, by the
/// reports that share them; they may not be asked anything that needs the model once that is gone.
class TARNKILN_EXPORT ModelElement::Impl::Changes
{
public:
    /// \param count  the highest index of a stored property, plus one.
    Changes(UUID const& id, Model const& model, meta::Class const& metaClass, unsigned long count);
    Changes(Changes const&) = delete;
    Changes& operator=(Changes const&) = delete;
    virtual ~Changes();

    /// Whether the element really differs from before; clears what was changed back.
    /// The base can not tell and answers true.
    virtual bool revertUnchanged(ModelElement::Impl* element);

    UUID const& getUuid() const { return m_id; }
    Model getModel() const;
    meta::Class const& getMetaClass() const { return m_metaClass; }

    /// False if the property is not live, has no slot, or is none of the element's class.
    bool isChanged(meta::Property const& property) const;
    /// The changed properties, class by class upward, in the order of their owned attributes.
    std::vector<meta::Property> getChangedProperties() const;

    bool isCreated() const { return m_modified.test(0); }
    bool isDestroyed() const { return m_modified.test(m_count + 1); }
    bool isContainerChanged() const { return m_modified.test(m_count); }
    /// Whether the slot `index` changed; false for index 0 and for one that does not exist.
    bool isSlotChanged(unsigned long index) const
    {
        return index != 0 && index < m_count && m_modified.test(index);
    }
    void setCreated() { m_modified.set(0); }
    void setDestroyed() { m_modified.set(m_count + 1); }
    /// Marks the slot; true if it was marked before. An index that does not exist counts as marked.
    bool setModified(unsigned long index);

protected:
    friend class ChangesHolder;

    void setContainerChanged(bool changed) { m_modified.set(m_count, changed); }
    void clearModified(unsigned long index) { m_modified.set(index, false); }

private:
    UUID m_id;
    Model::Impl* m_model;
    meta::Class m_metaClass;
    unsigned long m_count;
    support::SlotSet m_modified;
    std::uint32_t m_holderCount = 0;

protected:
    bool anyChanged() const { return m_modified.any(); }
};

/// The record of a deep transaction: also the old values. Each class derives its own.
class TARNKILN_EXPORT ModelElement::Impl::Storage : public ModelElement::Impl::Changes
{
public:
    using Changes::Changes;

    /// Keeps the link that the element had when the transaction began: the first call wins.
    void setOldContainer(ModelElement const& container, meta::Property const& property);
    bool revertUnchanged(ModelElement::Impl* element) override;
    /// The value that `property` had when the transaction began.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (property, class) if it is none of the class.
    virtual Value getOldValue(meta::Property const& property,
                              ReflectionPrivateTag const& tag) const;

    /// The container before the transaction; meaningful if `isContainerChanged`.
    ModelElement const& getOldContainer() const { return m_oldContainer; }
    meta::Property const& getOldContainmentProperty() const { return m_oldContainmentProperty; }
    Feature const& getOldContainment() const { return m_oldContainment; }

private:
    friend class ModelElement::Impl;

    void setOldContainer(ModelElement const& container, Feature const& feature);

    ModelElement m_oldContainer;
    meta::Property m_oldContainmentProperty;
    Feature m_oldContainment;
};
} // namespace tarn::kiln

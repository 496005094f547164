/// \file
/// What a transaction remembers about one element.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/support/OldValues.h"
#include "tarnkiln/support/SlotSet.h"

#include <boost/optional.hpp>

#include <cstdint>
#include <memory>
#include <vector>

namespace tarn::kiln {
namespace internal {
class ChangedExtensions;
}

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
    /// Of `element`, with its UUID, model and metaclass.
    Changes(ModelElement::Impl const& element, unsigned long count);
    Changes(Changes const&) = delete;
    Changes& operator=(Changes const&) = delete;
    virtual ~Changes();

    /// Whether the element really differs from before; clears what was changed back.
    /// The base can not tell and answers true.
    virtual bool revertUnchanged(ModelElement::Impl* element);

    UUID const& getUuid() const { return m_id; }
    Model getModel() const;
    meta::Class const& getMetaClass() const { return m_metaClass; }

    /// \name The element
    /// The record knows it by its address only, unless it is told to keep it in memory.
    /// @{
    bool isOf(ModelElement::Impl const* element) const
    {
        return m_element == element && m_id == element->getUuid();
    }
    void setElement(ModelElement::Impl* element) { m_element = element; }
    /// Shares `element`, which from now on is the one that the record is of.
    void keepElement(ModelElement::Impl* element) noexcept;
    void releaseElement() noexcept;
    /// Null unless it is kept.
    ModelElement::Impl* getKeptElement() const { return m_keepsElement ? m_element : nullptr; }
    /// Does no harm if it is gone.
    void prefetchElement() const { __builtin_prefetch(m_element); }
    /// @}

    /// False if the property is not live, has no slot, or is none of the element's class.
    bool isChanged(meta::Property const& property) const;
    /// The changed properties, class by class upward, in the order of their owned attributes.
    std::vector<meta::Property> getChangedProperties() const;

    /// \name Extensions
    /// @{
    /// Whether the extension changed that the element's class has by that name.
    bool isExtensionChanged(ustring const& name) const;
    /// The changed extensions that are still there, in the order of their first change.
    std::vector<meta::Extension> getChangedExtensions() const;
    /// Marks the extension; true if it was marked before.
    bool setModified(meta::Extension const& extension);
    /// @}

    bool isCreated() const { return m_modified.test(0); }
    bool isDestroyed() const { return m_modified.test(slots() + 1); }
    bool isContainerChanged() const { return m_modified.test(slots()); }
    /// Whether the slot `index` changed; false for index 0 and for one that does not exist.
    bool isSlotChanged(unsigned long index) const
    {
        return index != 0 && index < slots() && m_modified.test(index);
    }
    void setCreated() { m_modified.set(0); }
    void setDestroyed() { m_modified.set(slots() + 1); }
    /// Marks the slot; true if it was marked before. An index that does not exist counts as marked.
    bool setModified(unsigned long index);

protected:
    friend class ChangesHolder;
    friend class ModelElement::Impl;

    void setContainerChanged(bool changed) { m_modified.set(slots(), changed); }
    void clearModified(unsigned long index) { m_modified.set(index, false); }
    bool anyChanged() const;
    /// Null as long as none changed.
    internal::ChangedExtensions* changedExtensions() const { return m_changedExtensions.get(); }
    internal::ChangedExtensions& makeChangedExtensions();
    /// The extension that the element's class has by that name; empty if there is none.
    meta::Extension findExtension(ustring const& name) const;

private:
    unsigned long slots() const { return m_modified.size() - 2; }

    UUID m_id;
    Model::Impl* m_model;
    meta::Class m_metaClass;
    [[no_unique_address]] support::SlotSet m_modified;  ///< What comes next fits in behind.
    std::uint32_t m_keepsElement : 1 = 0;
    std::uint32_t m_holderCount : 31 = 0;
    ModelElement::Impl* m_element = nullptr;  ///< Not to be followed unless it is kept.
    std::unique_ptr<internal::ChangedExtensions>
        m_changedExtensions;  ///< Null while there are none.
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

    /// The value that the extension of that name had when the transaction began; a value that
    /// shares the record's collection for many values.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (name, qualified class name) if the class has no
    ///     such extension, or it did not change.
    Value getExtensionOldValue(ustring const& name) const;

    /// The container before the transaction; meaningful if `isContainerChanged`.
    ModelElement getOldContainer() const;
    meta::Property getOldContainmentProperty() const;
    Feature getOldContainment() const;

    /// The values of the slots that changed; for classes made of rows.
    support::OldValues& oldValues() { return m_oldValues; }
    support::OldValues const& oldValues() const { return m_oldValues; }

private:
    friend class ModelElement::Impl;

    struct OldLink
    {
        ModelElement container;
        meta::Property property;  ///< Keeps what `feature` may point to.
        Feature feature;
    };
    static constexpr unsigned long LINK = 0;  ///< No property has this slot.

    void setOldContainer(ModelElement const& container, Feature const& feature);

    support::OldValues m_oldValues;  ///< And the `OldLink`, for few elements move.
};
}  // namespace tarn::kiln

/// \file
/// The collections that keep an element by a key that is about to change.
#pragma once
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/internal/ReflectiveSlot.h"

#include <vector>

namespace tarn::kiln::internal {

/// The elements that a reflective element refers to and whose collection keeps it by the value of
/// one of its slots.
///
/// A change of that value first tests that the new key is free, then leaves the collections while
/// the old key is still in place, and enters them again when the new one is.
class DependentCollections
{
public:
    /// \param slot  the slot whose value is the key.
    DependentCollections(ReflectiveModelElementImpl& element, ReflectiveSlot const& slot)
        : m_element(element),
          m_slot(slot)
    {
        if (!slot.dependents().empty())
            find();
    }

    bool isEmpty() const { return m_holders.empty(); }
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the key's type)
    ///     if there is such a collection and `value` is absent.
    /// \throws tarnkiln::messages::UniquenessConstraint  if one has another element of that key.
    void check(Value const& value) const;
    void leave() const
    {
        if (!isEmpty())
            leaveAll();
    }
    void enter() const
    {
        if (!isEmpty())
            enterAll();
    }

private:
    void find();
    void leaveAll() const;
    void enterAll() const;

    struct Holder
    {
        ModelElement element;
        meta::Property collection;
    };

    ReflectiveModelElementImpl& m_element;
    ReflectiveSlot const& m_slot;
    std::vector<Holder> m_holders;
};
}  // namespace tarn::kiln::internal

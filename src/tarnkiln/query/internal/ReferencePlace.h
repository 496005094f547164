/// \file
/// Where elements of one kind keep a reference.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/StoredField.h"
#include "tarnkiln/meta/Property.h"

#include <cstddef>

namespace tarn::kiln::internal {

/// The place of a property with one value, which certainly is an element, in the elements for which
/// `KindKeys` give the same.
class ReferencePlace
{
public:
    /// No place: the elements must be asked.
    ReferencePlace() = default;
    /// The place that elements of the kind of `element` have; none if they must be asked.
    static ReferencePlace find(ModelElement::Impl const& element, meta::Property const& property);

    bool isKnown() const { return m_offset != 0 || m_target; }
    /// The target as it is, a proxy or dead ones too; null if there is none. The place must be
    /// known.
    ModelElement::Impl* read(ModelElement::Impl const& element) const
    {
        if (m_target)
            return m_target(element);
        return *static_cast<ModelElement::Impl* const*>(placeIn(element));
    }
    /// What is read of the element, as far as that is known; else where it begins.
    void const* placeIn(ModelElement::Impl const& element) const
    {
        return reinterpret_cast<char const*>(&element) + m_offset;
    }

private:
    std::ptrdiff_t m_offset = 0;
    ModelElement::Impl* (*m_target)(ModelElement::Impl const& element) = nullptr;
};
}  // namespace tarn::kiln::internal

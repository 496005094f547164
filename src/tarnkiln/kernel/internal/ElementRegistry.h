/// \file
/// The table of a model's elements by UUID.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/UUIDHasher.h"

#include <unordered_map>

namespace tarn::kiln::internal {

/// Maps UUIDs to elements, without a share in them.
class ElementRegistry
{
public:
    /// Null if there is none.
    ModelElement::Impl* find(UUID const& id) const
    {
        auto const found = m_elements.find(id);
        return found == m_elements.end() ? nullptr : found->second;
    }
    /// False if the UUID is taken.
    bool insert(ModelElement::Impl* element)
    {
        return m_elements.emplace(element->getUuid(), element).second;
    }
    /// Erases the entry of `element`, and no other element's of the same UUID.
    void erase(ModelElement::Impl const* element)
    {
        auto const found = m_elements.find(element->getUuid());
        if (found != m_elements.end() && found->second == element)
            m_elements.erase(found);
    }
    bool contains(ModelElement::Impl const* element) const
    {
        return find(element->getUuid()) == element;
    }
    std::size_t size() const { return m_elements.size(); }
    /// Calls `visit(ModelElement::Impl*)` for each; the table must not change meanwhile.
    template <class Visit>
    void forEach(Visit const& visit) const
    {
        for (auto const& entry : m_elements)
            visit(entry.second);
    }

private:
    std::unordered_map<UUID, ModelElement::Impl*, UUIDHasher> m_elements;
};
} // namespace tarn::kiln::internal

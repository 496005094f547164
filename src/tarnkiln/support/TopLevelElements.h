/// \file
/// The elements of a model that have no container.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

#include <vector>

namespace tarn::kiln::support {

/// A set of handles; each element knows its place in it, so that none is searched.
class TopLevelElements
{
public:
    void insert(ModelElement::Impl* element)
    {
        if (contains(element))
            return;
        m_elements.emplace_back(element);
        element->m_topLevelIndex = static_cast<std::uint32_t>(m_elements.size() - 1);
    }
    /// Drops the handle; the element may die by that.
    void erase(ModelElement::Impl* element)
    {
        if (!contains(element))
            return;
        std::uint32_t const index = element->m_topLevelIndex;
        element->m_topLevelIndex = ModelElement::Impl::NOT_TOP_LEVEL;
        std::swap(m_elements[index], m_elements.back());
        ModelElement const dropped = std::move(m_elements.back());
        m_elements.pop_back();
        if (index < m_elements.size())
            m_elements[index]->m_topLevelIndex = index;
    }
    bool contains(ModelElement::Impl const* element) const
    {
        std::uint32_t const index = element->m_topLevelIndex;
        return index < m_elements.size() && m_elements[index].getImpl() == element;
    }
    void clear()
    {
        for (ModelElement const& element : m_elements)
            element->m_topLevelIndex = ModelElement::Impl::NOT_TOP_LEVEL;
        std::vector<ModelElement> const dropped = std::move(m_elements);
        m_elements.clear();
    }
    std::vector<ModelElement> const& all() const { return m_elements; }
    std::size_t size() const { return m_elements.size(); }

private:
    std::vector<ModelElement> m_elements;
};
} // namespace tarn::kiln::support

/// \file
/// The elements of a model that have no container.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

#include <algorithm>
#include <vector>

namespace tarn::kiln::support {

/// A set of handles; each element knows its place in it, so that none is searched. Room is kept for
/// elements that left and may come back, so that their return allocates nothing.
class TopLevelElements
{
public:
    void insert(ModelElement::Impl* element)
    {
        if (contains(element))
            return;
        reserveFor(m_elements.size() + m_mayReturn + 1);
        place(element);
    }
    /// Keeps room for one more element, which is about to be inserted.
    void reserve() { reserveFor(m_elements.size() + m_mayReturn + 1); }
    /// Keeps room for one more element, which is about to leave.
    void reserveReturn()
    {
        reserveFor(m_elements.size() + m_mayReturn + 1);
        ++m_mayReturn;
    }
    /// Inserts an element for whose return room was kept.
    void insertReturning(ModelElement::Impl* element)
    {
        if (contains(element))
            return;
        place(element);
        --m_mayReturn;
    }
    /// Nothing that left comes back any more.
    void forgetReturns() { m_mayReturn = 0; }
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
    /// Drops all handles, and keeps the room for those that may come back.
    void clear()
    {
        while (!m_elements.empty())
            erase(m_elements.back().getImpl());
    }
    /// Drops all handles of elements that stand in another set by now.
    void abandon()
    {
        m_elements.clear();
        m_mayReturn = 0;
    }
    /// Tells the elements their places, after they had places in another set.
    void resume()
    {
        for (std::size_t i = 0; i < m_elements.size(); ++i)
            m_elements[i]->m_topLevelIndex = static_cast<std::uint32_t>(i);
    }
    std::vector<ModelElement> const& all() const { return m_elements; }
    std::size_t size() const { return m_elements.size(); }

private:
    void place(ModelElement::Impl* element)
    {
        m_elements.emplace_back(element);
        element->m_topLevelIndex = static_cast<std::uint32_t>(m_elements.size() - 1);
    }
    void reserveFor(std::size_t count)
    {
        if (count > m_elements.capacity())
            m_elements.reserve(std::max(count, 2 * m_elements.capacity()));
    }

    std::vector<ModelElement> m_elements;
    std::size_t m_mayReturn = 0;
};
}  // namespace tarn::kiln::support

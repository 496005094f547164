/// \file
/// The generic view of an unordered set of elements.
#pragma once
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/kernel/ModelElement.h"

namespace tarn::kiln {

/// Shows an `UnorderedElementSet` to code that knows no element class.
template <class Set> class WrapperInterface final : public GenericCollectionInterface
{
public:
    explicit WrapperInterface(Set& set) : m_set(set) {}

    // GenericCollectionInterface
    std::size_t genericSize() const override { return m_set.size(); }
    void genericAdd(ModelElement const& element) override
    {
        if (passes(element))
            m_set.insert(Set::value_type::cast(element));
    }
    void genericRemove(ModelElement const& element) override
    {
        if (passes(element))
            m_set.erase(element);
    }
    void genericClear() override { m_set.clear(); }
    void genericBasicClear() override { m_set.basicClear(); }

private:
    /// False for null and destroyed elements; refuses those of a wrong class.
    bool passes(ModelElement const& element) const
    {
        if (!element)
            return false;
        m_set.checkElementClass(element);
        return true;
    }

    Set& m_set;
};
}  // namespace tarn::kiln

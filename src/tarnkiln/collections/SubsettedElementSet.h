/// \file
/// A view of those elements of a collection that are of one class.
#pragma once
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/meta/Class.h"

#include <algorithm>
#include <vector>

namespace tarn::kiln {

/// The elements of another collection of the same owner that are `T`s, in the order of that one.
///
/// It holds nothing and shows each change of the other collection at once. It can only be read:
/// what would change it fails with `CannotAddIncompatibleObjectSubset`.
template <class T> class TARNKILN_EXPORT SubsettedElementSet : public ReferenceCollection
{
public:
    using value_type = T;

    /// \param all  must live as long as the view.
    SubsettedElementSet(ReferenceCollection& all, Feature const& feature)
        : ReferenceCollection(all.getOwner(), feature, Feature()),
          m_all(all)
    {}

    std::size_t size() const { return getAllValues().size(); }
    bool contains(ModelElement const& element) const;

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return T::metaClass(); }
    void copyContents(AbstractOwnedCollection const&) override
    {
        reportCannotAddIncompatibleObjectSubset();
    }
    /// A view holds nothing that could be swapped or dropped.
    void basicSwapContents(AbstractOwnedCollection&) noexcept override {}
    void basicDropContents() noexcept override {}

    // ReferenceCollection
    std::vector<ModelElement> getAllValues() const override
    {
        return subsetOf(m_all.getAllValues());
    }
    std::vector<ModelElement> getAllValuesAndProxies() const override
    {
        return subsetOf(m_all.getAllValuesAndProxies());
    }
    GenericCollectionInterface* getGenericInterface() const override { return &m_generic; }
    meta::Class const& getElementClass() const override { return T::metaClass(); }
    bool acceptsElement(ModelElement const& element) const override
    {
        return T::cast(element).getElementImpl() != nullptr;
    }
    void replaceProxy(ModelElement const&, unsigned long) override
    {
        reportCannotAddIncompatibleObjectSubset();
    }
    void resolveAll() override { m_all.resolveAll(); }
    void resolveLocal() override { m_all.resolveLocal(); }

protected:
    // ReferenceCollection
    void basicAdd(ModelElement const&) override { reportCannotAddIncompatibleObjectSubset(); }
    void basicRemove(ModelElement const&) override { reportCannotAddIncompatibleObjectSubset(); }
    void basicClear() override { reportCannotAddIncompatibleObjectSubset(); }
    void basicCopyValues(ReferenceCollection const&) override
    {
        reportCannotAddIncompatibleObjectSubset();
    }
    bool basicContainsProxyTo(ModelElement const&) override { return false; }

private:
    /// The view of it for code that knows no element class.
    class Generic final : public GenericSequenceInterface
    {
    public:
        explicit Generic(SubsettedElementSet& subset) : m_subset(subset) {}

        // GenericCollectionInterface
        std::size_t genericSize() const override { return m_subset.size(); }
        void genericAdd(ModelElement const&) override { fail(); }
        void genericEnsureAt(ModelElement const&, unsigned long) override { fail(); }
        void genericRemove(ModelElement const&) override { fail(); }
        void genericClear() override { fail(); }
        void genericBasicClear() override { fail(); }

        // GenericSequenceInterface
        ModelElement genericAt(unsigned long index) override
        {
            return m_subset.getAllValues()[index];
        }
        void genericInsert(ModelElement const&, unsigned long) override { fail(); }
        void genericReplace(ModelElement const&, unsigned long) override { fail(); }
        void genericRemoveAt(unsigned long) override { fail(); }
        int genericIndexOf(ModelElement const& element) const override
        {
            std::vector<ModelElement> const elements = m_subset.getAllValues();
            auto const place = std::find(elements.begin(), elements.end(), element);
            return !element || place == elements.end() ? -1
                                                       : static_cast<int>(place - elements.begin());
        }

    private:
        [[noreturn]] static void fail() { reportCannotAddIncompatibleObjectSubset(); }

        SubsettedElementSet& m_subset;
    };

    std::vector<ModelElement> subsetOf(std::vector<ModelElement> elements) const
    {
        std::erase_if(elements,
                      [this](ModelElement const& element) { return !acceptsElement(element); });
        return elements;
    }

    ReferenceCollection& m_all;
    mutable Generic m_generic{*this};
};

template <class T> bool SubsettedElementSet<T>::contains(ModelElement const& element) const
{
    return m_generic.genericIndexOf(element) >= 0;
}
}  // namespace tarn::kiln

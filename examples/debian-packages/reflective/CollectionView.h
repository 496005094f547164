/// \file
/// Collections of elements that have no generated code, with words of their own.
#pragma once
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <cstddef>
#include <vector>

namespace debian::reflective {

using namespace tarn::kiln;

/// The collection that a `Value` shares, used like one of a generated class.
///
/// \tparam T  a view of the members.
///
/// Lives as long as the element that has the collection. Threads: as the element.
template <class T> class CollectionView
{
public:
    explicit CollectionView(Value const& value)
        : m_collection(value.getValue<ReferenceCollection&>())
    {}

    std::size_t size() const { return generic().genericSize(); }
    bool empty() const { return size() == 0; }
    void remove(T const& member) const { generic().genericRemove(member); }
    void destroyAllContents() const { m_collection.destroyAllContents(); }

    /// The members at this moment, in their order.
    std::vector<T> members() const
    {
        std::vector<T> result;
        for (ModelElement const& member : m_collection.getAllValues())
            result.emplace_back(member.getImpl());
        return result;
    }

protected:
    GenericCollectionInterface& generic() const { return *m_collection.getGenericInterface(); }

private:
    ReferenceCollection& m_collection;
};

/// One whose members have places.
template <class T> class SequenceView : public CollectionView<T>
{
public:
    using CollectionView<T>::CollectionView;

    T at(std::size_t place) const { return T(sequence().genericAt(place).getImpl()); }
    void push_back(T const& member) const { sequence().genericAdd(member); }
    void ensureAt(std::size_t place, T const& member) const
    {
        sequence().genericEnsureAt(member, place);
    }

private:
    GenericSequenceInterface& sequence() const
    {
        return static_cast<GenericSequenceInterface&>(this->generic());
    }
};

/// One whose members are found by a text, one under each.
template <class T> class MapView : public CollectionView<T>
{
public:
    using CollectionView<T>::CollectionView;

    /// Empty if there is none.
    T find(ustring const& key) const
    {
        auto& map = static_cast<GenericMapInterface&>(this->generic());
        return T(map.genericFind(Value(meta::StandardTypes::stringMeta, key)).getImpl());
    }
    std::size_t count(ustring const& key) const { return find(key).getImpl() ? 1 : 0; }
};
}  // namespace debian::reflective

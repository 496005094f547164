/// \file
/// A reference collection as code that knows no element class sees it.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

#include <cstddef>

namespace tarn::kiln {

/// The operations that all reference collections share, over elements of any class.
///
/// It belongs to its collection and lives as long. A null or destroyed element is ignored, unless
/// an operation says otherwise; one of a wrong class is refused with `CannotAddIncompatibleTypes`.
///
/// Threads: as the collection.
class TARNKILN_EXPORT GenericCollectionInterface
{
public:
    GenericCollectionInterface() = default;
    GenericCollectionInterface(GenericCollectionInterface const&) = delete;
    GenericCollectionInterface& operator=(GenericCollectionInterface const&) = delete;
    virtual ~GenericCollectionInterface();

    /// The number of entries. Sequences count proxies, other collections do not.
    virtual std::size_t genericSize() const = 0;
    virtual void genericAdd(ModelElement const& element) = 0;
    /// Sees to it that `element` is in the collection, at `index` where there are positions.
    virtual void genericEnsureAt(ModelElement const& element, unsigned long index);
    virtual void genericRemove(ModelElement const& element) = 0;
    virtual void genericClear() = 0;
    /// Empties the collection without upkeep of the other end and of containers.
    virtual void genericBasicClear() = 0;

    virtual bool isSequenceInterface() const { return false; }
    virtual bool isMapInterface() const { return false; }
    virtual bool isMultimapInterface() const { return false; }
};
}  // namespace tarn::kiln

/// \file
/// An ordered reference collection as code that knows no element class sees it.
#pragma once
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/kernel/ModelElement.h"

namespace tarn::kiln {

/// Positions count from 0 and are trusted: one that does not exist is undefined behaviour.
class TARNKILN_EXPORT GenericSequenceInterface : public GenericCollectionInterface
{
public:
    ~GenericSequenceInterface() override;

    /// The entry, resolved if it is a proxy that can be.
    virtual ModelElement genericAt(unsigned long index) = 0;
    virtual void genericInsert(ModelElement const& element, unsigned long index) = 0;
    /// \throws tarnkiln::messages::CannotAddNonExistentObject  if `element` is null or destroyed.
    /// \throws tarnkiln::messages::CannotAddSecondObject  if a unique sequence holds `element` at
    ///     another position.
    virtual void genericReplace(ModelElement const& element, unsigned long index) = 0;
    virtual void genericRemoveAt(unsigned long index) = 0;
    /// The position of `element`, without resolving any entry; -1 if it is absent, and for a null,
    /// destroyed or incompatible element.
    virtual int genericIndexOf(ModelElement const& element) const = 0;

    bool isSequenceInterface() const override { return true; }
};
}  // namespace tarn::kiln

/// \file
/// What makes a collection of any elements one of elements of a class that is known at run time.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/ClassImpl.h"

#include <utility>

namespace tarn::kiln::support {

/// `Base`, a collection of `ModelElement`, that refuses elements of other classes than its own.
///
/// `getCollectionType()` stays the class of all elements.
template <class Base> class TARNKILN_EXPORT OfRunTimeClass : public Base
{
public:
    // ReferenceCollection
    meta::Class const& getElementClass() const override { return m_elementClass; }
    bool acceptsElement(ModelElement const& element) const override
    {
        meta::Class const& metaClass = element.getImpl()->getMetaClass();
        return metaClass.getElementImpl() &&
               (metaClass == m_elementClass || metaClass->isA(m_elementClass));
    }

protected:
    /// \param elementClass  what entries must be; their class may extend it.
    /// \param arguments     of the constructor of `Base`.
    template <class... Arguments>
    OfRunTimeClass(meta::Class const& elementClass, Arguments&&... arguments)
        : Base(std::forward<Arguments>(arguments)...),
          m_elementClass(elementClass)
    {}

private:
    meta::Class const m_elementClass;
};
}  // namespace tarn::kiln::support

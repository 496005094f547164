/// \file
/// A search instance together with the class of its elements.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

#include <concepts>

namespace tarn::kiln::query {

/// A search instance whose elements are known to be `C`s: a column of typed rows.
///
/// A reference in the form of a value: the instance must outlive it. It is made from an instance of
/// `C` or of a class that extends `C`.
template <class C> class MetaclassAttachment
{
public:
    template <std::derived_from<typename C::Constrainables> Instance>
    MetaclassAttachment(Instance const& instance) : m_instance(&instance)
    {}

    ModelElement::Constrainables const& getInstance() const { return *m_instance; }

private:
    ModelElement::Constrainables const* m_instance;  // never null
};

template <class Instance>
MetaclassAttachment(Instance const&) -> MetaclassAttachment<typename Instance::Handle>;
}  // namespace tarn::kiln::query

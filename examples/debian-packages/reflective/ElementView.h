/// \file
/// An element of a class that has no generated code, with words of its own.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Property.h"

namespace debian::reflective {

using namespace tarn::kiln;

/// A handle that is used like one of a generated class, `release->getVersion()`, and goes through
/// `Value` instead.
///
/// \tparam Handle  the class that is derived from this one; has `metaClass()`.
///
/// Threads: as all handles.
template <class Handle> class ElementView : public ModelElement
{
public:
    using Impl = ModelElement::Impl;

    ElementView() = default;
    explicit ElementView(Impl* impl) : ModelElement(impl) {}

    /// `element`, alive or dead, as a `Handle`; empty if it is empty or of another class.
    static Handle cast(ModelElement const& element)
    {
        bool const suits = element.getImpl() && element->getMetaClass()->isA(Handle::metaClass());
        return Handle(suits ? element.getImpl() : nullptr);
    }
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Handle create(Model const& model, UUID const& id = {})
    {
        return Handle(createReflective(model, Handle::metaClass(), id).getImpl());
    }

    Handle const* operator->() const { return static_cast<Handle const*>(this); }

    /// \name What all elements can do
    /// @{
    UUID const& getUuid() const { return element()->getUuid(); }
    Model getModel() const { return element()->getModel(); }
    Model::Impl* getModelImpl() const { return element()->getModelImpl(); }
    Impl* containerImpl() const { return element()->containerImpl(); }
    bool isProxy() const { return element()->isProxy(); }
    void destroy() const { element()->destroy(); }
    /// @}

protected:
    template <class T> T get(meta::Property const& property) const
    {
        return element()->getPropertyValue(property, Impl::PUBLIC_ACCESS).template getValue<T>();
    }
    template <class T> void set(meta::Property const& property, T const& value) const
    {
        element()->setPropertyValue(property, Value::createPrimitiveValue(property, value),
                                    Impl::PUBLIC_ACCESS);
    }
    template <class Collection> Collection getCollection(meta::Property const& property) const
    {
        return Collection(element()->getPropertyValue(property, Impl::PUBLIC_ACCESS));
    }
    /// Whether it has members, for a property that has many.
    bool has(meta::Property const& property) const
    {
        return element()->hasPropertyValue(property, Impl::PUBLIC_ACCESS);
    }

    /// The element that a single reference leads to.
    template <class Target> Target getElement(meta::Property const& property) const
    {
        return Target(get<ModelElement>(property).getImpl());
    }
    void setElement(meta::Property const& property, ModelElement const& target) const
    {
        element()->setPropertyValue(property, Value::createElementValue(property, target),
                                    Impl::PUBLIC_ACCESS);
    }
    /// The same, but a proxy stays one.
    Impl* peekElement(meta::Property const& property) const
    {
        return element()
            ->getPropertyValue(property, Impl::NO_PROXY_RESOLVE)
            .template getValue<ModelElement>()
            .getImpl();
    }

private:
    Impl* element() const { return getImpl(); }
};
}  // namespace debian::reflective

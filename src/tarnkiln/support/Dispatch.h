/// \file
/// The part of an element class that follows from its rows.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/support/Record.h"
#include "tarnkiln/support/Rows.h"

namespace tarn::kiln::support {

/// Overrides the steps of `ModelElement::Impl` for the properties of one class.
///
/// `Derived`, the class, supplies
///
/// - `Rows`, the `RowList` of its own properties that are stored,
/// - `ComputedRows`, that of the others, if it has any,
/// - `Handle`, its handle, and `SLOTS`, the highest index of its properties plus one,
/// - `Storage`, its `Record`.
///
/// What no row answers goes to `Base`, the superclass. A class is declared and instantiated like
///
///     extern template class support::Record<C::Impl, S::Impl::Storage>;  // CImpl.h
///     extern template class support::Dispatched<C::Impl, S::Impl>;
///     template class support::Record<C::Impl, S::Impl::Storage>;         // C.cpp, which includes
///     template class support::Dispatched<C::Impl, S::Impl>;              // DispatchSteps.h
template <class Derived, class Base> class TARNKILN_EXPORT Dispatched : public Base
{
public:
    using Base::Base;
    using Dispatch = Dispatched;  ///< The innermost of these bases, seen from a class.
    using Above = Base;

    // ElementImpl
    meta::Class const& getMetaClass() const override;
    void invalidate() override;

    // ModelElement::Impl
    bool hasPropertyValue(meta::Property const& property,
                          internal::ReflectionPrivateTag const& tag) const override;
    Value getPropertyValue(meta::Property const& property,
                           internal::ReflectionPrivateTag const& tag) const override;
    void setPropertyValue(meta::Property const& property, Value const& value,
                          internal::ReflectionPrivateTag const& tag) override;
    bool isReadByFields() const override;
    StoredField findStoredField(meta::Property const& property) const override;
    void doDestroy(bool keepIncoming, bool multiModel) override;
    void inverseAdd(ModelElement const& element, meta::Property const& property) override;
    void inverseRemove(ModelElement const& element, meta::Property const& property) override;
    bool inverseContainsProxyTo(ModelElement const& element,
                                meta::Property const& property) const override;
    void disassociateIncoming() override;
    void convertReferencesToProxies(bool multiModel, boost::optional<ProxyId>& cachedId) override;
    void basicDisassociateAll() override;
    void convertToProxy(meta::Property const& property, ProxyId const& id,
                        ModelElement const& element) override;
    ModelElement::Impl::Changes* createChanges() const override;
    ModelElement::Impl::Storage* createStorage() const override;
    void copyValue(ModelElement::Impl::Storage* storage, unsigned long index) const override;
    void copyStateFromStorage(ModelElement::Impl::Storage* storage) override;
    meta::Property getPropertyByIndex(unsigned long index) const override;
    void inverseAddSlot(ModelElement const& element, Slot const& slot) override;
    void inverseRemoveSlot(ModelElement const& element, Slot const& slot) override;
    bool inverseContainsProxyToSlot(ModelElement const& element, Slot const& slot) const override;
    void convertToProxySlot(Slot const& slot, ProxyId const& id,
                            ModelElement const& element) override;
    ModelElement::Impl* basicGetReference(Slot const& slot) const override;
    void visitReferences(ModelElement::Impl::ReferenceVisitor const& visit) const override;

private:
    Derived& self() { return static_cast<Derived&>(*this); }
    Derived const& self() const { return static_cast<Derived const&>(*this); }
};
}  // namespace tarn::kiln::support

// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `NamedElement`.
#pragma once
#include "tarnkiln/meta/NamedElement.h"
#include "tarnkiln/support/Dispatch.h"

namespace tarn::kiln::meta {

/// The properties of a `NamedElement`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT NamedElement::Impl
    : public support::Dispatched<NamedElement::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // NamedElementBuilder.h
    template <class Final> class BuilderBase;  // NamedElementBuilder.h

    using Handle = NamedElement;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 2;
    static Slot const NAME;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The name.
    ustring const& getName() const { return m_name; }
    virtual void setName(ustring const& name);

private:
    ustring m_name;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_name, NAME, &Impl::setName>>;
};

inline NamedElement::NamedElement(Impl* impl) : ModelElement(impl) {}
inline NamedElement::Impl* NamedElement::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline NamedElement::Impl* NamedElement::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::NamedElement::Impl, tarn::kiln::ModelElement::Impl>;

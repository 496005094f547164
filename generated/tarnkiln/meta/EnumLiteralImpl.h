// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind an `EnumLiteral`.
#pragma once
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/optional.hpp>

namespace tarn::kiln::meta {

/// The properties of an `EnumLiteral`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT EnumLiteral::Impl
    : public support::Dispatched<EnumLiteral::Impl, NamedElement::Impl>
{
public:
    class BuilderImpl;                         // EnumLiteralBuilder.h
    template <class Final> class BuilderBase;  // EnumLiteralBuilder.h

    using Handle = EnumLiteral;
    using Storage = support::Record<Impl, NamedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 5;
    static Slot const VALUE;
    static Slot const PARENT_ENUM;
    static Slot const PUBLIC_IDENTIFIER;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The number; a sibling may have the same.
    int getValue() const { return m_value; }
    void setValue(int value);

    /// The owner.
    Enum getParentEnum() const;
    Enum::Impl* getParentEnumImpl() const;
    /// Whether there is one and it is live.
    bool hasParentEnum() const;
    void setParentEnum(Enum const& parentEnum);

    /// What documents may write in place of the name.
    boost::optional<ustring> const& getPublicIdentifier() const { return m_publicIdentifier; }
    void setPublicIdentifier(boost::optional<ustring> const& publicIdentifier);

    /// Gives it another name, under which the owner then keeps it.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    void setName(ustring const& name) override;

    /// The owner's qualified name, a dot and the name; the name alone without an owner.
    ustring identifier() const override;

private:
    int m_value = 0;
    boost::optional<ustring> m_publicIdentifier;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>,
        support::Container<Enum, PARENT_ENUM, &Impl::setParentEnum>,
        support::Optional<
            &Impl::m_publicIdentifier, PUBLIC_IDENTIFIER, &Impl::setPublicIdentifier>>;
};

inline EnumLiteral::EnumLiteral(Impl* impl) : NamedElement(impl) {}
inline EnumLiteral::Impl* EnumLiteral::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline EnumLiteral::Impl* EnumLiteral::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl>;

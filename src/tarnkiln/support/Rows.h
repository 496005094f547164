/// \file
/// The compile-time table by which a class tells what its properties are and where they lie.
///
///     using Rows = support::RowList<
///         support::Scalar<&Impl::m_value, VALUE, &Impl::setValue>,
///         support::Container<Enum, PARENT_ENUM, &Impl::setParentEnum>>;
///
/// Rows stand in the order of declaration; destruction, cascades and callbacks follow it. The `Old`
/// of a row is what the record of a transaction keeps for it.
#pragma once
#include "tarnkiln/kernel/Feature.h"
#include "tarnkiln/support/CountedPointer.h"
#include "tarnkiln/support/LazyCollection.h"

#include <memory>

namespace tarn::kiln::support {

template <class Member> struct MemberTraits;
template <class T, class Class> struct MemberTraits<T Class::*>
{
    using Type = T;
    using Owner = Class;
};
/// The type of the member that `FIELD` points to.
template <auto FIELD> using FieldType = typename MemberTraits<decltype(FIELD)>::Type;
/// The class that has the member.
template <auto FIELD> using FieldOwner = typename MemberTraits<decltype(FIELD)>::Owner;

/// Stands for the old value of a row that keeps none of its own.
struct NoOldValue
{};

/// A required plain value; `SETTER` takes it.
template <auto FIELD, Slot const& SLOT, auto SETTER> struct Scalar
{
    using Old = FieldType<FIELD>;
};

/// A `boost::optional` of a plain value.
template <auto FIELD, Slot const& SLOT, auto SETTER> struct Optional
{
    using Old = FieldType<FIELD>;
};

/// A single reference to an element of the class `Target` that does not contain it.
/// The field is a `CountedPointer`, which may hold a proxy.
template <class Target, auto FIELD, Slot const& SLOT, auto SETTER> struct Reference
{
    using Old = FieldType<FIELD>;
};

/// A single reference to an element that this one contains.
template <class Target, auto FIELD, Slot const& SLOT, auto SETTER> struct CompositeReference
{
    using Old = FieldType<FIELD>;
};

/// The reference to the container. It has no field: the containment link is its storage.
template <class Target, Slot const& SLOT, auto SETTER> struct Container
{
    using Old = NoOldValue;
};

/// References to many elements, in a collection that `MAKE(owner)` makes and `GETTER` shows.
/// The field is a `LazyCollection`.
template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER> struct References
{
    using Old = std::unique_ptr<typename FieldType<FIELD>::Made>;
};

/// The same for many plain values.
template <auto FIELD, Slot const& SLOT, auto MAKE, auto GETTER> struct Values
{
    using Old = std::unique_ptr<typename FieldType<FIELD>::Made>;
};

/// A derived property, which `GETTER` computes: a plain value, an element, or a view of elements.
/// It has no field and no number, and can only be read. Such rows stand in a list of their own,
/// `ComputedRows`.
template <auto GETTER, Slot const& SLOT> struct Computed
{
    using Old = NoOldValue;
};

template <class... Rows> struct RowList
{
    /// Whether `step(row)` is true for a row; asks no further ones.
    template <class Step> static bool any([[maybe_unused]] Step step)
    {
        return (step(Rows{}) || ...);
    }
    /// Calls `step(row)` for each row.
    template <class Step> static void each([[maybe_unused]] Step step) { (step(Rows{}), ...); }
};
}  // namespace tarn::kiln::support

/// \file
/// Which values can be compared in which way.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/query/ValueMatchRelation.h"

#include <functional>

namespace tarn::kiln::query {

/// The table of comparators, by type, by whether a value is required, and by relation.
///
/// | Type | Relations |
/// |---|---|
/// | `String`, `StdString` | equality, order, `equalStringNocase`; `regexp` if required |
/// | numbers, `Boolean`, `UUID`, `DateTime` | equality, order |
/// | an enumeration | equality |
/// | a class | equality |
///
/// Equality is that of `Value`, of type and shape too, but enumerations compare by number. Order is
/// that of the C++ type; without a value on either side it is false. Two absent literals are both
/// equal and not equal, an absent and a present one are neither.
///
/// Threads: immutable; any thread may read it.
class TARNKILN_EXPORT ValueComparatorRegistry
{
public:
    /// Whether the first value, found on an element, has the relation to the second.
    ///
    /// Fails with `CannotCastIncompatibleTypes` (qualified name of the value's type) where a value
    /// is not what the type says, the first before the second.
    using Comparator = std::function<bool(Value const&, Value const&)>;

    /// The one registry, made at first use and never destroyed.
    static ValueComparatorRegistry const& getInstance();

    ValueComparatorRegistry(ValueComparatorRegistry const&) = delete;
    ValueComparatorRegistry& operator=(ValueComparatorRegistry const&) = delete;

    /// Null if there is none. What is returned lives for ever.
    virtual Comparator const* findComparator(ValueMatchRelation relation, meta::Type const& type,
                                             bool required) const = 0;
    /// The same, never null.
    ///
    /// \throws tarnkiln::query::RelationAndTypeNotSupported  if there is none. The first argument
    /// is
    ///     "less", whatever the relation; the second is the name of the type.
    Comparator const* getComparator(ValueMatchRelation relation, meta::Type const& type,
                                    bool required) const;

protected:
    ValueComparatorRegistry() = default;
    ~ValueComparatorRegistry() = default;
};
}  // namespace tarn::kiln::query

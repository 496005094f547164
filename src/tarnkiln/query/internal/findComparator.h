/// \file
/// The look-up of comparators for properties.
#pragma once
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/ValueComparatorRegistry.h"

namespace tarn::kiln::internal {

using Comparator = query::ValueComparatorRegistry::Comparator;

/// Never null.
///
/// \param asked  the relation that the caller named, for the failure.
/// \throws tarnkiln::query::RelationAndTypeNotSupported  (`asked`, name of the type)
inline Comparator const* findComparator(query::ValueMatchRelation relation,
                                        meta::Property const& property,
                                        query::ValueMatchRelation asked)
{
    meta::Type const type = property->getType();
    bool const required = property->getLower() != 0;
    Comparator const* const found =
        query::ValueComparatorRegistry::getInstance().findComparator(relation, type, required);
    if (!found)
        reportException(tarnkiln::query::RelationAndTypeNotSupported(
            query::ValueMatchRelationName(asked),
            type.getElementImpl() ? type->getName() : ustring()));
    return found;
}
}  // namespace tarn::kiln::internal

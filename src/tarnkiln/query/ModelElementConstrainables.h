/// \file
/// A search instance of a query: what stands for the elements that are sought.
///
///     query::AbstractQuery query(model);
///     Book::Constrainables book({query, query::SearchClassMatchMode::MatchSubclasses});
///     book.title.like(u"Em%");
///     book.isTopLevel();
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/query/Fwd.h"
#include "tarnkiln/query/SearchClassMatchMode.h"
#include "tarnkiln/query/ValueMatchRelation.h"

#include <cstddef>

namespace tarn::kiln {

/// One search instance of a query, by which constraints are stated.
///
/// Its construction is what adds the instance to the query. For each class `X` of a metamodel there
/// is `X::Constrainables`, with a member for each property of `X`; this class alone serves classes
/// that have no generated code.
///
/// The query must outlive it, and must not be reset while it is in use. It can't be copied, as its
/// members lead back to it.
///
/// Threads: as the query.
class TARNKILN_EXPORT ModelElement::Constrainables
{
public:
    using Handle = ModelElement;

    /// Adds an instance for elements of `metaClass`.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(query::AbstractQuery& query, meta::Class const& metaClass,
                   query::SearchClassMatchMode mode);
    Constrainables(Constrainables const&) = delete;
    Constrainables& operator=(Constrainables const&) = delete;

    query::AbstractQuery& getQuery() const { return *m_query; }
    std::size_t getInstanceId() const { return m_instanceId; }

    /// The element is to have no container.
    void isTopLevel() const;

    /// \name Constraints on properties by reflection; the members of `X::Constrainables` use them
    /// @{
    /// The value of `property` is to stand in that relation to `value`. A property with many values
    /// suits if one of them does.
    ///
    /// \throws tarnkiln::query::NoSuchInstanceId, PropertyRelationValueNotPrimitive,
    ///     LikePatternNotSingle, LikePatternNotString, RelationAndTypeNotSupported  as
    ///     `ReflectiveQuery::addValueConstraint` does.
    void constrain(meta::Property const& property, query::ValueMatchRelation relation,
                   Value const& value) const;
    /// The value of `property` is to stand in that relation to a value of `other`, which may be
    /// this instance.
    ///
    /// \throws tarnkiln::query::NoSuchInstanceId  if `other` belongs to another query.
    /// \throws tarnkiln::query::PropertyRelationPropertyTypeMismatch, RelationAndTypeNotSupported
    ///     as `ReflectiveQuery::addPropertyRelation` does.
    void constrain(meta::Property const& property, query::ValueMatchRelation relation,
                   Constrainables const& other, meta::Property const& otherProperty) const;
    /// `property` is to refer to the element of `target`, also by a proxy that is not resolved.
    ///
    /// \throws tarnkiln::query::NoSuchInstanceId  if `target` belongs to another query.
    void constrainTarget(meta::Property const& property, Constrainables const& target) const;
    /// @}

private:
    void requireSameQuery(Constrainables const& other) const;

    query::AbstractQuery* m_query;  // never null
    std::size_t m_instanceId;
};
}  // namespace tarn::kiln

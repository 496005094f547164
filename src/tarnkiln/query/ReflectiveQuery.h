/// \file
/// The interface by which queries are built and run.
///
///     auto const query = query::createNativeQuery(model);
///     size_t const book = query->addSearchClass(bookClass, SearchClassMatchMode::MatchSubclasses);
///     query->addValueConstraint(pages, ValueMatchRelation::greater, Value(integerMeta, 990),
///     book); auto const rows = query->getResultIterator({}); for (std::vector<ModelElement> row;
///     rows->next(row);)
///         use(row[0]);
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/query/SearchClassMatchMode.h"
#include "tarnkiln/query/ValueMatchRelation.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace tarn::kiln::query {

/// Asks a model for tuples of elements.
///
/// A query has search instances, each a class that an element must belong to, numbered from 0 in
/// the order in which they were added; constraints on one instance; and constraints between two.
/// A row has an element for each instance such that all constraints hold. Instances that no
/// constraint ties together are combined in all ways.
///
/// Rows come in an order that depends on nothing but the query and the model. A query with one
/// instance gives elements in the order of `Model::Impl::getAllElements`.
///
/// Threads: used by one at a time. Running it reads the model and needs its thread.
class TARNKILN_EXPORT ReflectiveQuery
{
public:
    /// The rows of one run.
    ///
    /// Owns them: it neither follows the model nor needs the query any more.
    class TARNKILN_EXPORT ResultIterator
    {
    public:
        ResultIterator(ResultIterator const&) = delete;
        ResultIterator& operator=(ResultIterator const&) = delete;
        virtual ~ResultIterator();

        /// Gives the next row, one element for each column asked for. Behind the last row it gives
        /// an empty handle for each search instance of the query, and false.
        virtual bool next(std::vector<ModelElement>& row) = 0;

    protected:
        ResultIterator() = default;
    };

    /// The right by which properties are read: `PRIVILEGED_ACCESS`.
    static internal::ReflectionPrivateTag const& privilegedTag;

    ReflectiveQuery(ReflectiveQuery const&) = delete;
    ReflectiveQuery& operator=(ReflectiveQuery const&) = delete;
    virtual ~ReflectiveQuery();

    /// Drops all search instances and constraints, the limit and the offset. The model stays.
    virtual void reset() = 0;

    /// \name Building
    /// The numbers of instances are those that `addSearchClass` gave. Properties must not be empty.
    /// @{
    /// Adds a search instance and returns its number.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if the class is empty or dead.
    virtual std::size_t addSearchClass(meta::Class const& searchClass,
                                       SearchClassMatchMode mode) = 0;
    /// Compares a property with a value. One of many values is enough.
    ///
    /// Equal values have the same type and shape: for a property typed by a class `value` must be
    /// made by `Value::createElementValue`, for an optional one it must be optional. That the type
    /// suits is seen at the first comparison only, which then fails with
    /// `CannotCastIncompatibleTypes` for the relations that order.
    ///
    /// `like` is no more than a translation to `regexp`: "%" becomes ".*", "_" becomes ".", and
    /// nothing can be escaped. A `regexp` must match all of an 8-bit text, and must be found
    /// somewhere in a UTF-16 text. One that is no regular expression raises a `std::runtime_error`
    /// at the first comparison: a `std::regex_error` for 8-bit texts.
    /// \throws tarnkiln::query::NoSuchInstanceId
    /// \throws tarnkiln::query::PropertyRelationValueNotPrimitive  if `value` is a collection.
    /// \throws tarnkiln::query::LikePatternNotSingle, LikePatternNotString
    /// \throws tarnkiln::query::RelationAndTypeNotSupported  (relation, name of the type) if there
    ///     is no such relation for the type, or for the type of an optional property.
    virtual void addValueConstraint(meta::Property const& property, ValueMatchRelation relation,
                                    Value const& value, std::size_t instance) = 0;
    /// Compares two properties, of one element or of two.
    ///
    /// \throws tarnkiln::query::PropertyRelationPropertyTypeMismatch  unless they have one type.
    /// \throws tarnkiln::query::RelationAndTypeNotSupported  (relation, name of the type) as above;
    ///     the left property decides whether the value is required. There is no `like`.
    virtual void addPropertyRelation(meta::Property const& left, ValueMatchRelation relation,
                                     meta::Property const& right, std::size_t leftInstance,
                                     std::size_t rightInstance) = 0;
    /// The element has no container.
    virtual void addTopLevelConstraint(std::size_t instance) = 0;
    /// A property of the source refers to the target, be it by a proxy with the target's UUID,
    /// which stays one.
    virtual void addAssociatedObjectConstraint(meta::Property const& property, std::size_t source,
                                               std::size_t target) = 0;
    /// The number of rows at most; 0 for all.
    virtual void setResultLimit(std::size_t limit) = 0;
    /// The number of rows to leave out first.
    virtual void setResultOffset(std::size_t offset) = 0;
    /// @}

    /// \name Running
    /// A column is the number of an instance, and may be given more than once; no columns stand for
    /// all instances in their order. What fails while values are read or compared passes
    /// unchanged, and leaves the query as it was.
    ///
    /// \throws tarnkiln::query::NoSearchInstances  if there is none.
    /// \throws tarnkiln::query::NoModel  if there is none, or a dead one.
    /// \throws tarnkiln::query::PropertyRelationValueNotPrimitive  if two properties of one element
    ///     are compared and one has many values.
    /// @{
    /// The first row; if there is none, an empty handle for each search instance.
    virtual std::vector<ModelElement> getFirstResult(std::vector<std::size_t> const& columns) = 0;
    virtual std::unique_ptr<ResultIterator>
    getResultIterator(std::vector<std::size_t> const& columns) = 0;
    /// The number of rows, under limit and offset.
    virtual std::size_t getResultCount() = 0;
    /// @}

protected:
    ReflectiveQuery() = default;
};
}  // namespace tarn::kiln::query

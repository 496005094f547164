/// \file
/// The rows of a query as tuples of typed handles.
///
///     for (auto const& [book, reader] : query.results(books, readers))
///         std::cout << toUtf8(book->getTitle()) << " has " << toUtf8(reader->getName()) << '\n';
#pragma once
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/MetaclassAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"
#include "tarnkiln/query/RetargetableQuery.h"

#include <cstddef>
#include <iterator>
#include <memory>
#include <tuple>
#include <utility>
#include <vector>

namespace tarn::kiln::query {

/// What a query finds: a range of rows, each with a handle for each search instance asked for.
///
/// Each `begin()` runs the query. The iterator owns its rows, which follow neither the model nor
/// the query. An element without generated code is no `C` and gives an empty handle.
///
/// The query must outlive the range.
///
/// Threads: as the query and its model.
template <class... C> class Results
{
public:
    using Row = std::tuple<C...>;
    class Iterator;

    Results(AbstractQuery& query, MetaclassAttachment<C> const&... columns)
        : m_query(query),
          m_columns{columns.getInstance().getInstanceId()...}
    {}

    /// The first row of a new run.
    ///
    /// \throws whatever `ReflectiveQuery::getResultIterator` does.
    Iterator begin() const
    {
        return Iterator(m_query.getReflectiveQuery().getResultIterator(m_columns));
    }
    std::default_sentinel_t end() const { return {}; }

private:
    AbstractQuery& m_query;
    std::vector<std::size_t> m_columns;
};

/// Goes through the rows of one run once. Movable, not copyable.
template <class... C> class Results<C...>::Iterator
{
public:
    using value_type = Row;
    using difference_type = std::ptrdiff_t;

    explicit Iterator(std::unique_ptr<ReflectiveQuery::ResultIterator> rows)
        : m_rows(std::move(rows))
    {
        ++*this;
    }

    Row const& operator*() const { return m_row; }
    Row const* operator->() const { return &m_row; }
    Iterator& operator++()
    {
        m_hasRow = m_rows->next(m_elements);
        m_row = m_hasRow ? typed(m_elements, std::index_sequence_for<C...>()) : Row();
        return *this;
    }
    void operator++(int) { ++*this; }
    bool operator==(std::default_sentinel_t) const { return !m_hasRow; }

private:
    template <std::size_t... INDEX>
    static Row typed(std::vector<ModelElement> const& elements, std::index_sequence<INDEX...>)
    {
        return Row(C::cast(elements[INDEX])...);
    }

    std::unique_ptr<ReflectiveQuery::ResultIterator> m_rows;
    std::vector<ModelElement> m_elements;  ///< Of the row; its memory serves all rows.
    Row m_row;
    bool m_hasRow = false;
};

template <class... Instance>
Results<typename Instance::Handle...> AbstractQuery::results(Instance const&... columns)
{
    return {*this, MetaclassAttachment(columns)...};
}
}  // namespace tarn::kiln::query

/// \file
/// Books and their authors, of classes that are made at run time, reached by reflection alone.
#pragma once
#include "benchmarks/peers/tarnkiln/LibraryClasses.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"

#include <functional>
#include <vector>

namespace peers {

inline auto const& ACCESS = ModelElement::Impl::PUBLIC_ACCESS;

/// Two libraries in one model; the first one is for books.
class Library
{
public:
    static constexpr std::size_t BOOKS_PER_AUTHOR = 100;

    /// Libraries without books, in a model of `constellation`.
    explicit Library(std::size_t size,
                     ModelConstellation const& constellation = ModelConstellation());
    ~Library();
    Library(Library const&) = delete;
    Library& operator=(Library const&) = delete;

    /// Makes the books in one transaction, the workload "create".
    void fill();
    /// Runs `change` in a transaction, which is committed.
    void change(bool revertible, std::function<void()> const& change) const;
    /// Gives a book other pages than the turn before.
    void setPages(std::size_t book, int turn) const;
    int getPages(ModelElement const& book) const;
    /// The collection of a property whose values are in an order.
    static GenericSequenceInterface& sequence(ModelElement const& owner,
                                              meta::Property const& property);

    /// Texts of ten characters.
    static std::vector<ustring> titles(std::size_t size);
    /// From 1 to 1000, evenly; other ones in the next turn.
    static int pages(std::size_t book, int turn);

    LibraryClasses const& classes = LibraryClasses::get();
    Model const model;
    ModelElement const library;
    ModelElement const secondLibrary;
    std::vector<ModelElement> books;

private:
    ModelElement makeLibrary() const;
    void addBooks();
    ModelElement addAuthor(std::size_t number) const;

    std::vector<ustring> const m_titles;
};
}  // namespace peers

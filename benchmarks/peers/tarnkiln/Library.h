/// \file
/// Books and their authors, of classes that are made at run time, reached by reflection alone.
#pragma once
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <vector>

namespace peers {

using namespace tarn::kiln;

/// The classes and their properties, made once for the process.
struct LibraryClasses
{
    static LibraryClasses const& get();

    meta::Class library, book, author;
    meta::Property title, pages, price, authorName;
    meta::Property books, libraryOf, authors, authorOf, booksBy, next, previous;

private:
    LibraryClasses();
};

/// Two libraries in one model; the first one is filled.
struct Library
{
    static constexpr std::size_t BOOKS_PER_AUTHOR = 100;

    explicit Library(std::size_t size);
    ~Library();
    Library(Library const&) = delete;
    Library& operator=(Library const&) = delete;

    /// The workload "create".
    void fill();

    static int pages(std::size_t number);
    static ReferenceCollection& collection(ModelElement const& owner,
                                           meta::Property const& property);

    LibraryClasses const& classes;
    Model const model = Model::create(ModelConstellation());
    ModelElement const library;
    ModelElement const secondLibrary;
    std::vector<ModelElement> books;

private:
    ModelElement addAuthor(std::size_t number) const;

    std::vector<ustring> m_titles;
};
}  // namespace peers

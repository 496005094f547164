/// \file
/// The classes of libraries, books and authors.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace peers {

using namespace tarn::kiln;

/// The classes and their properties, made once for the process.
struct LibraryClasses
{
    static LibraryClasses const& get();

    meta::Class library, book, author;
    meta::Property title, pages, price, authorName;
    meta::Property books, libraryOf, authors, authorOf, booksBy, next, previous;
    /// What refers to a book of another model.
    meta::Class card;
    meta::Property cardBook;

private:
    LibraryClasses();
};
}  // namespace peers

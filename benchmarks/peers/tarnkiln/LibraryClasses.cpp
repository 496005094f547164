#include "benchmarks/peers/tarnkiln/LibraryClasses.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace peers {

LibraryClasses const& LibraryClasses::get()
{
    static LibraryClasses const classes;
    return classes;
}

LibraryClasses::LibraryClasses()
{
    using meta::StandardTypes;
    meta::PackageDefinition definition(u"peers", u"http://tarnkiln.invalid/benchmarks/library");
    meta::ClassDefinition newLibrary = definition.defineClass(u"Library");
    meta::ClassDefinition newBook = definition.defineClass(u"Book");
    meta::ClassDefinition newAuthor = definition.defineClass(u"Author");
    meta::ClassDefinition newCard = definition.defineClass(u"Card");
    library = newLibrary;
    book = newBook;
    author = newAuthor;
    card = newCard;
    newLibrary.attribute(u"name", StandardTypes::stringMeta);
    title = newBook.attribute(u"title", StandardTypes::stringMeta);
    pages = newBook.attribute(u"pages", StandardTypes::integerMeta);
    price = newBook.attribute(u"price", StandardTypes::realMeta);
    authorName = newAuthor.attribute(u"name", StandardTypes::stringMeta);
    meta::PropertyDefinition contained = newLibrary.contents(u"books", book);
    contained.sequence().unique();
    books = contained;
    libraryOf = contained.opposite(u"library");
    authors = newLibrary.contents(u"authors", author).sequence().unique();
    meta::PropertyDefinition written = newAuthor.reference(u"books", book);
    written.sequence().unique();
    booksBy = written;
    authorOf = written.opposite(u"author");
    meta::PropertyDefinition following = newBook.reference(u"next", book);
    next = following;
    previous = following.opposite(u"previous");
    cardBook = newCard.reference(u"book", book);
    definition.finish();
}
}  // namespace peers

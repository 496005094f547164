#include "benchmarks/peers/tarnkiln/Library.h"

#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/kernel/Text.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <string>

namespace peers {
namespace {

using meta::StandardTypes;

auto const& ACCESS = ModelElement::Impl::PUBLIC_ACCESS;
}  // namespace

LibraryClasses const& LibraryClasses::get()
{
    static LibraryClasses const classes;
    return classes;
}

LibraryClasses::LibraryClasses()
{
    meta::PackageDefinition definition(u"peers", u"http://tarnkiln.invalid/benchmarks/library");
    meta::ClassDefinition newLibrary = definition.defineClass(u"Library");
    meta::ClassDefinition newBook = definition.defineClass(u"Book");
    meta::ClassDefinition newAuthor = definition.defineClass(u"Author");
    library = newLibrary;
    book = newBook;
    author = newAuthor;
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
    definition.finish();
}

Library::Library(std::size_t size)
    : classes(LibraryClasses::get()),
      library(ModelElement::createReflective(model, classes.library)),
      secondLibrary(ModelElement::createReflective(model, classes.library))
{
    books.reserve(size);
    for (std::size_t i = 0; i < size; ++i)
        m_titles.push_back(u"Book" + toUstring(std::to_string(1000000 + i % 1000000).substr(1)));
}

Library::~Library()
{
    model->destroy();
}

void Library::fill()
{
    ModelElement author;
    for (std::size_t i = 0; i < m_titles.size(); ++i)
    {
        if (i % BOOKS_PER_AUTHOR == 0)
            author = addAuthor(i / BOOKS_PER_AUTHOR);
        ModelElement const book = ModelElement::createReflective(model, classes.book);
        auto const set = [&](meta::Property const& property, auto const& payload) {
            book->setPropertyValue(property, Value(property->getType(), payload), ACCESS);
        };
        set(classes.title, m_titles[i]);
        set(classes.pages, pages(i));
        set(classes.price, 0.5 * static_cast<double>(i));
        set(classes.libraryOf, library);
        set(classes.authorOf, author);
        if (i > 0)
            set(classes.previous, books.back());
        books.push_back(book);
    }
}

ModelElement Library::addAuthor(std::size_t number) const
{
    ModelElement const author = ModelElement::createReflective(model, classes.author);
    ustring const name = u"Author " + toUstring(std::to_string(number));
    author->setPropertyValue(classes.authorName, Value(StandardTypes::stringMeta, name), ACCESS);
    collection(library, classes.authors).getGenericInterface()->genericAdd(author);
    return author;
}

int Library::pages(std::size_t number)
{
    return static_cast<int>(number * 7919 % 1000) + 1;
}

ReferenceCollection& Library::collection(ModelElement const& owner, meta::Property const& property)
{
    return owner->getPropertyValue(property, ACCESS).getValue<ReferenceCollection&>();
}
}  // namespace peers

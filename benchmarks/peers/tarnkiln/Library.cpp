#include "benchmarks/peers/tarnkiln/Library.h"

#include "benchmarks/peers/tarnkiln/Measure.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Text.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <string>

namespace peers {

using meta::StandardTypes;

Library::Library(std::size_t size, ModelConstellation const& constellation)
    : model(Model::create(constellation)),
      library(makeLibrary()),
      secondLibrary(makeLibrary()),
      m_titles(titles(size))
{
    books.reserve(size);
}

Library::~Library()
{
    model->destroy();
}

void Library::fill()
{
    change(/*revertible=*/false, [&] { addBooks(); });
}

void Library::addBooks()
{
    ModelElement author;
    for (std::size_t i = 0; i < m_titles.size(); ++i)
    {
        if (i % BOOKS_PER_AUTHOR == 0)
            author = addAuthor(i / BOOKS_PER_AUTHOR);
        ModelElement const book = ModelElement::createReflective(model, classes.book);
        auto const set = [&](meta::Property const& property, Value const& value) {
            book->setPropertyValue(property, value, ACCESS);
        };
        set(classes.title, Value(StandardTypes::stringMeta, m_titles[i]));
        set(classes.pages, Value(StandardTypes::integerMeta, pages(i, /*turn=*/0)));
        set(classes.price, Value(StandardTypes::realMeta, 0.5 * static_cast<double>(i)));
        set(classes.libraryOf, Value::createElementValue(classes.libraryOf, library));
        set(classes.authorOf, Value::createElementValue(classes.authorOf, author));
        if (i > 0)
            set(classes.previous, Value::createElementValue(classes.previous, books.back()));
        books.push_back(book);
    }
}

void Library::change(bool revertible, std::function<void()> const& change) const
{
    Transaction const transaction = model->beginTransaction(revertible);
    change();
    Measure::require(transaction.commit() != TransactionResult::RolledBack, "a commit");
}

void Library::setPages(std::size_t book, int turn) const
{
    Value const value(StandardTypes::integerMeta, pages(book, turn));
    books[book]->setPropertyValue(classes.pages, value, ACCESS);
}

int Library::getPages(ModelElement const& book) const
{
    return book->getPropertyValue(classes.pages, ACCESS).getValue<int>();
}

GenericSequenceInterface& Library::sequence(ModelElement const& owner,
                                            meta::Property const& property)
{
    auto& collection = owner->getPropertyValue(property, ACCESS).getValue<ReferenceCollection&>();
    return dynamic_cast<GenericSequenceInterface&>(*collection.getGenericInterface());
}

std::vector<ustring> Library::titles(std::size_t size)
{
    std::vector<ustring> titles;
    titles.reserve(size);
    for (std::size_t i = 0; i < size; ++i)
        titles.push_back(u"Book" + toUstring(std::to_string(1000000 + i % 1000000).substr(1)));
    return titles;
}

int Library::pages(std::size_t book, int turn)
{
    return static_cast<int>((book * 7919 + static_cast<std::size_t>(turn)) % 1000) + 1;
}

ModelElement Library::makeLibrary() const
{
    ModelElement made;
    change(/*revertible=*/false,
           [&] { made = ModelElement::createReflective(model, classes.library); });
    return made;
}

ModelElement Library::addAuthor(std::size_t number) const
{
    ModelElement const author = ModelElement::createReflective(model, classes.author);
    ustring const name = u"Author " + toUstring(std::to_string(number));
    author->setPropertyValue(classes.authorName, Value(StandardTypes::stringMeta, name), ACCESS);
    sequence(library, classes.authors).genericAdd(author);
    return author;
}
}  // namespace peers

// A metamodel that is described in library.json: made, changed, taken back and printed.
#include "library/BookImpl.h"
#include "library/LibraryImpl.h"
#include "library/ReaderImpl.h"
#include "tarnkiln/kernel/Transaction.h"

#include <iostream>
#include <string>

using namespace library;

namespace {

void print(std::string const& head, Library const& library)
{
    std::cout << head << '\n';
    for (auto const& [name, book] : library->getBooks())
    {
        std::cout << "  " << std::string(name.begin(), name.end());
        if (book->getYear())
            std::cout << ", " << *book->getYear();
        std::cout << (book->getShelf() == Shelf::Locked ? ", locked" : "")
                  << (book->hasReader() ? ", lent" : "") << '\n';
    }
}

Book addBook(Library const& library, ustring const& title, int year)
{
    Book const book = Book::create(library->getModel());
    book->setTitle(title);
    book->setYear(year);
    book->setLibrary(library);  // library->getBooks() holds it now, under its title
    return book;
}
}  // namespace

int main()
{
    Model const model = Model::create(ModelConstellation());
    Transaction const opening = model->beginTransaction(/*revertible=*/true);
    Library const library = Library::create(model);
    Book const emma = addBook(library, u"Emma", 1815);
    Book const persuasion = addBook(library, u"Persuasion", 1817);
    Reader const reader = Reader::create(model);
    reader->setLibrary(library);
    reader->getBooks().push_back(emma);  // emma->getReader() is the reader now
    opening.commit();
    print("opened:", library);

    {
        Transaction const dropped = model->beginTransaction(/*revertible=*/true);
        emma->setTitle(u"Emma, or Matchmaking");
        persuasion->setShelf(Shelf::Locked);
        reader->destroy();
        print("changed:", library);
    }  // not committed, so taken back
    print("as before:", library);
}

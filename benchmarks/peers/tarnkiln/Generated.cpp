#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "books/AuthorImpl.h"
#include "books/BookImpl.h"
#include "books/LibraryImpl.h"
#include "tarnkiln/kernel/Transaction.h"

namespace peers {
namespace {

/// The same books as in a `Library`, of the generated class.
class Books
{
public:
    explicit Books(std::size_t size)
    {
        Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
        books::Library const library = books::Library::create(m_model);
        books::Author author;
        for (ustring const& title : Library::titles(size))
        {
            if (all.size() % Library::BOOKS_PER_AUTHOR == 0)
            {
                author = books::Author::create(m_model);
                library->getAuthors().push_back(author);
            }
            books::Book const book = books::Book::create(m_model);
            book->setTitle(title);
            book->setPages(Library::pages(all.size(), /*turn=*/0));
            book->setPrice(0.5 * static_cast<double>(all.size()));
            book->setLibrary(library);
            book->setAuthor(author);
            if (!all.empty())
                book->setPrevious(all.back());
            all.push_back(book);
        }
        transaction.commit();
    }
    ~Books()
    {
        all.clear();
        m_model->destroy();
    }
    Books(Books const&) = delete;
    Books& operator=(Books const&) = delete;

    void setPages(int turn) const
    {
        Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
        for (std::size_t i = 0; i < all.size(); ++i)
            all[i]->setPages(Library::pages(i, turn));
        transaction.commit();
    }

    std::vector<books::Book> all;

private:
    Model const m_model = Model::create(ModelConstellation());
};

void measureFloor(Measure const& measure, FullLibraries& libraries)
{
    measure.floor("read in order, generated getter", [&] {
        PlainLibrary const& library = libraries.plain();
        long sum = 0;
        return measure.timeEach([&] {
            for (PlainBook const* book : library.books)
                sum += book->pages;
            Measure::keep(sum);
        });
    });
    int turn = 0;
    measure.floor("set, generated setter", [&] {
        PlainLibrary const& library = libraries.plain();
        ++turn;
        return measure.timeEach([&] {
            for (std::size_t i = 0; i < measure.size(); ++i)
                library.books[i]->pages = Library::pages(i, turn);
        });
    });
}
}  // namespace

void measureGenerated(Measure const& measure, FullLibraries& libraries)
{
    char const* const read = "read in order, generated getter";
    char const* const set = "set, generated setter";
    if (!measure.wants(read) && !measure.wants(set))
        return;
    Books const books(measure.size());
    measure.ours(read, [&] {
        long sum = 0;
        return measure.timeEach([&] {
            for (books::Book const& book : books.all)
                sum += book->getPages();
            Measure::keep(sum);
        });
    });
    int turn = 0;
    measure.ours(set, [&] {
        ++turn;
        double const taken = measure.timeEach([&] { books.setPages(turn); });
        Measure::require(books.all.front()->getPages() == Library::pages(0, turn), "the new pages");
        return taken;
    });
    measureFloor(measure, libraries);
}
}  // namespace peers

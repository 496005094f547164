#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "tarnkiln/kernel/Transaction.h"

#include <string>
#include <utility>

namespace peers {
namespace {

/// The first library that has more books, and the other one.
struct Direction
{
    explicit Direction(Library const& library)
        : fromLibrary(library.library),
          toLibrary(library.secondLibrary)
    {
        if (from().genericSize() < to().genericSize())
            std::swap(fromLibrary, toLibrary);
    }
    GenericSequenceInterface& from() const { return booksOf(fromLibrary); }
    GenericSequenceInterface& to() const { return booksOf(toLibrary); }

    ModelElement fromLibrary;
    ModelElement toLibrary;

private:
    static GenericSequenceInterface& booksOf(ModelElement const& library)
    {
        return Library::sequence(library, LibraryClasses::get().books);
    }
};

/// Moves all books, or those that can be moved in a time that is far beyond what they should need.
template <class Move> std::size_t moveAll(std::size_t count, Move const& move)
{
    constexpr double LONGEST = 3e9;
    constexpr std::size_t BATCH = 500;
    std::size_t moved = 0;
    for (double spent = 0; moved < count && spent < LONGEST;)
    {
        std::size_t const end = std::min(count, moved + BATCH);
        spent += Measure::time([&] {
            for (; moved < end; ++moved)
                move(moved);
        });
    }
    return moved;
}

/// The time of each of the moves, committed.
template <class Mover> double timeMoves(Library const& library)
{
    Direction const way(library);
    std::size_t const before = way.to().genericSize();
    std::size_t moved = 0;
    double const taken = Measure::time([&] {
        library.change(/*revertible=*/true,
                       [&] { moved = moveAll(way.from().genericSize(), Mover(library, way)); });
    });
    Measure::require(way.to().genericSize() == before + moved, "books in the other library");
    return taken / static_cast<double>(moved);
}

/// The time of taking back each of the moves.
template <class Mover> double timeUndo(Library const& library)
{
    Direction const way(library);
    std::size_t const before = way.to().genericSize();
    Transaction const transaction = library.model->beginTransaction(/*revertible=*/true);
    std::size_t const moved = moveAll(way.from().genericSize(), Mover(library, way));
    double const taken = Measure::time([&] { transaction.rollBack(); });
    Measure::require(way.to().genericSize() == before, "books in the library that they came from");
    return taken / static_cast<double>(moved);
}

/// Moves a book by giving it the other library.
class BySetting
{
public:
    BySetting(Library const& library, Direction const& way)
        : m_libraryOf(library.classes.libraryOf),
          m_from(way.from()),
          m_target(Value::createElementValue(m_libraryOf, way.toLibrary))
    {}

protected:
    void move(std::size_t at) const
    {
        m_from.genericAt(at)->setPropertyValue(m_libraryOf, m_target, ACCESS);
    }
    std::size_t last() const { return m_from.genericSize() - 1; }

private:
    meta::Property const& m_libraryOf;
    GenericSequenceInterface& m_from;
    Value const m_target;
};

struct FromTheFront : BySetting
{
    using BySetting::BySetting;
    void operator()(std::size_t) const { move(0); }
};

struct FromTheBack : BySetting
{
    using BySetting::BySetting;
    void operator()(std::size_t) const { move(last()); }
};

/// Adds all to the other collection.
class AllAtOnce
{
public:
    AllAtOnce(Library const&, Direction const& way) : m_to(way.to())
    {
        GenericSequenceInterface& from = way.from();
        m_books.reserve(from.genericSize());
        for (std::size_t i = 0; i < from.genericSize(); ++i)
            m_books.push_back(from.genericAt(i));
    }
    void operator()(std::size_t i) const { m_to.genericAdd(m_books[i]); }

private:
    GenericSequenceInterface& m_to;
    std::vector<ModelElement> m_books;
};

template <class Mover>
void measureMoves(Measure const& measure, FullLibraries& libraries, char const* move,
                  char const* undo)
{
    measure.ours(undo, [&] { return timeUndo<Mover>(libraries.ours()); });
    measure.ours(move, [&] { return timeMoves<Mover>(libraries.ours()); });
}
}  // namespace

void measureMoves(Measure const& measure, FullLibraries& libraries)
{
    measureMoves<FromTheFront>(measure, libraries, "move from the front",
                               "undo moves from the front");
    measureMoves<FromTheBack>(measure, libraries, "move from the back", "undo moves from the back");
    measureMoves<AllAtOnce>(measure, libraries, "move all at once", "undo moves all at once");
}
}  // namespace peers

#include "benchmarks/peers/tarnkiln/Workloads.h"

#include <functional>
#include <memory>

namespace peers {
namespace {

/// Books in one model, and as many cards in another one of its constellation.
class Cards
{
public:
    explicit Cards(std::size_t size) : m_books(size, m_constellation) { m_books.fill(); }

    /// All cards, which may stand in the model of the books too.
    std::vector<ModelElement> make(bool besideTheBooks)
    {
        Model const& model = besideTheBooks ? m_books.model : m_catalogue.model;
        std::vector<ModelElement> cards;
        m_books.change(/*revertible=*/false, [&] {
            for (std::size_t i = 0; i < m_books.books.size(); ++i)
                cards.push_back(ModelElement::createReflective(model, m_books.classes.card));
        });
        return cards;
    }

    void referToBooks(std::vector<ModelElement> const& cards) const
    {
        refer(cards, [](ModelElement const& book) { return book; });
    }

    void referByProxies(std::vector<ModelElement> const& cards) const
    {
        refer(cards, [this](ModelElement const& book) {
            return ModelElement::createProxy(m_catalogue.model, m_books.classes.book,
                                             book->getPersistentProxyId(/*omitModel=*/false));
        });
    }

    void readAll(std::vector<ModelElement> const& cards) const
    {
        std::size_t right = 0;
        for (std::size_t i = 0; i < cards.size(); ++i)
            right += cards[i]->getPropertyValue(m_books.classes.cardBook, ACCESS)
                                 .getValue<ModelElement>() == m_books.books[i]
                         ? 1
                         : 0;
        Measure::require(right == cards.size(), "the books");
    }

private:
    /// Lets each card refer to what `target` gives for its book.
    template <class Target>
    void refer(std::vector<ModelElement> const& cards, Target const& target) const
    {
        meta::Property const& property = m_books.classes.cardBook;
        m_books.change(/*revertible=*/false, [&] {
            for (std::size_t i = 0; i < cards.size(); ++i)
                cards[i]->setPropertyValue(
                    property, Value::createElementValue(property, target(m_books.books[i])),
                    ACCESS);
        });
    }

    ModelConstellation const m_constellation = ModelConstellation::create();
    Library m_books;
    Library m_catalogue{0, m_constellation};
};
}  // namespace

void measureProxies(Measure const& measure)
{
    char const* const resolve = "resolve a reference";
    char const* const again = "read a resolved reference";
    char const* const local = "read a local reference";
    if (!measure.wants(resolve) && !measure.wants(again) && !measure.wants(local))
        return;
    Cards cards(measure.size());
    std::vector<ModelElement> const elsewhere = cards.make(/*besideTheBooks=*/false);
    auto const readElsewhere = [&] { return measure.timeEach([&] { cards.readAll(elsewhere); }); };
    measure.ours(resolve, [&] {
        cards.referByProxies(elsewhere);
        return readElsewhere();
    });
    cards.referByProxies(elsewhere);
    cards.readAll(elsewhere);
    measure.ours(again, readElsewhere);
    std::vector<ModelElement> const beside = cards.make(/*besideTheBooks=*/true);
    cards.referToBooks(beside);
    measure.ours(local, [&] { return measure.timeEach([&] { cards.readAll(beside); }); });
}
}  // namespace peers

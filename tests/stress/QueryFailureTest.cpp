// Queries when memory runs out: an exception or the rows, nothing leaks, and the same query gives
// its rows afterwards.
#include "tarnkiln/meta/ClassConstrainables.h"
#include "tarnkiln/meta/PropertyConstrainables.h"
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/Results.h"
#include "tests/query/QueryFixture.h"
#include "tests/support/EachFailure.h"
#include "tests/support/PlainEngine.h"

#include <ostream>
#include <tuple>

namespace testkit {
namespace {

using query::AbstractQuery;
using Engine = NativeTarnkilnQuery::Engine;

/// Three authors with two books each.
class FilledLibrary : public QueryFixture
{
public:
    struct Case
    {
        char const* name;
        void (*build)(FilledLibrary const& library, NativeTarnkilnQuery& query);

        friend void PrintTo(Case const& shown, std::ostream* out) { *out << shown.name; }
    };
    static std::vector<Case> cases();

protected:
    FilledLibrary()
    {
        for (int i = 0; i < 3; ++i)
        {
            ustring const suffix(1, static_cast<char16_t>(u'a' + i));
            ModelElement const by = makeAuthor(u"an author of a long name, " + suffix, 1800 + i);
            for (int j = 0; j < 2; ++j)
            {
                ModelElement const made =
                    makeBook(u"a book with a title that is long, " + suffix, 100 * (i + j));
                set(made, writer, by);
                set(made, rating, boost::optional<int>(i + j));
                addTo(made, editors, by);
                valuesOf(made, scores).genericAdd(integer(i));
            }
        }
    }
};

std::vector<FilledLibrary::Case> FilledLibrary::cases()
{
    using R = ValueMatchRelation;
    using Library = FilledLibrary const&;
    using Query = NativeTarnkilnQuery&;
    return {
        {"AllOfAClass",
         [](Library w, Query query) { query.addSearchClass(w.book, WITH_SUBCLASSES); }},
        {"ByANumber",
         [](Library w, Query query) {
             query.addSearchClass(w.book, WITH_SUBCLASSES);
             query.addValueConstraint(w.pages, R::greater, integer(150), 0);
         }},
        {"ByAnOptionalNumber",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addValueConstraint(w.rating, R::lessOrEqual, optionalValue(w.rating, 2), 0);
         }},
        {"ByANumberAmongMany",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addValueConstraint(w.scores, R::equal, integer(1), 0);
         }},
        {"ByAPattern",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addValueConstraint(w.title, R::like, text(u"%b"), 0);
         }},
        {"ByARegularExpression",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addValueConstraint(w.title, R::regexp, text(u"a b.*[ab]"), 0);
         }},
        {"ByATextInAnyCase",
         [](Library w, Query query) {
             query.addSearchClass(w.author, EXACTLY);
             query.addValueConstraint(w.name, R::equalStringNocase,
                                      text(u"AN AUTHOR OF A LONG NAME, B"), 0);
         }},
        {"TopLevel",
         [](Library w, Query query) {
             query.addSearchClass(w.author, EXACTLY);
             query.addTopLevelConstraint(0);
         }},
        {"JoinedByAReference",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addSearchClass(w.author, EXACTLY);
             query.addAssociatedObjectConstraint(w.writer, 0, 1);
         }},
        {"JoinedByACollection",
         [](Library w, Query query) {
             query.addSearchClass(w.author, EXACTLY);
             query.addSearchClass(w.book, EXACTLY);
             query.addAssociatedObjectConstraint(w.editors, 1, 0);
         }},
        {"JoinedByEqualTexts",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addSearchClass(w.book, EXACTLY);
             query.addPropertyRelation(w.title, R::equal, w.title, 0, 1);
         }},
        {"JoinedByOrderedNumbers",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addSearchClass(w.book, EXACTLY);
             query.addPropertyRelation(w.pages, R::less, w.pages, 0, 1);
         }},
        {"JoinedThrice",
         [](Library w, Query query) {
             query.addSearchClass(w.book, EXACTLY);
             query.addSearchClass(w.author, EXACTLY);
             query.addSearchClass(w.book, WITH_SUBCLASSES);
             query.addAssociatedObjectConstraint(w.writer, 0, 1);
             query.addAssociatedObjectConstraint(w.writer, 2, 1);
             query.addPropertyRelation(w.pages, R::notEqual, w.pages, 0, 2);
         }},
        {"CombinedInAllWays",
         [](Library w, Query query) {
             query.addSearchClass(w.author, EXACTLY);
             query.addSearchClass(w.book, EXACTLY);
             query.setResultOffset(1);
             query.setResultLimit(7);
         }},
    };
}

class QueriesOutOfMemory
    : public FilledLibrary,
      public testing::WithParamInterface<std::tuple<FilledLibrary::Case, Engine>>
{
protected:
    /// All answers of a new query.
    struct Answers
    {
        Rows rows;
        Row first;
        std::size_t count = 0;

        bool operator==(Answers const& other) const = default;
    };
    Answers ask() const
    {
        auto const query = makeQuery();
        query->useEngine(std::get<Engine>(GetParam()));
        std::get<Case>(GetParam()).build(*this, *query);
        return ask(*query);
    }
    static Answers ask(NativeTarnkilnQuery& query)
    {
        return {rowsOf(query), query.getFirstResult({}), query.getResultCount()};
    }
};

INSTANTIATE_TEST_SUITE_P(Queries, QueriesOutOfMemory,
                         testing::Combine(testing::ValuesIn(FilledLibrary::cases()),
                                          testing::Values(Engine(nullptr), Engine(&runPlainly))),
                         [](auto const& tested) {
                             std::string const name = std::get<0>(tested.param).name;
                             bool const isFast = !std::get<1>(tested.param);
                             return name + (isFast ? "Fast" : "Plain");
                         });

TEST_P(QueriesOutOfMemory, FailOrGiveTheirRows)
{
    Answers const expected = ask();
    EXPECT_FALSE(expected.rows.empty());

    forEachFailure([&](unsigned long number, Failing mode) {
        Answers answers;
        Attempt const attempt(number, mode, [&] { answers = ask(); });
        EXPECT_TRUE(attempt.threw || answers == expected);
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        return attempt.failed;
    });
}

TEST_P(QueriesOutOfMemory, CanBeRunAgain)
{
    Answers const expected = ask();

    forEachFailure([&](unsigned long number, Failing mode) {
        auto const query = makeQuery();
        query->useEngine(std::get<Engine>(GetParam()));
        std::get<Case>(GetParam()).build(*this, *query);
        Attempt const attempt(number, mode, [&] { ask(*query); });
        EXPECT_EQ(ask(*query), expected);
        return attempt.failed;
    });
}

/// The pairs of a class with a name of some pattern and a property of that class.
std::size_t countTyped(Model const& model)
{
    AbstractQuery query(model);
    meta::Class::Constrainables const owner({query, WITH_SUBCLASSES});
    meta::Property::Constrainables const property({query, WITH_SUBCLASSES});
    owner.name == u"Book";
    property.owningType.refersTo(owner);
    std::size_t count = 0;
    for (auto const& [found, of] : query.results(property, owner))
        count += found && of ? 1 : 0;
    return count;
}

TEST_F(FilledLibrary, IsAskedByTypedQueriesWhichFailOrGiveTheirRows)
{
    std::size_t const expected = book->getOwnedAttributes().size();

    forEachFailure([&](unsigned long number, Failing mode) {
        std::size_t count = 0;
        Attempt const attempt(number, mode, [&] { count = countTyped(metamodel.model); });
        EXPECT_TRUE(attempt.threw || count == expected);
        EXPECT_EQ(countTyped(metamodel.model), expected);
        return attempt.failed;
    });
}
}  // namespace
}  // namespace testkit

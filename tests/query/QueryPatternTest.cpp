#include "tests/query/QueryFixture.h"
#include "textkit/regex/RegexError.h"

#include <gtest/gtest.h>

#include <chrono>
#include <regex>

namespace testkit {
namespace {

using enum ValueMatchRelation;

class QueryOfPatterns : public QueryFixture
{
protected:
    ModelElement makeMarked(string const& mark)
    {
        ModelElement const made = make(book);
        set(made, shelfMark, mark);
        return made;
    }
};

TEST_F(QueryOfPatterns, FindsUTF16TextsThatContainAMatch)
{
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const hemmed = makeBook(u"hEmmaed");
    makeBook(u"emma");

    EXPECT_EQ(booksWith(title, regexp, text(u"Em+a")), inOrder({emma, hemmed}));
    EXPECT_THAT(booksWith(title, regexp, text(u"^Em+a$")), ElementsAre(emma));
    EXPECT_EQ(booksWith(title, like, text(u"Em_a")), inOrder({emma, hemmed}));
    EXPECT_THAT(booksWith(title, like, text(u"h%a")), ElementsAre(hemmed));
}

TEST_F(QueryOfPatterns, FindsEightBitTextsThatMatchAsAWhole)
{
    ModelElement const first = makeMarked("A.100");
    ModelElement const second = makeMarked("A.1000");
    makeMarked("Ax100");

    EXPECT_THAT(booksWith(shelfMark, like, bytes("A.100")), ElementsAre(first));
    EXPECT_EQ(booksWith(shelfMark, like, bytes("A.%")), inOrder({first, second}));
    EXPECT_THAT(booksWith(shelfMark, like, bytes("A.___")), ElementsAre(first));
    EXPECT_EQ(booksWith(shelfMark, regexp, bytes("A\\.10*")), inOrder({first, second}));
    EXPECT_THAT(booksWith(shelfMark, like, bytes("100")), IsEmpty());
}

TEST_F(QueryOfPatterns, TakesAByteOfAnEightBitTextForACharacter)
{
    ModelElement const umlaut = makeMarked("\xC3\xA4");

    EXPECT_THAT(booksWith(shelfMark, like, bytes("_")), IsEmpty());
    EXPECT_THAT(booksWith(shelfMark, like, bytes("__")), ElementsAre(umlaut));
}

TEST_F(QueryOfPatterns, FailsForABadPatternAtTheFirstComparison)
{
    EXPECT_THAT(booksWith(shelfMark, regexp, bytes("(")), IsEmpty());
    EXPECT_THAT(booksWith(title, regexp, text(u"(")), IsEmpty());
    makeAuthor(u"Jane");
    EXPECT_THAT(booksWith(title, regexp, text(u"(")), IsEmpty());
    makeBook(u"Emma");

    EXPECT_THROW(booksWith(shelfMark, regexp, bytes("(")), std::regex_error);
    EXPECT_THROW(booksWith(title, regexp, text(u"(")), textkit::regex::RegexError);
}

TEST_F(QueryOfPatterns, FailsAgainInTheNextRun)
{
    makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addValueConstraint(shelfMark, regexp, bytes("["), 0);

    EXPECT_THROW(query->getResultCount(), std::regex_error);
    EXPECT_THROW(query->getFirstResult({}), std::regex_error);
}

TEST_F(QueryOfPatterns, GivesHostilePatternsUpSoon)
{
    makeBook(ustring(3000, u'a') + u'!');
    makeMarked(string(3000, 'a') + '!');
    auto const begin = std::chrono::steady_clock::now();

    EXPECT_THROW(booksWith(title, regexp, text(u"^(a|aa)+$")), textkit::regex::RegexError);
    EXPECT_THROW(booksWith(title, regexp, text(ustring(100'000, u'('))),
                 textkit::regex::RegexError);
    EXPECT_THAT(booksWith(shelfMark, regexp, bytes("(a|aa)+")), IsEmpty());
    EXPECT_THROW(booksWith(shelfMark, regexp, bytes("(a|aa)+(b)?\\2c")), std::regex_error);
    EXPECT_THROW(booksWith(shelfMark, regexp, bytes(string(100'000, '('))), std::regex_error);
    EXPECT_THROW(booksWith(shelfMark, regexp, bytes("((a{99}){99}){99}")), std::regex_error);
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(60));
}

TEST_F(QueryOfPatterns, TakesThePatternFromAProperty)
{
    meta::Property const pattern =
        metamodel.property(author, u"pattern", StandardTypes::stdstringMeta).required();
    ModelElement const jane = makeAuthor(u"Jane");
    set(jane, pattern, string("A\\d+"));
    ModelElement const mary = makeAuthor(u"Mary");
    set(mary, pattern, string("B.*"));
    ModelElement const first = makeMarked("A17");
    ModelElement const second = makeMarked("B17");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addPropertyRelation(shelfMark, regexp, pattern, 0, 1);

    EXPECT_THAT(rowsOf(*query),
                UnorderedElementsAre(ElementsAre(first, jane), ElementsAre(second, mary)));
}
}  // namespace
}  // namespace testkit

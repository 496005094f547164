#include "tests/query/QueryFixture.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/PlainEngine.h"

#include <boost/uuid/uuid_io.hpp>
#include <gtest/gtest.h>

#include <functional>
#include <utility>

namespace testkit {
namespace {

using enum ValueMatchRelation;

meta::Property const& countOfNodes()
{
    return NodeMetamodel::get().properties[Node::Impl::COUNT.index];
}

/// An element of a client that does something when it is asked for its count.
class Meddler : public Node::Impl
{
public:
    using Node::Impl::Impl;

    Value getPropertyValue(meta::Property const& property,
                           ReflectionPrivateTag const& tag) const override
    {
        if (property == countOfNodes())
            meddle();
        return Node::Impl::getPropertyValue(property, tag);
    }

    std::function<void()> meddle = [] {};
};

class QueryJoin : public QueryFixture
{
protected:
    /// The pairs of a book and an author that `property` ties together.
    Rows associated(meta::Property const& property)
    {
        auto const query = makeQuery();
        query->addSearchClass(book, EXACTLY);
        query->addSearchClass(author, EXACTLY);
        query->addAssociatedObjectConstraint(property, 0, 1);
        return rowsOf(*query);
    }
    /// The elements of one class in their order.
    Row all(meta::Class const& searched)
    {
        auto const query = makeQuery();
        query->addSearchClass(searched, EXACTLY);
        return elementsOf(*query);
    }
    /// The rows of the plain engine, which must be those of the library's.
    static Rows rowsOfBoth(NativeTarnkilnQuery& query)
    {
        Rows rows = rowsOf(query);
        query.useEngine(&runPlainly);
        EXPECT_EQ(rows, rowsOf(query));
        query.useEngine(nullptr);
        EXPECT_EQ(query.getResultCount(), rows.size());
        return rows;
    }
    Meddler& makeMeddler(std::function<void()> meddle) const
    {
        auto* const made = new Meddler(model, UUID());
        ModelElement const handle(made);
        made->notifyCreated();
        made->meddle = std::move(meddle);
        return *made;
    }
    static ustring uuidText(ModelElement const& element)
    {
        string const characters = boost::uuids::to_string(element->getUuid());
        return ustring(characters.begin(), characters.end());
    }
};

TEST_F(QueryJoin, FollowsSingleReferences)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const persuasion = makeBook(u"Persuasion");
    makeBook(u"anonymous");
    set(emma, writer, jane);
    set(persuasion, writer, jane);

    EXPECT_THAT(associated(writer),
                UnorderedElementsAre(ElementsAre(emma, jane), ElementsAre(persuasion, jane)));
    set(persuasion, writer, mary);
    EXPECT_THAT(associated(writer),
                UnorderedElementsAre(ElementsAre(emma, jane), ElementsAre(persuasion, mary)));
}

TEST_F(QueryJoin, FollowsManyReferences)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const persuasion = makeBook(u"Persuasion");
    addTo(emma, editors, jane);
    addTo(emma, editors, mary);
    addTo(emma, editors, jane);
    addTo(persuasion, editors, mary);

    EXPECT_THAT(associated(editors),
                UnorderedElementsAre(ElementsAre(emma, jane), ElementsAre(emma, mary),
                                     ElementsAre(persuasion, mary)));
}

TEST_F(QueryJoin, CountsTheRowsOfTheLowerInstanceFastest)
{
    for (int number = 0; number < 4; ++number)
    {
        makeAuthor(u"author", number);
        makeBook(u"book", number);
    }
    Row const books = all(book);
    Row const authors = all(author);
    for (ModelElement const& element : books)
    {
        for (ModelElement const& edited : authors)
            addTo(element, editors, edited);
    }
    Rows expected;
    for (ModelElement const& second : authors)
    {
        for (ModelElement const& first : books)
            expected.push_back({first, second});
    }

    EXPECT_EQ(associated(editors), expected);
    // The numbers of the instances decide, and not which of them refers to the other.
    auto const query = makeQuery();
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addAssociatedObjectConstraint(editors, 1, 0);
    expected.clear();
    for (ModelElement const& second : books)
    {
        for (ModelElement const& first : authors)
            expected.push_back({first, second});
    }
    EXPECT_EQ(rowsOf(*query), expected);
}

TEST_F(QueryJoin, TakesAProxyForTheElementThatItNames)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const emma = makeBook(u"Emma");
    FakeDataSource& source = FakeDataSource::installIn(model);
    set(emma, writer, proxyOf(jane));
    addTo(emma, editors, proxyOf(jane));
    source.calls.clear();

    EXPECT_THAT(associated(writer), ElementsAre(ElementsAre(emma, jane)));
    EXPECT_THAT(associated(editors), ElementsAre(ElementsAre(emma, jane)));

    // Both are still what they were, and nothing was loaded for them.
    EXPECT_TRUE(valueOf(emma, writer, ModelElement::Impl::NO_PROXY_RESOLVE)
                    .getValue<ModelElement>()
                    ->isProxy());
    EXPECT_EQ(referencesOf(emma, editors).getAllValuesAndProxies().size(), 1u);
    EXPECT_THAT(source.calls, ::testing::Not(::testing::Contains("fetchElement")));
}

TEST_F(QueryJoin, ComparesTheUUIDOfAProxyAsElementsWriteTheirs)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const emma = makeBook(u"Emma");
    auto const joins = [&](ustring const& type, ustring const& id,
                           boost::optional<ustring> const& modelId = boost::none) {
        set(emma, writer, ModelElement::createProxy(model, author, ProxyId(type, id, modelId)));
        return associated(writer).size() == 1;
    };
    ustring const id = uuidText(jane);
    ustring upper = id;
    for (char16_t& letter : upper)
        letter = letter >= u'a' && letter <= u'f' ? letter - 32 : letter;

    EXPECT_TRUE(joins(ElementId::UUID_TYPE, id));
    EXPECT_FALSE(joins(ElementId::UUID_TYPE, u'{' + id + u'}'));
    EXPECT_EQ(joins(ElementId::UUID_TYPE, upper), upper == id);
    EXPECT_FALSE(joins(ElementId::UUID_TYPE, u""));
    EXPECT_FALSE(joins(u"name", id));
    EXPECT_FALSE(joins(ElementId::UUID_TYPE, uuidText(emma)));
    // The model that it names does not matter.
    EXPECT_TRUE(joins(ElementId::UUID_TYPE, id, ustring(u"file:elsewhere")));
}

TEST_F(QueryJoin, DoesNotTakeADeadReferenceForAnElement)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const emma = makeBook(u"Emma");
    set(emma, writer, jane);
    jane->destroy();
    makeAuthor(u"Mary");

    EXPECT_THAT(associated(writer), IsEmpty());
}

TEST_F(QueryJoin, ComparesPropertiesOfTwoElements)
{
    ModelElement const emma = makeBook(u"Jane", 1775);
    ModelElement const other = makeBook(u"Mary", 3);
    ModelElement const jane = makeAuthor(u"Jane", 1775);
    ModelElement const mary = makeAuthor(u"Mary", 1797);
    auto const related = [&](meta::Property const& left, ValueMatchRelation relation,
                             meta::Property const& right) {
        auto const query = makeQuery();
        query->addSearchClass(book, EXACTLY);
        query->addSearchClass(author, EXACTLY);
        query->addPropertyRelation(left, relation, right, 0, 1);
        return rowsOf(*query);
    };

    EXPECT_THAT(related(title, equal, name),
                UnorderedElementsAre(ElementsAre(emma, jane), ElementsAre(other, mary)));
    EXPECT_THAT(related(title, notEqual, name),
                UnorderedElementsAre(ElementsAre(emma, mary), ElementsAre(other, jane)));
    EXPECT_THAT(related(pages, greaterOrEqual, born), ElementsAre(ElementsAre(emma, jane)));
    EXPECT_THAT(related(pages, less, born),
                UnorderedElementsAre(ElementsAre(emma, mary), ElementsAre(other, jane),
                                     ElementsAre(other, mary)));
}

TEST_F(QueryJoin, KeepsLeftAndRightWhateverTheirNumbers)
{
    ModelElement const emma = makeBook(u"Emma", 10);
    ModelElement const jane = makeAuthor(u"Jane", 20);
    auto const query = makeQuery();
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(pages, less, born, 1, 0);
    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(jane, emma)));

    query->addPropertyRelation(born, less, pages, 0, 1);
    EXPECT_THAT(rowsOf(*query), IsEmpty());
}

TEST_F(QueryJoin, ComparesCollectionsOfTwoElementsByIdentity)
{
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const other = makeBook(u"other");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(scores, equal, scores, 0, 1);
    EXPECT_THAT(rowsOf(*query),
                UnorderedElementsAre(ElementsAre(emma, emma), ElementsAre(other, other)));

    query->addPropertyRelation(scores, less, scores, 0, 1);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, query->getResultCount(), u"Integer");
}

TEST_F(QueryJoin, TestsConstraintsBetweenTwoInstancesInTheirOrder)
{
    makeBook(u"Emma", 10);
    makeBook(u"other", 20);
    auto const run = [&](bool failingFirst) {
        auto const query = makeQuery();
        query->addSearchClass(book, EXACTLY);
        query->addSearchClass(book, EXACTLY);
        if (failingFirst)
            query->addPropertyRelation(scores, less, scores, 0, 1);
        query->addPropertyRelation(pages, greater, printed, 0, 1);
        query->addPropertyRelation(printed, greater, pages, 1, 0);
        if (!failingFirst)
            query->addPropertyRelation(scores, less, scores, 1, 0);
        return query->getResultCount();
    };

    EXPECT_EQ(run(false), 0u);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, run(true), u"Integer");
}

TEST_F(QueryJoin, ReadsNothingWhereOneSideIsEmpty)
{
    makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addAssociatedObjectConstraint(name, 0, 1);
    EXPECT_EQ(query->getResultCount(), 0u);
    makeAuthor(u"Jane");

    EXPECT_RAISES_WITH(messages::NoSuchProperty, query->getResultCount(), u"name", u"rt.Book");
}

TEST_F(QueryJoin, FailsForPropertiesThatReferToNothing)
{
    makeBook(u"Emma");
    makeAuthor(u"Jane");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, associated(title), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, associated(scores), u"Integer");
}

TEST_F(QueryJoin, CombinesTheInstancesThatAreLeftOver)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const emma = makeBook(u"Emma");
    set(emma, writer, jane);
    ModelElement const first = make(novel);
    ModelElement const second = make(novel);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(novel, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addAssociatedObjectConstraint(writer, 0, 2);

    Row const novels = inOrder({first, second});
    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(emma, novels[0], jane),
                                            ElementsAre(emma, novels[1], jane)));
    EXPECT_THAT(rowsOf(*query, {2, 0}),
                ElementsAre(ElementsAre(jane, emma), ElementsAre(jane, emma)));
}

TEST_F(QueryJoin, PutsJoinedInstancesBehindTheOthers)
{
    for (int number = 0; number < 2; ++number)
    {
        ModelElement const element = makeBook(u"book", number);
        set(element, writer, makeAuthor(u"author", number));
        make(novel);
    }
    Rows const pairs = associated(writer);
    Row const novels = all(novel);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(novel, EXACTLY);
    query->addAssociatedObjectConstraint(writer, 0, 1);
    Rows expected;
    for (Row const& pair : pairs)
    {
        for (ModelElement const& third : novels)
            expected.push_back({pair[0], pair[1], third});
    }

    EXPECT_EQ(rowsOf(*query), expected);
}

TEST_F(QueryJoin, LetsAnInstanceBeTiedToItself)
{
    meta::Property const sequel = metamodel.property(book, u"sequel", book);
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const loop = makeBook(u"loop");
    set(emma, sequel, loop);
    set(loop, sequel, loop);
    make(novel);
    make(novel);
    Row const novels = all(novel);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(novel, EXACTLY);
    query->addAssociatedObjectConstraint(sequel, 0, 0);

    EXPECT_THAT(rowsOf(*query),
                ElementsAre(ElementsAre(loop, novels[0]), ElementsAre(loop, novels[1])));
}

TEST_F(QueryJoin, JoinsThreeInstances)
{
    ModelElement const jane = makeAuthor(u"Jane", 1);
    ModelElement const mary = makeAuthor(u"Mary", 2);
    ModelElement const emma = makeBook(u"Emma", 1);
    ModelElement const volume = makeBook(u"volume", 2);
    addTo(emma, parts, volume);
    set(emma, writer, jane);
    set(volume, writer, mary);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addAssociatedObjectConstraint(parts, 0, 2);
    query->addAssociatedObjectConstraint(writer, 2, 1);
    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(emma, mary, volume)));

    // And both ends of what has been joined already.
    query->addPropertyRelation(pages, less, born, 0, 1);
    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(emma, mary, volume)));
    query->addPropertyRelation(born, lessOrEqual, pages, 1, 0);
    EXPECT_THAT(rowsOf(*query), IsEmpty());
}

TEST_F(QueryJoin, FollowsReferencesOfGeneratedClasses)
{
    auto const& properties = NodeMetamodel::get().properties;
    Node const first = Node::create(model);
    Node const second = Node::create(model);
    first->setBuddy(second);
    first->getLinks().push_back(second);
    first->getMarks().insert(first);
    auto const tied = [&](Slot const& slot) {
        auto const query = makeQuery();
        query->addSearchClass(Node::metaClass(), WITH_SUBCLASSES);
        query->addSearchClass(Node::metaClass(), WITH_SUBCLASSES);
        query->addAssociatedObjectConstraint(properties[slot.index], 0, 1);
        return rowsOf(*query);
    };

    EXPECT_THAT(tied(Node::Impl::BUDDY), ElementsAre(ElementsAre(first, second)));
    EXPECT_THAT(tied(Node::Impl::LINKS), ElementsAre(ElementsAre(first, second)));
    EXPECT_THAT(tied(Node::Impl::BACKLINKS), ElementsAre(ElementsAre(second, first)));
    EXPECT_THAT(tied(Node::Impl::MARKS), ElementsAre(ElementsAre(first, first)));
}

TEST_F(QueryJoin, FollowsReferencesOfManyElementsOfSeveralClasses)
{
    meta::Property const special = metamodel.property(novel, u"special", author);
    Row authors;
    for (int number = 0; number < 20; ++number)
        authors.push_back(makeAuthor(u"author", number));
    for (int number = 0; number < 300; ++number)
    {
        ModelElement const element = make(number % 3 == 0 ? novel : book);
        ModelElement const& written = authors[static_cast<std::size_t>(number) % authors.size()];
        set(element, pages, number);
        if (number % 7 != 0)
            set(element, writer, number % 5 == 0 ? proxyOf(written) : written);
        if (number % 3 == 0)
            set(element, special, authors.front());
    }
    for (std::size_t const first : {0u, 1u})
    {
        std::size_t const second = 1 - first;
        auto const query = makeQuery();
        query->addSearchClass(first == 0 ? book : author, WITH_SUBCLASSES);
        query->addSearchClass(first == 0 ? author : book, WITH_SUBCLASSES);
        query->addAssociatedObjectConstraint(writer, first, second);
        EXPECT_EQ(rowsOfBoth(*query).size(), 257u);

        query->addValueConstraint(pages, less, integer(150), first);
        EXPECT_EQ(rowsOfBoth(*query).size(), 128u);
        query->addValueConstraint(born, equal, integer(1), second);
        EXPECT_EQ(rowsOfBoth(*query).size(), 7u);
    }
    auto const query = makeQuery();
    query->addSearchClass(novel, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addAssociatedObjectConstraint(special, 0, 1);
    EXPECT_EQ(rowsOfBoth(*query).size(), 100u);
}

TEST_F(QueryJoin, FollowsReferencesAsCodeOfClientsLeavesThemInTheScan)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    Row books;
    for (int number = 0; number < 50; ++number)
        books.push_back(makeBook(u"book"));
    auto const writeAll = [&](ModelElement const& element) {
        for (ModelElement const& written : books)
            set(written, writer, element);
    };
    makeMeddler([&] { writeAll(mary); });
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(Node::metaClass(), EXACTLY);
    query->addAssociatedObjectConstraint(writer, 0, 1);
    query->addValueConstraint(countOfNodes(), less, integer(5), 2);

    writeAll(jane);
    Rows const rows = rowsOf(*query);
    EXPECT_EQ(rows.size(), books.size());
    for (Row const& row : rows)
        EXPECT_EQ(row[1], mary);
}

TEST_F(QueryJoin, FollowsReferencesAsCodeOfClientsLeavesThemInAnotherJoin)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    ModelElement const emma = makeBook(u"Emma");
    meta::Property const count = countOfNodes();
    makeMeddler([&] { set(emma, writer, mary); });
    // Which join comes first depends on the numbers of the instances.
    for (std::size_t const first : {0u, 2u})
    {
        std::size_t const other = 2 - first;
        auto const query = makeQuery();
        for (std::size_t id = 0; id < 4; ++id)
        {
            bool const isOfBooks = id / 2 == first / 2;
            query->addSearchClass(!isOfBooks    ? Node::metaClass()
                                  : id == first ? book
                                                : author,
                                  EXACTLY);
        }
        query->addAssociatedObjectConstraint(writer, first, first + 1);
        query->addPropertyRelation(count, equal, count, other, other + 1);

        set(emma, writer, jane);
        query->useEngine(&runPlainly);
        Rows const plain = rowsOf(*query);
        set(emma, writer, jane);
        query->useEngine(nullptr);
        EXPECT_EQ(rowsOf(*query), plain);
        EXPECT_EQ(plain.size(), 1u);
    }
}

TEST_F(QueryJoin, KeepsElementsThatCodeOfClientsDestroys)
{
    meta::Property const count = countOfNodes();
    for (int number = 0; number < 20; ++number)
        makeBook(u"book");
    makeMeddler([&] {
        for (ModelElement const& element : all(book))
            element->destroy();
    });
    auto const query = makeQuery();
    query->addSearchClass(Node::metaClass(), EXACTLY);
    query->addSearchClass(Node::metaClass(), EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(count, equal, count, 0, 1);

    Rows const rows = rowsOf(*query);
    EXPECT_EQ(rows.size(), 20u);
    for (Row const& row : rows)
    {
        ASSERT_TRUE(row[2].getImpl());
        EXPECT_FALSE(row[2]);
        EXPECT_EQ(row[2]->getMetaClass(), book);
    }
}
}  // namespace
}  // namespace testkit

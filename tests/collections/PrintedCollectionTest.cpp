// How collections look in streams and in the messages of GoogleTest, and that all can be walked.
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/PrintTo.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/Uuids.h"

#include <boost/uuid/uuid_hash.hpp>
#include <gtest/gtest-spi.h>

#include <unordered_set>

namespace testkit {

using ::testing::PrintToString;

constexpr char const* ALPHA = "Node \"alpha\" 00000001-0000-0000-0000-000000000001";
constexpr char const* BETA = "Node \"beta\" 00000002-0000-0000-0000-000000000001";

class APrintedCollection : public ::testing::Test
{
protected:
    Node make(std::uint32_t number, ustring const& name) const
    {
        Node const made = Node::create(model, uuidOf(number));
        made->setName(name);
        return made;
    }

    Model const model = Model::create(ModelConstellation());
    Node const holder = make(9, u"holder");
    Node const alpha = make(1, u"alpha");
    Node const beta = make(2, u"beta");
};

TEST_F(APrintedCollection, ShowsItsElementsInTheirOrder)
{
    holder->getChildren().push_back(beta);
    holder->getChildren().push_back(alpha);
    string const expected = string("{") + BETA + ", " + ALPHA + "}";

    EXPECT_EQ(PrintToString(holder->getChildren()), expected);
    std::ostringstream out;
    out << holder->getChildren();
    EXPECT_EQ(out.str(), expected);
    EXPECT_EQ(PrintToString(alpha->getChildren()), "{}");
}

TEST_F(APrintedCollection, ShowsThoseOfSetsAndOfCollectionsWithKeys)
{
    holder->getByName().insert(beta);
    holder->getByName().insert(alpha);
    holder->getMarks().insert(beta);
    holder->getGrouped().insert(beta);

    EXPECT_EQ(PrintToString(holder->getByName()), string("{") + ALPHA + ", " + BETA + "}");
    EXPECT_EQ(PrintToString(holder->getMarks()), string("{") + BETA + "}");
    EXPECT_EQ(PrintToString(holder->getGrouped()), string("{") + BETA + "}");
}

TEST_F(APrintedCollection, ShowsProxiesAsTheyStand)
{
    Node const proxy = Node::createProxy(model, alpha->getPersistentProxyId(/*omitModel=*/true));
    holder->getParts().push_back(proxy);

    string const text = PrintToString(holder->getParts());

    EXPECT_NE(text.find("(stands in for uuid:00000001-0000-0000-0000-000000000001)"), string::npos)
        << text;
    EXPECT_EQ(holder->getParts().getAllValuesAndProxies(), std::vector<ModelElement>{proxy});
}

TEST_F(APrintedCollection, ShowsPlainValues)
{
    holder->getNumbers().push_back(3);
    holder->getNumbers().push_back(5);
    holder->getWords().insert(u"b");
    holder->getWords().insert(u"a");

    EXPECT_EQ(PrintToString(holder->getNumbers()), "{3, 5}");
    EXPECT_EQ(PrintToString(holder->getWords()), "{\"a\", \"b\"}");
    EXPECT_NONFATAL_FAILURE(EXPECT_EQ(&holder->getNumbers(), nullptr) << holder->getNumbers(),
                            "{3, 5}");
}

TEST_F(APrintedCollection, ShowsTextsUnderTexts)
{
    StringToStringMap map(nullptr, Feature());
    map.insert(u"b", u"2", StringToStringMap::Add);
    map.insert(u"a", u"1", StringToStringMap::Add);

    EXPECT_EQ(PrintToString(map), "{\"a\": \"1\", \"b\": \"2\"}");
}

TEST_F(APrintedCollection, ShowsAViewOfAnother)
{
    EXPECT_NE(PrintToString(meta::Property::metaClass()->getOwningPackage()->getEnumerations())
                  .find("{Enum \"Language\" "),
              string::npos);
}

// ---------------------------------------------------------------------------- walking

using AWalkedCollection = APrintedCollection;

TEST_F(AWalkedCollection, GivesItsEntriesToARangeFor)
{
    holder->getChildren().push_back(alpha);
    holder->getNumbers().push_back(3);
    holder->getWords().insert(u"a");
    holder->getMarks().insert(beta);
    holder->getByName().insert(beta);
    std::vector<ModelElement> elements;
    int sum = 0;
    ustring words;

    for (Node const& child : holder->getChildren())
        elements.push_back(child);
    for (Node const& mark : holder->getMarks())
        elements.push_back(mark);
    for (auto const& [name, node] : holder->getByName())
    {
        elements.push_back(node);
        words += name;
    }
    for (int const number : holder->getNumbers())
        sum += number;
    for (ustring const& word : holder->getWords())
        words += word;

    EXPECT_EQ(elements, (std::vector<ModelElement>{alpha, beta, beta}));
    EXPECT_EQ(sum, 3);
    EXPECT_EQ(words, u"betaa");
}

TEST_F(AWalkedCollection, FillsHashedContainersOfHandlesAndUuids)
{
    holder->getChildren().push_back(alpha);
    holder->getChildren().push_back(beta);

    std::unordered_set<Node> const nodes(holder->getChildren().begin(),
                                         holder->getChildren().end());
    std::unordered_set<Model> const models{alpha->getModel(), beta->getModel()};
    std::unordered_map<UUID, Node> byUuid;
    for (Node const& node : nodes)
        byUuid.emplace(node->getUuid(), node);

    EXPECT_EQ(nodes, (std::unordered_set<Node>{beta, alpha}));
    EXPECT_EQ(models.size(), 1u);
    EXPECT_EQ(byUuid.at(uuidOf(2)), beta);
}
}  // namespace testkit

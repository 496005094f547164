/// \file
/// How the element behind an identifier is found.
#include "tarnkiln/services/ElementIdResolver.h"

#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/services/internal/AttachedService.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/RecordingDataSource.h"
#include "tests/support/SpecialNodeImpl.h"

namespace tarn::kiln::services {
namespace {

using internal::AttachedService;
using testkit::Node;
using testkit::RecordingDataSource;
using testkit::SpecialNode;
using testkit::textOf;

/// Always gives the same answer, and counts how often it is asked.
class FixedResolver final : public ElementIdResolver
{
public:
    ModelElement resolveElement(Model const&, meta::Class const&, ElementId const& id) override
    {
        asked.push_back(id.getId());
        return answer;
    }

    ModelElement answer;
    std::vector<ustring> asked;
};

class ElementIds : public ::testing::Test
{
protected:
    using Attached = AttachedService<ElementIdResolver>;

    std::shared_ptr<FixedResolver> attach(string const& filter)
    {
        auto const resolver = std::make_shared<FixedResolver>();
        m_attached.push_back(std::make_unique<Attached>(filter, resolver));
        return resolver;
    }
    std::shared_ptr<FixedResolver> attachForUuids()
    {
        return attach("(bundle.tarnkiln.elementIdResolver=uuid)");
    }
    RecordingDataSource& addDataSource() { return RecordingDataSource::installIn(model); }
    ModelElement find(meta::Class const& metaClass, ElementId const& id) const
    {
        return ElementIdResolver::doFindElement(model, metaClass, id);
    }
    ModelElement findUuid(meta::Class const& metaClass, ustring const& text) const
    {
        return find(metaClass, ElementId(ElementId::UUID_TYPE, text));
    }
    Model model = Model::createTransientModel();
    meta::Class node = Node::metaClass();
    meta::Class special = SpecialNode::metaClass();

private:
    std::vector<std::unique_ptr<Attached>> m_attached;
};

TEST_F(ElementIds, OfTypeUuidFindAnElementInMemory)
{
    ModelElement const element = Node::create(model);
    auto const resolver = attachForUuids();
    RecordingDataSource const& source = addDataSource();

    EXPECT_EQ(findUuid(node, textOf(element->getUuid())), element);
    EXPECT_TRUE(resolver->asked.empty());
    EXPECT_TRUE(source.lookups.empty());
}

TEST_F(ElementIds, OfTypeUuidMayBeWrittenInCapitals)
{
    UUID const id{{0xab, 0xcd, 0xef}};
    ModelElement const element = Node::create(model, id);

    EXPECT_EQ(findUuid(node, u"ABCDEF00-0000-0000-0000-000000000000"), element);
}

TEST_F(ElementIds, ThatAreNoUuidAskNobody)
{
    auto const resolver = attachForUuids();
    resolver->answer = Node::create(model);
    RecordingDataSource const& source = addDataSource();

    for (ustring const text :
         {u"", u"emma", u"27118326-006d-3829-a67a-400ad23d5d9", u"27118326006d3829a67a400ad23d5d98",
          u"{27118326-006d-3829-a67a-400ad23d5d98}"})
        EXPECT_EQ(findUuid(node, text), ModelElement());

    EXPECT_TRUE(resolver->asked.empty());
    EXPECT_TRUE(source.lookups.empty());
}

TEST_F(ElementIds, FallThroughToTheServicesIfTheElementIsOfAnotherClass)
{
    ModelElement const element = Node::create(model);
    ustring const text = textOf(element->getUuid());
    auto const resolver = attachForUuids();
    EXPECT_EQ(findUuid(special, text), ModelElement());

    resolver->answer = SpecialNode::create(model);

    EXPECT_EQ(findUuid(special, text), resolver->answer);
    EXPECT_EQ(resolver->asked, (std::vector<ustring>{text, text}));
}

TEST_F(ElementIds, DoNotFindAnElementOfASubclass)
{
    ModelElement const element = SpecialNode::create(model);
    ASSERT_TRUE(special->isA(node));

    EXPECT_EQ(findUuid(node, textOf(element->getUuid())), ModelElement());
    EXPECT_EQ(findUuid(special, textOf(element->getUuid())), element);
}

TEST_F(ElementIds, OfUnloadedElementsAreLookedUpInTheDataSource)
{
    RecordingDataSource& source = addDataSource();
    ustring const text = textOf(ElementImpl::generateNewUuid());
    source.answer = Node::create(model);

    EXPECT_EQ(findUuid(node, text), source.answer);
    ASSERT_EQ(source.lookups.size(), 1u);
    EXPECT_EQ(source.lookups[0].metaClass, node);
    EXPECT_EQ(source.lookups[0].id.getType(), u"uuid");
    EXPECT_EQ(source.lookups[0].id.getId(), text);
    EXPECT_TRUE(source.fetches.empty());
}

TEST_F(ElementIds, FallThroughIfTheDataSourceGivesAnotherClass)
{
    addDataSource().answer = SpecialNode::create(model);
    auto const resolver = attachForUuids();
    resolver->answer = Node::create(model);

    EXPECT_EQ(findUuid(node, textOf(ElementImpl::generateNewUuid())), resolver->answer);
}

TEST_F(ElementIds, OfOtherTypesAreKnownToTheServicesOnly)
{
    RecordingDataSource& source = addDataSource();
    source.answer = Node::create(model);
    auto const resolver = attach("(bundle.tarnkiln.elementIdResolver=isbn)");
    auto const other = attach("(bundle.tarnkiln.elementIdResolver=issn)");
    ElementId const id(u"isbn", u"0-000");
    EXPECT_EQ(find(node, id), ModelElement());

    resolver->answer = SpecialNode::create(model);

    // A service may answer with whatever class it likes.
    EXPECT_EQ(find(node, id), resolver->answer);
    EXPECT_EQ(resolver->asked, (std::vector<ustring>{u"0-000", u"0-000"}));
    EXPECT_TRUE(other->asked.empty());
    EXPECT_TRUE(source.lookups.empty());
}

TEST_F(ElementIds, AreAnsweredByTheFirstServiceThatKnows)
{
    auto const ignorant = attach("(bundle.tarnkiln.elementIdResolver=isbn)");
    auto const stale = attach("(bundle.tarnkiln.elementIdResolver=isbn)");
    auto const knowing = attach("(bundle.tarnkiln.elementIdResolver=isbn)");
    auto const late = attach("(bundle.tarnkiln.elementIdResolver=isbn)");
    stale->answer = Node::create(model);
    stale->answer->destroy();
    knowing->answer = Node::create(model);
    late->answer = Node::create(model);

    EXPECT_EQ(find(node, ElementId(u"isbn", u"1")), knowing->answer);

    EXPECT_EQ(ignorant->asked.size(), 1u);
    EXPECT_EQ(stale->asked.size(), 1u);
    EXPECT_TRUE(late->asked.empty());
}

TEST_F(ElementIds, CannotReachOtherServicesByTheirType)
{
    auto const resolver = attach("(bundle.tarnkiln.elementIdResolver=*)");
    auto const escaped = attach("(bundle.tarnkiln.elementIdResolver=\\*)");
    auto const broken = attach("(bundle.tarnkiln.elementIdResolver=a\\)\\(b\\\\)");

    find(node, ElementId(u"*", u"1"));
    find(node, ElementId(u"a)(b\\", u"2"));

    EXPECT_TRUE(resolver->asked.empty());
    EXPECT_EQ(escaped->asked, (std::vector<ustring>{u"1"}));
    EXPECT_EQ(broken->asked, (std::vector<ustring>{u"2"}));
}
}  // namespace
}  // namespace tarn::kiln::services

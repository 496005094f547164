// Properties that not everybody may read or set, and operations.
#include "shapes/NodeImpl.h"
#include "shapes/VaultImpl.h"
#include "tests/generated/ShapesFixture.h"

namespace testkit::shapes {
namespace {

using GuardedProperty = ShapesTest;

template <class T>
concept HasFixedSetter = requires(T& element)
{
    element.setFixed(1);
};

TEST_F(GuardedProperty, HasNoSetterForOthersIfItIsReadOnly)
{
    static_assert(!HasFixedSetter<Vault::Impl>);
    Vault const vault = Vault::create(m_model);
    Value const six(meta::StandardTypes::integerMeta, 6);

    EXPECT_RAISES(messages::NoSuchProperty, write(vault, u"fixed", six));
    EXPECT_EQ(vault->getFixed(), 5);
    vault->adjust(6);
    EXPECT_EQ(vault->getFixed(), 6);
}

TEST_F(GuardedProperty, IsSetByThoseWhoReadDocumentsEvenIfItIsReadOnly)
{
    Vault const vault = Vault::create(m_model);

    vault->setPropertyValue(property(Vault::metaClass(), u"fixed"),
                            Value(meta::StandardTypes::integerMeta, 7),
                            ModelElement::Impl::PRIVILEGED_ACCESS);

    EXPECT_EQ(vault->getFixed(), 7);
}

TEST_F(GuardedProperty, IsSetOnceFromTheEmptyValue)
{
    Vault const vault = Vault::create(m_model);
    vault->setOnce(u"");
    vault->setOnce(u"first");

    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, vault->setOnce(u"second"), u"once");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, vault->setOnce(u"first"), u"once");
    EXPECT_RAISES_WITH(
        messages::CannotSetReadOnlyProperty,
        write(vault, u"once", Value(meta::StandardTypes::stringMeta, ustring(u"second"))), u"once");
    EXPECT_EQ(vault->getOnce(), u"first");
}

TEST_F(GuardedProperty, RefersOnceToATarget)
{
    Vault const vault = Vault::create(m_model);
    Node const first = Node::create(m_model);
    vault->setOnceTarget(first);
    vault->setOnceTarget(first);

    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty,
                       vault->setOnceTarget(Node::create(m_model)), u"onceTarget");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, vault->setOnceTarget(Node()),
                       u"onceTarget");
    EXPECT_EQ(vault->getOnceTarget(), first);
}

TEST_F(GuardedProperty, IsHiddenFromReflectionWithoutPublicAccessors)
{
    Vault const vault = Vault::create(m_model);
    Value const one(meta::StandardTypes::integerMeta, 1);

    EXPECT_RAISES(messages::NoSuchProperty, read(vault, u"hidden"));
    EXPECT_RAISES(messages::NoSuchProperty, write(vault, u"sealed", one));
    write(vault, u"hidden", one);
    EXPECT_EQ(vault->getHidden(), 1);
}

TEST_F(GuardedProperty, HasAnotherNameInCxxIfItsOwnIsAWordOfIt)
{
    Vault const vault = Vault::create(m_model);
    vault->setFallback(3);

    EXPECT_EQ(read(vault, u"default").getValue<int>(), 3);
}

TEST_F(GuardedProperty, IsComputedByHandIfItIsDerived)
{
    Vault const vault = Vault::create(m_model);
    vault->setOnce(u"here");

    EXPECT_EQ(vault->getSummary(), u"once: here");
    EXPECT_EQ(property(Vault::metaClass(), u"summary")->isDerived(), true);
}

using GeneratedOperation = ShapesTest;

TEST_F(GeneratedOperation, HasABodyByHand)
{
    Vault const vault = Vault::create(m_model);

    EXPECT_EQ(Guarded(vault)->score(2), 20);
    EXPECT_EQ(vault->tell(), u"guarded");
    EXPECT_EQ(vault->pick({u"a", u"b"}), (std::vector<ustring>{u"b", u"a"}));
}

TEST_F(GeneratedOperation, IsCalledByReflection)
{
    Vault const vault = Vault::create(m_model);
    ShapesMetaPackage const& package = ShapesMetaPackage::getInstance();
    meta::Operation const score = package.getOperation(rows::operations::GuardedScore);
    meta::Operation const paint = package.getOperation(rows::operations::VaultPaint);
    Value const three(meta::StandardTypes::integerMeta, 3);
    Money money;
    money.setAmount(9);

    auto const result = vault->invoke(score, {three}, ModelElement::Impl::PUBLIC_ACCESS);
    vault->invoke(paint,
                  {Value(package.getEnum(rows::enumerations::Colour), 3L),
                   Value(package.getDataType(rows::dataTypes::Money), money)},
                  ModelElement::Impl::PUBLIC_ACCESS);

    ASSERT_TRUE(result);
    EXPECT_EQ(result->getValue<int>(), 30);
    EXPECT_EQ(vault->getPrice().getNet().getAmount(), 9);
    EXPECT_EQ(vault->getPrice().getNet().getColour(), Colour::Red);
}

TEST_F(GeneratedOperation, IsCalledByReflectionWhereSeveralShareItsName)
{
    Vault const vault = Vault::create(m_model);
    Node const node = Node::create(m_model);
    ShapesMetaPackage const& package = ShapesMetaPackage::getInstance();
    meta::Operation const pickNode = package.getOperation(rows::operations::GuardedPick);
    meta::Operation const pickWords = package.getOperation(rows::operations::GuardedPick2);

    auto const picked =
        vault->invoke(pickNode,
                      {Value(Node::metaClass(), node),
                       Value(meta::StandardTypes::integerMeta, boost::optional<int>())},
                      ModelElement::Impl::PUBLIC_ACCESS);
    auto const words = vault->invoke(
        pickWords, {Value(meta::StandardTypes::stringMeta, std::vector<ustring>{u"a", u"b"})},
        ModelElement::Impl::PUBLIC_ACCESS);

    EXPECT_EQ(picked->getValue<Node>(), node);
    EXPECT_EQ(words->getValue<std::vector<ustring>>(), (std::vector<ustring>{u"b", u"a"}));
}

TEST_F(GeneratedOperation, IsNotCalledByReflectionWithoutAnInvoker)
{
    Vault const vault = Vault::create(m_model);
    meta::Operation const adjust =
        ShapesMetaPackage::getInstance().getOperation(rows::operations::GuardedAdjust);

    EXPECT_RAISES_WITH(messages::NoSuchOperation,
                       vault->invoke(adjust, {Value(meta::StandardTypes::integerMeta, 1)},
                                     ModelElement::Impl::PUBLIC_ACCESS),
                       u"adjust", u"shapes.Vault");
}
}  // namespace
}  // namespace testkit::shapes

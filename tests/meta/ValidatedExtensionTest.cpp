// Which extension of a model stands for one of another model.
#include "tarnkiln/meta/MetaRegistry.h"
#include "tests/meta/ExtensionFixture.h"

namespace testkit {
namespace {

class ValidatedExtensions : public ::testing::Test
{
protected:
    ValidatedExtensions()
    {
        RegistrySession session;
        m_novel->setSuperclass(m_book);
        session.commit();
    }
    ~ValidatedExtensions() override
    {
        m_mine->destroy();
        m_theirs->destroy();
    }

    /// What stands in `m_mine` for an extension of `m_theirs`, which is then forgotten.
    Extension validate(Class const& cls, ExtensionPrototype const& wanted,
                       boost::optional<Value> const& byDefault)
    {
        m_theirs->extendMetaclass(cls, wanted, byDefault);
        m_asked = m_theirs->getDeclaredExtension(cls, wanted.getName());
        Extension const result = m_mine->validateExtension(m_asked, byDefault);
        m_theirs->unextendMetaclass(cls, wanted.getName());
        return result;
    }
    Extension mine(ustring const& name) const { return m_mine->getExtension(m_novel, name); }

    RegistryElement<Class> m_book{u"ValidatedBook"};
    RegistryElement<Class> m_novel{u"ValidatedNovel"};
    RegistryElement<Class> m_magazine{u"ValidatedMagazine"};
    Model m_mine = Model::create(ModelConstellation());
    Model m_theirs = Model::create(ModelConstellation());
    Extension m_asked;
};

TEST_F(ValidatedExtensions, StandForThemselvesWhereTheNameIsFree)
{
    m_mine->extendMetaclass(m_magazine, prototype(u"shelf"), number(1));

    EXPECT_EQ(validate(m_book, prototype(u"shelf"), number(2)), m_asked);
    EXPECT_EQ(validate(m_magazine, prototype(u"row"), number(2)), m_asked);
}

TEST_F(ValidatedExtensions, GiveWayToThatOfTheSameClassOrAbove)
{
    m_mine->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    EXPECT_EQ(validate(m_book, prototype(u"shelf"), number(1)), mine(u"shelf"));
    EXPECT_EQ(validate(m_novel, prototype(u"shelf"), number(1)), mine(u"shelf"));
}

TEST_F(ValidatedExtensions, ConflictWithThatOfAClassBelow)
{
    m_mine->extendMetaclass(m_novel, prototype(u"shelf"), number(1));

    EXPECT_FALSE(validate(m_book, prototype(u"shelf"), number(1)));
}

TEST_F(ValidatedExtensions, ConflictWithAnotherType)
{
    m_mine->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    EXPECT_FALSE(
        validate(m_book, prototype(u"shelf", u"Boolean"), Value(StandardTypes::booleanMeta, true)));
}

TEST_F(ValidatedExtensions, ConflictWithAnotherDefault)
{
    m_mine->extendMetaclass(m_book, prototype(u"shelf"), number(1));

    EXPECT_FALSE(validate(m_book, prototype(u"shelf"), number(2)));
}

TEST_F(ValidatedExtensions, ConflictWithASingleValueIfTheyHaveMany)
{
    m_mine->extendMetaclass(m_book, prototype(u"shelf"), number(1));
    m_mine->extendMetaclass(m_book, manyNumbers(u"pages"), boost::none);

    EXPECT_FALSE(validate(m_book, manyNumbers(u"shelf"), boost::none));
    EXPECT_FALSE(validate(m_book, prototype(u"pages"), number(1)));
}

TEST_F(ValidatedExtensions, NeedTheSameOrderAndUniquenessForManyValues)
{
    m_mine->extendMetaclass(m_book, manyNumbers(u"pages"), boost::none);
    ExtensionPrototype unordered = manyNumbers(u"pages");
    unordered.setIsOrdered(false);
    ExtensionPrototype unique = manyNumbers(u"pages");
    unique.setIsUnique(true);
    ExtensionPrototype bounded = manyNumbers(u"pages");
    bounded.setUpper(5);

    EXPECT_FALSE(validate(m_book, unordered, boost::none));
    EXPECT_FALSE(validate(m_book, unique, boost::none));
    EXPECT_EQ(validate(m_book, bounded, boost::none), mine(u"pages"));
}

TEST_F(ValidatedExtensions, NeedNoEqualDefaultsWhereTheTypeIsAClass)
{
    ExtensionPrototype const reference =
        prototype(u"friend", Node::metaClass()->getQualifiedName());
    m_mine->extendMetaclass(m_book, reference, boost::none);
    m_theirs->extendMetaclass(m_book, reference, boost::none);
    Node const node = Node::create(m_theirs);

    EXPECT_EQ(m_mine->validateExtension(m_theirs->getExtension(m_book, u"friend"),
                                        Value(Node::metaClass(), node)),
              mine(u"friend"));
}
}  // namespace
}  // namespace testkit

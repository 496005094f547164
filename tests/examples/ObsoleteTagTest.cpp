#include "ObsoleteTag.h"

#include "SearchInstances.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace {

using namespace tarn::kiln;
using debian::ObsoleteTag;
using test::LoadedModel;
using test::paragraph;
using testing::ElementsAre;
using testing::IsEmpty;

using Row = debian::Table::Row;

std::string const TEXT = paragraph("b-dev", "Provides: v-dev\n") + paragraph("a") +
                         paragraph("a-dev") + paragraph("developer");

template <class Form> class ObsoleteTagTest : public testing::Test
{
protected:
    Transaction begin() const { return index.model->beginTransaction(/*revertible=*/true); }

    LoadedModel<Form> const index{TEXT};
};
TYPED_TEST_SUITE(ObsoleteTagTest, test::BothForms, test::FormName);

TYPED_TEST(ObsoleteTagTest, IsOnNoPackageAtFirst)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);

    EXPECT_THAT(tag.packagesWithTag().rows(), IsEmpty());
}

TYPED_TEST(ObsoleteTagTest, IsFoundOnThePackagesThatMatch)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);
    Transaction const transaction = this->begin();

    std::size_t const count = tag.setOnMatching("-dev$");

    EXPECT_EQ(count, 3u);
    EXPECT_THAT(tag.packagesWithTag().rows(),
                ElementsAre(Row{"a-dev", "1"}, Row{"b-dev", "1"}, Row{"v-dev", "0"}));
}

TYPED_TEST(ObsoleteTagTest, StaysAfterACommit)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);
    {
        Transaction const transaction = this->begin();
        tag.setOnMatching("^a$");
        transaction.commit();
    }

    EXPECT_THAT(tag.packagesWithTag().rows(), ElementsAre(Row{"a", "1"}));
}

TYPED_TEST(ObsoleteTagTest, IsTakenBackByARollback)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);
    Transaction const transaction = this->begin();
    tag.setOnMatching("-dev$");

    transaction.rollBack();

    EXPECT_THAT(tag.packagesWithTag().rows(), IsEmpty());
    ModelElement const& package = this->index.package(u"a-dev");
    EXPECT_FALSE(package->hasNonDefaultExtension(ObsoleteTag<TypeParam>::NAME));
}

TYPED_TEST(ObsoleteTagTest, GoesWithTheObject)
{
    {
        ObsoleteTag<TypeParam> const tag(this->index.model);
        Transaction const transaction = this->begin();
        tag.setOnMatching("a");
        transaction.commit();
    }
    auto const packageClass = debian::Package<TypeParam>::metaClass();
    EXPECT_FALSE(this->index.model->getExtension(packageClass, ObsoleteTag<TypeParam>::NAME));

    ObsoleteTag<TypeParam> const anew(this->index.model);
    EXPECT_THAT(anew.packagesWithTag().rows(), IsEmpty());
}

TYPED_TEST(ObsoleteTagTest, IsSetOnNothingByWhatIsNoRegularExpression)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);
    Transaction const transaction = this->begin();

    EXPECT_THROW(tag.setOnMatching("[a"), std::runtime_error);

    EXPECT_THAT(tag.packagesWithTag().rows(), IsEmpty());
}

TYPED_TEST(ObsoleteTagTest, CanBeAskedForByItsDefault)
{
    ObsoleteTag<TypeParam> const tag(this->index.model);
    Transaction const transaction = this->begin();
    tag.setOnMatching("^a");

    query::AbstractQuery query(this->index.model);
    debian::Packages<TypeParam> packages({query, debian::EXACT});
    meta::Class const packageClass = debian::Package<TypeParam>::metaClass();
    packages.constrain(this->index.model->getExtension(packageClass, ObsoleteTag<TypeParam>::NAME),
                       query::ValueMatchRelation::equal,
                       Value(meta::StandardTypes::booleanMeta, false));

    std::vector<ustring> names;
    for (auto const& [package] : query.results(packages))
        names.push_back(package->getName());
    EXPECT_THAT(names, testing::UnorderedElementsAre(u"b-dev", u"v-dev", u"developer"));
}

TYPED_TEST(ObsoleteTagTest, BelongsToOneModel)
{
    LoadedModel<TypeParam> const other(TEXT);
    ObsoleteTag<TypeParam> const tag(this->index.model);
    ObsoleteTag<TypeParam> const otherTag(other.model);
    Transaction const transaction = this->begin();

    tag.setOnMatching("^a$");

    EXPECT_THAT(tag.packagesWithTag().rows(), ElementsAre(Row{"a", "1"}));
    EXPECT_THAT(otherTag.packagesWithTag().rows(), IsEmpty());
}

}  // namespace

#include "PackageGraph.h"

#include "ElementText.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using debian::PackageGraph;
using test::LoadedModel;
using test::paragraph;
using testing::ElementsAre;
using testing::UnorderedElementsAre;

template <test::ElementForm Form>
std::vector<std::string> removableWith(LoadedModel<Form> const& index,
                                       tarn::kiln::ustring const& leaf)
{
    std::vector<std::string> names;
    for (auto const& package :
         PackageGraph<Form>(index.loaded.index).removableWith(index.package(leaf)))
        names.push_back(debian::textOf<Form>(package));
    return names;
}

template <class Form> class PackageGraphTest : public testing::Test
{};
TYPED_TEST_SUITE(PackageGraphTest, test::BothForms, test::FormName);

TYPED_TEST(PackageGraphTest, RemovesWhatOnlyTheLeafNeeds)
{
    LoadedModel<TypeParam> const index(
        paragraph("leaf", "Depends: own, shared\n") + paragraph("own", "Pre-Depends: deep\n") +
        paragraph("deep") + paragraph("shared", "Depends: below\n") + paragraph("below") +
        paragraph("other", "Depends: shared\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "own", "deep"));
}

TYPED_TEST(PackageGraphTest, KeepsWhatOthersRecommend)
{
    LoadedModel<TypeParam> const index(paragraph("leaf", "Depends: liked, named\n") +
                                       paragraph("liked") + paragraph("named") +
                                       paragraph("other", "Recommends: liked\nSuggests: named\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "named"));
}

TYPED_TEST(PackageGraphTest, RemovesPackagesThatNeedEachOther)
{
    LoadedModel<TypeParam> const index(paragraph("leaf", "Depends: one\n") +
                                       paragraph("one", "Depends: two\n") +
                                       paragraph("two", "Depends: one\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), UnorderedElementsAre("leaf", "one", "two"));
}

TYPED_TEST(PackageGraphTest, KeepsACircleThatIsUsedFromOutside)
{
    LoadedModel<TypeParam> const index(
        paragraph("leaf", "Depends: one\n") + paragraph("one", "Depends: two\n") +
        paragraph("two", "Depends: one\n") + paragraph("other", "Depends: two\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf"));
}

TYPED_TEST(PackageGraphTest, FollowsProviders)
{
    LoadedModel<TypeParam> const index(
        paragraph("leaf", "Depends: mail\n") + paragraph("exim", "Provides: mail\n") +
        paragraph("postfix", "Provides: mail\n") + paragraph("other", "Depends: postfix\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "exim"));
}

TYPED_TEST(PackageGraphTest, KeepsEssentialPackages)
{
    LoadedModel<TypeParam> const index(paragraph("leaf", "Depends: base\n") +
                                       paragraph("base", "Essential: yes\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf"));
}

TYPED_TEST(PackageGraphTest, ChoosesTheLeafWithWhichMostCanGo)
{
    LoadedModel<TypeParam> const index(
        paragraph("alone") + paragraph("big", "Depends: one, two\n") + paragraph("one") +
        paragraph("two") + paragraph("small", "Depends: x\n") + paragraph("x"));

    EXPECT_EQ(debian::textOf<TypeParam>(PackageGraph<TypeParam>(index.loaded.index).chooseLeaf()),
              "big");
}

TYPED_TEST(PackageGraphTest, HasNoLeafIfAllAreUsedOrEssential)
{
    LoadedModel<TypeParam> const index(paragraph("base", "Essential: yes\n") +
                                       paragraph("one", "Depends: two\n") +
                                       paragraph("two", "Depends: one\n"));

    EXPECT_FALSE(PackageGraph<TypeParam>(index.loaded.index).chooseLeaf());
}

}  // namespace

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

std::vector<std::string> removableWith(LoadedModel const& index, tarn::kiln::ustring const& leaf)
{
    std::vector<std::string> names;
    for (auto const& package : PackageGraph(index.loaded.index).removableWith(index.package(leaf)))
        names.push_back(debian::textOf(package));
    return names;
}

TEST(PackageGraph, RemovesWhatOnlyTheLeafNeeds)
{
    LoadedModel const index(paragraph("leaf", "Depends: own, shared\n") +
                            paragraph("own", "Pre-Depends: deep\n") + paragraph("deep") +
                            paragraph("shared", "Depends: below\n") + paragraph("below") +
                            paragraph("other", "Depends: shared\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "own", "deep"));
}

TEST(PackageGraph, KeepsWhatOthersRecommend)
{
    LoadedModel const index(paragraph("leaf", "Depends: liked, named\n") + paragraph("liked") +
                            paragraph("named") +
                            paragraph("other", "Recommends: liked\nSuggests: named\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "named"));
}

TEST(PackageGraph, RemovesPackagesThatNeedEachOther)
{
    LoadedModel const index(paragraph("leaf", "Depends: one\n") +
                            paragraph("one", "Depends: two\n") +
                            paragraph("two", "Depends: one\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), UnorderedElementsAre("leaf", "one", "two"));
}

TEST(PackageGraph, KeepsACircleThatIsUsedFromOutside)
{
    LoadedModel const index(
        paragraph("leaf", "Depends: one\n") + paragraph("one", "Depends: two\n") +
        paragraph("two", "Depends: one\n") + paragraph("other", "Depends: two\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf"));
}

TEST(PackageGraph, FollowsProviders)
{
    LoadedModel const index(
        paragraph("leaf", "Depends: mail\n") + paragraph("exim", "Provides: mail\n") +
        paragraph("postfix", "Provides: mail\n") + paragraph("other", "Depends: postfix\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf", "exim"));
}

TEST(PackageGraph, KeepsEssentialPackages)
{
    LoadedModel const index(paragraph("leaf", "Depends: base\n") +
                            paragraph("base", "Essential: yes\n"));

    EXPECT_THAT(removableWith(index, u"leaf"), ElementsAre("leaf"));
}

TEST(PackageGraph, ChoosesTheLeafWithWhichMostCanGo)
{
    LoadedModel const index(paragraph("alone") + paragraph("big", "Depends: one, two\n") +
                            paragraph("one") + paragraph("two") +
                            paragraph("small", "Depends: x\n") + paragraph("x"));

    EXPECT_EQ(debian::textOf(PackageGraph(index.loaded.index).chooseLeaf()), "big");
}

TEST(PackageGraph, HasNoLeafIfAllAreUsedOrEssential)
{
    LoadedModel const index(paragraph("base", "Essential: yes\n") +
                            paragraph("one", "Depends: two\n") +
                            paragraph("two", "Depends: one\n"));

    EXPECT_FALSE(PackageGraph(index.loaded.index).chooseLeaf());
}

}  // namespace

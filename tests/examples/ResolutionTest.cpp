#include "Resolution.h"

#include "ModelSnapshot.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/examples/LoadText.h"

#include <gtest/gtest.h>

namespace {

using namespace tarn::kiln;
using test::LoadedModel;
using test::paragraph;

std::string const TEXT = paragraph("a", "Depends: here | there, nowhere\n") +
                         paragraph("b", "Depends: there, a\n") + paragraph("here");

template <test::ElementForm Form>
debian::LoadResult<Form> loadAvailable(LoadedModel<Form> const& index, std::string const& text)
{
    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(u"packages:available");
    return test::loadText<Form>(available, text);
}

template <class Form> class ResolutionTest : public testing::Test
{};
TYPED_TEST_SUITE(ResolutionTest, test::BothForms, test::FormName);

TYPED_TEST(ResolutionTest, LeadsMissingPackagesToTheOtherModel)
{
    LoadedModel<TypeParam> const index(TEXT);
    auto const available = loadAvailable(index, paragraph("there") + paragraph("here"));

    debian::Resolution const resolution = debian::resolveTargets<TypeParam>(index.loaded.index);

    EXPECT_EQ(resolution.found, 1u);
    EXPECT_EQ(resolution.notFound, 1u);
    EXPECT_EQ(index.alternative(u"a", 0, 0)->getTargetImpl(), index.package(u"here").getImpl());
    EXPECT_EQ(index.alternative(u"a", 0, 1)->getTargetImpl(),
              available.index->getPackages().find(u"there").getImpl());
}

TYPED_TEST(ResolutionTest, FindsNothingWithoutTheOtherModel)
{
    LoadedModel<TypeParam> const index(TEXT);

    debian::Resolution const resolution = debian::resolveTargets<TypeParam>(index.loaded.index);

    EXPECT_EQ(resolution.found, 0u);
    EXPECT_EQ(resolution.notFound, 2u);
}

TYPED_TEST(ResolutionTest, IsNoChange)
{
    LoadedModel<TypeParam> const index(TEXT);
    loadAvailable(index, paragraph("there"));
    debian::ModelSnapshot const before(index.model);

    debian::resolveTargets<TypeParam>(index.loaded.index);

    EXPECT_EQ(debian::ModelSnapshot(index.model), before);
}

}  // namespace

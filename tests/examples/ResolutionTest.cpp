#include "Resolution.h"

#include "ModelSnapshot.h"
#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/examples/LoadText.h"

#include <gtest/gtest.h>

namespace {

using namespace tarn::kiln;
using test::LoadedModel;
using test::paragraph;

std::string const TEXT = paragraph("a", "Depends: here | there, nowhere\n") +
                         paragraph("b", "Depends: there, a\n") + paragraph("here");

debian::LoadResult loadAvailable(LoadedModel const& index, std::string const& text)
{
    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(u"packages:available");
    return test::loadText(available, text);
}

TEST(Resolution, LeadsMissingPackagesToTheOtherModel)
{
    LoadedModel const index(TEXT);
    auto const available = loadAvailable(index, paragraph("there") + paragraph("here"));

    debian::Resolution const resolution = debian::resolveTargets(index.loaded.index);

    EXPECT_EQ(resolution.found, 1u);
    EXPECT_EQ(resolution.notFound, 1u);
    auto const& alternatives = index.release(u"a")->getGroups().at(0)->getAlternatives();
    EXPECT_EQ(alternatives.at(0)->getTargetImpl(), index.package(u"here").getImpl());
    EXPECT_EQ(alternatives.at(1)->getTargetImpl(),
              available.index->getPackages().find(u"there").getImpl());
}

TEST(Resolution, FindsNothingWithoutTheOtherModel)
{
    LoadedModel const index(TEXT);

    debian::Resolution const resolution = debian::resolveTargets(index.loaded.index);

    EXPECT_EQ(resolution.found, 0u);
    EXPECT_EQ(resolution.notFound, 2u);
}

TEST(Resolution, IsNoChange)
{
    LoadedModel const index(TEXT);
    loadAvailable(index, paragraph("there"));
    debian::ModelSnapshot const before(index.model);

    debian::resolveTargets(index.loaded.index);

    EXPECT_EQ(debian::ModelSnapshot(index.model), before);
}

}  // namespace

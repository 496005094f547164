#include "Questions.h"

#include "AvailableModel.h"
#include "Dependencies.h"
#include "ElementText.h"
#include "ModelSnapshot.h"
#include "Resolution.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace {

using namespace tarn::kiln;
using debian::MissingNames;
using debian::RECOMMENDED_KIND;
using debian::STRICT_KINDS;
using test::paragraph;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

using Row = debian::Table::Row;

std::string const TEXT =
    paragraph("editor", "Maintainer: Ann\nInstalled-Size: 300\n"
                        "Depends: spell, lib (>= 2), gone | lost (>= 3)\nRecommends: manual\n") +
    paragraph("spell", "Maintainer: Ann\nInstalled-Size: 40\nPre-Depends: lib\n"
                       "Depends: words, editor\n") +
    paragraph("lib", "Maintainer: Bob\nInstalled-Size: 5000\nSuggests: lib-extra\n") +
    paragraph("lib-extra", "Maintainer: Bob\nInstalled-Size: 300\nProvides: words\n"
                           "Depends: lib (<< 2), lib (>= 1)\n") +
    paragraph("plain", "Depends: lib-extra (= 2) | words (>= 7), bare\nRecommends: spell\n") +
    paragraph("bare");

template <debian::ElementForm Form> struct AskedModel : test::LoadedModel<Form>
{
    explicit AskedModel(std::string const& text = TEXT)
        : test::LoadedModel<Form>(text),
          questions(this->loaded.index, MissingNames(this->loaded.missing))
    {}

    debian::Questions<Form> questions;
};

template <class Form> class QuestionsTest : public testing::Test
{};
TYPED_TEST_SUITE(QuestionsTest, test::BothForms, test::FormName);

TYPED_TEST(QuestionsTest, FindDependenciesThatNothingSatisfies)
{
    AskedModel<TypeParam> const index;

    EXPECT_THAT(index.questions.unmetDependencies(STRICT_KINDS).rows(),
                ElementsAre(Row{"editor", "1 all", "Depends: gone | lost (>= 3)"},
                            Row{"editor", "1 all", "Depends: lib (>= 2)"}));
    EXPECT_THAT(index.questions.unmetDependencies(RECOMMENDED_KIND).rows(),
                ElementsAre(Row{"editor", "1 all", "Recommends: manual"}));
}

TYPED_TEST(QuestionsTest, AgreeWithTheReleasesThatSatisfyADependency)
{
    AskedModel<TypeParam> const index;

    std::vector<std::string> unmet;
    debian::forEachRelease<TypeParam>(index.loaded.index, [&](auto const& release) {
        for (auto const& group : debian::strictGroupsOf<TypeParam>(release))
        {
            if (debian::satisfiersOf<TypeParam>(group).empty())
                unmet.push_back(debian::textOf<TypeParam>(release->getPackage()));
        }
    });

    debian::Table const table = index.questions.unmetDependencies(STRICT_KINDS);
    std::vector<std::string> found;
    for (Row const& row : table.rows())
        found.push_back(row[0]);
    EXPECT_THAT(found, testing::UnorderedElementsAreArray(unmet));
    EXPECT_EQ(unmet.size(), 2u);
}

TYPED_TEST(QuestionsTest, CountAPackageOfTheOtherModelAsMissing)
{
    AskedModel<TypeParam> const index;
    auto const before = index.questions.unmetDependencies(STRICT_KINDS).rows();
    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(debian::AVAILABLE_URI);
    auto const other = test::loadText<TypeParam>(available, paragraph("gone"));
    ASSERT_EQ(debian::resolveTargets<TypeParam>(index.loaded.index).found, 1u);

    EXPECT_EQ(index.questions.unmetDependencies(STRICT_KINDS).rows(), before);
}

TYPED_TEST(QuestionsTest, FindDependenciesAmongPackagesOfAMaintainer)
{
    AskedModel<TypeParam> const index;

    EXPECT_THAT(index.questions.dependenciesOfSameMaintainer().rows(),
                ElementsAre(Row{"editor", "spell", "Ann"}, Row{"lib-extra", "lib", "Bob"},
                            Row{"spell", "editor", "Ann"}));
}

TYPED_TEST(QuestionsTest, PutTheLargestPackageFirst)
{
    AskedModel<TypeParam> const index;

    EXPECT_THAT(index.questions.largestPackages("^l.b").rows(),
                ElementsAre(Row{"lib", "1 all", "5000"}, Row{"lib-extra", "1 all", "300"}));
    EXPECT_THAT(index.questions.largestPackages("").rows(),
                ElementsAre(Row{"lib", "1 all", "5000"}, Row{"editor", "1 all", "300"},
                            Row{"lib-extra", "1 all", "300"}, Row{"spell", "1 all", "40"}));
    EXPECT_THAT(index.questions.largestPackages("nothing").rows(), IsEmpty());
}

TYPED_TEST(QuestionsTest, TellReleasesOfAPackageApart)
{
    AskedModel<TypeParam> const index(
        "Package: a\nVersion: 1\nArchitecture: amd64\nInstalled-Size: 9\n\n"
        "Package: a\nVersion: 2\nArchitecture: i386\nInstalled-Size: 10\n\n");

    EXPECT_THAT(index.questions.largestPackages("a").rows(),
                ElementsAre(Row{"a", "2 i386", "10"}, Row{"a", "1 amd64", "9"}));
}

TYPED_TEST(QuestionsTest, FindTheDependenciesThatNameAPackage)
{
    AskedModel<TypeParam> const index;

    EXPECT_THAT(index.questions.reverseDependencies("lib").rows(),
                ElementsAre(Row{"editor", "1 all", "Depends: lib (>= 2)"},
                            Row{"lib-extra", "1 all", "Depends: lib (<< 2)"},
                            Row{"lib-extra", "1 all", "Depends: lib (>= 1)"},
                            Row{"spell", "1 all", "Pre-Depends: lib"}));
    EXPECT_THAT(index.questions.reverseDependencies("spell").rows(),
                ElementsAre(Row{"editor", "1 all", "Depends: spell"},
                            Row{"plain", "1 all", "Recommends: spell"}));
    EXPECT_THAT(index.questions.reverseDependencies("plain").rows(), IsEmpty());
}

TYPED_TEST(QuestionsTest, FindTheDependenciesThatNameAVirtualPackage)
{
    AskedModel<TypeParam> const index;

    EXPECT_THAT(index.questions.reverseDependencies("words").rows(),
                ElementsAre(Row{"plain", "1 all", "Depends: lib-extra (= 2) | words (>= 7)"},
                            Row{"spell", "1 all", "Depends: words"}));
}

TYPED_TEST(QuestionsTest, FindTheDependenciesThatNameAMissingPackage)
{
    AskedModel<TypeParam> const index;
    std::vector<Row> const expected = {{"editor", "1 all", "Depends: gone | lost (>= 3)"}};

    EXPECT_EQ(index.questions.reverseDependencies("gone").rows(), expected);
    EXPECT_EQ(index.questions.reverseDependencies("lost").rows(), expected);

    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(debian::AVAILABLE_URI);
    auto const other = test::loadText<TypeParam>(available, paragraph("gone"));
    ASSERT_EQ(debian::resolveTargets<TypeParam>(index.loaded.index).found, 1u);
    EXPECT_EQ(index.questions.reverseDependencies("gone").rows(), expected);
}

TYPED_TEST(QuestionsTest, TellADependencyOnceThatNamesAPackageTwice)
{
    AskedModel<TypeParam> const index(paragraph("a") +
                                      paragraph("b", "Depends: a (<< 1) | a (>> 1)\n"));

    EXPECT_THAT(index.questions.reverseDependencies("a").rows(),
                ElementsAre(Row{"b", "1 all", "Depends: a (<< 1) | a (>> 1)"}));
}

TYPED_TEST(QuestionsTest, KnowThePackageThatMostDependenciesName)
{
    AskedModel<TypeParam> const index;
    AskedModel<TypeParam> const even(paragraph("b") + paragraph("a") +
                                     paragraph("c", "Depends: b, a\n"));
    AskedModel<TypeParam> const alone(paragraph("a", "Depends: gone\n"));

    EXPECT_EQ(index.questions.mostNamedPackage(), "lib");
    EXPECT_EQ(even.questions.mostNamedPackage(), "a");
    EXPECT_EQ(alone.questions.mostNamedPackage(), "");
}

TYPED_TEST(QuestionsTest, RefuseWhatIsNoRegularExpression)
{
    AskedModel<TypeParam> const index;

    try
    {
        index.questions.largestPackages("(lib");
        ADD_FAILURE() << "nothing was raised";
    }
    catch (std::runtime_error const& error)
    {
        EXPECT_THAT(error.what(), HasSubstr("\"(lib\""));
    }
}

TYPED_TEST(QuestionsTest, RefuseNamesThatNobodyKnows)
{
    AskedModel<TypeParam> const index;

    for (std::string const name : {"nothing", "li", ""})
    {
        try
        {
            index.questions.reverseDependencies(name);
            ADD_FAILURE() << "nothing was raised for " << name;
        }
        catch (std::runtime_error const& error)
        {
            EXPECT_EQ(error.what(), "neither a package nor a dependency is called \"" + name + '"');
        }
    }
}

TYPED_TEST(QuestionsTest, ChangeNothing)
{
    AskedModel<TypeParam> const index;
    debian::ModelSnapshot const before(index.model);

    index.questions.unmetDependencies(STRICT_KINDS);
    index.questions.dependenciesOfSameMaintainer();
    index.questions.reverseDependencies("lib");

    EXPECT_EQ(debian::ModelSnapshot(index.model), before);
}

}  // namespace

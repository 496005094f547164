#include "Loader.h"

#include "ModelSnapshot.h"
#include "reader/ReadError.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tests/examples/LoadText.h"
#include "tests/examples/ReadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

namespace {

using namespace tarn::kiln;
using debian::ModelSnapshot;
using test::ElementForm;
using test::LoadedModel;
using test::paragraph;
using testing::ElementsAre;
using testing::IsEmpty;

/// Loads a text that is expected to fail.
template <ElementForm Form> class FailingLoad
{
public:
    explicit FailingLoad(Model const& model) : m_model(model) {}
    void operator()(std::string const& text) const { test::loadText<Form>(m_model, text); }

private:
    Model m_model;
};

template <class Form> class LoaderTest : public testing::Test
{};
TYPED_TEST_SUITE(LoaderTest, test::BothForms, test::FormName);

TYPED_TEST(LoaderTest, KeepsWhatTheParagraphSays)
{
    LoadedModel<TypeParam> const loaded(
        "Package: tool\nVersion: 1:2.0-3\nArchitecture: amd64\n"
        "Section: utils\nMaintainer: J\xC3\xBCrgen <j@example.org>\n"
        "Installed-Size: 12\nEssential: yes\nDescription: does it\n more\n");

    auto const release = loaded.release(u"tool");

    EXPECT_EQ(release->getLabel(), u"1:2.0-3 amd64");
    EXPECT_EQ(release->getVersion(), u"1:2.0-3");
    EXPECT_EQ(release->getArchitecture(), u"amd64");
    EXPECT_EQ(release->getSection(), u"utils");
    EXPECT_EQ(release->getMaintainer(), u"J\u00fcrgen <j@example.org>");
    EXPECT_EQ(release->getSummary(), u"does it");
    EXPECT_EQ(release->getInstalledSize().value_or(0), 12);
    EXPECT_TRUE(release->isEssential());
    EXPECT_EQ(release->getPackage(), loaded.package(u"tool"));
}

TYPED_TEST(LoaderTest, KeepsReleasesOfAPackageApart)
{
    LoadedModel<TypeParam> const loaded("Package: a\nVersion: 1\nArchitecture: amd64\n\n"
                                        "Package: a\nVersion: 1\nArchitecture: i386\n\n"
                                        "Package: a\nVersion: 2\nArchitecture: amd64\n");

    std::vector<ustring> labels;
    for (auto const& release : debian::members(loaded.package(u"a")->getReleases()))
        labels.push_back(release->getLabel());

    EXPECT_THAT(labels, ElementsAre(u"1 amd64", u"1 i386", u"2 amd64"));
    EXPECT_EQ(loaded.loaded.index->getPackages().size(), 1u);
}

TYPED_TEST(LoaderTest, CountsARepeatedReleaseAndKeepsTheFirst)
{
    LoadedModel<TypeParam> const loaded(paragraph("a", "Section: first\nDepends: a\n") +
                                        paragraph("a", "Section: second\nDepends: b\n"));

    EXPECT_EQ(loaded.loaded.releases, 1u);
    EXPECT_EQ(loaded.loaded.repeated, 1u);
    EXPECT_EQ(loaded.release(u"a")->getSection(), u"first");
    EXPECT_THAT(loaded.loaded.missing, IsEmpty());
}

TYPED_TEST(LoaderTest, KeepsDependenciesInTheirOrder)
{
    LoadedModel<TypeParam> const loaded(paragraph("a",
                                                  "Depends: b (>= 2) | c, d\nPre-Depends: e\n"
                                                  "Recommends: f\nSuggests: g\nConflicts: h\n"));

    std::vector<ustring> kinds;
    for (auto const& group : debian::members(loaded.release(u"a")->getGroups()))
        kinds.push_back(group->getKind());

    EXPECT_THAT(kinds,
                ElementsAre(u"Pre-Depends", u"Depends", u"Depends", u"Recommends", u"Suggests"));
    EXPECT_EQ(loaded.loaded.groups, 5u);
    EXPECT_EQ(loaded.loaded.alternatives, 6u);
    EXPECT_EQ(loaded.alternative(u"a", 1, 0)->getRelation(), u">=");
    EXPECT_EQ(loaded.alternative(u"a", 1, 0)->getBound(), u"2");
    EXPECT_EQ(loaded.alternative(u"a", 1, 1)->getRelation(), u"");
    EXPECT_THAT(loaded.loaded.missing, ElementsAre("b", "c", "d", "e", "f", "g"));
}

TYPED_TEST(LoaderTest, FindsPackagesBeforeAndBehindTheirUsers)
{
    LoadedModel<TypeParam> const loaded(paragraph("a") + paragraph("b", "Depends: a, c\n") +
                                        paragraph("c"));

    EXPECT_EQ(loaded.alternative(u"b", 0, 0)->getTarget(), loaded.package(u"a"));
    EXPECT_EQ(loaded.alternative(u"b", 1, 0)->getTarget(), loaded.package(u"c"));
    EXPECT_THAT(loaded.loaded.missing, IsEmpty());
}

TYPED_TEST(LoaderTest, MakesOneProxyForEachMissingName)
{
    LoadedModel<TypeParam> const loaded(paragraph("a", "Depends: gone | other\n") +
                                        paragraph("b", "Depends: gone\n"));

    auto* const target = loaded.alternative(u"a", 0, 0)->getTargetImpl();

    ASSERT_TRUE(target->isProxy());
    EXPECT_EQ(target->getProxyId()->getModelId().value_or(u""), u"packages:available");
    EXPECT_EQ(loaded.alternative(u"b", 0, 0)->getTargetImpl(), target);
    EXPECT_NE(loaded.alternative(u"a", 0, 1)->getTargetImpl(), target);
    EXPECT_THAT(loaded.loaded.missing, ElementsAre("gone", "other"));
    EXPECT_FALSE(loaded.package(u"gone"));
}

TYPED_TEST(LoaderTest, MakesVirtualPackagesOfWhatIsProvided)
{
    LoadedModel<TypeParam> const loaded(paragraph("a", "Provides: mail, post (= 2)\n") +
                                        paragraph("b", "Provides: mail\nDepends: mail\n"));

    auto const mail = loaded.package(u"mail");

    ASSERT_TRUE(mail);
    EXPECT_EQ(mail->getReleases().size(), 0u);
    ASSERT_EQ(mail->getProviders().size(), 2u);
    EXPECT_EQ(mail->getProviders().at(0), loaded.release(u"a"));
    EXPECT_EQ(mail->getProviders().at(1), loaded.release(u"b"));
    EXPECT_EQ(loaded.release(u"a")->getProvides().at(1), loaded.package(u"post"));
    EXPECT_EQ(loaded.alternative(u"b", 0, 0)->getTarget(), mail);
}

TYPED_TEST(LoaderTest, GivesTheSameIdentifiersEachTime)
{
    std::string const text = paragraph("a", "Depends: b | c, d\nProvides: v\n") + paragraph("b");
    LoadedModel<TypeParam> const first(text);
    LoadedModel<TypeParam> const second(text);

    EXPECT_EQ(ModelSnapshot(first.model), ModelSnapshot(second.model));
}

TYPED_TEST(LoaderTest, LeavesAConsistentModel)
{
    LoadedModel<TypeParam> const loaded(paragraph("a", "Depends: b | gone, d\nProvides: v\n") +
                                        paragraph("b", "Provides: v, d\n"));

    EXPECT_THAT(loaded.model->checkInvariants(), IsEmpty());
}

TYPED_TEST(LoaderTest, TellsOfItsProgress)
{
    std::string const text = paragraph("a") + paragraph("b");
    std::istringstream stream(text);
    debian::ControlFile file(stream, "index");
    std::vector<std::size_t> calls;
    debian::Loader<TypeParam> loader(Model::create(ModelConstellation()));

    loader.load(file, [&](std::size_t bytes) { calls.push_back(bytes); });

    EXPECT_THAT(calls, ElementsAre(text.size(), text.size()));
}

template <class Form> class LoaderFailure : public testing::Test
{
protected:
    LoaderFailure() : model(Model::create(ModelConstellation()))
    {
        stranger = debian::Package<Form>::create(model);
        stranger->setName(u"stranger");
    }

    Model model;
    debian::Package<Form> stranger;
};
TYPED_TEST_SUITE(LoaderFailure, test::BothForms, test::FormName);

TYPED_TEST(LoaderFailure, LeavesTheModelAsItWas)
{
    ModelSnapshot const before(this->model);
    std::string const good = paragraph("a", "Depends: b\nProvides: c\n");
    std::string const texts[] = {"", good + "Package: cut", good + "no colon\n",
                                 good + "Package: b\nVersion: 1\n",
                                 good + paragraph("b", "Depends: a (>= )\n")};

    for (std::string const& text : texts)
    {
        test::errorOf(FailingLoad<TypeParam>(this->model), text);

        EXPECT_EQ(ModelSnapshot(this->model), before) << text;
        EXPECT_THAT(this->model->checkInvariants(), IsEmpty()) << text;
    }
    EXPECT_EQ(this->model->getElementCount(), 1u);
}

TYPED_TEST(LoaderFailure, NamesFileLineAndReason)
{
    EXPECT_EQ(test::errorOf(FailingLoad<TypeParam>(this->model), paragraph("a") + "nonsense\n"),
              "index:5: line has no colon after a field name");
}

TYPED_TEST(LoaderFailure, LetsTheNextLoadSucceed)
{
    test::errorOf(FailingLoad<TypeParam>(this->model), paragraph("a") + "nonsense\n");

    auto const loaded = test::loadText<TypeParam>(this->model, paragraph("a"));

    EXPECT_EQ(loaded.releases, 1u);
    EXPECT_THAT(this->model->checkInvariants(), IsEmpty());
}

/// Refuses everything.
class Refuser : public Listener
{
public:
    bool transactionValidating(ReportData& /*report*/) { return false; }
};

TYPED_TEST(LoaderFailure, IsRaisedIfAListenerRefusesTheIndex)
{
    ModelSnapshot const before(this->model);
    Refuser refuser;
    this->model->addListener(&refuser);

    EXPECT_THROW(test::loadText<TypeParam>(this->model, paragraph("a")), std::runtime_error);

    this->model->removeListener(&refuser);
    EXPECT_EQ(ModelSnapshot(this->model), before);
}

}  // namespace

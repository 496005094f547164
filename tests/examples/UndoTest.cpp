#include "Undo.h"

#include "ChangeReport.h"
#include "ModelSnapshot.h"
#include "Removal.h"
#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <sstream>

namespace {

using namespace tarn::kiln;
using debian::ModelSnapshot;
using test::paragraph;
using testing::HasSubstr;
using testing::IsEmpty;

/// An index whose last change is recorded.
class RecordedModel : public test::LoadedModel
{
public:
    explicit RecordedModel(std::string const& text) : LoadedModel(text)
    {
        model->addListener(&recorder);
    }
    ~RecordedModel() { model->removeListener(&recorder); }

    /// Makes a change and returns its report.
    ReportData change(std::function<void()> const& step)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        step();
        EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
        return *recorder.last();
    }
    ReportData remove(std::vector<debian::model::Package> const& packages)
    {
        return change([&] { debian::removePackages(packages); });
    }

    /// Makes a change, takes it back and expects all to be as before.
    void expectUndone(std::function<void()> const& step)
    {
        ModelSnapshot const before(model);
        ReportData const report = change(step);
        EXPECT_NE(ModelSnapshot(model), before);

        debian::undo(report);

        EXPECT_THAT(before.differences(ModelSnapshot(model), 10), IsEmpty());
        EXPECT_EQ(ModelSnapshot(model), before);
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
    }

    debian::ChangeRecorder recorder;
};

std::string const TEXT = paragraph("a", "Depends: b (>= 1) | c, gone\nProvides: v, w\n") +
                         paragraph("b", "Installed-Size: 5\nProvides: v, a\n") +
                         paragraph("c", "Suggests: a\nProvides: w, v\n");

TEST(Undo, BringsBackEachPackage)
{
    for (ustring const name : {u"a", u"b", u"c", u"v", u"w"})
    {
        RecordedModel index(TEXT);
        index.expectUndone([&] { index.package(name)->destroy(); });
    }
}

TEST(Undo, BringsBackSeveralPackages)
{
    RecordedModel index(TEXT);

    index.expectUndone([&] { debian::removePackages({index.package(u"a"), index.package(u"b")}); });
}

TEST(Undo, BringsBackAllPackages)
{
    RecordedModel index(TEXT);

    index.expectUndone([&] { index.loaded.index->getPackages().destroyAllContents(); });
}

TEST(Undo, BringsBackTheIndex)
{
    RecordedModel index(TEXT);

    index.expectUndone([&] { index.loaded.index->destroy(); });
}

TEST(Undo, BringsBackTheMiddleOfAnOrder)
{
    RecordedModel index(paragraph("a", "Depends: b, c, d, e\n"));

    index.expectUndone([&] {
        auto const release = index.release(u"a");
        release->getGroups().at(1)->destroy();
        release->getGroups().at(1)->destroy();
    });
}

TEST(Undo, RestoresPlainValuesAndReferencesOfWhatChanged)
{
    RecordedModel index(TEXT);

    index.expectUndone([&] {
        auto const release = index.release(u"a");
        release->setSummary(u"another");
        release->setInstalledSize(7);
        release->setIsEssential(true);
        release->getProvides().remove(index.package(u"v"));
        release->getGroups().at(0)->getAlternatives().at(0)->setTarget(index.package(u"c"));
        index.release(u"b")->setInstalledSize(boost::none);
    });
}

TEST(Undo, DestroysWhatWasCreated)
{
    RecordedModel index(TEXT);

    index.expectUndone([&] {
        auto const added = debian::model::Package::create(index.model);
        added->setName(u"added");
        added->setIndex(index.loaded.index);
        index.release(u"a")->getProvides().push_back(added);
    });
}

TEST(Undo, TurnsReferencesToTheNewElement)
{
    RecordedModel index(paragraph("a", "Suggests: b\n") + paragraph("b"));
    auto const old = index.package(u"b");
    auto const suggestion = index.release(u"a")->getGroups().at(0)->getAlternatives().at(0);
    ReportData const report = index.remove({old});
    ASSERT_FALSE(suggestion->getTarget());

    debian::undo(report);

    EXPECT_TRUE(suggestion->getTarget());
    EXPECT_EQ(suggestion->getTarget(), index.package(u"b"));
    EXPECT_EQ(index.package(u"b")->getUuid(), old->getUuid());
    EXPECT_FALSE(old);
}

TEST(Undo, KeepsTheProxiesOfWhatIsMissing)
{
    RecordedModel index(paragraph("a", "Depends: gone\n") + paragraph("b", "Depends: gone\n"));
    auto const targetOf = [&](ustring const& name) {
        return index.release(name)->getGroups().at(0)->getAlternatives().at(0)->getTargetImpl();
    };
    auto* const proxy = targetOf(u"b");

    debian::undo(index.remove({index.package(u"a")}));

    EXPECT_EQ(targetOf(u"a"), proxy);
}

TEST(Undo, KeepsReferencesToTheOtherModel)
{
    RecordedModel index(paragraph("a", "Depends: gone\n"));
    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(u"packages:available");
    auto const other = test::loadText(available, paragraph("gone"));
    auto const target = other.index->getPackages().find(u"gone");
    ASSERT_EQ(index.release(u"a")->getGroups().at(0)->getAlternatives().at(0)->getTarget(), target);

    index.expectUndone([&] { index.package(u"a")->destroy(); });

    EXPECT_EQ(index.release(u"a")->getGroups().at(0)->getAlternatives().at(0)->getTarget(), target);
}

/// Refuses everything.
class Refuser : public Listener
{
public:
    bool transactionValidating(ReportData& /*report*/) { return false; }
};

TEST(Undo, LeavesTheModelAsItIsWhenItIsRefused)
{
    RecordedModel index(TEXT);
    ReportData const report = index.remove({index.package(u"a")});
    ModelSnapshot const after(index.model);
    Refuser refuser;
    index.model->addListener(&refuser);

    EXPECT_THROW(debian::undo(report), std::runtime_error);

    index.model->removeListener(&refuser);
    EXPECT_EQ(ModelSnapshot(index.model), after);
}

TEST(ChangeReport, TellsOldValuesOfWhatWasDestroyed)
{
    RecordedModel index(TEXT);
    ReportData const report = index.remove({index.package(u"c")});
    std::ostringstream output;

    debian::printReport(output, report, /*maxLines=*/100);

    EXPECT_THAT(output.str(), HasSubstr("changed Package w; had providers = {a 1 all, c 1 all}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Package c; had releases = {c 1 all}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Release c 1 all; had groups = {Suggests: a}, "
                                        "provides = {w, v}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Alternative a; had target = a\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed 4 elements: 1 Alternative, 1 DependencyGroup, "
                                        "1 Package, 1 Release\n"));
}

TEST(ChangeReport, CountsTheLinesThatItLeavesOut)
{
    RecordedModel index(TEXT);
    ReportData const report = index.remove({index.package(u"c")});
    std::ostringstream output;

    debian::printReport(output, report, /*maxLines=*/2);

    EXPECT_THAT(output.str(), HasSubstr("    and 5 lines more\n"));
    EXPECT_THAT(output.str(), testing::Not(HasSubstr("destroyed Release")));
}

TEST(ModelSnapshot, TellsWhichElementsDiffer)
{
    RecordedModel index(TEXT);
    ModelSnapshot const before(index.model);
    auto const release = index.release(u"a");
    index.change([&] { release->setSummary(u"another"); });

    auto const differences = before.differences(ModelSnapshot(index.model), 10);

    ASSERT_EQ(differences.size(), 1u);
    EXPECT_THAT(differences[0], HasSubstr(" differs"));
}

TEST(ModelSnapshot, SeesEachKindOfChange)
{
    std::function<void(RecordedModel&)> const changes[] = {
        [](RecordedModel& index) { index.release(u"a")->setIsEssential(true); },
        [](RecordedModel& index) { index.release(u"a")->setInstalledSize(0); },
        [](RecordedModel& index) {
            index.release(u"a")->getProvides().ensureAt(0, index.package(u"w"));
        },
        [](RecordedModel& index) { index.release(u"a")->setPackage(debian::model::Package()); },
        [](RecordedModel& index) { index.package(u"a")->destroy(); },
        [](RecordedModel& index) { debian::model::Package::create(index.model); },
        [](RecordedModel& index) {
            index.release(u"a")->getGroups().at(0)->getAlternatives().at(0)->setTarget(
                debian::model::Package());
        },
    };

    for (auto const& step : changes)
    {
        RecordedModel index(TEXT);
        ModelSnapshot const before(index.model);
        index.change([&] { step(index); });
        EXPECT_NE(ModelSnapshot(index.model), before) << &step - changes;
    }
}

}  // namespace

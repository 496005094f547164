#include "Undo.h"

#include "ChangeReport.h"
#include "ModelSnapshot.h"
#include "Removal.h"
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
template <test::ElementForm Form> class RecordedModel : public test::LoadedModel<Form>
{
public:
    using test::LoadedModel<Form>::model;

    explicit RecordedModel(std::string const& text) : test::LoadedModel<Form>(text)
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
    ReportData remove(std::vector<debian::Package<Form>> const& packages)
    {
        return change([&] { debian::removePackages<Form>(packages); });
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

template <class Form> class UndoTest : public testing::Test
{};
TYPED_TEST_SUITE(UndoTest, test::BothForms, test::FormName);

TYPED_TEST(UndoTest, BringsBackEachPackage)
{
    for (ustring const name : {u"a", u"b", u"c", u"v", u"w"})
    {
        RecordedModel<TypeParam> index(TEXT);
        index.expectUndone([&] { index.package(name)->destroy(); });
    }
}

TYPED_TEST(UndoTest, BringsBackSeveralPackages)
{
    RecordedModel<TypeParam> index(TEXT);

    index.expectUndone([&] {
        debian::removePackages<TypeParam>({index.package(u"a"), index.package(u"b")});
    });
}

TYPED_TEST(UndoTest, BringsBackAllPackages)
{
    RecordedModel<TypeParam> index(TEXT);

    index.expectUndone([&] { index.loaded.index->getPackages().destroyAllContents(); });
}

TYPED_TEST(UndoTest, BringsBackTheIndex)
{
    RecordedModel<TypeParam> index(TEXT);

    index.expectUndone([&] { index.loaded.index->destroy(); });
}

TYPED_TEST(UndoTest, BringsBackTheMiddleOfAnOrder)
{
    RecordedModel<TypeParam> index(paragraph("a", "Depends: b, c, d, e\n"));

    index.expectUndone([&] {
        auto const release = index.release(u"a");
        release->getGroups().at(1)->destroy();
        release->getGroups().at(1)->destroy();
    });
}

TYPED_TEST(UndoTest, RestoresPlainValuesAndReferencesOfWhatChanged)
{
    RecordedModel<TypeParam> index(TEXT);

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

TYPED_TEST(UndoTest, DestroysWhatWasCreated)
{
    RecordedModel<TypeParam> index(TEXT);

    index.expectUndone([&] {
        auto const added = debian::Package<TypeParam>::create(index.model);
        added->setName(u"added");
        added->setIndex(index.loaded.index);
        index.release(u"a")->getProvides().push_back(added);
    });
}

TYPED_TEST(UndoTest, TurnsReferencesToTheNewElement)
{
    RecordedModel<TypeParam> index(paragraph("a", "Suggests: b\n") + paragraph("b"));
    auto const old = index.package(u"b");
    auto const suggestion = index.alternative(u"a", 0, 0);
    ReportData const report = index.remove({old});
    ASSERT_FALSE(suggestion->getTarget());

    debian::undo(report);

    EXPECT_TRUE(suggestion->getTarget());
    EXPECT_EQ(suggestion->getTarget(), index.package(u"b"));
    EXPECT_EQ(index.package(u"b")->getUuid(), old->getUuid());
    EXPECT_FALSE(old);
}

TYPED_TEST(UndoTest, KeepsTheProxiesOfWhatIsMissing)
{
    RecordedModel<TypeParam> index(paragraph("a", "Depends: gone\n") +
                                   paragraph("b", "Depends: gone\n"));
    auto const targetOf = [&](ustring const& name) {
        return index.alternative(name, 0, 0)->getTargetImpl();
    };
    auto* const proxy = targetOf(u"b");

    debian::undo(index.remove({index.package(u"a")}));

    EXPECT_EQ(targetOf(u"a"), proxy);
}

TYPED_TEST(UndoTest, KeepsReferencesToTheOtherModel)
{
    RecordedModel<TypeParam> index(paragraph("a", "Depends: gone\n"));
    Model const available = Model::create(index.model->getModelConstellation());
    available->setModelURI(u"packages:available");
    auto const other = test::loadText<TypeParam>(available, paragraph("gone"));
    auto const target = other.index->getPackages().find(u"gone");
    ASSERT_EQ(index.alternative(u"a", 0, 0)->getTarget(), target);

    index.expectUndone([&] { index.package(u"a")->destroy(); });

    EXPECT_EQ(index.alternative(u"a", 0, 0)->getTarget(), target);
}

/// Refuses everything.
class Refuser : public Listener
{
public:
    bool transactionValidating(ReportData& /*report*/) { return false; }
};

TYPED_TEST(UndoTest, LeavesTheModelAsItIsWhenItIsRefused)
{
    RecordedModel<TypeParam> index(TEXT);
    ReportData const report = index.remove({index.package(u"a")});
    ModelSnapshot const after(index.model);
    Refuser refuser;
    index.model->addListener(&refuser);

    EXPECT_THROW(debian::undo(report), std::runtime_error);

    index.model->removeListener(&refuser);
    EXPECT_EQ(ModelSnapshot(index.model), after);
}

template <class Form> class ChangeReportTest : public testing::Test
{};
TYPED_TEST_SUITE(ChangeReportTest, test::BothForms, test::FormName);

TYPED_TEST(ChangeReportTest, TellsOldValuesOfWhatWasDestroyed)
{
    RecordedModel<TypeParam> index(TEXT);
    ReportData const report = index.remove({index.package(u"c")});
    std::ostringstream output;

    debian::printReport<TypeParam>(output, report, /*maxLines=*/100);

    EXPECT_THAT(output.str(), HasSubstr("changed Package w; had providers = {a 1 all, c 1 all}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Package c; had releases = {c 1 all}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Release c 1 all; had groups = {Suggests: a}, "
                                        "provides = {w, v}\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed Alternative a; had target = a\n"));
    EXPECT_THAT(output.str(), HasSubstr("destroyed 4 elements: 1 Alternative, 1 DependencyGroup, "
                                        "1 Package, 1 Release\n"));
}

TYPED_TEST(ChangeReportTest, CountsTheLinesThatItLeavesOut)
{
    RecordedModel<TypeParam> index(TEXT);
    ReportData const report = index.remove({index.package(u"c")});
    std::ostringstream output;

    debian::printReport<TypeParam>(output, report, /*maxLines=*/2);

    EXPECT_THAT(output.str(), HasSubstr("    and 5 lines more\n"));
    EXPECT_THAT(output.str(), testing::Not(HasSubstr("destroyed Release")));
}

template <class Form> class ModelSnapshotTest : public testing::Test
{};
TYPED_TEST_SUITE(ModelSnapshotTest, test::BothForms, test::FormName);

TYPED_TEST(ModelSnapshotTest, TellsWhichElementsDiffer)
{
    RecordedModel<TypeParam> index(TEXT);
    ModelSnapshot const before(index.model);
    auto const release = index.release(u"a");
    index.change([&] { release->setSummary(u"another"); });

    auto const differences = before.differences(ModelSnapshot(index.model), 10);

    ASSERT_EQ(differences.size(), 1u);
    EXPECT_THAT(differences[0], HasSubstr(" differs"));
}

TYPED_TEST(ModelSnapshotTest, SeesEachKindOfChange)
{
    std::function<void(RecordedModel<TypeParam>&)> const changes[] = {
        [](RecordedModel<TypeParam>& index) { index.release(u"a")->setIsEssential(true); },
        [](RecordedModel<TypeParam>& index) { index.release(u"a")->setInstalledSize(0); },
        [](RecordedModel<TypeParam>& index) {
            index.release(u"a")->getProvides().ensureAt(0, index.package(u"w"));
        },
        [](RecordedModel<TypeParam>& index) {
            index.release(u"a")->setPackage(debian::Package<TypeParam>());
        },
        [](RecordedModel<TypeParam>& index) { index.package(u"a")->destroy(); },
        [](RecordedModel<TypeParam>& index) { debian::Package<TypeParam>::create(index.model); },
        [](RecordedModel<TypeParam>& index) {
            index.alternative(u"a", 0, 0)->setTarget(debian::Package<TypeParam>());
        },
    };

    for (auto const& step : changes)
    {
        RecordedModel<TypeParam> index(TEXT);
        ModelSnapshot const before(index.model);
        index.change([&] { step(index); });
        EXPECT_NE(ModelSnapshot(index.model), before) << &step - changes;
    }
}

TEST(ModelSnapshotOfBothForms, IsTheSame)
{
    test::LoadedModel<debian::Generated> const generated(TEXT);
    test::LoadedModel<debian::Reflective> const reflective(TEXT);
    ModelSnapshot const one(generated.model);
    ModelSnapshot const other(reflective.model);

    EXPECT_THAT(one.differences(other, 10), IsEmpty());
    EXPECT_EQ(one, other);
    EXPECT_EQ(one.fingerprint(), other.fingerprint());
}

TEST(ModelSnapshotFingerprint, DiffersIfAnythingDiffers)
{
    test::LoadedModel<debian::Generated> const one(TEXT);
    test::LoadedModel<debian::Generated> const other(TEXT);

    other.release(u"a")->setSummary(u"another");

    EXPECT_NE(ModelSnapshot(one.model).fingerprint(), ModelSnapshot(other.model).fingerprint());
}

}  // namespace

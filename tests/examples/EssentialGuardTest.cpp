#include "EssentialGuard.h"

#include "ModelSnapshot.h"
#include "Removal.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using namespace tarn::kiln;
using debian::ModelSnapshot;
using test::paragraph;

/// An index under guard.
template <test::ElementForm Form> class GuardedModel : public test::LoadedModel<Form>
{
public:
    explicit GuardedModel(std::string const& text)
        : test::LoadedModel<Form>(text),
          guard(this->loaded.index)
    {
        this->model->addListener(&guard);
    }
    ~GuardedModel() { this->model->removeListener(&guard); }

    TransactionResult remove(ustring const& name)
    {
        Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);
        debian::removePackages<Form>({this->package(name)});
        return transaction.commit();
    }

    debian::EssentialGuard<Form> guard;
};

std::string essential(std::string const& name, std::string const& fields)
{
    return paragraph(name, "Essential: yes\n" + fields);
}

template <class Form> class EssentialGuardTest : public testing::Test
{};
TYPED_TEST_SUITE(EssentialGuardTest, test::BothForms, test::FormName);

TYPED_TEST(EssentialGuardTest, RefusesToRemoveWhatAnEssentialPackageNeeds)
{
    for (std::string const kind : {"Depends", "Pre-Depends"})
    {
        GuardedModel<TypeParam> index(essential("base", kind + ": lib\n") + paragraph("lib"));
        ModelSnapshot const before(index.model);

        EXPECT_EQ(index.remove(u"lib"), TransactionResult::RolledBack);

        EXPECT_EQ(index.guard.reason(), "base 1 all has nothing left for " + kind + ": lib");
        EXPECT_EQ(ModelSnapshot(index.model), before);
        EXPECT_TRUE(index.package(u"lib"));
        EXPECT_THAT(index.model->checkInvariants(), testing::IsEmpty());
    }
}

TYPED_TEST(EssentialGuardTest, RefusesToRemoveWhatIsNeededIndirectly)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: lib\n") +
                                  paragraph("lib", "Depends: core\n") + paragraph("core"));

    EXPECT_EQ(index.remove(u"core"), TransactionResult::RolledBack);
    EXPECT_EQ(index.guard.reason(), "lib 1 all has nothing left for Depends: core");
}

TYPED_TEST(EssentialGuardTest, RefusesToRemoveAnEssentialPackage)
{
    GuardedModel<TypeParam> index(essential("base", ""));

    EXPECT_EQ(index.remove(u"base"), TransactionResult::RolledBack);
    EXPECT_EQ(index.guard.reason(), "base 1 all is essential");
}

TYPED_TEST(EssentialGuardTest, AllowsToRemoveWhatIsOnlyRecommended)
{
    GuardedModel<TypeParam> index(essential("base", "Recommends: nice\nSuggests: nicer\n") +
                                  paragraph("nice") + paragraph("nicer"));

    EXPECT_EQ(index.remove(u"nice"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"nicer"), TransactionResult::Committed);
    EXPECT_EQ(index.guard.reason(), "");
}

TYPED_TEST(EssentialGuardTest, AllowsToRemoveOneOfTwoAlternatives)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: one | two\n") + paragraph("one") +
                                  paragraph("two"));

    EXPECT_EQ(index.remove(u"one"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"two"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, AllowsToBreakAnAlternativeThatIsNotUsed)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: one | two\n") + paragraph("one") +
                                  paragraph("two", "Depends: lib\n") + paragraph("lib"));

    EXPECT_EQ(index.remove(u"lib"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"one"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, TakesAProviderForThePackage)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: awk\n") +
                                  paragraph("mawk", "Provides: awk\n") +
                                  paragraph("gawk", "Provides: awk\n"));

    EXPECT_EQ(index.remove(u"mawk"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"gawk"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, KeepsAPackageThatAnotherOneProvides)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: awk\n") + paragraph("awk") +
                                  paragraph("gawk", "Provides: awk\n"));

    EXPECT_EQ(index.remove(u"awk"), TransactionResult::Committed);
    EXPECT_TRUE(index.package(u"awk"));
    EXPECT_EQ(index.remove(u"gawk"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, ComparesVersions)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: lib (>= 2)\n") +
                                  "Package: lib\nVersion: 1\nArchitecture: all\n\n"
                                  "Package: lib\nVersion: 2.1\nArchitecture: all\n");
    auto const remove = [&](ustring const& label) {
        Transaction const transaction = index.model->beginTransaction(/*revertible=*/true);
        index.package(u"lib")->getReleases().find(label)->destroy();
        return transaction.commit();
    };

    EXPECT_EQ(remove(u"2.1 all"), TransactionResult::RolledBack);
    EXPECT_EQ(remove(u"1 all"), TransactionResult::Committed);
}

TYPED_TEST(EssentialGuardTest, LetsPackagesThatNeedEachOtherWork)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: one\n") +
                                  paragraph("one", "Depends: two\n") +
                                  paragraph("two", "Depends: one\n") + paragraph("other"));

    EXPECT_EQ(index.remove(u"other"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"two"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, IgnoresWhatLackedFromTheStart)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: gone, lib\n") + paragraph("lib") +
                                  paragraph("other"));

    EXPECT_EQ(index.remove(u"other"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"lib"), TransactionResult::RolledBack);
}

TYPED_TEST(EssentialGuardTest, RefusesAVersionThatNoLongerFits)
{
    GuardedModel<TypeParam> index(essential("base", "Depends: lib (= 1)\n") + paragraph("lib"));
    ModelSnapshot const before(index.model);

    Transaction const transaction = index.model->beginTransaction(/*revertible=*/true);
    index.release(u"lib")->setVersion(u"2");

    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);
    EXPECT_EQ(ModelSnapshot(index.model), before);
}

template <class Form> class NeededByEssential : public testing::Test
{};
TYPED_TEST_SUITE(NeededByEssential, test::BothForms, test::FormName);

TYPED_TEST(NeededByEssential, FindsThePackageThatAloneSatisfiesIt)
{
    test::LoadedModel<TypeParam> const index(essential("base", "Depends: one | two, base2, lib\n") +
                                             essential("base2", "") + paragraph("one") +
                                             paragraph("two") + paragraph("lib"));

    EXPECT_EQ(debian::neededByEssential<TypeParam>(index.loaded.index), index.package(u"lib"));
}

TYPED_TEST(NeededByEssential, IsEmptyIfAllCanGo)
{
    test::LoadedModel<TypeParam> const index(paragraph("a", "Depends: b\n") + paragraph("b"));

    EXPECT_FALSE(debian::neededByEssential<TypeParam>(index.loaded.index));
}

}  // namespace

#include "EssentialGuard.h"

#include "ModelSnapshot.h"
#include "Removal.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tests/examples/LoadText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using namespace tarn::kiln;
using debian::EssentialGuard;
using debian::ModelSnapshot;
using test::paragraph;

/// An index under guard.
class GuardedModel : public test::LoadedModel
{
public:
    explicit GuardedModel(std::string const& text) : LoadedModel(text), guard(loaded.index)
    {
        model->addListener(&guard);
    }
    ~GuardedModel() { model->removeListener(&guard); }

    TransactionResult remove(ustring const& name)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        debian::removePackages({package(name)});
        return transaction.commit();
    }

    EssentialGuard guard;
};

std::string essential(std::string const& name, std::string const& fields)
{
    return paragraph(name, "Essential: yes\n" + fields);
}

TEST(EssentialGuard, RefusesToRemoveWhatAnEssentialPackageNeeds)
{
    for (std::string const kind : {"Depends", "Pre-Depends"})
    {
        GuardedModel index(essential("base", kind + ": lib\n") + paragraph("lib"));
        ModelSnapshot const before(index.model);

        EXPECT_EQ(index.remove(u"lib"), TransactionResult::RolledBack);

        EXPECT_EQ(index.guard.reason(), "base 1 all has nothing left for " + kind + ": lib");
        EXPECT_EQ(ModelSnapshot(index.model), before);
        EXPECT_TRUE(index.package(u"lib"));
        EXPECT_THAT(index.model->checkInvariants(), testing::IsEmpty());
    }
}

TEST(EssentialGuard, RefusesToRemoveWhatIsNeededIndirectly)
{
    GuardedModel index(essential("base", "Depends: lib\n") + paragraph("lib", "Depends: core\n") +
                       paragraph("core"));

    EXPECT_EQ(index.remove(u"core"), TransactionResult::RolledBack);
    EXPECT_EQ(index.guard.reason(), "lib 1 all has nothing left for Depends: core");
}

TEST(EssentialGuard, RefusesToRemoveAnEssentialPackage)
{
    GuardedModel index(essential("base", ""));

    EXPECT_EQ(index.remove(u"base"), TransactionResult::RolledBack);
    EXPECT_EQ(index.guard.reason(), "base 1 all is essential");
}

TEST(EssentialGuard, AllowsToRemoveWhatIsOnlyRecommended)
{
    GuardedModel index(essential("base", "Recommends: nice\nSuggests: nicer\n") +
                       paragraph("nice") + paragraph("nicer"));

    EXPECT_EQ(index.remove(u"nice"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"nicer"), TransactionResult::Committed);
    EXPECT_EQ(index.guard.reason(), "");
}

TEST(EssentialGuard, AllowsToRemoveOneOfTwoAlternatives)
{
    GuardedModel index(essential("base", "Depends: one | two\n") + paragraph("one") +
                       paragraph("two"));

    EXPECT_EQ(index.remove(u"one"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"two"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, AllowsToBreakAnAlternativeThatIsNotUsed)
{
    GuardedModel index(essential("base", "Depends: one | two\n") + paragraph("one") +
                       paragraph("two", "Depends: lib\n") + paragraph("lib"));

    EXPECT_EQ(index.remove(u"lib"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"one"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, TakesAProviderForThePackage)
{
    GuardedModel index(essential("base", "Depends: awk\n") + paragraph("mawk", "Provides: awk\n") +
                       paragraph("gawk", "Provides: awk\n"));

    EXPECT_EQ(index.remove(u"mawk"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"gawk"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, KeepsAPackageThatAnotherOneProvides)
{
    GuardedModel index(essential("base", "Depends: awk\n") + paragraph("awk") +
                       paragraph("gawk", "Provides: awk\n"));

    EXPECT_EQ(index.remove(u"awk"), TransactionResult::Committed);
    EXPECT_TRUE(index.package(u"awk"));
    EXPECT_EQ(index.remove(u"gawk"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, ComparesVersions)
{
    GuardedModel index(essential("base", "Depends: lib (>= 2)\n") +
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

TEST(EssentialGuard, LetsPackagesThatNeedEachOtherWork)
{
    GuardedModel index(essential("base", "Depends: one\n") + paragraph("one", "Depends: two\n") +
                       paragraph("two", "Depends: one\n") + paragraph("other"));

    EXPECT_EQ(index.remove(u"other"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"two"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, IgnoresWhatLackedFromTheStart)
{
    GuardedModel index(essential("base", "Depends: gone, lib\n") + paragraph("lib") +
                       paragraph("other"));

    EXPECT_EQ(index.remove(u"other"), TransactionResult::Committed);
    EXPECT_EQ(index.remove(u"lib"), TransactionResult::RolledBack);
}

TEST(EssentialGuard, RefusesAVersionThatNoLongerFits)
{
    GuardedModel index(essential("base", "Depends: lib (= 1)\n") + paragraph("lib"));
    ModelSnapshot const before(index.model);

    Transaction const transaction = index.model->beginTransaction(/*revertible=*/true);
    index.release(u"lib")->setVersion(u"2");

    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);
    EXPECT_EQ(ModelSnapshot(index.model), before);
}

TEST(NeededByEssential, FindsThePackageThatAloneSatisfiesIt)
{
    test::LoadedModel const index(essential("base", "Depends: one | two, base2, lib\n") +
                                  essential("base2", "") + paragraph("one") + paragraph("two") +
                                  paragraph("lib"));

    EXPECT_EQ(debian::neededByEssential(index.loaded.index), index.package(u"lib"));
}

TEST(NeededByEssential, IsEmptyIfAllCanGo)
{
    test::LoadedModel const index(paragraph("a", "Depends: b\n") + paragraph("b"));

    EXPECT_FALSE(debian::neededByEssential(index.loaded.index));
}

}  // namespace

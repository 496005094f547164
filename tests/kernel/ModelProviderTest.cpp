// What a model asks its data source, and tells its usage provider.
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/Package.h"
#include "tests/kernel/ModelFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/PlainChange.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

#include <memory>
#include <stdexcept>
#include <vector>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

// ---------------------------------------------------------------------------- data source

class AModelWithADataSource : public ModelFixture
{
protected:
    FakeDataSource& source = FakeDataSource::installIn(model);
};

TEST_F(AModelWithADataSource, AsksItForAUuidThatIsNotInMemory)
{
    Plain const loaded = Plain::create(model);
    source.onFetch = [&](UUID const& id) {
        EXPECT_EQ(id, uuidOf(9));
        return loaded;
    };

    EXPECT_EQ(model->findElement(uuidOf(9), FindElementBehavior::Fetch), loaded);
    EXPECT_THAT(source.calls, ElementsAre("fetchElement"));
}

TEST_F(AModelWithADataSource, DoesNotAskItForWhatIsInMemory)
{
    Plain const element = Plain::create(model, uuidOf(1));

    EXPECT_EQ(model->findElement(uuidOf(1), FindElementBehavior::Fetch), element);
    EXPECT_THAT(source.calls, IsEmpty());
}

TEST_F(AModelWithADataSource, DoesNotAskItUnlessTold)
{
    EXPECT_FALSE(model->findElement(uuidOf(9)));
    EXPECT_FALSE(model->findElement(uuidOf(9), FindElementBehavior::InMemory));
    EXPECT_THAT(source.calls, IsEmpty());
}

TEST_F(AModelWithADataSource, OwnsItAndLetsItGoWhenTold)
{
    int deaths = 0;
    source.onDeath = [&] { ++deaths; };
    EXPECT_EQ(model->getDataSource(), &source);

    model->resetDataSource();

    EXPECT_EQ(deaths, 1);
    EXPECT_EQ(model->getDataSource(), nullptr);
    EXPECT_FALSE(model->findElement(uuidOf(9), FindElementBehavior::Fetch));
}

TEST(FindElementBehavior, FetchesByTheValueOneOnly)
{
    EXPECT_EQ(static_cast<int>(FindElementBehavior::Fetch), 1);
    EXPECT_NE(static_cast<int>(FindElementBehavior::InMemory), 1);
}

// ---------------------------------------------------------------------------- usage

/// Notes what it is told, and what the model knew at that moment.
class UsageLog : public meta::DataModelUsageProvider
{
public:
    std::vector<meta::Package> getUsedPackages() const override { return {}; }
    std::vector<ustring> getUsedPackageUris() const override { return {u"one", u"two"}; }
    void elementCreated(ModelElement::Impl* element) override
    {
        created.push_back(element);
        Model const model = element->getModel();
        knownWhenCreated = model->findElementImpl(element->getUuid()) == element;
        topLevelWhenCreated = !model->getTopLevelElements().empty();
        if (refuses)
            throw std::runtime_error("refused");
    }
    void elementDestroying(ModelElement::Impl* element) override
    {
        destroying.push_back(element);
        knownWhenDestroying = element->getModel()->findElementImpl(element->getUuid()) == element;
    }

    std::vector<ModelElement::Impl*> created;
    std::vector<ModelElement::Impl*> destroying;
    bool knownWhenCreated = false;
    bool topLevelWhenCreated = false;
    bool knownWhenDestroying = false;
    bool refuses = false;
};

class AUsageProvider : public ModelFixture
{
protected:
    UsageLog& install()
    {
        auto log = std::make_unique<UsageLog>();
        UsageLog& result = *log;
        model->setUsageProvider(std::move(log));
        return result;
    }
};

TEST_F(AUsageProvider, IsToldOfACreationBetweenRegistryAndTopLevel)
{
    UsageLog const& log = install();

    Plain const element = Plain::create(model);

    EXPECT_THAT(log.created, ElementsAre(element.getImpl()));
    EXPECT_TRUE(log.knownWhenCreated);
    EXPECT_FALSE(log.topLevelWhenCreated);
}

TEST_F(AUsageProvider, IsToldOfADestructionBeforeTheElementLeavesTheRegistry)
{
    UsageLog const& log = install();
    Plain const element = Plain::create(model);

    element->destroy();

    EXPECT_THAT(log.destroying, ElementsAre(element.getImpl()));
    EXPECT_TRUE(log.knownWhenDestroying);
    EXPECT_FALSE(model->findElement(element->getUuid()));
}

TEST_F(AUsageProvider, IsNotToldWhenARollbackBringsAnElementBackOrTakesOneAway)
{
    UsageLog const& log = install();
    Plain const old = Plain::create(model);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    old->destroy();
    Plain const fresh = Plain::create(model);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(old);
    EXPECT_FALSE(fresh);
    EXPECT_EQ(log.created.size(), 2u);
    EXPECT_THAT(log.destroying, ElementsAre(old.getImpl()));
}

TEST_F(AUsageProvider, IsAskedForTheUrisOfUsedPackages)
{
    install();

    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
    EXPECT_THAT(model->getUsedPackageUris(), ElementsAre(u"one", u"two"));
}

TEST_F(AUsageProvider, MayBeMissing)
{
    model->setUsageProvider(nullptr);

    Plain const element = Plain::create(model);
    element->destroy();

    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
    EXPECT_THAT(model->getUsedPackageUris(), IsEmpty());
}

TEST_F(AUsageProvider, OfTheModelToleratesElementsWithoutAMetaclass)
{
    Plain const element = Plain::create(model);
    EXPECT_THAT(model->getUsedPackages(), IsEmpty());

    element->destroy();

    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
    EXPECT_THAT(model->getDescriptivePackageURIClosure(), IsEmpty());
}
}  // namespace

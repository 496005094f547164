/// \file
/// The registry model, its locks and the table of types.
#include "tarnkiln/meta/MetaRegistry.h"

#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <thread>

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

/// A class in the registry's table for the length of a test.
class RegisteredClass : public RegistryElement<Class>
{
public:
    explicit RegisteredClass(ustring const& name,
                             MetaRegistry::CollectionInstantiator collection = nullptr,
                             MetaRegistry::BuilderInstantiator builder = nullptr)
        : RegistryElement(name)
    {
        registry().registerType(get(), collection, builder);
    }
};

/// Makes nothing; remembers for which model it was made.
class IdleBuilder final : public ModelElement::Builder
{
public:
    explicit IdleBuilder(Model const& model) : Builder(model, 1) {}

    static std::unique_ptr<ModelElement::Builder> instantiate(Model const& model)
    {
        return std::make_unique<IdleBuilder>(model);
    }

    Class const& getMetaClass() const override { return m_none; }

protected:
    ModelElement doCreate(bool, UUID const&) override { return {}; }

private:
    Class m_none;
};

TEST(MetaRegistry, IsOneForTheWholeProcess)
{
    EXPECT_EQ(&MetaRegistry::getInstance(), &MetaRegistry::getInstance());
}

TEST(MetaRegistry, OwnsARegistryModelOfAFixedUri)
{
    Model const& model = registry().getModel();

    EXPECT_TRUE(model->isRegistryModel());
    EXPECT_EQ(model->getModelURI(), u"registry@registry://metaRegistry/model");
    EXPECT_EQ(model->getModelURI(), MetaRegistry::MetaRegistryModelID);
}

TEST(MetaRegistry, IsDescribedByTheCatalogueWhateverItHolds)
{
    RegistryElement<Class> const made(u"Made");
    Package const root = MetaPackageMeta::getInstance().getRootPackage();

    EXPECT_EQ(registry().getModel()->getUsedPackages(), std::vector<Package>{root});
    EXPECT_EQ(registry().getModel()->getUsedPackageUris(),
              std::vector<ustring>{SchemaBase + u"meta/19700101"});
}

TEST(RegistryModel, RefusesChangesOutsideALock)
{
    EXPECT_RAISES(messages::ModelFrozen, PrimitiveType::create(registry().getModel()));
}

TEST(RegistryModel, RefusesChangesUnderAConstLock)
{
    MetaRegistry::LockedConstModel const locked(registry());

    EXPECT_EQ(locked.getModel(), registry().getModel());
    EXPECT_RAISES(messages::ModelFrozen, PrimitiveType::create(locked.getModel()));
}

TEST(RegistryModel, StaysThawedUntilTheOutermostLockGoes)
{
    Model const& model = registry().getModel();
    {
        MetaRegistry::LockedModel const outer(registry());
        {
            MetaRegistry::LockedModel const inner(registry());
            EXPECT_FALSE(model->isFrozen());
        }
        EXPECT_FALSE(model->isFrozen());
    }
    EXPECT_TRUE(model->isFrozen());
}

TEST(RegistryModel, HasOneWriterAtATime)
{
    bool otherIsIn = false;
    std::thread other;
    {
        MetaRegistry::LockedModel const locked(registry());
        other = std::thread([&] {
            MetaRegistry::LockedModel const late(registry());
            otherIsIn = true;
        });
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        EXPECT_FALSE(otherIsIn);
    }
    other.join();
    EXPECT_TRUE(otherIsIn);
}

struct KernelClass
{
    Class const& metaClass;
    char const* uuid;
    ustring name;
    string vobjName;
};

TEST(KernelClasses, AreRegisteredUnderTheirBareNames)
{
    KernelClass const rows[] = {
        {Model::metaClass(), "a559b870-6892-3eec-8508-6ce5485e9784", u"Model", "tarn.kiln.Model"},
        {ModelElement::metaClass(), "42663bf5-8b3d-3c82-938a-ed709e37a269", u"ModelElement",
         "tarn.kiln.ModelElement"},
        {ModelConstellation::metaClass(), "9dbcfe9e-bec1-3843-9db4-a894b2344149",
         u"ModelConstellation", "tarn.kiln.ModelConstellation"}};

    for (KernelClass const& row : rows)
    {
        SCOPED_TRACE(row.vobjName);
        ASSERT_TRUE(row.metaClass);
        EXPECT_EQ(row.metaClass->getUuid(), boost::lexical_cast<UUID>(row.uuid));
        EXPECT_EQ(row.metaClass->getName(), row.name);
        EXPECT_EQ(row.metaClass->getVobjName(), row.vobjName);
        EXPECT_EQ(registry().getClass(row.name), row.metaClass);
    }
}

TEST(TypeTable, KnowsTheLegacyNamesOfTwoKernelClasses)
{
    EXPECT_EQ(registry().getType(u"meta.Model"), Model::metaClass());
    EXPECT_EQ(registry().getType(u"meta.ModelElement"), ModelElement::metaClass());
    EXPECT_EQ(registry().getClass(u"meta.Model"), Model::metaClass());
    EXPECT_EQ(registry().getType(u"meta.Model"), registry().getType(u"Model"));
}

TEST(TypeTable, HasNoLegacyNameForConstellations)
{
    EXPECT_FALSE(registry().getType(u"meta.ModelConstellation"));
}

TEST(TypeTable, PrefersAnEntryToALegacyName)
{
    RegistryElement<Class> const impostor(u"Impostor");
    registry().registerType(impostor.get(), u"meta.Model", nullptr, nullptr);

    EXPECT_EQ(registry().getType(u"meta.Model"), impostor.get());

    MetaRegistry::LockedModel const locked(registry());
    registry().unregisterType(impostor.get(), u"meta.Model");
    EXPECT_EQ(registry().getType(u"meta.Model"), Model::metaClass());
}

TEST(TypeTable, AnswersAnUnknownNameWithTheEmptyHandle)
{
    EXPECT_EQ(registry().getType(u"NoSuchType"), Type());
    EXPECT_EQ(registry().getType(u""), Type());
    EXPECT_EQ(registry().getClass(u"NoSuchType"), Class());
    EXPECT_EQ(registry().getPrimitiveType(u"NoSuchType"), PrimitiveType());
}

TEST(TypeTable, AnswersATypeOfAnotherKindWithTheEmptyHandle)
{
    EXPECT_EQ(registry().getClass(u"Integer"), Class());
    EXPECT_EQ(registry().getPrimitiveType(u"Model"), PrimitiveType());
}

TEST(TypeTable, KeepsTheFirstOfTwoTypesUnderOneName)
{
    RegisteredClass const first(u"Twice");
    RegistryElement<Class> const second(u"Twice");

    EXPECT_RAISES_WITH(messages::DuplicateTypeInRegistry,
                       registry().registerType(second.get(), nullptr, nullptr), u"Twice");

    EXPECT_EQ(registry().getType(u"Twice"), first.get());
}

TEST(TypeTable, RefusesTheSameTypeUnderItsNameAgain)
{
    RegisteredClass const once(u"Once");

    EXPECT_RAISES_WITH(messages::DuplicateTypeInRegistry,
                       registry().registerType(once.get(), nullptr, nullptr), u"Once");
}

TEST(TypeTable, TakesATypeUnderSeveralNames)
{
    RegisteredClass const type(u"Named");
    registry().registerType(type.get(), u"Alias", nullptr, nullptr);

    EXPECT_EQ(registry().getType(u"Alias"), type.get());

    MetaRegistry::LockedModel const locked(registry());
    registry().unregisterType(type.get(), u"Alias");
    EXPECT_EQ(registry().getType(u"Named"), type.get());
}

TEST(TypeTable, LetsALiveTypeReplaceADeadOne)
{
    Class doomed;
    {
        RegistrySession session;
        doomed = Class::create(session.getModel());
        doomed->setName(u"Reborn");
        registry().registerType(doomed, nullptr, nullptr);
        session.rollBack();
    }
    ASSERT_FALSE(registry().getType(u"Reborn"));

    RegisteredClass const reborn(u"Reborn");

    EXPECT_EQ(registry().getType(u"Reborn"), reborn.get());
}

TEST(TypeTable, IsLeftAloneWhenAnotherTypeOfTheNameIsUnregistered)
{
    RegisteredClass const entered(u"Entered");
    RegistryElement<Class> const other(u"Entered");
    MetaRegistry::LockedModel const locked(registry());

    registry().unregisterType(other.get(), u"Entered");
    registry().unregisterType(entered.get(), u"NoSuchType");

    EXPECT_EQ(registry().getType(u"Entered"), entered.get());
}

TEST(TypeTable, MakesTheCollectionsOfATypeThatIsRegistered)
{
    RegisteredClass const structured(u"Structured");
    RegistryElement<Enum> const enumeration(u"Enumeration");
    ASSERT_FALSE(enumeration->hasLiterals());
    registry().registerType(enumeration.get(), nullptr);

    EXPECT_TRUE(structured->hasOwnedAttributes());
    EXPECT_TRUE(structured->hasOwnedOperations());
    EXPECT_TRUE(enumeration->hasLiterals());
}

TEST(TypeTable, ForgetsATypeThatATransactionDestroys)
{
    RegisteredClass doomed(u"Doomed");
    ASSERT_TRUE(registry().getType(u"Doomed"));

    doomed.destroy();

    EXPECT_EQ(registry().getType(u"Doomed"), Type());
}

TEST(TypeTable, ForgetsADestroyedTypeUnderTheNameOfItsLastChange)
{
    RegisteredClass renamed(u"Before");
    {
        RegistrySession session;
        renamed->setName(u"After");
        registry().unregisterType(renamed.get(), u"Before");
        registry().registerType(renamed.get(), nullptr, nullptr);
        session.commit();
    }

    renamed.destroy();

    EXPECT_EQ(registry().getType(u"After"), Type());
}

TEST(TypeTable, KeepsATypeWhoseDestructionIsRolledBack)
{
    RegisteredClass const kept(u"Kept");
    {
        RegistrySession session;
        kept->destroy();
        session.rollBack();
    }

    EXPECT_EQ(registry().getType(u"Kept"), kept.get());
    EXPECT_TRUE(kept.get());
}

TEST(TypeTable, KeepsTheEntryOfANamesakeOfADestroyedType)
{
    RegisteredClass const entered(u"Namesake");
    RegistryElement<Class> stranger(u"Namesake");

    stranger.destroy();

    EXPECT_EQ(registry().getType(u"Namesake"), entered.get());
}

TEST(RegistryBuilders, AreMadeForTheGivenModel)
{
    RegisteredClass const type(u"Buildable", nullptr, IdleBuilder::instantiate);
    Model const model = Model::createTransientModel();

    std::unique_ptr<ModelElement::Builder> const builder =
        registry().instantiateBuilder(type.get(), model);

    ASSERT_NE(dynamic_cast<IdleBuilder*>(builder.get()), nullptr);
    EXPECT_EQ(builder->getModel(), model);
}

TEST(RegistryBuilders, AreNullWithoutAClass)
{
    EXPECT_EQ(registry().instantiateBuilder(Class(), Model::createTransientModel()), nullptr);
}

TEST(RegistryBuilders, AreNullForADeadClass)
{
    RegisteredClass type(u"Buried", nullptr, IdleBuilder::instantiate);
    Class const dead = type.get();
    type.destroy();

    EXPECT_EQ(registry().instantiateBuilder(dead, Model::createTransientModel()), nullptr);
}

TEST(RegistryBuilders, AreNullForAnUnknownClass)
{
    RegistryElement<Class> const stranger(u"Stranger");

    EXPECT_EQ(registry().instantiateBuilder(stranger.get(), Model::createTransientModel()),
              nullptr);
}

TEST(RegistryBuilders, AreNullForANamesakeOfARegisteredClass)
{
    RegisteredClass const type(u"Shared", nullptr, IdleBuilder::instantiate);
    RegistryElement<Class> const namesake(u"Shared");

    EXPECT_EQ(registry().instantiateBuilder(namesake.get(), Model::createTransientModel()),
              nullptr);
}

TEST(RegistryBuilders, AreNullForAClassRegisteredWithoutOne)
{
    EXPECT_EQ(registry().instantiateBuilder(Model::metaClass(), Model::createTransientModel()),
              nullptr);
}
}  // namespace
}  // namespace tarn::kiln::meta

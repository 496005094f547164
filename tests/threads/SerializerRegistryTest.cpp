/// \file
/// Text forms are looked up, entered and taken out on several threads at once.
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/StringPropertySerializer.h"
#include "tests/support/ExpectRaises.h"

#include <gtest/gtest.h>

#include <barrier>
#include <thread>

namespace {

using namespace tarn::kiln;
using meta::PropertySerializerRegistry;
using meta::StandardTypes;

constexpr int THREADS = 4;
constexpr int ROUNDS = 100;

PropertySerializerRegistry& registry()
{
    return PropertySerializerRegistry::getInstance();
}

/// Types that only one thread knows.
struct OwnTypes
{
    OwnTypes()
    {
        word->setName(u"Word");
        colour->setName(u"Colour");
        meta::EnumLiteral const red = meta::EnumLiteral::create(model);
        red->setName(u"red");
        red->setParentEnum(colour);
    }

    Model const model = Model::create(ModelConstellation());
    meta::PrimitiveType const word = meta::PrimitiveType::create(model);
    meta::Enum const colour = meta::Enum::create(model);
};

/// Calls `step` many times on each of several threads, which start together.
template <class Step> void onManyThreads(Step step)
{
    std::barrier start(THREADS);
    std::vector<std::thread> threads;
    for (int i = 0; i < THREADS; ++i)
        threads.emplace_back([&start, step] {
            OwnTypes const own;
            start.arrive_and_wait();
            for (int round = 0; round < ROUNDS && !testing::Test::HasFailure(); ++round)
                step(own);
        });
    for (std::thread& thread : threads)
        thread.join();
}

TEST(SerializersOnManyThreads, ComeAndGoWithoutDisturbingOneAnother)
{
    onManyThreads([](OwnTypes const& own) {
        auto serializer = std::make_unique<meta::StringPropertySerializer>(own.word);
        meta::PropertySerializer* const entered = serializer.get();
        registry().registerPropertySerializer(own.word, std::move(serializer), "");
        EXPECT_EQ(registry().getPropertySerializer(own.word, ""), entered);
        EXPECT_RAISES(
            messages::DuplicateTypeInRegistry,
            registry().registerPropertySerializer(
                own.word, std::make_unique<meta::StringPropertySerializer>(own.word), ""));
        EXPECT_EQ(registry().getPropertySerializerForTypeOnly(own.word, ""), entered);

        registry().unregisterSerializers(own.word);
        EXPECT_EQ(registry().getPropertySerializer(own.word, ""), nullptr);
    });
}

TEST(SerializersOnManyThreads, ReadAndWriteWhileOthersComeAndGo)
{
    onManyThreads([](OwnTypes const& own) {
        registry().registerPropertySerializer(
            own.word, std::make_unique<meta::StringPropertySerializer>(own.word), "loud");

        auto const truth = registry().parseInAnyFlavour(u"1", StandardTypes::booleanMeta);
        ASSERT_TRUE(truth);
        EXPECT_TRUE(truth->first.getValue<bool>());
        auto const* const ofIntegers =
            registry().getPropertySerializer(StandardTypes::integerMeta, "");
        EXPECT_EQ(
            ofIntegers->serializeValue(ofIntegers->parseValue(u"42", StandardTypes::integerMeta)),
            u"42");
        EXPECT_EQ(
            registry().getPropertySerializer(own.colour, "")->serializeValue(Value(own.colour, 0L)),
            u"red");
        meta::DataType const prototype =
            meta::DataType::cast(meta::standardTypeOf<meta::ExtensionPrototype>());
        EXPECT_NE(registry().getDatatypeSerializer(prototype), nullptr);

        registry().unregisterPropertySerializer(own.word, "loud");
    });
}
}  // namespace

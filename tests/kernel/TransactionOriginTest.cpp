#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/uuid/uuid.hpp>
#include <gtest/gtest.h>

namespace {
using namespace tarn::kiln;
using meta::Language;
using meta::TransactionOrigin;

UUID uuid(unsigned char last)
{
    UUID result{};
    result.data[15] = last;
    return result;
}

void expectLess(TransactionOrigin const& left, TransactionOrigin const& right)
{
    EXPECT_EQ(left.compareWith(right), -1);
    EXPECT_EQ(right.compareWith(left), 1);
    EXPECT_TRUE(left < right);
    EXPECT_FALSE(right < left);
    EXPECT_FALSE(left == right);
}

TEST(OriginOfATransaction, BeginsUnknown)
{
    TransactionOrigin const origin;

    EXPECT_EQ(origin.getModel(), UUID{});
    EXPECT_EQ(origin.getLanguage(), Language::Unknown);
    EXPECT_EQ(origin.getTransactionId(), UUID{});
    EXPECT_FALSE(origin.getSynchronizer());
}

TEST(OriginOfATransaction, KeepsWhatIsSet)
{
    TransactionOrigin origin;
    origin.setModel(uuid(1));
    origin.setLanguage(Language::JavaScript);
    origin.setTransactionId(uuid(2));
    origin.setSynchronizer(uuid(3));

    EXPECT_EQ(origin.getModel(), uuid(1));
    EXPECT_EQ(origin.getLanguage(), Language::JavaScript);
    EXPECT_EQ(origin.getTransactionId(), uuid(2));
    EXPECT_EQ(*origin.getSynchronizer(), uuid(3));

    TransactionOrigin const copy = origin;
    EXPECT_TRUE(copy == origin);
    EXPECT_EQ(copy.compareWith(origin), 0);
}

TEST(OriginOfATransaction, IsOrderedByModelThenLanguageThenTransactionThenSynchronizer)
{
    TransactionOrigin model;
    model.setModel(uuid(1));
    TransactionOrigin language;
    language.setLanguage(Language::CPlusPlus);
    TransactionOrigin transaction;
    transaction.setTransactionId(uuid(1));
    TransactionOrigin synchronizer;
    synchronizer.setSynchronizer(uuid(1));

    expectLess(TransactionOrigin(), synchronizer);
    expectLess(synchronizer, transaction);
    expectLess(transaction, language);
    expectLess(language, model);
}

TEST(OriginOfATransaction, ComesFirstWithoutSynchronizer)
{
    TransactionOrigin nil;
    nil.setSynchronizer(UUID{});
    TransactionOrigin one;
    one.setSynchronizer(uuid(1));

    expectLess(TransactionOrigin(), nil);
    expectLess(nil, one);
}
}  // namespace

#include "bedrock/core/except/Exception.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <type_traits>
#include <typeinfo>
#include <utility>
#include <vector>

namespace {

using bedrock::core::except::Argument;
using bedrock::core::except::Exception;
using bedrock::core::except::ExceptionBase;
using bedrock::core::except::MsgIDObj;

class TestFailure final : public Exception<TestFailure>
{
public:
    TestFailure(std::vector<Argument> arguments, std::string const& text)
        : Exception(MsgIDObj("TestFailure", "test:messages"), std::move(arguments), text)
    {}
};

std::string formatted(std::vector<Argument> arguments, std::string const& text)
{
    return TestFailure(std::move(arguments), text).what();
}

TEST(MessageId, IsEqualWhenBothTextsAreAndOrderedByCatalogueFirst)
{
    EXPECT_EQ(MsgIDObj("A", "x:y"), MsgIDObj("A", "x:y"));
    EXPECT_NE(MsgIDObj("A", "x:y"), MsgIDObj("B", "x:y"));
    EXPECT_NE(MsgIDObj("A", "x:y"), MsgIDObj("A", "x:z"));
    EXPECT_LT(MsgIDObj("B", "x:y"), MsgIDObj("A", "x:z"));
    EXPECT_LT(MsgIDObj("A", "x:y"), MsgIDObj("B", "x:y"));
}

TEST(MessageId, IsWrittenAsCatalogueColonId)
{
    EXPECT_EQ(MsgIDObj("NoSuchType", "tarnkiln:messages").toString(),
              "tarnkiln:messages:NoSuchType");
}

TEST(ExceptionText, HasTheArgumentsInTheirPlacesInUtf8)
{
    EXPECT_EQ(formatted({u"\u00E9", std::string("8-bit"), -7L}, "{2} {0} {1} {0}"),
              "-7 \u00E9 8-bit \u00E9");
}

TEST(ExceptionText, KeepsPlaceholdersWithoutArgumentAndOtherBraces)
{
    EXPECT_EQ(formatted({u"a"}, "{1} {x} {} {0 {{0}} }{"), "{1} {x} {} {0 {a} }{");
    EXPECT_EQ(formatted({}, "{0}"), "{0}");
    EXPECT_EQ(formatted({}, ""), "");
}

TEST(ExceptionText, IsNotSearchedForPlaceholdersInArguments)
{
    EXPECT_EQ(formatted({u"{1}", u"b"}, "{0}{1}"), "{1}b");
}

TEST(ExceptionCopy, SharesItsContentsAndDoesNotFail)
{
    static_assert(std::is_nothrow_copy_constructible_v<TestFailure>);
    auto const original = std::make_unique<TestFailure>(std::vector<Argument>{u"a"}, "{0}");

    auto const copy = *original;

    EXPECT_EQ(&copy.getArguments(), &original->getArguments());
    EXPECT_EQ(copy.what(), original->what());
}

TEST(ExceptionClone, IsIndependentOfTheLifeOfItsOriginal)
{
    auto original = std::make_unique<TestFailure>(std::vector<Argument>{u"a"}, "text {0}");

    auto const clone = original->clone();
    original.reset();

    EXPECT_THROW(clone->rethrow(), TestFailure);
    EXPECT_EQ(clone->getText(), "text a");
}

TEST(Exception, CanStandOnAnotherStandardClass)
{
    class ForeignBase : public std::bad_cast
    {};
    class CastFailure final : public Exception<CastFailure, ForeignBase>
    {
    public:
        CastFailure() : Exception(MsgIDObj("CastFailure", "test:messages"), {}, "no such cast") {}
    };

    EXPECT_THROW(throw CastFailure(), std::bad_cast);
    EXPECT_THROW(throw CastFailure(), ExceptionBase);
    EXPECT_STREQ(static_cast<std::bad_cast const&>(CastFailure()).what(), "no such cast");
}
}  // namespace

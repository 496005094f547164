/// \file
/// Expectations about exceptions with a message id.
///
///     EXPECT_RAISES(messages::UUIDConflict, call());
///     EXPECT_RAISES_WITH(messages::NoSuchProperty, call(), u"name", u"Class");
#pragma once
#include "bedrock/core/except/ExceptionBase.h"
#include "tarnkiln/kernel/Messages.h"

#include <gtest/gtest.h>

#include <concepts>
#include <exception>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace messages = tarnkiln::messages;

namespace tarnkiln::tests {

using bedrock::core::except::Argument;
using bedrock::core::except::ExceptionBase;

inline Argument toArgument(std::u16string text)
{
    return text;
}

inline Argument toArgument(std::string text)
{
    return text;
}

inline Argument toArgument(std::integral auto number)
{
    return static_cast<long>(number);
}

template <class... Texts> std::vector<Argument> toArguments(Texts const&... texts)
{
    return {toArgument(texts)...};
}

/// `arguments` as a person would write them in a call.
inline std::string printArguments(std::vector<Argument> const& arguments)
{
    std::string result;
    for (Argument const& argument : arguments)
    {
        if (!result.empty())
            result += ", ";
        result +=
            std::visit([](auto const& value) { return ::testing::PrintToString(value); }, argument);
    }
    return '(' + result + ')';
}

/// Succeeds if `call` throws an `Id`, with exactly the given arguments if there are any given.
template <class Id, class Call>
::testing::AssertionResult raises(Call const& call,
                                  std::optional<std::vector<Argument>> const& arguments = {})
{
    try
    {
        call();
    }
    catch (Id const& exception)
    {
        if (!arguments || *arguments == exception.getArguments())
            return ::testing::AssertionSuccess();
        return ::testing::AssertionFailure()
               << "raised with the arguments " << printArguments(exception.getArguments())
               << " instead of " << printArguments(*arguments);
    }
    catch (ExceptionBase const& exception)
    {
        return ::testing::AssertionFailure() << "raised " << exception.GetBaseMsgIDObj().toString()
                                             << ": " << exception.getText();
    }
    catch (std::exception const& exception)
    {
        return ::testing::AssertionFailure() << "threw a std::exception: " << exception.what();
    }
    return ::testing::AssertionFailure() << "raised nothing";
}
}  // namespace tarnkiln::tests

/// Expects that the expression raises exactly the id class.
#define EXPECT_RAISES(Id, ...)                                                                     \
    EXPECT_TRUE((::tarnkiln::tests::raises<Id>([&] { static_cast<void>(__VA_ARGS__); })))

/// Expects that the expression raises the id class with the arguments that follow it: UTF-16
/// texts, 8-bit texts or integers. An expression with a bare comma needs parentheses.
#define EXPECT_RAISES_WITH(Id, expression, ...)                                                    \
    EXPECT_TRUE((::tarnkiln::tests::raises<Id>([&] { static_cast<void>(expression); },             \
                                               ::tarnkiln::tests::toArguments(__VA_ARGS__))))

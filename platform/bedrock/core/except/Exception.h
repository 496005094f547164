/// \file
/// The base template of all exceptions with a message id.
///
///     class NoSuchType : public Exception<NoSuchType, std::exception, void>
///     {
///     public:
///         explicit NoSuchType(std::u16string const& name)
///             : Exception(MsgIDObj("NoSuchType", "tarnkiln:messages"), {name}, "no type {0}")
///         {
///         }
///     };
#pragma once
#include "bedrock/core/except/ExceptionBase.h"
#include "bedrock/core/except/Export.h"

#include <exception>
#include <memory>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

namespace bedrock::core::except {

/// Gives the id class `Id`, which derives from it, its copies and its text.
///
/// Such an exception can be caught as `Id`, as `ExceptionBase` and as `StandardBase`. An id class
/// that crosses library borders must be exported and should define its destructor in a source.
///
/// \tparam StandardBase  `std::exception` or a class derived from it with a default constructor.
/// \tparam Extra         what an exception carries beside its arguments; only `void`, nothing.
template <class Id, class StandardBase = std::exception, class Extra = void>
class BEDROCK_EXCEPT_EXPORT Exception : public StandardBase, public ExceptionBase
{
    static_assert(std::is_base_of_v<std::exception, StandardBase>);
    static_assert(std::is_void_v<Extra>, "an exception carries its arguments only");

public:
    /// The formatted text; lives as long as any copy of this exception.
    char const* what() const noexcept override { return getText().c_str(); }

    std::unique_ptr<ExceptionBase> clone() const override { return std::make_unique<Id>(self()); }

    [[noreturn]] void rethrow() const override { throw Id(self()); }

protected:
    Exception(MsgIDObj id, std::vector<Argument> arguments, std::string_view text)
        : ExceptionBase(std::move(id), std::move(arguments), text)
    {}

private:
    Id const& self() const { return static_cast<Id const&>(*this); }
};
}  // namespace bedrock::core::except

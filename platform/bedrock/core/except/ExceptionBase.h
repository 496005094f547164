/// \file
/// What all exceptions with a message id have in common.
#pragma once
#include "bedrock/core/except/Export.h"
#include "bedrock/core/except/MsgIDObj.h"

#include <memory>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace bedrock::core::except {

/// One argument of a message: UTF-16 text, UTF-8 text, or an integer.
using Argument = std::variant<std::u16string, std::string, long>;

/// The part of an exception that is independent of its id class: message id, arguments and text.
///
/// Catch it to handle every exception with a message id alike. Copies share their contents, which
/// never change, so copying does not fail and an exception may be handed to another thread.
class BEDROCK_EXCEPT_EXPORT ExceptionBase
{
public:
    virtual ~ExceptionBase();

    MsgIDObj const& GetBaseMsgIDObj() const;

    /// The arguments in the order of the catalogue.
    std::vector<Argument> const& getArguments() const;

    /// The message in UTF-8, with the arguments in their places.
    std::string const& getText() const;

    /// A copy of the same class; the caller owns it.
    virtual std::unique_ptr<ExceptionBase> clone() const = 0;

    /// Throws a copy of the same class.
    [[noreturn]] virtual void rethrow() const = 0;

protected:
    /// \param text  UTF-8; "{0}" stands for the first argument, "{1}" for the second, up to "{9}".
    ///              A placeholder without an argument stays as it is.
    ExceptionBase(MsgIDObj id, std::vector<Argument> arguments, std::string_view text);

    ExceptionBase(ExceptionBase const&) = default;
    ExceptionBase& operator=(ExceptionBase const&) = default;

private:
    struct Contents;

    std::shared_ptr<Contents const> m_contents;  // never null
};
}  // namespace bedrock::core::except

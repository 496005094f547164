#include "bedrock/core/except/ExceptionBase.h"

#include "sill/i18n/StringConversion.h"

#include <cstddef>
#include <utility>

namespace bedrock::core::except {
namespace {

std::string toText(Argument const& argument)
{
    struct Visitor
    {
        std::string operator()(std::u16string const& text) const
        {
            return sill::i18n::to_string(text);
        }
        std::string operator()(std::string const& text) const { return text; }
        std::string operator()(long number) const { return std::to_string(number); }
    };
    return std::visit(Visitor(), argument);
}

/// What is put in is not searched for placeholders again.
std::string format(std::string_view text, std::vector<Argument> const& arguments)
{
    std::string result;
    while (!text.empty())
    {
        bool const placeholder = text.size() >= 3 && text[0] == '{' && text[2] == '}' &&
                                 text[1] >= '0' && text[1] <= '9';
        auto const index = placeholder ? static_cast<std::size_t>(text[1] - '0') : arguments.size();
        if (index < arguments.size())
        {
            result += toText(arguments[index]);
            text.remove_prefix(3);
        }
        else
        {
            result += text.front();
            text.remove_prefix(1);
        }
    }
    return result;
}
}  // namespace

struct ExceptionBase::Contents
{
    MsgIDObj id;
    std::vector<Argument> arguments;
    std::string text;
};

ExceptionBase::ExceptionBase(MsgIDObj id, std::vector<Argument> arguments, std::string_view text)
{
    auto formatted = format(text, arguments);
    m_contents = std::make_shared<Contents const>(
        Contents{std::move(id), std::move(arguments), std::move(formatted)});
}

ExceptionBase::~ExceptionBase() = default;

MsgIDObj const& ExceptionBase::GetBaseMsgIDObj() const
{
    return m_contents->id;
}

std::vector<Argument> const& ExceptionBase::getArguments() const
{
    return m_contents->arguments;
}

std::string const& ExceptionBase::getText() const
{
    return m_contents->text;
}
}  // namespace bedrock::core::except

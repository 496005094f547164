/// \file
/// Assertions about our own code: what must hold whatever a caller does.
///
///     TARNKILN_ASSERT(m_owner, "a snapshot is never announced", m_property);
///
/// A caller's misuse is no matter for an assertion; it raises a `MessageException`.
#pragma once
#include "tarnkiln/Export.h"

#include <ostream>
#include <string_view>

namespace tarn::kiln::support {

/// Where an assertion stands and what it says; all texts are literals.
struct AssertionSite
{
    char const* sentence;
    char const* condition;
    char const* operands;  ///< The operands as written, separated by commas; may be "".
    char const* file;
    int line;
};

/// The standard error stream, after the opening lines of the report of a failed assertion.
TARNKILN_EXPORT std::ostream& beginAssertionReport(AssertionSite const& site);

/// Ends the report and the process.
[[noreturn]] TARNKILN_EXPORT void endAssertionReport(AssertionSite const& site);

/// Prints UTF-16 text as UTF-8; a lone surrogate is printed as U+FFFD.
TARNKILN_EXPORT void printAssertionText(std::ostream& stream, std::u16string_view text);

/// Prints `operand`: texts of both widths, and whatever else goes into a stream.
template <class Operand> void printAssertionOperand(std::ostream& stream, Operand const& operand)
{
    stream << "    ";
    if constexpr (requires { std::u16string_view(operand); })
        printAssertionText(stream, operand);
    else if constexpr (requires { stream << operand; })
        stream << operand;
    else
        stream << "(a value that has no text)";
    stream << '\n';
}

/// Prints the sentence, the condition, the operands and the place, and aborts.
template <class... Operands>
[[noreturn]] void assertionFailed(AssertionSite const& site, Operands const&... operands)
{
    [[maybe_unused]] std::ostream& stream = beginAssertionReport(site);
    (printAssertionOperand(stream, operands), ...);
    endAssertionReport(site);
}

/// Only named, never called: it keeps what unchecked builds do not evaluate in use.
template <class... Ignored> char notEvaluated(Ignored const&... ignored);

}  // namespace tarn::kiln::support

/// Aborts unless `condition` holds. `sentence`, a literal, says what must hold; the operands that
/// follow are printed with it. Neither condition nor operands may have side effects: only builds
/// with `TARNKILN_CHECKED` evaluate them.
#ifdef TARNKILN_CHECKED
#    define TARNKILN_ASSERT(condition, sentence, ...)                                              \
        ((condition) ? static_cast<void>(0)                                                        \
                     : ::tarn::kiln::support::assertionFailed(                                     \
                           {sentence, #condition, "" #__VA_ARGS__, __FILE__,                       \
                            __LINE__} __VA_OPT__(, ) __VA_ARGS__))
#else
#    define TARNKILN_ASSERT(condition, sentence, ...)                                              \
        static_cast<void>(sizeof(::tarn::kiln::support::notEvaluated(                              \
            (condition), sentence __VA_OPT__(, ) __VA_ARGS__)))
#endif

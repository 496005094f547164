#include "textkit/regex/Pattern.h"

#include "textkit/regex/Glob.h"
#include "textkit/regex/RegexError.h"

#define PCRE2_CODE_UNIT_WIDTH 16
#include <pcre2.h>

#include <array>
#include <cstdint>
#include <cstdlib>
#include <new>

namespace textkit::regex {
namespace {

static_assert(sizeof(PCRE2_UCHAR16) == sizeof(char16_t));

constexpr std::size_t LONGEST_PATTERN = 65536;    // code units
constexpr std::uint32_t DEEPEST_NESTING = 250;    // parentheses
constexpr std::int64_t MOST_STEPS = 10'000'000;   // of one search
constexpr std::uint32_t MOST_DEPTH = 10'000'000;  // the heap limit comes first
constexpr std::uint32_t MOST_HEAP = 64 * 1024;    // KiB

template <auto Free> struct FreeBy
{
    template <class T> void operator()(T* object) const { Free(object); }
};

using Code = std::unique_ptr<pcre2_code, FreeBy<pcre2_code_free>>;
using CompileContext = std::unique_ptr<pcre2_compile_context, FreeBy<pcre2_compile_context_free>>;
using MatchContext = std::unique_ptr<pcre2_match_context, FreeBy<pcre2_match_context_free>>;
using MatchData = std::unique_ptr<pcre2_match_data, FreeBy<pcre2_match_data_free>>;

/// What the library allocates is null for want of memory only.
template <class Owner, class T> Owner owned(T* object)
{
    if (!object)
        throw std::bad_alloc();
    return Owner(object);
}

PCRE2_SPTR codeUnits(std::u16string_view text)
{
    // The library refuses null, which an empty view may have.
    return reinterpret_cast<PCRE2_SPTR>(text.empty() ? u"" : text.data());
}

std::string messageOf(int error)
{
    std::array<PCRE2_UCHAR, 256> units = {};
    pcre2_get_error_message(error, units.data(), units.size());
    std::string text;
    for (PCRE2_UCHAR const* unit = units.data(); *unit != 0; ++unit)
        text += static_cast<char>(*unit);  // the messages are ASCII
    return text;
}

/// What a search has cost so far. The match limit of the library does not serve for that, as it
/// counts anew from each place where a match may begin, and counts no text that is passed.
struct Effort
{
    std::int64_t steps = 0;
    std::int64_t position = 0;
};

/// Called by the library before each item of the pattern.
int count(pcre2_callout_block* item, void* data)
{
    Effort& effort = *static_cast<Effort*>(data);
    auto const position = static_cast<std::int64_t>(item->current_position);
    effort.steps += 1 + std::abs(position - effort.position);
    effort.position = position;
    return effort.steps > MOST_STEPS ? PCRE2_ERROR_CALLOUT : 0;
}

Code compile(std::u16string_view pattern, bool caseSensitive)
{
    auto const context = owned<CompileContext>(pcre2_compile_context_create(nullptr));
    pcre2_set_max_pattern_length(context.get(), LONGEST_PATTERN);
    pcre2_set_parens_nest_limit(context.get(), DEEPEST_NESTING);
    pcre2_set_newline(context.get(), PCRE2_NEWLINE_ANY);

    std::uint32_t const options = PCRE2_UTF | PCRE2_MATCH_INVALID_UTF | PCRE2_NEVER_BACKSLASH_C |
                                  PCRE2_DOLLAR_ENDONLY | PCRE2_ALT_BSUX | PCRE2_AUTO_CALLOUT |
                                  (caseSensitive ? 0 : PCRE2_CASELESS);
    int error = 0;
    PCRE2_SIZE place = 0;
    Code code(
        pcre2_compile(codeUnits(pattern), pattern.size(), options, &error, &place, context.get()));
    if (code)
        return code;
    if (error == PCRE2_ERROR_HEAP_FAILED)
        throw std::bad_alloc();
    if (pattern.size() > LONGEST_PATTERN)
        throw RegexError(messageOf(error), pattern);
    throw RegexError(messageOf(error), pattern, place);
}

MatchContext limits()
{
    auto context = owned<MatchContext>(pcre2_match_context_create(nullptr));
    pcre2_set_match_limit(context.get(), MOST_STEPS);
    pcre2_set_depth_limit(context.get(), MOST_DEPTH);
    pcre2_set_heap_limit(context.get(), MOST_HEAP);
    return context;
}
}  // namespace

struct Pattern::Compiled
{
    std::u16string pattern;    // for errors
    std::optional<Glob> glob;  // finds the same as the code, if there is one
    Code code;
    MatchContext context;
    MatchData match;
};

Pattern::Pattern(std::u16string_view pattern, bool caseSensitive)
    : m_compiled(std::make_unique<Compiled>())
{
    m_compiled->code = compile(pattern, caseSensitive);
    m_compiled->pattern = pattern;
    if (caseSensitive)
        m_compiled->glob = Glob::parse(pattern);
    m_compiled->context = limits();
    m_compiled->match = owned<MatchData>(pcre2_match_data_create(1, nullptr));
}

Pattern::Pattern(Pattern&& other) noexcept = default;
Pattern& Pattern::operator=(Pattern&& other) noexcept = default;
Pattern::~Pattern() = default;

bool Pattern::isFoundIn(std::u16string_view subject) const
{
    if (m_compiled->glob)
    {
        if (std::optional<bool> const isFound = m_compiled->glob->isFoundIn(subject, MOST_STEPS))
            return *isFound;
    }
    Effort effort;
    pcre2_match_context* const context = m_compiled->context.get();
    pcre2_set_callout(context, count, &effort);
    int const result =
        pcre2_match(m_compiled->code.get(), codeUnits(subject), subject.size(),
                    /*start_offset=*/0, /*options=*/0, m_compiled->match.get(), context);
    if (result >= 0)
        return true;
    if (result == PCRE2_ERROR_NOMATCH)
        return false;
    if (result == PCRE2_ERROR_NOMEMORY)
        throw std::bad_alloc();
    if (result == PCRE2_ERROR_CALLOUT || result == PCRE2_ERROR_MATCHLIMIT)
        throw RegexError("search given up after too many steps", m_compiled->pattern);
    if (result == PCRE2_ERROR_HEAPLIMIT || result == PCRE2_ERROR_DEPTHLIMIT)
        throw RegexError("search given up, as it would take too much memory", m_compiled->pattern);
    throw RegexError(messageOf(result), m_compiled->pattern);
}
}  // namespace textkit::regex

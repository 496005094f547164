#include "tarnkiln/query/internal/ByteRegex.h"

#include <algorithm>
#include <iterator>
#include <string_view>

namespace tarn::kiln::internal {
namespace {

[[noreturn]] void fail(std::regex_constants::error_type code)
{
    throw std::regex_error(code);
}

/// Counts what matching one text costs.
class Effort
{
public:
    void step()
    {
        if (++m_steps > ByteRegex::MOST_STEPS)
            fail(std::regex_constants::error_complexity);
    }

private:
    std::size_t m_steps = 0;
};

/// Walks over a text and counts each look at it: the standard library looks once for each item of
/// the pattern that it tries.
class CountingIterator
{
public:
    using iterator_category = std::bidirectional_iterator_tag;
    using value_type = char;
    using difference_type = std::ptrdiff_t;
    using pointer = char const*;
    using reference = char const&;

    CountingIterator() = default;
    CountingIterator(char const* at, Effort* effort) : m_at(at), m_effort(effort) {}

    reference operator*() const
    {
        m_effort->step();
        return *m_at;
    }
    CountingIterator& operator++()
    {
        ++m_at;
        return *this;
    }
    CountingIterator operator++(int)
    {
        CountingIterator const old = *this;
        ++m_at;
        return old;
    }
    CountingIterator& operator--()
    {
        --m_at;
        return *this;
    }
    CountingIterator operator--(int)
    {
        CountingIterator const old = *this;
        --m_at;
        return old;
    }
    bool operator==(CountingIterator const& other) const { return m_at == other.m_at; }

private:
    char const* m_at = nullptr;
    Effort* m_effort = nullptr;
};

bool isDigit(char byte)
{
    return byte >= '0' && byte <= '9';
}

/// Reads a pattern just closely enough to know what the standard library will make of it.
///
/// Whether the pattern is well formed is not its business.
class PatternSurvey
{
public:
    /// \throws std::regex_error  if the pattern is beyond the limits.
    explicit PatternSurvey(std::string_view pattern) : m_pattern(pattern)
    {
        while (m_at < m_pattern.size())
            readItem();
        for (std::size_t const open : m_outer)
            add(open);
    }

    std::size_t getItems() const { return m_items; }
    bool refersBack() const { return m_refersBack; }

private:
    void readItem()
    {
        switch (char const byte = m_pattern[m_at++])
        {
        case '\\':
            readEscape();
            break;
        case '[':
            readClass();
            break;
        case '(':
            if (m_outer.size() == ByteRegex::DEEPEST_NESTING)
                fail(std::regex_constants::error_stack);
            m_outer.push_back(m_items);
            m_items = 0;
            m_last = 0;
            break;
        case ')':
            closeGroup();
            break;
        case '{':
            readRepetition();
            break;
        case '*':
        case '+':
        case '?':
            add(1);
            ++m_last;
            break;
        default:
            addItem(byte == '|' ? 0 : 1);
            break;
        }
    }
    void readEscape()
    {
        if (m_at < m_pattern.size())
        {
            char const escaped = m_pattern[m_at++];
            m_refersBack |= isDigit(escaped) && escaped != '0';
        }
        addItem(1);
    }
    void readClass()
    {
        // A bracket that stands first is one of the class, and so is an escaped one.
        if (m_at < m_pattern.size() && m_pattern[m_at] == '^')
            ++m_at;
        if (m_at < m_pattern.size() && m_pattern[m_at] == ']')
            ++m_at;
        while (m_at < m_pattern.size() && m_pattern[m_at] != ']')
            m_at += m_pattern[m_at] == '\\' ? 2 : 1;
        ++m_at;
        addItem(1);
    }
    void closeGroup()
    {
        if (m_outer.empty())
            return;
        std::size_t const inner = m_items + 2;
        m_items = m_outer.back();
        m_outer.pop_back();
        add(inner);
        m_last = inner;
    }
    void readRepetition()
    {
        std::size_t times = readNumber();
        if (m_at < m_pattern.size() && m_pattern[m_at] == ',')
        {
            ++m_at;
            times = std::max(times + 1, readNumber());
        }
        if (m_at < m_pattern.size() && m_pattern[m_at] == '}')
            ++m_at;
        // An optional repetition also has a branch each.
        m_last = std::min(m_last + 1, LIMIT) * std::min(times, LIMIT);
        add(m_last);
    }
    std::size_t readNumber()
    {
        std::size_t number = 0;
        for (; m_at < m_pattern.size() && isDigit(m_pattern[m_at]); ++m_at)
            number = std::min(number * 10 + static_cast<std::size_t>(m_pattern[m_at] - '0'), LIMIT);
        return number;
    }
    void addItem(std::size_t last)
    {
        add(1);
        m_last = last;
    }
    void add(std::size_t items)
    {
        m_items += items;
        if (m_items > ByteRegex::MOST_ITEMS)
            fail(std::regex_constants::error_space);
    }

    static constexpr std::size_t LIMIT = ByteRegex::MOST_ITEMS + 1;

    std::string_view m_pattern;
    std::size_t m_at = 0;
    std::size_t m_items = 0;  ///< Of the innermost open group.
    std::size_t m_last = 0;   ///< Of the item that a repetition would repeat.
    std::vector<std::size_t> m_outer;
    bool m_refersBack = false;
};

std::regex compile(string const& pattern, bool refersBack)
{
    using namespace std::regex_constants;
    if (refersBack)
        return std::regex(pattern, ECMAScript);
    // Without groups to remember all ways can be followed at once: the library's own extension.
    return std::regex(pattern, ECMAScript | nosubs | __polynomial);
}

bool isLineEnd(char byte)
{
    return byte == '\n' || byte == '\r';
}
}  // namespace

ByteRegex::ByteRegex(string const& pattern)
{
    PatternSurvey const survey(pattern);
    m_items = survey.getItems();
    m_refersBack = survey.refersBack();
    m_isGlob = compileGlob(pattern);
    if (!m_isGlob)
        m_regex = compile(pattern, m_refersBack);
}

bool ByteRegex::matches(string const& text) const
{
    if (m_isGlob)
        return matchesGlob(text);
    if (m_refersBack && (text.size() + 1) * (m_items + 1) > MOST_BACKTRACKING)
        fail(std::regex_constants::error_stack);
    Effort effort;
    CountingIterator const begin(text.data(), &effort);
    CountingIterator const end(text.data() + text.size(), &effort);
    return std::regex_match(begin, end, m_regex);
}

/// False if there is more in the pattern than a glob can tell.
bool ByteRegex::compileGlob(string const& pattern)
{
    constexpr std::string_view SPECIAL("^$\\.*+?()[]{}|\0", 15);
    for (std::size_t at = 0; at < pattern.size(); ++at)
    {
        char const byte = pattern[at];
        char const next = at + 1 < pattern.size() ? pattern[at + 1] : '\0';
        if (byte == '\\' && next != '\0' && SPECIAL.find(next) != SPECIAL.npos)
        {
            m_glob.push_back({GlobItem::Byte, next});
            ++at;
        }
        else if (byte == '.')
        {
            m_glob.push_back({next == '*' ? GlobItem::AnyBytes : GlobItem::AnyByte, '\0'});
            at += next == '*';
        }
        else if (SPECIAL.find(byte) == SPECIAL.npos)
        {
            m_glob.push_back({GlobItem::Byte, byte});
        }
        else
        {
            return false;
        }
    }
    return true;
}

/// Text that stands behind ".*" is matched at the first place where it can be. A later place is
/// never better, since what ".*" may pass does not depend on where it begins.
bool ByteRegex::matchesGlob(string const& text) const
{
    constexpr std::size_t NONE = ~std::size_t{0};
    Effort effort;
    std::size_t at = 0;
    std::size_t item = 0;
    std::size_t star = NONE;  // the last ".*" that was passed
    std::size_t starEnd = 0;  // how far it reaches
    while (at < text.size())
    {
        effort.step();
        GlobItem const* const wanted = item < m_glob.size() ? &m_glob[item] : nullptr;
        if (wanted && wanted->kind == GlobItem::AnyBytes)
        {
            star = item++;
            starEnd = at;
        }
        else if (wanted &&
                 (wanted->kind == GlobItem::Byte ? wanted->byte == text[at] : !isLineEnd(text[at])))
        {
            ++item;
            ++at;
        }
        else if (star != NONE && !isLineEnd(text[starEnd]))
        {
            item = star + 1;
            at = ++starEnd;
        }
        else
        {
            return false;
        }
    }
    return std::all_of(m_glob.begin() + static_cast<std::ptrdiff_t>(item), m_glob.end(),
                       [](GlobItem const& rest) { return rest.kind == GlobItem::AnyBytes; });
}
}  // namespace tarn::kiln::internal

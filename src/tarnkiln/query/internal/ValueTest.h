/// \file
/// A value constraint as a test of what elements keep.
#pragma once
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/PropertyRelationValueConstraint.h"
#include "tarnkiln/query/internal/RegexCache.h"

#include <cstdint>
#include <deque>
#include <tuple>

namespace tarn::kiln::internal {

/// Answers for a kept value what the constraint would answer for the `Value` of it.
struct ValueTest
{
    enum class Answer : std::uint8_t
    {
        No,
        Yes,
        Compare,  ///< What `compare` says of the payload.
        Ask       ///< The constraint must read the value itself, and may fail.
    };

    Answer single = Answer::Ask;
    Answer optional = Answer::Ask;
    Answer absent = Answer::Ask;
    /// Whether a kept value passes that has a payload.
    bool (*compare)(KeptValue const& value, void const* other) = nullptr;
    void const* other = nullptr;

    Answer answerFor(KeptValue::Shape shape) const
    {
        switch (shape)
        {
        case KeptValue::Shape::Single:
            return single;
        case KeptValue::Shape::Optional:
            return optional;
        case KeptValue::Shape::Absent:
            return absent;
        case KeptValue::Shape::Unknown:
            break;
        }
        return Answer::Ask;
    }
};

/// Makes the tests of one run, and owns what they compare with.
class ValueTests
{
public:
    explicit ValueTests(RegexCache& regexes) : m_regexes(regexes) {}

    /// \param kind  of the place of the values, which is known.
    /// \param type  the type of the values.
    ValueTest make(PropertyRelationValueConstraint const& constraint, SlotKind kind,
                   meta::Type const& type);

    /// A pattern that is compiled when a text is first matched.
    template <class Text> struct LazyRegex
    {
        bool matches(Text const& text) const
        {
            if (!compiled)
                compiled = &regexes.compiled(pattern);
            return RegexCache::matches(*compiled, text);
        }

        RegexCache& regexes;
        Text const& pattern;
        mutable RegexCache::Compiled<Text> const* compiled = nullptr;
    };

private:
    template <class T>
    ValueTest makeFor(PropertyRelationValueConstraint const& constraint, meta::Type const& type);
    template <class T>
    ValueTest makeOrdering(PropertyRelationValueConstraint const& constraint, bool required,
                           bool (*compare)(KeptValue const&, void const*));
    template <class Text> ValueTest makeRegexp(PropertyRelationValueConstraint const& constraint);
    ValueTest makeForLiteral(PropertyRelationValueConstraint const& constraint, bool required);

    RegexCache& m_regexes;
    std::deque<int> m_numbers;
    std::tuple<std::deque<LazyRegex<string>>, std::deque<LazyRegex<ustring>>> m_lazyRegexes;
};
}  // namespace tarn::kiln::internal

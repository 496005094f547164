#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"

namespace tarn::kiln::meta {

namespace {

/// The first live literal, by name, that `suits`.
template <class Suits> EnumLiteral findLiteral(Enum::Impl const& enumeration, Suits suits)
{
    for (auto const& [name, literal] : enumeration.getLiterals())
    {
        if (literal && suits(*literal.getImpl()))
            return literal;
    }
    return EnumLiteral();
}
}  // namespace

EnumLiteral Enum::Impl::findLiteralByValue(int value) const
{
    return findLiteral(*this, [&](auto const& literal) { return literal.getValue() == value; });
}

EnumLiteral Enum::Impl::findLiteralByPublicIdentifier(ustring const& identifier) const
{
    return findLiteral(
        *this, [&](auto const& literal) { return literal.getPublicIdentifier() == identifier; });
}
}  // namespace tarn::kiln::meta

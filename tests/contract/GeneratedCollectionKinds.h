/// \file
/// The kinds of collections that generated classes have.
#pragma once
#include "shapes/Money.h"
#include "shapes/NodeImpl.h"
#include "shapes/ValuesImpl.h"
#include "tests/contract/CollectionKinds.h"

#include <array>

namespace testkit {

template <> struct Entries<shapes::Colour>
{
    static shapes::Colour make(Model const&, int number)
    {
        using enum shapes::Colour;
        return std::array{Red, Green, None}.at(static_cast<std::size_t>(number));
    }
};
template <> struct Entries<shapes::Money>
{
    static shapes::Money make(Model const&, int number)
    {
        shapes::Money money;
        money.setAmount(number);
        return money;
    }
};

namespace generated {

using ValuesImpl = shapes::Values::Impl;
using NodeImpl = shapes::Node::Impl;

struct Numbers : PropertyKind<&ValuesImpl::getNumbers, ValuesImpl::NUMBERS, false>
{
    static constexpr char const* NAME = "Numbers";
};
struct Labels : PropertyKind<&ValuesImpl::getLabels, ValuesImpl::LABELS, true>
{
    static constexpr char const* NAME = "Labels";
};
struct Words : PropertyKind<&ValuesImpl::getWords, ValuesImpl::WORDS>
{
    static constexpr char const* NAME = "Words";
};
struct Colours : PropertyKind<&ValuesImpl::getColours, ValuesImpl::COLOURS, false>
{
    static constexpr char const* NAME = "Colours";
};
struct Palette : PropertyKind<&ValuesImpl::getPalette, ValuesImpl::PALETTE>
{
    static constexpr char const* NAME = "Palette";
};
struct Payments : PropertyKind<&ValuesImpl::getPayments, ValuesImpl::PAYMENTS, false>
{
    static constexpr char const* NAME = "Payments";
};
struct Prices : PropertyKind<&ValuesImpl::getPrices, ValuesImpl::PRICES>
{
    static constexpr char const* NAME = "Prices";
};

struct Owned : PropertyKind<&NodeImpl::getOwned, NodeImpl::OWNED, true>
{
    static constexpr char const* NAME = "Owned";
};
struct Links : PropertyKind<&NodeImpl::getLinks, NodeImpl::LINKS, true>
{
    static constexpr char const* NAME = "Links";
};
struct Children : PropertyKind<&NodeImpl::getChildren, NodeImpl::CHILDREN, true>
{
    static constexpr char const* NAME = "Children";
};
struct Parts : PropertyKind<&NodeImpl::getParts, NodeImpl::PARTS, true>
{
    static constexpr char const* NAME = "Parts";
};
struct Marks : PropertyKind<&NodeImpl::getMarks, NodeImpl::MARKS>
{
    static constexpr char const* NAME = "Marks";
};
struct Named : PropertyKind<&NodeImpl::getNamed, NodeImpl::NAMED, &nameOf<shapes::Node>>
{
    static constexpr char const* NAME = "Named";
};
struct Grouped : PropertyKind<&NodeImpl::getGrouped, NodeImpl::GROUPED, &nameOf<shapes::Node>>
{
    static constexpr char const* NAME = "Grouped";
};
struct Listed : PropertyKind<&NodeImpl::getListed, NodeImpl::LISTED, &nameOf<shapes::Node>>
{
    static constexpr char const* NAME = "Listed";
};
}  // namespace generated
}  // namespace testkit

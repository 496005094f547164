/// \file
/// A property of a search instance that refers to elements.
///
///     book.author.refersTo(author);      // a join with the search instance `author`
///     book.author == jane;               // a certain element
///     book.author == Author();           // no element
#pragma once
#include "tarnkiln/query/AbstractConstrainable.h"
#include "tarnkiln/query/InstanceAttachment.h"

#include <concepts>

namespace tarn::kiln::query {

/// One property whose type is the class `C`, by which constraints on it are stated.
///
/// Each operation adds one constraint to the query and returns nothing; all constraints of a query
/// must hold. A property with many values suits if one of them does.
///
/// \throws tarnkiln::query::NoSuchInstanceId  if the query was reset, or the other instance belongs
///     to another query.
template <class C, class Attachment>
class ConstrainableRelationWithAttachment : public AbstractConstrainable<C, Attachment, false>
{
public:
    using AbstractConstrainable<C, Attachment, false>::AbstractConstrainable;

    /// The property is to refer to the element of `target`, a search instance. A proxy that is not
    /// resolved counts by the UUID that it names, and stays as it is.
    template <class Instance> void refersTo(Instance const& target) const
    {
        static_assert(SearchInstance<Instance>,
                      "refersTo takes a search instance; use == for an element");
        if constexpr (SearchInstance<Instance>)
        {
            requireRelated<typename Instance::Handle>();
            this->getAttachment().getInstance().constrainTarget(this->getProperty(), target);
        }
    }

    /// The property is to refer to an element, to none if the handle is empty, or to the same one
    /// as another member. Proxies are resolved to tell.
    template <class Operand> void operator==(Operand const& operand) const
    {
        compare(ValueMatchRelation::equal, operand);
    }
    template <class Operand> void operator!=(Operand const& operand) const
    {
        compare(ValueMatchRelation::notEqual, operand);
    }

private:
    template <class Operand> void compare(ValueMatchRelation relation, Operand const& operand) const
    {
        if constexpr (Constrainable<Operand>)
        {
            static_assert(std::same_as<typename Operand::Type, C>,
                          "members of different types can't be compared");
            if constexpr (std::same_as<typename Operand::Type, C>)
                this->constrainByMember(relation, operand);
        }
        else
        {
            static_assert(!SearchInstance<Operand>, "use refersTo for a search instance");
            static_assert(SearchInstance<Operand> || support::ElementReference<Operand>,
                          "a reference can be compared with elements and references only");
            if constexpr (support::ElementReference<Operand>)
            {
                requireRelated<Operand>();
                // The value has the property's class, which the handle's may extend.
                ModelElement const& element = operand;
                this->constrain(relation, Value::createElementValue(this->getProperty(), element));
            }
        }
    }

    /// An element of the one class may be one of the other only if one of them extends the other.
    template <class Other> static constexpr void requireRelated()
    {
        static_assert(std::derived_from<Other, C> || std::derived_from<C, Other>,
                      "the property refers to elements of another class");
    }
};

/// A member of a search instance in generated code.
template <class C>
using ConstrainableReference = ConstrainableRelationWithAttachment<C, InstanceAttachment>;
}  // namespace tarn::kiln::query

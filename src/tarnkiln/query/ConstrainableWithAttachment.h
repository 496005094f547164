/// \file
/// A property of a search instance whose values are plain.
///
///     book.title == u"Emma";             // states a constraint; gives nothing
///     book.year >= 1800;
///     book.title.like(u"E_ma%");
///     book.title == film.title;          // a join of two search instances
#pragma once
#include "tarnkiln/query/AbstractConstrainable.h"
#include "tarnkiln/query/ConstraintOperand.h"
#include "tarnkiln/query/InstanceAttachment.h"

namespace tarn::kiln::query {

/// One property of a value type, by which constraints on it are stated.
///
/// Each operation adds one constraint to the query and returns nothing; all constraints of a query
/// must hold. The member stands on the left, on the right one of these:
///
/// - a value: `u"..."` for `String`, `"..."` for `StdString`, a literal for an enumeration, any
///   number for `Real`, and for integers one of any integer type;
/// - `boost::none` or a `boost::optional`, as only `==` and `!=` can ask for an absent value;
/// - a member with the same type of values, of another instance or of the same one.
///
/// A property with many values suits if one of them does; it can't be compared with a member of the
/// same instance, which the run of the query tells. An absent value equals `boost::none` only,
/// differs from every value, and stands in no order; but an absent literal of an enumeration
/// differs from `boost::none` only, from which no other literal differs.
///
/// What types can tell is refused by the compiler: values of data types, order between literals,
/// patterns for anything but required texts.
///
/// \throws tarnkiln::query::NoSuchInstanceId  if the query was reset, or a member belongs to
///     another query.
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the property's type)
///     if a number can't be a value of the property.
template <class T, class Attachment, bool Flag = false, class = void>
class ConstrainableWithAttachment : public AbstractConstrainable<T, Attachment, Flag>
{
public:
    using AbstractConstrainable<T, Attachment, Flag>::AbstractConstrainable;

    template <class Operand> void operator==(Operand const& operand) const
    {
        compare(ValueMatchRelation::equal, operand);
    }
    template <class Operand> void operator!=(Operand const& operand) const
    {
        compare(ValueMatchRelation::notEqual, operand);
    }
    template <class Operand> void operator<(Operand const& operand) const
    {
        order(ValueMatchRelation::less, operand);
    }
    template <class Operand> void operator<=(Operand const& operand) const
    {
        order(ValueMatchRelation::lessOrEqual, operand);
    }
    template <class Operand> void operator>(Operand const& operand) const
    {
        order(ValueMatchRelation::greater, operand);
    }
    template <class Operand> void operator>=(Operand const& operand) const
    {
        order(ValueMatchRelation::greaterOrEqual, operand);
    }

    /// The text is to match a pattern, in which "%" stands for any text and "_" for one character.
    ///
    /// A `StdString` must match as a whole, in a `String` the pattern is searched; neither wildcard
    /// stands for a line end. One character of a `StdString` is one byte.
    template <class Operand> void like(Operand const& pattern) const
    {
        requirePatterns();
        static_assert(!Constrainable<Operand>, "a like pattern can't come from another member");
        if constexpr (!Constrainable<Operand>)
            text(ValueMatchRelation::like, pattern);
    }
    /// The text is to match a regular expression: a `StdString` as a whole, one in the syntax of
    /// ECMAScript; in a `String` one in the syntax of Perl is searched. A member may give it.
    ///
    /// What is wrong with an expression is found out when the query runs, and raised as a
    /// `std::runtime_error`.
    template <class Operand> void regexp(Operand const& expression) const
    {
        requirePatterns();
        text(ValueMatchRelation::regexp, expression);
    }
    /// The text is to equal another one but for the case of its letters. An absent text suits none
    /// but the absent text of another member.
    template <class Operand> void equalNoCase(Operand const& operand) const
    {
        text(ValueMatchRelation::equalStringNocase, operand);
    }

private:
    template <class Operand> void compare(ValueMatchRelation relation, Operand const& operand) const
    {
        static_assert(!Composed<T>, "values of data types can't be compared in queries");
        if constexpr (Constrainable<Operand>)
            this->compareMember(relation, operand);
        else if constexpr (!Composed<T>)
            this->compareValue(relation, operand);
    }

    template <class Operand> void order(ValueMatchRelation relation, Operand const& operand) const
    {
        static_assert(!std::is_enum_v<T>, "literals of enumerations have no order in queries");
        static_assert(!isOptional<Operand>, "only == and != can ask for an absent value");
        if constexpr (!std::is_enum_v<T> && !isOptional<Operand>)
            compare(relation, operand);
    }

    template <class Operand> void text(ValueMatchRelation relation, Operand const& operand) const
    {
        static_assert(Text<T>, "only texts can be matched like this");
        if constexpr (!Text<T>)
            return;
        else if constexpr (Constrainable<Operand>)
            this->compareMember(relation, operand);
        else
        {
            requireValue<Operand>();
            if constexpr (ValueFor<Operand, T>)
                this->constrain(relation,
                                support::PlainField<T>::toValue(
                                    this->getProperty(), toPlain<T>(this->getProperty(), operand)));
        }
    }

    template <class Operand>
    void compareMember(ValueMatchRelation relation, Operand const& member) const
    {
        static_assert(std::same_as<typename Operand::Type, T>,
                      "members of different types can't be compared");
        if constexpr (std::same_as<typename Operand::Type, T>)
            this->constrainByMember(relation, member);
    }

    template <class Operand>
    void compareValue(ValueMatchRelation relation, Operand const& operand) const
    {
        if constexpr (!isOptional<Operand>)
            requireValue<Operand>();
        else
            static_assert(OperandFor<Operand, T>, "the optional value is not of the member's type");
        if constexpr (OperandFor<Operand, T>)
            this->constrain(relation, operandValue<T>(this->getProperty(),
                                                      toOptional<T>(this->getProperty(), operand)));
    }

    template <class Operand> static constexpr void requireValue()
    {
        static_assert(
            ValueFor<Operand, T>,
            "the operand is not of the member's type: a String is compared with u\"...\", a "
            "StdString with \"...\", an enumeration with its literals");
    }

    static constexpr void requirePatterns()
    {
        static_assert(!Text<T> || Flag,
                      "patterns can be asked of required texts only, not of optional ones");
    }
};

/// A member of a search instance in generated code.
template <class T, bool Flag = false>
using ConstrainableValue = ConstrainableWithAttachment<T, InstanceAttachment, Flag, void>;
}  // namespace tarn::kiln::query

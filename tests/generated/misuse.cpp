// Constraints that the compiler refuses. Each line tells what its error says; misuse.py compiles
// the file and compares.
#include "shapes/KeyedConstrainables.h"
#include "shapes/NodeConstrainables.h"
#include "shapes/OptionalsConstrainables.h"
#include "shapes/ScalarsConstrainables.h"

namespace testkit::shapes {

void misuse(Scalars::Constrainables& plain, Optionals::Constrainables& optional,
            Node::Constrainables& node, Keyed::Constrainables& keyed, Money const& money,
            Node const& element, Scalars const& other)
{
    plain.text == "Emma";                 // error: the operand is not of the member's type
    plain.bytes == u"Emma";               // error: the operand is not of the member's type
    plain.text == 5;                      // error: the operand is not of the member's type
    plain.integer == 5.0;                 // error: the operand is not of the member's type
    plain.integer < u"5";                 // error: the operand is not of the member's type
    plain.integer8 == 'c';                // error: the operand is not of the member's type
    plain.isSet == 1;                     // error: the operand is not of the member's type
    plain.colour == 3;                    // error: the operand is not of the member's type
    plain.id == u"not an id";             // error: the operand is not of the member's type
    optional.integer == boost::optional<ustring>();  // error: the optional value is not
    plain.colour < Colour::Red;           // error: literals of enumerations have no order
    plain.colour >= keyed.colour;         // error: literals of enumerations have no order
    optional.integer < boost::none;       // error: only == and != can ask for an absent value
    plain.money == money;                 // error: values of data types can't be compared
    plain.money != keyed.money;           // error: values of data types can't be compared
    optional.text.like(u"E%");            // error: patterns can be asked of required texts only
    optional.bytes.regexp("E.*");         // error: patterns can be asked of required texts only
    plain.integer.like(u"5%");            // error: only texts can be matched like this
    plain.integer.equalNoCase(5);         // error: only texts can be matched like this
    plain.text.like(plain.text);          // error: a like pattern can't come from another member
    plain.text.regexp("E.*");             // error: the operand is not of the member's type
    plain.text == plain.bytes;            // error: members of different types can't be compared
    plain.integer < plain.integer64;      // error: members of different types can't be compared
    plain.text == node.buddy;             // error: members of different types can't be compared
    node.buddy == node.described;         // error: members of different types can't be compared
    node.buddy == other;                  // error: the property refers to elements of another class
    node.buddy == node;                   // error: use refersTo for a search instance
    node.buddy == u"name";                // error: a reference can be compared with elements and ref
    node.buddy.refersTo(element);         // error: refersTo takes a search instance
    node.buddy.refersTo(keyed);           // error: the property refers to elements of another class
    node.buddy < element;                 // error: no match for 'operator<'
    plain.text = u"Emma";                 // error: no match for 'operator='
    bool const found = plain.integer == 5;  // error: void value not ignored as it ought to be
}
}  // namespace testkit::shapes

// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/Size.h"

#include "tarnkiln/support/CompareFields.h"
#include "tarnkiln/support/ValueAccess.h"

namespace acme::garden {

int Size::compareWith(Size const& other) const
{
    if (int const order = support::compareFields(m_length, other.m_length))
        return order;
    if (int const order = support::compareFields(m_width, other.m_width))
        return order;
    return 0;
}
}  // namespace acme::garden

TARNKILN_VALUE_ACCESS(acme::garden::Size)

// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The values of the data type `Size`.
#pragma once
#include "acme/garden/Fwd.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/ValueTraits.h"
#include "tarnkiln/meta/StandardTypeOf.h"

#include <boost/optional.hpp>

namespace acme::garden {

/// How much room something takes.
///
/// A plain value, copied and compared by its fields.
class Size
{
public:
    Size() = default;

    /// In metres.
    double getLength() const { return m_length; }
    void setLength(double length) { m_length = length; }

    /// In metres, if it matters.
    boost::optional<double> const& getWidth() const { return m_width; }
    void setWidth(boost::optional<double> const& width) { m_width = width; }

    /// Negative, 0 or positive; fields in the order of their declaration.
    int compareWith(Size const& other) const;
    bool operator==(Size const& other) const { return compareWith(other) == 0; }
    bool operator<(Size const& other) const { return compareWith(other) < 0; }

private:
    double m_length = 0;
    boost::optional<double> m_width;
};
}  // namespace acme::garden

template <>
inline constexpr bool tarn::kiln::support::isDataType<acme::garden::Size> = true;

namespace tarn::kiln::meta {
template <> Type const& standardTypeOf<acme::garden::Size>();
}  // namespace tarn::kiln::meta

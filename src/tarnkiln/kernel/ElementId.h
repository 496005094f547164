/// \file
/// The identifier of an element, as documents and proxies give it.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <iosfwd>

namespace tarn::kiln {

/// An identifier of some type, by which a resolver finds an element; ordered by type, then value.
class TARNKILN_EXPORT ElementId
{
public:
    /// The type of identifiers that are the text form of a UUID: "uuid".
    static ustring const UUID_TYPE;

    ElementId() = default;
    ElementId(ustring type, ustring id);

    ustring const& getType() const { return m_type; }
    ustring const& getId() const { return m_id; }

    /// Negative, 0 or positive: types by code unit first, then identifiers.
    int compare(ElementId const& other) const;
    bool operator<(ElementId const& other) const { return compare(other) < 0; }

private:
    ustring m_type;
    ustring m_id;
};

/// Shows type and identifier to people, as `uuid:8d5a0ea6-...`.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ElementId const& id);
}  // namespace tarn::kiln

/// \file
/// The detached description of an extension.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <cstdint>

namespace tarn::kiln::meta {

/// What an extension is to look like: cardinality, flags, name, and its type by qualified name.
/// A plain value; an `upper` of 0xFFFFFFFF means unbounded.
class TARNKILN_EXPORT ExtensionPrototype
{
public:
    ExtensionPrototype() = default;

    std::uint32_t getLower() const { return m_lower; }
    std::uint32_t getUpper() const { return m_upper; }
    bool isOrdered() const { return m_isOrdered; }
    bool isUnique() const { return m_isUnique; }
    ustring const& getName() const { return m_name; }
    ustring const& getTypeName() const { return m_typeName; }

    void setLower(std::uint32_t lower) { m_lower = lower; }
    void setUpper(std::uint32_t upper) { m_upper = upper; }
    void setIsOrdered(bool ordered) { m_isOrdered = ordered; }
    void setIsUnique(bool unique) { m_isUnique = unique; }
    void setName(ustring const& name) { m_name = name; }
    void setTypeName(ustring const& typeName) { m_typeName = typeName; }

    /// Negative, 0 or positive; fields in declaration order, texts by code unit.
    int compareWith(ExtensionPrototype const& other) const;
    bool operator==(ExtensionPrototype const& other) const { return compareWith(other) == 0; }
    bool operator<(ExtensionPrototype const& other) const { return compareWith(other) < 0; }

private:
    std::uint32_t m_lower = 0;
    std::uint32_t m_upper = 1;
    bool m_isOrdered = false;
    bool m_isUnique = true;
    ustring m_name;
    ustring m_typeName;
};
}  // namespace tarn::kiln::meta

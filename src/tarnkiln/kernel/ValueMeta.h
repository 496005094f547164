/// \file
/// The type and the shape of a value.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ValueFlags.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln {

/// All that a `Value` says about itself but its payload.
///
/// Threads: a plain value; distinct objects may be used on distinct threads.
class TARNKILN_EXPORT ValueMeta
{
public:
    /// What a value of `property`, which must not be empty, looks like.
    explicit ValueMeta(meta::Property const& property);
    explicit ValueMeta(meta::Type const& type, ValueFlags flags = ValueFlags::Single)
        : m_type(type),
          m_flags(flags)
    {}

    ValueMeta(ValueMeta const& other) = default;
    /// Copies: the other one stays as it is.
    ValueMeta(ValueMeta&& other) noexcept : ValueMeta(static_cast<ValueMeta const&>(other)) {}
    ~ValueMeta() = default;
    ValueMeta& operator=(ValueMeta const& other) = default;
    ValueMeta& operator=(ValueMeta&& other) noexcept
    {
        return *this = static_cast<ValueMeta const&>(other);
    }

    /// The type of the value, or of the entries of a collection.
    meta::Type const& getType() const { return m_type; }
    /// The type of the keys of a map or multimap; empty for all others.
    meta::Type const& getKeyType() const { return m_keyType; }
    ValueFlags getFlags() const { return m_flags; }
    /// Whether the value travels in the form for code that has no classes for its types.
    bool isReflective() const { return m_reflective; }
    /// Whether a collection is one that an element owns, and not a container of the value's own.
    bool isManaged() const { return m_managed; }

    /// Marks the value as reflective; if its type is a class, that becomes the class of all
    /// elements.
    void setReflective();
    void setUnmanaged() { m_managed = false; }

    /// The shape that values of `property`, which must not be empty, have.
    static ValueFlags doGetFlags(meta::Property const& property);

protected:
    meta::Type m_type;
    meta::Type m_keyType;
    ValueFlags m_flags;
    bool m_reflective = false;
    bool m_managed = true;
};
}  // namespace tarn::kiln

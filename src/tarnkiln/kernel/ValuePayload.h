/// \file
/// The room in which a `Value` keeps what it holds.
#pragma once
#include "tarnkiln/Export.h"

#include <cstddef>
#include <cstring>
#include <utility>

namespace tarn::kiln {

/// An object of any type, owned, or the address of something that is not.
///
/// A small object lies in the payload itself, any other on the heap. An owned payload that is
/// empty, such as one that was moved from, still knows its type.
///
/// Threads: as a plain value; what it holds may be read by several.
///
/// What creates and reads payloads of a type is in support/ValuePayload.h, for those sources that
/// know the type.
class TARNKILN_EXPORT ValuePayload
{
public:
    /// What to do with payloads of one type. Its address stands for the type.
    struct Functions
    {
        bool isTrivial;  ///< In place, copied as bytes, with nothing to be done at the end.
        void (*destroy)(void* payload);
        /// To `place` if such payloads lie in place, else to the heap; returns where.
        void* (*copy)(void const* payload, void* place);
        void (*relocate)(void* from, void* to) noexcept;
        bool (*equals)(void const* left, void const* right);
    };
    static constexpr std::size_t ROOM = 32;  ///< Of what lies in place: a text does.

    ValuePayload() = default;
    ValuePayload(ValuePayload const& other) : m_functions(other.m_functions)
    {
        if (!other.m_functions || !other.m_data)
            m_data = other.m_data;
        else if (other.m_functions->isTrivial)
            copyBytes(other);
        else
            m_data = m_functions->copy(other.m_data, m_place);
    }
    /// Leaves the other one empty, and of the same type.
    ValuePayload(ValuePayload&& other) noexcept : m_functions(other.m_functions) { take(other); }
    ~ValuePayload()
    {
        if (m_data && m_functions && !m_functions->isTrivial)
            m_functions->destroy(m_data);
    }
    ValuePayload& operator=(ValuePayload const&) = delete;
    ValuePayload& operator=(ValuePayload&&) = delete;
    void swap(ValuePayload& other) noexcept;

    /// Not owned ones are equal if they are the same object; null equals nothing but null, and what
    /// is of another type nothing at all.
    bool operator==(ValuePayload const& other) const;

    /// Null if there is none.
    void* address() const { return m_data; }
    bool isOwned() const { return m_functions != nullptr; }
    template <class T> bool isOf() const;
    bool isOf(Functions const& functions) const { return m_functions == &functions; }

    /// \name Filling one that holds nothing yet
    /// @{
    void share(void* object) { m_data = object; }
    template <class T> void setType();
    template <class T> void store(T const& object);
    /// Makes it an object of a trivial type that begins with these bytes.
    void storeBytes(Functions const& functions, void const* bytes, std::size_t size)
    {
        m_functions = &functions;
        m_data = std::memcpy(m_place, bytes, size);
    }
    /// @}

private:
    void copyBytes(ValuePayload const& other)
    {
        std::memcpy(m_place, other.m_place, ROOM);
        m_data = m_place;
    }
    void take(ValuePayload& other) noexcept
    {
        if (other.m_data != other.m_place)
            m_data = std::exchange(other.m_data, nullptr);
        else
            takeObject(other);
    }
    void takeObject(ValuePayload& other) noexcept;

    Functions const* m_functions = nullptr;  ///< Null: the payload is not owned.
    void* m_data = nullptr;                  ///< Null, `m_place`, or an object elsewhere.
    alignas(void*) std::byte m_place[ROOM];
};
}  // namespace tarn::kiln

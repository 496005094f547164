/// \file
/// How one property of many elements is read fast.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"

#include <cstddef>
#include <cstring>
#include <memory>
#include <type_traits>
#include <typeinfo>

namespace tarn::kiln::meta {

/// Finds where elements keep the value of a property; remembers it for the last kind of elements.
///
/// Threads: one.
class TARNKILN_EXPORT PropertyPlace
{
public:
    using Tag = ModelElement::Impl::ReflectionPrivateTag;

    /// A payload; of a text, its characters.
    struct Payload
    {
        void const* address = nullptr;  ///< Null: the element must be asked.
        std::size_t length = 0;         ///< Of a text.
    };

    /// \param type  the C++ type of the payloads.
    PropertyPlace(Property const& property, Tag const& tag, std::type_info const& type);
    PropertyPlace(PropertyPlace&& other) noexcept;
    PropertyPlace& operator=(PropertyPlace&& other) noexcept;
    ~PropertyPlace();

    Payload find(ModelElement::Impl const& element);
    Property const& getProperty() const { return m_property; }
    Tag const& getTag() const { return *m_tag; }

private:
    struct Known;

    Property m_property;
    Tag const* m_tag;
    std::unique_ptr<Known> m_known;
};

/// Reads a property with one value of many elements, without a `Value` for each.
///
///     meta::PropertyReader<int> pages(pagesOfBook);
///     for (ModelElement const& book : books)
///         sum += pages.read(book);
///
/// Works for all elements, of classes with generated code and of those known at run time; it is
/// fastest when elements of one class come one after the other.
///
/// Threads: a reader belongs to one thread; the elements may be read by several.
template <support::PlainScalar T> class PropertyReader
{
public:
    using Tag = PropertyPlace::Tag;

    /// \param tag  must live as long as the reader; the four of `ModelElement::Impl` do.
    explicit PropertyReader(Property const& property,
                            Tag const& tag = ModelElement::Impl::PUBLIC_ACCESS)
        : m_place(property, tag, typeid(T))
    {}

    /// The same as `element->getPropertyValue(property, tag).getValue<T>()`, whatever that raises
    /// included.
    T read(ModelElement const& element)
    {
        PropertyPlace::Payload const payload = m_place.find(*element.getImpl());
        if (!payload.address)
            return element->getPropertyValue(m_place.getProperty(), m_place.getTag())
                .template getValue<T>();
        if constexpr (support::OneOf<T, string, ustring>)
            return T(static_cast<typename T::value_type const*>(payload.address), payload.length);
        else if constexpr (std::is_trivially_copyable_v<T>)
        {
            T value;  // may be kept in a word of another type
            std::memcpy(static_cast<void*>(&value), payload.address, sizeof value);
            return value;
        }
        else
            return *static_cast<T const*>(payload.address);
    }

private:
    PropertyPlace m_place;
};
}  // namespace tarn::kiln::meta

#include "tarnkiln/meta/PropertyReader.h"

#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/PackedPayload.h"
#include "tarnkiln/meta/internal/PlainPlace.h"

namespace tarn::kiln::meta {

using internal::KeptBy;
using internal::KeptValue;
using internal::PlainPlace;
using internal::ReflectiveLayout;
using internal::ReflectiveSlot;

/// The kind of elements that was met last.
struct PropertyPlace::Known
{
    explicit Known(std::type_info const& ofPayload) : payloadType(ofPayload) {}

    void look(ModelElement::Impl const& element, Property const& property);
    bool isReadable(ModelElement::Impl const& element, Property const& property,
                    Tag const& tag) const;

    std::type_info const& payloadType;
    std::type_info const* type = nullptr;  ///< The C++ class.
    ReflectiveLayout::Handle layout;       ///< Of elements of a class known at run time.
    ReflectiveSlot const* slot = nullptr;
    PlainPlace place;
};

void PropertyPlace::Known::look(ModelElement::Impl const& element, Property const& property)
{
    type = &typeid(element);
    KeptBy const by = internal::keptBy(element);
    layout = by == KeptBy::Layout ? internal::cellsOf(element).layoutHandle()
                                  : ReflectiveLayout::Handle();
    slot = layout ? layout.get()->find(property) : nullptr;
    place = PlainPlace::find(element, by, property);
    // The number of a literal is kept in several ways.
    bool const isOfType = place.isKnown() && place.kind() != internal::SlotKind::Enumeration &&
                          internal::withPayloadType(
                              place.kind(), [&]<class T>() { return payloadType == typeid(T); });
    if (!isOfType)
        place = PlainPlace();
}

bool PropertyPlace::Known::isReadable(ModelElement::Impl const& element, Property const& property,
                                      Tag const& tag) const
{
    if (type != &typeid(element) || !place.isKnown())
        return false;
    if (!layout)
        return property &&
               (property->isPublicAccessor() || !(tag == ModelElement::Impl::PUBLIC_ACCESS));
    return &internal::cellsOf(element).layout() == layout.get() &&
           layout.get()->mayRead(*slot, tag);
}

PropertyPlace::PropertyPlace(Property const& property, Tag const& tag, std::type_info const& type)
    : m_property(property),
      m_tag(&tag),
      m_known(std::make_unique<Known>(type))
{}

PropertyPlace::PropertyPlace(PropertyPlace&& other) noexcept = default;
PropertyPlace& PropertyPlace::operator=(PropertyPlace&& other) noexcept = default;
PropertyPlace::~PropertyPlace() = default;

PropertyPlace::Payload PropertyPlace::find(ModelElement::Impl const& element)
{
    if (!m_known->isReadable(element, m_property, *m_tag))
    {
        m_known->look(element, m_property);
        if (!m_known->isReadable(element, m_property, *m_tag))
            return {};
    }
    KeptValue const kept = m_known->place.read(element);
    // Only a required value is a `T`; of an optional one the element tells that it is none.
    return kept.shape == KeptValue::Shape::Single ? Payload{kept.payload, kept.length} : Payload{};
}
}  // namespace tarn::kiln::meta

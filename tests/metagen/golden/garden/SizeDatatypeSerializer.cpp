// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/SizeDatatypeSerializer.h"

namespace acme::garden {

SizeDatatypeSerializer::SizeDatatypeSerializer(meta::DataType const& type)
    : DefaultDatatypeSerializer(type, {
          field<&Size::getLength, &Size::setLength>(u"length"),
          field<&Size::getWidth, &Size::setWidth>(u"width")})
{}

SizeDatatypeSerializer::~SizeDatatypeSerializer() = default;
}  // namespace acme::garden

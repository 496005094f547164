// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The fields of `Size` for code that does not know it.
#pragma once
#include "acme/garden/Size.h"
#include "tarnkiln/meta/DefaultDatatypeSerializer.h"

namespace acme::garden {

/// Takes a `Size` apart and puts it together.
class SizeDatatypeSerializer final : public meta::DefaultDatatypeSerializer<Size>
{
public:
    explicit SizeDatatypeSerializer(meta::DataType const& type);
    ~SizeDatatypeSerializer() override;
};
}  // namespace acme::garden
